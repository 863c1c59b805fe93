// How the function catalogue refers to the code that computes a function.
#pragma once

#include <span>

namespace tessal {

/// Computes a catalogue function from its arguments, as many as the catalogue's row says: NaN for fewer,
/// further ones are ignored.
using Evaluator = double (*)(std::span<const double> arguments);

}  // namespace tessal
