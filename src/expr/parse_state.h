// What one parse works on: the scan, the tree under way, and the failure.
// The generated parser's values are trivial so that its stack can grow; nodes and names collect in arrays
// that are used again from parse to parse.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

#include "core/messages.h"
#include "expr/expression_builder.h"
#include "expr/expression_node.h"
#include "expr/scanner.h"

namespace tessal {

/// The arrays of the parser, of which the process has one set.
struct ParseArrays {
  ExpressionBuilder tree;
  std::vector<LexemeSpan> identifiers;  ///< in the order of the text
};

class ParseState final {
 public:
  /// Clears the arrays. The text must outlive the parse and the tree.
  ParseState(std::string_view expression, ParseArrays& parseArrays);

  // The token side.
  /// The next token, and the place of those that have a text.
  TokenCode Pull(LexemeSpan& lexeme);
  /// Whether the token pulled is too long, and the parse has failed.
  bool TokenIsTooLong() const { return tooLong; }
  /// Notes a message of the parser. Its values are line, position, and the words if it has a place for them.
  void Fail(Message message, std::string_view words = {});

  // The tree side.
  NodeHandle Leaf(NodeKind kind, LexemeSpan lexeme) { return arrays.tree.Add(kind, TextOf(lexeme)); }
  /// A node named by a piece of the text.
  template <class... Children>
  NodeHandle Named(NodeKind kind, LexemeSpan name, Children... children) {
    return arrays.tree.Add(kind, TextOf(name), children...);
  }
  /// A node with a text of the language, which must live for ever.
  template <class... Children>
  NodeHandle Node(NodeKind kind, std::string_view nodeText, Children... children) {
    return arrays.tree.Add(kind, nodeText, children...);
  }
  NodeHandle RidValue(LexemeSpan name);
  NodeHandle Conditional(NodeHandle condition, NodeHandle thenValue, NodeHandle elseValue);
  // There is no boolean node: the operators become conditionals that yield 1 or 0, compared against 0.
  NodeHandle Not(NodeHandle condition);
  NodeHandle Or(NodeHandle left, NodeHandle right);
  NodeHandle And(NodeHandle left, NodeHandle right);
  NodeHandle Modlist(const std::array<NodeHandle, 6>& fields);

  /// What is wrong, after a parse that failed.
  const Finding& Failure() const { return *failure; }
  std::int32_t Line() const { return static_cast<std::int32_t>(scan.Lines()); }
  std::int32_t Position() const { return static_cast<std::int32_t>(scan.Consumed() - scan.LineStart()); }
  /// The token pulled last.
  LexemeSpan Place() const { return scan.Span(); }
  /// Whether the parse came to the end of the text.
  bool ScannedAll() const { return scannedAll; }
  /// The identifiers of a text that was scanned to its end and holds plain tokens alone; of others none.
  std::span<const LexemeSpan> Identifiers() const {
    return scannedAll && clean ? std::span<const LexemeSpan>(arrays.identifiers)
                               : std::span<const LexemeSpan>();
  }

 private:
  /// Identifiers and numbers fit a buffer of this size with their terminator, or fail the parse.
  static constexpr std::uint32_t kLexemeBuffer = 1000;

  std::string_view TextOf(LexemeSpan lexeme) const { return {text.data() + lexeme.start, lexeme.length}; }
  NodeHandle Number(std::string_view digit) { return Node(NodeKind::Number, digit); }
  NodeHandle IsTrue(NodeHandle conditional);

  std::string_view text;
  ParseArrays& arrays;
  ExpressionScan scan;
  std::optional<Finding> failure;
  bool tooLong = false;
  bool scannedAll = false;
  bool clean = true;
};

inline TokenCode ParseState::Pull(LexemeSpan& lexeme) {
  const TokenCode token = scan.Next();
  if (token >= TokenCode::Identifier && token <= TokenCode::ScientificNum) {
    lexeme = scan.Span();
    if (lexeme.length >= kLexemeBuffer) {
      tooLong = true;
      Fail("token-too-long");
    } else if (token == TokenCode::Identifier) {
      arrays.identifiers.push_back(lexeme);
    }
  } else if (token == TokenCode::End) {
    scannedAll = true;
  } else if (!IsPlainToken(token)) {
    clean = false;
  }
  return token;
}

}  // namespace tessal
