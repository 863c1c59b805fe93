#include "expr/expression_tree.h"

#include <algorithm>
#include <string_view>
#include <utility>
#include <vector>

#include "expr/expression_builder.h"

namespace tessal {

namespace {

/// A tree of one node, which has a text of the program.
struct LoneNode {
  explicit LoneNode(std::string_view text) {
    ExpressionBuilder builder;
    builder.Add(NodeKind::Unknown, text);
    root = builder.CopyTo(place);
  }

  alignas(ExpressionNode) std::byte place[sizeof(ExpressionNode)];
  const ExpressionNode* root;
};

/// A copy whose children wait for the copy of their parent.
struct WaitingCopy {
  NodeHandle handle;
  std::int32_t depth;
};

}  // namespace

const ExpressionNode& ExpressionTree::Root() const {
  static const LoneNode unknown("unknown");
  return block ? *root : *unknown.root;
}

void ExpressionTree::DeepCopy(const ExpressionNode* source) {
  static const LoneNode nothing("");
  if (source == nullptr) source = nothing.root;
  std::size_t nodes = 0;
  std::size_t characters = 0;
  source->WalkPostOrder(
      nullptr,
      [&nodes, &characters](NodeKind, std::string_view text, std::int32_t) {
        ++nodes;
        characters += text.size();
      },
      nullptr);
  auto copy = std::make_unique_for_overwrite<std::byte[]>(nodes * sizeof(ExpressionNode) + characters);
  char* nextText = reinterpret_cast<char*>(copy.get() + nodes * sizeof(ExpressionNode));
  ExpressionBuilder builder;
  std::vector<WaitingCopy> waiting;
  source->WalkPostOrder(
      nullptr,
      [&](NodeKind kind, std::string_view text, std::int32_t depth) {
        const std::string_view ownText(nextText, text.size());
        nextText = std::copy(text.begin(), text.end(), nextText);
        // The walk comes to the last child first, so the first one waits at the end.
        NodeHandle children[2] = {};
        int count = 0;
        for (; !waiting.empty() && waiting.back().depth == depth + 1; waiting.pop_back()) {
          children[count++] = waiting.back().handle;
        }
        const NodeHandle handle = count == 0   ? builder.Add(kind, ownText)
                                  : count == 1 ? builder.Add(kind, ownText, children[0])
                                               : builder.Add(kind, ownText, children[0], children[1]);
        waiting.push_back({handle, depth});
      },
      nullptr);
  root = builder.CopyTo(copy.get());
  block = std::move(copy);
}

}  // namespace tessal
