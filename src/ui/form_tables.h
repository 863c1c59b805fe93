// The forms of the elements: a class for each, and the table that finds the one for a node.
#pragma once

#include <memory>

#include "ui/element_form.h"

namespace tessal {

class CStateVariableView final : public CElementForm {
 public:
  CStateVariableView(const FormContext& context, QWidget* parent);
};

class CConstantView final : public CElementForm {
 public:
  CConstantView(const FormContext& context, QWidget* parent);
};

class CForcingView final : public CElementForm {
 public:
  CForcingView(const FormContext& context, QWidget* parent);
};

/// What the forms of auxiliaries and processes share: a new scope brings a spatial variation with it, so that
/// the one shown is not stored in the same commit.
class CScopedExpressionView : public CElementForm {
 protected:
  using CElementForm::CElementForm;
  bool StoreFields(CEL_Element& element) override;
};

class CAuxilarieView final : public CScopedExpressionView {
 public:
  CAuxilarieView(const FormContext& context, QWidget* parent);
};

class CProcessView final : public CScopedExpressionView {
 public:
  CProcessView(const FormContext& context, QWidget* parent);
};

class CDerviedView final : public CElementForm {
 public:
  CDerviedView(const FormContext& context, QWidget* parent);
};

/// The settings. The two fields about particles are open exactly while the template has a particle class.
class CMiscView final : public CElementForm {
 public:
  CMiscView(const FormContext& context, QWidget* parent);

 protected:
  bool IsEnabled(const FormField& field, const CEL_Property& property) const override;
};

/// What stands in the right pane for a node that has no form.
class CNoView final : public CRightPaneBase {
 public:
  CNoView(const FormContext& context, QWidget* parent);
};

/// The form for the node of a context; never none.
std::unique_ptr<CRightPaneBase> MakeForm(const FormContext& context, QWidget* parent);

}  // namespace tessal
