#include "elements/specie_values.h"

#include <array>
#include <limits>

#include "elements/element_checks.h"
#include "elements/property_io.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

constexpr std::string_view kUserDefined = "User defined";

constexpr std::array<UnitTypeRow, 14> kUnitTypes = {{
    {"Mass", 100039, 0, "kg"},
    {kUserDefined, kUserDefinedUnit, 0, "undefined"},
    {"Concentration", 100404, 0, "mg/l"},
    {"Mass per Area", 100437, 0, "g/m2"},
    {"Density", 100017, 0, "kg/m3"},
    {"Temperature", 100006, 0, "degree Celsius"},
    {"Surface Area", 100135, 0, "m2"},
    {"Light exinction", 100220, 0, "per meter"},
    {"Fraction", 100239, 0, "fraction"},
    {"Wind Speed", 100274, 0, "meter/sec"},
    {"Current Speed", 100242, 0, "meter/sec"},
    {"Attenuation", 100317, 0, "per meter"},
    {"Volume", 110230, 0, "m3"},
    {"Length", 110220, 0, "m"},
}};

const ChoiceList& UnitTypeChoices() {
  static const ChoiceList kList = MakeUnitTypeChoices(kUnitTypes);
  return kList;
}

// A deliberately tiny value and not zero.
constexpr double kForcingDefault = 1e-35;

constexpr std::array<PropertyRow, 6> kStateVariableRows = {{
    {key::kSpecie, "Specie", ValueType::Integer},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kDefaultValue, "Default Value", ValueType::Real, nullptr, "", 0.0, true},
    {key::kMinValue, "Min Value", ValueType::Real, nullptr, "", 0.0},
    {key::kMaxValue, "Max Value", ValueType::Real, nullptr, "", 100.0},
    {"", "Equation", ValueType::Expression, nullptr, "0"},
}};

constexpr std::array<PropertyRow, 5> kConstantRows = {{
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, nullptr, "PER_SPECIE"},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kDefaultValue, "Default Value", ValueType::Real, nullptr, "", 0.0, true},
    {key::kMinValue, "Min Value", ValueType::Real, nullptr, "", 0.0},
    {key::kMaxValue, "Max Value", ValueType::Real, nullptr, "", 10.0},
}};

constexpr std::array<PropertyRow, 5> kForcingRows = {{
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, nullptr, "PER_SPECIE"},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kDefaultValue, "Default Value", ValueType::Real, nullptr, "", kForcingDefault},
    {key::kMinValue, "Min Value", ValueType::Real, nullptr, "", kForcingDefault},
    {key::kMaxValue, "Max Value", ValueType::Real, nullptr, "", kForcingDefault},
}};

}  // namespace

void CEL_SpecieValue::Reset() {
  unqType.SetInt(kUserDefinedUnit);
  ResetOwn();
}

void CEL_SpecieValue::OfferParticleUnits(std::string_view selected) {
  unqType.SetChoices(UnitTypeChoices());
  unqType.SelectChoice(selected);
}

void CEL_SpecieValue::OnPropertyChanged(CEL_Property& changed) {
  if (&changed != &unqType) {
    RebuildOwner();
    return;
  }
  const UnitTypeRow* row = FindUnitType(kUnitTypes, unqType.IntValue());
  if (row != nullptr) unit.SetText(row->unit);
  unit.SetEditable(row == nullptr || row->unqType == kUserDefinedUnit);
}

CEL_Lagrange_StateVariable::CEL_Lagrange_StateVariable(std::string_view caption) : CEL_SpecieValue(caption) {
  SetKind(ElementKind::SpecieStateVariable);
  SetUnitMode(UnitMode::Both);
  Bind(kStateVariableRows, {&specie, &unit, &defaultValue, &minValue, &maxValue, &equation});
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
  const bool expressed = CheckExpression(*this, equation);
  const bool worded = CheckTextContent(*this);
  return inRange && named && expressed && worded;
}

bool CEL_Lagrange_StateVariable::ParseExpression() {
  return CompileExpression(*this, symbol.Text(), equation, equationTree);
}

void CEL_Lagrange_StateVariable::ReadEquation(KvfNode section, int& status) {
  ReadProperty(equation, section, symbol.Text(), status);
}

void CEL_Lagrange_StateVariable::WriteEquation(KvfHandle file, int& status) {
  WriteProperty(equation, file, symbol.Text(), *this, status);
}

CEL_Lagrange_Constant::CEL_Lagrange_Constant(std::string_view caption) : CEL_SpecieValue(caption) {
  SetKind(ElementKind::SpecieConstant);
  SetUnitMode(UnitMode::Both);
  Bind(kConstantRows, {&spatialVariation, &unit, &defaultValue, &minValue, &maxValue});
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
  Bind(kForcingRows, {&spatialVariation, &unit, &defaultValue, &minValue, &maxValue});
}

void CEL_Lagrange_Forcing::Read(KvfNode section, int& status) {
  if (!kvfIsSection(section)) return;
  minValue.SetReal(std::numeric_limits<double>::lowest());
  maxValue.SetReal(std::numeric_limits<double>::max());
  CEL_Element::Read(section, status);
}

void CEL_Lagrange_Forcing::Write(KvfHandle file, int& status) {
  WriteBase(file, status);
  WriteProperty(spatialVariation, file, key::kScope, *this, status);
  WriteProperty(unit, file, key::kUnit, *this, status);
  WriteProperty(defaultValue, file, key::kDefaultValue, *this, status);
  WriteProperty(minValue, file, key::kMinValue, *this, status);
  WriteProperty(maxValue, file, key::kMaxValue, *this, status);
}

}  // namespace tessal
