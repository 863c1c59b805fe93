#include "elements/state_variable.h"

#include <array>
#include <limits>

#include "elements/element_checks.h"
#include "elements/property_io.h"
#include "keyfile/keywords.h"
#include "keyfile/water_body.h"

namespace tessal {

namespace {

constexpr std::array<std::string_view, 2> kTransports = {"ADVECTION_DISPERSION", "FIXED"};

const ChoiceList& TransportChoices() {
  static const ChoiceList kList = MakeTextChoices(kTransports);
  return kList;
}

constexpr std::array<PropertyRow, 7> kRows = {{
    {PlaceOf(&CEL_StateVariable::scope), key::kScope, "Scope", ValueType::Text, LayerScopeChoices,
     scope::kWaterColumn},
    {PlaceOf(&CEL_StateVariable::transport), key::kTransport, "Transport", ValueType::Text, TransportChoices,
     "ADVECTION_DISPERSION"},
    {PlaceOf(&CEL_StateVariable::unit), key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {PlaceOf(&CEL_StateVariable::defaultValue), key::kDefaultValue, "Default Value", ValueType::Real, nullptr,
     "", 0.0},
    {PlaceOf(&CEL_StateVariable::minValue), key::kMinValue, "Min Value", ValueType::Real, nullptr, "", 0.0},
    {PlaceOf(&CEL_StateVariable::maxValue), key::kMaxValue, "Max Value", ValueType::Real, nullptr, "", 100.0},
    {PlaceOf(&CEL_StateVariable::equation), "", "Equation", ValueType::Expression, nullptr, "0"},
}};

}  // namespace

CEL_StateVariable::CEL_StateVariable(std::string_view caption) : CEL_Element(caption) {
  SetKind(ElementKind::StateVariable);
  SetUnitMode(UnitMode::Both);
  OfferUnitTypes(kStateVariableUnitTypes);
  Bind(kRows);
  ListenTo({&symbol, &scope, &unqType, &unqUnit, &equation});
  CEL_StateVariable::UpdateLocks();
}

void CEL_StateVariable::Reset() {
  unqType.SetInt(kUserDefinedUnit);
  unqType.SelectChoice(kUserDefined);
  unqUnit.SetInt(0);
  ResetOwn();
  CEL_StateVariable::UpdateLocks();
}

void CEL_StateVariable::UpdateLocks() {
  unit.SetEditable(LeavesUnitOpen(kStateVariableUnitTypes));
}

void CEL_StateVariable::Read(KvfNode section, ReadStatus& status) {
  if (!kvfIsSection(section)) return;
  ReadBase(section, status);
  ReadProperty(scope, section, key::kScope, status);
  ReadProperty(transport, section, key::kTransport, status);
  ReadProperty(unit, section, key::kUnit, status);
  minValue.StartWith(std::numeric_limits<double>::lowest());
  maxValue.StartWith(std::numeric_limits<double>::max());
  ReadProperty(minValue, section, key::kMinValue, status);
  // A file without a maximum gives one equal to the minimum.
  maxValue.StartWith(minValue.RealValue());
  ReadProperty(maxValue, section, key::kMaxValue, status);
  ReadProperty(defaultValue, section, key::kDefaultValue, status);
  SelectPresentValues();
  UpdateLocks();
}

bool CEL_StateVariable::Check() {
  const bool inRange = CheckDefaultInRange(*this, minValue, defaultValue, maxValue);
  const bool ordered = CheckRangeOrder(*this, minValue, maxValue);
  const bool named = CheckSymbolForm(*this);
  const bool expressed = CheckExpressions(*this);
  const bool worded = CheckTextContent(*this);
  return inRange && ordered && named && expressed && worded;
}

void CEL_StateVariable::OnPropertyChanged(CEL_Property& changed) {
  if (&changed == &unqType) {
    ApplyUnitType(kStateVariableUnitTypes, unit);
  } else {
    RebuildOwner();
  }
}

}  // namespace tessal
