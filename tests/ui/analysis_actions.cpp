#include "ui/analysis_actions.h"

#include <QAbstractItemView>
#include <QHeaderView>
#include <QLabel>
#include <QTabWidget>
#include <QTableView>
#include <QTest>

#include "ui/analysis_pane.h"
#include "ui/analysis_tools.h"
#include "ui/influence_view.h"
#include "ui/unit_note.h"

namespace tessal::test {

namespace {

void AppendRows(const QAbstractItemView& view, QStringList& lines) {
  const QAbstractItemModel& model = *view.model();
  const bool hasRowTitles = qobject_cast<const QTableView*>(&view) != nullptr;
  QStringList cells;
  for (int column = 0; column < model.columnCount(); ++column)
    cells.append(model.headerData(column, Qt::Horizontal).toString());
  lines.append(view.accessibleName() + QStringLiteral(": ") + cells.join(QStringLiteral(" | ")));
  for (int row = 0; row < model.rowCount(); ++row) {
    cells.clear();
    if (hasRowTitles) cells.append(model.headerData(row, Qt::Vertical).toString() + u':');
    for (int column = 0; column < model.columnCount(); ++column)
      cells.append(model.index(row, column).data().toString());
    lines.append((row == view.currentIndex().row() ? "> " : "  ") + cells.join(QStringLiteral(" | ")));
  }
}

}  // namespace

std::string AnalysisText(Editor& editor) {
  CAnalysisPane& pane = editor.View().Analyses().Pane();
  if (!pane.isVisible()) return "no pane\n";
  pane.CatchUp();
  const auto& pages = *pane.findChild<QTabWidget*>();
  QStringList lines = {pages.tabText(pages.currentIndex())};
  const QWidget& page = *pages.currentWidget();
  for (const auto* label : page.findChildren<QLabel*>()) {
    const QWidget* field = label->buddy();
    if (!label->isVisible() || label->text().isEmpty()) continue;
    const QString shown = field == nullptr ? QString() : Editor::TextOf(*field);
    lines.append(label->text() + (shown.isEmpty() ? QString() : u' ' + shown));
  }
  for (const auto* view : page.findChildren<QAbstractItemView*>()) {
    if (view->isVisible() && qobject_cast<const QHeaderView*>(view) == nullptr) AppendRows(*view, lines);
  }
  for (const auto* drawing : page.findChildren<CInfluenceView*>()) lines.append(drawing->DrawnText());
  return lines.join(u'\n').toStdString() + "\n";
}

void EnterCell(QWidget& table, const QString& cell) {
  auto& view = dynamic_cast<QAbstractItemView&>(table);
  view.setFocus();
  const int column = cell.contains(u' ') ? cell.section(u' ', 1).toInt() - 1 : 0;
  view.setCurrentIndex(view.model()->index(cell.section(u' ', 0, 0).toInt() - 1, column));
  QTest::keyClick(&view, Qt::Key_Return);
}

std::string UnitNoteText(Editor& editor) {
  QCoreApplication::processEvents();
  const auto* note = editor.View().Form()->findChild<CUnitNote*>();
  if (note == nullptr) return "no place for it\n";
  return (note->isVisible() ? note->Text().toStdString() : "none") + "\n";
}

}  // namespace tessal::test
