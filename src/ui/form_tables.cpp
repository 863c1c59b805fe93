#include "ui/form_tables.h"

#include <QLabel>
#include <QVBoxLayout>
#include <array>

#include "core/document.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/strings.h"

namespace tessal {

namespace {

template <class Owner>
Owner OwnerOf(CEL_Property Owner::*);

/// The property of an element as a field's table names it.
template <auto Member>
CEL_Property& Of(CEL_Element& element) {
  using Owner = decltype(OwnerOf(Member));
  return static_cast<Owner&>(element).*Member;
}

using enum FieldEditor;

constexpr FormField kSymbol{control_id::kSymbol, "Symbol", Symbol, Of<&CEL_Element::symbol>};
constexpr FormField kDescription{control_id::kDescription, "Description", Lines,
                                 Of<&CEL_Element::description>};
constexpr FormField kOnlineHelp{control_id::kOnlineHelp, "Online help", Line, Of<&CEL_Element::onlineHelp>};
constexpr FormField kDocumentation{control_id::kDocumentation, "Documentation", Documentation,
                                   Of<&CEL_Element::documentation>};
constexpr FormField kReferencedIn{control_id::kReferencedIn, "Referenced in", ReferencedIn, nullptr};
constexpr FormField kUnitType{1045, "Unq type", SortedChoice, Of<&CEL_Element::unqType>};

constexpr int kScopeControl = 1055;
constexpr int kSpatialControl = 1056;

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
    {1115, "Expression", Expression, Of<&CEL_StateVariable::equation>},
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

constexpr FormField kAuxiliaryFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {kScopeControl, "Scope", SortedChoice, Of<&CEL_ExpressionElement::scope>},
    {kSpatialControl, "Spatial var.", SortedChoice, Of<&CEL_ExpressionElement::spatialVariation>},
    {1050, "Output", SortedChoice, Of<&CEL_Auxilliary_Variable::output>},
    {1079, "Unit", ShortLine, Of<&CEL_ExpressionElement::unit>},
    {1115, "Expression", Expression, Of<&CEL_ExpressionElement::expression>},
    kReferencedIn,
};

constexpr FormField kProcessFields[] = {
    kSymbol,
    kDescription,
    kOnlineHelp,
    kDocumentation,
    {kScopeControl, "Scope", SortedChoice, Of<&CEL_ExpressionElement::scope>},
    {kSpatialControl, "Spatial var.", SortedChoice, Of<&CEL_ExpressionElement::spatialVariation>},
    {1050, "Output", SortedChoice, Of<&CEL_Process::output>},
    {1052, "Process type", SortedChoice, Of<&CEL_Process::processType>},
    {1079, "Unit", ShortLine, Of<&CEL_ExpressionElement::unit>},
    {1115, "Expression", Expression, Of<&CEL_ExpressionElement::expression>},
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
    {1115, "Expression", Expression, Of<&CEL_ExpressionElement::expression>},
};

constexpr int kRandomBearingControl = 1054;
constexpr int kSearchTreeControl = 1041;

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
    {kRandomBearingControl, "ABM: random bearing", SortedChoice, Of<&CEL_Miscanellous::randomParticleDir>},
    {kSearchTreeControl, "ABM: search tree", SortedChoice, Of<&CEL_Miscanellous::buildSpatialTree>},
    {1068, "Checksum", ShortLine, Of<&CEL_Miscanellous::checksum>},
    {1049, "Optimise expressions", SortedChoice, Of<&CEL_Miscanellous::optimise>},
    {1060, "Angle Unit", SortedChoice, Of<&CEL_Miscanellous::trigonometrics>},
};

constexpr FormTable kStateVariableForm{ElementKind::StateVariable, 675, 100, kStateVariableFields};
constexpr FormTable kConstantForm{ElementKind::Constant, 653, 102, kInputFields};
constexpr FormTable kForcingForm{ElementKind::Forcing, 660, 106, kInputFields};
constexpr FormTable kAuxiliaryForm{ElementKind::Auxiliary, 652, 101, kAuxiliaryFields};
constexpr FormTable kProcessForm{ElementKind::Process, 667, 119, kProcessFields};
constexpr FormTable kDerivedOutputForm{ElementKind::DerivedOutput, 655, 120, kDerivedOutputFields};
constexpr FormTable kMiscForm{ElementKind::Miscellaneous, 665, 110, kMiscFields};

template <class Form>
std::unique_ptr<CRightPaneBase> Make(const FormContext& context, QWidget* parent) {
  return std::make_unique<Form>(context, parent);
}

struct FormRow {
  ElementKind kind;
  std::unique_ptr<CRightPaneBase> (*make)(const FormContext& context, QWidget* parent);
};

constexpr std::array<FormRow, 7> kForms = {{
    {ElementKind::StateVariable, Make<CStateVariableView>},
    {ElementKind::Constant, Make<CConstantView>},
    {ElementKind::Forcing, Make<CForcingView>},
    {ElementKind::Auxiliary, Make<CAuxilarieView>},
    {ElementKind::Process, Make<CProcessView>},
    {ElementKind::DerivedOutput, Make<CDerviedView>},
    {ElementKind::Miscellaneous, Make<CMiscView>},
}};

}  // namespace

CStateVariableView::CStateVariableView(const FormContext& context, QWidget* parent)
    : CElementForm(kStateVariableForm, context, parent) {}

CConstantView::CConstantView(const FormContext& context, QWidget* parent)
    : CElementForm(kConstantForm, context, parent) {}

CForcingView::CForcingView(const FormContext& context, QWidget* parent)
    : CElementForm(kForcingForm, context, parent) {}

CAuxilarieView::CAuxilarieView(const FormContext& context, QWidget* parent)
    : CScopedExpressionView(kAuxiliaryForm, context, parent) {}

CProcessView::CProcessView(const FormContext& context, QWidget* parent)
    : CScopedExpressionView(kProcessForm, context, parent) {}

CDerviedView::CDerviedView(const FormContext& context, QWidget* parent)
    : CElementForm(kDerivedOutputForm, context, parent) {}

CMiscView::CMiscView(const FormContext& context, QWidget* parent)
    : CElementForm(kMiscForm, context, parent) {}

bool CScopedExpressionView::StoreFields(CEL_Element& element) {
  bool changed = false;
  bool newScope = false;
  for (const Control& control : Controls()) {
    if (newScope && control.field->control == kSpatialControl) continue;
    const bool stored = Store(control, element);
    if (control.field->control == kScopeControl) newScope = stored;
    changed = changed || stored;
  }
  return changed;
}

bool CMiscView::IsEnabled(const FormField& field, const CEL_Property& property) const {
  if (field.control == kRandomBearingControl || field.control == kSearchTreeControl) {
    return Core().GetSpecieCount() > 0;
  }
  return CElementForm::IsEnabled(field, property);
}

CNoView::CNoView(const FormContext& context, QWidget* parent) : CRightPaneBase(context, parent) {
  auto* layout = MakeChild<QVBoxLayout>(this);
  auto* text = MakeChild<QLabel>(strings::kNoView, this);
  text->setObjectName(QString::number(control_id::kNoView));
  text->setAlignment(Qt::AlignCenter);
  text->setWordWrap(true);
  layout->addWidget(text);
}

std::unique_ptr<CRightPaneBase> MakeForm(const FormContext& context, QWidget* parent) {
  for (const FormRow& row : kForms) {
    const bool isElement = IsElement(context.item.id) || context.item.kind == ElementKind::Miscellaneous;
    if (isElement && row.kind == context.item.kind) return row.make(context, parent);
  }
  return std::make_unique<CNoView>(context, parent);
}

}  // namespace tessal
