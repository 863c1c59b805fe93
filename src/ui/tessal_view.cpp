#include "ui/tessal_view.h"

#include <QTabBar>
#include <QTabWidget>
#include <QVBoxLayout>

#include "ui/child.h"
#include "ui/general_page.h"
#include "ui/overview_page.h"
#include "ui/strings.h"

namespace tessal {

namespace {

constexpr const char* kActiveTab = "ActiveTab";

}  // namespace

CTessalView::CTessalView(const FormContext& context, QWidget* parent)
    : CRightPaneBase(context, parent), pages(MakeChild<QTabWidget>(this)) {
  pages->setObjectName(QStringLiteral("1001"));
  general = MakeChild<CGeneralPpg>(context, pages);
  overview = MakeChild<COverviewPpg>(context, pages);
  pages->setAccessibleName(strings::kPages);
  pages->tabBar()->setAccessibleName(strings::kPages);
  pages->addTab(general, strings::kGeneralPage);
  pages->addTab(overview, strings::kOverviewPage);
  auto* layout = MakeChild<QVBoxLayout>(this);
  layout->setContentsMargins(0, 0, 0, 0);
  layout->addWidget(pages);
}

void CTessalView::ItemToForm() {
  general->Load();
  overview->Load();
  pages->setCurrentIndex(QString::fromStdString(Item().viewState[kActiveTab]).toInt());
}

std::vector<TypedValue> CTessalView::TypedValues() const {
  return general->TypedValues();
}

QWidget* CTessalView::ShowText(const TextToShow& text) {
  pages->setCurrentWidget(general);
  return general->ShowText(text);
}

void CTessalView::FormToItem() {
  general->Commit();
  Item().viewState[kActiveTab] = std::to_string(pages->currentIndex());
}

}  // namespace tessal
