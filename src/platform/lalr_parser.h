// The shift-reduce parser of a grammar: the loop over the tables that Bison makes of it by lalr_tables.m4. It
// behaves as LALR(1) tables with default reductions do, in what it accepts, in where it fails, and in its
// words.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <limits>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

namespace lalr {

constexpr std::size_t kMostStates = 10'000;

/// The grammar's numbers. Tokens are the first of the symbols.
using State = std::size_t;
using Symbol = std::size_t;
using Rule = std::size_t;

constexpr Symbol kErrorToken = 1;

/// What a state does with a token, or does whatever comes: an error, a shift to the state of that number, or
/// the reduction of the rule of the rest.
using Action = std::uint8_t;
constexpr Action kError = 0;

template <class Grammar>
constexpr Action Reduction(Rule rule) {
  static_assert(Grammar::kStateCount + Grammar::kRuleCount <= 256, "an action is a byte");
  return static_cast<Action>(Grammar::kStateCount + rule);
}

/// What a reduction needs to know of its rule, in one word.
struct alignas(4) RuleShape {
  Action action;        ///< the reduction; an error for no rule
  std::uint8_t length;  ///< symbols on the right side
  std::uint8_t left;
};

/// The automaton with its compressed rows spread out, so that each step is one look.
template <class Grammar>
struct Automaton {
  std::array<std::array<Action, Grammar::kTokenCount>, Grammar::kStateCount> actions;
  /// The reductions that need no look at the next token; no rule where there is none.
  std::array<RuleShape, Grammar::kStateCount> blindRules;
  /// The state after the reduction to a symbol, from the state below it.
  std::array<std::array<std::uint8_t, Grammar::kSymbolCount>, Grammar::kStateCount> nextStates;
  std::array<RuleShape, Grammar::kRuleCount> rules;
};

/// The place in the compressed rows, of which each row has its own base; none where the row has no entry.
template <class Grammar>
constexpr std::optional<std::size_t> PlaceOf(std::int16_t base, std::size_t column) {
  const std::ptrdiff_t place = base + static_cast<std::ptrdiff_t>(column);
  if (place < 0 || place >= std::ssize(Grammar::kTable_table)) return std::nullopt;
  const auto found = static_cast<std::size_t>(place);
  return Grammar::kTable_check[found] == static_cast<std::ptrdiff_t>(column) ? std::optional(found)
                                                                             : std::nullopt;
}

/// The entry of a state for a token; an error where its default applies.
template <class Grammar>
constexpr int Entry(State state, Symbol token) {
  const auto place = PlaceOf<Grammar>(Grammar::kTable_pact[state], token);
  return place ? Grammar::kTable_table[*place] : Grammar::kErrorEntry;
}

/// Whether a state reduces whatever token comes, without a look at it.
template <class Grammar>
constexpr bool IsBlind(State state) {
  return Grammar::kTable_pact[state] == Grammar::kNoRow;
}

template <class Grammar>
constexpr Rule DefaultRule(State state) {
  return static_cast<Rule>(Grammar::kTable_defact[state]);
}

template <class Grammar>
constexpr State NextState(State state, Symbol symbol) {
  const std::size_t column = symbol - Grammar::kTokenCount;
  const auto place = PlaceOf<Grammar>(Grammar::kTable_pgoto[column], state);
  return static_cast<State>(place ? Grammar::kTable_table[*place] : Grammar::kTable_defgoto[column]);
}

template <class Grammar>
constexpr RuleShape ShapeOf(Rule rule) {
  return {Reduction<Grammar>(rule), static_cast<std::uint8_t>(Grammar::kTable_r2[rule]),
          static_cast<std::uint8_t>(Grammar::kTable_r1[rule])};
}

template <class Grammar>
constexpr bool PassesOn(Rule rule) {
  for (const Rule own : Grammar::kRulesWithAction) {
    if (own == rule) return false;
  }
  return ShapeOf<Grammar>(rule).length == 1;
}

/// Whether a reduction may make the stack higher.
template <class Grammar>
constexpr bool kHasEmptyRules = [] {
  for (Rule rule = 1; rule < Grammar::kRuleCount; ++rule) {
    if (ShapeOf<Grammar>(rule).length == 0) return true;
  }
  return false;
}();

/// The state that comes after one that lies on a state, and after the reductions that follow blindly there
/// and change nothing but the symbol.
template <class Grammar>
constexpr State Settled(State next, State below) {
  while (IsBlind<Grammar>(next) && PassesOn<Grammar>(DefaultRule<Grammar>(next))) {
    next = NextState<Grammar>(below, ShapeOf<Grammar>(DefaultRule<Grammar>(next)).left);
  }
  return next;
}

template <class Grammar>
constexpr Action ActionOf(State state, Symbol token) {
  const int entry = IsBlind<Grammar>(state) ? Grammar::kErrorEntry : Entry<Grammar>(state, token);
  if (entry > 0) return static_cast<Action>(Settled<Grammar>(static_cast<State>(entry), state));
  if (entry != Grammar::kErrorEntry) return Reduction<Grammar>(static_cast<Rule>(-entry));
  const Rule rule = DefaultRule<Grammar>(state);
  return rule == 0 ? kError : Reduction<Grammar>(rule);
}

template <class Grammar>
constexpr Automaton<Grammar> SpreadOut() {
  Automaton<Grammar> automaton{};
  for (State state = 0; state < Grammar::kStateCount; ++state) {
    for (Symbol token = 0; token < Grammar::kTokenCount; ++token) {
      automaton.actions[state][token] = ActionOf<Grammar>(state, token);
    }
    if (IsBlind<Grammar>(state)) automaton.blindRules[state] = ShapeOf<Grammar>(DefaultRule<Grammar>(state));
    for (Symbol symbol = Grammar::kTokenCount; symbol < Grammar::kSymbolCount; ++symbol) {
      automaton.nextStates[state][symbol] =
          static_cast<std::uint8_t>(Settled<Grammar>(NextState<Grammar>(state, symbol), state));
    }
  }
  for (Rule rule = 0; rule < Grammar::kRuleCount; ++rule) automaton.rules[rule] = ShapeOf<Grammar>(rule);
  return automaton;
}

template <class Grammar>
inline constexpr Automaton<Grammar> kAutomaton = SpreadOut<Grammar>();

/// The stack of the process's one parser of a grammar.
template <class Grammar>
struct Stack {
  std::array<std::uint16_t, kMostStates> states;
  std::array<typename Grammar::Value, kMostStates> values;
};

template <class Grammar>
inline Stack<Grammar> stack;

}  // namespace lalr

/// The grammar's name of a symbol, without the quotes of those that are no names.
template <class Grammar>
constexpr std::string_view LalrSymbolName(std::size_t symbol) {
  const std::string_view name = Grammar::kSymbolNames[symbol];
  return name.front() == '"' ? name.substr(1, name.size() - 2) : name;
}

/// The words for a token that a state has no action for: up to four expected tokens are named.
template <class Grammar>
std::string LalrUnexpected(lalr::State state, lalr::Symbol token) {
  constexpr std::size_t kMostExpected = 4;
  std::vector<lalr::Symbol> expected;
  for (lalr::Symbol other = 0; other < Grammar::kTokenCount; ++other) {
    if (other != lalr::kErrorToken && lalr::Entry<Grammar>(state, other) != Grammar::kErrorEntry)
      expected.push_back(other);
  }
  std::string words = "syntax error, unexpected " + std::string(LalrSymbolName<Grammar>(token));
  if (expected.size() > kMostExpected) return words;
  std::string_view before = ", expecting ";
  for (const lalr::Symbol other : expected) {
    words += before;
    words += LalrSymbolName<Grammar>(other);
    before = " or ";
  }
  return words;
}

enum class LalrEnd : std::uint8_t {
  Accepted,
  Refused,  ///< at a token that no rule takes here
  TooDeep,  ///< for the stack
  Stopped   ///< by the parse
};

struct LalrOutcome {
  LalrEnd end;
  std::string words;  ///< of a refusal
};

/// What is pulled to stop a parse.
inline constexpr std::size_t kLalrStop = std::numeric_limits<std::size_t>::max();

/// Parses what `pull(value)` gives: the grammar's number of the next token, 0 at the end, with its value. The
/// actions of the rules are calls of `parse`.
template <class Grammar, class Parse, class Pull>
LalrOutcome RunLalr(Parse& parse, Pull pull) {
  using namespace lalr;
  constexpr const Automaton<Grammar>& kTables = kAutomaton<Grammar>;
  Stack<Grammar>& symbols = stack<Grammar>;
  std::size_t top = 0;
  State present = 0;
  const auto reduce = [&](RuleShape rule) {
    top = top + 1 - rule.length;
    present = kTables.nextStates[symbols.states[top - 1]][rule.left];
    symbols.states[top] = static_cast<std::uint16_t>(present);
    symbols.values[top] = Grammar::Reduce(rule.action - Grammar::kStateCount, &symbols.values[top], parse);
    return !kHasEmptyRules<Grammar> || top + 1 < kMostStates;
  };
  symbols.states[0] = 0;
  for (;;) {
    for (RuleShape rule = kTables.blindRules[present]; rule.action != kError;
         rule = kTables.blindRules[present]) {
      if (!reduce(rule)) return {LalrEnd::TooDeep, {}};
    }
    typename Grammar::Value value{};
    const Symbol token = pull(value);
    if (token == kLalrStop) return {LalrEnd::Stopped, {}};
    Action action = kTables.actions[present][token];
    for (; action >= Grammar::kStateCount; action = kTables.actions[present][token]) {
      if (!reduce(kTables.rules[action - Grammar::kStateCount])) return {LalrEnd::TooDeep, {}};
    }
    if (action == kError) return {LalrEnd::Refused, LalrUnexpected<Grammar>(present, token)};
    ++top;
    present = action;
    symbols.states[top] = action;
    symbols.values[top] = value;
    if (top + 1 == kMostStates) return {LalrEnd::TooDeep, {}};
    if (action == Grammar::kFinalState) return {LalrEnd::Accepted, {}};
  }
}

}  // namespace tessal
