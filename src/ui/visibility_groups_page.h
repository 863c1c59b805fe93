// The list of the visibility groups.
#pragma once

#include "ui/list_page.h"

namespace tessal {

class CVisibilityGroupsDlg final : public CListPage {
 public:
  CVisibilityGroupsDlg(const FormContext& context, QWidget* parent);

 protected:
  void ItemToForm() override;
  bool CanRun(Command command, int row) const override;
  void Run(Command command, int row) override;
  void EnterRow(int row) override;
};

}  // namespace tessal
