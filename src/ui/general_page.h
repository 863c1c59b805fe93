// The texts of the template as a whole, the counts of its elements, and three options.
#pragma once

#include "ui/element_form.h"

class QCheckBox;

namespace tessal {

class CGeneralPpg final : public CElementForm {
  Q_OBJECT

 public:
  CGeneralPpg(const FormContext& context, QWidget* parent);

 protected:
  CEL_Element* Element() const override;
  void ItemToForm() override;
  /// A documentation file is looked for beside the template first.
  QString DocumentationFolder() const override;
  /// A chosen file is stored at once.
  void OnDocumentationChosen() override { NoteChosen(); }

 private:
  QCheckBox* AddOption(int control, const QString& caption);
  /// Shows or hides a branch of the tree, and keeps the state with the node.
  void ShowBranch(const char* state, int hintNumber, bool on);

  QCheckBox* misc;
  QCheckBox* particles;
  QCheckBox* allBuiltIns;
};

}  // namespace tessal
