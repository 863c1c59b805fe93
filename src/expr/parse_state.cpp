#include "expr/parse_state.h"

#include <array>
#include <utility>

namespace tessal {

namespace {

/// Identifiers and numbers fit a buffer of this size with their terminator, or fail the parse.
constexpr std::size_t kLexemeBuffer = 1000;

std::string TextOf(LexemeSpan lexeme) {
  return {lexeme.start, lexeme.length};
}

bool HasLexeme(TokenCode code) {
  return code >= TokenCode::Identifier && code <= TokenCode::ScientificNum;
}

constexpr std::array<const char*, 6> kModlistFields = {"SV1", "SV2", "cpy12", "cpy21", "red1", "red2"};

}  // namespace

int ParseState::Pull(LexemeSpan& lexeme) {
  const TokenCode token = scan.Next();
  const int code = static_cast<int>(token);
  // A character with the high bit set is negative, and ends the input for the parser.
  if (token > TokenCode::End && token < TokenCode::Identifier) return UNDEFINED;
  if (!HasLexeme(token)) return code;
  const std::size_t length = scan.Lexeme().size();
  if (length >= kLexemeBuffer) {
    tooLong = true;
    Fail("token-too-long");
    return code;
  }
  lexeme = {text.data() + (scan.Consumed() - length), static_cast<std::uint32_t>(length)};
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

NodeHandle ParseState::Put(std::unique_ptr<ExpressionNode> node) {
  store.push_back(std::move(node));
  return static_cast<NodeHandle>(store.size() - 1);
}

NodeHandle ParseState::Leaf(NodeKind kind, LexemeSpan lexeme) {
  return Put(std::make_unique<ExpressionNode>(kind, TextOf(lexeme)));
}

NodeHandle ParseState::Number(const char* digits) {
  return Put(std::make_unique<ExpressionNode>(NodeKind::Number, digits));
}

NodeHandle ParseState::Node(NodeKind kind, const char* nodeText, std::initializer_list<NodeHandle> children) {
  auto node = std::make_unique<ExpressionNode>(kind, nodeText, static_cast<std::int32_t>(children.size()));
  std::int32_t slot = 0;
  for (const NodeHandle child : children) node->SetChild(++slot, std::move(store[child]));
  return Put(std::move(node));
}

NodeHandle ParseState::Named(NodeKind kind, LexemeSpan name, std::initializer_list<NodeHandle> children) {
  return Node(kind, TextOf(name).c_str(), children);
}

NodeHandle ParseState::RidValue(LexemeSpan name) {
  return Node(NodeKind::Call, "RID_VAL",
              {Node(NodeKind::Argument, "Argument", {Leaf(NodeKind::Identifier, name)})});
}

NodeHandle ParseState::Conditional(NodeHandle condition, NodeHandle thenValue, NodeHandle elseValue) {
  const NodeHandle elseNode = Node(NodeKind::Conditional, "ELSE", {elseValue});
  const NodeHandle thenNode = Node(NodeKind::Conditional, "THEN", {thenValue, elseNode});
  return Node(NodeKind::Conditional, "IF", {condition, thenNode});
}

NodeHandle ParseState::IsTrue(NodeHandle conditional) {
  return Node(NodeKind::Comparison, ">", {conditional, Number("0")});
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

NodeHandle ParseState::Modlist(std::initializer_list<NodeHandle> fields) {
  // A chain from the last field to the first: each holds its value and the next one.
  std::size_t place = kModlistFields.size() - 1;
  const NodeHandle* value = fields.begin() + place;
  NodeHandle chain = Node(NodeKind::Modfield, kModlistFields[place], {*value});
  while (place > 0) {
    --place;
    --value;
    chain = Node(NodeKind::Modfield, kModlistFields[place], {*value, chain});
  }
  return Node(NodeKind::Modlist, "Modlist", {chain});
}

}  // namespace tessal
