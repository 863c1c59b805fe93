// The list of messages, and that each row of the table of messages is given by some template, with its code.
#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <set>
#include <sstream>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "support/case_file.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::Case;
using test::CaseCall;
using test::TemplateText;

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
  if (input.empty() || input.starts_with('\n')) return input;
  TemplateText text;
  std::istringstream lines(input);
  for (std::string kind, symbol, rest; lines >> kind >> symbol && std::getline(lines >> std::ws, rest);) {
    if (kind == "constant") text.Constant(symbol, rest);
    if (kind == "auxiliary") text.Auxiliary(symbol, rest);
    if (kind == "class") text.Specie(symbol, rest, {});
  }
  return text.Text();
}

/// The calls: what is done with the template, given the rest of the call's line.
using Operation = void (*)(TemplateCore&, const std::string& folder, const std::string& rest);
const std::map<std::string, Operation> kOperations = {
    {"load", [](TemplateCore& core, const std::string& folder,
                const std::string& rest) { core.LoadWrapper(folder + "/" + rest); }},
    {"save", [](TemplateCore& core, const std::string& folder,
                const std::string& rest) { core.SaveWrapper(folder + "/" + rest); }},
    {"rename-class", [](TemplateCore& core, const std::string&,
                        const std::string& rest) { core.GetSpecie(0).symbol.SetText(rest); }},
    {"describe-class", [](TemplateCore& core, const std::string&,
                          const std::string& rest) { core.GetSpecie(0).description.SetText(rest); }},
    {"repeat-in-auxiliary",
     [](TemplateCore& core, const std::string&, const std::string& rest) {
       std::istringstream words(rest);
       std::string expression;
       std::string piece;
       for (words >> piece; expression.size() < 20'000; expression += piece) {
       }
       words >> std::ws >> piece;
       core.GetAuxiliary(0).expression.SetText(expression.substr(0, std::stoul(piece)));
       core.ValidateTemplate();
     }},
    {"process-rule",
     [](TemplateCore& core, const std::string&, const std::string&) { core.CheckProcessRule(); }},
};

TEST(Messages, EachCodeIsGivenByAnExampleOrACase) {
  test::RunCases("core/cases/messages.txt", [](const Case& given) {
    auto loaded = std::make_shared<test::LoadedTemplate>(TextOf(given.input));
    const std::string folder = loaded->Path().substr(0, loaded->Path().rfind('/'));
    return [loaded, folder](const CaseCall& call) {
      const std::size_t blank = std::min(call.words.find(' '), call.words.size());
      const std::string rest = call.words.substr(std::min(blank + 1, call.words.size()));
      if (call.words != "messages") {
        Errors().Reset();
        kOperations.at(call.words.substr(0, blank))(**loaded, folder, rest);
      }
      return TakeMessages(**loaded, folder);
    };
  });
  // It guards the check itself: the counts balance on every tree of the parser.
  CodesSeen().insert("call-incomplete");
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
  registry.AddError(2, "K", 5, "wrong");
  registry.AddError(3, "", -1, "missing");
  registry.AddError(9, "odd", 0, "level");
  registry.ReportElementError("K", 5, "again");
  registry.ReportInFile("LOAD ", 7, {"load-failed", {"early"}});
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
  std::int32_t uid = 0;
  std::uint32_t level = 0;
  registry.GetErrorForList(2, symbol, uid, text);
  EXPECT_EQ(symbol + std::to_string(uid) + text, "odd-1: level");
  registry.GetErrorForList(5, symbol, uid, text);
  EXPECT_EQ(symbol + std::to_string(uid) + text, "-1no errors");
  EXPECT_FALSE(registry.FormatError(5, text));
  EXPECT_EQ(text, "invalid error number!");
  EXPECT_FALSE(registry.GetError(5, level, symbol, uid, text));
  EXPECT_TRUE(registry.GetError(0, level, symbol, uid, text));
  EXPECT_EQ(std::to_string(level) + symbol + std::to_string(uid) + text, "2K5wrong");
  registry.ClearErrors();
  EXPECT_EQ(registry.GetErrorCount(2) + registry.GetErrorCount(0), 0U);
  EXPECT_EQ(registry.ExpressionWarningCount(), 1);
}

}  // namespace
}  // namespace tessal
