#include "ui/pools_page.h"

#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRegularExpression>
#include <QScopedValueRollback>
#include <QSplitter>
#include <QVBoxLayout>
#include <algorithm>
#include <utility>

#include "core/document.h"
#include "ui/child.h"
#include "ui/expression_completer.h"
#include "ui/expression_field.h"
#include "ui/focus_watch.h"
#include "ui/icons.h"
#include "ui/label.h"
#include "ui/row_table.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kPoolTable = 1302;
constexpr int kLeakTable = 1303;
constexpr int kExpressionLines = 3;
constexpr int kDigits = 6;

QString JoinedSymbols(const std::vector<std::string>& symbols) {
  QStringList shown;
  for (const std::string& symbol : symbols) shown.append(ToScreen(symbol));
  return shown.join(QStringLiteral(", "));
}

std::vector<std::string> SymbolsIn(const QString& text) {
  std::vector<std::string> symbols;
  static const QRegularExpression separators(QStringLiteral("[,;\\s]+"));
  for (const QString& symbol : text.split(separators, Qt::SkipEmptyParts)) {
    symbols.push_back(symbol.toStdString());
  }
  return symbols;
}

std::string VerdictText(const PoolBalance& balance) {
  switch (balance.verdict) {
    case PoolVerdict::Closed:
      return strings::kClosedPool.toStdString();
    case PoolVerdict::Open:
      return strings::kOpenPool.toStdString();
    default:
      return strings::kUnknownPool.arg(ToScreen(balance.reason)).toStdString();
  }
}

ErrorLevel LevelOf(PoolVerdict verdict) {
  return verdict == PoolVerdict::Open ? ErrorLevel::Warning : ErrorLevel::Notice;
}

}  // namespace

CPoolsPage::CPoolsPage(CTessalDoc& analysedDocument, QWidget* parent)
    : CAnalysisPage(parent), document(analysedDocument) {
  auto* parts = MakeChild<QSplitter>(Qt::Horizontal, this);
  parts->setChildrenCollapsible(false);
  for (QWidget* part : {MakeList(), MakeFields(), MakeLeaks()}) parts->addWidget(part);
  auto* layout = MakeChild<QVBoxLayout>(this);
  layout->addWidget(parts);
  ShowFields();
}

CPoolsPage::~CPoolsPage() {
  isClosed = true;
  // The fields go first: one that loses the focus on its way out still reports to its page.
  qDeleteAll(findChildren<QWidget*>(QString(), Qt::FindDirectChildrenOnly));
}

QWidget* CPoolsPage::MakeList() {
  auto* part = MakeChild<QWidget>(this);
  list = MakeChild<CRowTable>(kPoolTable, strings::kPoolList, part);
  auto* add = MakeChild<QPushButton>(strings::kAddPool, part);
  remove = MakeChild<QPushButton>(strings::kRemovePool, part);
  state = MakeChild<CLabel>(part);
  state->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
  auto* buttons = MakeChild<QHBoxLayout>();
  buttons->addWidget(add);
  buttons->addWidget(remove);
  buttons->addWidget(state, 1);
  auto* rows = MakeChild<QVBoxLayout>(part);
  rows->setContentsMargins(0, 0, 0, 0);
  rows->addLayout(buttons);
  rows->addWidget(list, 1);
  setTabOrder(add, remove);
  setTabOrder(remove, list);
  connect(add, &QPushButton::clicked, this, &CPoolsPage::Add);
  connect(remove, &QPushButton::clicked, this, &CPoolsPage::Remove);
  connect(list, &CRowTable::RowSelected, this, [this] {
    if (isFilling) return;
    ShowFields();
    ShowLeaks();
  });
  connect(list, &CRowTable::RowEntered, this, [this] {
    name->setFocus(Qt::OtherFocusReason);
    name->selectAll();
  });
  return part;
}

void CPoolsPage::AddRow(QGridLayout& grid, const QString& label, QWidget& control) {
  auto* text = MakeChild<QLabel>(label + u':', control.parentWidget());
  text->setBuddy(&control);
  const int row = grid.count() / 2;
  grid.addWidget(text, row, 0, Qt::AlignTop);
  grid.addWidget(&control, row, 1);
  control.setAccessibleName(label);
}

QLineEdit* CPoolsPage::AddLine(QGridLayout& grid, const QString& label) {
  auto* line = MakeChild<QLineEdit>(grid.parentWidget());
  AddRow(grid, label, *line);
  connect(line, &QLineEdit::editingFinished, this, &CPoolsPage::CommitTyped);
  return line;
}

QWidget* CPoolsPage::MakeFields() {
  auto* part = MakeChild<QWidget>(this);
  auto* grid = MakeChild<QGridLayout>(part);
  grid->setContentsMargins(0, 0, 0, 0);
  name = AddLine(*grid, strings::kPoolName);
  expression = MakeChild<CAutoRichEditCtrl>(document, part);
  const int lines = expression->fontMetrics().lineSpacing() * kExpressionLines;
  expression->setMinimumHeight(lines);
  AddRow(*grid, strings::kPoolExpression, *expression);
  grid->setRowStretch(1, 1);
  // What a pool may use is what a process may.
  MakeChild<CExpressionCompleter>(*expression, document, [this]() -> const CEL_Element* {
    const auto& processes = document.Core().Processes();
    return processes.empty() ? nullptr : processes.back().get();
  });
  WatchFocusLoss(*expression, [this] { CommitTyped(); });
  connect(expression, &CAutoRichEditCtrl::LinkActivated, this, &CPoolsPage::ElementChosen);
  boundary = AddLine(*grid, strings::kPoolBoundary);
  description = AddLine(*grid, strings::kPoolDescription);
  return part;
}

QWidget* CPoolsPage::MakeLeaks() {
  leaks = MakeChild<CRowTable>(kLeakTable, strings::kLeakList, this);
  const auto go = [this](int row) {
    const Uid uid = leaks->Model().Rows()[static_cast<std::size_t>(row)].uid;
    if (IsElement(uid)) emit ElementChosen(uid);
  };
  connect(leaks, &CRowTable::RowEntered, this, go);
  connect(leaks, &QTreeView::clicked, this, [go](const QModelIndex& cell) { go(cell.row()); });
  return leaks;
}

QWidget& CPoolsPage::FirstStop() const {
  return *list;
}

const Pool* CPoolsPage::Selected() const {
  const int row = list->CurrentRow();
  return row >= 0 && static_cast<std::size_t>(row) < pools.size() ? &pools[static_cast<std::size_t>(row)]
                                                                  : nullptr;
}

void CPoolsPage::Refresh() {
  PoolsRead read = PoolsOf(document.Core());
  const bool isTyped = HasTyped();
  pools = std::move(read.pools);
  balances = CheckMassBalance(document.Core(), pools);
  QStringList faults;
  for (const auto* unread : {&read.faults, &read.notPools}) {
    for (const std::string& fault : *unread) faults.append(ToScreen(fault));
  }
  state->setText(faults.isEmpty() ? QString()
                                  : strings::kPoolsNotRead.arg(faults.join(QStringLiteral("; "))));
  ShowPools();
  // What is being typed stays.
  if (!isTyped) ShowFields();
  ShowLeaks();
}

void CPoolsPage::ShowPools() {
  const QScopedValueRollback filling(isFilling, true);
  const int former = list->CurrentRow();
  std::vector<CRowModel::Row> rows(pools.size());
  for (std::size_t place = 0; place < rows.size(); ++place)
    rows[place] = {Uid::None, static_cast<std::int32_t>(place), 0};
  const auto levelOf = [this](const CRowModel::Row& row) {
    return static_cast<std::uint32_t>(LevelOf(balances[static_cast<std::size_t>(row.key)].verdict));
  };
  const auto isBalanced = [this](const CRowModel::Row& row) {
    return balances[static_cast<std::size_t>(row.key)].verdict == PoolVerdict::Closed;
  };
  constexpr int kVerdict = 1;
  list->Model().ShowIcons(kVerdict, [levelOf, isBalanced](const auto& row) {
    return isBalanced(row) ? QIcon() : IconOfLevel(levelOf(row));
  });
  list->Fill({strings::kPoolColumn, strings::kVerdictColumn}, std::move(rows),
             [this](const CRowModel::Row& row, int column) {
               const auto place = static_cast<std::size_t>(row.key);
               return column == kVerdict ? VerdictText(balances[place]) : pools[place].name;
             });
  if (!pools.empty()) list->SelectRow(std::max(0, former));
}

void CPoolsPage::ShowFields() {
  const Pool* pool = Selected();
  const Pool none;
  const Pool& shown = pool == nullptr ? none : *pool;
  remove->setEnabled(pool != nullptr);
  for (QWidget* field : {static_cast<QWidget*>(name), static_cast<QWidget*>(expression),
                         static_cast<QWidget*>(boundary), static_cast<QWidget*>(description)})
    field->setEnabled(pool != nullptr);
  name->setText(ToScreen(shown.name));
  expression->SetColouredText(shown.expression);
  boundary->setText(JoinedSymbols(shown.boundary));
  description->setText(ToScreen(shown.description));
  for (QLineEdit* line : {name, boundary, description}) {
    line->setCursorPosition(0);
    line->setModified(false);
  }
}

void CPoolsPage::ShowLeaks() {
  const int row = list->CurrentRow();
  static const PoolBalance kNone;
  const bool isSelected = row >= 0 && static_cast<std::size_t>(row) < balances.size();
  const auto& shown = isSelected ? balances[static_cast<std::size_t>(row)].leaks : kNone.leaks;
  std::vector<CRowModel::Row> rows(shown.size());
  for (std::size_t place = 0; place < rows.size(); ++place)
    rows[place] = {shown[place].uid, static_cast<std::int32_t>(place), 0};
  leaks->Fill({strings::kProcessColumn, strings::kNetColumn, strings::kValueColumn}, std::move(rows),
              [this](const CRowModel::Row& leakRow, int column) -> std::string {
                const int pool = list->CurrentRow();
                if (pool < 0) return {};
                const auto& ofPool = balances[static_cast<std::size_t>(pool)].leaks;
                const PoolLeak& leak = ofPool[static_cast<std::size_t>(leakRow.key)];
                if (column == 0)
                  return leak.process.empty() ? strings::kNoProcess.toStdString() : leak.process;
                return column == 1 ? leak.net : QString::number(leak.value, 'g', kDigits).toStdString();
              });
}

bool CPoolsPage::HasTyped() const {
  return name->isModified() || boundary->isModified() || description->isModified() || expression->IsEdited();
}

Pool CPoolsPage::Entered(const Pool& former) const {
  const TextEncoding encoding = document.Encoding();
  Pool entered = former;
  if (name->isModified()) entered.name = FromScreen(name->text(), former.name, encoding);
  if (expression->IsEdited())
    entered.expression = FromScreen(expression->ContentText(), former.expression, encoding);
  if (boundary->isModified()) entered.boundary = SymbolsIn(boundary->text());
  if (description->isModified())
    entered.description = FromScreen(description->text(), former.description, encoding);
  return entered;
}

void CPoolsPage::CommitTyped() {
  if (isClosed || !HasTyped()) return;
  const Pool* shown = Selected();
  if (shown == nullptr) return;
  const Pool entered = Entered(*shown);
  std::vector<Pool> wanted = pools;
  wanted[static_cast<std::size_t>(list->CurrentRow())] = entered;
  // A refusal leaves what was typed where it is, for another try.
  if (entered == *shown || Store(wanted, strings::kStepChangePool + shown->name)) ShowFields();
}

void CPoolsPage::Add() {
  CommitTyped();
  std::vector<Pool> wanted = pools;
  Pool added;
  int number = static_cast<int>(wanted.size());
  const auto isTaken = [&added](const Pool& pool) { return pool.name == added.name; };
  do added.name = strings::kNewPool.arg(++number).toStdString();
  while (std::any_of(wanted.begin(), wanted.end(), isTaken));
  wanted.push_back(added);
  if (!Store(wanted, strings::kStepAddPool + added.name)) return;
  list->SelectRow(static_cast<int>(wanted.size()) - 1);
  name->setFocus(Qt::OtherFocusReason);
  name->selectAll();
}

void CPoolsPage::Remove() {
  const Pool* shown = Selected();
  if (shown == nullptr) return;
  std::vector<Pool> wanted = pools;
  wanted.erase(wanted.begin() + list->CurrentRow());
  Store(wanted, strings::kStepRemovePool + shown->name);
}

bool CPoolsPage::Store(const std::vector<Pool>& wanted, const std::string& step) {
  TemplateCore& core = document.Core();
  std::string failure;
  bool isStored = false;
  {
    const EditStep act(core.History(), step);
    isStored = PoolsOf(core).pools == pools && SetPools(core, wanted, failure);
  }
  if (!isStored && !failure.empty()) {
    state->setText(strings::kPoolsNotKept.arg(ToScreen(failure)));
    return false;
  }
  // What is typed is in the template, or belongs to pools that are there no more.
  ShowFields();
  Refresh();
  emit Edited();
  return isStored;
}

}  // namespace tessal
