// What a load and a save do not keep of a broken file is in the account of the load, what is taken over is in
// the file, and what lies beside the template stays byte for byte.
#include <algorithm>
#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "broken_file.h"
#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "expr/user_function_names.h"
#include "stable_save.h"
#include "support/choices.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::BrokenFile;
using fuzz::Choices;
using fuzz::Content;
using fuzz::kComment;
using fuzz::Lines;
using fuzz::LinesOf;
using fuzz::MarksIn;
using fuzz::Require;
using fuzz::RequireStable;
using fuzz::Trimmed;

/// A save writes a line with the present type in its place.
constexpr std::string_view kTypeLine = "// type = ";

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
  const Lines lines = LinesOf(file);
  std::vector<int> heads;
  int number = 0;
  for (const std::string& line : lines) {
    ++number;
    const std::string_view text = Trimmed(line);
    if (text.starts_with("[")) heads.push_back(number);
    for (const std::string& mark : MarksIn(line)) {
      const bool isComment = text.starts_with(kComment) || text.starts_with(kTypeLine);
      if (isComment || IsDerived(text) || saved.find(mark) != std::string::npos) continue;
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
    if (entry.code != "comment-dropped") continue;
    const std::size_t count = LinesOfEntry(entry);
    comments += count;
    for (std::size_t line = 0; line < count; ++line) {
      const std::string& text = lines.at(static_cast<std::size_t>(entry.line) - 1 + line);
      Require(text.find("//") != std::string::npos, "an entry about comments is for lines that have some");
    }
  }
  Require(comments >= CommentLines(file), "a comment that is lost is in the account");
}

void RequireBeside(const BrokenFile& file, const std::string& saved, const LoadAccount& account) {
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
  const BrokenFile file = fuzz::MakeBrokenFile(choices);
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
  if (!account.HasPassedOver()) return 0;

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
