// Every single slip in the equations of the examples: a term left out, a sign turned round, a process in the
// place of another. Which of them make a pool leak follows from the pool alone, and each of those is found.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <iostream>
#include <string>
#include <vector>

#include "analysis/mass_balance.h"
#include "core/template_core.h"
#include "expr/token_spans.h"

namespace tessal::test {
namespace {

/// A term of an equation that is a sum of processes: its sign and its name in the text.
struct Term {
  LexemeSpan sign;  ///< empty for a first term without one
  LexemeSpan name;
};

std::vector<Term> TermsOf(std::string_view equation) {
  std::vector<Term> terms;
  LexemeSpan sign{0, 0};
  for (const TokenSpan& token : TokenSpans(equation)) {
    if (token.code == TokenCode::Identifier) {
      terms.push_back({sign, token.span});
    } else {
      sign = token.span;
    }
  }
  return terms;
}

std::string Replaced(std::string text, LexemeSpan place, const std::string& by) {
  return text.replace(place.start, place.length, by);
}

class Mutants final {
 public:
  explicit Mutants(TemplateCore& mutated) : core(mutated), pools(PoolsOf(core).pools) {
    for (const PoolBalance& balance : CheckMassBalance(core, pools)) {
      EXPECT_EQ(static_cast<int>(balance.verdict), static_cast<int>(PoolVerdict::Closed))
          << balance.name << balance.reason;
    }
  }

  void TryAll() {
    for (const auto& state : core.StateVariables()) TryEquation(*state);
  }

  int leaks = 0;
  int found = 0;
  std::string missed;

 private:
  void TryEquation(CEL_StateVariable& state) {
    const std::string equation = state.equation.TextOf();
    const auto at = [&equation](LexemeSpan span) { return equation.substr(span.start, span.length); };
    for (const Term& term : TermsOf(equation)) {
      const std::string name = at(term.name);
      Try(state, Replaced(equation, term.name, "0"), {name});
      if (term.sign.length == 0) {
        Try(state, "-" + equation, {name});
      } else {
        Try(state, Replaced(equation, term.sign, at(term.sign) == "-" ? "+" : "-"), {name});
      }
      const std::string other = OtherProcess(name);
      Try(state, Replaced(equation, term.name, other), {name, other});
    }
    state.equation.SetText(equation);
  }

  /// The next process that equations use.
  std::string OtherProcess(const std::string& name) const {
    std::string first;
    bool isNext = false;
    for (const auto& process : core.Processes()) {
      if (!core.IsReferenced(process->GetUid())) continue;
      const std::string symbol = process->symbol.TextOf();
      if (first.empty()) first = symbol;
      if (isNext) return symbol;
      isNext = symbol == name;
    }
    return first;
  }

  void Try(CEL_StateVariable& state, const std::string& equation, const std::vector<std::string>& touched) {
    state.equation.SetText(equation);
    const std::vector<PoolBalance> balances = CheckMassBalance(core, pools);
    for (std::size_t place = 0; place < pools.size(); ++place) {
      if (!HoldsState(pools[place], state) || IsOfBoundary(pools[place], touched)) continue;
      ++leaks;
      if (balances[place].verdict == PoolVerdict::Open) {
        ++found;
      } else {
        missed += pools[place].name + ": " + equation + "  " + balances[place].reason + '\n';
      }
    }
  }

  static bool HoldsState(const Pool& pool, const CEL_StateVariable& state) {
    for (const TokenSpan& token : TokenSpans(pool.expression)) {
      if (TextOf(pool.expression, token) == state.symbol.Text()) return true;
    }
    return false;
  }

  static bool IsOfBoundary(const Pool& pool, const std::vector<std::string>& names) {
    return std::all_of(names.begin(), names.end(), [&pool](const std::string& name) {
      return std::find(pool.boundary.begin(), pool.boundary.end(), name) != pool.boundary.end();
    });
  }

  TemplateCore& core;
  std::vector<Pool> pools;
};

TEST(Balance, FindsEverySlipInTheEquationsOfTheExamples) {
  int leaks = 0;
  for (const auto& file : std::filesystem::directory_iterator(TESSAL_SOURCE_DIR "/examples")) {
    if (file.path().extension() != ".tessal") continue;
    TemplateCore core;
    ASSERT_TRUE(core.LoadWrapper(file.path().string()));
    Mutants mutants(core);
    mutants.TryAll();
    EXPECT_EQ(mutants.found, mutants.leaks) << file.path() << '\n' << mutants.missed;
    leaks += mutants.leaks;
    if (mutants.leaks > 0) {
      std::cout << file.path().stem() << ": " << mutants.found << " of " << mutants.leaks << " found\n";
    }
  }
  // The examples have pools that can leak.
  EXPECT_GT(leaks, 100);
}

}  // namespace
}  // namespace tessal::test
