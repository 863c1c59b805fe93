// The page of the process matrix. Its headers stay while the cells scroll, and each cell leads to the process
// in the equation that it is about.
#pragma once

#include <QTableView>

#include "ui/analysis_page.h"
#include "ui/matrix_model.h"

class QAction;
class QComboBox;
class QLabel;

namespace tessal {

class CTessalDoc;

/// A table whose cells are entered by a double click or Return.
class CMatrixTable final : public QTableView {
  Q_OBJECT

 public:
  explicit CMatrixTable(QWidget* parent);

  CMatrixModel& Model() const { return *cells; }
  /// Makes each column as wide as its texts, up to a limit.
  void FitColumns();

 signals:
  void CellEntered(const QModelIndex& cell);

 protected:
  void keyPressEvent(QKeyEvent* key) override;

 private:
  CMatrixModel* cells;
};

class CMatrixPage final : public CAnalysisPage {
  Q_OBJECT

 public:
  CMatrixPage(const CTessalDoc& analysedDocument, QWidget* parent);

  void Refresh() override;
  QWidget& FirstStop() const override;

 signals:
  /// The way leads to where the equation of a state variable uses a name.
  void UseChosen(Uid user, const std::string& name);

 private:
  void AddJump(const QString& text, const MatrixElement* (CMatrixPage::*target)() const);
  /// Offers the template and its particle classes, with the present choice where it is still there.
  void FillOwners();
  ProcessMatrix Build() const;
  void ShowState();
  void EnterCell(const QModelIndex& cell);
  const MatrixElement* CurrentState() const;
  const MatrixElement* CurrentProcess() const;

  const CTessalDoc& document;
  QComboBox* owner = nullptr;
  QComboBox* processes = nullptr;
  QLabel* state;
  CMatrixTable* table;
};

}  // namespace tessal
