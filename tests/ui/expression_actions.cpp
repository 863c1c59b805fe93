#include "ui/expression_actions.h"

#include <QAbstractItemView>
#include <QApplication>
#include <QKeySequence>
#include <QTest>
#include <algorithm>

namespace tessal::test {

namespace {

/// The text with a bar at the caret, and the rows of the list of completions, the chosen one with a mark.
std::string Shown(const CAutoRichEditCtrl& field) {
  QString text = field.ContentText();
  text.insert(field.textCursor().position(), u'|');
  QString shown = text + u'\n';
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

}  // namespace tessal::test
