// The page of the pools: what they are, which one can edit here, and whether the processes keep their
// amounts, with the processes that do not.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "analysis/mass_balance.h"
#include "core/pools.h"
#include "ui/analysis_page.h"

class QGridLayout;
class QLabel;
class QLineEdit;
class QPushButton;

namespace tessal {

class CAutoRichEditCtrl;
class CLabel;
class CRowTable;
class CTessalDoc;

class CPoolsPage final : public CAnalysisPage {
  Q_OBJECT

 public:
  CPoolsPage(CTessalDoc& analysedDocument, QWidget* parent);
  ~CPoolsPage() override;

  void Refresh() override;
  QWidget& FirstStop() const override;

  /// Whether something was typed that is not in the template yet.
  bool HasTyped() const;
  /// Puts what was typed into the template.
  void CommitTyped();

 signals:
  /// The pools of the template are others.
  void Edited();

 private:
  QWidget* MakeList();
  QWidget* MakeFields();
  QWidget* MakeLeaks();
  QLineEdit* AddLine(QGridLayout& grid, const QString& label);
  /// Puts a control under those that the grid holds, with its label.
  void AddRow(QGridLayout& grid, const QString& label, QWidget& control);

  void ShowPools();
  void ShowFields();
  void ShowLeaks();
  /// The pool that is selected; none without one.
  const Pool* Selected() const;
  /// The pool that the fields say, and what they show of no other is as it is in the former.
  Pool Entered(const Pool& former) const;
  void Add();
  void Remove();
  /// Puts the pools into the template as one step; false, with the reason on the screen, when it refuses.
  bool Store(const std::vector<Pool>& wanted, const std::string& step);

  CTessalDoc& document;
  CRowTable* list = nullptr;
  QPushButton* remove = nullptr;
  CLabel* state = nullptr;
  QLineEdit* name = nullptr;
  CAutoRichEditCtrl* expression = nullptr;
  QLineEdit* boundary = nullptr;
  QLineEdit* description = nullptr;
  CRowTable* leaks = nullptr;

  std::vector<Pool> pools;
  std::vector<PoolBalance> balances;  ///< of the pools, in their order
  bool isFilling = false;
  bool isClosed = false;
};

}  // namespace tessal
