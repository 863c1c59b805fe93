#include "ui/tree_filter.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QTimer>
#include <algorithm>

#include "core/template_core.h"
#include "ui/child.h"
#include "ui/element_tree.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// What an element is found by, in small letters.
QString SearchedText(const CEL_Element& element) {
  QString text = ToScreen(element.symbol.Text()) + u'\n' + ToScreen(element.description.Text());
  const PropertyPlace unit = element.PlaceWithLabel("Unit");
  if (unit != nullptr) text += u'\n' + ToScreen((element.*unit).Text());
  return text.toLower();
}

bool HasAll(const QString& text, const QStringList& words) {
  return std::all_of(words.begin(), words.end(),
                     [&text](const QString& word) { return text.contains(word); });
}

bool IsFolder(const CItemData& node) {
  return !IsElement(node.id) ? node.kind != ElementKind::VisibilityGroup
                             : node.kind >= ElementKind::SpecieStateVariableList;
}

}  // namespace

CTreeFilter::CTreeFilter(CElementTree& filteredTree, const TemplateCore& template_, QWidget* parent)
    : QWidget(parent),
      tree(filteredTree),
      core(template_),
      line(MakeChild<QLineEdit>(this)),
      count(MakeChild<QLabel>(this)) {
  line->setPlaceholderText(strings::kFilterTree);
  line->setAccessibleName(strings::kFilterTree);
  line->installEventFilter(this);
  count->hide();
  setFocusProxy(line);
  auto* layout = MakeChild<QHBoxLayout>(this);
  layout->setContentsMargins(0, 0, 0, 2);
  layout->addWidget(line, 1);
  layout->addWidget(count);
  connect(line, &QLineEdit::textChanged, this, &CTreeFilter::OnTyped);
  const QAbstractItemModel* nodes = tree.model();
  connect(nodes, &QAbstractItemModel::rowsInserted, this, &CTreeFilter::ScheduleRefresh);
  connect(nodes, &QAbstractItemModel::rowsRemoved, this, &CTreeFilter::ScheduleRefresh);
  connect(nodes, &QAbstractItemModel::dataChanged, this, &CTreeFilter::ScheduleRefresh);
  connect(&tree, &QTreeWidget::currentItemChanged, this, &CTreeFilter::ScheduleRefresh);
}

void CTreeFilter::Begin() {
  QWidget* focus = QApplication::focusWidget();
  if (focus != line) focusBefore = focus;
  line->setFocus(Qt::ShortcutFocusReason);
  line->selectAll();
}

bool CTreeFilter::IsOn() const {
  return !words.isEmpty();
}

void CTreeFilter::OnTyped() {
  const bool wasOn = IsOn();
  words = line->text().toLower().simplified().split(u' ', Qt::SkipEmptyParts);
  if (!wasOn && IsOn()) {
    expandedBefore.clear();
    NoteExpanded(*tree.RootItem());
    ReadTexts();
  }
  if (IsOn()) {
    Apply({});
  } else if (wasOn) {
    TurnOff();
  }
}

void CTreeFilter::TurnOff() {
  texts.clear();
  matches.clear();
  tree.setUpdatesEnabled(false);
  ShowAll(*tree.RootItem());
  tree.setUpdatesEnabled(true);
  if (tree.currentItem() != nullptr) tree.scrollToItem(tree.currentItem());
  ShowCount();
}

void CTreeFilter::NoteExpanded(QTreeWidgetItem& item) {
  if (item.childCount() == 0) return;
  expandedBefore[NameOf(item).first] = item.isExpanded();
  for (int place = 0; place < item.childCount(); ++place) NoteExpanded(*item.child(place));
}

void CTreeFilter::ShowAll(QTreeWidgetItem& item) {
  if (item.isHidden()) item.setHidden(false);
  for (int place = 0; place < item.childCount(); ++place) ShowAll(*item.child(place));
  const auto before = expandedBefore.find(NameOf(item).first);
  if (item.childCount() > 0 && before != expandedBefore.end()) item.setExpanded(before->second);
}

void CTreeFilter::ScheduleRefresh() {
  if (!IsOn() || isScheduled) return;
  // Several changes come together, and the template may be in the midst of one.
  isScheduled = true;
  QTimer::singleShot(0, this, [this] {
    isScheduled = false;
    Refresh();
  });
}

void CTreeFilter::Refresh() {
  if (!IsOn()) return;
  ReadTexts();
  Apply(matches);
}

void CTreeFilter::ReadTexts() {
  texts.clear();
  const CEL_Element* previous = nullptr;
  // The two records of a movement are side by side.
  for (const SymbolRecord& record : core.SymbolTable()) {
    if (record.element != previous) texts.emplace(record.uid, SearchedText(*record.element));
    previous = record.element;
  }
  if (core.GetMisc() == nullptr) return;
  for (const auto& function : core.GetMisc()->ExternalFunctions()) {
    const QString name = ToScreen(function->publicName.Text()).toLower();
    texts.emplace(function->GetUid(), SearchedText(*function) + u'\n' + name);
  }
}

bool CTreeFilter::Fits(QTreeWidgetItem& item) const {
  const CItemData& node = CElementTree::DataOf(item);
  if (IsFolder(node)) return false;
  const auto text = texts.find(node.id);
  // A visibility group has its caption alone.
  return HasAll(text == texts.end() ? item.text(0).toLower() : text->second, words);
}

void CTreeFilter::Apply(std::vector<NodeName> former) {
  std::sort(former.begin(), former.end());
  matches.clear();
  QTreeWidgetItem* current = tree.currentItem();
  const bool wasHidden = current != nullptr && current->isHidden();
  tree.setUpdatesEnabled(false);
  ApplyTo(*tree.RootItem(), former);
  tree.setUpdatesEnabled(true);
  if (wasHidden) tree.scrollToItem(current);
  ShowCount();
}

CTreeFilter::Branch CTreeFilter::ApplyTo(QTreeWidgetItem& item, const std::vector<NodeName>& former) {
  const bool fits = Fits(item);
  if (fits) matches.push_back(NameOf(item));
  Branch below{false, false};
  for (int place = 0; place < item.childCount(); ++place) {
    const Branch child = ApplyTo(*item.child(place), former);
    below.isShown |= child.isShown;
    below.holdsNewMatch |= child.holdsNewMatch;
  }
  // The root stays, and so does what is being edited.
  const bool isShown = fits || below.isShown || &item == tree.currentItem() || item.parent() == nullptr;
  if (item.isHidden() == isShown) item.setHidden(!isShown);
  if (below.holdsNewMatch && !item.isExpanded()) item.setExpanded(true);
  const bool isNew = fits && !std::binary_search(former.begin(), former.end(), NameOf(item));
  return {isShown, isNew || below.holdsNewMatch};
}

CTreeFilter::NodeName CTreeFilter::NameOf(QTreeWidgetItem& item) {
  const CItemData& node = CElementTree::DataOf(item);
  return {node.id, node.groupIndex};
}

void CTreeFilter::ShowCount() {
  count->setVisible(IsOn());
  if (!IsOn()) return;
  QTreeWidgetItem* current = tree.currentItem();
  const auto place =
      current == nullptr ? matches.end() : std::find(matches.begin(), matches.end(), NameOf(*current));
  if (matches.empty()) {
    count->setText(strings::kNoMatch);
  } else if (place == matches.end()) {
    count->setText(strings::kMatchCount.arg(matches.size()));
  } else {
    count->setText(strings::kMatchOf.arg(place - matches.begin() + 1).arg(matches.size()));
  }
}

void CTreeFilter::GoToMatch(int step) {
  Refresh();
  if (matches.empty()) return;
  QTreeWidgetItem* item = tree.currentItem();
  if (item == nullptr) item = tree.RootItem();
  QTreeWidgetItemIterator place(item);
  // A match is there: the walk comes to it, around the end of the tree at most once.
  do {
    step > 0 ? ++place : --place;
    if (*place == nullptr) {
      QTreeWidgetItem* last = tree.RootItem();
      while (step < 0 && last->childCount() > 0) last = last->child(last->childCount() - 1);
      place = QTreeWidgetItemIterator(last);
    }
  } while (!Fits(**place));
  tree.setCurrentItem(*place);
  tree.scrollToItem(*place);
  ShowCount();
}

bool CTreeFilter::eventFilter(QObject* watched, QEvent* happened) {
  if (watched != line || happened->type() != QEvent::KeyPress) return QWidget::eventFilter(watched, happened);
  const auto* key = static_cast<QKeyEvent*>(happened);
  switch (key->key()) {
    case Qt::Key_Escape:
      line->clear();
      if (focusBefore != nullptr && focusBefore->isVisible()) {
        focusBefore->setFocus(Qt::OtherFocusReason);
      } else {
        tree.setFocus(Qt::OtherFocusReason);
      }
      return true;
    case Qt::Key_Return:
    case Qt::Key_Enter:
      GoToMatch((key->modifiers() & Qt::ShiftModifier) != 0 ? -1 : 1);
      return true;
    case Qt::Key_Down:
      tree.setFocus(Qt::OtherFocusReason);
      return true;
    default:
      return QWidget::eventFilter(watched, happened);
  }
}

}  // namespace tessal
