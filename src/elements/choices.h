// The allowed values that several elements share, and the unit types with the unit texts that they fix.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

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

/// A list that properties may share.
ChoiceList ShareChoices(std::vector<CEL_Choice> choices);
/// A list of text choices whose display is their stored text.
ChoiceList MakeTextChoices(std::span<const std::string_view> texts);

/// A unit type: its number, the unit number that goes with it (0 where none is known) and the unit text that
/// it brings; an empty text leaves the unit as it is.
struct UnitTypeRow {
  std::string_view display;
  std::int32_t unqType;
  std::int32_t unqUnit;
  std::string_view unit;
};

/// What a choice without a fixed value is called: a unit type, a quantity that is not built in.
inline constexpr std::string_view kUserDefined = "User defined";

/// The number of the unit type "User defined".
inline constexpr std::int32_t kUserDefinedUnit = 999;

/// The unit types of a family of elements.
struct UnitTypes {
  std::span<const UnitTypeRow> rows;
  bool keepsUnknown;  ///< a number without a row stays; otherwise it becomes "User defined"
};

extern const UnitTypes kPlainUnitTypes;          ///< of elements without unit types of their own
extern const UnitTypes kInputUnitTypes;          ///< of constants and forcings
extern const UnitTypes kStateVariableUnitTypes;  ///< of the template's state variables
extern const UnitTypes kParticleUnitTypes;       ///< of the values of particle classes

/// The row of a unit type, or none.
const UnitTypeRow* FindUnitType(const UnitTypes& types, std::int32_t unqType);

/// The unit library's look-up: the name of a unit type of any family, as forms show it. Not 0 when there is
/// one; else 0, with the text untouched.
int unqGetItemTypeKey(std::int32_t unqType, std::string& text);

/// Numbered choices over the unit types, one list for each family.
const ChoiceList& UnitTypeChoices(const UnitTypes& types);

}  // namespace tessal
