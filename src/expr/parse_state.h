// What one parse works on: the scan, the nodes that wait for their parents, and the failure text.
// The generated parser's values are trivial so that its stack can grow; the nodes lie here, so that a failed
// parse releases them all.
#pragma once

#include <cstdint>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "core/messages.h"
#include "expr/expression_grammar.h"
#include "expr/expression_node.h"
#include "expr/scanner.h"
#include "platform/parser_memory.h"

namespace tessal {

class ParseState final {
 public:
  /// The text must outlive the parse.
  explicit ParseState(std::string_view expression) : text(expression), scan(expression) {}

  ParserMemory& Memory() { return memory; }

  // The token side.
  int Pull(LexemeSpan& lexeme);
  bool TokenIsTooLong() const { return tooLong; }
  /// The failure in the words of the generated parser.
  void FailAsParser(std::string_view words);

  // The tree side. Each takes its children out of the store and puts itself in.
  NodeHandle Leaf(NodeKind kind, LexemeSpan lexeme);
  NodeHandle Node(NodeKind kind, const char* nodeText, std::initializer_list<NodeHandle> children);
  NodeHandle Named(NodeKind kind, LexemeSpan name, std::initializer_list<NodeHandle> children);
  NodeHandle RidValue(LexemeSpan name);
  NodeHandle Conditional(NodeHandle condition, NodeHandle thenValue, NodeHandle elseValue);
  // There is no boolean node: the operators become conditionals that yield 1 or 0, compared against 0.
  NodeHandle Not(NodeHandle condition);
  NodeHandle Or(NodeHandle left, NodeHandle right);
  NodeHandle And(NodeHandle left, NodeHandle right);
  NodeHandle Modlist(std::initializer_list<NodeHandle> fields);
  void SetRoot(NodeHandle handle) { root = std::move(store[handle]); }

  std::unique_ptr<ExpressionNode>& Root() { return root; }
  /// What is wrong, after a parse that failed.
  const Finding& Failure() const { return *failure; }
  std::int32_t Line() const { return static_cast<std::int32_t>(scan.Lines()); }
  std::int32_t Position() const { return static_cast<std::int32_t>(scan.Consumed() - scan.LineStart()); }

 private:
  /// Notes a message of the parser. Its values are line, position, and the words if it has a place for them.
  void Fail(Message message, std::string_view words = {});
  NodeHandle Put(std::unique_ptr<ExpressionNode> node);
  NodeHandle Number(const char* digits);
  NodeHandle IsTrue(NodeHandle conditional);

  std::string_view text;
  ExpressionScan scan;
  ParserMemory memory;
  std::vector<std::unique_ptr<ExpressionNode>> store;
  std::unique_ptr<ExpressionNode> root;
  std::optional<Finding> failure;
  bool tooLong = false;
};

}  // namespace tessal
