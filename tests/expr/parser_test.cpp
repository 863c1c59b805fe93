#include "expr/parser.h"

#include <gtest/gtest.h>

#include "expr/expression_text.h"
#include "expr/scanner.h"

namespace tessal {
namespace {

using test::ParsedText;

class Parser : public testing::Test {
 protected:
  void SetUp() override { ResetExpressionScanner(); }
  void TearDown() override { ResetExpressionScanner(); }
};

TEST_F(Parser, BuildsTheTreesOfTheLanguage) {
  struct Row {
    const char* text;
    const char* tree;
  };
  const Row rows[] = {
      {"a - b - c", "(5 - (5 - (2 a) (2 b)) (2 c))"},
      {"a / b * c", "(5 * (5 / (2 a) (2 b)) (2 c))"},
      {"a + b * c", "(5 + (2 a) (5 * (2 b) (2 c)))"},
      {"(a + b) * c", "(5 * (5 + (2 a) (2 b)) (2 c))"},
      {"- - a", "(21 negate (21 negate (2 a)))"},
      {"-a*b", "(5 * (21 negate (2 a)) (2 b))"},
      {"-a+b", "(5 + (21 negate (2 a)) (2 b))"},
      {"+a", "(2 a)"},
      {"PI", "(2 PI)"},
      {"PI()", "(4 PI)"},
      {"f(a;b, 1.5)", "(4 f (14 Argument (14 Argument (14 Argument (2 a)) (2 b)) (3 1.5)))"},
      {"$a + 1", "(5 + (4 RID_VAL (14 Argument (2 a))) (3 1))"},
      {"- [x]", "(21 negate (13 x))"},
      {"a ::= b ::= 1", "(8 a (8 b (3 1)))"},
      {"a * b ::= 1", "(5 * (2 a) (8 b (3 1)))"},
      {"a ::+ b + 1", "(9 a (5 + (2 b) (3 1)))"},
      {"a ::- 1", "(10 a (3 1))"},
      {"a ::* 1", "(11 a (3 1))"},
      {"a ::/ 1", "(12 a (3 1))"},
      {"IF a > 1 THEN b ELSE c + 1", "(7 IF (6 > (2 a) (3 1)) (7 THEN (2 b) (7 ELSE (5 + (2 c) (3 1)))))"},
      {"IF(a == 1, b, c)", "(7 IF (6 == (2 a) (3 1)) (7 THEN (2 b) (7 ELSE (2 c))))"},
      {"-IF a > 1 THEN b ELSE c + 1",
       "(21 negate (7 IF (6 > (2 a) (3 1)) (7 THEN (2 b) (7 ELSE (5 + (2 c) (3 1))))))"},
      {"IF (a) > 1 THEN 1 ELSE 2", "(7 IF (6 > (2 a) (3 1)) (7 THEN (3 1) (7 ELSE (3 2))))"},
      {"EXCEEDANCE_FREQUENCY(a > 1)", "(22 Exceedance_Frequency (6 > (2 a) (3 1)))"},
      {"V{(a,1)}", "(15 V (16 Target (2 a) (3 1)))"},
      {"V{(a,1),}", "(15 V (16 Target (2 a) (3 1)))"},
      {"V{(1,x)}", "(15 V (16 Target ID (3 1) (2 x)))"},
      {"V{(a,1),()}", "(15 V (16 Target (2 a) (3 1)) (17 empty))"},
      {"V{(a,1),(p,[Q],1,2,3,4)}",
       "(15 V (16 Target (2 a) (3 1)) (18 Modlist (19 SV1 (2 p) (19 SV2 (13 Q) (19 cpy12 (3 1) (19 cpy21 (3 "
       "2) "
       "(19 red1 (3 3) (19 red2 (3 4)))))))))"},
      {"V{(a,1),(),(p,q,1,2,3,4)}",
       "(15 V (16 Target (2 a) (3 1)) (17 Modlist (17 empty) (18 Modlist (19 SV1 (2 p) (19 SV2 (2 q) (19 "
       "cpy12 "
       "(3 1) (19 cpy21 (3 2) (19 red1 (3 3) (19 red2 (3 4))))))))))"},
  };
  for (const Row& row : rows) EXPECT_EQ(ParsedText(row.text), row.tree) << row.text;
}

TEST_F(Parser, LowersBooleansToConditionals) {
  const char* const kA = "(6 > (2 a) (3 1))";
  const char* const kB = "(6 > (2 b) (3 1))";
  const auto ifTree = [](const std::string& condition, const std::string& yes, const std::string& no) {
    return "(7 IF " + condition + " (7 THEN " + yes + " (7 ELSE " + no + ")))";
  };
  const auto isTrue = [](const std::string& tree) { return "(6 > " + tree + " (3 0))"; };
  const auto whole = [&](const std::string& condition) { return ifTree(condition, "(3 1)", "(3 2)"); };
  const std::string one = "(3 1)";
  const std::string zero = "(3 0)";
  const std::string both = isTrue(ifTree(kA, ifTree(kB, one, zero), zero));
  const std::string either = isTrue(ifTree(kA, one, ifTree(kB, one, zero)));
  EXPECT_EQ(ParsedText("IF a>1 AND b>1 THEN 1 ELSE 2"), whole(both));
  EXPECT_EQ(ParsedText("IF a>1 OR b>1 THEN 1 ELSE 2"), whole(either));
  EXPECT_EQ(ParsedText("IF NOT a>1 THEN 1 ELSE 2"), whole(isTrue(ifTree(kA, zero, one))));
  // AND binds tighter, on either side.
  EXPECT_EQ(ParsedText("IF b>1 OR a>1 AND b>1 THEN 1 ELSE 2"),
            whole(isTrue(ifTree(kB, one, ifTree(both, one, zero)))));
  EXPECT_EQ(ParsedText("IF a>1 AND b>1 OR b>1 THEN 1 ELSE 2"),
            whole(isTrue(ifTree(both, one, ifTree(kB, one, zero)))));
  EXPECT_EQ(ParsedText("IF NOT (a>1 AND b>1) THEN 1 ELSE 2"), whole(isTrue(ifTree(both, zero, one))));
}

TEST_F(Parser, WordsItsFailures) {
  struct Row {
    const char* text;
    const char* message;
  };
  const Row rows[] = {
      {"", "Line 1 position 0 : syntax error, unexpected $end\n"},
      {"a b", "Line 1 position 3 : syntax error, unexpected IDENTIFIER, expecting $end\n"},
      {"a > 1", "Line 1 position 3 : syntax error, unexpected BIGGER, expecting $end\n"},
      {"a (1", "Line 1 position 4 : syntax error, unexpected $end, expecting COMMA or RIGHT_BRACKET\n"},
      {"IF a > 1", "Line 1 position 8 : syntax error, unexpected $end, expecting THEN or OR_OP\n"},
      {"$ 1", "Line 1 position 3 : syntax error, unexpected INT_NUM, expecting IDENTIFIER\n"},
      {"a {(a", "Line 1 position 5 : syntax error, unexpected $end, expecting COMMA\n"},
      {"*", "Line 1 position 1 : syntax error, unexpected MUL_OP_MULTIPLY\n"},
      {"a + ^", "Line 1 position 5 : syntax error, unexpected $undefined\n"},
      {"a +\n  )", "Line 2 position 3 : syntax error, unexpected RIGHT_BRACKET\n"},
  };
  for (const Row& row : rows) EXPECT_EQ(ParsedText(row.text), row.message) << row.text;
}

TEST_F(Parser, RefusesWhatIsNoExpression) {
  const char* const refused[] = {"(a > 1)",
                                 "f(a > 1)",
                                 "IF a THEN 1 ELSE 2",
                                 "IF a > 1 THEN b",
                                 "IF(a + 1, 2, 3)",
                                 "IF NOT NOT a > 1 THEN 1 ELSE 2",
                                 "IF a > 1 > 2 THEN 1 ELSE 2",
                                 "1 ::= a",
                                 "$1",
                                 "$a(1)",
                                 "V{(a,1),(p,q,1,2,3,4),()}",
                                 "V{(a,1),(p,q,1,2,3)}",
                                 "[1]",
                                 "KILL{(Fish, x > 1)}"};
  for (const char* text : refused) EXPECT_EQ(ParsedText(text).substr(0, 5), "Line ") << text;
}

TEST_F(Parser, AHighByteEndsTheInput) {
  EXPECT_EQ(ParsedText("a + 1 \xC3\xA9 b"), "(5 + (2 a) (3 1))");
}

TEST_F(Parser, TokensOfAThousandCharactersAreTooLong) {
  EXPECT_EQ(ParsedText(std::string(999, 'a')).substr(0, 4), "(2 a");
  EXPECT_EQ(ParsedText(std::string(1000, 'a')), "Line 1 position 1000 : token too long\n");
  // Ahead of a syntax error at the same token.
  EXPECT_EQ(ParsedText("a " + std::string(1000, '7')), "Line 1 position 1002 : token too long\n");
}

TEST_F(Parser, DeepNestingIsAMessageAndLongChainsParse) {
  const std::string brackets(200'000, '(');
  EXPECT_NE(ParsedText(brackets).find("memory exhausted"), std::string::npos);
  EXPECT_NE(ParsedText(std::string(200'000, '-') + "a").find("memory exhausted"), std::string::npos);
  // Deeper than the stack's first room, and still read.
  const std::string fits(4'000, '(');
  EXPECT_EQ(ParsedText(fits + "a" + std::string(4'000, ')')), "(2 a)");

  std::string chain = "a";
  for (int link = 0; link < 1'000'000; ++link) chain += "*a";
  ExpressionNode tree;
  std::int32_t line = 0;
  std::int32_t position = 0;
  std::string message;
  ASSERT_EQ(ParseExpressionText(chain, tree, line, position, message), 1);
  const ExpressionNode copy(tree);
  int visits = 0;
  int deepest = 0;
  copy.WalkInOrder(
      nullptr,
      [&](NodeKind, const std::string&, std::int32_t depth) {
        ++visits;
        deepest = std::max(deepest, static_cast<int>(depth));
      },
      nullptr);
  EXPECT_EQ(visits, 2'000'001);
  EXPECT_EQ(deepest, 1'000'000);
}

TEST_F(Parser, AFailureLeavesTheTreeAlone) {
  ExpressionNode tree;
  std::int32_t line = 0;
  std::int32_t position = 0;
  std::string message;
  ASSERT_EQ(ParseExpressionText("a + 1", tree, line, position, message), 1);
  EXPECT_EQ(message, "no error");
  EXPECT_EQ(line, -1);
  EXPECT_EQ(position, -1);
  ASSERT_EQ(ParseExpressionText("\n a +", tree, line, position, message), 0);
  EXPECT_EQ(line, 1);
  EXPECT_EQ(position, 4);
  EXPECT_EQ(test::TreeText(tree), "(5 + (2 a) (3 1))");
}

TEST_F(Parser, AnEarlyStopLeavesLaterCommentsUnopened) {
  EXPECT_EQ(ParsedText("a b c /* open").substr(0, 5), "Line ");
  EXPECT_EQ(ParsedText("a"), "(2 a)");
}

TEST_F(Parser, RandomExpressionsParseTheSameWhateverTheirBlanks) {
  for (unsigned seed = 1; seed <= 500; ++seed) {
    const std::string text = test::RandomExpression(seed);
    const std::string tree = ParsedText(text);
    ASSERT_EQ(tree.front(), '(') << "seed " << seed << ": " << text << "\n" << tree;
    std::string spaced;
    for (const char character : text) {
      spaced += character;
      if (character == ' ') spaced += "\n\t/* */ ";
    }
    ASSERT_EQ(ParsedText("(" + spaced + ")"), tree) << "seed " << seed;
  }
}

}  // namespace
}  // namespace tessal
