#include "expr/evaluate.h"

#include <algorithm>
#include <array>
#include <numbers>
#include <utility>

#include "expr/function_catalogue.h"

namespace tessal {

namespace {

constexpr std::int32_t kPlainMathematics = 1;
constexpr std::size_t kMostArguments = 6;
constexpr std::int32_t kArcTangentOfTwo = 4;
constexpr double kHalfTurn = 180.0;

struct IdRange {
  std::int32_t first;
  std::int32_t last;
};

/// Functions that draw random numbers, need the engine or keep state.
constexpr std::array<IdRange, 4> kRefused = {{{50, 58}, {68, 73}, {78, 88}, {92, 92}}};

/// Functions of an angle, and functions that give one.
constexpr std::array<std::int32_t, 6> kTakeAngle = {6, 7, 14, 15, 18, 19};
constexpr IdRange kGiveAngle{2, 5};

bool IsIn(const IdRange& range, std::int32_t id) {
  return id >= range.first && id <= range.last;
}

bool IsRefused(std::int32_t id) {
  return std::any_of(kRefused.begin(), kRefused.end(),
                     [id](const IdRange& range) { return IsIn(range, id); });
}

}  // namespace

bool& AnglesAreDegrees() {
  static bool degrees = false;
  return degrees;
}

int EvaluateFunction(const std::string& name, std::span<const double> arguments, double& value) {
  const CatalogueFunction* function = FindFunction(name);
  if (function == nullptr || IsRefused(function->id)) return 0;
  if (function->argumentCount != static_cast<std::int32_t>(arguments.size()) ||
      function->functionClass != kPlainMathematics || arguments.size() > kMostArguments ||
      function->evaluator == nullptr) {
    return 0;
  }
  std::array<double, kMostArguments> values{};
  std::copy(arguments.begin(), arguments.end(), values.begin());
  const bool takesAngle = std::find(kTakeAngle.begin(), kTakeAngle.end(), function->id) != kTakeAngle.end();
  if (AnglesAreDegrees() && takesAngle) values[0] *= std::numbers::pi / kHalfTurn;
  if (function->id == kArcTangentOfTwo) std::swap(values[0], values[1]);
  value = function->evaluator(std::span(values).first(arguments.size()));
  if (AnglesAreDegrees() && IsIn(kGiveAngle, function->id)) value *= kHalfTurn / std::numbers::pi;
  return 1;
}

}  // namespace tessal
