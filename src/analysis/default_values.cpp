#include "analysis/default_values.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <string>

#include "analysis/declared_values.h"
#include "analysis/symbol_index.h"
#include "analysis/tree_nodes.h"
#include "core/template_core.h"
#include "expr/evaluate.h"
#include "expr/expression_shape.h"

namespace tessal {

namespace {

constexpr double kUnknown = std::numeric_limits<double>::quiet_NaN();

double Known(double number) {
  return std::isfinite(number) ? number : kUnknown;
}

double Arithmetic(char sign, double left, double right) {
  switch (sign) {
    case '+':
      return left + right;
    case '-':
      return left - right;
    case '*':
      return left * right;
    case '/':
      return right == 0.0 ? kUnknown : left / right;
    default:
      return kUnknown;
  }
}

bool Compare(std::string_view sign, double left, double right) {
  if (sign == ">") return left > right;
  if (sign == "<") return left < right;
  if (sign == ">=") return left >= right;
  if (sign == "<=") return left <= right;
  return sign == "==" ? left == right : left != right;
}

double Call(const ExpressionNode& call, const NodeValues& values) {
  std::vector<double> arguments;
  for (const ExpressionNode* argument : ArgumentsOf(call)) {
    arguments.push_back(values.Of(*argument));
    if (std::isnan(arguments.back())) return kUnknown;
  }
  double value = kUnknown;
  return EvaluateFunction(std::string(call.Text()), arguments, value) == 1 ? value : kUnknown;
}

double Choose(const ExpressionNode& conditional, const NodeValues& values) {
  const auto [condition, then, otherwise] = BranchesOf(conditional);
  const double chosen = values.Of(condition);
  if (std::isnan(chosen)) return kUnknown;
  return values.Of(chosen != 0.0 ? then : otherwise);
}

}  // namespace

double NodeValues::Of(const ExpressionNode& node) const {
  const auto distance = static_cast<std::size_t>(root - &node);
  return distance < values.size() ? values[distance] : kUnknown;
}

DefaultValues::DefaultValues(const SymbolIndex& indexed) : symbols(indexed) {
  const std::vector<SymbolRecord>& table = symbols.Template().SymbolTable();
  records.resize(table.size(), kUnknown);
  for (const SymbolRecord& record : table) {
    const std::optional<DeclaredValue> declared = DeclaredValueOf(*record.element);
    if (declared) records[record.sequence - 1] = declared->value;
  }
  for (const SymbolRecord& record : table) {
    if (record.kind != ElementKind::Auxiliary && record.kind != ElementKind::Process &&
        record.kind != ElementKind::ArithmeticExpression) {
      continue;
    }
    const ExpressionNode* tree = ExpressionOf(record).tree;
    if (tree != nullptr) records[record.sequence - 1] = Evaluate(*tree).Of(*tree);
  }
}

NodeValues DefaultValues::Evaluate(const ExpressionNode& tree) const {
  std::vector<const ExpressionNode*> downwards;
  NodeValues values;
  values.root = &tree;
  ForEachNode(tree, [&downwards, &values, &tree](const ExpressionNode& node) {
    downwards.push_back(&node);
    const auto distance = static_cast<std::size_t>(&tree - &node);
    if (distance >= values.values.size()) values.values.resize(distance + 1, kUnknown);
    return true;
  });
  std::reverse(downwards.begin(), downwards.end());
  for (const ExpressionNode* node : downwards) {
    values.values[static_cast<std::size_t>(&tree - node)] = Known(Compute(*node, values));
  }
  return values;
}

double DefaultValues::Compute(const ExpressionNode& node, const NodeValues& values) const {
  switch (node.Kind()) {
    case NodeKind::Number:
      return ValueOfNumber(node).value_or(kUnknown);
    case NodeKind::Identifier: {
      const SymbolRecord* record = symbols.Find(node.Text());
      return record == nullptr ? kUnknown : records[record->sequence - 1];
    }
    case NodeKind::Negate:
      return -values.Of(*node.Child(1));
    case NodeKind::Arithmetic:
      return Arithmetic(node.Text().front(), values.Of(*node.Child(1)), values.Of(*node.Child(2)));
    case NodeKind::Comparison: {
      const double left = values.Of(*node.Child(1));
      const double right = values.Of(*node.Child(2));
      if (std::isnan(left) || std::isnan(right)) return kUnknown;
      return Compare(node.Text(), left, right) ? 1.0 : 0.0;
    }
    case NodeKind::Conditional:
      return IsWholeIf(node) ? Choose(node, values) : kUnknown;
    case NodeKind::Call:
      return Call(node, values);
    default:
      return kUnknown;
  }
}

}  // namespace tessal
