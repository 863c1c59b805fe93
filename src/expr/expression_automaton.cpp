#include "expr/expression_automaton.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "expr/expression_grammar.h"
#include "expr/parse_state.h"
#include "expr/scanner.h"

namespace tessal {

namespace {

using grammar::kStateCount;
using grammar::kTokenCount;

constexpr std::size_t kMostStates = 10'000;

/// The grammar's numbers. Tokens are the first of the symbols.
using State = std::size_t;
using Symbol = std::size_t;
using Rule = std::size_t;

constexpr Symbol kErrorToken = 1;
constexpr Symbol kUndefinedToken = kTokenCount - 1;

/// The number of a token that is pulled. What is no token of the grammar is undefined; a character with the
/// high bit set is negative, and ends the text for the parser.
constexpr Symbol TokenNumber(TokenCode code) {
  constexpr std::size_t kFirstNumber = 3;
  if (code <= TokenCode::End) return 0;
  if (code < TokenCode::Identifier) return kUndefinedToken;
  return static_cast<std::size_t>(code) - static_cast<std::size_t>(TokenCode::Identifier) + kFirstNumber;
}

/// The grammar's name of a symbol, without the quotes of those that are no names.
constexpr std::string_view SymbolName(Symbol symbol) {
  const std::string_view name = grammar::kSymbolNames[symbol];
  return name.front() == '"' ? name.substr(1, name.size() - 2) : name;
}

// The scanner's codes are the grammar's tokens, in the same order.
static_assert(SymbolName(TokenNumber(TokenCode::Identifier)) == "IDENTIFIER" &&
              SymbolName(TokenNumber(TokenCode::If)) == "IF" &&
              SymbolName(TokenNumber(TokenCode::UMinus)) == "U_MINUS" &&
              SymbolName(kUndefinedToken) == "$undefined" && SymbolName(0) == "$end");

/// What a state does with a token, or does whatever comes: an error, a shift to the state of that number, or
/// the reduction of the rule of the rest.
using Action = std::uint8_t;
constexpr Action kError = 0;

constexpr Action Reduction(Rule rule) {
  return static_cast<Action>(kStateCount + rule);
}

static_assert(kStateCount + grammar::kRuleCount <= 256, "an action is a byte");

struct RuleShape {
  std::uint8_t length;  ///< symbols on the right side
  std::uint8_t left;
};

/// The automaton with its compressed rows spread out, so that each step is one look.
struct Automaton {
  std::array<std::array<Action, kTokenCount>, kStateCount> actions;
  /// The reductions that need no look at the next token; an error where there is none.
  std::array<Action, kStateCount> blindActions;
  /// The state after the reduction to a symbol, from the state below it.
  std::array<std::array<std::uint8_t, grammar::kSymbolCount>, kStateCount> nextStates;
  std::array<RuleShape, grammar::kRuleCount> rules;
};

/// The place in the compressed rows, of which each row has its own base; none where the row has no entry.
constexpr std::optional<std::size_t> PlaceOf(std::int16_t base, std::size_t column) {
  const std::ptrdiff_t place = base + static_cast<std::ptrdiff_t>(column);
  if (place < 0 || place >= std::ssize(grammar::kTable_table)) return std::nullopt;
  const auto found = static_cast<std::size_t>(place);
  return grammar::kTable_check[found] == static_cast<std::ptrdiff_t>(column) ? std::optional(found)
                                                                             : std::nullopt;
}

/// The entry of a state for a token; an error where its default applies.
constexpr int Entry(State state, Symbol token) {
  const auto place = PlaceOf(grammar::kTable_pact[state], token);
  return place ? grammar::kTable_table[*place] : grammar::kErrorEntry;
}

/// Whether a state reduces whatever token comes, without a look at it.
constexpr bool IsBlind(State state) {
  return grammar::kTable_pact[state] == grammar::kNoRow;
}

constexpr Rule DefaultRule(State state) {
  return static_cast<Rule>(grammar::kTable_defact[state]);
}

constexpr Action ActionOf(State state, Symbol token) {
  const int entry = IsBlind(state) ? grammar::kErrorEntry : Entry(state, token);
  if (entry > 0) return static_cast<Action>(entry);
  if (entry != grammar::kErrorEntry) return Reduction(static_cast<Rule>(-entry));
  return DefaultRule(state) == 0 ? kError : Reduction(DefaultRule(state));
}

constexpr State NextState(State state, Symbol symbol) {
  const std::size_t column = symbol - kTokenCount;
  const auto place = PlaceOf(grammar::kTable_pgoto[column], state);
  return static_cast<State>(place ? grammar::kTable_table[*place] : grammar::kTable_defgoto[column]);
}

constexpr RuleShape ShapeOf(Rule rule) {
  return {static_cast<std::uint8_t>(grammar::kTable_r2[rule]),
          static_cast<std::uint8_t>(grammar::kTable_r1[rule])};
}

constexpr bool PassesOn(Rule rule) {
  for (const Rule own : grammar::kRulesWithAction) {
    if (own == rule) return false;
  }
  return ShapeOf(rule).length == 1;
}

/// The same after the reductions that follow blindly and change nothing but the symbol.
constexpr State SettledState(State state, Symbol symbol) {
  State next = NextState(state, symbol);
  while (IsBlind(next) && PassesOn(DefaultRule(next))) {
    next = NextState(state, ShapeOf(DefaultRule(next)).left);
  }
  return next;
}

constexpr Automaton kAutomaton = [] {
  Automaton automaton{};
  for (State state = 0; state < kStateCount; ++state) {
    for (Symbol token = 0; token < kTokenCount; ++token) {
      automaton.actions[state][token] = ActionOf(state, token);
    }
    if (IsBlind(state)) automaton.blindActions[state] = ActionOf(state, 0);
    for (Symbol symbol = kTokenCount; symbol < grammar::kSymbolCount; ++symbol) {
      automaton.nextStates[state][symbol] = static_cast<std::uint8_t>(SettledState(state, symbol));
    }
  }
  for (Rule rule = 0; rule < grammar::kRuleCount; ++rule) automaton.rules[rule] = ShapeOf(rule);
  return automaton;
}();

/// The stack of the process's one parser.
struct Stack {
  std::array<std::uint16_t, kMostStates> states;
  std::array<grammar::Value, kMostStates> values;
};

Stack stack;

/// The words for a token that a state has no action for: up to four expected tokens are named.
std::string Unexpected(State state, Symbol token) {
  constexpr std::size_t kMostExpected = 4;
  std::vector<Symbol> expected;
  for (Symbol other = 0; other < kTokenCount; ++other) {
    if (other != kErrorToken && Entry(state, other) != grammar::kErrorEntry) expected.push_back(other);
  }
  std::string words = "syntax error, unexpected " + std::string(SymbolName(token));
  if (expected.size() > kMostExpected) return words;
  std::string_view before = ", expecting ";
  for (const Symbol other : expected) {
    words += before;
    words += SymbolName(other);
    before = " or ";
  }
  return words;
}

}  // namespace

bool RunAutomaton(ParseState& state) {
  std::size_t top = 0;
  stack.states[0] = 0;
  const auto reduce = [&top, &state](Action reduction) {
    const Rule rule = reduction - kStateCount;
    const RuleShape shape = kAutomaton.rules[rule];
    top = top + 1 - shape.length;
    stack.states[top] = kAutomaton.nextStates[stack.states[top - 1]][shape.left];
    stack.values[top] = grammar::Reduce(rule, &stack.values[top], state);
  };
  for (;;) {
    while (const Action blind = kAutomaton.blindActions[stack.states[top]]) reduce(blind);
    grammar::Value value{};
    const Symbol token = TokenNumber(state.Pull(value.lexeme));
    if (state.TokenIsTooLong()) return false;
    Action action = kAutomaton.actions[stack.states[top]][token];
    for (; action >= kStateCount; action = kAutomaton.actions[stack.states[top]][token]) reduce(action);
    if (action == kError) {
      state.Fail("syntax-error", Unexpected(stack.states[top], token));
      return false;
    }
    ++top;
    stack.states[top] = action;
    stack.values[top] = value;
    if (top + 1 == kMostStates) {
      state.Fail("nesting-too-deep");
      return false;
    }
    if (action == grammar::kFinalState) return true;
  }
}

std::string_view TokenName(TokenCode code) {
  return code < TokenCode::Identifier || code > TokenCode::UMinus ? "-" : SymbolName(TokenNumber(code));
}

}  // namespace tessal
