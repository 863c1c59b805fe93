#include "expr/expression_node.h"

#include <utility>

namespace tessal {

namespace {

/// A node under way in a walk, and how many of its children have been walked.
struct WalkStep {
  const ExpressionNode* node;
  std::int32_t walked;
};

void Call(const ExpressionNode::Callback& callback, const ExpressionNode& node, std::int32_t depth) {
  if (callback) callback(node.Kind(), node.Text(), depth);
}

}  // namespace

ExpressionNode& ExpressionNode::operator=(const ExpressionNode& other) {
  if (this != &other) DeepCopy(&other);
  return *this;
}

ExpressionNode& ExpressionNode::operator=(ExpressionNode&& other) noexcept {
  if (this == &other) return *this;
  Release();
  TakeFrom(other);
  return *this;
}

void ExpressionNode::TakeFrom(ExpressionNode& other) noexcept {
  kind = std::exchange(other.kind, NodeKind::Unknown);
  text = std::move(other.text);
  children = std::move(other.children);
  other.text.clear();
  other.children.clear();
  for (const auto& child : children) {
    if (child) child->parent = this;
  }
}

const ExpressionNode* ExpressionNode::Child(std::int32_t slot) const {
  const auto place = static_cast<std::size_t>(slot) - 1;
  return slot >= 1 && place < children.size() ? children[place].get() : nullptr;
}

void ExpressionNode::SetChild(std::int32_t slot, std::unique_ptr<ExpressionNode> node) {
  const auto place = static_cast<std::size_t>(slot) - 1;
  if (slot < 1 || place >= children.size()) return;
  if (node) node->parent = this;
  children[place] = std::move(node);
}

void ExpressionNode::Release() noexcept {
  // From leaf to leaf, the last first: a list of what is still to be released would need memory, and there
  // may be none.
  ExpressionNode* node = this;
  while (node != this || !children.empty()) {
    if (node->children.empty()) {
      node = node->parent;
      node->children.pop_back();
    } else if (ExpressionNode* const last = node->children.back().get()) {
      node = last;
    } else {
      node->children.pop_back();
    }
  }
}

void ExpressionNode::CopyHead(const ExpressionNode& source) {
  kind = source.kind <= kHighestKind ? source.kind : NodeKind::Unknown;
  text = source.kind <= kHighestKind ? source.text : std::string();
  children.resize(source.kind <= kHighestKind ? source.children.size() : 0);
}

void ExpressionNode::DeepCopy(const ExpressionNode* source) {
  Release();
  kind = NodeKind::Unknown;
  text.clear();
  if (source == nullptr) return;
  std::vector<std::pair<const ExpressionNode*, ExpressionNode*>> pending;
  CopyHead(*source);
  pending.emplace_back(source, this);
  while (!pending.empty()) {
    const auto [from, to] = pending.back();
    pending.pop_back();
    for (std::size_t place = 0; place < to->children.size(); ++place) {
      const ExpressionNode* child = from->children[place].get();
      if (child == nullptr) continue;
      auto copy = std::make_unique<ExpressionNode>();
      copy->CopyHead(*child);
      copy->parent = to;
      pending.emplace_back(child, copy.get());
      to->children[place] = std::move(copy);
    }
  }
}

void ExpressionNode::WalkPostOrder(const Callback& before, const Callback& visit, const Callback& after,
                                   std::int32_t depth) const {
  std::vector<WalkStep> path{{this, 0}};
  Call(before, *this, depth);
  while (!path.empty()) {
    const std::int32_t here = depth + static_cast<std::int32_t>(path.size()) - 1;
    WalkStep& step = path.back();
    const ExpressionNode& node = *step.node;
    if (step.walked < node.ChildCount()) {
      const ExpressionNode* child = node.Child(node.ChildCount() - step.walked++);
      if (child == nullptr) continue;
      path.push_back({child, 0});
      Call(before, *child, here + 1);
      continue;
    }
    Call(visit, node, here);
    Call(after, node, here);
    path.pop_back();
  }
}

void ExpressionNode::WalkInOrder(const Callback& before, const Callback& visit, const Callback& after,
                                 std::int32_t depth) const {
  std::vector<WalkStep> path{{this, 0}};
  Call(before, *this, depth);
  while (!path.empty()) {
    const std::int32_t here = depth + static_cast<std::int32_t>(path.size()) - 1;
    WalkStep& step = path.back();
    const ExpressionNode& node = *step.node;
    const bool afterFirst = step.walked == 1 || (step.walked == 0 && node.ChildCount() == 0);
    if (afterFirst) Call(visit, node, here);
    if (step.walked < node.ChildCount()) {
      const ExpressionNode* child = node.Child(++step.walked);
      if (child == nullptr) continue;
      path.push_back({child, 0});
      Call(before, *child, here + 1);
      continue;
    }
    Call(after, node, here);
    path.pop_back();
  }
}

}  // namespace tessal
