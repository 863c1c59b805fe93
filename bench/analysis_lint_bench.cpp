// Lint and graphs of generated templates.
#include <benchmark/benchmark.h>

#include <stdexcept>

#include "analysis/dependency_graph.h"
#include "analysis/lint.h"
#include "core/template_core.h"
#include "generated_template.h"

namespace {

using namespace tessal;

void Load(TemplateCore& core, std::int64_t elements) {
  const bench::ScratchFolder folder;
  if (!core.LoadWrapper(bench::FileOfSize(folder, elements))) throw std::runtime_error("no template");
}

void LintAll(benchmark::State& state) {
  TemplateCore core;
  Load(core, state.range(0));
  for ([[maybe_unused]] auto turn : state) benchmark::DoNotOptimize(Lint(core).size());
}

void GraphOf(benchmark::State& state, const std::vector<ElementKind>& kinds) {
  TemplateCore core;
  Load(core, state.range(0));
  for ([[maybe_unused]] auto turn : state) {
    benchmark::DoNotOptimize(BuildGraph(core, {.kinds = kinds}).edges.size());
  }
}

void GraphUsual(benchmark::State& state) {
  GraphOf(state, UsualGraphKinds());
}

/// Everything between states is bridged.
void GraphOfStates(benchmark::State& state) {
  GraphOf(state, {ElementKind::StateVariable});
}

}  // namespace

BENCHMARK(LintAll)->Arg(1'000)->Arg(10'000)->Unit(benchmark::kMillisecond);
BENCHMARK(GraphUsual)->Arg(1'000)->Arg(10'000)->Unit(benchmark::kMillisecond);
BENCHMARK(GraphOfStates)->Arg(1'000)->Arg(10'000)->Unit(benchmark::kMillisecond);
