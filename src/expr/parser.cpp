#include "expr/parser.h"

#include <memory>
#include <new>
#include <type_traits>
#include <utility>

#include "expr/expression_automaton.h"
#include "expr/expression_builder.h"
#include "expr/parse_state.h"

namespace tessal {

namespace {

static_assert(sizeof(ParsedExpression) % alignof(ExpressionNode) == 0 &&
                  alignof(ExpressionNode) % alignof(LexemeSpan) == 0,
              "the parts of a block follow each other");
static_assert(std::is_trivially_destructible_v<LexemeSpan>, "a block is released without a look at them");

/// The arrays of the process's one parser.
ParseArrays parseArrays;

}  // namespace

std::unique_ptr<ParsedExpression> ParsedExpression::InBlock(const ExpressionBuilder* tree,
                                                            std::span<const LexemeSpan> identifiers) {
  const std::size_t nodeBytes = tree == nullptr ? 0 : tree->Count() * sizeof(ExpressionNode);
  void* const block = ::operator new(sizeof(ParsedExpression) + nodeBytes + identifiers.size_bytes());
  std::unique_ptr<ParsedExpression> parsed(::new (block) ParsedExpression);
  std::byte* const nodes = static_cast<std::byte*>(block) + sizeof(ParsedExpression);
  if (tree != nullptr) parsed->root = tree->CopyTo(nodes);
  std::uninitialized_copy(identifiers.begin(), identifiers.end(),
                          reinterpret_cast<LexemeSpan*>(nodes + nodeBytes));
  parsed->identifierCount = static_cast<std::uint32_t>(identifiers.size());
  return parsed;
}

std::span<const LexemeSpan> ParsedExpression::Identifiers() const {
  const void* const afterNodes =
      root != nullptr ? static_cast<const void*>(root + 1) : static_cast<const void*>(this + 1);
  return {static_cast<const LexemeSpan*>(afterNodes), identifierCount};
}

std::unique_ptr<const ParsedExpression> ParseExpression(std::string_view text) {
  const ScannerStart began = ExpressionScannerStart();
  std::unique_ptr<ParsedExpression> parsed;
  if (text.size() > kLongestExpression) {
    parsed = ParsedExpression::InBlock(nullptr, {});
    parsed->failure = std::make_unique<const ParseFailure>(
        ParseFailure{{"expression-too-long", {std::to_string(kLongestExpression)}}, 0, 1});
    parsed->knowsIdentifiers = true;
  } else {
    ParseState state(text, parseArrays);
    const bool good = RunAutomaton(state);
    parsed = ParsedExpression::InBlock(good ? &parseArrays.tree : nullptr, state.Identifiers());
    if (!good) {
      parsed->failure = std::make_unique<const ParseFailure>(
          ParseFailure{state.Failure(), state.Line(), state.Position(), state.Place()});
    }
    parsed->knowsIdentifiers = state.ScannedAll();
  }
  parsed->began = began;
  parsed->left = ExpressionScannerStart();
  return parsed;
}

const ParsedExpression& ParseOnce(std::unique_ptr<const ParsedExpression>& held, std::string_view text) {
  if (held && held->Began() == ExpressionScannerStart()) {
    SetExpressionScannerStart(held->Left());
  } else {
    held = ParseExpression(text);
  }
  return *held;
}

int ParseExpressionText(const std::string& text, ExpressionTree& tree, std::int32_t& line,
                        std::int32_t& position, std::string& message) {
  const std::unique_ptr<const ParsedExpression> parsed = ParseExpression(text);
  if (const ParseFailure* failure = parsed->Failure()) {
    line = failure->line;
    position = failure->position;
    message = failure->finding.text;
    return 0;
  }
  tree.DeepCopy(parsed->Tree());
  line = -1;
  position = -1;
  message = "no error";
  return 1;
}

}  // namespace tessal
