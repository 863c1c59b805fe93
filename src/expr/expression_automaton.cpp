#include "expr/expression_automaton.h"

#include <array>
#include <cstddef>
#include <cstdint>
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

constexpr int kErrorToken = 1;
constexpr int kUndefinedToken = kTokenCount - 1;

/// The grammar's number of a token that is pulled. What is no token of the grammar is undefined; a character
/// with the high bit set is negative, and ends the text for the parser.
constexpr int TokenNumber(TokenCode code) {
  constexpr int kFirstNumber = 3;
  if (code <= TokenCode::End) return 0;
  if (code < TokenCode::Identifier) return kUndefinedToken;
  return static_cast<int>(code) - static_cast<int>(TokenCode::Identifier) + kFirstNumber;
}

/// The grammar's name of a symbol, without the quotes of those that are no names.
constexpr std::string_view SymbolName(int number) {
  const std::string_view name = grammar::kSymbolNames[number];
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

constexpr Action Reduction(int rule) {
  return static_cast<Action>(kStateCount + rule);
}

static_assert(kStateCount + grammar::kRuleCount <= 256, "an action is a byte");

/// The automaton with its compressed rows spread out, so that each step is one look.
struct Automaton {
  std::array<std::array<Action, kTokenCount>, kStateCount> actions;
  /// The reductions that need no look at the next token; an error where there is none.
  std::array<Action, kStateCount> blindActions;
  /// The state after the reduction to a symbol, from the state below it.
  std::array<std::array<std::uint8_t, grammar::kSymbolCount>, kStateCount> nextStates;
};

/// The entry of a row for a token; an error where the default of the state applies.
constexpr int Entry(int state, int token) {
  const int place = grammar::kTable_pact[state] + token;
  if (place < 0 || place >= static_cast<int>(std::size(grammar::kTable_table))) return grammar::kErrorEntry;
  return grammar::kTable_check[place] == token ? grammar::kTable_table[place] : grammar::kErrorEntry;
}

constexpr bool IsBlind(int state) {
  return grammar::kTable_pact[state] == grammar::kNoRow;
}

constexpr Action ActionOf(int state, int token) {
  const int entry = IsBlind(state) ? grammar::kErrorEntry : Entry(state, token);
  if (entry > 0) return static_cast<Action>(entry);
  if (entry < 0 && entry != grammar::kErrorEntry) return Reduction(-entry);
  const int rule = grammar::kTable_defact[state];
  return rule == 0 ? kError : Reduction(rule);
}

constexpr int NextState(int state, int symbol) {
  const int column = symbol - kTokenCount;
  const int place = grammar::kTable_pgoto[column] + state;
  const bool hasEntry = place >= 0 && place < static_cast<int>(std::size(grammar::kTable_table)) &&
                        grammar::kTable_check[place] == state;
  return hasEntry ? grammar::kTable_table[place] : grammar::kTable_defgoto[column];
}

constexpr bool PassesOn(int rule) {
  for (const int own : grammar::kRulesWithAction) {
    if (own == rule) return false;
  }
  return grammar::kTable_r2[rule] == 1;
}

/// The same after the reductions that follow blindly and change nothing but the symbol.
constexpr int SettledState(int state, int symbol) {
  int next = NextState(state, symbol);
  while (IsBlind(next) && PassesOn(grammar::kTable_defact[next])) {
    next = NextState(state, grammar::kTable_r1[grammar::kTable_defact[next]]);
  }
  return next;
}

constexpr Automaton kAutomaton = [] {
  Automaton automaton{};
  for (int state = 0; state < kStateCount; ++state) {
    for (int token = 0; token < kTokenCount; ++token)
      automaton.actions[state][token] = ActionOf(state, token);
    if (IsBlind(state)) automaton.blindActions[state] = ActionOf(state, 0);
    for (int symbol = kTokenCount; symbol < grammar::kSymbolCount; ++symbol) {
      automaton.nextStates[state][symbol] = static_cast<std::uint8_t>(SettledState(state, symbol));
    }
  }
  return automaton;
}();

/// The stack of the process's one parser.
struct Stack {
  std::array<std::uint16_t, kMostStates> states;
  std::array<grammar::Value, kMostStates> values;
};

Stack stack;

/// The words for a token that a state has no action for: up to four expected tokens are named.
std::string Unexpected(int state, int token) {
  constexpr std::size_t kMostExpected = 4;
  std::vector<int> expected;
  for (int other = 0; other < kTokenCount; ++other) {
    if (other != kErrorToken && Entry(state, other) != grammar::kErrorEntry) expected.push_back(other);
  }
  std::string words = "syntax error, unexpected " + std::string(SymbolName(token));
  if (expected.size() > kMostExpected) return words;
  std::string_view before = ", expecting ";
  for (const int other : expected) {
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
    const int rule = reduction - kStateCount;
    top = top + 1 - static_cast<std::size_t>(grammar::kTable_r2[rule]);
    stack.values[top] = grammar::Reduce(rule, &stack.values[top], state);
    stack.states[top] = kAutomaton.nextStates[stack.states[top - 1]][grammar::kTable_r1[rule]];
  };
  for (;;) {
    while (const Action blind = kAutomaton.blindActions[stack.states[top]]) reduce(blind);
    grammar::Value value{};
    const int token = TokenNumber(state.Pull(value.lexeme));
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
