#include "ui/error_list.h"

#include <QApplication>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QHeaderView>
#include <QKeyEvent>
#include <QMenu>
#include <QSignalBlocker>
#include <QStyledItemDelegate>
#include <algorithm>
#include <map>
#include <numeric>
#include <utility>

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
constexpr int kMessageColumn = 1;
/// The column "Item" takes at most this part of the list.
constexpr int kItemShare = 3;
/// An undefined symbol keeps a template from being used.
constexpr auto kUndefinedLevel = static_cast<std::uint32_t>(ErrorLevel::Critical);

constexpr std::string_view kUndefinedCode = "undefined-symbol";

MessageGroup GroupOfLevel(std::uint32_t level) {
  if (level >= static_cast<std::uint32_t>(ErrorLevel::Critical)) return MessageGroup::Errors;
  return level == static_cast<std::uint32_t>(ErrorLevel::Warning) ? MessageGroup::Warnings
                                                                  : MessageGroup::Notices;
}

/// A row by its texts, which stay the same when the list is filled again. Equal rows differ by their
/// order.
using RowTexts = std::pair<QString, QString>;

RowTexts TextsOf(const QTreeWidgetItem& item) {
  return {item.text(kItemColumn), item.text(kMessageColumn)};
}

/// A row of the list. Its icon and its tips are made when they are asked for: the list is filled often.
class RowItem final : public QTreeWidgetItem {
 public:
  RowItem(const QString& item, const QString& message, Uid uid, std::uint32_t messageLevel,
          std::size_t rowPlace)
      : QTreeWidgetItem(QStringList{item, message}), place(rowPlace), level(messageLevel) {
    setData(kItemColumn, kUidRole, NumberOf(uid));
  }

  QVariant data(int column, int role) const override {
    if (role == Qt::ToolTipRole) return PlainTip(text(column));
    if (role == Qt::DecorationRole && column == kItemColumn) return IconOfLevel(level);
    if (role == Qt::AccessibleTextRole && column == kItemColumn)
      return QString(WordOfLevel(level) + u' ' + text(column));
    return QTreeWidgetItem::data(column, role);
  }

  const std::size_t place;  ///< of its row in the order of the messages

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
  setSelectionMode(ExtendedSelection);
  // A choice fills the list again: where a click also activates, the second signal finds its row gone.
  const auto choose = [this](const QTreeWidgetItem* row) {
    // A click that adds to the selection leads nowhere.
    const bool isSelecting =
        (QApplication::keyboardModifiers() & (Qt::ControlModifier | Qt::ShiftModifier)) != 0;
    if (row != nullptr && !isSelecting) emit ElementChosen(Uid{row->data(0, kUidRole).toInt()});
  };
  connect(this, &QTreeWidget::itemClicked, this, choose);
  connect(this, &QTreeWidget::itemActivated, this, choose);
  header()->setSectionsClickable(true);
  connect(header(), &QHeaderView::sectionClicked, this, &CErrorList::CycleSorting);
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
      collected.insert(
          collected.begin() + static_cast<std::ptrdiff_t>(std::min(place, collected.size())),
          {caption, message, user, kUndefinedLevel, std::string(kUndefinedCode), undefined->symbol});
    }
    ++place;
  }
  std::string symbol;
  std::string text;
  Uid uid = Uid::None;
  for (std::size_t index = 0; index < Errors().Records().size(); ++index) {
    Errors().GetErrorForList(index, symbol, uid, text);
    const ErrorRecord& record = Errors().Records()[index];
    collected.push_back({symbol.empty() ? strings::kGeneric : ToScreen(symbol), ToScreen(text).trimmed(), uid,
                         record.level, std::string(record.code), std::string()});
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

int CErrorList::CountOf(MessageGroup group) const {
  return static_cast<int>(std::count_if(
      rows.begin(), rows.end(), [group](const Row& row) { return GroupOfLevel(row.level) == group; }));
}

const CErrorList::Row& CErrorList::RowOf(const QTreeWidgetItem& item) const {
  return rows[static_cast<const RowItem&>(item).place];
}

void CErrorList::RefreshErrorList(TemplateCore& core) {
  Errors().ClearErrors();
  core.ValidateTemplate();
  // The items on the screen know their texts by themselves.
  rows = CollectRows(core);
  ShowRows();
  emit Refreshed();
}

void CErrorList::ShowRows() {
  // How many of the rows with the same texts come before one that is selected, or current.
  std::map<RowTexts, int> met;
  std::map<RowTexts, std::vector<int>> selected;
  std::pair<RowTexts, int> current{{}, -1};
  for (int place = 0; place < topLevelItemCount(); ++place) {
    QTreeWidgetItem* item = topLevelItem(place);
    const int order = met[TextsOf(*item)]++;
    if (item->isSelected()) selected[TextsOf(*item)].push_back(order);
    if (item == currentItem()) current = {TextsOf(*item), order};
  }
  const QSignalBlocker quiet(this);
  clear();
  QList<QTreeWidgetItem*> items;
  items.reserve(static_cast<qsizetype>(rows.size()));
  for (const std::size_t place : SortedPlaces()) {
    const Row& row = rows[place];
    items.append(MakeChild<RowItem>(row.item, row.message, row.uid, row.level, place));
  }
  addTopLevelItems(items);
  met.clear();
  QTreeWidgetItem* again = nullptr;
  QList<QTreeWidgetItem*> selectedAgain;
  for (QTreeWidgetItem* item : items) {
    item->setHidden(!PassesFilter(RowOf(*item)));
    const RowTexts texts = TextsOf(*item);
    const int order = met[texts]++;
    // Where there are fewer equal rows than before, it is the last one.
    if (texts == current.first && order <= current.second) again = item;
    const auto chosen = selected.find(texts);
    if (chosen != selected.end() && std::count(chosen->second.begin(), chosen->second.end(), order) > 0)
      selectedAgain.append(item);
  }
  if (again != nullptr) setCurrentItem(again);
  for (QTreeWidgetItem* item : selectedAgain) item->setSelected(true);
  FitColumns();
}

std::vector<std::size_t> CErrorList::SortedPlaces() const {
  std::vector<std::size_t> places(rows.size());
  std::iota(places.begin(), places.end(), std::size_t{0});
  if (sorting.column < 0) return places;
  const auto textOf = [this](std::size_t place) -> const QString& {
    return sorting.column == kItemColumn ? rows[place].item : rows[place].message;
  };
  std::stable_sort(places.begin(), places.end(), [this, &textOf](std::size_t left, std::size_t right) {
    const int order = textOf(left).compare(textOf(right), Qt::CaseInsensitive);
    return sorting.order == Qt::AscendingOrder ? order < 0 : order > 0;
  });
  return places;
}

bool CErrorList::PassesFilter(const Row& row) const {
  if (!filter.shows[static_cast<std::size_t>(GroupOfLevel(row.level))]) return false;
  const QStringList words = filter.words.split(u' ', Qt::SkipEmptyParts);
  return std::all_of(words.begin(), words.end(), [&row](const QString& word) {
    return row.item.contains(word, Qt::CaseInsensitive) || row.message.contains(word, Qt::CaseInsensitive);
  });
}

void CErrorList::Filter(const MessageFilter& rowFilter) {
  filter = rowFilter;
  for (int place = 0; place < topLevelItemCount(); ++place) {
    QTreeWidgetItem* item = topLevelItem(place);
    item->setHidden(!PassesFilter(RowOf(*item)));
  }
}

void CErrorList::SortBy(const Sorting& wanted) {
  sorting = wanted;
  header()->setSortIndicatorShown(sorting.column >= 0);
  if (sorting.column >= 0) header()->setSortIndicator(sorting.column, sorting.order);
  ShowRows();
}

void CErrorList::CycleSorting(int column) {
  if (sorting.column != column) {
    SortBy({column, Qt::AscendingOrder});
  } else if (sorting.order == Qt::AscendingOrder) {
    SortBy({column, Qt::DescendingOrder});
  } else {
    SortBy({});
  }
}

void CErrorList::GoToMessage(int step) {
  const int count = topLevelItemCount();
  QTreeWidgetItem* from = currentItem();
  int place = from == nullptr ? (step > 0 ? -1 : count) : indexOfTopLevelItem(from);
  for (int left = count; left > 0; --left) {
    place = (place + step + count) % count;
    QTreeWidgetItem* item = topLevelItem(place);
    if (item->isHidden()) continue;
    // A field that has the focus goes with its form.
    setFocus(Qt::OtherFocusReason);
    setCurrentItem(item);
    scrollToItem(item);
    emit ElementChosen(RowOf(*item).uid);
    return;
  }
}

void CErrorList::CopyRows() const {
  QString text;
  for (int place = 0; place < topLevelItemCount(); ++place) {
    const QTreeWidgetItem& item = *topLevelItem(place);
    if (item.isSelected() && !item.isHidden())
      text += item.text(kItemColumn) + u'\t' + item.text(kMessageColumn).simplified() + u'\n';
  }
  if (!text.isEmpty()) QApplication::clipboard()->setText(text);
}

void CErrorList::keyPressEvent(QKeyEvent* key) {
  if (key->matches(QKeySequence::Copy)) {
    CopyRows();
    return;
  }
  QTreeWidget::keyPressEvent(key);
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

void CErrorList::FillMenu(QMenu& menu, const QTreeWidgetItem& item) {
  const Row& row = RowOf(item);
  if (!row.undefinedSymbol.empty()) {
    QString name = ToScreen(row.undefinedSymbol);
    menu.addAction(strings::kCreateSymbol.arg(name.replace(u'&', QStringLiteral("&&"))), this,
                   [this, symbol = row.undefinedSymbol] { emit CreateSymbolRequested(symbol); });
  }
  QAction* explain =
      menu.addAction(strings::kExplain, this, [this, code = row.code] { emit ExplanationRequested(code); });
  explain->setEnabled(FindMessage(row.code) != nullptr);
  menu.addAction(strings::kCopyRows, this, &CErrorList::CopyRows);
  menu.addSeparator();
  menu.addAction(strings::kSortByItem, this, [this] { SortBy({kItemColumn}); });
  menu.addAction(strings::kSortByMessage, this, [this] { SortBy({kMessageColumn}); });
  menu.addAction(strings::kUsualOrder, this, [this] { SortBy({}); })->setEnabled(sorting.column >= 0);
}

void CErrorList::contextMenuEvent(QContextMenuEvent* request) {
  const bool byKey = request->reason() == QContextMenuEvent::Keyboard;
  QTreeWidgetItem* item = byKey ? currentItem() : itemAt(viewport()->mapFromGlobal(request->globalPos()));
  if (item == nullptr) return;
  QMenu menu(this);
  FillMenu(menu, *item);
  const QPoint point = byKey ? viewport()->mapToGlobal(visualItemRect(item).center()) : request->globalPos();
  menu.exec(point);
}

}  // namespace tessal
