#include "ui/find_pane.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QStyle>
#include <QToolButton>
#include <algorithm>

#include "core/document.h"
#include "ui/child.h"
#include "ui/found_list.h"
#include "ui/kept_splitter.h"
#include "ui/strings.h"

namespace tessal {

namespace {

struct Place {
  FindIn in;
  const QString& text;
};

const Place kPlaces[] = {
    {FindIn::All, strings::kInAll},
    {FindIn::Expressions, strings::kInExpressions},
    {FindIn::Texts, strings::kInTexts},
};

constexpr int kFindRow = 0;
constexpr int kReplaceRow = 1;
constexpr int kOptionRow = 2;
constexpr int kStateRow = 3;
constexpr int kListRow = 4;
constexpr int kGridColumns = 5;
constexpr int kUsualHeight = 280;

/// "4 matches in 3 texts", in the words of the two forms.
QString CountText(const QString& one, const QString& several, const std::vector<FoundText>& found) {
  const std::size_t count = CountMatches(found);
  if (count == 0) return strings::kNothingFound;
  return count == 1 ? one : several.arg(count).arg(found.size());
}

}  // namespace

CFindPane::CFindPane(CTessalDoc& searchedDocument, QWidget* parent)
    : QFrame(parent), document(searchedDocument) {
  setObjectName(QStringLiteral("FindPane"));
  setAccessibleName(strings::kFindInTemplate);
  constexpr int kMargin = 4;
  auto* grid = MakeChild<QGridLayout>(this);
  grid->setContentsMargins(kMargin, kMargin, 0, 0);
  BuildFindRow(*grid);
  BuildReplaceRow(*grid);
  BuildOptions(*grid);
  state = MakeChild<QLabel>(this);
  state->setObjectName(QStringLiteral("FindState"));
  state->setTextFormat(Qt::PlainText);
  // As wide as there is room, however long the pattern.
  state->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
  grid->addWidget(state, kStateRow, 0, 1, kGridColumns);
  list = MakeChild<CFoundList>(this);
  connect(list, &CFoundList::RowChosen, this, &CFindPane::ChooseRow);
  connect(&list->Rows(), &CFoundRows::ChoiceChanged, this, &CFindPane::UpdateReplace);
  grid->addWidget(list, kListRow, 0, 1, kGridColumns);
  grid->setRowStretch(kListRow, 1);
  UpdateReplace();
}

QLineEdit* CFindPane::AddLine(QGridLayout& grid, int row, const QString& label) {
  auto* line = MakeChild<QLineEdit>(this);
  line->setAccessibleName(label);
  auto* name = MakeChild<QLabel>(label + u':', this);
  name->setBuddy(line);
  grid.addWidget(name, row, 0);
  grid.addWidget(line, row, 1);
  connect(line, &QLineEdit::textChanged, this, &CFindPane::DropPreview);
  return line;
}

QPushButton* CFindPane::AddButton(QGridLayout& grid, int row, int column, const QString& text,
                                  void (CFindPane::*run)()) {
  auto* button = MakeChild<QPushButton>(text, this);
  grid.addWidget(button, row, column);
  connect(button, &QPushButton::clicked, this, run);
  return button;
}

QCheckBox* CFindPane::AddOption(const QString& text) {
  auto* option = MakeChild<QCheckBox>(text, this);
  connect(option, &QCheckBox::toggled, this, &CFindPane::DropPreview);
  return option;
}

void CFindPane::BuildFindRow(QGridLayout& grid) {
  pattern = AddLine(grid, kFindRow, strings::kFindPattern);
  connect(pattern, &QLineEdit::returnPressed, this, &CFindPane::Find);
  AddButton(grid, kFindRow, 2, strings::kFindAll, &CFindPane::Find);
  where = MakeChild<QComboBox>(this);
  where->setAccessibleName(strings::kFindWhere);
  // A reader takes what is chosen for the name of a choice without a label.
  where->setToolTip(strings::kFindWhere);
  for (const Place& place : kPlaces) where->addItem(place.text, static_cast<int>(place.in));
  connect(where, &QComboBox::currentIndexChanged, this, &CFindPane::DropPreview);
  grid.addWidget(where, kFindRow, 3);
  auto* close = MakeChild<QToolButton>(this);
  close->setIcon(style()->standardIcon(QStyle::SP_TitleBarCloseButton));
  close->setAutoRaise(true);
  close->setToolTip(strings::kCloseFind);
  close->setAccessibleName(strings::kCloseFind);
  close->setFocusPolicy(Qt::StrongFocus);
  connect(close, &QToolButton::clicked, this, &CFindPane::CloseUp);
  grid.addWidget(close, kFindRow, kGridColumns - 1);
}

void CFindPane::BuildReplaceRow(QGridLayout& grid) {
  replacement = AddLine(grid, kReplaceRow, strings::kReplaceWith);
  connect(replacement, &QLineEdit::returnPressed, this, &CFindPane::Preview);
  AddButton(grid, kReplaceRow, 2, strings::kPreview, &CFindPane::Preview);
  replace = AddButton(grid, kReplaceRow, 3, strings::kReplaceChosen, &CFindPane::Replace);
}

void CFindPane::BuildOptions(QGridLayout& grid) {
  auto* options = MakeChild<QHBoxLayout>();
  matchCase = AddOption(strings::kMatchCase);
  wholeSymbols = AddOption(strings::kWholeSymbols);
  regex = AddOption(strings::kRegex);
  // Symbols are other symbols in other letters.
  matchCase->setChecked(true);
  for (QCheckBox* option : {matchCase, wholeSymbols, regex}) options->addWidget(option);
  options->addStretch(1);
  grid.addLayout(options, kOptionRow, 1, 1, kGridColumns - 1);
}

void CFindPane::Begin(const QString& text) {
  if (!text.isEmpty()) pattern->setText(text);
  OpenUp();
  pattern->setFocus(Qt::ShortcutFocusReason);
  pattern->selectAll();
}

FindQuery CFindPane::Query() const {
  FindQuery query;
  query.pattern = {pattern->text().toStdString(), regex->isChecked(), wholeSymbols->isChecked(),
                   !matchCase->isChecked()};
  query.in = static_cast<FindIn>(where->currentData().toInt());
  return query;
}

void CFindPane::Find() {
  emit AboutToRead();
  FindResult result = FindTexts(document.Core(), Query());
  const QString found = CountText(strings::kOneMatch, strings::kFoundMatches, result.found);
  const bool isBad = !result.failure.empty();
  list->Rows().ShowFound(std::move(result.found));
  ShowRows(isBad ? QString::fromStdString(result.failure) : found);
}

void CFindPane::ShowUses(const QString& name) {
  emit AboutToRead();
  OpenUp();
  std::vector<FoundText> uses = FindUses(document.Core(), name.toStdString());
  const QString found = CountText(strings::kOneUse.arg(name), strings::kFoundUses.arg(name), uses);
  list->Rows().ShowFound(std::move(uses));
  ShowRows(found);
  list->setFocus(Qt::OtherFocusReason);
  if (HasRows()) list->setCurrentIndex(list->Rows().index(0, 0));
}

void CFindPane::Preview() {
  emit AboutToRead();
  ReplacePreview preview = PreviewReplacements(document.Core(), Query(), replacement->text().toStdString());
  const QString text = preview.failure.empty() ? strings::kPreviewCount.arg(preview.replacements.size())
                                               : QString::fromStdString(preview.failure);
  list->Rows().ShowReplacements(std::move(preview.replacements));
  ShowRows(text);
}

void CFindPane::Replace() {
  emit AboutToRead();
  const ReplaceOutcome outcome =
      ApplyReplacements(document.Core(), list->Rows().Replacements(), document.Encoding());
  list->Rows().ShowRefused(outcome.refused);
  emit Replaced();
  ShowRows(outcome.refused.empty() ? strings::kReplaced.arg(outcome.applied)
                                   : strings::kReplacedSome.arg(outcome.applied).arg(outcome.refused.size()));
}

void CFindPane::DropPreview() {
  if (list == nullptr || !list->Rows().IsPreview()) return;
  list->Rows().ShowFound({});
  ShowRows(QString());
}

void CFindPane::ShowRows(const QString& text) {
  state->setText(text);
  state->setToolTip(text.toHtmlEscaped());
  list->FitColumns();
  UpdateReplace();
}

void CFindPane::UpdateReplace() {
  const auto& changes = list->Rows().Replacements();
  replace->setEnabled(
      std::any_of(changes.begin(), changes.end(), [](const Replacement& change) { return change.isChosen; }));
}

bool CFindPane::HasRows() const {
  return list->Rows().rowCount() > 0;
}

void CFindPane::GoToRow(int step) {
  list->GoToRow(step);
}

void CFindPane::ChooseRow(int row) {
  // The way there may change what is shown here.
  const FoundText found = list->Rows().FoundAt(row);
  const TextMatch match = list->Rows().MatchAt(row);
  emit PlaceChosen(found, match);
}

void CFindPane::OpenUp() {
  emit Opening();
  OpenInSplitter(*this, kUsualHeight);
}

void CFindPane::CloseUp() {
  hide();
  emit Closed();
}

void CFindPane::keyPressEvent(QKeyEvent* key) {
  if (key->key() == Qt::Key_Escape) {
    CloseUp();
    return;
  }
  QFrame::keyPressEvent(key);
}

}  // namespace tessal
