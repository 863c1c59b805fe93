#include "expr/function_reference_rows.h"

namespace tessal {

namespace {

// clang-format off

// --- Arguments that several functions take -----------------------------------------------------------------

constexpr ArgumentReference kNumber[] = {{"x", "a number", "any"}};
constexpr ArgumentReference kTwoNumbers[] = {{"x", "a number", "any"}, {"y", "another", "as x"}};
constexpr ArgumentReference kPlainNumber[] = {{"x", "a number", "1"}};
constexpr ArgumentReference kPositiveNumber[] = {{"x", "a number above 0", "1"}};
constexpr ArgumentReference kAngle[] = {
    {"x", "an angle, in radians or in degrees as the settings' Trigonometric unit says", "radian"}};
constexpr ArgumentReference kSineOrCosine[] = {{"x", "a number from -1 to 1", "1"}};
constexpr ArgumentReference kSerialTime[] = {
    {"Time", "a serial date: days since 30 December 1899, the time of day as the fraction", "day"}};
constexpr ArgumentReference kDate[] = {
    {"YEAR", "the year, 2001", "1"}, {"MONTH", "the month, 1 to 12", "1"},
    {"DAY", "the day of the month, from 1", "1"}};
constexpr ArgumentReference kDateAndLatitude[] = {
    {"YEAR", "the year, 2001", "1"}, {"MONTH", "the month, 1 to 12", "1"},
    {"DAY", "the day of the month, from 1", "1"},
    {"Latitude", "the latitude, north positive, -90 to 90", "degree"}};
constexpr ArgumentReference kDateLatitudeAndClock[] = {
    {"YEAR", "the year, 2001", "1"}, {"MONTH", "the month, 1 to 12", "1"},
    {"DAY", "the day of the month, from 1", "1"},
    {"Latitude", "the latitude, north positive, -90 to 90", "degree"},
    {"Summertime_Correction_In_Hours", "hours to add, as summer time does", "hour"}};
constexpr ArgumentReference kRateAndTemperature[] = {
    {"Temperature_Coefficient", "the factor of the rate for each degree, usually 1 to 1.2", "1"},
    {"Temperature", "the temperature", "degC"}};
constexpr ArgumentReference kSalinityAndTemperature[] = {
    {"Salinity", "the salinity, 0 to 40", "g/kg"}, {"Temperature", "the temperature, 0 to 36", "degC"}};
constexpr ArgumentReference kLayerOfLight[] = {
    {"Surface_Light", "the light on top of the layer", "any"},
    {"Layer_Height", "the height of the layer", "m"},
    {"Light_Extinction_Coefficient", "the extinction coefficient", "1/m"}};
constexpr ArgumentReference kMovement[] = {
    {"Speed", "the speed", "any"}, {"Direction", "the direction", "degree"}};
constexpr ArgumentReference kTwoMovements[] = {
    {"Speed1", "the speed of the first movement", "any"},
    {"Direction1", "its direction, clockwise from north", "degree"},
    {"Speed2", "the speed of the second movement", "as Speed1"},
    {"Direction2", "its direction, clockwise from north", "degree"}};
constexpr ArgumentReference kDataSlot[] = {{"data_slot", "the number of the slot, 1 to 100; cut off", "1"}};

// --- Numbers ------------------------------------------------------------------------------------------------

constexpr ArgumentReference kDivision[] = {
    {"value", "a number", "any"}, {"divisor", "what it is divided by", "as value"}};

constexpr FunctionReference kNumbers[] = {
    {"ABS", "The absolute value of a number.", kNumber, "x without its sign", "as x", "0 or above", ""},
    {"SIGN", "The sign of a number.", kNumber, "-1 below 0, 0 at 0, 1 above", "1", "-1, 0 or 1", ""},
    {"MAX", "Of two numbers the smaller one: the result is the opposite of what the name says, and templates "
            "rely on it.",
     kTwoNumbers, "the smaller of x and y", "as x", "", ""},
    {"MIN", "Of two numbers the larger one: the result is the opposite of what the name says, and templates "
            "rely on it.",
     kTwoNumbers, "the larger of x and y", "as x", "", ""},
    {"MOD", "The rest of a division, with the sign of the value; numbers need not be whole.", kDivision,
     "the remainder, 0 for a divisor of 0", "as value", "smaller than the divisor", ""},
    {"FLOOR", "Rounds down to a whole number.", kNumber, "the largest whole number not above x", "as x", "", ""},
    {"CEIL", "Rounds up to a whole number.", kNumber, "the smallest whole number not below x", "as x", "", ""},
};

// --- Powers and logarithms ------------------------------------------------------------------------------------

constexpr ArgumentReference kPower[] = {{"x", "the base", "any"}, {"y", "the exponent", "1"}};
constexpr ArgumentReference kRadicand[] = {{"x", "a number, 0 or above", "any"}};

constexpr FunctionReference kPowers[] = {
    {"EXP", "The exponential function: e to the power of x.", kPlainNumber, "e^x", "1", "above 0", ""},
    {"LN", "The natural logarithm.", kPositiveNumber, "the logarithm to the base e", "1", "", ""},
    {"LOG10", "The decimal logarithm.", kPositiveNumber, "the logarithm to the base 10", "1", "", ""},
    {"POW", "A power. This is how an expression writes x to the power of y.", kPower,
     "x^y; not a number for a base below 0 and an exponent that is not whole", "as x^y", "", ""},
    {"SQR", "The square of a number. For the square root see SQRT.", kNumber, "x*x", "as x^2", "0 or above", ""},
    {"SQRT", "The square root of a number.", kRadicand, "the root; not a number below 0", "as x^0.5",
     "0 or above", ""},
};
// clang-format on

constexpr FunctionGroup kGroups[] = {
    {"Numbers", kNumbers},
    {"Powers and logarithms", kPowers},
};

}  // namespace

std::span<const FunctionGroup> GeneralFunctionGroups() {
  return kGroups;
}

}  // namespace tessal
