// What the rewriter makes of each construct of the language.

#include <string>

#include <gtest/gtest.h>

#include "expr/expression_node.h"
#include "expr/interaction_rewriter.h"
#include "expr/parser.h"

namespace tessal {
namespace {

std::string Rewritten(const std::string& expression) {
  ExpressionNode tree;
  std::int32_t line = 0;
  std::int32_t position = 0;
  std::string message;
  if (ParseExpressionText(expression, tree, line, position, message) == 0) return message;
  return RewriteExpressionText(tree);
}

TEST(InteractionRewriter, WritesEachConstruct) {
  const struct {
    const char* expression;
    const char* rewritten;
  } rows[] = {
      // Brackets stand around each additive chain of a level; the grouping inside a chain is lost.
      {"a", "a"},
      {"1.50E+2", "1.50E+2"},
      {"a+b*c", "(a+b*c)"},
      {"(a+b)*c", "(a+b)*c"},
      {"a-(b-c)", "(a-b-c)"},
      {"a/(b*(c+d))-e", "(a/b*(c+d)-e)"},
      {"-(a+b)", "-(a+b)"},
      {"-a*-b", "-a*-b"},
      // A call opens a level of its own, and its arguments count for themselves.
      {"F()", "F()"},
      {"F(a,b)", "F(a,b)"},
      {"F(a+b;-c)+1", "(F((a+b),-c)+1)"},
      {"F(G(a,H(b,c)),d,e)", "F(G(a,H(b,c)),d,e)"},
      {"F(a,b)*G(c,d)", "F(a,b)*G(c,d)"},
      {"$rate*2", "RID_VAL(rate)*2"},
      // The parts of the time are functions of the engine, in capitals only and not as calls.
      {"YEAR+MONTH+DAY+HOUR+MINUTE+SECOND", "(YEAR()+MONTH()+DAY()+HOUR()+MINUTE()+SECOND())"},
      {"year*YEARS", "year*YEARS"},
      {"YEAR(t)", "YEAR(t)"},
      {"IF a>1 THEN b ELSE c", "IF((a>1),b,c)"},
      {"IF(a>=1;b;c+d)+e", "(IF((a>=1),b,c+d)+e)"},
      {"IF NOT a==b THEN 1 ELSE 2", "IF((IF((a==b),0,1)>0),1,2)"},
      {"EXCEEDANCE_FREQUENCY(a>1)", "a>1"},
      // Of a direct modification, value and target stand with nothing between them.
      {"Age ::+ 1", "1Age"},
      {"Age ::= a+b", "(a+b)Age"},
      {"[XPOS]*2", "_GetProperty(XPOS)*2"},
      // The fields of an interaction have no separators either.
      {"KILL{(Fish,1)}", "_ABMInteract_KILL(Fish1)"},
      {"SPLIT{(3, x)}", "_ABMInteract_SPLIT(3x)"},
      {"TRANSFER{(Fish, F(a,b)), (Mass, [XPOS], 1, -2, c+d, 0)}",
       "_ABMInteract_TRANSFER(FishF(a,b)Mass_GetProperty(XPOS)1-2(c+d)0)"},
      {"GETVALUE{(Fish,1),(),(p,2,3,4,5,6)}*k", "_ABMInteract_GETVALUE(Fish1p23456)*k"},
  };
  for (const auto& row : rows) EXPECT_EQ(Rewritten(row.expression), row.rewritten) << row.expression;
}

TEST(InteractionRewriter, StartsAnewForEachTree) {
  ExpressionNode tree;
  EXPECT_EQ(RewriteExpressionText(tree), "") << "a tree of nothing";
  EXPECT_EQ(Rewritten("F(a,b+1)"), "F(a,(b+1))");
  EXPECT_EQ(Rewritten("a+1"), "(a+1)");
}

TEST(InteractionRewriter, LongChainsNeedNoStack) {
  std::string sum = "a";
  std::string product = "a";
  for (int term = 0; term < 200000; ++term) {
    sum += "+a";
    product += "*a";
  }
  EXPECT_EQ(Rewritten(sum), "(" + sum + ")");
  EXPECT_EQ(Rewritten(product), product);
}

}  // namespace
}  // namespace tessal
