// Functions whose work is done by a simulation engine. Here there is no engine state to reach, so they change
// nothing.
#pragma once

#include <span>

namespace tessal {

/// `SET_RADIUS`: the radius, as given.
double SetRadius(double searchFunction, double radius);

/// `TERMINATE`, `SET_PROJECTION`, `SET_FOV`, and the functions that read or write the engine's layer,
/// element, id and state: computes nothing. The answer is 0 whatever the arguments.
double WithoutEngine(std::span<const double> arguments);

}  // namespace tessal
