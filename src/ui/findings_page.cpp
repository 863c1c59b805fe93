#include "ui/findings_page.h"

#include <QAction>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>
#include <algorithm>
#include <utility>

#include "analysis/all_findings.h"
#include "core/document.h"
#include "ui/child.h"
#include "ui/icons.h"
#include "ui/row_table.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kTable = 1301;
enum Column : std::uint8_t { Symbol, Text, Rule };

bool IsSame(const AnalysisFinding& one, const AnalysisFinding& other) {
  return one.element == other.element && one.text == other.text && one.message->code == other.message->code &&
         one.symbol == other.symbol && one.field == other.field && one.place.start == other.place.start &&
         one.place.length == other.place.length;
}

std::uint32_t LevelOf(const AnalysisFinding& finding) {
  return static_cast<std::uint32_t>(finding.message->level);
}

std::string TextOf(const AnalysisFinding& finding, int column) {
  switch (column) {
    case Symbol:
      return finding.symbol.empty() ? strings::kGeneric.toStdString() : finding.symbol;
    case Text:
      return finding.text;
    default:
      return std::string(finding.message->code);
  }
}

}  // namespace

CFindingsPage::CFindingsPage(const CTessalDoc& analysedDocument, QWidget* parent)
    : CAnalysisPage(parent),
      document(analysedDocument),
      explain(MakeChild<QPushButton>(strings::kExplainFinding, this)),
      explainRow(MakeChild<QAction>(strings::kExplain, this)),
      state(MakeChild<QLabel>(this)),
      table(MakeChild<CRowTable>(kTable, strings::kFindingList, this)) {
  auto* analyse = MakeChild<QPushButton>(strings::kAnalyse, this);
  auto* row = MakeChild<QHBoxLayout>();
  for (QWidget* widget : {static_cast<QWidget*>(analyse), static_cast<QWidget*>(explain)})
    row->addWidget(widget);
  row->addWidget(state, 1);
  auto* rows = MakeChild<QVBoxLayout>(this);
  rows->addLayout(row);
  rows->addWidget(table, 1);
  setTabOrder(analyse, explain);
  setTabOrder(explain, table);
  table->addAction(explainRow);
  table->setContextMenuPolicy(Qt::ActionsContextMenu);
  const auto findingOf = [this](const CRowModel::Row& shown) -> const AnalysisFinding& {
    return findings[static_cast<std::size_t>(shown.key)];
  };
  table->Model().ShowIcons(
      Symbol, [findingOf](const auto& shown) { return IconOfLevel(LevelOf(findingOf(shown))); },
      [findingOf](const auto& shown) { return WordOfLevel(LevelOf(findingOf(shown))); });
  connect(analyse, &QPushButton::clicked, this, &CFindingsPage::AnalysisRequested);
  connect(explain, &QPushButton::clicked, this, &CFindingsPage::Explain);
  connect(explainRow, &QAction::triggered, this, &CFindingsPage::Explain);
  connect(table, &CRowTable::RowSelected, this, &CFindingsPage::UpdateCommands);
  connect(table, &CRowTable::RowEntered, this, [this](int entered) {
    // The way there may change what is shown here.
    const AnalysisFinding finding = findings[static_cast<std::size_t>(entered)];
    emit FindingChosen(finding);
  });
  Show({});
}

QWidget& CFindingsPage::FirstStop() const {
  return *table;
}

void CFindingsPage::Refresh() {
  std::vector<AnalysisFinding> found = AllFindings(document.Core());
  // The row that one works on stays where it is.
  if (!std::equal(findings.begin(), findings.end(), found.begin(), found.end(), IsSame))
    Show(std::move(found));
  state->setText(findings.empty()       ? strings::kNothingFound
                 : findings.size() == 1 ? strings::kOneFinding
                                        : strings::kFindingCount.arg(findings.size()));
}

void CFindingsPage::Show(std::vector<AnalysisFinding> found) {
  const int former = table->CurrentRow();
  std::vector<CRowModel::Row> rows(found.size());
  for (std::size_t place = 0; place < rows.size(); ++place)
    rows[place] = {found[place].element, static_cast<std::int32_t>(place), 0};
  findings = std::move(found);
  table->Fill({strings::kSymbolColumn, strings::kTextColumn, strings::kRuleColumn}, std::move(rows),
              [this](const CRowModel::Row& row, int column) {
                return TextOf(findings[static_cast<std::size_t>(row.key)], column);
              });
  if (former >= 0) table->SelectRow(former);
}

void CFindingsPage::UpdateCommands() {
  const bool isSelected = table->CurrentRow() >= 0;
  explain->setEnabled(isSelected);
  explainRow->setEnabled(isSelected);
}

void CFindingsPage::Explain() {
  const int row = table->CurrentRow();
  if (row >= 0) emit ExplanationRequested(std::string(findings[static_cast<std::size_t>(row)].message->code));
}

}  // namespace tessal
