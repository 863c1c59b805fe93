#include "expr/parse_state.h"

#include <string>

namespace tessal {

namespace {

constexpr std::array<std::string_view, 6> kModlistFields = {"SV1", "SV2", "cpy12", "cpy21", "red1", "red2"};

}  // namespace

ParseState::ParseState(std::string_view expression, ParseArrays& parseArrays)
    : text(expression), arrays(parseArrays), scan(expression) {
  arrays.tree.Clear();
  arrays.identifiers.clear();
}

void ParseState::Fail(Message message, std::string_view words) {
  failure = Finding(message, {std::to_string(scan.Lines() + 1), std::to_string(Position()), words});
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
