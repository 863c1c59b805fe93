// What a modeller waits for: opening a template, one edit with everything that follows it, saving, and a
// rename.
#include <benchmark/benchmark.h>
#include <malloc.h>

#include <cstdint>
#include <fstream>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "core/error_registry.h"
#include "core/find.h"
#include "core/replace.h"
#include "core/symbol_ranking.h"
#include "core/template_core.h"
#include "generated_template.h"

namespace {

using namespace tessal;
using bench::FileOfSize;
using bench::ScratchFolder;

/// Loads a template and turns notifications on, as an editor does.
void Open(TemplateCore& core, const std::string& path) {
  if (!core.LoadWrapper(path)) throw std::runtime_error(Errors().JoinErrors());
  SetNotifyChanges(true);
}

void WarmLoad(benchmark::State& state) {
  const ScratchFolder folder;
  const std::string path = FileOfSize(folder, state.range(0));
  TemplateCore core;
  // The first load takes its memory from the system, those after it take it from the allocator.
  Open(core, path);
  for ([[maybe_unused]] auto iteration : state) Open(core, path);
  state.SetComplexityN(state.range(0));
}
BENCHMARK(WarmLoad)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond)->Complexity();

/// The rows of the error list, as the main view and the command line tool show them.
std::size_t ListErrors(TemplateCore& core) {
  Errors().ClearErrors();
  core.ValidateTemplate();
  std::vector<std::pair<std::string, std::string>> rows;
  for (std::size_t index = 0; index < Errors().Records().size(); ++index) {
    Uid uid = Uid::None;
    auto& [symbol, text] = rows.emplace_back();
    Errors().GetErrorForList(index, symbol, uid, text);
  }
  for (const auto& undefined : core.UndefinedSymbols()) {
    rows.emplace_back("generic", "Undefined symbol " + undefined->symbol);
  }
  return rows.size();
}

void Edit(benchmark::State& state) {
  const ScratchFolder folder;
  TemplateCore core;
  Open(core, FileOfSize(folder, state.range(0)));
  CEL_Property& expression = core.GetProcess(core.GetProcessCount() / 2).expression;
  const std::string former = expression.TextOf();
  bool changed = false;
  const auto edit = [&] {
    changed = !changed;
    expression.SetText(changed ? former + " + constant1*nobody" : former);
    benchmark::DoNotOptimize(ListErrors(core));
  };
  // Both texts once before it counts, so that few edits of a large template are as warm as many of a small
  // one.
  edit();
  edit();
  for ([[maybe_unused]] auto iteration : state) edit();
  state.SetComplexityN(state.range(0));
}
BENCHMARK(Edit)->Arg(500)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond)->Complexity();

void Save(benchmark::State& state) {
  const ScratchFolder folder;
  const std::string path = FileOfSize(folder, state.range(0));
  TemplateCore core;
  Open(core, path);
  for ([[maybe_unused]] auto iteration : state) {
    if (!core.SaveWrapper(path)) throw std::runtime_error(Errors().JoinErrors());
  }
}
BENCHMARK(Save)->Arg(10'000)->Unit(benchmark::kMillisecond);

void Rename(benchmark::State& state) {
  constexpr std::size_t kUsers = 1000;
  const ScratchFolder folder;
  TemplateCore core;
  Open(core, FileOfSize(folder, state.range(0)));
  SetNotifyChanges(false);
  for (std::size_t place = 0; place < kUsers; ++place) {
    CEL_Property& expression = core.GetProcess(place).expression;
    expression.SetText("used*2 + " + expression.TextOf());
  }
  core.GetConstant(0).symbol.SetText("used");
  core.RebuildSymbolTable();
  SetNotifyChanges(true);
  std::string present = "used";
  std::string other = "renamed";
  for ([[maybe_unused]] auto iteration : state) {
    if (!core.RenameSymbol(present, other, true)) throw std::runtime_error("not renamed");
    std::swap(present, other);
  }
}
BENCHMARK(Rename)->Arg(5'000)->Unit(benchmark::kMillisecond);

/// A pattern that is in every tenth text, by a regular expression and as it is.
void Find(benchmark::State& state, const char* pattern, bool isRegex) {
  const ScratchFolder folder;
  TemplateCore core;
  Open(core, FileOfSize(folder, state.range(0)));
  const FindQuery query{{pattern, isRegex, false, false}, FindIn::All};
  for ([[maybe_unused]] auto iteration : state) benchmark::DoNotOptimize(FindTexts(core, query).found.data());
  state.SetComplexityN(state.range(0));
}
BENCHMARK_CAPTURE(Find, plain, "constant1", false)
    ->Arg(5'000)
    ->Arg(50'000)
    ->Unit(benchmark::kMillisecond)
    ->Complexity();
BENCHMARK_CAPTURE(Find, regex, "constant[0-9]*7\\b", true)
    ->Arg(5'000)
    ->Arg(50'000)
    ->Unit(benchmark::kMillisecond)
    ->Complexity();

void Uses(benchmark::State& state) {
  const ScratchFolder folder;
  TemplateCore core;
  Open(core, FileOfSize(folder, state.range(0)));
  const std::string name = core.GetConstant(1).symbol.TextOf();
  for ([[maybe_unused]] auto iteration : state) benchmark::DoNotOptimize(FindUses(core, name).data());
}
BENCHMARK(Uses)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

/// A replacement in all expressions, and back.
void Replace(benchmark::State& state) {
  const ScratchFolder folder;
  TemplateCore core;
  Open(core, FileOfSize(folder, state.range(0)));
  const char* former = "*";
  const char* later = " * ";
  for ([[maybe_unused]] auto iteration : state) {
    const FindQuery query{{former, false, false, false}, FindIn::Expressions};
    const ReplacePreview preview = PreviewReplacements(core, query, later);
    const ReplaceOutcome outcome = ApplyReplacements(core, preview.replacements, TextEncoding::Utf8);
    if (outcome.applied == 0) throw std::runtime_error("nothing replaced");
    std::swap(former, later);
  }
  state.SetComplexityN(state.range(0));
}
BENCHMARK(Replace)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond)->Complexity();

void SymbolRanking(benchmark::State& state) {
  const ScratchFolder folder;
  TemplateCore core;
  Open(core, FileOfSize(folder, state.range(0)));
  for ([[maybe_unused]] auto iteration : state)
    benchmark::DoNotOptimize(SymbolsByRank(core, "cs1", 100).data());
}
BENCHMARK(SymbolRanking)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

/// One step taken back: of a value, of a deletion with what follows for all numbers, of a rename.
void Undo(benchmark::State& state) {
  const ScratchFolder folder;
  TemplateCore core;
  Open(core, FileOfSize(folder, state.range(0)));
  core.History().Start();
  CEL_Process& process = core.GetProcess(core.GetProcessCount() / 2);
  process.expression.SetText(process.expression.TextOf() + " + 1");
  core.AddConstant();
  core.RenameSymbol(core.GetConstant(0).symbol.TextOf(), "renamed", true);
  for ([[maybe_unused]] auto iteration : state) {
    if (!core.Undo()) {
      state.PauseTiming();
      while (core.Redo()) continue;
      state.ResumeTiming();
    }
  }
}
BENCHMARK(Undo)->Arg(500)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

/// How much of the process's memory is in use, in MB.
double ResidentMegabytes() {
  std::ifstream status("/proc/self/statm");
  std::size_t all = 0;
  std::size_t resident = 0;
  status >> all >> resident;
  return static_cast<double>(resident) * 4096.0 / 1e6;
}

/// What 10,000 steps take: texts of processes, with a creation and a deletion of a constant among ten.
void MemoryOfSteps(benchmark::State& state) {
  constexpr int kSteps = 10'000;
  const ScratchFolder folder;
  TemplateCore core;
  Open(core, FileOfSize(folder, state.range(0)));
  double before = 0.0;
  for ([[maybe_unused]] auto iteration : state) {
    core.History().Start();
    // What the load has left free would hide what the steps take.
    malloc_trim(0);
    before = ResidentMegabytes();
    for (int step = 0; step < kSteps; ++step) {
      const EditStep act(core.History());
      CEL_Process& process = core.GetProcess(static_cast<std::size_t>(step) % core.GetProcessCount());
      if (step % 10 == 0) {
        core.AddConstant();
      } else if (step % 10 == 1) {
        core.DeleteElement(core.GetConstant(core.GetConstantCount() - 1).GetUid());
      } else {
        core.SetRebuildEnabled(false);
        process.expression.SetText(process.expression.TextOf() + " + 1");
        process.description.SetText("A description of some length, number " + std::to_string(step));
        core.SetRebuildEnabled(true);
      }
    }
    state.counters["steps"] = static_cast<double>(core.History().UndoCount());
    state.counters["MB"] = ResidentMegabytes() - before;
    state.counters["counted MB"] = static_cast<double>(core.History().Bytes()) / 1e6;
  }
}
BENCHMARK(MemoryOfSteps)->Arg(10'000)->Iterations(1)->Unit(benchmark::kMillisecond);

}  // namespace
