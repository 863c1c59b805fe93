#include "ui/expression_actions.h"

#include <QAbstractItemView>
#include <QApplication>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QImage>
#include <QKeySequence>
#include <QMenu>
#include <QTest>
#include <QTimer>
#include <algorithm>

#include "ui/call_tip.h"
#include "ui/expression_palette.h"
#include "ui/formula_preview.h"

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
  const auto* tip = field.findChild<CCallTip*>();
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
    QWidget* const focused = QApplication::focusWidget();
    QWidget* target = popup != nullptr ? popup : focused != nullptr ? focused : &field;
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

std::string InsertFromPalette(Editor& editor, const QString& label, const QString& menu,
                              const QString& entry) {
  auto& field = editor.Field<CAutoRichEditCtrl>(label);
  QMenu& palette = *field.parentWidget()->findChild<CExpressionPalette*>()->menu();
  emit palette.aboutToShow();
  for (const QAction* group : palette.actions()) {
    if (group->text() != menu) continue;
    for (QAction* action : group->menu()->actions()) {
      if (action->text().startsWith(entry)) {
        action->trigger();
        return Shown(field);
      }
    }
  }
  return "no such entry\n";
}

std::string UseFormula(Editor& editor, const QString& label, const QString& entry) {
  auto& formula = *editor.Field(label).parentWidget()->findChild<CFormulaPreview*>();
  QApplication::clipboard()->clear();
  QTimer::singleShot(0, &formula, [&entry] {
    auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
    if (menu == nullptr) return;
    for (QAction* action : menu->actions()) {
      if (!entry.isEmpty() && action->text().remove(u'&').contains(entry)) menu->setActiveAction(action);
    }
    QTest::keyClick(menu, menu->activeAction() != nullptr ? Qt::Key_Return : Qt::Key_Escape);
  });
  QContextMenuEvent byKey(QContextMenuEvent::Keyboard, QPoint(0, 0), QPoint(0, 0));
  QApplication::sendEvent(formula.viewport(), &byKey);
  QCoreApplication::processEvents();
  QString text = formula.isVisible() ? formula.accessibleDescription() : QStringLiteral("hidden");
  const QString copied = QApplication::clipboard()->text();
  if (!copied.isEmpty()) text += u'\n' + copied.trimmed();
  const QImage picture = QApplication::clipboard()->image();
  if (!picture.isNull())
    text += picture.width() > picture.height() ? QStringLiteral("\na wide picture")
                                               : QStringLiteral("\na picture");
  return text.toStdString() + "\n";
}

std::string TipIn(Editor& editor, const QString& label, int position) {
  auto& field = editor.Field<CAutoRichEditCtrl>(label);
  QTextCursor cursor(field.document());
  cursor.setPosition(position);
  return field.TipAt(field.cursorRect(cursor).center() + QPoint(2, 0)).toStdString() + "\n";
}

}  // namespace tessal::test
