// The table of all elements of a template, as it was when the page was first seen: a row leads to its
// element, and the whole goes to the clipboard as text.
#pragma once

#include <vector>

#include "docgen/overview.h"
#include "ui/right_pane.h"

namespace tessal {

class CRowTable;

class COverviewPpg final : public CRightPaneBase {
  Q_OBJECT

 public:
  COverviewPpg(const FormContext& context, QWidget* parent);

 protected:
  void ItemToForm() override;
  void showEvent(QShowEvent* seen) override;

 private:
  void Fill();
  void CopyToClipboard();
  /// Writes the documentation page beside the template, after a question. A failure is shown before the
  /// closing message, which reads the same whatever came of it.
  void ExportPage();

  CRowTable* table;
  std::vector<OverviewRow> shown;
  bool isFilled = false;
};

}  // namespace tessal
