#include "expr/expression_builder.h"

#include <algorithm>
#include <new>
#include <type_traits>

namespace tessal {

static_assert(sizeof(ExpressionNode) == 24, "a template holds some hundred thousand of them");
static_assert(std::is_trivially_destructible_v<ExpressionNode>, "a block is released without a look at them");

const ExpressionNode* ExpressionBuilder::CopyTo(void* place) const {
  auto* node = static_cast<ExpressionNode*>(place);
  for (NodeHandle handle = 0; handle < count; ++handle) ::new (node + handle) ExpressionNode(nodes[handle]);
  return node + count - 1;
}

void ExpressionBuilder::Clear() {
  count = 0;
  if (nodes.size() > kMostKept) nodes = {};
}

void ExpressionBuilder::Grow() {
  constexpr std::size_t kFirstRoom = 64;
  nodes.resize(std::max(kFirstRoom, nodes.size() * 2));
}

}  // namespace tessal
