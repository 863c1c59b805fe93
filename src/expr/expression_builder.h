// Makes the nodes of a tree from its leaves up, in an array that is used again from tree to tree. The
// finished nodes are copied into the block of whoever holds the tree; the one added last is the root.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

#include "expr/expression_node.h"

namespace tessal {

/// A node of the tree under way, by its place.
using NodeHandle = std::uint32_t;

class ExpressionBuilder final {
 public:
  /// Each adds a node. Its text is a view that must outlive the tree; a child becomes its own, and may have
  /// no other parent.
  NodeHandle Add(NodeKind kind, std::string_view text);
  NodeHandle Add(NodeKind kind, std::string_view text, NodeHandle child);
  NodeHandle Add(NodeKind kind, std::string_view text, NodeHandle first, NodeHandle second);

  std::size_t Count() const { return count; }
  /// Copies the nodes to a place with room for `Count` of them, and gives the root, the last of them.
  const ExpressionNode* CopyTo(void* place) const;
  /// Begins another tree.
  void Clear();

 private:
  /// More are not kept from one tree to the next.
  static constexpr std::size_t kMostKept = 16'384;

  void Grow();

  std::vector<ExpressionNode::Fields> nodes;  ///< those of the tree, then room for more
  NodeHandle count = 0;
};

inline NodeHandle ExpressionBuilder::Add(NodeKind kind, std::string_view text) {
  if (count == nodes.size()) Grow();
  nodes[count] = {.text = text.data(), .textLength = static_cast<std::uint16_t>(text.size()), .kind = kind};
  return count++;
}

inline NodeHandle ExpressionBuilder::Add(NodeKind kind, std::string_view text, NodeHandle child) {
  const NodeHandle handle = Add(kind, text);
  nodes[handle].childCount = 1;
  nodes[handle].toFirst = nodes[child].toParent = handle - child;
  return handle;
}

inline NodeHandle ExpressionBuilder::Add(NodeKind kind, std::string_view text, NodeHandle first,
                                         NodeHandle second) {
  const NodeHandle handle = Add(kind, text, first);
  nodes[handle].childCount = 2;
  nodes[handle].toSecond = nodes[second].toParent = handle - second;
  return handle;
}

}  // namespace tessal
