#include "expr/semantic_checks.h"

#include <gtest/gtest.h>

#include "core/error_registry.h"
#include "expr/scanner.h"
#include "expr/user_function_names.h"

namespace tessal {
namespace {

class SemanticChecks : public testing::Test {
 protected:
  void SetUp() override {
    ResetExpressionScanner();
    Errors().Reset();
    ResetUserFunctionNames();
  }
  void TearDown() override { SetUp(); }

  /// The findings on an expression, each in brackets, and the result.
  static std::string Findings(const std::string& expression) {
    Errors().Reset();
    const int result = CheckFunctionsSpecified("S", 7, expression);
    std::string text = std::to_string(result);
    for (const ErrorRecord& record : Errors().Records()) text += "[" + record.text + "]";
    return text;
  }
};

TEST_F(SemanticChecks, FindsWhatTheGrammarCannotSee) {
  const std::pair<const char*, const char*> rows[] = {
      {"SIN(1)", "1"},
      {"PI()", "1"},
      {"SIN(1,2)", "1[Wrong number of arguments for function SIN(x)!]"},
      {"sin()", "1[Wrong number of arguments for function sin(x)!]"},
      {"ARCTAN2(1)", "1[Wrong number of arguments for function ARCTAN2(x,y)!]"},
      {"PI(1)", "1[Wrong number of arguments for function PI()!]"},
      {"foo(1)", "1[Unknown function 'foo' !]"},
      {"$a", "1[Unknown function 'RID_VAL' !]"},
      {"[XPOS] + [xpos]", "1[Unknown property ['xpos'] !]"},
      {"EXCEEDANCE_FREQUENCY(a>1)", "1"},
      {"exceedance_frequency(1,2)",
       "1[The function exceedance_frequency is deprecated and should not be used!]"},
      {"F1(1)", "1[The function F1 is deprecated and should not be used!]"},
      {"X(1)",
       "1[Wrong number of arguments for function X()!][The function X is deprecated and should not be "
       "used!]"},
      {"MAX(SIN(1,2),3)", "1[Wrong number of arguments for function SIN(x)!]"},
      {"SIN(foo(1,2))", "1[Unknown function 'foo' !]"},
      {"MAX(MIN(1,2),MIN(3,MAX(4,5)))", "1"},
      {"TABLE_VALUE(1,2,3,4,5,6)", "1"},
      {"IF foo(1) > 1 THEN [bad] ELSE a ::= bar()",
       "1[Unknown function 'bar' !][Unknown property ['bad'] !][Unknown function 'foo' !]"},
      {"V{(a,foo(1)),([no],1,1,1,1,1)}", "1[Unknown property ['no'] !][Unknown function 'foo' !]"},
      {"a +", "0[Line 1 position 3 : syntax error, unexpected $end\n]"},
  };
  for (const auto& [expression, findings] : rows) EXPECT_EQ(Findings(expression), findings) << expression;
  EXPECT_EQ(Errors().Records().front().symbol, "S");
  EXPECT_EQ(Errors().Records().front().uid, 7);
  EXPECT_EQ(Errors().Records().front().level, 2U);
}

TEST_F(SemanticChecks, UserFunctionsAreCallableWithAnyArguments) {
  EXPECT_TRUE(RegisterUserFunctionName("Mix"));
  EXPECT_FALSE(RegisterUserFunctionName("Mix"));
  EXPECT_EQ(Findings("Mix(1,2,3) + Mix()"), "1");
  EXPECT_EQ(Findings("mix(1)"), "1[Unknown function 'mix' !]");
  EXPECT_FALSE(IsValidSymbol("Mix"));
  UnregisterUserFunctionName("Mix");
  EXPECT_EQ(Findings("Mix(1)"), "1[Unknown function 'Mix' !]");
}

TEST_F(SemanticChecks, JudgesNames) {
  struct Row {
    const char* name;
    bool spelling;
    bool valid;
    bool reserved;
  };
  const Row rows[] = {
      {"a", true, true, false},     {"", false, false, true},      {"a.b", false, false, false},
      {"a b", false, false, false}, {"_a", false, false, false},   {"1a", false, false, false},
      {"K_2", true, true, false},   {"X", true, false, true},      {"x", true, true, true},
      {"SIN", true, false, true},   {"sin", true, true, true},     {"IF", true, false, true},
      {"if", true, true, true},     {"kill", true, true, true},    {"KILL", true, false, true},
      {"12", false, false, true},   {"1.5e3", false, false, true}, {"-1", false, false, true},
      {"0x1F", false, false, true}, {"1e", false, false, false},   {"nan", true, true, true},
      {"inf", true, true, true},    {" 5", false, false, true},    {"5 ", false, false, false},
      {"+-5", false, false, false}, {"1e999", false, false, true}, {"AND", true, true, false},
  };
  for (const Row& row : rows) {
    EXPECT_EQ(IsValidSymbolSpelling(row.name), row.spelling) << row.name;
    EXPECT_EQ(IsValidSymbol(row.name), row.valid) << row.name;
    EXPECT_EQ(IsReservedName(row.name), row.reserved) << row.name;
  }
}

}  // namespace
}  // namespace tessal
