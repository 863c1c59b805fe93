#include "ui/go_to_symbol.h"

#include <QCoreApplication>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLineEdit>
#include <QTreeWidget>
#include <QVBoxLayout>
#include <algorithm>

#include "core/symbol_ranking.h"
#include "core/template_core.h"
#include "ui/child.h"
#include "ui/icons.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr std::size_t kMostRows = 100;
constexpr QSize kWindow(460, 320);

}  // namespace

CGoToSymbol::CGoToSymbol(const TemplateCore& template_, QWidget* parent)
    : QDialog(parent),
      core(template_),
      letters(MakeChild<QLineEdit>(this)),
      list(MakeChild<QTreeWidget>(this)) {
  setWindowTitle(strings::kGoToSymbol);
  letters->setPlaceholderText(strings::kSymbolLetters);
  letters->setAccessibleName(strings::kSymbolLetters);
  letters->installEventFilter(this);
  list->setAccessibleName(strings::kFittingSymbols);
  list->setColumnCount(2);
  list->setHeaderHidden(true);
  list->setRootIsDecorated(false);
  list->setUniformRowHeights(true);
  list->setAllColumnsShowFocus(true);
  auto* layout = MakeChild<QVBoxLayout>(this);
  layout->addWidget(letters);
  layout->addWidget(list, 1);
  resize(kWindow);
  connect(letters, &QLineEdit::textChanged, this, &CGoToSymbol::ShowFitting);
  connect(list, &QTreeWidget::itemClicked, this, &CGoToSymbol::Choose);
  connect(list, &QTreeWidget::itemActivated, this, &CGoToSymbol::Choose);
  ShowFitting();
}

void CGoToSymbol::ShowFitting() {
  list->clear();
  QList<QTreeWidgetItem*> rows;
  for (const SymbolRecord* record : SymbolsByRank(core, letters->text().toStdString(), kMostRows)) {
    const CEL_Element& element = *record->element;
    const QString description = ToScreen(element.description.Text()).simplified();
    auto* row = MakeChild<QTreeWidgetItem>(QStringList{ToScreen(NameToGoTo(*record)), description});
    row->setIcon(0, IconOfKind(element.Kind()));
    row->setData(0, Qt::UserRole, NumberOf(element.GetUid()));
    row->setToolTip(0, ToScreen(element.KindText()));
    rows.append(row);
  }
  list->addTopLevelItems(rows);
  list->resizeColumnToContents(0);
  list->setColumnWidth(0, std::min(list->columnWidth(0), kWindow.width() / 2));
  list->setCurrentItem(list->topLevelItem(0));
}

void CGoToSymbol::Choose(const QTreeWidgetItem* row) {
  // A click may activate too.
  if (row == nullptr || !isVisible()) return;
  const Uid uid{row->data(0, Qt::UserRole).toInt()};
  accept();
  emit SymbolChosen(uid);
}

bool CGoToSymbol::eventFilter(QObject* watched, QEvent* happened) {
  if (watched == letters && happened->type() == QEvent::KeyPress) {
    const auto* key = static_cast<QKeyEvent*>(happened);
    switch (key->key()) {
      case Qt::Key_Up:
      case Qt::Key_Down:
      case Qt::Key_PageUp:
      case Qt::Key_PageDown:
        QCoreApplication::sendEvent(list, happened);
        return true;
      case Qt::Key_Return:
      case Qt::Key_Enter:
        Choose(list->currentItem());
        return true;
      default:
        break;
    }
  }
  return QDialog::eventFilter(watched, happened);
}

}  // namespace tessal
