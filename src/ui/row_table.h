// The table of a list page: rows that are selected as a whole, and entered by a double click or Return.
#pragma once

#include <QTreeView>
#include <functional>
#include <vector>

#include "ui/row_model.h"

namespace tessal {

class CRowTable final : public QTreeView {
  Q_OBJECT

 public:
  CRowTable(int control, const QString& name, QWidget* parent);

  CRowModel& Model() const { return *rows; }
  /// Replaces the content, and sizes the columns to it.
  void Fill(QStringList titles, std::vector<CRowModel::Row> shown, CRowModel::TextOf textOf);

  /// Several rows can be selected, and dragged to another place.
  void AllowSeveral(std::function<void(int row)> moveTo);
  /// The rows that are selected, in their order.
  std::vector<int> SelectedRows() const;

  /// The selected row, -1 for none.
  int CurrentRow() const;
  /// Selects a row and makes it visible; one beyond the rows is the last. Nothing without rows.
  void SelectRow(int row, ScrollHint place = EnsureVisible);

 signals:
  void RowEntered(int row);
  /// Another row was selected; -1 for none.
  void RowSelected(int row);

 protected:
  void keyPressEvent(QKeyEvent* key) override;
  /// A cell that shows only a part of its text has the whole in a tip.
  bool viewportEvent(QEvent* happened) override;

 private:
  /// Makes each column as wide as its title or its longest text, up to a limit.
  void SizeColumns();
  int WidthOfLongest(int column) const;

  CRowModel* rows;
};

}  // namespace tessal
