#include "docgen/mathml.h"

#include <gtest/gtest.h>

#include "expr/scanner.h"

namespace tessal {
namespace {

constexpr const char* kStart =
    "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><math display=\"block\" align=\"left\" "
    "xmlns=\"http://www.w3.org/1998/Math/MathML\"><mrow><mi>s</mi><mo>=</mo>";
constexpr const char* kEnd = "</mrow></math>\n";

/// The right side of an expression's block.
std::string RightSide(const std::string& expression) {
  ResetExpressionScanner();
  std::string block = ExpressionToMathML(expression, "s", false);
  const std::string start = kStart;
  const std::string end = kEnd;
  if (block.substr(0, start.size()) != start || !block.ends_with(end)) return block;
  return block.substr(start.size(), block.size() - start.size() - end.size());
}

TEST(MathML, WritesEachConstruct) {
  const std::string fence = "<mfenced separators=\"\">";
  struct Row {
    const char* expression;
    std::string markUp;
  };
  const std::string row = "<mtr><mtd columnalign=\"left\"><mtext mathcolor=\"blue\">";
  const Row rows[] = {
      {"a", "<mi>a</mi>"},
      {"1.50", "<mn>1.50</mn>"},
      {"a+b-c", fence + "<mi>a</mi><mo>+</mo><mi>b</mi><mo>-</mo><mi>c</mi></mfenced>"},
      {"a-(b-c)", fence + "<mi>a</mi><mo>-</mo><mi>b</mi><mo>-</mo><mi>c</mi></mfenced>"},
      {"a*(b+c)", "<mi>a</mi><mo>*</mo>" + fence + "<mi>b</mi><mo>+</mo><mi>c</mi></mfenced>"},
      {"a+b*(c+d)", fence + "<mi>a</mi><mo>+</mo><mi>b</mi><mo>*</mo>" + fence +
                        "<mi>c</mi><mo>+</mo><mi>d</mi></mfenced></mfenced>"},
      {"a/b/c",
       "<mfrac><mrow><mfrac><mrow><mi>a</mi></mrow><mrow><mi>b</mi></mrow></mfrac></mrow><mrow><mi>c</mi></"
       "mrow></mfrac>"},
      {"-a", "<mo>-</mo><mi>a</mi>"},
      {"pi()", "<mi mathvariant=\"bold-italic\">&#x3C0;</mi>"},
      {"sqrt(a)", "<mrow><msqrt><mrow><mi>a</mi></mrow></msqrt></mrow>"},
      {"SQR(x)", "<mrow><msup><mrow><mi>x</mi></mrow><mn>2</mn></msup></mrow>"},
      {"POW(a, b+1)", "<mrow><msup><mrow><mi>a</mi></mrow><mrow>" + fence +
                          "<mi>b</mi><mo>+</mo><mn>1</mn></mfenced></mrow></msup></mrow>"},
      {"exp(a)", "<mrow><msup><mi>e</mi><mrow><mi>a</mi></mrow></msup></mrow>"},
      {"max(a,b)",
       "<mrow><mtext mathvariant=\"bold-italic\" "
       "mathcolor=\"green\">MAX</mtext><mfenced><mrow><mi>a</mi></mrow>"
       "<mrow><mi>b</mi></mrow></mfenced></mrow>"},
      {"[XPOS]", "<mtext>[XPOS]</mtext>"},
      {"A ::+ 1", "<mi>A</mi><mtext mathvariant=\"bold-italic\" mathcolor=\"green\">::+</mtext><mn>1</mn>"},
      {"KILL{(Fish, 1)}", "<mi>Fish</mi><mn>1</mn>"},
      {"IF a<=1 THEN b ELSE c",
       "<mtext mathcolor=\"blue\">IF</mtext>" + fence +
           "<mi>a</mi><mo>&#x2264;</mo><mn>1</mn></mfenced><mfenced open=\"{\" close=\"\"><mtable>" + row +
           "THEN</mtext></mtd><mtd columnalign=\"left\"><mi>b</mi></mtd></mtr>" + row +
           "ELSE</mtext></mtd><mtd columnalign=\"left\"><mi>c</mi></mtd></mtr></mtable> </mfenced> "},
      // A conditional in a sum stays within the sum's fence, and its own sums share it.
      {"1+IF a>b THEN c ELSE d-1",
       fence + "<mn>1</mn><mo>+</mo><mtext mathcolor=\"blue\">IF</mtext>" + fence +
           "<mi>a</mi><mo>></mo><mi>b</mi></mfenced><mfenced open=\"{\" close=\"\"><mtable>" + row +
           "THEN</mtext></mtd><mtd columnalign=\"left\"><mi>c</mi></mtd></mtr>" + row +
           "ELSE</mtext></mtd><mtd columnalign=\"left\"><mi>d</mi><mo>-</mo><mn>1</mn></mtd></mtr></mtable> "
           "</mfenced> </mfenced>"},
      {"f(a;g(b+c);d)",
       "<mrow><mtext mathvariant=\"bold-italic\" "
       "mathcolor=\"green\">F</mtext><mfenced><mrow><mi>a</mi></mrow>"
       "<mrow><mrow><mtext mathvariant=\"bold-italic\" mathcolor=\"green\">G</mtext><mfenced><mrow>" +
           fence +
           "<mi>b</mi><mo>+</mo><mi>c</mi></mfenced></mrow></mfenced></mrow></mrow><mrow><mi>d</mi></mrow>"
           "</mfenced></mrow>"},
      {"T{(3, x), (A, [P], 1, 2, 3, 4)}",
       "<mn>3</mn><mi>x</mi><mi>A</mi><mtext>[P]</mtext><mn>1</mn><mn>2</mn><mn>3</mn><mn>4</mn>"},
      {"EXCEEDANCE_FREQUENCY(a==1)", fence + "<mi>a</mi><mo>=</mo><mn>1</mn></mfenced>"},
      {"a +", ""},
      {"", ""},
  };
  for (const Row& each : rows) EXPECT_EQ(RightSide(each.expression), each.markUp) << each.expression;
}

TEST(MathML, BooleanOperatorsShowAsConditionals) {
  const std::pair<const char*, int> rows[] = {
      {"IF a>b THEN 1 ELSE 2", 1},
      {"IF NOT a>b THEN 1 ELSE 2", 2},
      {"IF a>b AND c>d THEN 1 ELSE 2", 3},
      {"IF a>b OR c>d THEN 1 ELSE 2", 3},
  };
  for (const auto& [expression, conditionals] : rows) {
    const std::string text = RightSide(expression);
    int tables = 0;
    for (std::size_t place = text.find("<mtable>"); place != std::string::npos;
         place = text.find("<mtable>", place + 1)) {
      ++tables;
    }
    EXPECT_EQ(tables, conditionals) << expression;
  }
}

TEST(MathML, RelationsAndDerivatives) {
  const std::pair<const char*, const char*> relations[] = {
      {"==", "<mo>=</mo>"}, {"!=", "<mo>&#x2260;</mo>"}, {"<", "<mo>&lt;</mo>"},
      {">", "<mo>></mo>"},  {">=", "<mo>&#x2265;</mo>"}, {"<=", "<mo>&#x2264;</mo>"}};
  for (const auto& [relation, markUp] : relations) {
    EXPECT_NE(RightSide("IF a " + std::string(relation) + " b THEN 1 ELSE 2").find(markUp), std::string::npos)
        << relation;
  }
  EXPECT_NE(
      ExpressionToMathML("p", "S", true)
          .find(
              "<mfrac><mrow><mi>d</mi><mi>S</mi></mrow><mrow><mi>dt</mi></mrow></mfrac><mo>=</mo><mi>p</mi>"),
      std::string::npos);
}

}  // namespace
}  // namespace tessal
