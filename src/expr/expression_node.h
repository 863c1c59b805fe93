// The parse tree of an expression: one type of node, whose kind says what its text and children mean. The
// nodes of a tree lie in one block, and refer to each other by their distance in it; their texts are views.
// Trees of long chains are as deep as they are long, so nothing here recurses.
#pragma once

#include <cstdint>
#include <string_view>
#include <type_traits>

namespace tessal {

/// The numbers are part of what a tree shows as JSON.
enum class NodeKind : std::uint8_t {
  Unknown = 0,
  Identifier = 2,
  Number = 3,
  Call = 4,
  Arithmetic = 5,
  Comparison = 6,
  Conditional = 7,
  DirectAssign = 8,
  DirectPlus = 9,
  DirectMinus = 10,
  DirectMultiply = 11,
  DirectDivide = 12,
  Property = 13,
  Argument = 14,
  Interaction = 15,
  Target = 16,
  Modlists = 17,
  Modlist = 18,
  Modfield = 19,
  Negate = 21,
  Exceedance = 22
};

/// A node of a tree. It lives in the tree's block, and its text in the text that was parsed.
class ExpressionNode final {
 public:
  ExpressionNode(const ExpressionNode&) = delete;
  ExpressionNode& operator=(const ExpressionNode&) = delete;

  NodeKind Kind() const { return fields.kind; }
  std::string_view Text() const { return {fields.text, fields.textLength}; }
  std::int32_t ChildCount() const { return fields.childCount; }
  /// The child in a slot from 1; none for a slot beyond the count.
  const ExpressionNode* Child(std::int32_t slot) const {
    if (slot < 1 || slot > fields.childCount) return nullptr;
    return this - (slot == 1 ? fields.toFirst : fields.toSecond);
  }
  /// The node above; none at the root.
  const ExpressionNode* Parent() const { return fields.toParent == 0 ? nullptr : this + fields.toParent; }

  /// Calls `before`, walks the children from the last to the first, calls `visit` and `after`. Each is called
  /// with the node's kind, its text and its depth; `before` and `after` may be `nullptr`.
  template <class Before, class Visit, class After>
  void WalkPostOrder(Before&& before, Visit&& visit, After&& after, std::int32_t depth = 0) const;
  /// Calls `before`, walks the first child, calls `visit`, walks the other children in order, calls `after`.
  template <class Before, class Visit, class After>
  void WalkInOrder(Before&& before, Visit&& visit, After&& after, std::int32_t depth = 0) const;

 private:
  friend class ExpressionBuilder;

  /// Children lie before their parent.
  struct Fields {
    const char* text = nullptr;
    std::uint32_t toFirst = 0;   ///< nodes back to the first child
    std::uint32_t toSecond = 0;  ///< nodes back to the second child
    std::uint32_t toParent = 0;  ///< nodes on to the parent; 0 at the root
    std::uint16_t textLength = 0;
    NodeKind kind = NodeKind::Unknown;
    std::uint8_t childCount = 0;
  };

  explicit ExpressionNode(const Fields& nodeFields) : fields(nodeFields) {}

  template <class Callback>
  void Call(Callback& callback, std::int32_t depth) const {
    if constexpr (!std::is_null_pointer_v<std::remove_cvref_t<Callback>>) callback(Kind(), Text(), depth);
  }
  /// The slot of a node that has a parent.
  std::int32_t Slot() const { return fields.toParent == Parent()->fields.toFirst ? 1 : 2; }

  Fields fields;
};

template <class Before, class Visit, class After>
void ExpressionNode::WalkPostOrder(Before&& before, Visit&& visit, After&& after, std::int32_t depth) const {
  const ExpressionNode* node = this;
  node->Call(before, depth);
  for (std::int32_t toWalk = ChildCount();;) {
    if (toWalk > 0) {
      node = node->Child(toWalk);
      node->Call(before, ++depth);
      toWalk = node->ChildCount();
      continue;
    }
    node->Call(visit, depth);
    node->Call(after, depth);
    if (node == this) return;
    toWalk = node->Slot() - 1;
    node = node->Parent();
    --depth;
  }
}

template <class Before, class Visit, class After>
void ExpressionNode::WalkInOrder(Before&& before, Visit&& visit, After&& after, std::int32_t depth) const {
  const ExpressionNode* node = this;
  node->Call(before, depth);
  for (std::int32_t walked = 0;;) {
    if (walked == 1 || node->ChildCount() == 0) node->Call(visit, depth);
    if (walked < node->ChildCount()) {
      node = node->Child(walked + 1);
      node->Call(before, ++depth);
      walked = 0;
      continue;
    }
    node->Call(after, depth);
    if (node == this) return;
    walked = node->Slot();
    node = node->Parent();
    --depth;
  }
}

}  // namespace tessal
