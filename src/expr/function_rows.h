// The table of the functions that expressions may call: one row holds all that is known of a function, what
// computes it included. The catalogue is made from it.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

#include "expr/function_catalogue.h"
#include "expr/numeric/evaluator.h"

namespace tessal {

inline constexpr std::size_t kMostArguments = 15;

struct FunctionRow {
  std::int32_t id;
  std::string_view name;
  std::string_view internalName;  ///< the function's name in the simulation engine
  std::int32_t functionClass;
  Evaluator evaluator;
  std::array<std::string_view, kMostArguments> arguments;
  FunctionTraits traits = {};
};

/// All rows, in catalogue order.
std::span<const FunctionRow> FunctionRows();

}  // namespace tessal
