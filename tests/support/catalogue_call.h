// Calls catalogue functions as a modeller writes them: "CALC_PH(2100, 2300, 35, 25, 0)".
#pragma once

#include <string>

namespace tessal::test {

/// The value of the last of several calls, separated by semicolons; a test failure and NaN for a text that is
/// no call of a function with an evaluator.
double Call(const std::string& calls);

/// The same as text with twelve digits, from the settings of a fresh process.
std::string FreshCall(const std::string& calls);

/// Data slots, random numbers and the settings of the carbonate system as in a fresh process.
void ResetNumbers();

}  // namespace tessal::test
