// Every single slip in the equations of the examples: a term left out, a sign turned round, a process in the
// place of another. Which of them make a pool leak follows from the pool alone, and each of those is found.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <vector>

#include "analysis/mass_balance.h"
#include "core/template_core.h"
#include "expr/token_spans.h"
#include "support/case_file.h"

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
    if (pools.empty()) return;
    for (const auto& process : core.Processes()) TryRate(*process);
  }

  int leaks = 0;
  int found = 0;
  std::string missed;
  int rates = 0;
  int openRates = 0;
  std::string closedRates;

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

  /// Each name in a rate that is made of other processes is another of its kind. What that does to the pools
  /// depends on their boundaries too: a listing says which slips leave all of them closed.
  void TryRate(CEL_Process& process) {
    const std::string rate = process.expression.TextOf();
    const std::vector<const CEL_Element*> used = core.ReferencedElements(process);
    if (std::none_of(used.begin(), used.end(), IsProcess)) return;
    for (const TokenSpan& token : TokenSpans(rate)) {
      const std::string other = OtherOfKind(TextOf(rate, token));
      if (token.code != TokenCode::Identifier || other.empty()) continue;
      process.expression.SetText(Replaced(rate, token.span, other));
      core.RebuildSymbolTable();
      const std::vector<PoolBalance> balances = CheckMassBalance(core, pools);
      const bool isOpen = std::any_of(balances.begin(), balances.end(), [](const PoolBalance& balance) {
        return balance.verdict == PoolVerdict::Open;
      });
      ++rates;
      if (isOpen) ++openRates;
      if (!isOpen) {
        closedRates += "  " + process.symbol.TextOf() + " = " + process.expression.TextOf() + '\n';
      }
    }
    process.expression.SetText(rate);
    core.RebuildSymbolTable();
  }

  static bool IsProcess(const CEL_Element* element) { return element->Kind() == ElementKind::Process; }

  /// The constant or process before one of them; empty for any other name.
  std::string OtherOfKind(std::string_view name) const {
    const auto before = [name](const auto& elements) -> std::string {
      for (std::size_t place = 0; place < elements.size(); ++place) {
        if (elements[place]->symbol.Text() == name) {
          return elements[(place + elements.size() - 1) % elements.size()]->symbol.TextOf();
        }
      }
      return {};
    };
    const std::string constant = before(core.Constants());
    return constant.empty() ? before(core.Processes()) : constant;
  }

  /// The next process that equations use.
  std::string OtherProcess(const std::string& name) const {
    std::string first;
    bool isNext = false;
    for (const auto& process : core.Processes()) {
      if (!core.IsReferenced(process->GetUid())) continue;
      std::string symbol = process->symbol.TextOf();
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
  std::string listing;
  std::vector<std::filesystem::path> files;
  for (const auto& file : std::filesystem::directory_iterator(TESSAL_SOURCE_DIR "/examples")) {
    if (file.path().extension() == ".tessal") files.push_back(file.path());
  }
  std::sort(files.begin(), files.end());
  for (const std::filesystem::path& file : files) {
    TemplateCore core;
    ASSERT_TRUE(core.LoadWrapper(file.string()));
    Mutants mutants(core);
    mutants.TryAll();
    EXPECT_EQ(mutants.found, mutants.leaks) << file << '\n' << mutants.missed;
    if (mutants.leaks == 0) continue;
    listing += file.stem().string() + ": " + std::to_string(mutants.found) + " of " +
               std::to_string(mutants.leaks) + " slips in equations are found, " +
               std::to_string(mutants.openRates) + " of " + std::to_string(mutants.rates) +
               " in rates made of processes; not these:\n" + mutants.closedRates;
  }
  ExpectListing("analysis/cases/balance_mutants.txt", listing);
}

}  // namespace
}  // namespace tessal::test
