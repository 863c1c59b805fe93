// The process matrix as a table: a row for each process and one for what belongs to none, a column for each
// state variable and one for the rates. Most cells are empty; the model holds only the others.
#pragma once

#include <QAbstractTableModel>
#include <optional>
#include <string>
#include <vector>

#include "analysis/process_matrix.h"

namespace tessal {

class CMatrixModel final : public QAbstractTableModel {
  Q_OBJECT

 public:
  using QAbstractTableModel::QAbstractTableModel;

  void Show(ProcessMatrix shown);
  const ProcessMatrix& Matrix() const { return matrix; }

  /// The process of a row and the state variable of a column; none in the row and the column that are about
  /// neither.
  const MatrixElement* ProcessOf(int row) const;
  const MatrixElement* StateOf(int column) const;
  /// The longest texts of the columns, their titles among them, in characters.
  std::vector<std::size_t> ColumnLengths() const;

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& cell, int role) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

 private:
  std::string TextOf(const QModelIndex& cell) const;

  ProcessMatrix matrix;
  bool hasOther = false;
};

}  // namespace tessal
