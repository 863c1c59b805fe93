#include "expr/expression_builder.h"

#include <memory>
#include <new>
#include <type_traits>

namespace tessal {

static_assert(sizeof(ExpressionNode) == 24, "a template holds some hundred thousand of them");
static_assert(std::is_trivially_destructible_v<ExpressionNode>, "a block is released without a look at them");

const ExpressionNode* ExpressionBuilder::CopyTo(void* place) const {
  auto* node = static_cast<ExpressionNode*>(place);
  for (const ExpressionNode::Fields& fields : nodes) ::new (node++) ExpressionNode(fields);
  return node - 1;
}

void ExpressionBuilder::Clear() {
  nodes.clear();
  if (nodes.capacity() > kMostKept) nodes.shrink_to_fit();
}

}  // namespace tessal
