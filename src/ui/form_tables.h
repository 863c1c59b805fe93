// The forms of the elements: a table of fields for each, and the class over it.
#pragma once

#include "ui/element_form.h"

namespace tessal {

/// A form that is its table of fields and nothing more.
template <const FormTable& Fields>
class CTableForm final : public CElementForm {
 public:
  CTableForm(const FormContext& context, QWidget* parent) : CElementForm(Fields, context, parent) {}
};

extern const FormTable kStateVariableForm;
extern const FormTable kInputForm;
extern const FormTable kAuxiliaryForm;
extern const FormTable kProcessForm;
extern const FormTable kDerivedOutputForm;
extern const FormTable kMiscForm;
extern const FormTable kExternalFunctionForm;
extern const FormTable kGeneralForm;

using CStateVariableView = CTableForm<kStateVariableForm>;
using CConstantView = CTableForm<kInputForm>;
using CForcingView = CTableForm<kInputForm>;
using CAuxilarieView = CTableForm<kAuxiliaryForm>;
using CProcessView = CTableForm<kProcessForm>;
using CDerviedView = CTableForm<kDerivedOutputForm>;
/// The settings. The two fields about particles are open exactly while the template has a particle class.
using CMiscView = CTableForm<kMiscForm>;
using CExternalFunctionView = CTableForm<kExternalFunctionForm>;

/// What the right pane shows for a node that has no form.
class CNoView final : public CRightPaneBase {
 public:
  CNoView(const FormContext& context, QWidget* parent);
};

}  // namespace tessal
