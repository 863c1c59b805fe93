// The page of one visibility group: its name and description, its levels, and which elements each includes.
#pragma once

#include "ui/right_pane.h"

class QLabel;
class QLineEdit;
class QPushButton;
class QVBoxLayout;

namespace tessal {

class CRowTable;
struct VisibilityGroup;
struct VisibilityLevel;

class CVisibilityGroupDlg final : public CRightPaneBase {
  Q_OBJECT

 public:
  CVisibilityGroupDlg(const FormContext& context, QWidget* parent);

  std::vector<TypedValue> TypedValues() const override;
  QWidget* ShowText(const TextToShow& text) override;

 protected:
  void ItemToForm() override;
  void FormToItem() override;

 private:
  void BuildGroupFields();
  void BuildLevels();
  void BuildItems();
  QLineEdit* AddLine(int control, const QString& label, void (CVisibilityGroupDlg::*store)());
  QLabel* AddLabel(const QString& text, QWidget* labelled);
  QPushButton* AddButton(int control, const QString& text, const QString& name,
                         void (CVisibilityGroupDlg::*run)());

  /// The number of the group, which falls when one before it goes.
  std::int32_t Number() const { return Item().groupIndex; }
  const VisibilityGroup* Group() const;
  /// The level that is selected; none without one.
  const VisibilityLevel* Level() const;

  void ShowLevels(int selected);
  void SelectLevel(int row);
  void ShowLevelFields();
  void FillItems();
  void FillItemTable(CRowTable& table, const std::vector<std::int32_t>& numbers);
  void UpdateButtons();

  void StoreGroup();
  void StoreLevel();
  void StoreLevelCell(int row, int column, const QString& text);
  void AddLevel();
  void DeleteLevel();
  void IncludePicked();
  void ExcludePicked();

  QVBoxLayout* layout;
  QList<QLabel*> labels;
  QLineEdit* name = nullptr;
  QLineEdit* description = nullptr;
  CRowTable* levels = nullptr;
  QPushButton* deleteLevel = nullptr;
  QLineEdit* levelName = nullptr;
  QLineEdit* levelDescription = nullptr;
  CRowTable* available = nullptr;
  CRowTable* included = nullptr;
  QPushButton* include = nullptr;
  QPushButton* exclude = nullptr;
  std::int32_t current = 0;  ///< the number of the selected level, 0 for none
};

}  // namespace tessal
