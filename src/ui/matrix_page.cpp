#include "ui/matrix_page.h"

#include <QAction>
#include <QComboBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QScrollBar>
#include <QSignalBlocker>
#include <QVBoxLayout>
#include <algorithm>

#include "core/document.h"
#include "ui/child.h"
#include "ui/label.h"
#include "ui/plain_tip.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// A cell with a long text leaves room for the others: its text ends in "...", and a tip shows the whole.
constexpr std::size_t kWidestColumn = 40;  // in characters
constexpr int kCellMargin = 16;

}  // namespace

CMatrixTable::CMatrixTable(QWidget* parent) : QTableView(parent), cells(MakeChild<CMatrixModel>(this)) {
  setAccessibleName(strings::kMatrixTable);
  setModel(cells);
  setTabKeyNavigation(false);
  setWordWrap(false);
  setSelectionMode(SingleSelection);
  setHorizontalScrollMode(ScrollPerPixel);
  verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  verticalHeader()->setDefaultSectionSize(fontMetrics().height() + kCellMargin / 2);
  connect(this, &QTableView::doubleClicked, this, &CMatrixTable::CellEntered);
}

void CMatrixTable::FitColumns() {
  const std::vector<std::size_t> lengths = cells->ColumnLengths();
  const int character = fontMetrics().horizontalAdvance(u'n');
  for (int column = 0; column < cells->columnCount(); ++column) {
    const auto shown = std::min(lengths[static_cast<std::size_t>(column)], kWidestColumn);
    setColumnWidth(column, static_cast<int>(shown) * character + kCellMargin);
  }
}

void CMatrixTable::keyPressEvent(QKeyEvent* key) {
  const bool isEnter = key->key() == Qt::Key_Return || key->key() == Qt::Key_Enter;
  if (isEnter && key->modifiers() == Qt::NoModifier && currentIndex().isValid()) {
    emit CellEntered(currentIndex());
    return;
  }
  QTableView::keyPressEvent(key);
}

CMatrixPage::CMatrixPage(const CTessalDoc& analysedDocument, QWidget* parent)
    : CAnalysisPage(parent),
      document(analysedDocument),
      state(MakeChild<CLabel>(this)),
      table(MakeChild<CMatrixTable>(this)) {
  auto* choices = MakeChild<QHBoxLayout>();
  owner = AddChoice(*choices, strings::kMatrixOf);
  processes = AddChoice(*choices, strings::kMatrixProcesses);
  processes->addItems({strings::kAsWritten, strings::kElementary});
  // As wide as there is room, however many equations are not in the matrix.
  state->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
  choices->addWidget(state, 1);
  auto* rows = MakeChild<QVBoxLayout>(this);
  rows->addLayout(choices);
  rows->addWidget(table, 1);
  setTabOrder(owner, processes);
  setTabOrder(processes, table);
  AddJump(strings::kGoToState, &CMatrixPage::CurrentState);
  AddJump(strings::kGoToProcess, &CMatrixPage::CurrentProcess);
  table->setContextMenuPolicy(Qt::ActionsContextMenu);
  connect(owner, &QComboBox::currentIndexChanged, this, &CMatrixPage::Refresh);
  connect(processes, &QComboBox::currentIndexChanged, this, &CMatrixPage::Refresh);
  connect(table, &CMatrixTable::CellEntered, this, &CMatrixPage::EnterCell);
  connect(table->horizontalHeader(), &QHeaderView::sectionDoubleClicked, this, [this](int column) {
    if (const MatrixElement* chosen = table->Model().StateOf(column)) emit ElementChosen(chosen->uid);
  });
  connect(table->verticalHeader(), &QHeaderView::sectionDoubleClicked, this, [this](int row) {
    if (const MatrixElement* chosen = table->Model().ProcessOf(row)) emit ElementChosen(chosen->uid);
  });
}

void CMatrixPage::AddJump(const QString& text, const MatrixElement* (CMatrixPage::*target)() const) {
  auto* jump = MakeChild<QAction>(text, this);
  table->addAction(jump);
  connect(jump, &QAction::triggered, this, [this, target] {
    if (const MatrixElement* chosen = (this->*target)()) emit ElementChosen(chosen->uid);
  });
}

QWidget& CMatrixPage::FirstStop() const {
  return *table;
}

void CMatrixPage::FillOwners() {
  const QSignalBlocker quiet(owner);
  const QVariant chosen = owner->currentData();
  owner->clear();
  owner->addItem(strings::kWholeTemplate, NumberOf(Uid::None));
  for (const auto& specie : document.Core().Species())
    owner->addItem(ToScreen(specie->symbol.TextOf()), NumberOf(specie->GetUid()));
  owner->setCurrentIndex(std::max(0, owner->findData(chosen)));
}

ProcessMatrix CMatrixPage::Build() const {
  const TemplateCore& core = document.Core();
  const auto kind = processes->currentIndex() == 0 ? MatrixProcesses::AsWritten : MatrixProcesses::Elementary;
  const Uid chosen{owner->currentData().toInt()};
  for (const auto& specie : core.Species()) {
    if (specie->GetUid() == chosen) return BuildProcessMatrix(core, *specie, kind);
  }
  return BuildProcessMatrix(core, kind);
}

void CMatrixPage::Refresh() {
  FillOwners();
  // What one works on stays where it is.
  const QModelIndex former = table->currentIndex();
  const int row = former.row();
  const int column = former.column();
  const int across = table->horizontalScrollBar()->value();
  const int down = table->verticalScrollBar()->value();
  table->Model().Show(Build());
  table->FitColumns();
  if (row >= 0) table->setCurrentIndex(table->Model().index(row, column));
  table->horizontalScrollBar()->setValue(across);
  table->verticalScrollBar()->setValue(down);
  ShowState();
}

void CMatrixPage::ShowState() {
  const ProcessMatrix& matrix = table->Model().Matrix();
  QString text = strings::kMatrixSize.arg(matrix.rows.size()).arg(matrix.states.size());
  QStringList faults;
  for (const MatrixFault& fault : matrix.faults)
    faults.append(ToScreen(matrix.states[fault.column].symbol + " (" + fault.reason + ")"));
  if (!faults.isEmpty())
    text += QStringLiteral(". ") + strings::kNotInMatrix.arg(faults.join(QStringLiteral(", ")));
  state->setText(text);
}

const MatrixElement* CMatrixPage::CurrentState() const {
  return table->currentIndex().isValid() ? table->Model().StateOf(table->currentIndex().column()) : nullptr;
}

const MatrixElement* CMatrixPage::CurrentProcess() const {
  return table->currentIndex().isValid() ? table->Model().ProcessOf(table->currentIndex().row()) : nullptr;
}

void CMatrixPage::EnterCell(const QModelIndex& cell) {
  const MatrixElement* column = table->Model().StateOf(cell.column());
  const MatrixElement* row = table->Model().ProcessOf(cell.row());
  // The way there may change what is shown here.
  const std::string name = row == nullptr ? std::string() : row->symbol;
  if (column != nullptr) {
    emit UseChosen(column->uid, name);
  } else if (row != nullptr) {
    emit ElementChosen(row->uid);
  }
}

}  // namespace tessal
