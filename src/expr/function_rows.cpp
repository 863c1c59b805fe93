#include "expr/function_rows.h"

#include <cmath>
#include <cstddef>
#include <limits>
#include <utility>

#include "expr/carbonate/constants.h"
#include "expr/carbonate/options.h"
#include "expr/carbonate/ph_scales.h"
#include "expr/carbonate/ph_solvers.h"
#include "expr/carbonate/sea_water.h"
#include "expr/carbonate/speciation.h"
#include "expr/carbonate/totals.h"
#include "expr/numeric/angles.h"
#include "expr/numeric/arithmetic.h"
#include "expr/numeric/calendar.h"
#include "expr/numeric/data_slots.h"
#include "expr/numeric/daylight.h"
#include "expr/numeric/engine_placeholders.h"
#include "expr/numeric/light.h"
#include "expr/numeric/movement.h"
#include "expr/numeric/oxygen.h"
#include "expr/numeric/random.h"
#include "expr/numeric/saturation_kinetics.h"
#include "expr/numeric/tables.h"
#include "expr/numeric/temperature_response.h"

namespace tessal {

namespace {

using OneArgument = double (*)(double);
using TwoArguments = double (*)(double, double);

/// Spreads the values over a function's arguments.
template <auto Function, typename... Arguments>
double CallWith(std::span<const double> values, double (* /*signature*/)(Arguments...)) {
  if (values.size() < sizeof...(Arguments)) return std::numeric_limits<double>::quiet_NaN();
  return [values]<std::size_t... Index>(std::index_sequence<Index...>) {
    return Function(values[Index]...);
  }
  (std::index_sequence_for<Arguments...>{});
}

/// The evaluator of an ordinary function. A name with overloads needs the wanted one:
/// `Of<OneArgument{std::sin}>`.
template <auto Function>
double Of(std::span<const double> values) {
  return CallWith<Function>(values, Function);
}

/// One species of the water that six arguments describe.
template <double Speciation::*Specie>
double SpecieOf(double ph, double dic, double alkalinity, double salinity, double temperature, double depth) {
  return SpeciationOf({.ph = ph,
                       .dic = dic,
                       .alkalinity = alkalinity,
                       .salinity = salinity,
                       .temperature = temperature,
                       .depth = depth}).*
         Specie;
}

// The names of the arguments are what messages show; some are no identifiers, some are misspelt, and stay so.
// MAX and MIN have each other's internal name, and each computes what the other is called. Row 138 lies where
// it was inserted. Functions without an evaluator are computed by the simulation engine alone.
// clang-format off
constexpr FunctionRow kRows[] = {
    // id, name, name in the engine, class, evaluator, arguments; traits
    {1, "ABS", "fabs", 1, Of<OneArgument{std::fabs}>, {"x"}},
    {2, "ARCCOS", "acos", 1, Of<OneArgument{std::acos}>, {"x"}, {.givesAngle = true}},
    {3, "ARCSIN", "asin", 1, Of<OneArgument{std::asin}>, {"x"}, {.givesAngle = true}},
    {4, "ARCTAN2", "atan2", 1, Of<TwoArguments{std::atan2}>,
     {"x", "y"}, {.givesAngle = true, .swapsArguments = true}},
    {5, "ARCTAN", "atan", 1, Of<OneArgument{std::atan}>, {"x"}, {.givesAngle = true}},
    {6, "COS", "cos", 1, Of<OneArgument{std::cos}>, {"x"}, {.takesAngle = true}},
    {7, "COSH", "cosh", 1, Of<OneArgument{std::cosh}>, {"x"}, {.takesAngle = true}},
    {8, "EXP", "exp", 1, Of<OneArgument{std::exp}>, {"x"}},
    {9, "LN", "log", 1, Of<OneArgument{std::log}>, {"x"}},
    {10, "LOG10", "log10", 1, Of<OneArgument{std::log10}>, {"x"}},
    {11, "MAX", "_min", 1, Of<CatalogueMax>, {"x", "y"}},
    {12, "MIN", "_max", 1, Of<CatalogueMin>, {"x", "y"}},
    {13, "POW", "pow", 1, Of<TwoArguments{std::pow}>, {"x", "y"}},
    {14, "SIN", "sin", 1, Of<OneArgument{std::sin}>, {"x"}, {.takesAngle = true}},
    {15, "SINH", "sinh", 1, Of<OneArgument{std::sinh}>, {"x"}, {.takesAngle = true}},
    {16, "SQR", "sqr", 1, Of<Square>, {"x"}},
    {17, "SQRT", "sqrt", 1, Of<OneArgument{std::sqrt}>, {"x"}},
    {18, "TAN", "tan", 1, Of<OneArgument{std::tan}>, {"x"}, {.takesAngle = true}},
    {19, "TANH", "tanh", 1, Of<OneArgument{std::tanh}>, {"x"}, {.takesAngle = true}},
    {20, "DAYNUMBER", "DayNumber", 2, Of<DayNumber>, {"YEAR", "MONTH", "DAY"}},
    {21, "f1", "FORTRANMODULE_mp_f1", 2, nullptr, {"p1"}, {.isDeprecated = true}},
    {22, "x", "PIx", 2, nullptr, {}, {.isDeprecated = true}},
    {23, "ARRHENIUS20", "Arhenius20", 2, Of<Arrhenius20>, {"Temperature_Coefficient", "Temperature"}},
    {24, "OXYGENSATURATION", "OxygenSaturation", 2, Of<OxygenSaturation>, {"Salinity", "Temperature"}},
    {25, "ARRHENIUS5", "Arhenius5", 2, Of<Arrhenius5>, {"Temperature_Coefficient", "Temperature"}},
    {26, "LASSITER", "Lassiter", 2, Of<Lassiter>,
     {"Lassiter_Constant", "Growth_Rate_Mabce", "Growth_Optimum_Temperature",
      "Growth_Inhibition_Temperature", "Temperature"}},
    {27, "MICHAELIS_MENTEN1", "MichaelisMenten1", 2, Of<MichaelisMenten1>,
     {"Concentration", "Halfsaturation_Constant"}},
    {28, "MICHAELIS_MENTEN2", "MichaelisMenten2", 2, Of<MichaelisMenten2>, {"Concentration", "Constant"}},
    {29, "REVERSE_MICHAELIS_MENTEN", "ReverseMichaelisMenten", 2, Of<ReverseMichaelisMenten>,
     {"Concentration"}},
    {30, "SUNRISE", "Sunrise", 2, Of<Sunrise>,
     {"YEAR", "MONTH", "DAY", "Latitude", "Summertime_Correction_In_Hours"}},
    {31, "SUNSET", "Sunset", 2, Of<Sunset>,
     {"YEAR", "MONTH", "DAY", "Latitude", "Summertime_Correction_In_Hours"}},
    {32, "SECOND", "Second", 3, Of<SecondOf>, {"Time"}},
    {33, "MINUTE", "Minute", 3, Of<MinuteOf>, {"Time"}},
    {34, "HOUR", "Hour", 3, Of<HourOf>, {"Time"}},
    {35, "DAY", "Day", 3, Of<DayOf>, {"Time"}},
    {36, "MONTH", "Month", 3, Of<MonthOf>, {"Time"}},
    {37, "YEAR", "Year", 3, Of<YearOf>, {"Time"}},
    {38, "LAMBERT_BEER_1", "LambertBeer1", 2, Of<LightBelowLayer>,
     {"Surface_Light", "Layer_Height", "Light_Extinction_Coefficient"}},
    {39, "LAMBERT_BEER_2", "LambertBeer2", 2, Of<LightBelowLayer>,
     {"Surface_Light", "Layer_Height", "Light_Extinction_Coefficient"}},
    {40, "OXYGENSATURATION_WEISS", "OxygenSaturation_Weiss", 2, Of<OxygenSaturationWeiss>,
     {"Salinity", "Temperature"}},
    {41, "RELATIVE_DAYLENGTH", "RelativeDaylength", 2, Of<RelativeDayLength>,
     {"YEAR", "MONTH", "DAY", "Latitude"}},
    {42, "PI", "PI", 2, Of<Pi>, {}},
    {43, "EXCEEDANCE_FREQUENCY", "ExceedFreq", 2, Of<ExceedanceFrequency>,
     {"ntrue", "ntota"}, {.isDeprecated = true}},
    {44, "ANUTRC11", "Anutrc11", 2, nullptr,
     {"nutr", "kadnutr", "ptam", "pc1", "cn11", "cn12", "cn13"}, {.isDeprecated = true}},
    {45, "ANUTRC12", "Anutrc12", 2, nullptr,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "cn11", "cn12", "cn13", "cn21", "cn22",
      "cn23"}, {.isDeprecated = true}},
    {46, "ANUTRC22", "Anutrc22", 2, nullptr,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "cn11", "cn12", "cn13", "cn21", "cn22",
      "cn23"}, {.isDeprecated = true}},
    {47, "ANUTRC13", "Anutrc13", 2, nullptr,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "pc3", "cn11", "cn12", "cn13", "cn21", "cn22", "cn23", "cn31",
      "cn32", "cn33"}, {.isDeprecated = true}},
    {48, "ANUTRC23", "Anutrc23", 2, nullptr,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "pc3", "cn11", "cn12", "cn13", "cn21", "cn22", "cn23", "cn31",
      "cn32", "cn33"}, {.isDeprecated = true}},
    {49, "ANUTRC33", "Anutrc33", 2, nullptr,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "pc3", "cn11", "cn12", "cn13", "cn21", "cn22", "cn23", "cn31",
      "cn32", "cn33"}, {.isDeprecated = true}},
    {50, "RAND", "RandomNumber", 2, Of<UniformDeviate>, {}, {.drawsRandomNumbers = true}},
    {51, "U_RAND", "U_Rand", 2, Of<UniformDeviate>, {}, {.drawsRandomNumbers = true}},
    {52, "U_RAND2", "U_Rand2", 2, Of<UniformDeviateBetween>, {"Min", "Max"}, {.drawsRandomNumbers = true}},
    {53, "N_RAND", "N_Rand", 2, Of<NormalDeviate>, {}, {.drawsRandomNumbers = true}},
    {54, "N_RAND2", "N_Rand2", 2, Of<NormalDeviateOf>, {"Mean", "Variance"}, {.drawsRandomNumbers = true}},
    {55, "E_RAND", "E_Rand", 2, Of<ExponentialDeviate>, {}, {.drawsRandomNumbers = true}},
    {56, "P_RAND", "P_Rand", 2, Of<PoissonDeviate>, {"Mean"}, {.drawsRandomNumbers = true}},
    {57, "G_RAND", "G_Rand", 2, Of<GammaDeviate>, {"nth_event"}, {.drawsRandomNumbers = true}},
    {58, "B_RAND", "B_Rand", 2, Of<BinomialDeviate>, {"Propability", "Events"}, {.drawsRandomNumbers = true}},
    {59, "GETX", "GetX", 2, Of<CosineComponent>, {"Speed", "Direction"}},
    {60, "GETY", "GetY", 2, Of<SineComponent>, {"Speed", "Direction"}},
    {61, "GETDISTANCE", "GetDistance", 2, Of<Distance>, {"X1", "Y1", "Z1", "X2", "Y2", "Z2"}},
    {62, "GETANGLE", "GetAngle", 2, Of<Bearing>, {"X1", "Y1", "X2", "Y2"}},
    {63, "RESULTINGSPEED", "ResultingSpeed", 2, Of<ResultingSpeed>,
     {"Speed1", "Direction1", "Speed2", "Direction2"}},
    {64, "RESULTINGDIRECTION", "ResultingDirection", 2, Of<ResultingDirection>,
     {"Speed1", "Direction1", "Speed2", "Direction2"}},
    {65, "ANGLEBETWEEN", "AngleBetween", 2, Of<AngleBetween>,
     {"Speed1", "Direction1", "Speed2", "Direction2"}},
    {66, "TESTHITSTATE", "TestHitstate", 2, Of<TestHitState>, {"Testvalue", "Conditions"}},
    {67, "MOD", "Mod", 2, Of<Remainder>, {"value", "divisor"}},
    {68, "SECCHI_DEPTH", "SECCHI_DETPH_func", 4, nullptr,
     {"Light extinction coefficient", "Damping_percentage"}, {.needsEngine = true}},
    {69, "AVERAGE_WATER_COLUMN", "AVERAGE_WATER_COLUMN_func", 5, nullptr,
     {"State variable"}, {.needsEngine = true}},
    {70, "SMOOTHING_AVERAGE", "SMOOTHING_AVERAGE_func", 6, nullptr,
     {"State variable", "weight alpha"}, {.needsEngine = true}},
    {71, "MOVING_AVERAGE", "MOVING_AVERAGE_func", 7, nullptr,
     {"State variable", "timesteps"}, {.needsEngine = true}},
    {72, "DISTANCE_TO", "Distance_to", 1, nullptr, {"X", "Y", "Z"}, {.needsEngine = true}},
    {73, "INSIDE", "Inside", 1, nullptr, {"X1", "Y1", "Z1", "X2", "Y2", "Z2"}, {.needsEngine = true}},
    {74, "FLOOR", "floor", 2, Of<OneArgument{std::floor}>, {"x"}},
    {75, "CEIL", "ceil", 2, Of<OneArgument{std::ceil}>, {"x"}},
    {76, "DEG2RAD", "deg2rad", 1, Of<DegreesToRadians>, {"degree"}},
    {77, "RAD2DEG", "rad2deg", 1, Of<RadiansToDegrees>, {"radians"}},
    {78, "SAVE", "Save", 2, Of<SaveInSlot>, {"data_slot", "value"}, {.keepsState = true}},
    {79, "LOAD", "Load", 2, Of<LoadFromSlot>, {"data_slot"}, {.keepsState = true}},
    {80, "TERMINATE", "Terminate", 1, WithoutEngine, {}, {.needsEngine = true}},
    {81, "_GET_LAYER", "Get_Layer", 1, WithoutEngine, {}, {.needsEngine = true}},
    {82, "_GET_ELEMENT", "Get_Element", 1, WithoutEngine, {}, {.needsEngine = true}},
    {83, "_GET_ID", "Get_ID", 2, WithoutEngine, {"ID"}, {.needsEngine = true}},
    {84, "SET_RADIUS", "SetRadius", 1, Of<SetRadius>, {"RASF ID", "radius"}, {.needsEngine = true}},
    {85, "SET_PROJECTION", "SetProjectionTime", 1, WithoutEngine, {"seconds"}, {.needsEngine = true}},
    {86, "SET_FOV", "SetFieldOfView", 1, WithoutEngine, {"degrees"}, {.needsEngine = true}},
    {87, "_GET_ENGINESTATE", "Get_EngineState", 1, WithoutEngine, {"StateID"}, {.needsEngine = true}},
    {88, "_SET_ENGINESTATE", "Set_EngineState", 1, WithoutEngine,
     {"StateID", "Value"}, {.needsEngine = true}},
    {89, "_CALC_PH", "CalcpH", 2, Of<CalculatePhSimply>,
     {"DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {90, "_GET_K1", "fK1", 2, nullptr, {"Salinity", "Temperature"}},
    {91, "_GET_K2", "fK2", 2, nullptr, {"Salinity", "Temperature"}},
    {92, "PEEK", "Peek", 2, Of<PeekAtSlot>, {"data_slot"}, {.keepsState = true}},
    {93, "PER_DAY", "Per_Day", 2, Of<StepsPerDay>, {"Timestep"}},
    {94, "TABLE_INDEX", "Table_Index", 2, Of<TableIndex>, {"Value", "A", "B", "C", "D", "E"}},
    {95, "TABLE_VALUE", "Table_Value", 2, Of<TableValue>, {"Index", "A", "B", "C", "D", "E"}},
    {96, "GET_WATER_DENSITY", "WaterDensity", 2, Of<WaterDensity>, {"Salinity", "Temperature"}},
    {97, "GET_DEPTH_PRESSURE", "DepthToPressure", 2, Of<DepthToPressure>,
     {"Depth", "Salinity", "Temperature"}},
    {98, "CONVERT_PH", "ConvertpH", 2, Of<ConvertPh>,
     {"pH", "Salinity", "Temperature", "Scale_in", "Scale_out"}},
    {99, "SETGET_SPECIE", "SetGetSpecie", 2, Of<SetGetSpecie>, {"SpecieID", "Value"}},
    {100, "SET_SPECIES", "SetSpecies", 2, Of<SetSpecies>, {"TB", "TF", "TS", "TP", "TSi"}},
    {101, "SET_SPECIE_FACTORS", "SetSpeciesConversionFactor", 2, Of<SetSpeciesFactors>,
     {"fTB", "fTF", "fTS", "fTP", "fTSi"}},
    {138, "SET_DICALK_FACTORS", "SetDICALKConversionFactors", 2, Of<SetDicAlkFactors>, {"fDIC", "fALK"}},
    {102, "SET_K_OPTION", "SetKOption", 2, Of<SetKOption>, {"Option (1-14)"}},
    {103, "SET_K1K2_OPTION", "SetK1K2Option", 2, Of<SetK1K2Option>, {"Option (1-14)"}},
    {104, "SET_KW_OPTION", "SetKWOption", 2, Of<SetKWOption>, {"Option (1-14)"}},
    {105, "SET_KB_OPTION", "SetKBOption", 2, Of<SetKBOption>, {"Option (1-14)"}},
    {106, "SET_KS_OPTION", "SetKSOption", 2, Of<SetKSOption>, {"Option (1-2)"}},
    {107, "SET_FH_OPTION", "SetfHOption", 2, Of<SetFHOption>, {"Option (1-14)"}},
    {108, "GET_KO", "fK0", 2, Of<GetK0>, {"Salinity", "Temperature"}},
    {109, "GET_K1", "fK1", 2, Of<GetK1>, {"Salinity", "Temperature"}},
    {110, "GET_K2", "fK2", 2, Of<GetK2>, {"Salinity", "Temperature"}},
    {111, "GET_KB", "fKB", 2, Of<GetKB>, {"Salinity", "Temperature"}},
    {112, "GET_KW", "fKW", 2, Of<GetKW>, {"Salinity", "Temperature"}},
    {113, "GET_KP1", "fKP1", 2, Of<GetKP1>, {"Salinity", "Temperature"}},
    {114, "GET_KP2", "fKP2", 2, Of<GetKP2>, {"Salinity", "Temperature"}},
    {115, "GET_KP3", "fKP3", 2, Of<GetKP3>, {"Salinity", "Temperature"}},
    {116, "GET_KSI", "fKSi", 2, Of<GetKSi>, {"Salinity", "Temperature"}},
    {117, "GET_KF", "fKF", 2, Of<GetKF>, {"Salinity", "Temperature"}},
    {118, "GET_KS", "fKS", 2, Of<GetKS>, {"Salinity", "Temperature"}},
    {119, "SET_B_OPTION", "SetTBOption", 2, Of<SetTBOption>, {"Option (1-4)"}},
    {120, "GET_TB", "ftBor", 2, Of<GetTotalBoron>, {"Salinity"}},
    {121, "GET_TF", "ftF", 2, Of<GetTotalFluoride>, {"Salinity"}},
    {122, "GET_TS", "ftS", 2, Of<GetTotalSulphate>, {"Salinity"}},
    {123, "CALC_PH", "CalcpH_CO2SYS", 2, Of<CalculatePh>,
     {"DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {124, "GET_OH", "Get_OH", 2, Of<SpecieOf<&Speciation::hydroxide>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {125, "GET_HCO3", "Get_HCO3", 2, Of<SpecieOf<&Speciation::bicarbonate>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {126, "GET_CO3", "Get_CO3", 2, Of<SpecieOf<&Speciation::carbonate>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {127, "GET_CO2", "Get_CO2", 2, Of<SpecieOf<&Speciation::carbonDioxide>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {128, "GET_FCO2", "Get_fCO2", 2, Of<SpecieOf<&Speciation::fugacity>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {129, "GET_DIC_EST", "Get_DIC_estimate", 2, Of<SpecieOf<&Speciation::dicEstimate>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {130, "GET_ALK_EST", "Get_ALK_estimate", 2, Of<SpecieOf<&Speciation::alkalinityEstimate>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {131, "GET_CALK", "Get_CALK", 2, Of<SpecieOf<&Speciation::carbonateAlkalinity>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {132, "GET_BALK", "Get_BALK", 2, Of<SpecieOf<&Speciation::borateAlkalinity>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {133, "GET_SIALK", "Get_SiALK", 2, Of<SpecieOf<&Speciation::silicateAlkalinity>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {134, "GET_PALK", "Get_PALK", 2, Of<SpecieOf<&Speciation::phosphateAlkalinity>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {135, "GET_HF", "Get_HF", 2, Of<SpecieOf<&Speciation::hydrogenFluoride>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {136, "GET_HFREE", "Get_HFree", 2, Of<SpecieOf<&Speciation::freeHydrogen>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {137, "GET_HSO4", "Get_HSO4", 2, Of<SpecieOf<&Speciation::bisulphate>>,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {139, "LAMBERT_BEER_AVR", "LambertBeerAvr", 2, Of<MeanLightInLayer>,
     {"Surface_Light", "Depth", "Light_Extinction_Coefficient"}},
    {140, "SIGN", "Sign", 1, Of<Sign>, {"x"}},
    {141, "MOONPHASE", "MoonPhase", 2, Of<MoonPhase>, {"Year", "Month", "Day", "Hour", "Minute", "Second"}},
};
// clang-format on

}  // namespace

std::span<const FunctionRow> FunctionRows() {
  return kRows;
}

}  // namespace tessal
