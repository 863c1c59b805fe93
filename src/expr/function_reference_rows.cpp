#include "expr/function_reference_rows.h"

namespace tessal {

namespace {

// ---- Arguments that several functions take

constexpr ArgumentReference kNumber[] = {{"x", "a number", "any"}};
constexpr ArgumentReference kTwoNumbers[] = {{"x", "a number", "any"}, {"y", "another", "as x"}};
constexpr ArgumentReference kPlainNumber[] = {{"x", "a number", "1"}};
constexpr ArgumentReference kPositiveNumber[] = {{"x", "a number above 0", "1"}};
constexpr ArgumentReference kAngle[] = {{"x", "an angle; in degrees where the settings say so", "radian"}};
constexpr ArgumentReference kSineOrCosine[] = {{"x", "a number from -1 to 1", "1"}};
constexpr ArgumentReference kSerialTime[] = {
    {"Time", "a serial date: days since 30 December 1899, with the time of day as the fraction", "day"}};
constexpr ArgumentReference kDate[] = {{"YEAR", "the year, such as 2001", "1"},
                                       {"MONTH", "the month, 1 to 12", "1"},
                                       {"DAY", "the day of the month, from 1 on", "1"}};
constexpr ArgumentReference kDateAndLatitude[] = {
    {"YEAR", "the year, such as 2001", "1"},
    {"MONTH", "the month, 1 to 12", "1"},
    {"DAY", "the day of the month, from 1 on", "1"},
    {"Latitude", "the latitude, -90 to 90, north positive", "degree"}};
constexpr ArgumentReference kDateLatitudeAndClock[] = {
    {"YEAR", "the year, such as 2001", "1"},
    {"MONTH", "the month, 1 to 12", "1"},
    {"DAY", "the day of the month, from 1 on", "1"},
    {"Latitude", "the latitude, -90 to 90, north positive", "degree"},
    {"Summertime_Correction_In_Hours", "what is added to solar time, such as 1 in summer time", "hour"}};
constexpr ArgumentReference kRateTemperature[] = {
    {"Temperature_Coefficient", "the factor by which the rate grows with each degree, usually 1 to 1.2", "1"},
    {"Temperature", "the temperature", "degC"}};
constexpr ArgumentReference kOxygenWater[] = {{"Salinity", "the salinity, 0 to 40", "g/kg"},
                                              {"Temperature", "the temperature, 0 to 36", "degC"}};
constexpr ArgumentReference kLayerOfLight[] = {
    {"Surface_Light", "the light on top of the layer", "any"},
    {"Layer_Height", "the height of the layer", "m"},
    {"Light_Extinction_Coefficient", "the extinction coefficient", "1/m"}};
constexpr ArgumentReference kVector[] = {{"Speed", "the speed", "any"},
                                         {"Direction", "the direction", "degree"}};
constexpr ArgumentReference kTwoMovements[] = {
    {"Speed1", "the speed of the first movement", "any"},
    {"Direction1", "its direction, clockwise from north", "degree"},
    {"Speed2", "the speed of the second movement", "as Speed1"},
    {"Direction2", "its direction, clockwise from north", "degree"}};
constexpr ArgumentReference kDataSlot[] = {
    {"data_slot", "the number of the slot, 1 to 100; its fraction is cut off", "1"}};
constexpr ArgumentReference kEngineState[] = {{"StateID", "the number of a state of the engine", "1"}};

// ---- Numbers

constexpr ArgumentReference kDivision[] = {{"value", "a number", "any"},
                                           {"divisor", "what it is divided by", "as value"}};

constexpr FunctionReference kNumbers[] = {
    {"ABS", "The absolute value of a number.", kNumber, "x without its sign", "as x", "0 and above", ""},
    {"SIGN", "The sign of a number.", kNumber, "-1 below 0, 0 at 0, 1 above", "1", "-1, 0 or 1", ""},
    {"MAX", "The smaller of two numbers. The name says the opposite; templates rely on it as it is.",
     kTwoNumbers, "the smaller of x and y", "as x", "", ""},
    {"MIN", "The larger of two numbers. The name says the opposite; templates rely on it as it is.",
     kTwoNumbers, "the larger of x and y", "as x", "", ""},
    {"MOD", "The remainder of a division, with the sign of the value. The numbers need not be whole.",
     kDivision, "the remainder; 0 for a divisor of 0", "as value", "between -|divisor| and |divisor|", ""},
    {"FLOOR", "Rounds down to a whole number.", kNumber, "the largest whole number not above x", "as x",
     "whole numbers", ""},
    {"CEIL", "Rounds up to a whole number.", kNumber, "the smallest whole number not below x", "as x",
     "whole numbers", ""},
};

// ---- Powers and logarithms

constexpr ArgumentReference kPower[] = {{"x", "the base", "any"}, {"y", "the exponent", "1"}};
constexpr ArgumentReference kRadicand[] = {{"x", "a number, 0 or above", "any"}};

constexpr FunctionReference kPowers[] = {
    {"EXP", "The exponential function.", kPlainNumber, "e to the power of x", "1", "0 and above", ""},
    {"LN", "The natural logarithm.", kPositiveNumber,
     "the logarithm to the base e; minus infinity at 0, NaN below", "1", "", ""},
    {"LOG10", "The decimal logarithm.", kPositiveNumber,
     "the logarithm to the base 10; minus infinity at 0, NaN below", "1", "", ""},
    {"POW", "The power of a number.", kPower,
     "x to the power of y; NaN for a base below 0 with an exponent that is not whole", "as x^y", "", ""},
    {"SQR", "The square of a number. The square root is SQRT.", kNumber, "x*x", "as x^2", "0 and above", ""},
    {"SQRT", "The square root of a number. The square is SQR.", kRadicand, "the root; NaN below 0",
     "as x^0.5", "0 and above", ""},
};

// ---- Angles

constexpr ArgumentReference kPoint[] = {{"x", "how far the point is along the first axis", "any"},
                                        {"y", "how far it is along the second axis", "as x"}};
constexpr ArgumentReference kDegrees[] = {{"degree", "an angle in degrees", "degree"}};
constexpr ArgumentReference kRadians[] = {{"radians", "an angle in radians", "radian"}};

constexpr FunctionReference kAngles[] = {
    {"PI", "The ratio of a circle's circumference to its diameter.", {}, "3.141592653589793", "1", "", ""},
    {"DEG2RAD", "Turns degrees into radians, and brings them into one turn by whole turns.", kDegrees,
     "the angle in radians; NaN for an infinite one", "radian", "0 to 2 pi, both included", ""},
    {"RAD2DEG", "Turns radians into degrees, and brings them into one turn by whole turns.", kRadians,
     "the angle in degrees; NaN for an infinite one", "degree", "0 to 360, both included", ""},
    {"SIN", "The sine of an angle. The template's settings say whether the engine takes degrees or radians.",
     kAngle, "the sine", "1", "-1 to 1", ""},
    {"COS",
     "The cosine of an angle. The template's settings say whether the engine takes degrees or radians.",
     kAngle, "the cosine", "1", "-1 to 1", ""},
    {"TAN",
     "The tangent of an angle. The template's settings say whether the engine takes degrees or radians.",
     kAngle, "the tangent", "1", "", ""},
    {"ARCSIN",
     "The angle whose sine is x. The template's settings say whether the engine gives degrees or radians.",
     kSineOrCosine, "the angle; NaN outside -1 to 1", "radian", "-pi/2 to pi/2", ""},
    {"ARCCOS",
     "The angle whose cosine is x. The template's settings say whether the engine gives degrees or radians.",
     kSineOrCosine, "the angle; NaN outside -1 to 1", "radian", "0 to pi", ""},
    {"ARCTAN",
     "The angle whose tangent is x. The template's settings say whether the engine gives degrees or radians.",
     kPlainNumber, "the angle", "radian", "-pi/2 to pi/2", ""},
    {"ARCTAN2",
     "The angle of the point (x, y), counter-clockwise from the first axis. The template's settings say "
     "whether the engine gives degrees or radians.",
     kPoint, "the angle", "radian", "-pi to pi", ""},
    {"SINH",
     "The hyperbolic sine. Where the settings ask for degrees the engine turns x into radians here too.",
     kAngle, "(e^x - e^-x)/2", "1", "", ""},
    {"COSH",
     "The hyperbolic cosine. Where the settings ask for degrees the engine turns x into radians here too.",
     kAngle, "(e^x + e^-x)/2", "1", "1 and above", ""},
    {"TANH",
     "The hyperbolic tangent. Where the settings ask for degrees the engine turns x into radians here too.",
     kAngle, "SINH(x)/COSH(x)", "1", "-1 to 1", ""},
};

// ---- Calendar

constexpr ArgumentReference kTimestep[] = {{"Timestep", "the length of a time step", "s"}};

constexpr std::string_view kDayNumbers = "Fliegel and Van Flandern 1968, Commun. ACM 11:657";

constexpr FunctionReference kCalendar[] = {
    {"YEAR", "The year of a serial date.", kSerialTime, "the year", "1", "whole numbers", kDayNumbers},
    {"MONTH", "The month of a serial date.", kSerialTime, "the month", "1", "1 to 12", kDayNumbers},
    {"DAY", "The day of the month of a serial date.", kSerialTime, "the day", "1", "1 to 31", kDayNumbers},
    {"HOUR", "The hour of a serial date, cut off and not rounded.", kSerialTime, "the hour", "hour",
     "0 to 23", ""},
    {"MINUTE", "The minute of a serial date, cut off and not rounded.", kSerialTime, "the minute", "minute",
     "0 to 59", ""},
    {"SECOND", "The second of a serial date, cut off and not rounded.", kSerialTime, "the second", "second",
     "0 to 59", ""},
    {"DAYNUMBER", "The number of a day in its year, with leap years. The day may have a fraction.", kDate,
     "the day of the year, 1 for 1 January; NaN for a month outside 1 to 12", "1", "1 to 366", ""},
    {"PER_DAY", "How many time steps of that length make a day: turns a rate per time step into one per day.",
     kTimestep, "86400/Timestep", "1/day", "", ""},
};

// ---- Sun and moon

constexpr ArgumentReference kMoment[] = {
    {"Year", "the year, such as 2001", "1"},         {"Month", "the month, 1 to 12", "1"},
    {"Day", "the day of the month, from 1 on", "1"}, {"Hour", "the hour, 0 to 23", "hour"},
    {"Minute", "the minute, 0 to 59", "minute"},     {"Second", "the second, 0 to 59", "second"}};

constexpr std::string_view kDayLength =
    "Cooper 1969, Sol. Energy 12:333-346; Brock 1981, Ecol. Model. 14:1-19";

constexpr FunctionReference kSunAndMoon[] = {
    {"RELATIVE_DAYLENGTH",
     "The part of the day between sunrise and sunset, for the centre of the sun and without refraction. The "
     "latitude is taken 1.7 per cent too large; close to the poles, from 88.5 degrees on, summer and winter "
     "change places.",
     kDateAndLatitude, "the length of the day over 24 hours", "1", "0 (polar night) to 1 (polar day)",
     kDayLength},
    {"SUNRISE", "The time of sunrise, from the relative length of the day.", kDateLatitudeAndClock,
     "hours after midnight", "hour", "0 to 12, plus the correction", kDayLength},
    {"SUNSET", "The time of sunset, from the relative length of the day.", kDateLatitudeAndClock,
     "hours after midnight", "hour", "12 to 24, plus the correction", kDayLength},
    {"MOONPHASE",
     "The part of the moon's mean month of 29.5306 days that has passed since the full moon. A moment before "
     "the reference, the full moon of 31 December 2009 at 20:12:36, has the phase of the moment as long "
     "after it.",
     kMoment, "1 at full moon, about 0.5 at new moon", "1", "above 0 to 1", ""},
};

// ---- Rates

constexpr ArgumentReference kLassiter[] = {
    {"Lassiter_Constant", "how steep the response is", "1/K"},
    {"Growth_Rate_Mabce", "the rate at the optimum temperature", "any"},
    {"Growth_Optimum_Temperature", "the temperature of the largest rate", "degC"},
    {"Growth_Inhibition_Temperature", "the temperature, above the optimum, at which the rate is 0", "degC"},
    {"Temperature", "the temperature", "degC"}};
constexpr ArgumentReference kMichaelisMenten[] = {
    {"Concentration", "the concentration of what is consumed", "any"},
    {"Halfsaturation_Constant", "the concentration at which the rate is halved", "as Concentration"}};
constexpr ArgumentReference kMichaelisMentenSquared[] = {
    {"Concentration", "the concentration of what is consumed", "any"},
    {"Constant", "the square of the concentration at which the rate is halved", "as Concentration^2"}};
constexpr ArgumentReference kInhibitor[] = {
    {"Concentration", "the concentration of what inhibits, in units of the one that halves the rate", "1"}};

constexpr std::string_view kStreeterPhelps = "Streeter and Phelps 1925, Public Health Bulletin 146";

constexpr FunctionReference kRates[] = {
    {"ARRHENIUS20", "The factor that takes a rate known at 20 degrees C to another temperature.",
     kRateTemperature, "Temperature_Coefficient to the power of (Temperature - 20)", "1",
     "above 0, 1 at 20 degrees C", kStreeterPhelps},
    {"ARRHENIUS5", "The factor that takes a rate known at 5 degrees C to another temperature.",
     kRateTemperature, "Temperature_Coefficient to the power of (Temperature - 5)", "1",
     "above 0, 1 at 5 degrees C", kStreeterPhelps},
    {"LASSITER",
     "A rate of growth that rises to its optimum temperature and falls to 0 at the inhibition temperature.",
     kLassiter, "the rate; NaN above the inhibition temperature unless the exponent is whole",
     "as Growth_Rate_Mabce", "up to the rate at the optimum",
     "Lassiter and Kearns 1974, in Modeling the Eutrophication Process, eds. Middlebrooks, Falkenborg, "
     "Maloney"},
    {"MICHAELIS_MENTEN1", "Saturation of a rate with the concentration of what it consumes.",
     kMichaelisMenten, "the fraction of the largest rate, c/(c + k)", "1", "0 to 1",
     "Michaelis and Menten 1913, Biochem. Z. 49:333-369"},
    {"MICHAELIS_MENTEN2",
     "Saturation of the second order: slower at low concentrations. The constant is a square.",
     kMichaelisMentenSquared, "the fraction of the largest rate, c^2/(c^2 + k)", "1", "0 to 1",
     "Hill 1910, J. Physiol. 40:iv-vii"},
    {"REVERSE_MICHAELIS_MENTEN", "Inhibition of a rate by a concentration, with the half at 1.", kInhibitor,
     "the fraction of the rate that is left, 1/(c + 1)", "1", "0 to 1", ""},
};

// ---- Oxygen

constexpr FunctionReference kOxygen[] = {
    {"OXYGENSATURATION",
     "The saturation concentration of dissolved oxygen under one atmosphere of moist air: a cubic in the "
     "temperature with linear terms for salinity. Up to 25 degrees C it is within 2 per cent of "
     "OXYGENSATURATION_WEISS, at 30 up to 4.5 per cent lower.",
     kOxygenWater, "the concentration of oxygen", "mg/l", "",
     "Elmore and Hayes 1960, J. Sanit. Eng. Div. ASCE 86(SA4):41-53"},
    {"OXYGENSATURATION_WEISS",
     "The saturation concentration of dissolved oxygen under one atmosphere of moist air.", kOxygenWater,
     "the concentration of oxygen", "mg/l", "above 0", "Weiss 1970, Deep-Sea Res. 17:721-735"},
};

// ---- Light

constexpr ArgumentReference kDepthOfLight[] = {
    {"Surface_Light", "the light at the surface", "any"},
    {"Depth", "the depth down to which the mean is taken", "m"},
    {"Light_Extinction_Coefficient", "the extinction coefficient", "1/m"}};
constexpr ArgumentReference kSecchi[] = {
    {"Light extinction coefficient", "the extinction coefficient", "1/m"},
    {"Damping_percentage", "the part of the light that is lost at that depth", "percent"}};

constexpr std::string_view kLambertBeer = "Bouguer 1729, Lambert 1760, Beer 1852";

constexpr FunctionReference kLight[] = {
    {"LAMBERT_BEER_1", "The light that is left at the bottom of a layer: exponential extinction.",
     kLayerOfLight, "the light below the layer", "as Surface_Light", "0 to the light above", kLambertBeer},
    {"LAMBERT_BEER_2", "The light that is left at the bottom of a layer; the same as LAMBERT_BEER_1.",
     kLayerOfLight, "the light below the layer", "as Surface_Light", "0 to the light above", kLambertBeer},
    {"LAMBERT_BEER_AVR", "The mean light between the surface and a depth: exponential extinction.",
     kDepthOfLight, "the mean light; 0 unless both depth and extinction are above 0", "as Surface_Light",
     "0 to the light at the surface", kLambertBeer},
    {"SECCHI_DEPTH", "The Secchi depth: the depth at which a given part of the light is lost.", kSecchi,
     "the depth", "m", "", ""},
};

// ---- Tables

constexpr ArgumentReference kBreakpoints[] = {
    {"Value", "the value to find", "any"}, {"A", "the first breakpoint; they ascend", "as Value"},
    {"B", "the second", "as Value"},       {"C", "the third", "as Value"},
    {"D", "the fourth", "as Value"},       {"E", "the fifth", "as Value"}};
constexpr ArgumentReference kEntries[] = {{"Index", "the place in the table, 1 to 5", "1"},
                                          {"A", "the entry at 1", "any"},
                                          {"B", "the entry at 2", "as A"},
                                          {"C", "the entry at 3", "as A"},
                                          {"D", "the entry at 4", "as A"},
                                          {"E", "the entry at 5", "as A"}};

constexpr FunctionReference kTables[] = {
    {"TABLE_INDEX",
     "The place of a value among five breakpoints. Put into TABLE_VALUE it takes the value through a curve "
     "of straight lines.",
     kBreakpoints, "the number of the breakpoint before, plus the fraction of the way to the next", "1",
     "1 to 5", ""},
    {"TABLE_VALUE", "Interpolates between five entries.", kEntries,
     "the value between the entries around the index; 0 for an index outside 1 to 5", "as A", "", ""},
};

// ---- Averages

constexpr ArgumentReference kState[] = {{"State variable", "a state variable of the water column", "any"}};
constexpr ArgumentReference kSmoothing[] = {{"State variable", "a state variable", "any"},
                                            {"weight alpha", "the weight of the smoothing", "1"}};
constexpr ArgumentReference kMoving[] = {{"State variable", "a state variable", "any"},
                                         {"timesteps", "how many time steps the mean is taken over", "1"}};

constexpr FunctionReference kAverages[] = {
    {"AVERAGE_WATER_COLUMN", "The mean of a state variable over the water column.", kState, "the mean",
     "as State variable", "", ""},
    {"SMOOTHING_AVERAGE", "The mean of a state variable over time, smoothed exponentially.", kSmoothing,
     "the smoothed mean", "as State variable", "", ""},
    {"MOVING_AVERAGE", "The mean of a state variable over the last time steps.", kMoving, "the mean",
     "as State variable", "", ""},
};

// ---- Data slots

constexpr ArgumentReference kSave[] = {
    {"data_slot", "the number of the slot, 1 to 100; its fraction is cut off", "1"},
    {"value", "what is kept", "any"}};

constexpr FunctionReference kSlots[] = {
    {"SAVE",
     "Keeps a value in a numbered slot. PEEK gives it back; LOAD gives what the engine has made visible.",
     kSave, "the value; -1, and nothing kept, for a slot outside 1 to 100", "as value", "", ""},
    {"LOAD", "The value of a slot as the engine has made it visible, not the one that SAVE has just kept.",
     kDataSlot, "the value, 0 at first; -1 for a slot outside 1 to 100", "unknown", "", ""},
    {"PEEK", "The value that SAVE last kept in a slot.", kDataSlot,
     "the value, 0 at first; -1 for a slot outside 1 to 100", "unknown", "", ""},
};

// ---- Random numbers

constexpr ArgumentReference kBounds[] = {{"Min", "the lower bound", "any"},
                                         {"Max", "the upper bound", "as Min"}};
constexpr ArgumentReference kMeanAndVariance[] = {{"Mean", "the mean", "any"},
                                                  {"Variance", "the variance, 0 or above", "as Mean^2"}};
constexpr ArgumentReference kMean[] = {{"Mean", "the mean number of events", "1"}};
constexpr ArgumentReference kOrder[] = {
    {"nth_event", "which event is waited for, from 1; its fraction is cut off", "1"}};
constexpr ArgumentReference kTrials[] = {
    {"Propability", "the probability of each event, 0 to 1", "1"},
    {"Events", "how many events there are; its fraction is cut off", "1"}};

constexpr std::string_view kGenerator =
    "Park and Miller 1988, Commun. ACM 31:1192-1201; Bays and Durham 1976, ACM Trans. Math. Softw. 2:59-64";
constexpr std::string_view kPolarMethod =
    "Box and Muller 1958, Ann. Math. Stat. 29:610-611; Marsaglia and Bray 1964, SIAM Rev. 6:260-264";
constexpr std::string_view kRejection = "Ahrens and Dieter 1974, Computing 12:223-246";

constexpr FunctionReference kRandom[] = {
    {"RAND",
     "A random number, uniform between 0 and 1. The sequence is the same in each process, so that a run can "
     "be repeated.",
     {},
     "the number",
     "1",
     "between 0 and 1, both excluded",
     kGenerator},
    {"U_RAND",
     "A random number, uniform between 0 and 1; the same as RAND.",
     {},
     "the number",
     "1",
     "between 0 and 1, both excluded",
     kGenerator},
    {"U_RAND2", "A random number, uniform between two bounds.", kBounds, "the number", "as Min",
     "between Min and Max", kGenerator},
    {"N_RAND",
     "A random number of the normal distribution with mean 0 and variance 1.",
     {},
     "the number",
     "1",
     "",
     kPolarMethod},
    {"N_RAND2",
     "A random number of a normal distribution. It takes the variance, not the standard deviation.",
     kMeanAndVariance, "the number; NaN for a negative variance", "as Mean", "", kPolarMethod},
    {"E_RAND",
     "A random number of the exponential distribution with mean 1.",
     {},
     "the number",
     "1",
     "above 0",
     ""},
    {"P_RAND", "A random count of the Poisson distribution.", kMean, "the count; 0 for a mean of 0 or below",
     "1", "whole numbers, 0 and above", kRejection},
    {"G_RAND",
     "The random waiting time for the n-th event where one is expected in each unit of time: the gamma "
     "distribution.",
     kOrder, "the time, in mean times between events; 0 for an event below 1", "1", "0 and above",
     kRejection},
    {"B_RAND", "A random count of the binomial distribution: how many of the events happen.", kTrials,
     "the count", "1", "whole numbers, 0 to Events",
     "Ahrens and Dieter 1974, Computing 12:223-246; Devroye 1986, Non-Uniform Random Variate Generation"},
};

// ---- Movement

constexpr ArgumentReference kPointsInSpace[] = {{"X1", "the first point, along the first axis", "any"},
                                                {"Y1", "along the second axis", "as X1"},
                                                {"Z1", "along the third axis", "as X1"},
                                                {"X2", "the second point, along the first axis", "as X1"},
                                                {"Y2", "along the second axis", "as X1"},
                                                {"Z2", "along the third axis", "as X1"}};
constexpr ArgumentReference kPointsInPlane[] = {{"X1", "the first point, towards east", "any"},
                                                {"Y1", "towards north", "as X1"},
                                                {"X2", "the second point, towards east", "as X1"},
                                                {"Y2", "towards north", "as X1"}};
constexpr ArgumentReference kPlace[] = {{"X", "the point, along the first axis", "any"},
                                        {"Y", "along the second axis", "as X"},
                                        {"Z", "along the third axis", "as X"}};
constexpr ArgumentReference kBox[] = {{"X1", "the first corner, along the first axis", "any"},
                                      {"Y1", "along the second axis", "as X1"},
                                      {"Z1", "along the third axis", "as X1"},
                                      {"X2", "the opposite corner, along the first axis", "as X1"},
                                      {"Y2", "along the second axis", "as X1"},
                                      {"Z2", "along the third axis", "as X1"}};
constexpr ArgumentReference kHitState[] = {{"Testvalue", "a hit state", "1"},
                                           {"Conditions", "the conditions to test for, one bit each", "1"}};

constexpr FunctionReference kMoves[] = {
    {"GETX",
     "The speed times the cosine of its direction: the component along the line from which the direction is "
     "counted.",
     kVector, "the component", "as Speed", "-Speed to Speed", ""},
    {"GETY",
     "The speed times the sine of its direction: the component a quarter turn from the line from which the "
     "direction is counted.",
     kVector, "the component", "as Speed", "-Speed to Speed", ""},
    {"GETDISTANCE", "The distance between two points in space.", kPointsInSpace, "the distance", "as X1",
     "0 and above", ""},
    {"GETANGLE",
     "The compass direction from one point to another, clockwise from north. It comes in radians, while "
     "other functions take directions in degrees.",
     kPointsInPlane, "the direction; due north is 2 pi", "radian", "above 0 to 2 pi", ""},
    {"RESULTINGSPEED", "The speed of two movements at once.", kTwoMovements, "the length of the sum",
     "as Speed1", "0 and above", ""},
    {"RESULTINGDIRECTION",
     "The compass direction of two movements at once, clockwise from north. It comes in radians, while the "
     "arguments are in degrees.",
     kTwoMovements, "the direction of the sum; pi/2 where there is no movement", "radian", "above 0 to 2 pi",
     ""},
    {"ANGLEBETWEEN",
     "The angle between two movements: the arc cosine of the lesser over the greater speed times the cosine "
     "of the difference of directions. So it is the angle between the directions only where the speeds are "
     "equal.",
     kTwoMovements, "the angle; 0 for equal directions, NaN where both speeds are 0", "radian", "0 to pi",
     ""},
    {"DISTANCE_TO", "The distance from the particle to a point.", kPlace, "the distance", "as X", "", ""},
    {"INSIDE", "Whether the particle is in the box between two corners.", kBox, "whether it is inside", "1",
     "", ""},
    {"TESTHITSTATE",
     "Whether a particle's hit state meets one of several conditions. Only the lowest eight bits count.",
     kHitState, "1 if the two share a bit, else 0", "1", "0 or 1", ""},
};

// ---- The engine

constexpr ArgumentReference kEngineId[] = {{"ID", "a number of the engine's", "1"}};
constexpr ArgumentReference kRadius[] = {{"RASF ID", "the number of the restricted area search", "1"},
                                         {"radius", "its new radius", "any"}};
constexpr ArgumentReference kProjection[] = {{"seconds", "the new time of projection", "s"}};
constexpr ArgumentReference kFieldOfView[] = {{"degrees", "the new angle of view", "degree"}};
constexpr ArgumentReference kNewEngineState[] = {{"StateID", "the number of a state of the engine", "1"},
                                                 {"Value", "its new value", "any"}};

constexpr FunctionReference kEngine[] = {
    {"SET_RADIUS", "Changes the radius of a restricted area search.", kRadius, "the radius, as given",
     "as radius", "", ""},
    {"SET_PROJECTION", "Changes the time over which the position of the particle is projected.", kProjection,
     "the engine's answer", "unknown", "", ""},
    {"SET_FOV", "Changes the field of view of the particle.", kFieldOfView, "the engine's answer", "unknown",
     "", ""},
    {"TERMINATE", "Asks the engine to terminate.", {}, "the engine's answer", "unknown", "", ""},
    {"_GET_LAYER",
     "The number of the layer in which the expression is computed.",
     {},
     "the number",
     "1",
     "",
     ""},
    {"_GET_ELEMENT",
     "The number of the grid element in which the expression is computed.",
     {},
     "the number",
     "1",
     "",
     ""},
    {"_GET_ID", "An identity that the engine keeps under a number.", kEngineId, "the identity", "unknown", "",
     ""},
    {"_GET_ENGINESTATE", "The value of a state of the engine.", kEngineState, "the value", "unknown", "", ""},
    {"_SET_ENGINESTATE", "Changes a state of the engine.", kNewEngineState, "the engine's answer", "unknown",
     "", ""},
};

// ---- Deprecated

constexpr ArgumentReference kParameter[] = {{"p1", "a number", "unknown"}};
constexpr ArgumentReference kCases[] = {{"ntrue", "how many cases exceed the limit", "1"},
                                        {"ntota", "how many cases there are", "1"}};
constexpr std::string_view kOfTheEngine = "as the engine defines it";
constexpr ArgumentReference kOneAlga[] = {
    {"nutr", kOfTheEngine, "unknown"}, {"kadnutr", kOfTheEngine, "unknown"},
    {"ptam", kOfTheEngine, "unknown"}, {"pc1", kOfTheEngine, "unknown"},
    {"cn11", kOfTheEngine, "unknown"}, {"cn12", kOfTheEngine, "unknown"},
    {"cn13", kOfTheEngine, "unknown"}};
constexpr ArgumentReference kTwoAlgae[] = {
    {"nutr", kOfTheEngine, "unknown"}, {"kadnutr", kOfTheEngine, "unknown"},
    {"ptam", kOfTheEngine, "unknown"}, {"pc1", kOfTheEngine, "unknown"},
    {"pc2", kOfTheEngine, "unknown"},  {"cn11", kOfTheEngine, "unknown"},
    {"cn12", kOfTheEngine, "unknown"}, {"cn13", kOfTheEngine, "unknown"},
    {"cn21", kOfTheEngine, "unknown"}, {"cn22", kOfTheEngine, "unknown"},
    {"cn23", kOfTheEngine, "unknown"}};
constexpr ArgumentReference kThreeAlgae[] = {
    {"nutr", kOfTheEngine, "unknown"}, {"kadnutr", kOfTheEngine, "unknown"},
    {"ptam", kOfTheEngine, "unknown"}, {"pc1", kOfTheEngine, "unknown"},
    {"pc2", kOfTheEngine, "unknown"},  {"pc3", kOfTheEngine, "unknown"},
    {"cn11", kOfTheEngine, "unknown"}, {"cn12", kOfTheEngine, "unknown"},
    {"cn13", kOfTheEngine, "unknown"}, {"cn21", kOfTheEngine, "unknown"},
    {"cn22", kOfTheEngine, "unknown"}, {"cn23", kOfTheEngine, "unknown"},
    {"cn31", kOfTheEngine, "unknown"}, {"cn32", kOfTheEngine, "unknown"},
    {"cn33", kOfTheEngine, "unknown"}};
constexpr std::string_view kNutrientPurpose =
    "Kept for old templates, about nutrients. The engine alone defines what it computes.";

constexpr FunctionReference kOld[] = {
    {"F1", "Kept for old templates. The engine alone defines what it computes.", kParameter, kOfTheEngine,
     "unknown", "", ""},
    {"X",
     "Kept for old templates. The engine alone defines what it computes.",
     {},
     kOfTheEngine,
     "unknown",
     "",
     ""},
    {"EXCEEDANCE_FREQUENCY", "Kept for old templates. How many per cent of all cases exceed a limit.", kCases,
     "ntrue/ntota*100", "percent", "0 to 100", ""},
    {"ANUTRC11", kNutrientPurpose, kOneAlga, kOfTheEngine, "unknown", "", ""},
    {"ANUTRC12", kNutrientPurpose, kTwoAlgae, kOfTheEngine, "unknown", "", ""},
    {"ANUTRC22", kNutrientPurpose, kTwoAlgae, kOfTheEngine, "unknown", "", ""},
    {"ANUTRC13", kNutrientPurpose, kThreeAlgae, kOfTheEngine, "unknown", "", ""},
    {"ANUTRC23", kNutrientPurpose, kThreeAlgae, kOfTheEngine, "unknown", "", ""},
    {"ANUTRC33", kNutrientPurpose, kThreeAlgae, kOfTheEngine, "unknown", "", ""},
};

constexpr FunctionGroup kGroups[] = {
    {"Numbers", kNumbers},
    {"Powers and logarithms", kPowers},
    {"Angles and trigonometry", kAngles},
    {"Calendar", kCalendar},
    {"Sun and moon", kSunAndMoon},
    {"Rates", kRates},
    {"Oxygen", kOxygen},
    {"Light", kLight},
    {"Tables", kTables},
    {"Averages", kAverages},
    {"Data slots", kSlots},
    {"Random numbers", kRandom},
    {"Movement", kMoves},
    {"The simulation engine", kEngine},
};

constexpr FunctionGroup kDeprecatedGroups[] = {
    {"Deprecated", kOld},
};

}  // namespace

std::span<const FunctionGroup> GeneralFunctionGroups() {
  return kGroups;
}

std::span<const FunctionGroup> DeprecatedFunctionGroups() {
  return kDeprecatedGroups;
}

}  // namespace tessal
