#include "ui/page_actions.h"

#include <QAction>
#include <QApplication>
#include <QCheckBox>
#include <QTabWidget>
#include <QTest>
#include <QToolBar>
#include <map>

#include "ui/row_table.h"

namespace tessal::test {

namespace {

/// "Constants: 2" is a row of a table; "Defined levels: 1 2" is a cell.
QModelIndex CellOf(Editor& editor, const QString& table, const QString& place) {
  const CRowModel& model = editor.Field<CRowTable>(table).Model();
  return model.index(place.section(u' ', 0, 0).toInt() - 1, place.section(u' ', 1, 1).toInt());
}

QToolBar& Commands(Editor& editor) {
  return *editor.View().Form()->findChild<QToolBar*>(QStringLiteral("678"));
}

void RunCommand(Editor& editor, const QString& text, const QString& /*value*/) {
  for (QAction* action : Commands(editor).actions()) {
    if (action->text() == text) action->trigger();
  }
}

void SelectRow(Editor& editor, const QString& table, const QString& row) {
  editor.Field<CRowTable>(table).SelectRow(row.toInt() - 1);
}

void DoubleClick(Editor& editor, const QString& table, const QString& place) {
  auto& rows = editor.Field<CRowTable>(table);
  const QPoint point = rows.visualRect(CellOf(editor, table, place)).center();
  QTest::mouseClick(rows.viewport(), Qt::LeftButton, {}, point);
  QTest::mouseDClick(rows.viewport(), Qt::LeftButton, {}, point);
}

/// "Defined levels: 1 2 text" edits a cell in place.
void EditCell(Editor& editor, const QString& table, const QString& value) {
  DoubleClick(editor, table, value);
  auto* line = qobject_cast<QLineEdit*>(QApplication::focusWidget());
  if (line == nullptr) throw std::runtime_error("the cell is not edited");
  line->setText(value.section(u' ', 2));
  QTest::keyClick(line, Qt::Key_Return);
  // The cell takes the text over in the event loop.
  QCoreApplication::processEvents();
}

void PressInTree(Editor& editor, Qt::Key key) {
  QTest::keyClick(&editor.Tree(), key, Qt::AltModifier);
}

using Action = void (*)(Editor& editor, const QString& what, const QString& value);

const std::map<std::string, Action> kActions = {
    {"run", RunCommand},
    {"row", SelectRow},
    {"double-click", DoubleClick},
    {"edit-cell", EditCell},
    {"enter-row",
     [](Editor& editor, auto& table, auto& row) {
       SelectRow(editor, table, row);
       QTest::keyClick(&editor.Field<CRowTable>(table), Qt::Key_Return);
     }},
    {"tick",
     [](Editor& editor, auto& label, auto& /*value*/) {
       QTest::mouseClick(&editor.Field<QCheckBox>(label), Qt::LeftButton, {}, QPoint(8, 8));
     }},
    {"tab",
     [](Editor& editor, auto& caption, auto& /*value*/) {
       auto* pages = editor.View().Form()->findChild<QTabWidget*>();
       pages->setCurrentIndex(caption == "Overview" ? 1 : 0);
     }},
    {"move-up", [](Editor& editor, auto& /*what*/, auto& /*value*/) { PressInTree(editor, Qt::Key_Up); }},
    {"move-down", [](Editor& editor, auto& /*what*/, auto& /*value*/) { PressInTree(editor, Qt::Key_Down); }},
};

}  // namespace

bool ActOnPage(Editor& editor, const std::string& verb, const QString& what, const QString& value) {
  const auto action = kActions.find(verb);
  if (action == kActions.end()) return false;
  action->second(editor, what, value);
  return true;
}

std::string CommandsText(Editor& editor) {
  std::string text;
  for (const QAction* action : Commands(editor).actions()) {
    if (action->isEnabled()) text += action->text().toStdString() + "|";
  }
  return text + "\n";
}

}  // namespace tessal::test
