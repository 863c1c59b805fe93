// pH and the carbonate species: solutions per second, and what the kept results of the last water save.
#include <benchmark/benchmark.h>

#include <array>
#include <cstddef>
#include <string_view>
#include <vector>

#include "expr/carbonate/options.h"
#include "expr/carbonate/ph_solvers.h"
#include "expr/carbonate/speciation.h"
#include "expr/function_catalogue.h"

namespace {

using namespace tessal;

struct Water {
  double dic;
  double alkalinity;
  double salinity;
  double temperature;
};

/// Ordinary waters, from a river's mouth to the open sea; no two in a row are alike.
std::vector<Water> Waters() {
  std::vector<Water> waters;
  for (const double salinity : {2.0, 10.0, 25.0, 35.0}) {
    for (const double temperature : {2.0, 12.0, 25.0}) {
      for (const double ratio : {0.98, 1.05, 1.15}) {
        waters.push_back({1000 + 30 * salinity, ratio * (1000 + 30 * salinity), salinity, temperature});
      }
    }
  }
  return waters;
}

/// The functions that give one species each, as expressions call them.
std::vector<Evaluator> SpecieFunctions() {
  constexpr std::array<std::string_view, 14> kNames = {
      "GET_OH",   "GET_HCO3", "GET_CO3",   "GET_CO2",  "GET_FCO2", "GET_DIC_EST", "GET_ALK_EST",
      "GET_CALK", "GET_BALK", "GET_SIALK", "GET_PALK", "GET_HF",   "GET_HFREE",   "GET_HSO4"};
  std::vector<Evaluator> functions;
  for (const std::string_view name : kNames) functions.push_back(FindFunction(name)->evaluator);
  return functions;
}

template <double (*Solve)(double, double, double, double, double)>
void SolvePh(benchmark::State& state) {
  const std::vector<Water> waters = Waters();
  const auto depth = static_cast<double>(state.range(0));
  std::size_t next = 0;
  for ([[maybe_unused]] auto turn : state) {
    const Water& w = waters[next++ % waters.size()];
    benchmark::DoNotOptimize(Solve(w.dic, w.alkalinity, w.salinity, w.temperature, depth));
  }
  state.SetItemsProcessed(state.iterations());
}

void KeepLastWater() {}

/// A setter empties what is kept, even when it sets what was set before.
void ForgetLastWater() {
  SetDicAlkFactors(1, 1);
}

/// The pH of a water and its 14 species, as the equations of a template ask for them.
template <void (*BeforeEachSpecie)()>
void SolvePhAndSpecies(benchmark::State& state) {
  const std::vector<Water> waters = Waters();
  const std::vector<Evaluator> functions = SpecieFunctions();
  std::size_t next = 0;
  for ([[maybe_unused]] auto turn : state) {
    const Water& w = waters[next++ % waters.size()];
    const double ph = CalculatePh(w.dic, w.alkalinity, w.salinity, w.temperature, 0);
    const std::array sample{ph, w.dic, w.alkalinity, w.salinity, w.temperature, 0.0};
    for (const Evaluator function : functions) {
      BeforeEachSpecie();
      benchmark::DoNotOptimize(function(sample));
    }
  }
  state.SetItemsProcessed(state.iterations());
}

}  // namespace

// At the surface, and at 1000 m, where pressure acts.
BENCHMARK(SolvePh<CalculatePh>)->Name("CalcPh")->Arg(0)->Arg(1000);
BENCHMARK(SolvePh<CalculatePhSimply>)->Name("SimpleCalcPh")->Arg(0)->Arg(1000);
BENCHMARK(SolvePhAndSpecies<KeepLastWater>)->Name("CalcPhAndSpecies/cache");
BENCHMARK(SolvePhAndSpecies<ForgetLastWater>)->Name("CalcPhAndSpecies/no_cache");
