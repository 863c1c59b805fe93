// Key-file text: read to an item tree, read by the library, and compared.
#include <benchmark/benchmark.h>

#include <string>

#include "keyfile/item_tree.h"
#include "keyfile/reader.h"
#include "platform/kvf2004.h"

namespace {

using namespace tessal;

std::string KeyFileText(std::int64_t sections) {
  std::string text = "// head\r\n\r\n[TESSAL_SETUP]\r\n";
  for (std::int64_t number = 1; number <= sections; ++number) {
    text += "   [PROCESS_" + std::to_string(number) + "]\r\n      SYMBOL = 'p" + std::to_string(number) +
            "'\r\n      ID = " + std::to_string(number) +
            "\r\n      DESCRIPTION = 'Decay of organic matter in the water column'\r\n      CONTROLVALUE = "
            "0.8\r\n"
            "      EXPRESSION = '\"kd*ARRHENIUS20(theta, temp)*C\"'\r\n   EndSect  // PROCESS\r\n\r\n";
  }
  return text + "EndSect  // TESSAL_SETUP\r\n\r\n";
}

void ReadTree(benchmark::State& state) {
  const std::string text = KeyFileText(state.range(0));
  for ([[maybe_unused]] auto turn : state) {
    CKvfItemTree tree;
    if (ParseKeyFileTree(text, tree) == 0) state.SkipWithError(KeyFileFailureText().c_str());
  }
  state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(text.size()));
}

void ReadByLibrary(benchmark::State& state) {
  const std::string text = KeyFileText(state.range(0));
  for ([[maybe_unused]] auto turn : state) {
    KvfHandle file = kvfLoadText(text);
    if (file == 0) state.SkipWithError("the text does not load");
    kvfClose(&file);
  }
  state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(text.size()));
}

void CompareTrees(benchmark::State& state) {
  CKvfItemTree left;
  CKvfItemTree right;
  ParseKeyFileTree(KeyFileText(state.range(0)), left);
  right.Assign(left);
  for ([[maybe_unused]] auto turn : state)
    benchmark::DoNotOptimize(left.Compare(right, nullptr, nullptr, false));
}

}  // namespace

BENCHMARK(ReadTree)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond);
BENCHMARK(ReadByLibrary)->RangeMultiplier(10)->Range(100, 100'000)->Unit(benchmark::kMillisecond);
BENCHMARK(CompareTrees)->RangeMultiplier(10)->Range(100, 10'000)->Unit(benchmark::kMillisecond);
