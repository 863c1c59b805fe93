// What a tree means where its nodes do not say so by themselves: lists that are chains, the parts of a
// conditional, and the conditions that the grammar has put into conditionals. Shared by what sets
// expressions.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "expr/expression_node.h"

namespace tessal {

/// The items of a list that the tree holds as a chain to the left, in their order.
std::vector<const ExpressionNode*> ItemsOf(const ExpressionNode* list, NodeKind link);

std::vector<const ExpressionNode*> ArgumentsOf(const ExpressionNode& call);

/// The six fields of an interaction's list, in their order.
std::vector<const ExpressionNode*> FieldsOf(const ExpressionNode& modlist);

/// The parts of IF, THEN and ELSE.
struct Branches {
  const ExpressionNode& condition;
  const ExpressionNode& then;
  const ExpressionNode& otherwise;
};

bool IsIf(const ExpressionNode& node);
/// Of a node that is an IF.
Branches BranchesOf(const ExpressionNode& conditional);

/// What NOT, AND and OR were before the grammar made conditionals of them.
struct Logic {
  enum class Operator : std::uint8_t { Not, And, Or } which;
  const ExpressionNode& left;
  const ExpressionNode& right;  ///< the left side again with NOT
};

/// Of a comparison; none where it is one as it was written.
std::optional<Logic> LogicOf(const ExpressionNode& comparison);

/// How tightly the parts of an expression hold together. What is looser than its place asks for gets brackets
/// where it is set as mathematics.
enum class Bond : std::uint8_t {
  None,  ///< conditionals, direct modifications
  Or,
  And,
  Comparison,
  Sum,
  Negation,
  Product,
  Power,  ///< whole as an operand, but not as the base of a power
  Atom
};

/// Whether it is a sum or a difference.
bool IsSum(const ExpressionNode& node);
bool IsProduct(const ExpressionNode& node);
/// The value of a number; none where it is beyond the range of 64 bits.
std::optional<double> ValueOfNumber(const ExpressionNode& number);
/// Whether what may be a product begins with a sign, which needs no brackets where nothing is to the left of
/// it.
bool BeginsWithSign(const ExpressionNode& node);

bool IsDirectModification(NodeKind kind);
/// "::=" and its like.
std::string_view DirectSign(NodeKind kind);

}  // namespace tessal
