// How a form lays out its fields: in rows, as many to a row as there is room for, with what has a block of
// its own under them.
#include <QEvent>
#include <QFontMetrics>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QSplitter>
#include <algorithm>
#include <memory>
#include <utility>

#include "ui/child.h"
#include "ui/element_form.h"
#include "ui/plain_text_field.h"
#include "ui/strings.h"

namespace tessal {

namespace {

constexpr int kGridColumns = 4;
constexpr int kRowSpacing = 4;
/// Default, minimum and maximum.
constexpr std::ptrdiff_t kNumbersInRow = 3;
constexpr int kDigitsSeen = 6;

bool IsShort(FieldEditor editor) {
  switch (editor) {
    case FieldEditor::ShortLine:
    case FieldEditor::Number:
    case FieldEditor::Integer:
    case FieldEditor::Shown:
    case FieldEditor::Count:
    case FieldEditor::SortedChoice:
    case FieldEditor::OrderedChoice:
      return true;
    default:
      return false;
  }
}

/// How many lines of text an editor shows at least and at most; none of both for one line.
struct LineRange {
  int fewest = 0;
  int most = 0;
};

LineRange LinesOf(FieldEditor editor) {
  constexpr int kAnyNumber = 1000;
  switch (editor) {
    case FieldEditor::Lines:
    case FieldEditor::ReferencedIn:
      return {1, 3};
    case FieldEditor::Expression:
      return {3, kAnyNumber};
    default:
      return {};
  }
}

int HeightOf(const QTextEdit& editor, int lines) {
  const int margins = static_cast<int>(2 * editor.document()->documentMargin()) + 2 * editor.frameWidth();
  return editor.fontMetrics().lineSpacing() * lines + margins;
}

void LimitSize(FieldEditor kind, QWidget& editor) {
  const LineRange lines = LinesOf(kind);
  if (const auto* text = qobject_cast<const QTextEdit*>(&editor)) {
    editor.setMinimumHeight(HeightOf(*text, lines.fewest));
    editor.setMaximumHeight(HeightOf(*text, lines.most));
  }
  if (kind == FieldEditor::Number) {
    editor.setMinimumWidth(editor.fontMetrics().horizontalAdvance(u'0') * kDigitsSeen);
  }
}

}  // namespace

void CElementForm::LayOut() {
  for (const Control& control : controls) LimitSize(control.field->editor, *control.editor);
  layout->setVerticalSpacing(kRowSpacing);
  SplitExpressions();
  BoxCounts();
  FlattenReadOnlyFields();
  Arrange(1);
  narrowWidth = layout->minimumSize().width();
  Arrange(2);
  wideWidth = layout->minimumSize().width();
}

void CElementForm::SplitExpressions() {
  constexpr int kSameShare = 1000;
  const auto isExpression = [](const Control& control) {
    return control.field->editor == FieldEditor::Expression;
  };
  if (std::count_if(controls.begin(), controls.end(), isExpression) < 2) return;
  split = MakeChild<QSplitter>(Qt::Vertical, this);
  split->setObjectName(QStringLiteral("Split"));
  split->setChildrenCollapsible(false);
  int widest = 0;
  for (const Control& control : controls) widest = std::max(widest, control.label->sizeHint().width());
  for (Control& control : controls) {
    if (!isExpression(control)) continue;
    // The halves are laid out by themselves; their fields begin side by side.
    control.label->setMinimumWidth(widest);
    // A splitter takes a child in as soon as it has it as its parent.
    const bool isFirst = split->count() == 0;
    auto* panel = MakeChild<QWidget>(split);
    panel->setObjectName(isFirst ? QStringLiteral("Top") : QStringLiteral("Bottom"));
    auto* parts = MakeChild<QHBoxLayout>(panel);
    parts->setContentsMargins(0, 0, 0, 0);
    parts->addWidget(control.label, 0, Qt::AlignTop);
    parts->addWidget(control.cell, 1);
    split->addWidget(panel);
    control.isInBlock = true;
  }
  split->setSizes(QList<int>(split->count(), kSameShare));
}

void CElementForm::BoxCounts() {
  constexpr int kCountsPerRow = 2;
  QGridLayout* cells = nullptr;
  int place = 0;
  for (Control& control : controls) {
    if (control.field->editor != FieldEditor::Count) continue;
    if (cells == nullptr) {
      overview = MakeChild<QGroupBox>(strings::kGeneralOverview, this);
      overview->setObjectName(QString::number(control_id::kOverviewBox));
      cells = MakeChild<QGridLayout>(overview);
    }
    const int column = 2 * (place % kCountsPerRow);
    cells->addWidget(control.label, place / kCountsPerRow, column);
    cells->addWidget(control.cell, place / kCountsPerRow, column + 1);
    control.isInBlock = true;
    ++place;
  }
}

void CElementForm::FlattenReadOnlyFields() {
  for (const Control& control : controls) {
    if (!control.editor->property("readOnly").toBool()) continue;
    QPalette flat = palette();
    flat.setBrush(QPalette::Base, flat.brush(QPalette::Window));
    control.editor->setPalette(flat);
  }
}

void CElementForm::Arrange(int columnCount) {
  if (columnCount == columns) return;
  columns = columnCount;
  while (const std::unique_ptr<QLayoutItem> gone{layout->takeAt(0)}) continue;
  for (int row = 0; row < layout->rowCount(); ++row) layout->setRowStretch(row, 0);
  const int last = ArrangeBlocks(ArrangeRows());
  layout->setColumnStretch(1, 1);
  layout->setColumnStretch(3, columns > 1 ? 1 : 0);
  const bool grows =
      split != nullptr || std::any_of(controls.begin(), controls.end(), [](const auto& control) {
        return control.field->editor == FieldEditor::Expression;
      });
  if (!grows) layout->setRowStretch(last + 1, 1);
  updateGeometry();
}

int CElementForm::ArrangeRows() {
  int row = -1;
  int column = kGridColumns;
  for (auto control = controls.begin(); control != controls.end(); ++control) {
    if (control->isInBlock) continue;
    const auto next = std::find_if(control, controls.end(), [](const Control& each) {
      return each.field->editor != FieldEditor::Number;
    });
    if (columns > 1 && next - control == kNumbersInRow) {
      ArrangeNumbers({control, next}, ++row);
      column = kGridColumns;
      control = std::prev(next);
      continue;
    }
    const FieldEditor kind = control->field->editor;
    const bool isShort = columns > 1 && IsShort(kind);
    if (!isShort || column >= kGridColumns) {
      ++row;
      column = 0;
    }
    layout->addWidget(control->label, row, column, LinesOf(kind).most == 0 ? Qt::AlignVCenter : Qt::AlignTop);
    layout->addWidget(control->cell, row, column + 1, 1, isShort ? 1 : kGridColumns - 1);
    column = isShort ? column + 2 : kGridColumns;
    if (kind == FieldEditor::Expression) layout->setRowStretch(row, 1);
  }
  return row;
}

void CElementForm::ArrangeNumbers(std::span<const Control> numbers, int row) {
  auto* cells = MakeChild<QHBoxLayout>();
  cells->setSpacing(layout->horizontalSpacing());
  layout->addWidget(numbers.front().label, row, 0);
  for (const Control& number : numbers) {
    if (&number != &numbers.front()) cells->addWidget(number.label);
    cells->addWidget(number.cell, 1);
  }
  layout->addLayout(cells, row, 1, 1, kGridColumns - 1);
}

int CElementForm::ArrangeBlocks(int row) {
  if (overview != nullptr) layout->addWidget(overview, ++row, 0, 1, kGridColumns);
  if (split != nullptr) {
    layout->addWidget(split, ++row, 0, 1, kGridColumns);
    layout->setRowStretch(row, 1);
  }
  for (QWidget* widget : under) layout->addWidget(widget, ++row, 0, 1, kGridColumns);
  return row;
}

void CElementForm::AddUnder(QWidget* widget) {
  under.push_back(widget);
  const int present = std::exchange(columns, 0);
  Arrange(present);
}

QSize CElementForm::minimumSizeHint() const {
  return {narrowWidth, layout->minimumSize().height()};
}

void CElementForm::resizeEvent(QResizeEvent* resize) {
  CRightPaneBase::resizeEvent(resize);
  Arrange(width() >= wideWidth ? 2 : 1);
}

void CElementForm::changeEvent(QEvent* change) {
  CRightPaneBase::changeEvent(change);
  if (change->type() == QEvent::PaletteChange) FlattenReadOnlyFields();
}

}  // namespace tessal
