#include "ui/element_tree.h"

#include <QApplication>
#include <QPainter>
#include <QStyledItemDelegate>
#include <algorithm>
#include <memory>
#include <unordered_set>
#include <utility>

#include "core/template_core.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/error_list.h"
#include "ui/icons.h"
#include "ui/node_kinds.h"
#include "ui/plain_tip.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kIndent = 14;

constexpr int kCountRole = Qt::UserRole;
constexpr int kLevelRole = Qt::UserRole + 1;

/// Between the text and its ground, and nearer to the text.
QColor Greyed(const QPalette& palette) {
  const QColor text = palette.color(QPalette::Text);
  const QColor ground = palette.color(QPalette::Base);
  const auto mixed = [](int near, int far) { return (3 * near + 2 * far) / 5; };
  return {mixed(text.red(), ground.red()), mixed(text.green(), ground.green()),
          mixed(text.blue(), ground.blue())};
}

/// A node with its data. What is drawn beside the caption is computed when it is asked for.
class ElementItem final : public QTreeWidgetItem {
 public:
  QVariant data(int column, int role) const override {
    switch (role) {
      case Qt::DecorationRole:
        return IconOfKind(node.kind);
      case Qt::ToolTipRole:
        return messages.count == 0 ? QVariant() : PlainTip(MessageText());
      case Qt::AccessibleTextRole:
        return ShownText();
      case Qt::AccessibleDescriptionRole:
        return messages.count == 0 ? QVariant() : MessageText();
      case kCountRole:
        return IsFolder() ? QVariant(childCount()) : QVariant();
      case kLevelRole:
        return messages.level;
      default:
        return QTreeWidgetItem::data(column, role);
    }
  }

  QString ShownText() const { return text(0).isEmpty() ? standIn : text(0); }

  CItemData node;
  ElementMessages messages;
  QString standIn;  ///< shown greyed while the caption is empty

 private:
  /// A collection. The folder of the particle classes has the kind of its elements.
  bool IsFolder() const {
    const bool isList =
        node.kind >= ElementKind::StateVariableList && node.kind <= ElementKind::VerticalEquationList;
    return isList || node.id == folder_id::kParticleClasses || node.id == folder_id::kPluginFunctions ||
           node.id == folder_id::kVisibilityGroups;
  }

  QString MessageText() const { return strings::kHasMessages.arg(ShownText()).arg(messages.count); }
};

/// Draws the number of its elements after the caption of a folder, and a dot at an element with messages.
class NodeDelegate final : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;

  void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override {
    QStyledItemDelegate::paint(painter, option, index);
    QStyleOptionViewItem shown = option;
    initStyleOption(&shown, index);
    const QStyle& style = shown.widget == nullptr ? *QApplication::style() : *shown.widget->style();
    const QRect icon = style.subElementRect(QStyle::SE_ItemViewItemDecoration, &shown, shown.widget);
    const QRect caption = style.subElementRect(QStyle::SE_ItemViewItemText, &shown, shown.widget);
    const std::uint32_t level = index.data(kLevelRole).toUInt();
    const QVariant count = index.data(kCountRole);
    if (level != 0) DrawDot(*painter, icon, level);
    if (count.isValid()) DrawCount(*painter, shown, caption, count.toInt());
  }

 protected:
  void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
    QStyledItemDelegate::initStyleOption(option, index);
    if (!option->text.isEmpty()) return;
    option->text = index.data(Qt::AccessibleTextRole).toString();
    option->palette.setColor(QPalette::Text, Greyed(option->palette));
  }

 private:
  static void DrawDot(QPainter& painter, const QRect& icon, std::uint32_t level) {
    const int size = icon.height() / 2;
    const QRect dot(icon.right() - size + 2, icon.bottom() - size + 2, size, size);
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(Qt::white, 1));
    painter.setBrush(ColourOfLevel(level));
    painter.drawEllipse(dot);
    painter.restore();
  }

  static void DrawCount(QPainter& painter, const QStyleOptionViewItem& shown, const QRect& caption,
                        int count) {
    constexpr int kGap = 10;
    const bool isSelected = shown.state.testFlag(QStyle::State_Selected);
    const QRect rest = caption.adjusted(shown.fontMetrics.horizontalAdvance(shown.text) + kGap, 0, 0, 0);
    painter.save();
    painter.setFont(shown.font);
    painter.setPen(isSelected ? shown.palette.color(QPalette::HighlightedText) : Greyed(shown.palette));
    painter.drawText(rest, Qt::AlignVCenter, QString::number(count));
    painter.restore();
  }
};

}  // namespace

CElementTree::CElementTree(QWidget* parent) : QTreeWidget(parent) {
  setObjectName(QString::number(control_id::kTree));
  setHeaderHidden(true);
  setIndentation(kIndent);
  setUniformRowHeights(true);
  setItemDelegate(MakeChild<NodeDelegate>(this));
  setContextMenuPolicy(Qt::CustomContextMenu);
  setAccessibleName(strings::kElements);
}

CItemData& CElementTree::DataOf(QTreeWidgetItem& item) {
  return static_cast<ElementItem&>(item).node;
}

QString CElementTree::ShownText(const QTreeWidgetItem& item) {
  return static_cast<const ElementItem&>(item).ShownText();
}

QTreeWidgetItem* CElementTree::MakeElement(const CEL_Element& element) {
  QTreeWidgetItem* item = Make(element.Kind(), element.GetUid(), ElementCaption(element));
  static_cast<ElementItem*>(item)->standIn = ToScreen(element.symbol.Text());
  return item;
}

QTreeWidgetItem* CElementTree::Make(ElementKind kind, Uid id, const std::string& caption) {
  auto* item = MakeChild<ElementItem>();
  item->node.kind = kind;
  item->node.id = id;
  item->setText(0, ToScreen(caption));
  if (id != folder_id::kVisibilityGroup) nodes.emplace(id, item);
  return item;
}

QTreeWidgetItem* CElementTree::Insert(QTreeWidgetItem& parent, int place, ElementKind kind, Uid id,
                                      const std::string& caption) {
  QTreeWidgetItem* item = Make(kind, id, caption);
  parent.insertChild(std::min(place, parent.childCount()), item);
  return item;
}

QTreeWidgetItem* CElementTree::InsertFixed(QTreeWidgetItem& parent, int place, Uid id) {
  const NodeRow& row = NodeRowWithId(id);
  return Insert(parent, place, row.kind, id, CaptionOfFixedNode(row));
}

template <class Elements>
void CElementTree::InsertAll(QTreeWidgetItem& folder, const Elements& elements) {
  // All at once: a tree that is shown does some work for each insertion.
  QList<QTreeWidgetItem*> made;
  made.reserve(static_cast<qsizetype>(elements.size()));
  for (const auto& element : elements) made.append(MakeElement(*element));
  folder.addChildren(made);
}

void CElementTree::Build(TemplateCore& core) {
  clear();
  nodes.clear();
  groupItems.clear();
  marked.clear();
  const NodeRow& row = NodeRowWithId(folder_id::kRoot);
  root = Make(row.kind, row.id, CaptionOfFixedNode(row));
  ForEachHeadedCollection([this, &core](const auto& collection) {
    const Uid id = NodeRowOfElements(collection.kind).folder;
    InsertAll(*InsertFixed(*root, root->childCount(), id), core.Elements().*collection.elements);
  });
  if (core.GetMisc() != nullptr) ShowMisc(core);
  if (core.GetSpecieCount() > 0) ShowParticles(core);
  // The whole tree comes into the view in one step; only then can its nodes be opened.
  addTopLevelItem(root);
  root->setExpanded(true);
  if (QTreeWidgetItem* particles = FindById(folder_id::kParticleClasses)) particles->setExpanded(true);
}

QTreeWidgetItem* CElementTree::FindById(Uid id) const {
  if (id == folder_id::kVisibilityGroup) return groupItems.empty() ? nullptr : groupItems.front();
  const auto node = nodes.find(id);
  return node == nodes.end() ? nullptr : node->second;
}

QTreeWidgetItem* CElementTree::InsertElement(QTreeWidgetItem& folder, const CEL_Element& element, int place) {
  QTreeWidgetItem* item = MakeElement(element);
  folder.insertChild(std::min(place, folder.childCount()), item);
  return item;
}

QTreeWidgetItem* CElementTree::InsertSpecie(QTreeWidgetItem& folder, const CEL_Lagrange_Specie& specie) {
  QTreeWidgetItem* branch = MakeSpecie(specie);
  folder.addChild(branch);
  return branch;
}

QTreeWidgetItem* CElementTree::MakeSpecie(const CEL_Lagrange_Specie& specie) {
  QTreeWidgetItem* branch = MakeElement(specie);
  const auto addList = [this, branch, &specie](ElementKind listKind) {
    return InsertElement(*branch, specie.Head(listKind), branch->childCount());
  };
  ForEachMemberList([this, &specie, &addList](const auto& list) {
    // The forcings of a class are kept out on purpose.
    if (list.kind == ElementKind::SpecieForcing) return;
    InsertAll(*addList(list.listKind), specie.*list.members);
  });
  InsertElement(*addList(ElementKind::VerticalEquationList), *specie.verticalEquation, 0);
  return branch;
}

void CElementTree::ShowMisc(TemplateCore& core) {
  if (FindById(folder_id::kMiscellaneous) != nullptr || core.GetMisc() == nullptr) return;
  // After the collections and before the particle classes.
  QTreeWidgetItem* particles = FindById(folder_id::kParticleClasses);
  const int place = particles == nullptr ? root->childCount() : root->indexOfChild(particles);
  QTreeWidgetItem* settings = InsertFixed(*root, place, folder_id::kMiscellaneous);
  const auto& functions = core.GetMisc()->ExternalFunctions();
  if (!functions.empty()) InsertAll(*InsertFixed(*settings, 0, folder_id::kPluginFunctions), functions);
  InsertFixed(*settings, settings->childCount(), folder_id::kVisibilityGroups);
  for (const VisibilityGroup& group : core.GetMisc()->Visibilities().groups) AddGroup(group.name);
}

void CElementTree::ShowParticles(TemplateCore& core) {
  if (FindById(folder_id::kParticleClasses) != nullptr) return;
  QTreeWidgetItem* folder = InsertFixed(*root, root->childCount(), folder_id::kParticleClasses);
  QList<QTreeWidgetItem*> branches;
  for (const auto& specie : core.Species()) branches.append(MakeSpecie(*specie));
  folder->addChildren(branches);
  folder->setExpanded(true);
}

void CElementTree::RemoveBranch(Uid folderId) {
  QTreeWidgetItem* branch = FindById(folderId);
  if (branch == nullptr) return;
  for (const QTreeWidgetItem* item = currentItem(); item != nullptr; item = item->parent()) {
    if (item == branch) setCurrentItem(RootItem());
  }
  if (folderId == folder_id::kMiscellaneous) groupItems.clear();
  RemoveNode(*branch);
}

void CElementTree::ForgetBranch(QTreeWidgetItem& item) {
  // A visibility group has no entry of its own.
  if (const auto node = nodes.find(DataOf(item).id); node != nodes.end() && node->second == &item)
    nodes.erase(node);
  for (int place = 0; place < item.childCount(); ++place) ForgetBranch(*item.child(place));
}

void CElementTree::RemoveNode(QTreeWidgetItem& item) {
  if (item.parent() == nullptr) return;
  ForgetBranch(item);
  const std::unique_ptr<QTreeWidgetItem> gone(item.parent()->takeChild(item.parent()->indexOfChild(&item)));
}

void CElementTree::AddGroup(const std::string& name) {
  QTreeWidgetItem* folder = FindById(folder_id::kVisibilityGroups);
  if (folder == nullptr) return;
  QTreeWidgetItem* item =
      Insert(*folder, folder->childCount(), ElementKind::VisibilityGroup, folder_id::kVisibilityGroup, name);
  groupItems.push_back(item);
  DataOf(*item).groupIndex = static_cast<std::int32_t>(groupItems.size());
}

void CElementTree::RemoveGroup(std::size_t position) {
  if (position >= groupItems.size()) return;
  RemoveNode(*groupItems[position]);
  groupItems.erase(groupItems.begin() + static_cast<std::ptrdiff_t>(position));
  for (std::size_t place = position; place < groupItems.size(); ++place)
    --DataOf(*groupItems[place]).groupIndex;
}

void CElementTree::MoveNode(QTreeWidgetItem& item, int step) {
  QTreeWidgetItem* parent = item.parent();
  if (parent == nullptr) return;
  const int place = parent->indexOfChild(&item);
  const int target = place + step;
  if (target < 0 || target >= parent->childCount()) return;
  setUpdatesEnabled(false);
  const bool wasCurrent = currentItem() == &item;
  const bool wasExpanded = item.isExpanded();
  const QSignalBlocker quiet(this);
  // The neighbour moves past the node, so that the node itself stays where it is.
  QTreeWidgetItem* neighbour = parent->takeChild(target);
  parent->insertChild(place, neighbour);
  item.setExpanded(wasExpanded);
  if (wasCurrent) setCurrentItem(&item);
  setUpdatesEnabled(true);
}

QTreeWidgetItem* CElementTree::MakeBranch(const CEL_Element& element) {
  if (element.Kind() != ElementKind::Specie) return MakeElement(element);
  return MakeSpecie(static_cast<const CEL_Lagrange_Specie&>(element));
}

template <class Elements>
void CElementTree::FollowFolder(Uid folderId, const Elements& elements) {
  QTreeWidgetItem* folder = FindById(folderId);
  if (folder == nullptr) return;
  std::unordered_set<Uid> present;
  for (const auto& element : elements) present.insert(element->GetUid());
  for (int place = folder->childCount() - 1; place >= 0; --place) {
    QTreeWidgetItem* child = folder->child(place);
    if (!present.contains(DataOf(*child).id)) RemoveNode(*child);
  }
  int place = 0;
  for (const auto& element : elements) {
    const Uid wanted = element->GetUid();
    const auto isAt = [folder, wanted](int at) {
      QTreeWidgetItem* child = folder->child(at);
      return child != nullptr && DataOf(*child).id == wanted;
    };
    // One that has moved away comes in again at its new place.
    if (!isAt(place) && isAt(place + 1)) folder->takeChild(place);
    if (!isAt(place)) {
      QTreeWidgetItem* node = FindById(wanted);
      if (node == nullptr) node = MakeBranch(*element);
      const bool wasExpanded = node->isExpanded();
      if (node->parent() != nullptr) folder->takeChild(folder->indexOfChild(node));
      folder->insertChild(place, node);
      node->setExpanded(wasExpanded);
    }
    ++place;
  }
}

void CElementTree::FollowGroups(TemplateCore& core) {
  if (core.GetMisc() == nullptr) return;
  const auto& groups = core.GetMisc()->Visibilities().groups;
  while (groupItems.size() > groups.size()) RemoveGroup(groupItems.size() - 1);
  while (groupItems.size() < groups.size() && FindById(folder_id::kVisibilityGroups) != nullptr) {
    AddGroup(groups[groupItems.size()].name);
  }
  for (std::size_t place = 0; place < groupItems.size(); ++place) {
    groupItems[place]->setText(0, ToScreen(groups[place].name));
  }
}

void CElementTree::Follow(TemplateCore& core) {
  const QSignalBlocker quiet(this);
  setUpdatesEnabled(false);
  if (core.GetSpecieCount() > 0) ShowParticles(core);
  ForEachHeadedCollection([this, &core](const auto& collection) {
    FollowFolder(NodeRowOfElements(collection.kind).folder, core.Elements().*collection.elements);
  });
  FollowFolder(folder_id::kParticleClasses, core.Species());
  for (const auto& specie : core.Species()) {
    ForEachMemberList([this, &specie](const auto& list) {
      FollowFolder(specie->Head(list.listKind).GetUid(), (*specie).*list.members);
    });
  }
  if (core.GetMisc() != nullptr)
    FollowFolder(folder_id::kPluginFunctions, core.GetMisc()->ExternalFunctions());
  FollowGroups(core);
  setUpdatesEnabled(true);
}

void CElementTree::FollowCaption(const CEL_Element& element) {
  auto* item = static_cast<ElementItem*>(FindById(element.GetUid()));
  const bool isNamed = item != nullptr && element.Kind() < ElementKind::Root;
  if (!isNamed) return;
  item->standIn = ToScreen(element.symbol.Text());
  item->setText(0, ToScreen(MarkedCaption(element)));
}

void CElementTree::ShowMessages(const std::unordered_map<Uid, ElementMessages>& messages) {
  const auto mark = [this](Uid id, const ElementMessages& shown) {
    auto* item = static_cast<ElementItem*>(FindById(id));
    if (item != nullptr) item->messages = shown;
    return item != nullptr;
  };
  for (const Uid id : std::exchange(marked, {})) mark(id, {});
  for (const auto& [id, shown] : messages) {
    if (mark(id, shown)) marked.push_back(id);
  }
  viewport()->update();
}

}  // namespace tessal
