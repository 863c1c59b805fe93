#include "expr/function_catalogue.h"

#include <algorithm>
#include <unordered_map>

#include "expr/carbonate/options.h"
#include "expr/evaluators.h"
#include "expr/numeric/data_slots.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr std::size_t kMostArguments = 15;

struct FunctionRow {
  std::int32_t id;
  std::string_view name;
  std::string_view internalName;  ///< the function's name in the simulation engine
  std::int32_t functionClass;
  std::int32_t firstFlag;
  std::int32_t variant;
  std::array<std::string_view, kMostArguments> arguments;
};

// The names of the arguments are what messages show; some are no identifiers, some are misspelt, and stay so.
// MAX and MIN have each other's internal name. Row 138 stands where it was inserted.
constexpr FunctionRow kRows[] = {
    {1, "ABS", "fabs", 1, 1, 0, {"x"}},
    {2, "ARCCOS", "acos", 1, 1, 0, {"x"}},
    {3, "ARCSIN", "asin", 1, 1, 0, {"x"}},
    {4, "ARCTAN2", "atan2", 1, 1, 0, {"x", "y"}},
    {5, "ARCTAN", "atan", 1, 1, 0, {"x"}},
    {6, "COS", "cos", 1, 1, 0, {"x"}},
    {7, "COSH", "cosh", 1, 1, 0, {"x"}},
    {8, "EXP", "exp", 1, 1, 0, {"x"}},
    {9, "LN", "log", 1, 1, 0, {"x"}},
    {10, "LOG10", "log10", 1, 1, 0, {"x"}},
    {11, "MAX", "_min", 1, 1, 0, {"x", "y"}},
    {12, "MIN", "_max", 1, 1, 0, {"x", "y"}},
    {13, "POW", "pow", 1, 1, 0, {"x", "y"}},
    {14, "SIN", "sin", 1, 1, 0, {"x"}},
    {15, "SINH", "sinh", 1, 1, 0, {"x"}},
    {16, "SQR", "sqr", 1, 1, 0, {"x"}},
    {17, "SQRT", "sqrt", 1, 1, 0, {"x"}},
    {18, "TAN", "tan", 1, 1, 0, {"x"}},
    {19, "TANH", "tanh", 1, 1, 0, {"x"}},
    {20, "DAYNUMBER", "DayNumber", 2, 1, 0, {"YEAR", "MONTH", "DAY"}},
    {21, "f1", "FORTRANMODULE_mp_f1", 2, 1, 0, {"p1"}},
    {22, "x", "PIx", 2, 1, 0, {}},
    {23, "ARRHENIUS20", "Arhenius20", 2, 1, 0, {"Temperature_Coefficient", "Temperature"}},
    {24, "OXYGENSATURATION", "OxygenSaturation", 2, 1, 0, {"Salinity", "Temperature"}},
    {25, "ARRHENIUS5", "Arhenius5", 2, 1, 0, {"Temperature_Coefficient", "Temperature"}},
    {26,
     "LASSITER",
     "Lassiter",
     2,
     1,
     0,
     {"Lassiter_Constant", "Growth_Rate_Mabce", "Growth_Optimum_Temperature", "Growth_Inhibition_Temperature",
      "Temperature"}},
    {27, "MICHAELIS_MENTEN1", "MichaelisMenten1", 2, 1, 0, {"Concentration", "Halfsaturation_Constant"}},
    {28, "MICHAELIS_MENTEN2", "MichaelisMenten2", 2, 1, 0, {"Concentration", "Constant"}},
    {29, "REVERSE_MICHAELIS_MENTEN", "ReverseMichaelisMenten", 2, 1, 0, {"Concentration"}},
    {30,
     "SUNRISE",
     "Sunrise",
     2,
     1,
     0,
     {"YEAR", "MONTH", "DAY", "Latitude", "Summertime_Correction_In_Hours"}},
    {31, "SUNSET", "Sunset", 2, 1, 0, {"YEAR", "MONTH", "DAY", "Latitude", "Summertime_Correction_In_Hours"}},
    {32, "SECOND", "Second", 3, 1, 0, {"Time"}},
    {33, "MINUTE", "Minute", 3, 1, 0, {"Time"}},
    {34, "HOUR", "Hour", 3, 1, 0, {"Time"}},
    {35, "DAY", "Day", 3, 1, 0, {"Time"}},
    {36, "MONTH", "Month", 3, 1, 0, {"Time"}},
    {37, "YEAR", "Year", 3, 1, 0, {"Time"}},
    {38,
     "LAMBERT_BEER_1",
     "LambertBeer1",
     2,
     3,
     1,
     {"Surface_Light", "Layer_Height", "Light_Extinction_Coefficient"}},
    {39,
     "LAMBERT_BEER_2",
     "LambertBeer2",
     2,
     3,
     2,
     {"Surface_Light", "Layer_Height", "Light_Extinction_Coefficient"}},
    {40, "OXYGENSATURATION_WEISS", "OxygenSaturation_Weiss", 2, 1, 0, {"Salinity", "Temperature"}},
    {41, "RELATIVE_DAYLENGTH", "RelativeDaylength", 2, 1, 0, {"YEAR", "MONTH", "DAY", "Latitude"}},
    {42, "PI", "PI", 2, 1, 0, {}},
    {43, "EXCEEDANCE_FREQUENCY", "ExceedFreq", 2, 1, 0, {"ntrue", "ntota"}},
    {44, "ANUTRC11", "Anutrc11", 2, 1, 0, {"nutr", "kadnutr", "ptam", "pc1", "cn11", "cn12", "cn13"}},
    {45,
     "ANUTRC12",
     "Anutrc12",
     2,
     1,
     0,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "cn11", "cn12", "cn13", "cn21", "cn22", "cn23"}},
    {46,
     "ANUTRC22",
     "Anutrc22",
     2,
     1,
     0,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "cn11", "cn12", "cn13", "cn21", "cn22", "cn23"}},
    {47,
     "ANUTRC13",
     "Anutrc13",
     2,
     1,
     0,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "pc3", "cn11", "cn12", "cn13", "cn21", "cn22", "cn23", "cn31",
      "cn32", "cn33"}},
    {48,
     "ANUTRC23",
     "Anutrc23",
     2,
     1,
     0,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "pc3", "cn11", "cn12", "cn13", "cn21", "cn22", "cn23", "cn31",
      "cn32", "cn33"}},
    {49,
     "ANUTRC33",
     "Anutrc33",
     2,
     1,
     0,
     {"nutr", "kadnutr", "ptam", "pc1", "pc2", "pc3", "cn11", "cn12", "cn13", "cn21", "cn22", "cn23", "cn31",
      "cn32", "cn33"}},
    {50, "RAND", "RandomNumber", 2, 1, 0, {}},
    {51, "U_RAND", "U_Rand", 2, 1, 0, {}},
    {52, "U_RAND2", "U_Rand2", 2, 1, 0, {"Min", "Max"}},
    {53, "N_RAND", "N_Rand", 2, 1, 0, {}},
    {54, "N_RAND2", "N_Rand2", 2, 1, 0, {"Mean", "Variance"}},
    {55, "E_RAND", "E_Rand", 2, 1, 0, {}},
    {56, "P_RAND", "P_Rand", 2, 1, 0, {"Mean"}},
    {57, "G_RAND", "G_Rand", 2, 1, 0, {"nth_event"}},
    {58, "B_RAND", "B_Rand", 2, 1, 0, {"Propability", "Events"}},
    {59, "GETX", "GetX", 2, 1, 0, {"Speed", "Direction"}},
    {60, "GETY", "GetY", 2, 1, 0, {"Speed", "Direction"}},
    {61, "GETDISTANCE", "GetDistance", 2, 1, 0, {"X1", "Y1", "Z1", "X2", "Y2", "Z2"}},
    {62, "GETANGLE", "GetAngle", 2, 1, 0, {"X1", "Y1", "X2", "Y2"}},
    {63, "RESULTINGSPEED", "ResultingSpeed", 2, 1, 0, {"Speed1", "Direction1", "Speed2", "Direction2"}},
    {64,
     "RESULTINGDIRECTION",
     "ResultingDirection",
     2,
     1,
     0,
     {"Speed1", "Direction1", "Speed2", "Direction2"}},
    {65, "ANGLEBETWEEN", "AngleBetween", 2, 1, 0, {"Speed1", "Direction1", "Speed2", "Direction2"}},
    {66, "TESTHITSTATE", "TestHitstate", 2, 1, 0, {"Testvalue", "Conditions"}},
    {67, "MOD", "Mod", 2, 1, 0, {"value", "divisor"}},
    {68,
     "SECCHI_DEPTH",
     "SECCHI_DETPH_func",
     4,
     1,
     0,
     {"Light extinction coefficient", "Damping_percentage"}},
    {69, "AVERAGE_WATER_COLUMN", "AVERAGE_WATER_COLUMN_func", 5, 1, 0, {"State variable"}},
    {70, "SMOOTHING_AVERAGE", "SMOOTHING_AVERAGE_func", 6, 1, 0, {"State variable", "weight alpha"}},
    {71, "MOVING_AVERAGE", "MOVING_AVERAGE_func", 7, 1, 0, {"State variable", "timesteps"}},
    {72, "DISTANCE_TO", "Distance_to", 1, 1, 0, {"X", "Y", "Z"}},
    {73, "INSIDE", "Inside", 1, 1, 0, {"X1", "Y1", "Z1", "X2", "Y2", "Z2"}},
    {74, "FLOOR", "floor", 2, 1, 0, {"x"}},
    {75, "CEIL", "ceil", 2, 1, 0, {"x"}},
    {76, "DEG2RAD", "deg2rad", 1, 1, 0, {"degree"}},
    {77, "RAD2DEG", "rad2deg", 1, 1, 0, {"radians"}},
    {78, "SAVE", "Save", 2, 1, 0, {"data_slot", "value"}},
    {79, "LOAD", "Load", 2, 1, 0, {"data_slot"}},
    {80, "TERMINATE", "Terminate", 1, 1, 0, {}},
    {81, "_GET_LAYER", "Get_Layer", 1, 1, 0, {}},
    {82, "_GET_ELEMENT", "Get_Element", 1, 1, 0, {}},
    {83, "_GET_ID", "Get_ID", 2, 1, 0, {"ID"}},
    {84, "SET_RADIUS", "SetRadius", 1, 1, 0, {"RASF ID", "radius"}},
    {85, "SET_PROJECTION", "SetProjectionTime", 1, 1, 0, {"seconds"}},
    {86, "SET_FOV", "SetFieldOfView", 1, 1, 0, {"degrees"}},
    {87, "_GET_ENGINESTATE", "Get_EngineState", 1, 1, 0, {"StateID"}},
    {88, "_SET_ENGINESTATE", "Set_EngineState", 1, 1, 0, {"StateID", "Value"}},
    {89, "_CALC_PH", "CalcpH", 2, 1, 0, {"DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {90, "_GET_K1", "fK1", 2, 1, 0, {"Salinity", "Temperature"}},
    {91, "_GET_K2", "fK2", 2, 1, 0, {"Salinity", "Temperature"}},
    {92, "PEEK", "Peek", 2, 1, 0, {"data_slot"}},
    {93, "PER_DAY", "Per_Day", 2, 1, 0, {"Timestep"}},
    {94, "TABLE_INDEX", "Table_Index", 2, 1, 0, {"Value", "A", "B", "C", "D", "E"}},
    {95, "TABLE_VALUE", "Table_Value", 2, 1, 0, {"Index", "A", "B", "C", "D", "E"}},
    {96, "GET_WATER_DENSITY", "WaterDensity", 2, 1, 0, {"Salinity", "Temperature"}},
    {97, "GET_DEPTH_PRESSURE", "DepthToPressure", 2, 1, 0, {"Depth", "Salinity", "Temperature"}},
    {98, "CONVERT_PH", "ConvertpH", 2, 1, 0, {"pH", "Salinity", "Temperature", "Scale_in", "Scale_out"}},
    {99, "SETGET_SPECIE", "SetGetSpecie", 2, 1, 0, {"SpecieID", "Value"}},
    {100, "SET_SPECIES", "SetSpecies", 2, 1, 0, {"TB", "TF", "TS", "TP", "TSi"}},
    {101, "SET_SPECIE_FACTORS", "SetSpeciesConversionFactor", 2, 1, 0, {"fTB", "fTF", "fTS", "fTP", "fTSi"}},
    {138, "SET_DICALK_FACTORS", "SetDICALKConversionFactors", 2, 1, 0, {"fDIC", "fALK"}},
    {102, "SET_K_OPTION", "SetKOption", 2, 1, 0, {"Option (1-14)"}},
    {103, "SET_K1K2_OPTION", "SetK1K2Option", 2, 1, 0, {"Option (1-14)"}},
    {104, "SET_KW_OPTION", "SetKWOption", 2, 1, 0, {"Option (1-14)"}},
    {105, "SET_KB_OPTION", "SetKBOption", 2, 1, 0, {"Option (1-14)"}},
    {106, "SET_KS_OPTION", "SetKSOption", 2, 1, 0, {"Option (1-2)"}},
    {107, "SET_FH_OPTION", "SetfHOption", 2, 1, 0, {"Option (1-14)"}},
    {108, "GET_KO", "fK0", 2, 1, 0, {"Salinity", "Temperature"}},
    {109, "GET_K1", "fK1", 2, 1, 0, {"Salinity", "Temperature"}},
    {110, "GET_K2", "fK2", 2, 1, 0, {"Salinity", "Temperature"}},
    {111, "GET_KB", "fKB", 2, 1, 0, {"Salinity", "Temperature"}},
    {112, "GET_KW", "fKW", 2, 1, 0, {"Salinity", "Temperature"}},
    {113, "GET_KP1", "fKP1", 2, 1, 0, {"Salinity", "Temperature"}},
    {114, "GET_KP2", "fKP2", 2, 1, 0, {"Salinity", "Temperature"}},
    {115, "GET_KP3", "fKP3", 2, 1, 0, {"Salinity", "Temperature"}},
    {116, "GET_KSI", "fKSi", 2, 1, 0, {"Salinity", "Temperature"}},
    {117, "GET_KF", "fKF", 2, 1, 0, {"Salinity", "Temperature"}},
    {118, "GET_KS", "fKS", 2, 1, 0, {"Salinity", "Temperature"}},
    {119, "SET_B_OPTION", "SetTBOption", 2, 1, 0, {"Option (1-4)"}},
    {120, "GET_TB", "ftBor", 2, 1, 0, {"Salinity"}},
    {121, "GET_TF", "ftF", 2, 1, 0, {"Salinity"}},
    {122, "GET_TS", "ftS", 2, 1, 0, {"Salinity"}},
    {123, "CALC_PH", "CalcpH_CO2SYS", 2, 1, 0, {"DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {124, "GET_OH", "Get_OH", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {125, "GET_HCO3", "Get_HCO3", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {126, "GET_CO3", "Get_CO3", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {127, "GET_CO2", "Get_CO2", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {128, "GET_FCO2", "Get_fCO2", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {129,
     "GET_DIC_EST",
     "Get_DIC_estimate",
     2,
     1,
     0,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {130,
     "GET_ALK_EST",
     "Get_ALK_estimate",
     2,
     1,
     0,
     {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {131, "GET_CALK", "Get_CALK", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {132, "GET_BALK", "Get_BALK", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {133, "GET_SIALK", "Get_SiALK", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {134, "GET_PALK", "Get_PALK", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {135, "GET_HF", "Get_HF", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {136, "GET_HFREE", "Get_HFree", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {137, "GET_HSO4", "Get_HSO4", 2, 1, 0, {"pH", "DIC", "Alkalinity", "Salinity", "Temperature", "Depth"}},
    {139,
     "LAMBERT_BEER_AVR",
     "LambertBeerAvr",
     2,
     1,
     0,
     {"Surface_Light", "Depth", "Light_Extinction_Coefficient"}},
    {140, "SIGN", "Sign", 1, 1, 0, {"x"}},
    {141, "MOONPHASE", "MoonPhase", 2, 1, 0, {"Year", "Month", "Day", "Hour", "Minute", "Second"}},
};

constexpr std::array<CatalogueGroup, 2> kGroups = {{{"Mathematica", 1}, {"Some other group", 2}}};

struct DeprecatedRow {
  std::int32_t id;
  std::int32_t reason;
};

constexpr std::array<DeprecatedRow, 9> kDeprecated = {
    {{21, 1}, {22, 1}, {43, 1}, {44, 4}, {45, 4}, {46, 4}, {47, 4}, {48, 4}, {49, 4}}};

constexpr std::string_view kOptionFile = "TESSALpH.set";

CatalogueFunction MakeFunction(const FunctionRow& row) {
  CatalogueFunction function;
  function.name = UpperCase(row.name);
  function.id = row.id;
  function.functionClass = row.functionClass;
  function.firstFlag = row.firstFlag;
  function.argumentCount = static_cast<std::int32_t>(std::count_if(
      row.arguments.begin(), row.arguments.end(), [](std::string_view name) { return !name.empty(); }));
  function.variant = row.variant;
  // Set-up overwrites the engine's name with the catalogue's own.
  function.internalName = function.name;
  return function;
}

/// The catalogue of the process, and how many templates use it.
struct Catalogue {
  Catalogue() {
    for (const FunctionRow& row : kRows) {
      functions.push_back(MakeFunction(row));
      for (std::int32_t position = 1; position <= functions.back().argumentCount; ++position) {
        arguments.push_back({row.id, position, row.arguments[static_cast<std::size_t>(position - 1)]});
      }
    }
    // Behind the last insertion, so that the keys stay where they are.
    for (std::size_t place = 0; place < functions.size(); ++place)
      byName.emplace(functions[place].name, place);
  }

  std::vector<CatalogueFunction> functions;
  std::vector<CatalogueArgument> arguments;
  std::unordered_map<std::string_view, std::size_t> byName;  ///< the first row of each name
  int users = 0;
};

Catalogue& TheCatalogue() {
  static Catalogue catalogue;
  return catalogue;
}

const CatalogueFunction* FindExact(std::string_view upperName) {
  const Catalogue& catalogue = TheCatalogue();
  const auto hit = catalogue.byName.find(upperName);
  return hit == catalogue.byName.end() ? nullptr : &catalogue.functions[hit->second];
}

void SetEvaluators(std::vector<CatalogueFunction>& functions) {
  for (const EvaluatorRow& row : Evaluators()) {
    const auto hit =
        std::find_if(functions.begin(), functions.end(),
                     [&row](const CatalogueFunction& function) { return function.name == row.name; });
    if (hit != functions.end()) hit->evaluator = row.evaluator;
  }
}

}  // namespace

void InitCatalogues() {
  Catalogue& catalogue = TheCatalogue();
  if (catalogue.users++ > 0) return;
  ClearDataSlots();
  SetCarbonateDefaults();
  ReadOptionFile(std::string(kOptionFile));
  SetEvaluators(catalogue.functions);
}

void ReleaseCatalogues() {
  Catalogue& catalogue = TheCatalogue();
  if (catalogue.users > 0 && --catalogue.users == 0) ReleaseCarbonate();
}

const std::vector<CatalogueFunction>& Functions() {
  return TheCatalogue().functions;
}

const std::vector<CatalogueArgument>& Arguments() {
  return TheCatalogue().arguments;
}

const std::array<CatalogueGroup, 2>& Groups() {
  return kGroups;
}

const CatalogueFunction* FindFunction(std::string_view name) {
  return FindExact(UpperCase(name));
}

int FindFunctionUpper(std::string_view name, std::string& internalName, std::int32_t& argumentCount,
                      std::int32_t& functionClass, std::int32_t& id) {
  const CatalogueFunction* function = FindFunction(name);
  if (function == nullptr) return 0;
  internalName = function->internalName;
  argumentCount = function->argumentCount;
  functionClass = function->functionClass;
  id = function->id;
  return 1;
}

std::uint32_t GetFunctionById(std::int32_t id, CatalogueFunction& record) {
  const auto& functions = Functions();
  const auto hit = std::find_if(functions.begin(), functions.end(),
                                [id](const CatalogueFunction& function) { return function.id == id; });
  if (hit == functions.end()) return kCatalogueNotFound;
  record = *hit;
  return 0;
}

std::uint32_t GetArgumentName(std::int32_t functionId, std::int32_t position, std::string& name) {
  const auto& arguments = Arguments();
  const auto hit = std::find_if(arguments.begin(), arguments.end(),
                                [functionId, position](const CatalogueArgument& argument) {
                                  return argument.functionId == functionId && argument.position == position;
                                });
  if (hit == arguments.end()) return kCatalogueNotFound;
  name = hit->name;
  return 0;
}

std::int32_t FunctionIdByName(std::string_view upperName) {
  const CatalogueFunction* function = FindExact(upperName);
  return function == nullptr ? -1 : function->id;
}

bool IsFunctionName(std::string& name) {
  name = UpperCase(name);
  return FindExact(name) != nullptr;
}

bool IsDeprecatedFunction(std::int32_t id) {
  return std::any_of(kDeprecated.begin(), kDeprecated.end(),
                     [id](const DeprecatedRow& row) { return row.id == id; });
}

std::string JoinedArguments(const CatalogueFunction& function) {
  std::string joined;
  std::string name;
  for (std::int32_t position = 1; position <= function.argumentCount; ++position) {
    if (position > 1) joined += ',';
    if (GetArgumentName(function.id, position, name) == 0) joined += name;
  }
  return joined;
}

}  // namespace tessal
