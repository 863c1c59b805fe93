// The rows of the function reference, by subject. For the meaning of the fields see function_reference.h.
#pragma once

#include <span>

#include "expr/function_reference.h"

namespace tessal {

/// Mathematics, calendar, rates, light, random numbers, movement and what the engine computes.
std::span<const FunctionGroup> GeneralFunctionGroups();
/// What old templates may still call.
std::span<const FunctionGroup> DeprecatedFunctionGroups();
/// Sea water and its carbonate system.
std::span<const FunctionGroup> SeaWaterFunctionGroups();

}  // namespace tessal
