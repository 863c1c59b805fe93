// Computing plain mathematical functions of the catalogue for a host of the expression layer.
#pragma once

#include <span>
#include <string>

namespace tessal {

/// Computes a function by its name in any case. 1 with the value; 0, with the output untouched, for a name
/// without a row, a wrong number of arguments, and functions that are no plain mathematics, draw random
/// numbers, need the simulation engine or keep state.
int EvaluateFunction(const std::string& name, std::span<const double> arguments, double& value);

/// Whether angles of plain functions are degrees. Off; nothing in the system turns it on.
bool& AnglesAreDegrees();

}  // namespace tessal
