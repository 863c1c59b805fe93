// An expression in a form: the field with what helps to fill it in, and under it what the parser says.
#pragma once

#include <QWidget>

#include "ui/expression_completer.h"

class QHBoxLayout;

namespace tessal {

class CAutoRichEditCtrl;
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

 private:
  CAutoRichEditCtrl* field;
  CLabel* note;
  QHBoxLayout* foot;
};

}  // namespace tessal
