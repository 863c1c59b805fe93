#include "ui/overview_page.h"

#include <QApplication>
#include <QClipboard>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QPushButton>
#include <QVBoxLayout>

#include "core/document.h"
#include "docgen/html_documentation.h"
#include "platform/host_settings.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/dialogs.h"
#include "ui/row_table.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// The export button is for developers, who put a marker file into the installation.
bool IsDeveloper() {
  const QString root = QString::fromStdString(InstallRoot());
  return !root.isEmpty() && QFileInfo::exists(root + QStringLiteral("/Bin/Tessal.debug"));
}

}  // namespace

COverviewPpg::COverviewPpg(const FormContext& context, QWidget* parent)
    : CRightPaneBase(context, parent),
      table(MakeChild<CRowTable>(control_id::kList, strings::kOverviewPage, this)) {
  auto* copy = MakeChild<QPushButton>(strings::kToClipboard, this);
  copy->setObjectName(QStringLiteral("1039"));
  copy->setAccessibleName(strings::kToClipboard);
  auto* exportPage = MakeChild<QPushButton>(strings::kExportHtml, this);
  exportPage->setObjectName(QStringLiteral("1132"));
  exportPage->setAccessibleName(strings::kExportHtml);
  exportPage->setVisible(IsDeveloper());
  exportPage->setEnabled(IsDeveloper());
  auto* buttons = MakeChild<QHBoxLayout>();
  buttons->addStretch(1);
  buttons->addWidget(exportPage);
  buttons->addWidget(copy);
  auto* layout = MakeChild<QVBoxLayout>(this);
  layout->addWidget(table, 1);
  layout->addLayout(buttons);
  connect(copy, &QPushButton::clicked, this, &COverviewPpg::CopyToClipboard);
  connect(exportPage, &QPushButton::clicked, this, &COverviewPpg::ExportPage);
  connect(table, &CRowTable::RowEntered, this,
          [this](int row) { JumpTo(table->Model().Rows()[static_cast<std::size_t>(row)].uid); });
}

void COverviewPpg::ItemToForm() {
  isFilled = false;
  if (isVisible()) Fill();
}

void COverviewPpg::showEvent(QShowEvent* seen) {
  CRightPaneBase::showEvent(seen);
  // Most visits to the root look at its other page.
  if (!isFilled) Fill();
}

void COverviewPpg::Fill() {
  isFilled = true;
  shown = BuildOverview(Core());
  std::vector<CRowModel::Row> rows(shown.size());
  for (std::size_t place = 0; place < rows.size(); ++place) {
    rows[place] = {shown[place].uid, static_cast<std::int32_t>(place), 0};
  }
  QStringList titles;
  for (const OverviewColumn& column : kOverviewColumns) titles.append(ToScreen(column.title));
  table->Fill(titles, std::move(rows), [this](const CRowModel::Row& row, int column) {
    return shown[static_cast<std::size_t>(row.key)].cells[static_cast<std::size_t>(column)];
  });
}

void COverviewPpg::CopyToClipboard() {
  QApplication::clipboard()->setText(ToScreen(OverviewText(Core(), shown)));
  Dialogs().ShowMessage(strings::kClipboardDone);
}

void COverviewPpg::ExportPage() {
  std::string failure;
  const std::optional<std::string> path = PrepareUsualPagePath(Core().TemplateFileName(), failure);
  // There is no way to cancel.
  PageOptions options;
  if (Dialogs().Ask(this, strings::kAskMathJax) == Answer::Yes) options.mathJax = UsualMathJax();
  if (!path || !ExportHtmlDocumentation(Core(), *path, options, failure)) {
    Dialogs().ShowFailure(this, ToScreen(failure));
  }
  Dialogs().ShowMessage(strings::kPageExported.arg(ToScreen(Core().TemplateFileName())).toStdString());
}

}  // namespace tessal
