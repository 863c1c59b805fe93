#include "expr/expression_node.h"

#include <gtest/gtest.h>

#include "expr/expression_text.h"
#include "expr/parser.h"

namespace tessal {
namespace {

ExpressionNode Parsed(const std::string& text) {
  ExpressionNode tree;
  std::int32_t line = 0;
  std::int32_t position = 0;
  std::string message;
  EXPECT_EQ(ParseExpressionText(text, tree, line, position, message), 1) << message;
  return tree;
}

/// The calls of a walk: < before, = visit, > after, each with text and depth.
using Walk = void (ExpressionNode::*)(const ExpressionNode::Callback&, const ExpressionNode::Callback&,
                                      const ExpressionNode::Callback&, std::int32_t) const;

std::string Walked(const ExpressionNode& tree, Walk walk) {
  std::string calls;
  const auto note = [&calls](char sign) {
    return [&calls, sign](NodeKind, const std::string& text, std::int32_t depth) {
      calls += sign + text + std::to_string(depth) + ' ';
    };
  };
  (tree.*walk)(note('<'), note('='), note('>'), 0);
  return calls;
}

TEST(Tree, WalksInTheOrderOfItsClients) {
  const ExpressionNode tree = Parsed("a+b*c");
  EXPECT_EQ(Walked(tree, &ExpressionNode::WalkInOrder),
            "<+0 <a1 =a1 >a1 =+0 <*1 <b2 =b2 >b2 =*1 <c2 =c2 >c2 >*1 >+0 ");
  EXPECT_EQ(Walked(tree, &ExpressionNode::WalkPostOrder),
            "<+0 <*1 <c2 =c2 >c2 <b2 =b2 >b2 =*1 >*1 <a1 =a1 >a1 =+0 >+0 ");
}

TEST(Tree, CopiesAndMovesKeepParents) {
  ExpressionNode tree = Parsed("f(a, b)");
  ExpressionNode copy;
  copy = tree;
  const std::string text = test::TreeText(tree);
  const ExpressionNode moved = std::move(tree);
  EXPECT_EQ(test::TreeText(copy), text);
  EXPECT_EQ(test::TreeText(moved), text);
  EXPECT_EQ(moved.Child(1)->Parent(), &moved);
  EXPECT_EQ(copy.Child(1)->Parent(), &copy);
  EXPECT_EQ(copy.Child(1)->Child(2)->Parent(), copy.Child(1));
  EXPECT_EQ(copy.Parent(), nullptr);
}

TEST(Tree, TakesChildrenInItsSlotsOnly) {
  ExpressionNode node(NodeKind::Arithmetic, "+", 2);
  node.SetChild(0, std::make_unique<ExpressionNode>(NodeKind::Number, "0"));
  node.SetChild(3, std::make_unique<ExpressionNode>(NodeKind::Number, "3"));
  node.SetChild(2, std::make_unique<ExpressionNode>(NodeKind::Number, "2"));
  EXPECT_EQ(node.Child(1), nullptr);
  EXPECT_EQ(node.Child(2)->Text(), "2");
  node.Release();
  EXPECT_EQ(node.ChildCount(), 0);
}

TEST(Tree, CopiesNothingAndUnknownKindsAsUnknown) {
  ExpressionNode node(NodeKind::Number, "1");
  node.DeepCopy(nullptr);
  EXPECT_EQ(node.Kind(), NodeKind::Unknown);
  EXPECT_EQ(node.Text(), "");
  const ExpressionNode strange(NodeKind{23}, "strange");
  EXPECT_EQ(ExpressionNode(strange).Kind(), NodeKind::Unknown);
  EXPECT_EQ(ExpressionNode().Text(), "unknown");
}

}  // namespace
}  // namespace tessal
