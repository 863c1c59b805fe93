// The list of messages, and that each row of the table of messages is given by some template, with its code.
#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <set>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "support/case_file.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::Case;
using test::CaseCall;

std::set<std::string_view>& CodesSeen() {
  static std::set<std::string_view> codes;
  return codes;
}

/// What is listed, as "code level symbol: text", the undefined symbols and the counter; then the list is
/// emptied.
std::string TakeMessages(const TemplateCore& core, const std::string& folder) {
  std::string listed;
  for (const ErrorRecord& record : Errors().Records()) {
    CodesSeen().insert(record.code);
    listed += std::string(record.code) + " " + std::to_string(record.level) + " " + record.symbol +
              (record.line > 0 ? " in line " + std::to_string(record.line) : "") + ": " + record.text + "\n";
  }
  for (const auto& undefined : core.UndefinedSymbols()) {
    const Finding finding("undefined-symbol", {undefined->symbol});
    CodesSeen().insert(finding.message->code);
    listed += std::string(finding.message->code) + ": " + finding.text + "\n";
  }
  for (std::size_t hit = listed.find(folder); hit != std::string::npos; hit = listed.find(folder)) {
    listed.replace(hit, folder.size(), "FOLDER");
  }
  listed += std::to_string(Errors().ExpressionWarningCount()) + " of checks\n";
  Errors().Reset();
  return listed;
}

std::string TextOf(const std::string& input) {
  if (input.starts_with("from ")) return test::ReadFile(TESSAL_SOURCE_DIR "/" + input.substr(5));
  return input.empty() || input.starts_with('\n') ? input : test::TemplateFromNotation(input);
}

/// A template in a folder of its own, loaded; notifications are on, as in an editor.
struct OpenTemplate {
  explicit OpenTemplate(const std::string& input) {
    ResetExpressionScanner();
    core.LoadWrapper(folder.Write("model.tessal", TextOf(input)));
    SetNotifyChanges(true);
  }
  OpenTemplate(const OpenTemplate&) = delete;
  OpenTemplate& operator=(const OpenTemplate&) = delete;
  ~OpenTemplate() { SetNotifyChanges(false); }

  test::TemporaryFolder folder;
  TemplateCore core;
};

/// Gives the first auxiliary an expression of so many of a character.
void Repeat(TemplateCore& core, const std::string& words) {
  const std::size_t blank = words.find(' ');
  core.GetAuxiliary(0).expression.SetText(std::string(std::stoul(words.substr(blank)), words.front()));
  core.ValidateTemplate();
}

/// What is done with a template, given the rest of the call's line.
using Operation = void (*)(OpenTemplate&, const std::string& rest);
const std::map<std::string, Operation> kOperations = {
    {"load",
     [](OpenTemplate& open, const std::string& rest) { open.core.LoadWrapper(open.folder.File(rest)); }},
    {"load-with-zeros",
     [](OpenTemplate& open, const std::string&) {
       const std::string text = TextOf("constant k 1");
       open.core.LoadWrapper(open.folder.Write("zeros", text + std::string(3, '\0') + "[X]"));
     }},
    {"load-sparse",
     [](OpenTemplate& open, const std::string& rest) {
       const std::string path = open.folder.Write("sparse", "");
       std::filesystem::resize_file(path, std::stoull(rest));
       open.core.LoadWrapper(path);
     }},
    {"load-with-keywords",
     [](OpenTemplate& open, const std::string& rest) {
       std::string text = "\n[TESSAL_SETUP]\n";
       for (int count = std::stoi(rest); count > 0; --count) text += "K = 1\n";
       open.core.LoadWrapper(open.folder.Write("keywords", text + "EndSect\n"));
     }},
    {"save",
     [](OpenTemplate& open, const std::string& rest) { open.core.SaveWrapper(open.folder.File(rest)); }},
    {"rename-class",
     [](OpenTemplate& open, const std::string& rest) { open.core.GetSpecie(0).symbol.SetText(rest); }},
    {"describe-class",
     [](OpenTemplate& open, const std::string& rest) { open.core.GetSpecie(0).description.SetText(rest); }},
    {"repeat-in-auxiliary", [](OpenTemplate& open, const std::string& rest) { Repeat(open.core, rest); }},
    {"process-rule", [](OpenTemplate& open, const std::string&) { open.core.CheckProcessRule(); }},
};

/// The entries of the load's account, or those of one code.
std::string AccountOf(const TemplateCore& core, std::string_view code = "") {
  std::string listed;
  for (const AccountEntry& entry : core.Account().Entries()) {
    if (!code.empty() && entry.code != code) continue;
    CodesSeen().insert(entry.code);
    listed += std::string(entry.code) + " " + entry.symbol + ": " + entry.text + "\n";
  }
  return listed;
}

std::string AnswerTo(const CaseCall& call, OpenTemplate& open) {
  if (call.words == "account") return AccountOf(open.core);
  const std::size_t end = std::min(call.words.find(' '), call.words.size());
  const std::string rest = call.words.substr(std::min(end + 1, call.words.size()));
  if (call.words.starts_with("account ")) return AccountOf(open.core, rest);
  if (call.words != "messages") {
    Errors().Reset();
    kOperations.at(call.words.substr(0, end))(open, rest);
  }
  return TakeMessages(open.core, open.folder.Path().string());
}

TEST(Messages, EachCodeIsGivenByAnExampleOrACase) {
  test::RunCases("core/cases/messages.txt", [](const Case& given) -> test::Answer {
    return [open = std::make_shared<OpenTemplate>(given.input)](const CaseCall& call) {
      return AnswerTo(call, *open);
    };
  });
  // The first guards the check itself: the counts balance on every tree of the parser. The tests of failing
  // allocations see the second. The others are reserved.
  CodesSeen().insert({"call-incomplete", "out-of-memory", "value-outside-range", "unknown-symbol"});
  std::set<std::string_view> codes;
  for (const MessageRow& row : AllMessages()) {
    EXPECT_TRUE(codes.insert(row.code).second) << row.code << " has two rows";
    EXPECT_TRUE(CodesSeen().contains(row.code)) << row.code << " is given by no case";
  }
}

TEST(Messages, ValuesAreFilledInAsTheyAre) {
  EXPECT_EQ(Finding("argument-count", {"%2", "x"}).text, "Wrong number of arguments for function %2(x)!");
}

TEST(Messages, TheListCountsAndFormatsItsRecords) {
  ErrorRegistry registry;
  EXPECT_EQ(registry.JoinErrors(), "");
  registry.AddError(2, "K", Uid{5}, "wrong");
  registry.AddError(3, "", Uid{-1}, "missing");
  registry.AddError(9, "odd", Uid{0}, "level");
  registry.ReportElementError("K", Uid{5}, "again");
  registry.ReportInFile("LOAD ", 7, {"load-failed", {"early"}});
  EXPECT_EQ(registry.Records().front().code, "other");
  EXPECT_EQ(registry.GetErrorCount(2), 2U);
  EXPECT_EQ(registry.GetErrorCount(3), 1U);
  EXPECT_EQ(registry.GetErrorCount(0), 5U);
  EXPECT_EQ(registry.GetErrorCount(9), 5U);
  EXPECT_EQ(registry.ExpressionWarningCount(), 1);
  EXPECT_EQ(registry.JoinErrors(),
            "Warningwrong symbol \"K\" ( UID=5)\nCriticalmissing\nlevel\nWarningagain symbol \"K\" "
            "( UID=5)\n-FATAL-early\n\n");

  std::string symbol;
  std::string text;
  Uid uid{};
  std::uint32_t level = 0;
  registry.GetErrorForList(2, symbol, uid, text);
  EXPECT_EQ(symbol + std::to_string(static_cast<int>(uid)) + text, "odd-1: level");
  uid = Uid{7};
  registry.GetErrorForList(5, symbol, uid, text);
  EXPECT_EQ(symbol + std::to_string(static_cast<int>(uid)) + text, "-1no errors");
  EXPECT_FALSE(registry.FormatError(5, text));
  EXPECT_EQ(text, "invalid error number!");
  EXPECT_FALSE(registry.GetError(5, level, symbol, uid, text));
  EXPECT_TRUE(registry.GetError(0, level, symbol, uid, text));
  EXPECT_EQ(std::to_string(level) + symbol + std::to_string(static_cast<int>(uid)) + text, "2K5wrong");
  registry.ClearErrors();
  EXPECT_EQ(registry.GetErrorCount(2) + registry.GetErrorCount(0), 0U);
  EXPECT_EQ(registry.ExpressionWarningCount(), 1);
}

}  // namespace
}  // namespace tessal
