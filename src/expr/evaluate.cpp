#include "expr/evaluate.h"

#include <algorithm>
#include <array>
#include <numbers>
#include <utility>

#include "expr/function_catalogue.h"

namespace tessal {

namespace {

constexpr std::int32_t kPlainMathematics = 1;
constexpr std::size_t kMostValues = 6;
constexpr double kHalfTurn = 180.0;

/// Whether a call has no effect and depends on its arguments alone.
bool IsPure(const FunctionTraits& traits) {
  return !traits.drawsRandomNumbers && !traits.needsEngine && !traits.keepsState;
}

}  // namespace

bool& AnglesAreDegrees() {
  static bool degrees = false;
  return degrees;
}

int EvaluateFunction(const std::string& name, std::span<const double> arguments, double& value) {
  const CatalogueFunction* function = FindFunction(name);
  if (function == nullptr || !IsPure(function->traits)) return 0;
  if (function->argumentCount != static_cast<std::int32_t>(arguments.size()) ||
      function->functionClass != kPlainMathematics || arguments.size() > kMostValues ||
      function->evaluator == nullptr) {
    return 0;
  }
  std::array<double, kMostValues> values{};
  std::copy(arguments.begin(), arguments.end(), values.begin());
  if (AnglesAreDegrees() && function->traits.takesAngle) values[0] *= std::numbers::pi / kHalfTurn;
  if (function->traits.swapsArguments) std::swap(values[0], values[1]);
  value = function->evaluator(std::span(values).first(arguments.size()));
  if (AnglesAreDegrees() && function->traits.givesAngle) value *= kHalfTurn / std::numbers::pi;
  return 1;
}

}  // namespace tessal
