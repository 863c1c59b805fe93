#include "ui/row_model.h"

#include <QTimer>
#include <algorithm>
#include <utility>

#include "ui/text_bytes.h"

namespace tessal {

void CRowModel::Fill(QStringList columnTitles, std::vector<Row> shownRows, TextOf lookUp) {
  beginResetModel();
  titles = std::move(columnTitles);
  rows = std::move(shownRows);
  textOf = std::move(lookUp);
  endResetModel();
}

void CRowModel::AllowEditing(std::vector<int> columns, StoreText store) {
  editableColumns = std::move(columns);
  storeText = std::move(store);
}

void CRowModel::ShowIcons(int column, std::function<QIcon(const Row& row)> iconOf,
                          std::function<QString(const Row& row)> wordsOf) {
  iconColumn = column;
  icon = std::move(iconOf);
  iconWords = std::move(wordsOf);
}

std::string CRowModel::TextAt(int row, int column) const {
  return textOf(rows[static_cast<std::size_t>(row)], column);
}

void CRowModel::RemoveRowAt(int row) {
  beginRemoveRows({}, row, row);
  rows.erase(rows.begin() + row);
  endRemoveRows();
}

void CRowModel::ExchangeRows(int row, int other) {
  const auto [first, second] = std::minmax(row, other);
  if (first == second) return;
  beginMoveRows({}, second, second, {}, first);
  std::rotate(rows.begin() + first, rows.begin() + second, rows.begin() + second + 1);
  endMoveRows();
}

void CRowModel::RefreshRow(int row) {
  emit dataChanged(index(row, 0), index(row, columnCount() - 1));
}

int CRowModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(rows.size());
}

int CRowModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(titles.size());
}

QVariant CRowModel::data(const QModelIndex& index, int role) const {
  if (role == Qt::DisplayRole || role == Qt::EditRole) {
    return ToScreen(TextAt(index.row(), index.column())).replace(u'\n', role == Qt::EditRole ? u'\n' : u' ');
  }
  if (role == Qt::DecorationRole && index.column() == iconColumn && icon) {
    return icon(rows[static_cast<std::size_t>(index.row())]);
  }
  if (role == Qt::AccessibleTextRole && index.column() == iconColumn && iconWords) {
    const QString words = iconWords(rows[static_cast<std::size_t>(index.row())]);
    return words.isEmpty() ? index.data() : words + u' ' + index.data().toString();
  }
  return {};
}

bool CRowModel::setData(const QModelIndex& index, const QVariant& value, int role) {
  if (role != Qt::EditRole || !storeText) return false;
  storeText(index.row(), index.column(), value.toString());
  return true;
}

QVariant CRowModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
  return titles.value(section);
}

bool CRowModel::dropMimeData(const QMimeData* /*data*/, Qt::DropAction /*action*/, int row, int /*column*/,
                             const QModelIndex& parent) {
  if (!moveRowsTo || parent.isValid()) return false;
  const int target = row < 0 ? rowCount() : row;
  // The view is still busy with the drag.
  QTimer::singleShot(0, this, [this, target] { moveRowsTo(target); });
  return true;
}

Qt::ItemFlags CRowModel::flags(const QModelIndex& index) const {
  const bool isEditable =
      std::find(editableColumns.begin(), editableColumns.end(), index.column()) != editableColumns.end();
  Qt::ItemFlags plain = QAbstractTableModel::flags(index) | Qt::ItemNeverHasChildren;
  // What is dragged goes between rows, not into one.
  if (moveRowsTo) plain |= index.isValid() ? Qt::ItemIsDragEnabled : Qt::ItemIsDropEnabled;
  return isEditable ? plain | Qt::ItemIsEditable : plain;
}

}  // namespace tessal
