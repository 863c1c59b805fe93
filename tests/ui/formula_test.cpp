// How expressions look as formulas: which look alike, which do not, and what is too large to be one.
#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <optional>
#include <stdexcept>
#include <string>

#include "expr/parser.h"
#include "ui/formula_layout.h"

namespace tessal {
namespace {

std::optional<FormulaLayout> LayOut(const std::string& expression) {
  FormulaStyle style;
  style.ink = style.number = style.callable = style.keyword = style.property = Qt::black;
  style.colourOf = [](const std::string&) { return QColor(Qt::black); };
  const auto parsed = ParseExpression(expression);
  if (parsed->Tree() == nullptr) throw std::invalid_argument("does not parse: " + expression);
  return FormulaLayout::Of(*parsed->Tree(), {}, style);
}

QImage Picture(const std::string& expression) {
  const auto formula = LayOut(expression);
  QImage picture(formula->Size().toSize() + QSize(2, 2), QImage::Format_RGB32);
  picture.fill(Qt::white);
  QPainter painter(&picture);
  formula->Paint(painter, QPointF(1, 1));
  return picture;
}

TEST(Formula, HasTheBracketsThatItsGroupingNeedsAndNoOthers) {
  const std::pair<const char*, const char*> alike[] = {
      {"((a))", "a"},
      {"(a*b)+c", "a*b+c"},
      {"(a+b)+c", "a+b+c"},
      {"(a*b)*c", "a*b*c"},
      {"(a+b)/(c-d)", "((a+b))/(c-d)"},
      {"MAX((a),(b+c))", "max(a;b+c)"},
      {"POW(a,(b+c))", "POW(a,b+c)"},
      {"IF(a > 1, b, c)", "IF a > 1 THEN b ELSE c"},
      {"IF (a > 1 AND b > 1) AND c > 1 THEN 1 ELSE 2", "IF a > 1 AND b > 1 AND c > 1 THEN 1 ELSE 2"},
      {"IF (a > 1 AND b > 1) OR c > 1 THEN 1 ELSE 2", "IF a > 1 AND b > 1 OR c > 1 THEN 1 ELSE 2"},
      {"1e3", "1E+3"},
  };
  for (const auto& [left, right] : alike)
    EXPECT_EQ(Picture(left), Picture(right)) << left << " and " << right;
  const std::pair<const char*, const char*> different[] = {
      {"a-(b-c)", "a-b-c"},
      {"a*(b+c)", "a*b+c"},
      {"a*(b*c)", "a*b*c"},
      {"-(a+b)", "-a+b"},
      {"a-(-b)", "a--b+0"},
      {"a*(-b)*c", "a*b*c"},
      {"SQR(-a)", "-SQR(a)"},
      {"SQR(a+b)", "a+SQR(b)"},
      {"POW(SQR(a),b)", "SQR(POW(a,b))"},
      {"(IF a > 1 THEN b ELSE c)+1", "IF a > 1 THEN b ELSE c+1"},
      {"IF a > 1 THEN (IF b > 1 THEN 1 ELSE 2) ELSE 3", "IF a > 1 THEN 1 ELSE IF b > 1 THEN 2 ELSE 3"},
      {"IF a > 1 AND (b > 1 OR c > 1) THEN 1 ELSE 2", "IF a > 1 AND b > 1 OR c > 1 THEN 1 ELSE 2"},
      {"IF NOT (a > 1 AND b > 1) THEN 1 ELSE 2", "IF (NOT a > 1) AND b > 1 THEN 1 ELSE 2"},
      {"KILL{(Fish, a)}", "KILL{(Fish, a),(b,c,1,2,3,4)}"},
      {"[XPOS]", "XPOS"},
  };
  for (const auto& [left, right] : different)
    EXPECT_NE(Picture(left), Picture(right)) << left << " and " << right;
}

TEST(Formula, GrowsAsMathematicsDoes) {
  const auto size = [](const char* expression) { return LayOut(expression)->Size(); };
  EXPECT_GT(size("a/b").height(), size("a*b").height());
  EXPECT_LT(size("a/b").width(), size("a*b").width());
  EXPECT_LT(size("POW(a,b)").width(), size("a*b").width()) << "an exponent is small";
  EXPECT_GT(size("IF a > 1 THEN b ELSE c").height(), size("a").height() * 2);
  EXPECT_GT(size("ABS(a/b)").width(), size("a/b").width());
}

TEST(Formula, IsNoneForATreeThatNobodyCouldRead) {
  constexpr int kDeep = 9'000;
  const auto repeated = [](int times, const std::string& part) {
    std::string text;
    for (int count = 0; count < times; ++count) text += part;
    return text;
  };
  EXPECT_FALSE(LayOut(repeated(kDeep, "-") + "a"));
  EXPECT_FALSE(LayOut(repeated(3'000, "SIN(") + "a" + repeated(3'000, ")")));
  EXPECT_FALSE(LayOut("a" + repeated(200'000, "/a")));
  EXPECT_FALSE(LayOut("a" + repeated(200'000, "+a")));
  EXPECT_FALSE(LayOut("IF a > 1" + repeated(50'000, " AND a > 1") + " THEN 1 ELSE 2"));
  EXPECT_FALSE(LayOut(repeated(1'500, "IF a > 1 THEN 1 ELSE ") + "2"));
  EXPECT_FALSE(LayOut("MAX(a" + repeated(100'000, ",a") + ")"));
  EXPECT_TRUE(LayOut("a" + repeated(500, "+a*b")).has_value()) << "a long chain is one level";
  EXPECT_TRUE(LayOut(repeated(100, "IF a > 1 THEN 1 ELSE ") + "2").has_value());
  EXPECT_TRUE(LayOut(repeated(40, "(1+") + "a" + repeated(40, ")")).has_value());
}

}  // namespace
}  // namespace tessal
