// An expression in a form: the field with what helps to fill it in, and under it what the parser says.
#pragma once

#include <QWidget>

#include "ui/expression_completer.h"

class QHBoxLayout;

namespace tessal {

class CAutoRichEditCtrl;
class CExpressionMarks;
class CFormulaPreview;
class CLabel;
class CTessalDoc;

class CExpressionPanel final : public QWidget {
  Q_OBJECT

 public:
  /// The label names the field for those who listen.
  CExpressionPanel(const CTessalDoc& shownDocument, ElementSource shownElement, const QString& label,
                   QWidget* parent);

  CAutoRichEditCtrl& Field() const { return *field; }
  /// Puts a button into the row under the field.
  void AddButton(QWidget& button);

  /// The formula takes what room there is, and needs none.
  QSize minimumSizeHint() const override;

 signals:
  /// The caret is at a line and a column, both from 1.
  void CaretMoved(int line, int column);
  /// What is wrong at the caret or before anything else, in plain language; empty when nothing is.
  void FaultChanged(const QString& plain);

 protected:
  void resizeEvent(QResizeEvent* resize) override;

 private:
  void ReportCaret();
  void ShowFault();
  void ShowFormula();
  /// Gives the formula the room that the field can spare.
  void FitFormula();

  CAutoRichEditCtrl* field;
  CExpressionMarks* marks;
  CLabel* note;
  CFormulaPreview* formula;
  ElementSource element;
  QHBoxLayout* foot;
};

}  // namespace tessal
