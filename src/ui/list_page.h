// What the list pages share: a table, a tool bar with five commands over it, and the keys that go with them.
// Each command acts at once, so that a commit has nothing to write.
#pragma once

#include <array>

#include "ui/right_pane.h"

class QAction;
class QVBoxLayout;

namespace tessal {

class CRowTable;

class CListPage : public CRightPaneBase {
  Q_OBJECT

 public:
  CRowTable& Table() const { return *table; }
  void OnStructureChanged() override;

 protected:
  enum Command { New, Edit, Delete, MoveDown, MoveUp };
  static constexpr std::size_t kCommandCount = 5;

  CListPage(const FormContext& context, const QString& name, QWidget* parent);

  /// The layout of the page, in which the tool bar lies over the table.
  QVBoxLayout& Rows() const { return *layout; }

  /// Whether a command can be given while this row, or none (-1), is selected.
  virtual bool CanRun(Command /*command*/, int /*row*/) const { return false; }
  virtual void Run(Command /*command*/, int /*row*/) {}
  /// A double click on a row, or Return.
  virtual void EnterRow(int row) = 0;

  /// Fills the page again while nothing is painted, and selects a row.
  void Reload(int row);
  void UpdateCommands();
  int RowCount() const;

 private:
  void BuildToolBar();

  QVBoxLayout* layout;
  CRowTable* table;
  std::array<QAction*, kCommandCount> actions{};
};

}  // namespace tessal
