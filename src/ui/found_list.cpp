#include "ui/found_list.h"

#include <QApplication>
#include <QHeaderView>
#include <QPainter>
#include <QStyledItemDelegate>
#include <QTextLayout>
#include <algorithm>

#include "ui/child.h"
#include "ui/strings.h"

namespace tessal {

namespace {

/// Draws a text with its marks: bold on a tinted ground, and underlined for those who see no tint.
class MarkingDelegate final : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;

  void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override {
    const auto* rows = qobject_cast<const CFoundRows*>(index.model());
    if (rows == nullptr || index.column() != CFoundRows::Text) {
      QStyledItemDelegate::paint(painter, option, index);
      return;
    }
    QStyleOptionViewItem shown = option;
    initStyleOption(&shown, index);
    shown.text.clear();
    const QStyle& style = shown.widget == nullptr ? *QApplication::style() : *shown.widget->style();
    style.drawControl(QStyle::CE_ItemViewItem, &shown, painter, shown.widget);
    const int margin = style.pixelMetric(QStyle::PM_FocusFrameHMargin, &shown, shown.widget) + 1;
    DrawMarked(*painter, shown, shown.rect.adjusted(margin, 0, -margin, 0), rows->Marked(index));
  }

 private:
  static void DrawMarked(QPainter& painter, const QStyleOptionViewItem& shown, const QRect& place,
                         const MarkedText& marked) {
    constexpr int kTint = 90;
    const bool isSelected = shown.state.testFlag(QStyle::State_Selected);
    QTextCharFormat looks;
    looks.setFontWeight(QFont::Bold);
    looks.setFontUnderline(true);
    QColor tint = shown.palette.color(QPalette::Highlight);
    tint.setAlpha(kTint);
    if (!isSelected) looks.setBackground(tint);
    QList<QTextLayout::FormatRange> formats;
    for (const auto& [start, length] : marked.marks) formats.append({start, length, looks});
    QTextLayout layout(marked.text, shown.font);
    layout.setFormats(formats);
    QTextOption oneLine;
    oneLine.setWrapMode(QTextOption::NoWrap);
    layout.setTextOption(oneLine);
    layout.beginLayout();
    QTextLine line = layout.createLine();
    layout.endLayout();
    painter.save();
    painter.setClipRect(place);
    painter.setPen(shown.palette.color(isSelected ? QPalette::HighlightedText : QPalette::Text));
    layout.draw(&painter, QPointF(place.left(), place.top() + (place.height() - line.height()) / 2));
    painter.restore();
  }
};

}  // namespace

CFoundList::CFoundList(QWidget* parent) : QTreeView(parent), rows(MakeChild<CFoundRows>(this)) {
  setModel(rows);
  setItemDelegate(MakeChild<MarkingDelegate>(this));
  setAccessibleName(strings::kFoundList);
  setRootIsDecorated(false);
  setItemsExpandable(false);
  setUniformRowHeights(true);
  setAllColumnsShowFocus(true);
  setTabKeyNavigation(false);
  connect(this, &QTreeView::activated, this, [this](const QModelIndex& cell) { emit RowChosen(cell.row()); });
  connect(this, &QTreeView::clicked, this, [this](const QModelIndex& cell) {
    // A click on a box is for the box.
    if ((rows->flags(cell) & Qt::ItemIsUserCheckable) == 0) emit RowChosen(cell.row());
  });
}

void CFoundList::FitColumns() {
  constexpr int kMostPart = 3;
  // Marks are bold, and so wider than the text that is measured.
  constexpr int kForMarks = 8;
  for (const int column : {CFoundRows::Element, CFoundRows::Field, CFoundRows::Text}) {
    resizeColumnToContents(column);
    const int part = column == CFoundRows::Text ? 2 : kMostPart;
    const int width =
        columnWidth(column) + (column == CFoundRows::Text ? columnWidth(column) / kForMarks : 0);
    if (column < rows->columnCount() - 1) setColumnWidth(column, std::min(width, viewport()->width() / part));
  }
}

void CFoundList::GoToRow(int step) {
  const int count = rows->rowCount();
  if (count == 0) return;
  const int from = currentIndex().isValid() ? currentIndex().row() : (step > 0 ? -1 : count);
  const QModelIndex target = rows->index((from + step + count) % count, 0);
  setCurrentIndex(target);
  scrollTo(target);
  emit RowChosen(target.row());
}

}  // namespace tessal
