// The allowed values that several elements share, and the unit types with the unit texts that they fix.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>

#include "elements/property.h"

namespace tessal {

/// Where a property's choices come from; null for free input.
using ChoiceSource = const ChoiceList& (*)();

/// "YES" and "NO".
const ChoiceList& YesNoChoices();
/// Scopes of state variables and processes.
const ChoiceList& LayerScopeChoices();
/// Scopes of constants and forcings.
const ChoiceList& InputScopeChoices();
/// The one scope of auxiliaries and derived outputs.
const ChoiceList& NoScopeChoices();
const ChoiceList& SpatialVariationChoices();

/// A list of text choices whose display is their stored text.
ChoiceList MakeTextChoices(std::span<const std::string_view> texts);

/// A unit type: its number, the unit number that goes with it and the unit text that it fixes.
struct UnitTypeRow {
  std::string_view display;
  std::int32_t unqType;
  std::int32_t unqUnit;
  std::string_view unit;
};

/// The number of the unit type "User defined".
inline constexpr std::int32_t kUserDefinedUnit = 999;

/// The row of a unit type, or none.
const UnitTypeRow* FindUnitType(std::span<const UnitTypeRow> rows, std::int32_t unqType);

/// Numbered choices over the unit types.
ChoiceList MakeUnitTypeChoices(std::span<const UnitTypeRow> rows);

/// The spatial variation that a scope brings with it; empty for a scope that brings none.
std::string_view SpatialVariationOfScope(std::string_view scope);

}  // namespace tessal
