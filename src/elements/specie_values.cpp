#include "elements/specie_values.h"

#include <array>
#include <limits>

#include "elements/element_checks.h"
#include "keyfile/keywords.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

// A deliberately tiny value and not zero.
constexpr double kForcingDefault = 1e-35;

constexpr std::array<PropertyRow, 6> kStateVariableRows = {{
    {PlaceOf(&CEL_Lagrange_StateVariable::specie), key::kSpecie, "Specie", ValueType::Integer},
    {PlaceOf(&CEL_Lagrange_StateVariable::unit), key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    ReadLast({PlaceOf(&CEL_Lagrange_StateVariable::defaultValue), key::kDefaultValue, "Default Value",
              ValueType::Real, nullptr, "", 0.0}),
    {PlaceOf(&CEL_Lagrange_StateVariable::minValue), key::kMinValue, "Min Value", ValueType::Real, nullptr,
     "", 0.0},
    {PlaceOf(&CEL_Lagrange_StateVariable::maxValue), key::kMaxValue, "Max Value", ValueType::Real, nullptr,
     "", 100.0},
    {PlaceOf(&CEL_Lagrange_StateVariable::equation), "", "Equation", ValueType::Expression, nullptr, "0"},
}};

constexpr std::array<PropertyRow, 5> kConstantRows = {{
    {PlaceOf(&CEL_Lagrange_Constant::spatialVariation), key::kSpatialVariation, "Spatial Variation",
     ValueType::Text, nullptr, "PER_SPECIE"},
    {PlaceOf(&CEL_Lagrange_Constant::unit), key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    ReadLast({PlaceOf(&CEL_Lagrange_Constant::defaultValue), key::kDefaultValue, "Default Value",
              ValueType::Real, nullptr, "", 0.0}),
    {PlaceOf(&CEL_Lagrange_Constant::minValue), key::kMinValue, "Min Value", ValueType::Real, nullptr, "",
     0.0},
    {PlaceOf(&CEL_Lagrange_Constant::maxValue), key::kMaxValue, "Max Value", ValueType::Real, nullptr, "",
     10.0},
}};

constexpr std::array<PropertyRow, 5> kForcingRows = {{
    WrittenAs(key::kScope, {PlaceOf(&CEL_Lagrange_Forcing::spatialVariation), key::kSpatialVariation,
                            "Spatial Variation", ValueType::Text, nullptr, "PER_SPECIE"}),
    {PlaceOf(&CEL_Lagrange_Forcing::unit), key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {PlaceOf(&CEL_Lagrange_Forcing::defaultValue), key::kDefaultValue, "Default Value", ValueType::Real,
     nullptr, "", kForcingDefault},
    {PlaceOf(&CEL_Lagrange_Forcing::minValue), key::kMinValue, "Min Value", ValueType::Real, nullptr, "",
     kForcingDefault},
    {PlaceOf(&CEL_Lagrange_Forcing::maxValue), key::kMaxValue, "Max Value", ValueType::Real, nullptr, "",
     kForcingDefault},
}};

}  // namespace

void CEL_SpecieValue::Reset() {
  unqType.SetInt(kUserDefinedUnit);
  unqUnit.SetInt(0);
  ResetOwn();
  UpdateLocks();
}

void CEL_SpecieValue::UpdateLocks() {
  // A forcing has no unit type, and so the one that leaves the unit open.
  unit.SetEditable(LeavesUnitOpen(kParticleUnitTypes));
}

std::string CEL_SpecieValue::RecordText() const {
  return SixDigitNumberText(defaultValue.RealValue());
}

void CEL_SpecieValue::OfferParticleUnits(std::string_view selected) {
  OfferUnitTypes(kParticleUnitTypes);
  unqType.SelectChoice(selected);
}

void CEL_SpecieValue::OnPropertyChanged(CEL_Property& changed) {
  if (&changed == &unqType) {
    ApplyUnitType(kParticleUnitTypes, unit);
  } else {
    RebuildOwner();
  }
}

CEL_Lagrange_StateVariable::CEL_Lagrange_StateVariable(std::string_view caption) : CEL_SpecieValue(caption) {
  SetKind(ElementKind::SpecieStateVariable);
  SetUnitMode(UnitMode::Both);
  Bind(kStateVariableRows);
  OfferParticleUnits("Mass");
  ListenTo({&symbol, &unqType, &unqUnit, &equation});
}

void CEL_Lagrange_StateVariable::Reset() {
  const std::int32_t number = specie.IntValue();
  CEL_SpecieValue::Reset();
  specie.SetInt(number);
}

bool CEL_Lagrange_StateVariable::Check() {
  const bool inRange = CheckDefaultInRange(*this, minValue, defaultValue, maxValue);
  const bool named = CheckSymbolForm(*this);
  const bool expressed = CheckExpressions(*this);
  const bool worded = CheckTextContent(*this);
  return inRange && named && expressed && worded;
}

CEL_Lagrange_Constant::CEL_Lagrange_Constant(std::string_view caption) : CEL_SpecieValue(caption) {
  SetKind(ElementKind::SpecieConstant);
  SetUnitMode(UnitMode::Both);
  Bind(kConstantRows);
  OfferParticleUnits(kUserDefined);
  ListenTo({&symbol, &unqType, &unqUnit});
}

bool CEL_Lagrange_Constant::Check() {
  const bool inRange = CheckDefaultInRange(*this, minValue, defaultValue, maxValue);
  const bool named = CheckSymbolForm(*this);
  const bool worded = CheckTextContent(*this);
  return inRange && named && worded;
}

CEL_Lagrange_Forcing::CEL_Lagrange_Forcing(std::string_view caption) : CEL_SpecieValue(caption) {
  SetKind(ElementKind::SpecieForcing);
  Bind(kForcingRows);
}

void CEL_Lagrange_Forcing::Read(KvfNode section, ReadStatus& status) {
  if (!kvfIsSection(section)) return;
  minValue.StartWith(std::numeric_limits<double>::lowest());
  maxValue.StartWith(std::numeric_limits<double>::max());
  CEL_Element::Read(section, status);
}

}  // namespace tessal
