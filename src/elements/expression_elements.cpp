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
    {PlaceOf(&CEL_Auxilliary_Variable::output), key::kOutput, "Output", ValueType::Boolean, YesNoChoices,
     kYes},
    {PlaceOf(&CEL_Auxilliary_Variable::scope), key::kScope, "Scope", ValueType::Text, NoScopeChoices,
     scope::kNotSpecified},
    {PlaceOf(&CEL_Auxilliary_Variable::spatialVariation), key::kSpatialVariation, "Spatial Variation",
     ValueType::Text, SpatialVariationChoices, variation::kHorizontalAndVertical},
    {PlaceOf(&CEL_Auxilliary_Variable::unit), key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {PlaceOf(&CEL_Auxilliary_Variable::expression), key::kExpression, "Expression", ValueType::Expression,
     nullptr, "0"},
}};

constexpr std::array<PropertyRow, 8> kProcessRows = {{
    {PlaceOf(&CEL_Process::output), key::kOutput, "Output", ValueType::Boolean, YesNoChoices, kYes},
    {PlaceOf(&CEL_Process::processType), key::kProcessType, "Process type", ValueType::Text,
     ProcessTypeChoices, "TRANSFORMATION"},
    {PlaceOf(&CEL_Process::scope), key::kScope, "Scope", ValueType::Text, LayerScopeChoices,
     scope::kWaterColumn},
    {PlaceOf(&CEL_Process::spatialVariation), key::kSpatialVariation, "Spatial Variation", ValueType::Text,
     SpatialVariationChoices, variation::kHorizontalAndVertical},
    {PlaceOf(&CEL_Process::unit), key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {PlaceOf(&CEL_Process::expression), key::kExpression, "Expression", ValueType::Expression, nullptr, "0"},
    // Files of older versions lack both.
    OnlyWith(key::kControlId, {PlaceOf(&CEL_Process::controlId), key::kControlId, "Control ID",
                               ValueType::Integer, nullptr, "", -1.0}),
    OnlyWith(key::kControlId, {PlaceOf(&CEL_Process::controlValue), key::kControlValue, "Control Value",
                               ValueType::Real, nullptr, "", 0.8}),
}};

constexpr std::array<PropertyRow, 5> kDerivedOutputRows = {{
    {PlaceOf(&CEL_Derived_Output::scope), key::kScope, "Scope", ValueType::Text, NoScopeChoices,
     scope::kNotSpecified},
    {PlaceOf(&CEL_Derived_Output::spatialVariation), key::kSpatialVariation, "Spatial Variation",
     ValueType::Text, SpatialVariationChoices, variation::kNone},
    {PlaceOf(&CEL_Derived_Output::unit), key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {PlaceOf(&CEL_Derived_Output::format), key::kFormat, "Format", ValueType::Text, FormatChoices,
     "INSTANTANEOUS"},
    {PlaceOf(&CEL_Derived_Output::expression), key::kExpression, "Expression", ValueType::Expression, nullptr,
     "0"},
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
  Bind(kAuxiliaryRows);
  ListenTo({&symbol, &spatialVariation, &expression});
  // Its variation does not follow its scope.
  scope.ReportTo(ReportsTo::Table);
}

CEL_Process::CEL_Process(std::string_view caption) : CEL_ExpressionElement(ElementKind::Process, caption) {
  Bind(kProcessRows);
  ListenTo({&symbol, &scope, &spatialVariation, &expression});
}

CEL_Derived_Output::CEL_Derived_Output(std::string_view caption)
    : CEL_ExpressionElement(ElementKind::DerivedOutput, caption) {
  SetFileFlags(false, true, true);
  symbol.SetEditable(false);
  Bind(kDerivedOutputRows);
  ListenTo({&spatialVariation, &expression});
  // Its variation does not follow its scope.
  scope.ReportTo(ReportsTo::Table);
}

}  // namespace tessal
