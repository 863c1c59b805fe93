#include "ui/error_list.h"

#include <QSignalBlocker>
#include <algorithm>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/node_kinds.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kUidRole = Qt::UserRole;

}  // namespace

CErrorList::CErrorList(QWidget* parent) : QTreeWidget(parent) {
  setObjectName(QString::number(control_id::kErrorList));
  setColumnCount(2);
  setHeaderLabels({strings::kItemColumn, strings::kMessageColumn});
  setRootIsDecorated(false);
  setUniformRowHeights(true);
  setAllColumnsShowFocus(true);
  setAccessibleName(strings::kMessages);
  // A choice fills the list again: where a click also activates, the second signal finds its row gone.
  const auto choose = [this](const QTreeWidgetItem* row) {
    if (row != nullptr) emit ElementChosen(Uid{row->data(0, kUidRole).toInt()});
  };
  connect(this, &QTreeWidget::itemClicked, this, choose);
  connect(this, &QTreeWidget::itemActivated, this, choose);
}

std::vector<CErrorList::Row> CErrorList::CollectRows(const TemplateCore& core) {
  std::vector<Row> rows;
  // The users of the undefined symbols lie on top, the last ones first: each is put at the place of its
  // symbol, before what lies there.
  std::size_t place = 0;
  for (const auto& undefined : core.UndefinedSymbols()) {
    const QString message = strings::kUndefinedSymbol + ToScreen(undefined->symbol);
    for (const Uid user : undefined->usedBy) {
      const CEL_Element* element = core.GetElement(user);
      const QString caption = element == nullptr ? QString() : ToScreen(ElementCaption(*element));
      rows.insert(rows.begin() + static_cast<std::ptrdiff_t>(std::min(place, rows.size())),
                  {caption, message, user});
    }
    ++place;
  }
  std::string symbol;
  std::string text;
  Uid uid = Uid::None;
  for (std::size_t index = 0; index < Errors().Records().size(); ++index) {
    Errors().GetErrorForList(index, symbol, uid, text);
    rows.push_back({symbol.empty() ? strings::kGeneric : ToScreen(symbol), ToScreen(text).trimmed(), uid});
  }
  return rows;
}

void CErrorList::RefreshErrorList(TemplateCore& core) {
  Errors().ClearErrors();
  core.ValidateTemplate();
  const std::vector<Row> rows = CollectRows(core);

  const QTreeWidgetItem* selected = currentItem();
  const QString selectedItem = selected == nullptr ? QString() : selected->text(0);
  const QString selectedMessage = selected == nullptr ? QString() : selected->text(1);
  const QSignalBlocker quiet(this);
  clear();
  QList<QTreeWidgetItem*> items;
  items.reserve(static_cast<qsizetype>(rows.size()));
  QTreeWidgetItem* reselected = nullptr;
  for (const Row& row : rows) {
    auto* item = MakeChild<QTreeWidgetItem>(QStringList{row.item, row.message});
    item->setData(0, kUidRole, NumberOf(row.uid));
    item->setToolTip(1, row.message.toHtmlEscaped());
    items.append(item);
    const bool isSelected = selected != nullptr && row.item == selectedItem && row.message == selectedMessage;
    if (isSelected && reselected == nullptr) reselected = item;
  }
  addTopLevelItems(items);
  if (reselected != nullptr) setCurrentItem(reselected);
  for (int column = 0; column < columnCount(); ++column) resizeColumnToContents(column);
}

}  // namespace tessal
