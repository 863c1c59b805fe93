// The parse tree of an expression: one type of node, whose kind says what its text and children mean.
// Trees of long chains are as deep as they are long, so nothing here recurses.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace tessal {

/// The numbers are part of what a tree shows as JSON.
enum class NodeKind : std::int32_t {
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

class ExpressionNode final {
 public:
  /// What a walk calls: the node's kind, its text and its depth.
  using Callback = std::function<void(NodeKind kind, const std::string& text, std::int32_t depth)>;

  ExpressionNode() : text("unknown") {}
  ExpressionNode(NodeKind nodeKind, std::string nodeText) : kind(nodeKind), text(std::move(nodeText)) {}
  /// A node with empty slots for children.
  ExpressionNode(NodeKind nodeKind, std::string nodeText, std::int32_t childCount)
      : kind(nodeKind), text(std::move(nodeText)), children(static_cast<std::size_t>(childCount)) {}
  ExpressionNode(const ExpressionNode& other) { DeepCopy(&other); }
  ExpressionNode(ExpressionNode&& other) noexcept { TakeFrom(other); }
  ExpressionNode& operator=(const ExpressionNode& other);
  ExpressionNode& operator=(ExpressionNode&& other) noexcept;
  ~ExpressionNode() {
    if (!children.empty()) Release();
  }

  NodeKind Kind() const { return kind; }
  const std::string& Text() const { return text; }
  std::int32_t ChildCount() const { return static_cast<std::int32_t>(children.size()); }
  /// The child in a slot from 1; none for an empty slot or one beyond the count.
  const ExpressionNode* Child(std::int32_t slot) const;
  /// The node above; none at the root.
  const ExpressionNode* Parent() const { return parent; }

  /// Fills a slot from 1; a slot beyond the count is ignored, and the node released.
  void SetChild(std::int32_t slot, std::unique_ptr<ExpressionNode> node);
  /// Releases all children; the node keeps its kind and text.
  void Release() noexcept;
  /// Becomes a copy of another tree, or, of nothing, an unknown node with an empty text.
  void DeepCopy(const ExpressionNode* source);

  /// Calls `before`, walks the children from the last to the first, calls `visit` and `after`. `before` and
  /// `after` may be empty.
  void WalkPostOrder(const Callback& before, const Callback& visit, const Callback& after,
                     std::int32_t depth = 0) const;
  /// Calls `before`, walks the first child, calls `visit`, walks the other children in order, calls `after`.
  void WalkInOrder(const Callback& before, const Callback& visit, const Callback& after,
                   std::int32_t depth = 0) const;

 private:
  static constexpr NodeKind kHighestKind = NodeKind::Exceedance;

  void TakeFrom(ExpressionNode& other) noexcept;
  void CopyHead(const ExpressionNode& source);

  NodeKind kind = NodeKind::Unknown;
  std::string text;
  std::vector<std::unique_ptr<ExpressionNode>> children;
  ExpressionNode* parent = nullptr;
};

}  // namespace tessal
