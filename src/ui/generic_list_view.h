// The page of a folder: its elements in a table, with a filter by visibility group and level.
#pragma once

#include "ui/list_page.h"

class QCheckBox;
class QComboBox;

namespace tessal {

class CGenericListView final : public CListPage {
  Q_OBJECT

 public:
  CGenericListView(const FormContext& context, QWidget* parent);

  std::vector<Uid> SelectedElements() const override;

 protected:
  void ItemToForm() override;
  bool CanRun(Command command, int row) const override;
  void Run(Command command, int row) override;
  void EnterRow(int row) override;

 private:
  void BuildFilter();
  void ShowFilter();
  void ChooseGroup(int group);
  void ChooseLevel(int level);
  void Expand(bool on);
  void FillTable();

  Uid UidOf(int row) const;
  void CreateNew();
  void DeleteRow(int row);
  void DeleteRows();
  /// Moves the selected rows before another, in their order, or to the end.
  void MoveRowsTo(int row);
  void MoveRow(int row, int step);
  bool CanMoveRow(int row, int step) const;
  bool CanCreate(int row) const;

  QComboBox* groups = nullptr;
  QComboBox* levels = nullptr;
  QCheckBox* expand = nullptr;
};

}  // namespace tessal
