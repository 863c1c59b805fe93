#include "expr/expression_automaton.h"

#include <cstddef>
#include <string_view>

#include "expr/expression_grammar.h"
#include "expr/parse_state.h"
#include "expr/scanner.h"
#include "platform/lalr_parser.h"

namespace tessal {

namespace {

constexpr std::size_t kUndefinedToken = ExpressionGrammar::kTokenCount - 1;

/// The grammar's number of a token that is pulled. What is no token of the grammar is undefined; a character
/// with the high bit set is negative, and ends the text for the parser.
constexpr std::size_t TokenNumber(TokenCode code) {
  constexpr std::size_t kFirstNumber = 3;
  if (code <= TokenCode::End) return 0;
  if (code < TokenCode::Identifier) return kUndefinedToken;
  return static_cast<std::size_t>(code) - static_cast<std::size_t>(TokenCode::Identifier) + kFirstNumber;
}

constexpr std::string_view NameOf(TokenCode code) {
  return LalrSymbolName<ExpressionGrammar>(TokenNumber(code));
}

// The scanner's codes are the grammar's tokens, in the same order.
static_assert(NameOf(TokenCode::Identifier) == "IDENTIFIER" && NameOf(TokenCode::If) == "IF" &&
              NameOf(TokenCode::UMinus) == "U_MINUS" && NameOf(TokenCode::End) == "$end" &&
              LalrSymbolName<ExpressionGrammar>(kUndefinedToken) == "$undefined");

}  // namespace

bool RunAutomaton(ParseState& state) {
  const auto pull = [&state](ExpressionGrammar::Value& value) {
    const std::size_t token = TokenNumber(state.Pull(value.lexeme));
    return state.TokenIsTooLong() ? kLalrStop : token;
  };
  const LalrOutcome outcome = RunLalr<ExpressionGrammar>(state, pull);
  if (outcome.end == LalrEnd::Refused) state.Fail("syntax-error", outcome.words);
  if (outcome.end == LalrEnd::TooDeep) state.Fail("nesting-too-deep");
  return outcome.end == LalrEnd::Accepted;
}

std::string_view TokenName(TokenCode code) {
  return code < TokenCode::Identifier || code > TokenCode::UMinus ? "-" : NameOf(code);
}

}  // namespace tessal
