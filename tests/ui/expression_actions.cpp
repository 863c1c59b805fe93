#include "ui/expression_actions.h"

#include <QAbstractItemView>
#include <QApplication>
#include <QKeySequence>
#include <QLabel>
#include <QTest>
#include <algorithm>

namespace tessal::test {

namespace {

/// The text with a bar at the caret, the marks over it, the tip of a call, and the rows of the list of
/// completions, the chosen one with a mark.
std::string Shown(const CAutoRichEditCtrl& field) {
  QString text = field.ContentText();
  text.insert(field.textCursor().position(), u'|');
  QString shown = text + u'\n';
  for (const QTextEdit::ExtraSelection& mark : field.extraSelections()) {
    const bool isFault = mark.format.underlineStyle() == QTextCharFormat::WaveUnderline;
    shown += QStringLiteral("%1 at %2: %3\n")
                 .arg(isFault ? QStringLiteral("fault") : QStringLiteral("bracket"))
                 .arg(mark.cursor.selectionStart())
                 .arg(mark.cursor.selectedText());
  }
  const auto* tip = field.findChild<QLabel*>(QStringLiteral("CallTip"));
  if (tip != nullptr && tip->isVisible()) shown += QStringLiteral("tip: ") + tip->text() + u'\n';
  if (const auto* list = qobject_cast<const QAbstractItemView*>(QApplication::activePopupWidget())) {
    constexpr int kShown = 5;
    const QAbstractItemModel& rows = *list->model();
    for (int row = 0; row < std::min(rows.rowCount(), kShown); ++row) {
      shown += list->currentIndex().row() == row ? u'*' : u' ';
      shown += rows.index(row, 0).data().toString() + QStringLiteral(", ") +
               rows.index(row, 1).data().toString() + u'\n';
    }
    if (rows.rowCount() > kShown) shown += QStringLiteral("  %1 more\n").arg(rows.rowCount() - kShown);
  }
  return shown.toStdString();
}

}  // namespace

std::string PressKeys(Editor& editor, const QString& label, const QString& keys) {
  auto& field = editor.Field<CAutoRichEditCtrl>(label);
  if (QApplication::activePopupWidget() == nullptr) field.setFocus();
  for (qsizetype place = 0; place < keys.size(); ++place) {
    QWidget* popup = QApplication::activePopupWidget();
    QWidget* target = popup != nullptr ? popup : QApplication::focusWidget();
    const qsizetype end = keys[place] == u'<' ? keys.indexOf(u'>', place) : -1;
    if (end < 0) {
      QTest::keyClicks(target, keys.mid(place, 1));
      continue;
    }
    const QKeyCombination key = QKeySequence(keys.mid(place + 1, end - place - 1))[0];
    QTest::keyClick(target, key.key(), key.keyboardModifiers());
    place = end;
  }
  return Shown(field);
}

std::string TipIn(Editor& editor, const QString& label, int position) {
  auto& field = editor.Field<CAutoRichEditCtrl>(label);
  QTextCursor cursor(field.document());
  cursor.setPosition(position);
  return field.TipAt(field.cursorRect(cursor).center() + QPoint(2, 0)).toStdString() + "\n";
}

}  // namespace tessal::test
