// The documentation page and the overview of a large template.
#include <benchmark/benchmark.h>

#include <ctime>
#include <string>

#include "core/template_core.h"
#include "docgen/html_documentation.h"
#include "docgen/overview.h"

namespace {

using namespace tessal;

/// A template of constants, auxiliaries and processes that use them.
void Fill(TemplateCore& core, std::int64_t elements) {
  const auto third = elements / 3;
  for (std::int64_t number = 0; number < third; ++number) core.AddConstant();
  for (std::int64_t number = 1; number <= third; ++number) {
    const std::string symbol = "Constant_" + std::to_string(number);
    core.AddAuxiliary().expression.SetText(symbol + "*(1 + EXP(-" + symbol + "/2))");
    core.AddProcess().expression.SetText("IF " + symbol + " > 1 THEN Auxiliary_" + std::to_string(number) +
                                         " ELSE 0");
  }
}

/// Fills the template with that many elements, with its symbol table.
void Make(TemplateCore& core, std::int64_t elements) {
  core.SetRebuildEnabled(false);
  Fill(core, elements);
  core.SetRebuildEnabled(true);
  core.RebuildSymbolTable();
}

void Page(benchmark::State& state) {
  TemplateCore core;
  Make(core, state.range(0));
  const std::tm time = {};
  for ([[maybe_unused]] auto turn : state) benchmark::DoNotOptimize(HtmlDocumentation(core, {}, time).size());
}

void Overview(benchmark::State& state) {
  TemplateCore core;
  Make(core, state.range(0));
  for ([[maybe_unused]] auto turn : state)
    benchmark::DoNotOptimize(OverviewText(core, BuildOverview(core)).size());
}

}  // namespace

BENCHMARK(Overview)->Arg(1'000)->Arg(10'000)->Unit(benchmark::kMillisecond);
BENCHMARK(Page)->Arg(1'000)->Arg(10'000)->Unit(benchmark::kMillisecond);
