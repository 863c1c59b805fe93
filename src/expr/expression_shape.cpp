#include "expr/expression_shape.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <system_error>

namespace tessal {

namespace {

/// The signs of the direct modifications, in the order of their kinds.
constexpr std::array<std::string_view, 5> kDirectSigns = {"::=", "::+", "::-", "::*", "::/"};

bool IsNumber(const ExpressionNode& node, std::string_view text) {
  return node.Kind() == NodeKind::Number && node.Text() == text;
}

/// A conditional that is 1 where a condition holds and 0 where it does not.
bool IsIndicator(const ExpressionNode& node) {
  if (!IsIf(node)) return false;
  const Branches branches = BranchesOf(node);
  return IsNumber(branches.then, "1") && IsNumber(branches.otherwise, "0");
}

}  // namespace

std::vector<const ExpressionNode*> ItemsOf(const ExpressionNode* list, NodeKind link) {
  std::vector<const ExpressionNode*> items;
  while (list != nullptr && list->Kind() == link && list->ChildCount() == 2) {
    items.push_back(list->Child(2));
    list = list->Child(1);
  }
  if (list != nullptr) items.push_back(list->Kind() == link ? list->Child(1) : list);
  items.erase(std::remove(items.begin(), items.end(), nullptr), items.end());
  std::reverse(items.begin(), items.end());
  return items;
}

std::vector<const ExpressionNode*> ArgumentsOf(const ExpressionNode& call) {
  return ItemsOf(call.Child(1), NodeKind::Argument);
}

std::vector<const ExpressionNode*> FieldsOf(const ExpressionNode& modlist) {
  std::vector<const ExpressionNode*> values;
  for (const ExpressionNode* field = modlist.Child(1); field != nullptr; field = field->Child(2)) {
    values.push_back(field->Child(1));
  }
  return values;
}

bool IsIf(const ExpressionNode& node) {
  return node.Kind() == NodeKind::Conditional && node.ChildCount() == 2;
}

Branches BranchesOf(const ExpressionNode& conditional) {
  const ExpressionNode& then = *conditional.Child(2);
  return {*conditional.Child(1), *then.Child(1), *then.Child(2)->Child(1)};
}

std::optional<Logic> LogicOf(const ExpressionNode& comparison) {
  if (comparison.Text() != ">" || !IsIf(*comparison.Child(1)) || !IsNumber(*comparison.Child(2), "0")) {
    return std::nullopt;
  }
  const auto [condition, then, otherwise] = BranchesOf(*comparison.Child(1));
  if (IsNumber(then, "0") && IsNumber(otherwise, "1")) {
    return Logic{Logic::Operator::Not, condition, condition};
  }
  if (IsNumber(then, "1") && IsIndicator(otherwise)) {
    return Logic{Logic::Operator::Or, condition, BranchesOf(otherwise).condition};
  }
  if (IsIndicator(then) && IsNumber(otherwise, "0")) {
    return Logic{Logic::Operator::And, condition, BranchesOf(then).condition};
  }
  return std::nullopt;
}

bool IsSum(const ExpressionNode& node) {
  return node.Kind() == NodeKind::Arithmetic && (node.Text() == "+" || node.Text() == "-");
}

std::optional<double> ValueOfNumber(const ExpressionNode& number) {
  const std::string_view text = number.Text();
  double value = 0;
  const auto read = std::from_chars(text.data(), text.data() + text.size(), value);
  return read.ec == std::errc() ? std::optional(value) : std::nullopt;
}

bool IsProduct(const ExpressionNode& node) {
  return node.Kind() == NodeKind::Arithmetic && node.Text() == "*";
}

bool BeginsWithSign(const ExpressionNode& node) {
  const ExpressionNode* first = &node;
  while (IsProduct(*first)) first = first->Child(1);
  return first->Kind() == NodeKind::Negate;
}

bool IsDirectModification(NodeKind kind) {
  return kind >= NodeKind::DirectAssign && kind <= NodeKind::DirectDivide;
}

std::string_view DirectSign(NodeKind kind) {
  return kDirectSigns.at(static_cast<std::size_t>(kind) - static_cast<std::size_t>(NodeKind::DirectAssign));
}

}  // namespace tessal
