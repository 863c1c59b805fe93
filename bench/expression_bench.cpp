// Expressions: to trees, to identifiers, and checked, as a validation does for every element; and the look-up
// of a function, which a check does for every call.
#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "expr/function_catalogue.h"
#include "expr/identifiers.h"
#include "expr/parser.h"
#include "expr/semantic_checks.h"

namespace {

using namespace tessal;

const std::string kShort = "a*b";
const std::string kTypical = "kd*ARRHENIUS20(theta, temp)*(Cs - C)/dz + load";
const std::string kLong = [] {
  std::string text = kTypical;
  for (int repeat = 0; repeat < 40; ++repeat) text += " + IF a > 1 AND b < 2 THEN MAX(a, b) ELSE " + kTypical;
  return text;
}();

const std::string& Text(const benchmark::State& state) {
  return state.range(0) == 0 ? kShort : state.range(0) == 1 ? kTypical : kLong;
}

void Parse(benchmark::State& state) {
  for ([[maybe_unused]] auto turn : state) {
    const auto parsed = ParseExpression(Text(state));
    benchmark::DoNotOptimize(parsed.get());
  }
  state.SetItemsProcessed(state.iterations());
}

void Identifiers(benchmark::State& state) {
  std::vector<std::string_view> names;
  for ([[maybe_unused]] auto turn : state) {
    ScanIdentifiers(Text(state), names);
    benchmark::DoNotOptimize(names.data());
  }
  state.SetItemsProcessed(state.iterations());
}

void Check(benchmark::State& state) {
  for ([[maybe_unused]] auto turn : state) {
    benchmark::DoNotOptimize(CheckFunctionsSpecified("S", Uid{1}, Text(state)));
  }
  state.SetItemsProcessed(state.iterations());
}

/// The first row, the last one, a name in small letters, and a name without a row.
void FindFunctionByName(benchmark::State& state) {
  constexpr const char* kNames[] = {"ABS", "MOONPHASE", "oxygensaturation_weiss", "NO_SUCH_FUNCTION"};
  const std::string name = kNames[state.range(0)];
  std::string internalName;
  std::int32_t count = 0;
  std::int32_t functionClass = 0;
  std::int32_t id = 0;
  for ([[maybe_unused]] auto turn : state) {
    benchmark::DoNotOptimize(FindFunctionUpper(name, internalName, count, functionClass, id));
  }
  state.SetItemsProcessed(state.iterations());
}

}  // namespace

// 0 short, 1 typical, 2 long.
BENCHMARK(Parse)->DenseRange(0, 2);
BENCHMARK(Identifiers)->DenseRange(0, 2);
BENCHMARK(Check)->DenseRange(0, 2);
BENCHMARK(FindFunctionByName)->DenseRange(0, 3);
