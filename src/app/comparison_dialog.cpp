#include "app/comparison_dialog.h"

#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QPlainTextEdit>
#include <QTreeWidget>
#include <QVBoxLayout>
#include <algorithm>
#include <memory>

#include "platform/docview.h"

namespace tessal {

namespace {

constexpr QSize kUsualSize(900, 480);
constexpr int kWidestColumn = 200;

template <class Object, class... Arguments>
Object* Make(Arguments&&... arguments) {
  return std::make_unique<Object>(std::forward<Arguments>(arguments)...).release();
}

enum Column { kChange, kKind, kName, kField, kBefore, kAfter };

/// Several lines lie in one row; the item keeps the whole.
void AddRow(QTreeWidget& table, const DocumentDifference& difference) {
  const QStringList texts = {
      QString::fromStdString(difference.change), QString::fromStdString(difference.kind),
      QString::fromStdString(difference.name),   QString::fromStdString(difference.field),
      QString::fromStdString(difference.before), QString::fromStdString(difference.after)};
  auto* row = Make<QTreeWidgetItem>(&table);
  for (int column = 0; column < texts.size(); ++column) {
    row->setText(column, texts[column].simplified());
    row->setData(column, Qt::UserRole, texts[column]);
  }
}

QTreeWidget* MakeTable(const DocumentComparison& comparison, const QStringList& heads, QWidget* parent) {
  auto* table = Make<QTreeWidget>(parent);
  table->setAccessibleName(QDialog::tr("Differences"));
  table->setRootIsDecorated(false);
  table->setUniformRowHeights(true);
  table->setAlternatingRowColors(true);
  table->setAllColumnsShowFocus(true);
  table->setHeaderLabels(heads);
  for (const DocumentDifference& difference : comparison.differences) AddRow(*table, difference);
  for (int column = kChange; column < kBefore; ++column) {
    table->resizeColumnToContents(column);
    table->setColumnWidth(column, std::min(table->columnWidth(column), kWidestColumn));
  }
  for (const int column : {kBefore, kAfter})
    table->header()->setSectionResizeMode(column, QHeaderView::Stretch);
  return table;
}

/// Shows one value of the row in front with all its lines.
QPlainTextEdit* MakeValue(QTreeWidget& table, int column, QWidget* parent) {
  auto* value = Make<QPlainTextEdit>(parent);
  value->setReadOnly(true);
  value->setTabChangesFocus(true);
  value->setAccessibleName(table.headerItem()->text(column));
  QObject::connect(&table, &QTreeWidget::currentItemChanged, value, [value, column](QTreeWidgetItem* row) {
    value->setPlainText(row == nullptr ? QString() : row->data(column, Qt::UserRole).toString());
  });
  return value;
}

}  // namespace

QString SummaryOf(const DocumentComparison& comparison) {
  if (!comparison.failure.empty()) return QString::fromStdString(comparison.failure);
  const auto count = static_cast<int>(comparison.differences.size());
  if (count == 0) return QDialog::tr("There are no differences.");
  return count == 1 ? QDialog::tr("There is 1 difference.")
                    : QDialog::tr("There are %1 differences.").arg(count);
}

ComparisonDialog::ComparisonDialog(const DocumentComparison& comparison, const QString& before,
                                   const QString& after, QWidget* parent)
    : QDialog(parent) {
  setWindowTitle(tr("Compare"));
  resize(kUsualSize.boundedTo(parent->size()));
  auto* summary = Make<QLabel>(SummaryOf(comparison), this);
  summary->setTextFormat(Qt::PlainText);
  summary->setWordWrap(true);
  auto* rows = Make<QVBoxLayout>(this);
  rows->addWidget(summary);
  const QStringList heads = {tr("Change"), tr("Kind"), tr("Name"), tr("Field"), before, after};
  QTreeWidget* table = MakeTable(comparison, heads, this);
  auto* values = Make<QHBoxLayout>();
  for (const int column : {kBefore, kAfter}) values->addWidget(MakeValue(*table, column, this));
  rows->addWidget(table, 3);
  rows->addLayout(values, 1);
  table->setCurrentItem(table->topLevelItem(0));
  auto* buttons = Make<QDialogButtonBox>(QDialogButtonBox::Close, this);
  connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
  rows->addWidget(buttons);
}

}  // namespace tessal
