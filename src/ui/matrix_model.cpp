#include "ui/matrix_model.h"

#include <algorithm>
#include <utility>

#include "ui/plain_tip.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

QString TipOf(const MatrixElement& element, const std::string& rate) {
  QStringList parts = {ToScreen(element.symbol)};
  for (const std::string* part : {&element.description, &element.unit, &rate}) {
    if (!part->empty()) parts.append(ToScreen(*part));
  }
  return PlainTip(parts.join(QStringLiteral(", ")));
}

}  // namespace

void CMatrixModel::Show(ProcessMatrix shown) {
  beginResetModel();
  matrix = std::move(shown);
  hasOther =
      std::any_of(matrix.other.begin(), matrix.other.end(), [](const auto& other) { return !other.empty(); });
  endResetModel();
}

const MatrixElement* CMatrixModel::ProcessOf(int row) const {
  const auto place = static_cast<std::size_t>(row);
  return place < matrix.rows.size() ? &matrix.rows[place].process : nullptr;
}

const MatrixElement* CMatrixModel::StateOf(int column) const {
  const auto place = static_cast<std::size_t>(column);
  return place < matrix.states.size() ? &matrix.states[place] : nullptr;
}

std::vector<std::size_t> CMatrixModel::ColumnLengths() const {
  std::vector<std::size_t> lengths;
  lengths.reserve(matrix.states.size() + 1);
  for (const MatrixElement& state : matrix.states) lengths.push_back(state.symbol.size());
  lengths.push_back(static_cast<std::size_t>(strings::kRateColumn.size()));
  for (std::size_t column = 0; column < matrix.other.size(); ++column)
    lengths[column] = std::max(lengths[column], matrix.other[column].size());
  for (const MatrixRow& row : matrix.rows) {
    lengths.back() = std::max(lengths.back(), row.rate.size());
    for (const MatrixCell& cell : row.cells)
      lengths[cell.column] = std::max(lengths[cell.column], cell.factor.size());
  }
  return lengths;
}

int CMatrixModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(matrix.rows.size()) + (hasOther ? 1 : 0);
}

int CMatrixModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() || rowCount() == 0 ? 0 : static_cast<int>(matrix.states.size()) + 1;
}

std::string CMatrixModel::TextOf(const QModelIndex& cell) const {
  const auto row = static_cast<std::size_t>(cell.row());
  const auto column = static_cast<std::size_t>(cell.column());
  if (row >= matrix.rows.size()) return column < matrix.other.size() ? matrix.other[column] : std::string();
  if (column >= matrix.states.size()) return matrix.rows[row].rate;
  const auto& cells = matrix.rows[row].cells;
  const auto found =
      std::lower_bound(cells.begin(), cells.end(), column,
                       [](const MatrixCell& each, std::size_t wanted) { return each.column < wanted; });
  return found == cells.end() || found->column != column ? std::string() : found->factor;
}

QVariant CMatrixModel::data(const QModelIndex& cell, int role) const {
  if (role == Qt::DisplayRole) return ToScreen(TextOf(cell)).replace(u'\n', u' ');
  if (role == Qt::ToolTipRole) {
    const QString text = ToScreen(TextOf(cell));
    return text.isEmpty() ? QVariant() : PlainTip(text);
  }
  if (role == Qt::AccessibleTextRole) {
    const QString text = ToScreen(TextOf(cell));
    return text.isEmpty() ? strings::kEmptyCell : text;
  }
  return {};
}

QVariant CMatrixModel::headerData(int section, Qt::Orientation orientation, int role) const {
  const bool isRow = orientation == Qt::Vertical;
  const MatrixElement* element = isRow ? ProcessOf(section) : StateOf(section);
  if (role == Qt::DisplayRole) {
    if (element != nullptr) return ToScreen(element->symbol);
    return isRow ? strings::kOtherRow : strings::kRateColumn;
  }
  if (role == Qt::ToolTipRole && element != nullptr)
    return TipOf(*element, isRow ? matrix.rows[static_cast<std::size_t>(section)].rate : std::string());
  return {};
}

}  // namespace tessal
