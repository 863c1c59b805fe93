#include "broken_file.h"

#include <algorithm>
#include <array>
#include <cstddef>

#include "core/template_core.h"
#include "stable_save.h"
#include "template_file.h"

namespace tessal::fuzz {

namespace {

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

std::string Joined(const Lines& lines) {
  std::string text;
  for (const std::string& line : lines) text += line + "\r\n";
  return text;
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
    const std::string path = ScratchFile("base.tessal");
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
  if (lines.empty()) return;
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
                                              "'\"" + marks.Next() + "\"' " + std::string(kComment)};
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

}  // namespace

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

std::string_view Trimmed(std::string_view line) {
  return line.substr(std::min(line.find_first_not_of(' '), line.size()));
}

BrokenFile MakeBrokenFile(Choices& choices) {
  constexpr std::size_t kMostChanges = 12;
  // Those from 1000 on are in the base.
  Marks marks(5000);
  Lines lines = Base();
  const std::size_t before = choices.Pick(3);
  const std::size_t after = choices.Pick(3);
  BrokenFile file;
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

}  // namespace tessal::fuzz
