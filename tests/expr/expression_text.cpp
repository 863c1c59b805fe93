#include "expr/expression_text.h"

#include <random>

#include "expr/parser.h"

namespace tessal::test {

namespace {

class ExpressionMaker final {
 public:
  explicit ExpressionMaker(unsigned seed) : random(seed) {}

  std::string Expression(int depth) {
    if (depth == 0) return Leaf();
    switch (Pick(9)) {
      case 0:
        return Expression(depth - 1) + " + " + Expression(depth - 1);
      case 1:
        return Expression(depth - 1) + "-" + Expression(depth - 1);
      case 2:
        return "(" + Expression(depth - 1) + ")*" + Leaf();
      case 3:
        return "(" + Expression(depth - 1) + ")/(" + Expression(depth - 1) + ")";
      case 4:
        return "-(" + Expression(depth - 1) + ")";
      case 5:
        return "MAX(" + Expression(depth - 1) + ", " + Expression(depth - 1) + ")";
      case 6:
        return "(IF " + Condition(depth - 1) + " THEN " + Expression(depth - 1) + " ELSE " +
               Expression(depth - 1) + ")";
      case 7:
        return "IF(" + Condition(depth - 1) + ";" + Expression(depth - 1) + ";" + Expression(depth - 1) + ")";
      default:
        return Leaf();
    }
  }

 private:
  std::string Condition(int depth) {
    std::string comparison = Expression(depth) + " >= " + Leaf();
    switch (Pick(4)) {
      case 0:
        return comparison + " AND " + Leaf() + " != " + Leaf();
      case 1:
        return "NOT (" + comparison + " OR " + Leaf() + "<" + Leaf() + ")";
      default:
        return comparison;
    }
  }

  std::string Leaf() {
    static const char* const kLeaves[] = {"a", "Kd", "x_1", "2", "0.5", "1e-3", "[XPOS]", "$r", "PI()"};
    return kLeaves[Pick(std::size(kLeaves))];
  }

  std::size_t Pick(std::size_t count) { return random() % count; }

  std::mt19937 random;
};

}  // namespace

std::string TreeText(const ExpressionNode& node) {
  std::string text = "(" + std::to_string(static_cast<int>(node.Kind())) + " " + node.Text();
  for (std::int32_t slot = 1; slot <= node.ChildCount(); ++slot) text += " " + TreeText(*node.Child(slot));
  return text + ")";
}

std::string ParsedText(const std::string& expression) {
  ExpressionNode tree;
  std::int32_t line = 0;
  std::int32_t position = 0;
  std::string message;
  return ParseExpressionText(expression, tree, line, position, message) != 0 ? TreeText(tree) : message;
}

std::string RandomExpression(unsigned seed) {
  constexpr int kDepth = 6;
  return ExpressionMaker(seed).Expression(kDepth);
}

}  // namespace tessal::test
