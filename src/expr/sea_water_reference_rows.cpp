#include "expr/function_reference_rows.h"

namespace tessal {

namespace {

// clang-format off
constexpr ArgumentReference kSurfaceWater[] = {
    {"Salinity", "the salinity, 0 to 42", "g/kg"}, {"Temperature", "the temperature, -2 to 40", "degC"}};

constexpr FunctionReference kSeaWater[] = {
    {"GET_WATER_DENSITY", "The density of sea water at one atmosphere, by the international equation of state "
                          "of 1980.",
     kSurfaceWater, "the density", "kg/m3", "",
     "Millero and Poisson 1981, Deep-Sea Res. 28A:625-629; Fofonoff and Millard 1983, UNESCO Tech. Pap. Mar. "
     "Sci. 44"},
};
// clang-format on

constexpr FunctionGroup kGroups[] = {
    {"Sea water", kSeaWater},
};

}  // namespace

std::span<const FunctionGroup> SeaWaterFunctionGroups() {
  return kGroups;
}

}  // namespace tessal
