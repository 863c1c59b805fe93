#include "platform/unit_names.h"

#include <algorithm>
#include <array>
#include <string_view>

namespace tessal {

namespace {

struct UnitName {
  std::int32_t unitType;
  std::string_view key;
};

constexpr std::array<UnitName, 16> kUnitNames = {{
    {999, "Undefined"},
    {100006, "Temperature"},
    {100008, "Bacteria_Concentration"},
    {100017, "Density"},
    {100039, "Mass"},
    {100135, "Surface_Area"},
    {100150, "Process_Rate"},
    {100220, "Light_Extinction"},
    {100239, "Fraction"},
    {100242, "Current_Speed"},
    {100274, "Wind_Speed"},
    {100317, "Attenuation"},
    {100404, "Concentration"},
    {100437, "Mass_per_Area"},
    {110220, "Length"},
    {110230, "Volume"},
}};

}  // namespace

int unqGetItemTypeKey(std::int32_t unitType, std::string& text) {
  const auto hit = std::find_if(kUnitNames.begin(), kUnitNames.end(),
                                [unitType](const UnitName& row) { return row.unitType == unitType; });
  if (hit == kUnitNames.end()) return 0;
  text = hit->key;
  return 1;
}

}  // namespace tessal
