// What each analysis of a template costs, at sizes up to ten times the largest that people write.
#include <benchmark/benchmark.h>

#include <stdexcept>
#include <string>
#include <vector>

#include "analysis/dependency_graph.h"
#include "analysis/lint.h"
#include "analysis/mass_balance.h"
#include "analysis/process_matrix.h"
#include "analysis/unit_check.h"
#include "core/error_registry.h"
#include "core/template_core.h"
#include "generated_template.h"

namespace {

using namespace tessal;

/// Runs an analysis of a generated template of that many elements again and again.
template <class Analysis>
void Run(benchmark::State& state, Analysis analysis) {
  const bench::ScratchFolder folder;
  TemplateCore core;
  if (!core.LoadWrapper(bench::FileOfSize(folder, state.range(0)))) {
    throw std::runtime_error(Errors().JoinErrors());
  }
  for ([[maybe_unused]] auto iteration : state) benchmark::DoNotOptimize(analysis(core));
  state.SetComplexityN(state.range(0));
}

void Matrix(benchmark::State& state) {
  Run(state, [](const TemplateCore& core) {
    return BuildProcessMatrix(core, MatrixProcesses::AsWritten).rows.size();
  });
}

void ElementaryMatrix(benchmark::State& state) {
  Run(state, [](const TemplateCore& core) {
    return BuildProcessMatrix(core, MatrixProcesses::Elementary).rows.size();
  });
}

/// Of the pool of all state variables.
void Balance(benchmark::State& state) {
  Run(state, [](const TemplateCore& core) {
    Pool pool{"all", "0", {}, {}};
    for (const auto& variable : core.StateVariables()) {
      pool.expression += " + " + variable->symbol.TextOf();
    }
    return CheckMassBalance(core, {&pool, 1}).front().leaks.size();
  });
}

void Units(benchmark::State& state) {
  Run(state, [](const TemplateCore& core) { return CheckUnits(core, Substances::Ignored).findings.size(); });
}

void LintAll(benchmark::State& state) {
  Run(state, [](const TemplateCore& core) { return Lint(core).size(); });
}

void UsualGraph(benchmark::State& state) {
  Run(state,
      [](const TemplateCore& core) { return BuildGraph(core, {.kinds = UsualGraphKinds()}).edges.size(); });
}

/// Everything between state variables is bridged.
void GraphOfStates(benchmark::State& state) {
  Run(state, [](const TemplateCore& core) {
    return BuildGraph(core, {.kinds = {ElementKind::StateVariable}}).edges.size();
  });
}

// clang-format off
BENCHMARK(Matrix)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond)->Complexity();
BENCHMARK(ElementaryMatrix)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond)->Complexity();
BENCHMARK(Balance)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond)->Complexity();
BENCHMARK(Units)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond)->Complexity();
BENCHMARK(LintAll)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond)->Complexity();
BENCHMARK(UsualGraph)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond)->Complexity();
BENCHMARK(GraphOfStates)->RangeMultiplier(10)->Range(100, 10'000)->Unit(benchmark::kMillisecond)->Complexity();
// clang-format on

}  // namespace
