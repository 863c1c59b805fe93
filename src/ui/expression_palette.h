// A button with a menu of what an expression may be made of: operators, and the functions by their subjects.
// A choice goes into the field at the caret; what is selected there becomes its first part.
#pragma once

#include <QString>
#include <QToolButton>

namespace tessal {

class CAutoRichEditCtrl;
struct FunctionReference;

class CExpressionPalette final : public QToolButton {
  Q_OBJECT

 public:
  CExpressionPalette(CAutoRichEditCtrl& filledField, QWidget* parent);

 private:
  /// What is written before and after the selection.
  struct Insertion {
    QString before;
    QString after;
    int back = 0;  ///< how far before the end the caret is, after a selection
  };

  void FillMenu();
  void AddFunction(QMenu& group, const FunctionReference& function);
  void Insert(const Insertion& insertion);

  CAutoRichEditCtrl& field;
};

}  // namespace tessal
