// The forms of particle classes and their members.
#pragma once

#include "ui/form_tables.h"

namespace tessal {

extern const FormTable kSpecieForm;
extern const FormTable kSpecieStateVariableForm;
extern const FormTable kSpecieConstantForm;
extern const FormTable kArithmeticExpressionForm;
extern const FormTable kHorizontalVectorForm;
extern const FormTable kVerticalEquationForm;
extern const FormTable kSpatialFunctionForm;

using CSpecieGeneralView = CTableForm<kSpecieForm>;
using CSpecieStateVariableView = CTableForm<kSpecieStateVariableForm>;
using CSpecieConstantView = CTableForm<kSpecieConstantForm>;
using CSpecieArithmeticExprView = CTableForm<kArithmeticExpressionForm>;
using CSpecieVectorHView = CTableForm<kHorizontalVectorForm>;
using CSpecieVectorVView = CTableForm<kVerticalEquationForm>;

/// A search function. Its choices are linked: they are offered afresh at each load, and a new framework takes
/// the owner and the variable away, with nothing else stored in that commit.
class CSpecieSpatialFunctionView final : public CElementForm {
 public:
  CSpecieSpatialFunctionView(const FormContext& context, QWidget* parent)
      : CElementForm(kSpatialFunctionForm, context, parent) {}

 protected:
  void ItemToForm() override;
  bool StoreFields(CEL_Element& element) override;
};

}  // namespace tessal
