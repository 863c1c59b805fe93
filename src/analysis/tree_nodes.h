// The nodes of a tree, for walks that need more than a node's kind and text.
#pragma once

#include <vector>

#include "expr/expression_node.h"
#include "expr/expression_shape.h"

namespace tessal {

/// Calls the visitor with each node, a parent before its children and these in their order. The visitor says
/// whether the walk goes on below the node.
template <class Visitor>
void ForEachNode(const ExpressionNode& root, Visitor visit) {
  std::vector<const ExpressionNode*> open{&root};
  while (!open.empty()) {
    const ExpressionNode* node = open.back();
    open.pop_back();
    if (!visit(*node)) continue;
    for (std::int32_t slot = node->ChildCount(); slot > 0; --slot) {
      if (const ExpressionNode* child = node->Child(slot)) open.push_back(child);
    }
  }
}

/// Whether a node is an IF, and not the THEN or ELSE that is the second child of one: nodes of the same kind.
inline bool IsWholeIf(const ExpressionNode& node) {
  const ExpressionNode* parent = node.Parent();
  const bool isPart =
      parent != nullptr && parent->Kind() == NodeKind::Conditional && parent->Child(2) == &node;
  return IsIf(node) && !isPart;
}

}  // namespace tessal
