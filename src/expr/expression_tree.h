// A parse tree that owns its texts, and so lives on without the text that it was parsed from.
#pragma once

#include <cstddef>
#include <memory>

#include "expr/expression_node.h"

namespace tessal {

class ExpressionTree final {
 public:
  /// An unknown node.
  ExpressionTree() = default;
  explicit ExpressionTree(const ExpressionNode* source) { DeepCopy(source); }

  const ExpressionNode& Root() const;

  /// Becomes a copy of a node and all below it, or, of nothing, an unknown node with an empty text.
  void DeepCopy(const ExpressionNode* source);
  /// Becomes an unknown node again.
  void Release() noexcept { block.reset(); }

 private:
  std::unique_ptr<std::byte[]> block;  ///< the nodes, then their texts
  const ExpressionNode* root = nullptr;
};

}  // namespace tessal
