#include "elements/expression_elements.h"

#include <array>

#include "elements/element_checks.h"
#include "keyfile/keywords.h"

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
    {key::kOutput, "Output", ValueType::Boolean, YesNoChoices, "YES"},
    {key::kScope, "Scope", ValueType::Text, NoScopeChoices, "NOT_SPECIFIED"},
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, SpatialVariationChoices,
     "HORISONTAL_AND_VERTICAL"},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kExpression, "Expression", ValueType::Expression, nullptr, "0"},
}};

constexpr std::array<PropertyRow, 8> kProcessRows = {{
    {key::kOutput, "Output", ValueType::Boolean, YesNoChoices, "YES"},
    {key::kProcessType, "Process type", ValueType::Text, ProcessTypeChoices, "TRANSFORMATION"},
    {key::kScope, "Scope", ValueType::Text, LayerScopeChoices, "WC"},
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, SpatialVariationChoices,
     "HORISONTAL_AND_VERTICAL"},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kExpression, "Expression", ValueType::Expression, nullptr, "0"},
    // Files of older versions lack both.
    {key::kControlId, "Control ID", ValueType::Integer, nullptr, "", -1.0, false, false, key::kControlId},
    {key::kControlValue, "Control Value", ValueType::Real, nullptr, "", 0.8, false, false, key::kControlId},
}};

constexpr std::array<PropertyRow, 5> kDerivedOutputRows = {{
    {key::kScope, "Scope", ValueType::Text, NoScopeChoices, "NOT_SPECIFIED"},
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, SpatialVariationChoices, "NONE"},
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
  const bool expressed = CheckExpression(*this, expression);
  const bool worded = CheckTextContent(*this);
  return expressed && worded;
}

bool CEL_ExpressionElement::ParseExpression() {
  return CompileExpression(*this, symbol.Text(), expression, tree);
}

void CEL_ExpressionElement::OnPropertyChanged(CEL_Property& changed) {
  if (&changed != &scope) {
    RebuildOwner();
    return;
  }
  const std::string_view variation = SpatialVariationOfScope(scope.Text());
  if (!variation.empty()) spatialVariation.SetText(variation);
  // A form opens on the selection, and would store it over the new variation.
  SelectPresentValues();
}

CEL_Auxilliary_Variable::CEL_Auxilliary_Variable(std::string_view caption)
    : CEL_ExpressionElement(ElementKind::Auxiliary, caption) {
  Bind(kAuxiliaryRows, {&output, &scope, &spatialVariation, &unit, &expression});
  ListenTo({&symbol, &spatialVariation, &expression});
}

CEL_Process::CEL_Process(std::string_view caption) : CEL_ExpressionElement(ElementKind::Process, caption) {
  Bind(kProcessRows,
       {&output, &processType, &scope, &spatialVariation, &unit, &expression, &controlId, &controlValue});
  ListenTo({&symbol, &scope, &spatialVariation, &expression});
}

CEL_Derived_Output::CEL_Derived_Output(std::string_view caption)
    : CEL_ExpressionElement(ElementKind::DerivedOutput, caption) {
  SetFileFlags(false, true, true);
  Bind(kDerivedOutputRows, {&scope, &spatialVariation, &unit, &format, &expression});
  ListenTo({&spatialVariation, &expression});
}

}  // namespace tessal
