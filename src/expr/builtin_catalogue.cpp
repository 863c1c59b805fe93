#include "expr/builtin_catalogue.h"

#include <algorithm>
#include <array>

#include "expr/function_catalogue.h"

#include "keyfile/water_body.h"

namespace tessal {

namespace {

constexpr std::int32_t kConstant = 1;
constexpr std::int32_t kForcing = 2;

constexpr std::int32_t kAnyLayer = 1;
constexpr std::int32_t kSurface = 2;
constexpr std::int32_t kColumn = 3;
constexpr std::int32_t kBottom = 4;
[[maybe_unused]] constexpr std::int32_t kSediment = 5;

constexpr std::int32_t kNone = 1;
constexpr std::int32_t kHorizontal = 2;
constexpr std::int32_t kFull = 3;

/// The unit type "User defined" of the elements.
constexpr std::int32_t kUserUnit = 999;

// The first two rows are one text, and the first of them wins a selection.
constexpr std::array<std::string_view, 6> kLayers = {scope::kNotSpecified, scope::kNotSpecified,
                                                     scope::kWaterSurface, scope::kWaterColumn,
                                                     scope::kWaterBottom,  scope::kSediment};
constexpr std::array<std::string_view, 4> kVariations = {
    variation::kNone, variation::kNone, variation::kHorizontal, variation::kHorizontalAndVertical};

// Names, units without a denominator and limits are part of the vocabulary and stay as they are.
constexpr CatalogueBuiltin kRows[] = {
    {"DOMAIN_LATITUDE", 1, kConstant, kAnyLayer, kNone, kUserUnit, "Degrees", 55, -90, 90},
    {"DOMAIN_LONGITUDE", 2, kConstant, kAnyLayer, kNone, kUserUnit, "Degrees", 12, -180, 180},
    {"BED_LEVEL", 3, kConstant, kAnyLayer, kHorizontal, kUserUnit, "m", 0, -12000, 8000},
    {"WATER_LAYER_HEIGHT", 4, kForcing, kColumn, kFull, kUserUnit, "m", 2, 0.0001, 8000},
    {"SALINITY", 5, kForcing, kColumn, kFull, kUserUnit, "psu", 0, 0, 350},
    {"TEMPERATURE", 6, kForcing, kColumn, kFull, kUserUnit, "degrees C", 10, 0, 100},
    {"WIND_VELOCITY", 7, kForcing, kSurface, kHorizontal, kUserUnit, "m/s", 2, 0, 100},
    {"WIND_DIRECTION", 8, kForcing, kSurface, kHorizontal, kUserUnit, "degrees", 0, 0, 360},
    {"WATER_SURFACE_LEVEL", 9, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m", 0, 0, 200},
    {"WATER_DEPTH", 10, kForcing, kColumn, kHorizontal, kUserUnit, "m", 8, 0, 12000},
    {"HORISONTAL_CURRENT_SPEED", 11, kForcing, kColumn, kFull, kUserUnit, "m/s", 0.2, 0, 10},
    {"HORISONTAL_CURRENT_DIRECTION", 12, kForcing, kColumn, kFull, kUserUnit, "degrees", 0, 0, 360},
    {"VERTICAL_CURRENT_SPEED", 13, kForcing, kColumn, kFull, kUserUnit, "m/s", 0, 0, 10},
    {"WATER_SURFACE_SLOPE_IN_FLOW_DIRECTION", 14, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m/m", 0, -10,
     10},
    {"BED_AREA_OF_GRIDCELL", 15, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m2", 100000, 1e-07, 1e+10},
    {"FLOODED_AREA_OF_GRIDCELL", 16, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m2", 100000, 1e-07, 1e+10},
    {"SURFACE_AREA_OF_GRIDCELL", 17, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m2", 100000, 1e-07, 1e+10},
    {"VOLUME_OF_GRIDCELL", 18, kForcing, kAnyLayer, kFull, kUserUnit, "m3", 200000, 1e-07, 1e+10},
    {"AD_DT_old", 19, kConstant, kAnyLayer, kNone, kUserUnit, "Seconds", 30, 1, 86400},
    {"WQ_DT_old", 20, kConstant, kAnyLayer, kNone, kUserUnit, "Seconds", 30, 1, 86400},
    {"HORISONTAL_GRIDCELL_FLUX", 21, kForcing, kAnyLayer, kFull, kUserUnit, "m3/s", 0, 0, 1e+10},
    {"VERTICAL_GRIDCELL_FLUX", 22, kForcing, kAnyLayer, kFull, kUserUnit, "m3/s", 0, 0, 1e+10},
    {"WATER_DENSITY", 23, kForcing, kAnyLayer, kFull, kUserUnit, "ton/m3", 1, 0, 20},
    {"HYDRIA_BASE_FLOW", 24, kForcing, kAnyLayer, kFull, kUserUnit, "m3/s", 0, 0, 1e+10},
    {"HYDRIA_DRAIN_FLOW", 25, kForcing, kAnyLayer, kFull, kUserUnit, "m3/s", 0, 0, 1e+10},
    {"HYDRIA_OVERLAND_FLOW", 26, kForcing, kAnyLayer, kFull, kUserUnit, "m3/s", 0, 0, 1e+10},
    {"HYDRIA_BASE_CONC_1", 27, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_DRAIN_CONC_1", 28, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_OVERLAND_CONC_1", 29, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_BASE_CONC_2", 30, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_DRAIN_CONC_2", 31, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_OVERLAND_CONC_2", 32, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_BASE_CONC_3", 33, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_DRAIN_CONC_3", 34, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_OVERLAND_CONC_3", 35, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_BASE_CONC_4", 36, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_DRAIN_CONC_4", 37, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_OVERLAND_CONC_4", 38, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_BASE_CONC_5", 39, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_DRAIN_CONC_5", 40, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"HYDRIA_OVERLAND_CONC_5", 41, kForcing, kAnyLayer, kFull, kUserUnit, "mg/", 0, 0, 1e+10},
    {"GRIDSPACING", 42, kConstant, kAnyLayer, kFull, kUserUnit, "m", 0, 0, 1e+10},
    {"FLUVIO_NODE_TYPE", 43, kConstant, kAnyLayer, kFull, kUserUnit, "", 0, 0, 4},
    {"CHEZY_NO", 44, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m^1/2 /s", 0, 0, 1e+10},
    {"WATER_SURFACE_WIDTH", 45, kForcing, kSurface, kHorizontal, kUserUnit, "m", 0, 0, 1e+10},
    {"HEAT_FLUX_WATER_ATMOSPHERE", 46, kForcing, kAnyLayer, kHorizontal, kUserUnit, "W/m2", 0, 0, 1e+10},
    {"FLUVIOICE_LOCAL_VELO_AT_BORDER_ICE_WIDTH", 47, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m/s", 0, 0,
     1e+10},
    {"FLUVIOICE_BORDER_ICE_WIDTH_VLIM_PROGR", 48, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m", 0, 0,
     1e+10},
    {"FLUVIOICE_BORDER_ICE_WIDTH_VLIM_RETREAT", 49, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m", 0, 0,
     1e+10},
    {"FLUVIOICE_WATER_LEVEL_AT_FREEZEUP", 50, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m", 0, 0, 1e+10},
    {"FLUVIOICE_KAPPA_DYNAMIC_PROGRESSION", 51, kForcing, kAnyLayer, kHorizontal, kUserUnit, "", 0, 0, 1e+10},
    {"FLUVIOICE_LEADING_EDGE_AT_NEXT_SECTION", 52, kForcing, kSurface, kHorizontal, kUserUnit, "", 0, 0, 1},
    {"HORISONTAL_VISCOSITY", 53, kForcing, kColumn, kFull, kUserUnit, "m2/s", 0.002, 0, 1e+08},
    {"HYDRIA_SUPPLIED_CONSTANT", 54, kConstant, kColumn, kFull, kUserUnit, "auto", 0, -1e+08, 1e+08},
    {"HYDRIA_SUPPLIED_FORCING", 55, kForcing, kColumn, kFull, kUserUnit, "auto", 0, -1e+08, 1e+08},
    {"VERTICAL_DISPERSION", 56, kForcing, kColumn, kFull, kUserUnit, "m2/s", 0.1, 0, 10000},
    {"HORIZONTAL_DISPERSION", 57, kForcing, kColumn, kFull, kUserUnit, "m2/s", 0.1, 0, 10000},
    {"TURBULENT_KINETIC_ENERGY", 58, kForcing, kColumn, kFull, kUserUnit, "m2/s2", 0, 0, 10000},
    {"DISSIPATION_TURBULENT_KINETIC_ENERGY", 59, kForcing, kColumn, kFull, kUserUnit, "m2/s3", 0, 0, 10000},
    {"BED_SHEAR_STRESS", 60, kForcing, kBottom, kHorizontal, kUserUnit, "Pa", 0, 0, 10000},
    {"BASIN_RESIDENCE_TIME", 61, kForcing, kAnyLayer, kHorizontal, kUserUnit, "s", 0, 0, 86400},
    {"WEIRHEIGHT_old", 62, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m", 0, 0, 10000},
    {"CONVERGENCE_ANGLE", 63, kConstant, kAnyLayer, kHorizontal, kUserUnit, "degree", 0, 0, 360},
    {"AD_DT", 64, kConstant, kAnyLayer, kNone, kUserUnit, "Seconds", 30, 1, 86400},
    {"WQ_DT", 65, kConstant, kAnyLayer, kNone, kUserUnit, "Seconds", 30, 1, 86400},
    {"BASIN_CATCHMENT_RUNOFF", 66, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m3/s", 0, 0, 1e+10},
    {"BASIN_CATCHMENT_AREA", 67, kForcing, kAnyLayer, kHorizontal, kUserUnit, "m2", 0, 10000, 1e+10},
    {"TIMESTEPS_PER_DAY", 68, kConstant, kAnyLayer, kNone, kUserUnit, "dt/day", 2880, 1, 86400},
    {"LATITUDE", 69, kConstant, kAnyLayer, kHorizontal, kUserUnit, "Degrees", 55, -90, 90},
    {"LONGITUDE", 70, kConstant, kAnyLayer, kHorizontal, kUserUnit, "Degrees", 12, -180, 180},
    {"LAYER_CENTER_DEPTH", 71, kForcing, kColumn, kFull, kUserUnit, "m", 5, 0, 12000},
    {"FLOW_AREA", 72, kForcing, kSurface, kHorizontal, kUserUnit, "m^2", 0, 0, 1e+10},
    {"RELATIVE_DEPTH", 73, kForcing, kSurface, kHorizontal, kUserUnit, "()", -1, -1, 1e+10},
};

struct DeprecatedRange {
  std::int32_t first;
  std::int32_t last;
  std::int32_t reason;
};

constexpr std::array<DeprecatedRange, 4> kDeprecated = {{{24, 41, 4}, {47, 52, 4}, {19, 20, 2}, {62, 62, 1}}};

std::vector<std::int32_t> IdsByName(std::int32_t kind) {
  std::vector<const CatalogueBuiltin*> rows;
  for (const CatalogueBuiltin& row : kRows) {
    if (row.kind == kind) rows.push_back(&row);
  }
  std::sort(rows.begin(), rows.end(), [](const CatalogueBuiltin* left, const CatalogueBuiltin* right) {
    return left->name < right->name;
  });
  std::vector<std::int32_t> ids;
  ids.reserve(rows.size());
  for (const CatalogueBuiltin* row : rows) ids.push_back(row->id);
  return ids;
}

template <std::size_t Count>
std::string_view TextAt(const std::array<std::string_view, Count>& texts, std::int32_t row) {
  const auto place = static_cast<std::size_t>(row);
  return row >= 0 && place < Count ? texts[place] : texts[0];
}

}  // namespace

std::uint32_t GetBuiltinById(std::int32_t id, CatalogueBuiltin& record) {
  // The rows are in the order of their ids, which count from 1.
  if (id < 1 || static_cast<std::size_t>(id) > std::size(kRows)) return kCatalogueNotFound;
  record = kRows[id - 1];
  return 0;
}

const std::vector<CatalogueBuiltin>& Builtins() {
  static const std::vector<CatalogueBuiltin> kBuiltins(std::begin(kRows), std::end(kRows));
  return kBuiltins;
}

const std::vector<std::int32_t>& ConstantBuiltinIds() {
  static const std::vector<std::int32_t> kIds = IdsByName(kConstant);
  return kIds;
}

const std::vector<std::int32_t>& ForcingBuiltinIds() {
  static const std::vector<std::int32_t> kIds = IdsByName(kForcing);
  return kIds;
}

bool IsDeprecatedBuiltin(std::int32_t id) {
  return std::any_of(kDeprecated.begin(), kDeprecated.end(),
                     [id](const DeprecatedRange& range) { return id >= range.first && id <= range.last; });
}

std::span<const std::string_view> LayerTexts() {
  return kLayers;
}

std::string_view LayerText(std::int32_t layer) {
  return TextAt(kLayers, layer);
}

std::string_view VariationText(std::int32_t variation) {
  return TextAt(kVariations, variation);
}

}  // namespace tessal
