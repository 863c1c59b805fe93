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
  static const ChoiceList kList = ShareChoices(
      {CEL_Choice::Text("Auxiliary variable", kAuxiliaryType), CEL_Choice::Text("Process", kProcessType)});
  return kList;
}

const ChoiceList& VariationChoices() {
  static const ChoiceList kList = MakeTextChoices(kVariations);
  return kList;
}

constexpr std::array<PropertyRow, 6> kExpressionRows = {{
    {PlaceOf(&CEL_Lagrange_Arithmetical_Expression::expressionType), key::kExpressionType, "Expression type",
     ValueType::Text, ExpressionTypeChoices, kAuxiliaryType},
    {PlaceOf(&CEL_Lagrange_Arithmetical_Expression::specie), key::kSpecie, "Specie", ValueType::Integer},
    {PlaceOf(&CEL_Lagrange_Arithmetical_Expression::output), key::kOutput, "Output", ValueType::Boolean,
     YesNoChoices, kYes},
    {PlaceOf(&CEL_Lagrange_Arithmetical_Expression::spatialVariation), key::kSpatialVariation,
     "Spatial Variation", ValueType::Text, VariationChoices, kVariations[0]},
    {PlaceOf(&CEL_Lagrange_Arithmetical_Expression::unit), key::kUnit, "Unit", ValueType::Text, nullptr,
     "undefined"},
    {PlaceOf(&CEL_Lagrange_Arithmetical_Expression::expression), key::kExpression, "Expression",
     ValueType::Expression, nullptr, "0"},
}};

constexpr std::array<PropertyRow, 2> kHorizontalRows = {{
    Captioned("horizontal speed equation",
              {PlaceOf(&CEL_Lagrange_Horizontal_Vector::speed), key::kExpressionHorizontalSpeed, "Speed",
               ValueType::Expression, nullptr, "0"}),
    Captioned("horizontal direction equation",
              {PlaceOf(&CEL_Lagrange_Horizontal_Vector::direction), key::kExpressionHorizontalDirection,
               "Direction", ValueType::Expression, nullptr, "0"}),
}};

constexpr std::array<PropertyRow, 1> kVerticalRows = {{
    Captioned("vertical speed equation",
              {PlaceOf(&CEL_Lagrange_Vertical_Equation::speed), key::kExpressionVerticalSpeed, "Speed",
               ValueType::Expression, nullptr, "0"}),
}};

}  // namespace

CEL_Lagrange_Arithmetical_Expression::CEL_Lagrange_Arithmetical_Expression(std::string_view caption)
    : CEL_Element(caption) {
  SetKind(ElementKind::ArithmeticExpression);
  SetUnitMode(UnitMode::Both);
  Bind(kExpressionRows);
  ListenTo({&symbol, &unit, &expression});
}

void CEL_Lagrange_Arithmetical_Expression::Reset() {
  const std::int32_t number = specie.IntValue();
  ResetOwn();
  specie.SetInt(number);
}

bool CEL_Lagrange_Arithmetical_Expression::Check() {
  const bool expressed = CheckExpressions(*this);
  const bool worded = CheckTextContent(*this);
  return expressed && worded;
}

void CEL_Lagrange_Arithmetical_Expression::Classify(bool isProcess) {
  expressionType.SetText(isProcess ? kProcessType : kAuxiliaryType);
}

CEL_Movement::CEL_Movement(ElementKind kind, std::string_view caption) : CEL_Element(caption) {
  SetKind(kind);
  SetFileFlags(false, false, false);
  symbol.SetEditable(false);
}

bool CEL_Movement::Check() {
  return CheckExpressions(*this);
}

void CEL_Movement::AppendFullSymbol(std::string& text) const {
  if (ListHeader() != nullptr) {
    text += '(';
    text += ListHeader()->Parent()->symbol.Text();
    text += ')';
  }
  text += symbol.Text();
}

void CEL_Movement::GetFields(std::vector<ElementField>& fields) const {
  AppendCaption(fields);
  AppendOwnFields(fields);
}

CEL_Lagrange_Horizontal_Vector::CEL_Lagrange_Horizontal_Vector(std::string_view caption)
    : CEL_Movement(ElementKind::HorizontalVector, caption) {
  Bind(kHorizontalRows);
  ListenTo({&speed, &direction});
}

CEL_Lagrange_Vertical_Equation::CEL_Lagrange_Vertical_Equation(std::string_view caption)
    : CEL_Movement(ElementKind::VerticalEquation, caption) {
  Bind(kVerticalRows);
  ListenTo({&speed});
}

}  // namespace tessal
