// Calls catalogue functions as a modeller writes them: "CALC_PH(2100, 2300, 35, 25, 0)".
#pragma once

#include <string_view>

namespace tessal {

/// The value of the call; a test failure and NaN for a text that is no call of a function with an evaluator.
double Call(std::string_view call);

/// Several calls, separated by semicolons; their values are dropped.
void CallEach(std::string_view calls);

/// The settings of a fresh process.
void ResetCarbonateForTest();

}  // namespace tessal
