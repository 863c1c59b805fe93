#include "elements/specie_expressions.h"

#include <array>

#include "elements/element_checks.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

constexpr std::string_view kAuxiliaryType = "AUXILIARY_VARIABLE";
constexpr std::string_view kProcessType = "PROCESS";
constexpr std::array<std::string_view, 1> kVariations = {"PER_INDIVIDUAL"};

const ChoiceList& ExpressionTypeChoices() {
  static const ChoiceList kList = std::make_shared<const std::vector<CEL_Choice>>(std::vector<CEL_Choice>{
      CEL_Choice::Text("Auxiliary variable", kAuxiliaryType), CEL_Choice::Text("Process", kProcessType)});
  return kList;
}

const ChoiceList& VariationChoices() {
  static const ChoiceList kList = MakeTextChoices(kVariations);
  return kList;
}

constexpr std::array<PropertyRow, 6> kExpressionRows = {{
    {key::kExpressionType, "Expression type", ValueType::Text, ExpressionTypeChoices, kAuxiliaryType},
    {key::kSpecie, "Specie", ValueType::Integer},
    {key::kOutput, "Output", ValueType::Boolean, YesNoChoices, "YES"},
    {key::kSpatialVariation, "Spatial Variation", ValueType::Text, VariationChoices, kVariations[0]},
    {key::kUnit, "Unit", ValueType::Text, nullptr, "undefined"},
    {key::kExpression, "Expression", ValueType::Expression, nullptr, "0"},
}};

constexpr std::array<PropertyRow, 2> kHorizontalRows = {{
    {key::kExpressionHorizontalSpeed, "Speed", ValueType::Expression, nullptr, "0"},
    {key::kExpressionHorizontalDirection, "Direction", ValueType::Expression, nullptr, "0"},
}};

constexpr std::array<PropertyRow, 1> kVerticalRows = {{
    {key::kExpressionVerticalSpeed, "Speed", ValueType::Expression, nullptr, "0"},
}};

}  // namespace

CEL_Lagrange_Arithmetical_Expression::CEL_Lagrange_Arithmetical_Expression(std::string_view caption)
    : CEL_Element(caption) {
  SetKind(ElementKind::ArithmeticExpression);
  SetUnitMode(UnitMode::Both);
  Bind(kExpressionRows, {&expressionType, &specie, &output, &spatialVariation, &unit, &expression});
  ListenTo({&symbol, &unit, &expression});
}

void CEL_Lagrange_Arithmetical_Expression::Reset() {
  const std::int32_t number = specie.IntValue();
  ResetOwn();
  specie.SetInt(number);
}

bool CEL_Lagrange_Arithmetical_Expression::Check() {
  const bool expressed = CheckExpression(*this, expression);
  const bool worded = CheckTextContent(*this);
  return expressed && worded;
}

bool CEL_Lagrange_Arithmetical_Expression::ParseExpression() {
  return CompileExpression(*this, symbol.Text(), expression, tree);
}

void CEL_Lagrange_Arithmetical_Expression::Classify(bool isProcess) {
  expressionType.SetText(isProcess ? kProcessType : kAuxiliaryType);
}

CEL_Lagrange_Horizontal_Vector::CEL_Lagrange_Horizontal_Vector(std::string_view caption)
    : CEL_Element(caption) {
  SetKind(ElementKind::HorizontalVector);
  SetFileFlags(false, false, false);
  Bind(kHorizontalRows, {&speed, &direction});
  ListenTo({&speed, &direction});
}

bool CEL_Lagrange_Horizontal_Vector::Check() {
  const bool speedGood = CheckExpression(*this, speed);
  const bool directionGood = CheckExpression(*this, direction);
  return speedGood && directionGood;
}

bool CEL_Lagrange_Horizontal_Vector::ParseExpression() {
  const bool speedGood = CompileExpression(*this, "horizontal speed equation", speed, speedTree);
  const bool directionGood =
      CompileExpression(*this, "horizontal direction equation", direction, directionTree);
  return speedGood && directionGood;
}

void CEL_Lagrange_Horizontal_Vector::GetFields(std::vector<ElementField>& fields) const {
  AppendCaption(fields);
  AppendOwnFields(fields);
}

int CEL_Lagrange_Horizontal_Vector::SetFields(const std::vector<ElementField>& fields) {
  return SetOwnFields(fields);
}

CEL_Lagrange_Vertical_Equation::CEL_Lagrange_Vertical_Equation(std::string_view caption)
    : CEL_Element(caption) {
  SetKind(ElementKind::VerticalEquation);
  SetFileFlags(false, false, false);
  Bind(kVerticalRows, {&speed});
  ListenTo({&speed});
}

bool CEL_Lagrange_Vertical_Equation::Check() {
  return CheckExpression(*this, speed);
}

bool CEL_Lagrange_Vertical_Equation::ParseExpression() {
  return CompileExpression(*this, "vertical speed equation", speed, speedTree);
}

void CEL_Lagrange_Vertical_Equation::GetFields(std::vector<ElementField>& fields) const {
  AppendCaption(fields);
  AppendOwnFields(fields);
}

int CEL_Lagrange_Vertical_Equation::SetFields(const std::vector<ElementField>& fields) {
  return SetOwnFields(fields);
}

}  // namespace tessal
