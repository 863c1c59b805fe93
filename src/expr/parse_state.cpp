#include "expr/parse_state.h"

#include <string>

namespace tessal {

namespace {

/// Identifiers and numbers fit a buffer of this size with their terminator, or fail the parse.
constexpr std::size_t kLexemeBuffer = 1000;

bool HasLexeme(TokenCode code) {
  return code >= TokenCode::Identifier && code <= TokenCode::ScientificNum;
}

constexpr std::array<std::string_view, 6> kModlistFields = {"SV1", "SV2", "cpy12", "cpy21", "red1", "red2"};

}  // namespace

ParseState::ParseState(std::string_view expression, ParseArrays& parseArrays)
    : text(expression), arrays(parseArrays), scan(expression) {
  arrays.tree.Clear();
  arrays.identifiers.clear();
}

int ParseState::Pull(LexemeSpan& lexeme) {
  const TokenCode token = scan.Next();
  const int code = static_cast<int>(token);
  if (HasLexeme(token)) {
    const auto length = static_cast<std::uint32_t>(scan.Lexeme().size());
    if (length >= kLexemeBuffer) {
      tooLong = true;
      Fail("token-too-long");
      return code;
    }
    lexeme = {scan.Consumed() - length, length};
    if (token == TokenCode::Identifier) arrays.identifiers.push_back(lexeme);
    return code;
  }
  if (token == TokenCode::End) {
    scannedAll = true;
  } else if (!IsPlainToken(token)) {
    clean = false;
    // A character with the high bit set is negative, and ends the input for the parser.
    if (token > TokenCode::End && token < TokenCode::Identifier) return UNDEFINED;
  }
  return code;
}

void ParseState::Fail(Message message, std::string_view words) {
  failure = Finding(message, {std::to_string(scan.Lines() + 1), std::to_string(Position()), words});
}

void ParseState::FailAsParser(std::string_view words) {
  if (words == "memory exhausted") {
    Fail("nesting-too-deep");
  } else {
    Fail("syntax-error", words);
  }
}

NodeHandle ParseState::RidValue(LexemeSpan name) {
  return Node(NodeKind::Call, "RID_VAL",
              Node(NodeKind::Argument, "Argument", Leaf(NodeKind::Identifier, name)));
}

NodeHandle ParseState::Conditional(NodeHandle condition, NodeHandle thenValue, NodeHandle elseValue) {
  const NodeHandle elseNode = Node(NodeKind::Conditional, "ELSE", elseValue);
  const NodeHandle thenNode = Node(NodeKind::Conditional, "THEN", thenValue, elseNode);
  return Node(NodeKind::Conditional, "IF", condition, thenNode);
}

NodeHandle ParseState::IsTrue(NodeHandle conditional) {
  return Node(NodeKind::Comparison, ">", conditional, Number("0"));
}

NodeHandle ParseState::Not(NodeHandle condition) {
  return IsTrue(Conditional(condition, Number("0"), Number("1")));
}

NodeHandle ParseState::Or(NodeHandle left, NodeHandle right) {
  return IsTrue(Conditional(left, Number("1"), Conditional(right, Number("1"), Number("0"))));
}

NodeHandle ParseState::And(NodeHandle left, NodeHandle right) {
  return IsTrue(Conditional(left, Conditional(right, Number("1"), Number("0")), Number("0")));
}

NodeHandle ParseState::Modlist(const std::array<NodeHandle, 6>& fields) {
  // A chain from the last field to the first: each holds its value and the next one.
  std::size_t place = kModlistFields.size() - 1;
  NodeHandle chain = Node(NodeKind::Modfield, kModlistFields[place], fields[place]);
  while (place > 0) {
    --place;
    chain = Node(NodeKind::Modfield, kModlistFields[place], fields[place], chain);
  }
  return Node(NodeKind::Modlist, "Modlist", chain);
}

}  // namespace tessal
