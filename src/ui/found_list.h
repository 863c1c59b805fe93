// The list of what was found: its rows with their matches marked, each a way to its place.
#pragma once

#include <QTreeView>

#include "ui/found_rows.h"

namespace tessal {

class CFoundList final : public QTreeView {
  Q_OBJECT

 public:
  explicit CFoundList(QWidget* parent);

  CFoundRows& Rows() const { return *rows; }
  /// Makes the columns as wide as their first rows need.
  void FitColumns();
  /// Goes so many rows further, around the ends, and to the place of the row there.
  void GoToRow(int step);

 signals:
  /// A row was clicked or entered.
  void RowChosen(int row);

 private:
  CFoundRows* rows;
};

}  // namespace tessal
