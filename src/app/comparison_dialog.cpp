#include "app/comparison_dialog.h"

#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QTreeWidget>
#include <QVBoxLayout>
#include <memory>

#include "platform/docview.h"

namespace tessal {

namespace {

constexpr QSize kUsualSize(900, 480);
constexpr int kWidestColumn = 260;

template <class Object, class... Arguments>
Object* Make(Arguments&&... arguments) {
  return std::make_unique<Object>(std::forward<Arguments>(arguments)...).release();
}

/// Several lines lie in one row, with the whole in the tip.
void AddRow(QTreeWidget& table, const DocumentDifference& difference) {
  const QStringList texts = {
      QString::fromStdString(difference.change), QString::fromStdString(difference.kind),
      QString::fromStdString(difference.name),   QString::fromStdString(difference.field),
      QString::fromStdString(difference.before), QString::fromStdString(difference.after)};
  auto* row = Make<QTreeWidgetItem>(&table);
  for (int column = 0; column < texts.size(); ++column) {
    row->setText(column, texts[column].simplified());
    row->setToolTip(column, texts[column].toHtmlEscaped());
  }
}

QTreeWidget* MakeTable(const DocumentComparison& comparison, const QStringList& heads, QWidget* parent) {
  auto* table = Make<QTreeWidget>(parent);
  table->setAccessibleName(QDialog::tr("Differences"));
  table->setRootIsDecorated(false);
  table->setUniformRowHeights(true);
  table->setAlternatingRowColors(true);
  table->setHeaderLabels(heads);
  for (const DocumentDifference& difference : comparison.differences) AddRow(*table, difference);
  table->header()->setMaximumSectionSize(kWidestColumn);
  for (int column = 0; column < table->columnCount(); ++column) table->resizeColumnToContents(column);
  table->header()->setMaximumSectionSize(-1);
  return table;
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
  rows->addWidget(MakeTable(comparison, heads, this), 1);
  auto* buttons = Make<QDialogButtonBox>(QDialogButtonBox::Close, this);
  connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
  rows->addWidget(buttons);
}

}  // namespace tessal
