#include "elements/expression_elements.h"

#include <array>

#include "elements/element_checks.h"
#include "keyfile/keywords.h"
#include "keyfile/water_body.h"

namespace tessal {

namespace {

constexpr std::array<std::string_view, 3> kProcessTypes = {"SETTLING", "TRANSFORMATION", "BUOYANCY"};
constexpr std::array<std::string_view, 4> kFormats = {"SMOOTHING", "INSTANTANEOUS", "ACCUMULATED_IN_TIME",
                                                      "SUMMARIZED_WATER_COLUMN"};

const ChoiceList& ProcessTypeChoices() {
  static const ChoiceList kList = MakeTextChoices(kProcessTypes);
  return kList;
}

const ChoiceList& FormatChoices() {
  static const ChoiceList kList = MakeTextChoices(kFormats);
  return kList;
}

constexpr std::array<PropertyRow, 5> kAuxiliaryRows = {{
    {key::kOutput, "Output", ValueType::Boolean, YesNoChoices, kYes},
    {key::kScope, "Scope", ValueType::Text, NoScopeChoices, scope::kNotSpecified},
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, SpatialVariationChoices,
     variation::kHorizontalAndVertical},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kExpression, "Expression", ValueType::Expression, nullptr, "0"},
}};

constexpr std::array<PropertyRow, 8> kProcessRows = {{
    {key::kOutput, "Output", ValueType::Boolean, YesNoChoices, kYes},
    {key::kProcessType, "Process type", ValueType::Text, ProcessTypeChoices, "TRANSFORMATION"},
    {key::kScope, "Scope", ValueType::Text, LayerScopeChoices, scope::kWaterColumn},
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, SpatialVariationChoices,
     variation::kHorizontalAndVertical},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kExpression, "Expression", ValueType::Expression, nullptr, "0"},
    // Files of older versions lack both.
    OnlyWith(key::kControlId, {key::kControlId, "Control ID", ValueType::Integer, nullptr, "", -1.0}),
    OnlyWith(key::kControlId, {key::kControlValue, "Control Value", ValueType::Real, nullptr, "", 0.8}),
}};

constexpr std::array<PropertyRow, 5> kDerivedOutputRows = {{
    {key::kScope, "Scope", ValueType::Text, NoScopeChoices, scope::kNotSpecified},
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, SpatialVariationChoices, variation::kNone},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kFormat, "Format", ValueType::Text, FormatChoices, "INSTANTANEOUS"},
    {key::kExpression, "Expression", ValueType::Expression, nullptr, "0"},
}};

}  // namespace

CEL_ExpressionElement::CEL_ExpressionElement(ElementKind kindNumber, std::string_view caption)
    : CEL_Element(caption) {
  SetKind(kindNumber);
  SetUnitMode(UnitMode::Both);
}

void CEL_ExpressionElement::Reset() {
  ResetOwn();
}

bool CEL_ExpressionElement::Check() {
  const bool expressed = CheckExpressions(*this);
  const bool worded = CheckTextContent(*this);
  return expressed && worded;
}

void CEL_ExpressionElement::OnPropertyChanged(CEL_Property& changed) {
  if (&changed == &scope) ApplyScope(scope, spatialVariation);
  RebuildOwner();
}

CEL_Auxilliary_Variable::CEL_Auxilliary_Variable(std::string_view caption)
    : CEL_ExpressionElement(ElementKind::Auxiliary, caption) {
  Bind(kAuxiliaryRows, {&output, &scope, &spatialVariation, &unit, &expression});
  ListenTo({&symbol, &spatialVariation, &expression});
  scope.AddListener(scopeListener);
}

CEL_Process::CEL_Process(std::string_view caption) : CEL_ExpressionElement(ElementKind::Process, caption) {
  Bind(kProcessRows,
       {&output, &processType, &scope, &spatialVariation, &unit, &expression, &controlId, &controlValue});
  ListenTo({&symbol, &scope, &spatialVariation, &expression});
}

CEL_Derived_Output::CEL_Derived_Output(std::string_view caption)
    : CEL_ExpressionElement(ElementKind::DerivedOutput, caption) {
  SetFileFlags(false, true, true);
  symbol.SetEditable(false);
  Bind(kDerivedOutputRows, {&scope, &spatialVariation, &unit, &format, &expression});
  ListenTo({&spatialVariation, &expression});
  scope.AddListener(scopeListener);
}

}  // namespace tessal
