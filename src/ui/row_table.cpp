#include "ui/row_table.h"

#include <QHeaderView>
#include <QHelpEvent>
#include <QKeyEvent>
#include <QToolTip>
#include <algorithm>
#include <numeric>
#include <utility>

#include "ui/child.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// A column with long texts leaves room for the others: its texts end in "...", and a tip shows the whole.
constexpr int kWidestColumn = 60;  // in characters
constexpr int kCellMargin = 16;
/// How many of a column's longest texts are measured in pixels.
constexpr std::size_t kMeasured = 32;

}  // namespace

CRowTable::CRowTable(int control, const QString& name, QWidget* parent)
    : QTreeView(parent), rows(MakeChild<CRowModel>(this)) {
  setObjectName(QString::number(control));
  setAccessibleName(name);
  setModel(rows);
  setRootIsDecorated(false);
  setItemsExpandable(false);
  setUniformRowHeights(true);
  setAllColumnsShowFocus(true);
  setSelectionBehavior(SelectRows);
  setSelectionMode(SingleSelection);
  setEditTriggers(DoubleClicked | EditKeyPressed);
  setTabKeyNavigation(false);
  connect(this, &QTreeView::doubleClicked, this, [this](const QModelIndex& cell) {
    if ((rows->flags(cell) & Qt::ItemIsEditable) == 0) emit RowEntered(cell.row());
  });
  connect(selectionModel(), &QItemSelectionModel::currentRowChanged, this,
          [this](const QModelIndex& current) { emit RowSelected(current.isValid() ? current.row() : -1); });
}

void CRowTable::Fill(QStringList titles, std::vector<CRowModel::Row> shown, CRowModel::TextOf textOf) {
  rows->Fill(std::move(titles), std::move(shown), std::move(textOf));
  SizeColumns();
  emit RowSelected(-1);
}

void CRowTable::AllowSeveral(std::function<void(int row)> moveTo) {
  rows->AllowMoving(std::move(moveTo));
  setSelectionMode(ExtendedSelection);
  setDragEnabled(true);
  setAcceptDrops(true);
  setDropIndicatorShown(true);
  setDragDropOverwriteMode(false);
  setDragDropMode(InternalMove);
}

std::vector<int> CRowTable::SelectedRows() const {
  std::vector<int> selected;
  for (const QModelIndex& row : selectionModel()->selectedRows()) selected.push_back(row.row());
  std::sort(selected.begin(), selected.end());
  return selected;
}

int CRowTable::CurrentRow() const {
  return currentIndex().isValid() ? currentIndex().row() : -1;
}

void CRowTable::SelectRow(int row, ScrollHint place) {
  if (rows->rowCount() == 0) return;
  const QModelIndex target = rows->index(std::clamp(row, 0, rows->rowCount() - 1), 0);
  setCurrentIndex(target);
  scrollTo(target, place);
}

void CRowTable::keyPressEvent(QKeyEvent* key) {
  const bool isEnter = key->key() == Qt::Key_Return || key->key() == Qt::Key_Enter;
  if (isEnter && key->modifiers() == Qt::NoModifier && CurrentRow() >= 0) {
    emit RowEntered(CurrentRow());
    return;
  }
  QTreeView::keyPressEvent(key);
}

bool CRowTable::viewportEvent(QEvent* happened) {
  if (happened->type() != QEvent::ToolTip) return QTreeView::viewportEvent(happened);
  const auto* help = static_cast<QHelpEvent*>(happened);
  const QModelIndex cell = indexAt(help->pos());
  const QString whole = cell.data(Qt::EditRole).toString();
  const bool isCut =
      cell.isValid() &&
      fontMetrics().horizontalAdvance(cell.data().toString()) + kCellMargin / 2 > visualRect(cell).width();
  QToolTip::showText(help->globalPos(), isCut ? whole.toHtmlEscaped() : QString(), this);
  return true;
}

int CRowTable::WidthOfLongest(int column) const {
  std::vector<std::pair<std::size_t, int>> lengths;
  lengths.reserve(rows->Rows().size());
  for (int row = 0; row < rows->rowCount(); ++row)
    lengths.emplace_back(rows->TextAt(row, column).size(), row);
  const std::size_t measured = std::min(kMeasured, lengths.size());
  std::partial_sort(lengths.begin(), lengths.begin() + static_cast<std::ptrdiff_t>(measured), lengths.end(),
                    std::greater<>());
  const QFontMetrics metrics = fontMetrics();
  return std::accumulate(lengths.begin(), lengths.begin() + static_cast<std::ptrdiff_t>(measured), 0,
                         [this, column, &metrics](int widest, const auto& length) {
                           const QString text = rows->index(length.second, column).data().toString();
                           return std::max(widest, metrics.horizontalAdvance(text));
                         });
}

void CRowTable::SizeColumns() {
  const int limit = kWidestColumn * fontMetrics().averageCharWidth();
  for (int column = 0; column < rows->columnCount(); ++column) {
    int content = WidthOfLongest(column) + kCellMargin;
    if (rows->index(0, column).data(Qt::DecorationRole).isValid()) {
      content += style()->pixelMetric(QStyle::PM_SmallIconSize) + kCellMargin / 2;
    }
    setColumnWidth(column, std::max(header()->sectionSizeHint(column), std::min(content, limit)));
  }
}

}  // namespace tessal
