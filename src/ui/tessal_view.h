// The form of the root: a page with the texts of the template as a whole, and one with all its elements.
#pragma once

#include "ui/right_pane.h"

class QTabWidget;

namespace tessal {

class CGeneralPpg;
class COverviewPpg;

class CTessalView final : public CRightPaneBase {
 public:
  CTessalView(const FormContext& context, QWidget* parent);

  std::vector<TypedValue> TypedValues() const override;
  QWidget* ShowText(const TextToShow& text) override;

 protected:
  /// Fills the pages, and opens the one that was open at the last visit.
  void ItemToForm() override;
  void FormToItem() override;

 private:
  QTabWidget* pages;
  CGeneralPpg* general;
  COverviewPpg* overview;
};

}  // namespace tessal
