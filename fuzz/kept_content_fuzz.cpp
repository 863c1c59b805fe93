// A template's file with lines left out, doubled, mistyped and swapped, with comments, foreign keywords and
// foreign sections: what a load and a save do not keep of it is in the account of the load, and what lies
// beside the template stays byte for byte. Each value carries a number of its own, by which it is found
// again.
#include <algorithm>
#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "choices.h"
#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "expr/user_function_names.h"
#include "stable_save.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Choices;
using fuzz::Content;
using fuzz::Require;
using fuzz::RequireStable;
using Lines = std::vector<std::string>;

constexpr std::string_view kComment = "//#";
constexpr std::string_view kTargetHead = "[TESSAL_SETUP]";

/// Gives numbers that nothing else in a file holds.
class Marks final {
 public:
  explicit Marks(int first) : next(first) {}
  std::string Next() { return "7" + std::to_string(next++) + "7"; }

 private:
  int next;
};

bool IsDigit(char character) {
  return character >= '0' && character <= '9';
}

/// The marks in a text: its runs of six digits.
Lines MarksIn(std::string_view text) {
  constexpr std::size_t kDigits = 6;
  Lines marks;
  for (std::size_t place = 0; place < text.size();) {
    std::size_t end = place;
    while (end < text.size() && IsDigit(text[end])) ++end;
    if (end - place == kDigits) marks.emplace_back(text.substr(place, kDigits));
    place = end + 1;
  }
  return marks;
}

Lines LinesOf(std::string_view text) {
  Lines lines;
  while (!text.empty()) {
    const std::size_t end = std::min(text.find('\n'), text.size() - 1);
    const std::string_view line = text.substr(0, end + 1);
    lines.emplace_back(line.substr(0, line.find_last_not_of("\r\n") + 1));
    text.remove_prefix(end + 1);
  }
  return lines;
}

std::string Joined(const Lines& lines) {
  std::string text;
  for (const std::string& line : lines) text += line + "\r\n";
  return text;
}

std::string_view Trimmed(std::string_view line) {
  return line.substr(std::min(line.find_first_not_of(' '), line.size()));
}

/// A line whose value has a mark, where it had an empty or a default value.
std::string Marked(const std::string& line, Marks& marks) {
  const std::size_t end = line.find(" = ");
  if (end == std::string::npos) return line;
  const std::string head = line.substr(0, end + 3);
  const std::string_view key = Trimmed(head);
  const std::string_view value = std::string_view(line).substr(end + 3);
  constexpr std::array<std::string_view, 6> kNumbers = {"DEFAULT_VALUE", "MIN_VALUE", "MAX_VALUE",
                                                        "RANDSEED",      "RADIUS",    "CONTROLVALUE"};
  const bool isNumber = std::any_of(kNumbers.begin(), kNumbers.end(),
                                    [key](std::string_view number) { return key.starts_with(number); });
  if (isNumber) return head + marks.Next();
  if (key.starts_with("EXPRESSION") && value.starts_with("'\"")) return head + "'\"" + marks.Next() + "\"'";
  return value == "''" ? head + "'of " + marks.Next() + "'" : line;
}

/// A template with one element of each kind and a mark in each value, as a save writes it.
const Lines& Base() {
  static const Lines kBase = [] {
    const std::string path = fuzz::ScratchFile("base.tessal");
    TemplateCore core;
    Require(core.SaveWrapper(path), "the base is saved");
    const auto make = [&core](ElementKind first, std::size_t kinds, Uid owner) {
      for (std::size_t kind = 0; kind < kinds; ++kind)
        core.CreateElement({"", KindAfter(first, kind), owner});
    };
    make(ElementKind::StateVariable, 7, Uid::None);
    make(ElementKind::StateVariable, 2, Uid::None);
    make(ElementKind::SpecieStateVariable, 6,
         core.GetSpecie(0).Head(ElementKind::SpecieConstantList).GetUid());
    core.GetMisc()->AddExternalFunction();
    const std::int32_t group = core.AddVisibilityGroup();
    core.AddItemToLevel(group, core.CreateLevel(group), 1);
    Require(core.SaveWrapper(path), "the base is saved");
    Marks marks(1000);
    Lines lines = LinesOf(Content(path));
    for (std::string& line : lines) line = Marked(line, marks);
    Require(ReplaceFile(path, Joined(lines)).empty(), "the base is written");
    // A save writes the constants' texts in the place of the auxiliaries'.
    Require(core.LoadWrapper(path) && core.SaveWrapper(path), "the base is saved");
    Require(core.LoadWrapper(path) && !core.Account().Loses(), "and whole");
    return LinesOf(Content(path));
  }();
  return kBase;
}

std::size_t EndOfSection(const Lines& lines, std::size_t head) {
  const std::size_t indent = lines[head].find('[');
  if (indent == std::string::npos) return head;
  for (std::size_t line = head; line < lines.size(); ++line) {
    if (lines[line].find("EndSect") == indent) return line;
  }
  return head;
}

void Change(Lines& lines, Choices& choices, Marks& marks) {
  const std::size_t at = choices.PickOfMany(lines.size());
  const auto begin = lines.begin() + static_cast<std::ptrdiff_t>(at);
  const auto end = lines.begin() + static_cast<std::ptrdiff_t>(EndOfSection(lines, at) + 1);
  const std::size_t valueStart = lines[at].find(" = ");
  const std::string key = lines[at].substr(0, std::min(valueStart, lines[at].size()));
  const std::array<std::string, 7> kValues = {"'" + marks.Next() + "'",
                                              "|" + marks.Next() + "|",
                                              marks.Next(),
                                              "-0.5e" + marks.Next(),
                                              "TRUE",
                                              "'" + marks.Next() + "', " + marks.Next(),
                                              "'\"" + marks.Next() + "\"' // " + marks.Next()};
  switch (choices.Pick(12)) {
    case 0:
      lines.erase(begin);
      break;
    case 1:
      lines.erase(begin, end);
      break;
    case 2:
      lines.insert(begin, std::string(lines[at]));
      break;
    case 3: {
      const Lines section(begin, end);
      lines.insert(end, section.begin(), section.end());
      break;
    }
    case 4:
      lines.insert(begin, std::string(kComment) + marks.Next());
      break;
    case 5:
      lines[at] += " " + std::string(kComment);
      break;
    case 6:
      lines.insert(begin, "F" + marks.Next() + " = " + choices.AnyOf(kValues));
      break;
    case 7:
      lines.insert(begin, "[F" + marks.Next() + "]\r\nA = 1\r\nEndSect");
      break;
    case 8:
    case 9:
      if (valueStart != std::string::npos) lines[at] = key + " = " + choices.AnyOf(kValues);
      break;
    case 10:
      lines[at].insert(lines[at].size() - Trimmed(lines[at]).size(), "X");
      break;
    default:
      std::swap(lines[at], lines[choices.PickOfMany(lines.size())]);
      break;
  }
}

/// A top-level section that is none of ours, in any form that the library reads.
std::string ForeignSection(Choices& choices, Marks& marks) {
  constexpr std::array<const char*, 5> kBefore = {"", "", "\r\n", "//# before\r\n", "\t \r\n"};
  constexpr std::array<const char*, 6> kInside = {"  A = 007 ,1.2345678901234567 // x",
                                                  "B = 'two\r\nlines'",
                                                  "[INNER]//\r\n   EndSect",
                                                  "//# in it",
                                                  "C=99999999999,TRUE,|it's|",
                                                  ""};
  std::string text = "[E" + marks.Next() + "]";
  for (std::size_t count = choices.Pick(4); count > 0; --count)
    text += "\r\n" + std::string(choices.AnyOf(kInside));
  return choices.AnyOf(kBefore) + text + "\r\nEndSect";
}

/// A file in which a template lies between other sections.
struct File {
  std::string text;
  Lines sections;  ///< those beside the template
};

File Make(Choices& choices) {
  constexpr std::size_t kMostChanges = 12;
  // Those from 1000 on are in the base.
  Marks marks(5000);
  Lines lines = Base();
  const std::size_t before = choices.Pick(3);
  const std::size_t after = choices.Pick(3);
  File file;
  for (std::size_t count = before + after; count > 0; --count)
    file.sections.push_back(ForeignSection(choices, marks));
  const bool bareLines = choices.Pick(4) == 1;
  const bool noLastLineEnd = choices.Pick(4) == 1;
  for (std::size_t count = 0; count < kMostChanges && !choices.Done(); ++count) Change(lines, choices, marks);
  const auto head = std::find(lines.begin(), lines.end(), kTargetHead);
  lines.insert(head, file.sections.begin(), file.sections.begin() + static_cast<std::ptrdiff_t>(before));
  lines.insert(lines.end(), file.sections.begin() + static_cast<std::ptrdiff_t>(before), file.sections.end());
  file.text = Joined(lines);
  if (noLastLineEnd) file.text.erase(file.text.find_last_not_of("\r\n") + 1);
  if (bareLines) std::erase(file.text, '\r');
  return file;
}

std::size_t CountOf(std::string_view text, std::string_view part) {
  std::size_t count = 0;
  for (std::size_t place = text.find(part); place != std::string_view::npos;
       place = text.find(part, place + 1))
    ++count;
  return count;
}

std::size_t CommentLines(std::string_view text) {
  const Lines lines = LinesOf(text);
  return static_cast<std::size_t>(std::count_if(lines.begin(), lines.end(), [](const std::string& line) {
    return line.find(kComment) != std::string::npos;
  }));
}

/// Whether a line's value follows from the rest of a template, or is stamped by a save under a new name.
bool IsDerived(std::string_view line) {
  constexpr std::array<std::string_view, 15> kDerived = {"ID",
                                                         "ITEMS",
                                                         "ITEMCOUNT",
                                                         "GROUPS",
                                                         "LEVELS",
                                                         "LOOKFOR",
                                                         "VARIABLE_ID",
                                                         "SPECIE_ID",
                                                         "SPECIE",
                                                         "EXPRESSION_TYPE",
                                                         "DOCUMENT_REVISION",
                                                         "TESSAL_VERSION",
                                                         "PARSER_VERSION",
                                                         "OPTIMISE",
                                                         "BUILD_SPATIAL_TREE"};
  return std::find(kDerived.begin(), kDerived.end(), line.substr(0, line.find(' '))) != kDerived.end();
}

/// How many lines an entry about comments is for: "in line 9", or "lines 9 to 12".
std::size_t LinesOfEntry(const AccountEntry& entry) {
  const std::size_t last = entry.text.rfind(" to ");
  const int count = last == std::string::npos ? 1 : std::atoi(entry.text.c_str() + last + 4) - entry.line + 1;
  return static_cast<std::size_t>(std::max(count, 1));
}

/// For the reader of a finding.
void Print(int number, const std::string& line, const LoadAccount& account) {
  for (const AccountEntry& entry : account.Entries())
    std::fprintf(stderr, "%d: %s\n", entry.line, entry.text.c_str());
  std::fprintf(stderr, "line %d is lost: %s\n", number, line.c_str());
}

/// Every mark of the file is in what was saved or named by the account, by itself or with the whole section
/// that it is in.
void RequireNamed(const std::string& file, const std::string& saved, const LoadAccount& account) {
  std::vector<int> heads;
  int number = 0;
  for (const std::string& line : LinesOf(file)) {
    ++number;
    const std::string_view text = Trimmed(line);
    if (text.starts_with("[")) heads.push_back(number);
    for (const std::string& mark : MarksIn(line)) {
      if (saved.find(mark) != std::string::npos || text.starts_with(kComment) || IsDerived(text)) continue;
      const auto& entries = account.Entries();
      const bool isNamed = std::any_of(entries.begin(), entries.end(), [&](const AccountEntry& entry) {
        return entry.kind != AccountKind::Absent &&
               (entry.text.find(mark) != std::string::npos ||
                std::find(heads.begin(), heads.end(), entry.line) != heads.end());
      });
      if (!isNamed) Print(number, line, account);
      Require(isNamed, "a value that is lost is in the account");
    }
    if (text.starts_with("EndSect") && !heads.empty()) heads.pop_back();
  }
  std::size_t comments = CommentLines(saved);
  for (const AccountEntry& entry : account.Entries()) {
    if (entry.code == "comment-dropped") comments += LinesOfEntry(entry);
  }
  Require(comments >= CommentLines(file), "a comment that is lost is in the account");
}

void RequireBeside(const File& file, const std::string& saved, const LoadAccount& account) {
  const auto& entries = account.Entries();
  for (const std::string& section : file.sections) {
    const std::string whole = section.substr(section.find('['));
    // Changes to the template's own section may have moved its end.
    const bool isNamed = std::any_of(entries.begin(), entries.end(), [&whole](const AccountEntry& entry) {
      return entry.text.find(whole.substr(1, whole.find(']') - 1)) != std::string::npos;
    });
    Require(isNamed || CountOf(saved, whole) == 1, "what lies beside the template stays byte for byte");
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  Choices choices(data, size);
  ResetUserFunctionNames();
  const File file = Make(choices);
  const std::string path = fuzz::ScratchFile("in.tessal");
  const std::string copy = fuzz::ScratchFile("out.tessal");
  Require(ReplaceFile(path, file.text).empty(), "the file is written");
  ResetExpressionScanner();
  TemplateCore core;
  if (!core.LoadWrapper(path)) {
    Require(!Errors().Records().empty(), "a failed load says why");
    return 0;
  }
  const LoadAccount account = core.Account();
  if (!core.SaveWrapper(copy)) {
    Require(!Errors().Records().empty(), "a failed save says why");
    return 0;
  }
  RequireNamed(file.text, Content(copy), account);
  RequireBeside(file, Content(copy), account);
  RequireStable(core, copy);

  ResetExpressionScanner();
  Require(core.LoadWrapper(path), "it loads again");
  core.TakeOverPassedOver();
  Require(!core.Account().HasPassedOver(), "all is taken over");
  const LoadAccount rest = core.Account();
  if (!core.SaveWrapper(copy)) return 0;
  RequireNamed(file.text, Content(copy), rest);
  RequireStable(core, copy);
  return 0;
}
