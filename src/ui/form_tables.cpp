#include "ui/form_tables.h"

#include <QLabel>
#include <QVBoxLayout>

#include "core/template_core.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/form_fields.h"
#include "ui/strings.h"

namespace tessal {

namespace {

using enum FieldEditor;

constexpr FormField kStateVariableFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {kScopeControl, "Scope", SortedChoice, Of<&CEL_StateVariable::scope>},
    {1059, "Transport", SortedChoice, Of<&CEL_StateVariable::transport>},
    {1079, "Unit", ShortLine, Of<&CEL_StateVariable::unit>},
    kUnitType,
    {1071, "Default value", Number, Of<&CEL_StateVariable::defaultValue>},
    {1085, "Minimum value", Number, Of<&CEL_StateVariable::minValue>},
    {1084, "Maximum value", Number, Of<&CEL_StateVariable::maxValue>},
    {kExpressionControl, "Expression", Expression, Of<&CEL_StateVariable::equation>},
    kReferencedIn,
};

// A field that a built-in quantity has locked is not written.
constexpr FormField OnlyWhileEnabled(FormField field) {
  field.onlyWhileEnabled = true;
  return field;
}

constexpr FormField kInputFields[] = {
    kSymbol,
    OnlyWhileEnabled(kDescription),
    OnlyWhileEnabled(kOnlineHelp),
    OnlyWhileEnabled(kDocumentation),
    {kScopeControl, "Scope", SortedChoice, Of<&CEL_Input::scope>},
    {kSpatialControl, "Spatial var.", SortedChoice, Of<&CEL_Input::spatialVariation>},
    {1062, "User specified", OrderedChoice, Of<&CEL_Input::isUserSpecified>},
    {1042, "Built in ID", OrderedChoice, Of<&CEL_Input::builtInId>},
    kUnitType,
    {1079, "Unit", ShortLine, Of<&CEL_Input::unit>, true},
    {1071, "Default value", Number, Of<&CEL_Input::defaultValue>, true},
    {1085, "Minimum value", Number, Of<&CEL_Input::minValue>, true},
    {1084, "Maximum value", Number, Of<&CEL_Input::maxValue>, true},
    kReferencedIn,
};

// A new scope brings a spatial variation with it.
constexpr FormField kFollowingSpatialVariation{
    .control = kSpatialControl,
    .label = "Spatial var.",
    .editor = SortedChoice,
    .property = Of<&CEL_ExpressionElement::spatialVariation>,
    .follows = kScopeControl,
};

constexpr FormField kAuxiliaryFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {kScopeControl, "Scope", SortedChoice, Of<&CEL_ExpressionElement::scope>},
    kFollowingSpatialVariation,
    {1050, "Output", SortedChoice, Of<&CEL_Auxilliary_Variable::output>},
    {1079, "Unit", ShortLine, Of<&CEL_ExpressionElement::unit>},
    {kExpressionControl, "Expression", Expression, Of<&CEL_ExpressionElement::expression>},
    kReferencedIn,
};

constexpr FormField kProcessFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {kScopeControl, "Scope", SortedChoice, Of<&CEL_ExpressionElement::scope>},
    kFollowingSpatialVariation,
    {1050, "Output", SortedChoice, Of<&CEL_Process::output>},
    {1052, "Process type", SortedChoice, Of<&CEL_Process::processType>},
    {1202, "Control ID", Integer, Of<&CEL_Process::controlId>},
    {1203, "Control value", Number, Of<&CEL_Process::controlValue>},
    {1079, "Unit", ShortLine, Of<&CEL_ExpressionElement::unit>},
    {kExpressionControl, "Expression", Expression, Of<&CEL_ExpressionElement::expression>},
    kReferencedIn,
};

constexpr FormField kDerivedOutputFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {kScopeControl, "Scope", SortedChoice, Of<&CEL_ExpressionElement::scope>},
    {1046, "Format", SortedChoice, Of<&CEL_Derived_Output::format>},
    {kSpatialControl, "Spatial var.", SortedChoice, Of<&CEL_ExpressionElement::spatialVariation>},
    {1079, "Unit", ShortLine, Of<&CEL_ExpressionElement::unit>},
    {kExpressionControl, "Expression", Expression, Of<&CEL_ExpressionElement::expression>},
};

bool HasParticleClass(const TemplateCore& core) {
  return core.GetSpecieCount() > 0;
}

constexpr FormField OnlyWithParticles(FormField field) {
  field.isOpen = HasParticleClass;
  return field;
}

constexpr FormField kMiscFields[] = {
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {1077, "Tessal version", Shown, Of<&CEL_Miscanellous::tessalVersion>},
    {1089, "Parser version", Shown, Of<&CEL_Miscanellous::parserVersion>},
    {1098, "Template revision", Shown, Of<&CEL_Miscanellous::documentRevision>},
    {1095, "Rand. seed", Integer, Of<&CEL_Miscanellous::randSeed>},
    {1043, "Debug level", SortedChoice, Of<&CEL_Miscanellous::debugLevel>},
    {1070, "Debug log", Line, Of<&CEL_Miscanellous::debugLog>},
    OnlyWithParticles({1054, "ABM: random bearing", SortedChoice, Of<&CEL_Miscanellous::randomParticleDir>}),
    OnlyWithParticles({1041, "ABM: search tree", SortedChoice, Of<&CEL_Miscanellous::buildSpatialTree>}),
    {1068, "Checksum", ShortLine, Of<&CEL_Miscanellous::checksum>},
    {1049, "Optimise expressions", SortedChoice, Of<&CEL_Miscanellous::optimise>},
    {1060, "Angle Unit", SortedChoice, Of<&CEL_Miscanellous::trigonometrics>},
};

constexpr FormField kExternalFunctionFields[] = {
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {1092, "Public name", Line, Of<&CEL_ExternalFunction::publicName>},
    {1051, "Parameter count", SortedChoice, Of<&CEL_ExternalFunction::parameters>},
    {1061, "Used as", SortedChoice, Of<&CEL_ExternalFunction::usedAs>},
    {1075, "DLL", Line, Of<&CEL_ExternalFunction::dll>},
    {1078, "Entry point", Line, Of<&CEL_ExternalFunction::entryPoint>},
};

template <auto Members>
std::size_t CountOf(const CEL_Element& root) {
  return (static_cast<const TemplateCore&>(*root.Owner()).Elements().*Members).size();
}

constexpr FormField kGeneralFields[] = {
    kDescription,
    kOnlineHelp,
    kDocumentation,
    CountField(1096, "State variables", CountOf<&Collections::stateVariables>),
    CountField(1069, "Constants", CountOf<&Collections::constants>),
    CountField(1081, "Forcings", CountOf<&Collections::forcings>),
    // Spelt as they have always been.
    CountField(1067, "Auxilary variables", CountOf<&Collections::auxiliaries>),
    CountField(1090, "Processes", CountOf<&Collections::processes>),
    CountField(1073, "Derived ouputs", CountOf<&Collections::derivedOutputs>),
    CountField(1088, "Particle classes", CountOf<&Collections::species>),
};

}  // namespace

constexpr FormTable kStateVariableForm = kStateVariableFields;
constexpr FormTable kInputForm = kInputFields;
constexpr FormTable kAuxiliaryForm = kAuxiliaryFields;
constexpr FormTable kProcessForm = kProcessFields;
constexpr FormTable kDerivedOutputForm = kDerivedOutputFields;
constexpr FormTable kMiscForm = kMiscFields;
constexpr FormTable kExternalFunctionForm = kExternalFunctionFields;
constexpr FormTable kGeneralForm = kGeneralFields;

CNoView::CNoView(const FormContext& context, QWidget* parent) : CRightPaneBase(context, parent) {
  auto* layout = MakeChild<QVBoxLayout>(this);
  auto* text = MakeChild<QLabel>(strings::kNoView, this);
  text->setObjectName(QString::number(control_id::kNoView));
  text->setAlignment(Qt::AlignCenter);
  text->setWordWrap(true);
  layout->addWidget(text);
}

}  // namespace tessal
