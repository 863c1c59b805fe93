#include "ui/analysis_pane.h"

#include <QKeyEvent>
#include <QStyle>
#include <QTabWidget>
#include <QTimer>
#include <QToolButton>
#include <QVBoxLayout>
#include <utility>

#include "ui/child.h"
#include "ui/findings_page.h"
#include "ui/influence_page.h"
#include "ui/kept_splitter.h"
#include "ui/matrix_page.h"
#include "ui/pools_page.h"
#include "ui/strings.h"

namespace tessal {

namespace {

constexpr int kUsualHeight = 280;
/// How long nothing happens before the page is brought up to date, in milliseconds.
constexpr int kPause = 200;

}  // namespace

CAnalysisPane::CAnalysisPane(CTessalDoc& analysedDocument, std::function<Uid()> selectedElement,
                             QWidget* parent)
    : QFrame(parent),
      pages(MakeChild<QTabWidget>(this)),
      pause(MakeChild<QTimer>(this)),
      findings(MakeChild<CFindingsPage>(analysedDocument, this)),
      matrix(MakeChild<CMatrixPage>(analysedDocument, this)),
      pools(MakeChild<CPoolsPage>(analysedDocument, this)),
      influences(MakeChild<CInfluencePage>(analysedDocument, std::move(selectedElement), this)) {
  setObjectName(QStringLiteral("AnalysisPane"));
  setAccessibleName(strings::kAnalyses);
  auto* layout = MakeChild<QVBoxLayout>(this);
  layout->setContentsMargins(0, 0, 0, 0);
  layout->addWidget(pages);
  pages->setAccessibleName(strings::kAnalyses);
  auto* close = MakeChild<QToolButton>(pages);
  close->setIcon(style()->standardIcon(QStyle::SP_TitleBarCloseButton));
  close->setAutoRaise(true);
  close->setToolTip(strings::kCloseAnalyses);
  close->setAccessibleName(strings::kCloseAnalyses);
  close->setFocusPolicy(Qt::StrongFocus);
  connect(close, &QToolButton::clicked, this, &CAnalysisPane::CloseUp);
  pages->setCornerWidget(close);
  AddPage(*findings, strings::kFindingsPage);
  AddPage(*matrix, strings::kMatrixPage);
  AddPage(*pools, strings::kPoolsPage);
  AddPage(*influences, strings::kInfluencesPage);
  pause->setObjectName(QStringLiteral("AnalysisPause"));
  pause->setSingleShot(true);
  pause->setInterval(kPause);
  connect(pause, &QTimer::timeout, this, &CAnalysisPane::RefreshPage);
  connect(pages, &QTabWidget::currentChanged, this, &CAnalysisPane::RefreshPage);
}

void CAnalysisPane::AddPage(CAnalysisPage& page, const QString& title) {
  pages->addTab(&page, title);
  connect(&page, &CAnalysisPage::ElementChosen, this, &CAnalysisPane::ElementChosen);
}

void CAnalysisPane::Open(CAnalysisPage& page) {
  emit Opening();
  OpenInSplitter(*this, kUsualHeight);
  if (pages->currentWidget() == &page) {
    RefreshPage();
  } else {
    pages->setCurrentWidget(&page);
  }
  page.FirstStop().setFocus(Qt::OtherFocusReason);
}

void CAnalysisPane::NoteChange() {
  if (isVisible()) pause->start();
}

void CAnalysisPane::CatchUp() {
  if (pause->isActive()) RefreshPage();
}

void CAnalysisPane::RefreshPage() {
  pause->stop();
  if (isVisible()) static_cast<CAnalysisPage*>(pages->currentWidget())->Refresh();
}

void CAnalysisPane::CloseUp() {
  pools->CommitTyped();
  pause->stop();
  hide();
  emit Closed();
}

void CAnalysisPane::keyPressEvent(QKeyEvent* key) {
  if (key->key() == Qt::Key_Escape) {
    CloseUp();
    return;
  }
  QFrame::keyPressEvent(key);
}

}  // namespace tessal
