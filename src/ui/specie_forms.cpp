#include "ui/specie_forms.h"

#include "core/template_core.h"
#include "ui/form_fields.h"

namespace tessal {

namespace {

using enum FieldEditor;

constexpr FormField kMemberUnit{1079, "Unit", ShortLine, Of<&CEL_Lagrange_StateVariable::unit>};

const CEL_Lagrange_Specie& Class(const CEL_Element& element) {
  return static_cast<const CEL_Lagrange_Specie&>(element);
}

template <auto Members>
std::size_t CountOf(const CEL_Element& element) {
  return (Class(element).*Members).size();
}

/// Each class has its one downward movement.
std::size_t OneOf(const CEL_Element& /*element*/) {
  return 1;
}

constexpr FormField kSpecieFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    // Spelt as it has always been.
    {control_id::kDocumentation, "Documenation", Documentation, Of<&CEL_Element::documentation>},
    {1091, "Position projection", Number, Of<&CEL_Lagrange_Specie::projectionTime>},
    {1080, "Field view", Number, Of<&CEL_Lagrange_Specie::fieldOfView>},
    CountField(1096, "State variables", CountOf<&CEL_Lagrange_Specie::stateVariables>),
    CountField(1069, "Constants", CountOf<&CEL_Lagrange_Specie::constants>),
    CountField(1082, "Spatial functions", CountOf<&CEL_Lagrange_Specie::spatialFunctions>),
    CountField(1066, "Arithmetical expression", CountOf<&CEL_Lagrange_Specie::arithmeticExpressions>),
    CountField(1100, "Horizontal vectors", CountOf<&CEL_Lagrange_Specie::horizontalVectors>),
    CountField(1101, "Vertical vectors", OneOf),
};

constexpr FormField kStateVariableFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    kUnitType,
    kMemberUnit,
    {1071, "Default value", Number, Of<&CEL_Lagrange_StateVariable::defaultValue>},
    {1085, "Minimum value", Number, Of<&CEL_Lagrange_StateVariable::minValue>},
    {1084, "Maximum value", Number, Of<&CEL_Lagrange_StateVariable::maxValue>},
    {kExpressionControl, "Expression", Expression, Of<&CEL_Lagrange_StateVariable::equation>},
    kReferencedIn,
};

constexpr FormField kConstantFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    kUnitType,
    {1079, "Unit", ShortLine, Of<&CEL_Lagrange_Constant::unit>},
    {1071, "Default value", Number, Of<&CEL_Lagrange_Constant::defaultValue>},
    {1085, "Minimum value", Number, Of<&CEL_Lagrange_Constant::minValue>},
    {1084, "Maximum value", Number, Of<&CEL_Lagrange_Constant::maxValue>},
    kReferencedIn,
};

constexpr FormField kArithmeticExpressionFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {1050, "Output", SortedChoice, Of<&CEL_Lagrange_Arithmetical_Expression::output>},
    {kSpatialControl, "Spatial var.", SortedChoice,
     Of<&CEL_Lagrange_Arithmetical_Expression::spatialVariation>},
    {1201, "Expression type", SortedChoice, Of<&CEL_Lagrange_Arithmetical_Expression::expressionType>},
    {1099, "Unit", ShortLine, Of<&CEL_Lagrange_Arithmetical_Expression::unit>},
    {kExpressionControl, "Expression", Expression, Of<&CEL_Lagrange_Arithmetical_Expression::expression>},
    kReferencedIn,
};

constexpr int kSpeedControl = 1116;
constexpr int kSpeedButton = 1034;

constexpr FormField kHorizontalVectorFields[] = {
    {.control = 1114,
     .label = "Direction",
     .editor = Expression,
     .property = Of<&CEL_Lagrange_Horizontal_Vector::direction>,
     .keypad = 1019},
    {.control = kSpeedControl,
     .label = "Speed",
     .editor = Expression,
     .property = Of<&CEL_Lagrange_Horizontal_Vector::speed>,
     .keypad = kSpeedButton},
};

constexpr FormField kVerticalEquationFields[] = {
    {.control = kSpeedControl,
     .label = "Speed",
     .editor = Expression,
     .property = Of<&CEL_Lagrange_Vertical_Equation::speed>,
     .keypad = kSpeedButton},
};

constexpr int kPurposeControl = 1053;
constexpr int kFrameworkControl = 1047;
constexpr int kFunctionControl = 1040;

constexpr FormField kSpatialFunctionFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {kPurposeControl, "Purpose", SortedChoice, Of<&CEL_Lagrange_Spatial_Function::purpose>},
    {kFrameworkControl, "Framework", SortedChoice, Of<&CEL_Lagrange_Spatial_Function::framework>},
    {1063, "Based on variable", SortedChoice, Of<&CEL_Lagrange_Spatial_Function::variableId>},
    {1057, "Owner", SortedChoice, Of<&CEL_Lagrange_Spatial_Function::specieId>},
    {1130, "Based on property", SortedChoice, Of<&CEL_Lagrange_Spatial_Function::property>},
    {1044, "Dimension", SortedChoice, Of<&CEL_Lagrange_Spatial_Function::dimension>},
    {1093, "Range/radius", Number, Of<&CEL_Lagrange_Spatial_Function::radius>},
    {kFunctionControl, "Function", SortedChoice, Of<&CEL_Lagrange_Spatial_Function::math>},
    {1048, "Consider", SortedChoice, Of<&CEL_Lagrange_Spatial_Function::lookFor>},
    kReferencedIn,
};

/// Leaves a property without a selection, which counts as a change whatever it was.
void TakeSelection(CEL_Property& property) {
  property.SelectIndex(-1);
  property.RaiseChange();
}

}  // namespace

constexpr FormTable kSpecieForm = kSpecieFields;
constexpr FormTable kSpecieStateVariableForm = kStateVariableFields;
constexpr FormTable kSpecieConstantForm = kConstantFields;
constexpr FormTable kArithmeticExpressionForm = kArithmeticExpressionFields;
constexpr FormTable kHorizontalVectorForm = kHorizontalVectorFields;
constexpr FormTable kVerticalEquationForm = kVerticalEquationFields;
constexpr FormTable kSpatialFunctionForm = kSpatialFunctionFields;

void CSpecieSpatialFunctionView::ItemToForm() {
  {
    // A look is no act: the class that the search belongs to follows from its place.
    const RecordingOff unrecorded(Core().History());
    Core().RefreshSearchFunctionChoices();
  }
  CElementForm::ItemToForm();
}

bool CSpecieSpatialFunctionView::StoreFields(CEL_Element& element) {
  bool changed = StoreField(kPurposeControl, element);
  changed = StoreField(kFunctionControl, element) || changed;
  if (StoreField(kFrameworkControl, element)) {
    auto& function = static_cast<CEL_Lagrange_Spatial_Function&>(element);
    TakeSelection(function.specieId);
    TakeSelection(function.variableId);
    return true;
  }
  return CElementForm::StoreFields(element) || changed;
}

}  // namespace tessal
