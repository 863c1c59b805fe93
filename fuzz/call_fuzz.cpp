// Any sequence of calls of catalogue functions, with any values, has an answer in bounded time; a function
// that draws no random number answers the same question the same way, from its cache or not.
#include <array>
#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>
#include <span>
#include <utility>
#include <vector>

#include "expr/evaluate.h"
#include "expr/function_catalogue.h"
#include "expr/numeric/random.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Require;

/// The slowest call, the simple pH solver on water where it never settles, takes a million rounds.
constexpr int kMostCalls = 16;

/// Values at which functions change their ways.
constexpr std::array kValues = {0.0,
                                -0.0,
                                1.0,
                                -1.0,
                                0.5,
                                2.0,
                                3.0,
                                4.0,
                                5.0,
                                6.0,
                                7.0,
                                8.0,
                                10.0,
                                12.0,
                                14.0,
                                15.0,
                                20.0,
                                25.0,
                                29.0,
                                35.0,
                                60.0,
                                61.0,
                                90.0,
                                100.0,
                                101.0,
                                273.15,
                                360.0,
                                1000.0,
                                1900.0,
                                2000.0,
                                2300.0,
                                45000.0,
                                -273.15,
                                1e-5,
                                1e-18,
                                1e-300,
                                5e-324,
                                4e9,
                                -4e9,
                                1e15,
                                -1e15,
                                1e16,
                                9.3e18,
                                -9.3e18,
                                1e19,
                                1e300,
                                -1e300,
                                1.7e308,
                                std::numeric_limits<double>::infinity(),
                                -std::numeric_limits<double>::infinity(),
                                std::numeric_limits<double>::quiet_NaN()};

/// Takes an input apart, byte by byte.
class Input final {
 public:
  Input(const std::uint8_t* data, std::size_t size) : rest(data, size) {}

  bool IsEmpty() const { return rest.empty(); }

  std::uint8_t Byte() {
    if (rest.empty()) return 0;
    const std::uint8_t byte = rest.front();
    rest = rest.subspan(1);
    return byte;
  }

  /// One of the values, a small number, or any number from eight bytes.
  double Value() {
    const std::uint8_t choice = Byte();
    if (choice < kValues.size()) return kValues.at(choice);
    if (choice < 0xC0) return (choice - 0x80) / 4.0;
    std::uint64_t bits = 0;
    for (int byte = 0; byte < 8; ++byte) bits = bits << 8 | Byte();
    return std::bit_cast<double>(bits);
  }

 private:
  std::span<const std::uint8_t> rest;
};

bool AreSame(double first, double second) {
  return first == second || (std::isnan(first) && std::isnan(second));
}

void CheckCall(const CatalogueFunction& function, const std::vector<double>& values) {
  const double answer = function.evaluator(values);
  if (function.traits.drawsRandomNumbers) return;
  Require(AreSame(function.evaluator(values), answer), "the same question has the same answer");
  double evaluated = answer;
  std::vector<double> order = values;
  if (function.traits.swapsArguments) std::swap(order[0], order[1]);
  EvaluateFunction(function.name, order, evaluated);
  Require(AreSame(evaluated, answer), "what a host may evaluate is what the row computes");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  InitCatalogues();
  ResetRandomNumbers();
  Input input(data, size);
  for (int call = 0; call < kMostCalls && !input.IsEmpty(); ++call) {
    const CatalogueFunction& function = Functions()[input.Byte() % Functions().size()];
    std::vector<double> values(static_cast<std::size_t>(function.argumentCount));
    for (double& value : values) value = input.Value();
    if (function.evaluator != nullptr) CheckCall(function, values);
  }
  ReleaseCatalogues();
  return 0;
}
