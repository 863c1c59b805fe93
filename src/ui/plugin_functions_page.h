// The list of the plug-in user functions. A template's functions are neither made nor moved here: all that is
// left to do is to enter one.
#pragma once

#include "ui/list_page.h"

namespace tessal {

class CPluginFunctionsDlg final : public CListPage {
 public:
  CPluginFunctionsDlg(const FormContext& context, QWidget* parent);

 protected:
  void ItemToForm() override;
  void EnterRow(int row) override;
};

}  // namespace tessal
