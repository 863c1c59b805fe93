// Marks that lie over an expression while it is edited: the bracket that belongs to the one at the caret, and
// a wavy line under what is wrong. Faults are looked for when typing pauses, and at once when the field is
// filled.
#pragma once

#include <QObject>
#include <QTextEdit>
#include <vector>

#include "core/expression_faults.h"
#include "ui/expression_completer.h"

class QTimer;

namespace tessal {

class CExpressionMarks final : public QObject {
  Q_OBJECT

 public:
  /// Belongs to the field.
  CExpressionMarks(CAutoRichEditCtrl& shownField, const CTessalDoc& shownDocument,
                   ElementSource shownElement);

  /// What is wrong at the caret, else the first of what is wrong; none while nothing is, or not known yet.
  const ExpressionFault* PresentFault() const;
  /// What is wrong at a position of the text, in plain language; empty where nothing is.
  QString FaultAt(int position) const;

 signals:
  /// The present fault has become another, or none.
  void FaultChanged();

 private:
  /// A fault between two positions on the screen.
  struct Place {
    int begin = 0;
    int end = 0;
    ExpressionFault fault;

    bool Holds(int position) const { return begin <= position && position <= end; }
  };

  void FollowText();
  void FollowCaret();
  void LookForFaults();
  void Show();
  void AppendBrackets(QList<QTextEdit::ExtraSelection>& marks) const;
  void Append(QList<QTextEdit::ExtraSelection>& marks, int begin, int end,
              const QTextCharFormat& looks) const;

  CAutoRichEditCtrl& field;
  const CTessalDoc& document;
  ElementSource element;
  QTimer* pause;
  std::vector<Place> faults;
};

}  // namespace tessal
