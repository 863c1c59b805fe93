#include "ui/error_list.h"

#include <QContextMenuEvent>
#include <QHeaderView>
#include <QMenu>
#include <QSignalBlocker>
#include <QStyledItemDelegate>
#include <algorithm>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/icons.h"
#include "ui/node_kinds.h"
#include "ui/plain_tip.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kUidRole = Qt::UserRole;
constexpr int kItemColumn = 0;
/// The column "Item" takes at most this part of the list.
constexpr int kItemShare = 3;
/// An undefined symbol keeps a template from being used.
constexpr auto kUndefinedLevel = static_cast<std::uint32_t>(ErrorLevel::Critical);

/// A row of the list. Its icon and its tips are made when they are asked for: the list is filled often.
class RowItem final : public QTreeWidgetItem {
 public:
  RowItem(const QString& item, const QString& message, Uid uid, std::uint32_t messageLevel)
      : QTreeWidgetItem(QStringList{item, message}), level(messageLevel) {
    setData(kItemColumn, kUidRole, NumberOf(uid));
  }

  QVariant data(int column, int role) const override {
    if (role == Qt::ToolTipRole) return PlainTip(text(column));
    if (role == Qt::DecorationRole && column == kItemColumn) return IconOfLevel(level);
    if (role == Qt::AccessibleTextRole && column == kItemColumn)
      return QString(WordOfLevel(level) + u' ' + text(column));
    return QTreeWidgetItem::data(column, role);
  }

 private:
  std::uint32_t level;
};

/// Each row is a link to its element, and looks like one under the pointer.
class LinkRows final : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;

 protected:
  void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
    QStyledItemDelegate::initStyleOption(option, index);
    if (option->state.testFlag(QStyle::State_MouseOver)) option->font.setUnderline(true);
  }
};

}  // namespace

CErrorList::CErrorList(QWidget* parent) : QTreeWidget(parent) {
  setObjectName(QString::number(control_id::kErrorList));
  setColumnCount(2);
  setHeaderLabels({strings::kItemColumn, strings::kMessageColumn});
  setRootIsDecorated(false);
  setUniformRowHeights(true);
  setAllColumnsShowFocus(true);
  setAccessibleName(strings::kMessages);
  setItemDelegate(MakeChild<LinkRows>(this));
  // The hand over a row, and the line under it, follow the pointer.
  viewport()->setAttribute(Qt::WA_Hover);
  viewport()->setMouseTracking(true);
  // A choice fills the list again: where a click also activates, the second signal finds its row gone.
  const auto choose = [this](const QTreeWidgetItem* row) {
    if (row != nullptr) emit ElementChosen(Uid{row->data(0, kUidRole).toInt()});
  };
  connect(this, &QTreeWidget::itemClicked, this, choose);
  connect(this, &QTreeWidget::itemActivated, this, choose);
}

std::vector<CErrorList::Row> CErrorList::CollectRows(const TemplateCore& core) {
  std::vector<Row> collected;
  // The users of the undefined symbols lie on top, the last ones first: each is put at the place of its
  // symbol, before what lies there.
  std::size_t place = 0;
  for (const auto& undefined : core.UndefinedSymbols()) {
    const QString message = strings::kUndefinedSymbol + ToScreen(undefined->symbol);
    for (const Uid user : undefined->usedBy) {
      const CEL_Element* element = core.GetElement(user);
      const QString caption = element == nullptr ? QString() : ToScreen(ElementCaption(*element));
      collected.insert(collected.begin() + static_cast<std::ptrdiff_t>(std::min(place, collected.size())),
                       {caption, message, user, kUndefinedLevel, undefined->symbol});
    }
    ++place;
  }
  std::string symbol;
  std::string text;
  Uid uid = Uid::None;
  for (std::size_t index = 0; index < Errors().Records().size(); ++index) {
    Errors().GetErrorForList(index, symbol, uid, text);
    collected.push_back({symbol.empty() ? strings::kGeneric : ToScreen(symbol), ToScreen(text).trimmed(), uid,
                         Errors().Records()[index].level, std::string()});
  }
  return collected;
}

std::unordered_map<Uid, ElementMessages> CErrorList::MessagesOfElements() const {
  std::unordered_map<Uid, ElementMessages> messages;
  for (const Row& row : rows) {
    if (!IsElement(row.uid)) continue;
    ElementMessages& entry = messages[row.uid];
    ++entry.count;
    entry.level = std::max(entry.level, row.level);
  }
  return messages;
}

void CErrorList::RefreshErrorList(TemplateCore& core) {
  Errors().ClearErrors();
  core.ValidateTemplate();
  rows = CollectRows(core);

  const QTreeWidgetItem* selected = currentItem();
  const QString selectedItem = selected == nullptr ? QString() : selected->text(0);
  const QString selectedMessage = selected == nullptr ? QString() : selected->text(1);
  QSignalBlocker quiet(this);
  clear();
  QList<QTreeWidgetItem*> items;
  items.reserve(static_cast<qsizetype>(rows.size()));
  QTreeWidgetItem* reselected = nullptr;
  for (const Row& row : rows) {
    auto* item = MakeChild<RowItem>(row.item, row.message, row.uid, row.level);
    items.append(item);
    const bool isSelected = selected != nullptr && row.item == selectedItem && row.message == selectedMessage;
    if (isSelected && reselected == nullptr) reselected = item;
  }
  addTopLevelItems(items);
  if (reselected != nullptr) setCurrentItem(reselected);
  FitColumns();
  quiet.unblock();
  emit Refreshed();
}

void CErrorList::FitColumns() {
  resizeColumnToContents(kItemColumn);
  setColumnWidth(kItemColumn, std::min(columnWidth(kItemColumn), viewport()->width() / kItemShare));
}

void CErrorList::resizeEvent(QResizeEvent* resize) {
  QTreeWidget::resizeEvent(resize);
  FitColumns();
}

void CErrorList::mouseMoveEvent(QMouseEvent* move) {
  QTreeWidget::mouseMoveEvent(move);
  viewport()->setCursor(itemAt(move->pos()) == nullptr ? Qt::ArrowCursor : Qt::PointingHandCursor);
}

void CErrorList::contextMenuEvent(QContextMenuEvent* request) {
  const bool byKey = request->reason() == QContextMenuEvent::Keyboard;
  QTreeWidgetItem* item = byKey ? currentItem() : itemAt(viewport()->mapFromGlobal(request->globalPos()));
  const auto place = static_cast<std::size_t>(indexOfTopLevelItem(item));
  if (item == nullptr || rows[place].undefinedSymbol.empty()) return;
  const std::string symbol = rows[place].undefinedSymbol;
  QMenu menu(this);
  QString name = ToScreen(symbol);
  const QAction* create =
      menu.addAction(strings::kCreateSymbol.arg(name.replace(u'&', QStringLiteral("&&"))));
  const QPoint point = byKey ? viewport()->mapToGlobal(visualItemRect(item).center()) : request->globalPos();
  // Creating fills the list again, and with it goes the row: the menu is closed by then.
  if (menu.exec(point) == create) emit CreateSymbolRequested(symbol);
}

}  // namespace tessal
