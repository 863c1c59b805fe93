// A dialog with a keypad for expressions. It is a shell for a later version: it neither reads nor changes the
// expression.
#pragma once

#include <QDialog>

namespace tessal {

class CExpressionEditorDlg final : public QDialog {
  Q_OBJECT

 public:
  explicit CExpressionEditorDlg(QWidget* parent);
};

}  // namespace tessal
