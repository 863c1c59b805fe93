#include "ui/element_tree.h"

#include <algorithm>
#include <memory>

#include "core/template_core.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/node_kinds.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kIndent = 14;

/// A node with its data.
class ElementItem final : public QTreeWidgetItem {
 public:
  CItemData data;
};

}  // namespace

CElementTree::CElementTree(QWidget* parent) : QTreeWidget(parent) {
  setObjectName(QString::number(control_id::kTree));
  setHeaderHidden(true);
  setIndentation(kIndent);
  setUniformRowHeights(true);
  setContextMenuPolicy(Qt::CustomContextMenu);
  setAccessibleName(strings::kElements);
}

CItemData& CElementTree::DataOf(QTreeWidgetItem& item) {
  return static_cast<ElementItem&>(item).data;
}

QTreeWidgetItem* CElementTree::Insert(QTreeWidgetItem& parent, int place, ElementKind kind, Uid id,
                                      const std::string& caption) {
  auto* item = MakeChild<ElementItem>();
  item->data.kind = kind;
  item->data.id = id;
  item->setText(0, ToScreen(caption));
  parent.insertChild(std::min(place, parent.childCount()), item);
  return item;
}

QTreeWidgetItem* CElementTree::InsertFixed(QTreeWidgetItem& parent, int place, Uid id) {
  const NodeRow& row = NodeRowWithId(id);
  return Insert(parent, place, row.kind, id, CaptionOfFixedNode(row));
}

template <class Elements>
void CElementTree::InsertAll(QTreeWidgetItem& folder, const Elements& elements) {
  for (const auto& element : elements) InsertElement(folder, *element, folder.childCount());
}

void CElementTree::Build(TemplateCore& core) {
  clear();
  groupItems.clear();
  QTreeWidgetItem* root = InsertFixed(*invisibleRootItem(), 0, folder_id::kRoot);
  ForEachHeadedCollection([this, root, &core](const auto& collection) {
    const Uid id = NodeRowOfElements(collection.kind).folder;
    InsertAll(*InsertFixed(*root, root->childCount(), id), core.Elements().*collection.elements);
  });
  if (core.GetMisc() != nullptr) ShowMisc(core);
  if (core.GetSpecieCount() > 0) ShowParticles(core);
  root->setExpanded(true);
}

QTreeWidgetItem* CElementTree::FindById(Uid id) const {
  if (RootItem() == nullptr) return nullptr;
  for (QTreeWidgetItemIterator item(RootItem()); *item != nullptr; ++item) {
    if (DataOf(**item).id == id) return *item;
  }
  return nullptr;
}

QTreeWidgetItem* CElementTree::InsertElement(QTreeWidgetItem& folder, const CEL_Element& element, int place) {
  return Insert(folder, place, element.Kind(), element.GetUid(), ElementCaption(element));
}

QTreeWidgetItem* CElementTree::InsertSpecie(QTreeWidgetItem& folder, const CEL_Lagrange_Specie& specie) {
  QTreeWidgetItem* branch = InsertElement(folder, specie, folder.childCount());
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
  const int place = particles == nullptr ? RootItem()->childCount() : RootItem()->indexOfChild(particles);
  QTreeWidgetItem* settings = InsertFixed(*RootItem(), place, folder_id::kMiscellaneous);
  const auto& functions = core.GetMisc()->ExternalFunctions();
  if (!functions.empty()) InsertAll(*InsertFixed(*settings, 0, folder_id::kPluginFunctions), functions);
  InsertFixed(*settings, settings->childCount(), folder_id::kVisibilityGroups);
  for (const VisibilityGroup& group : core.GetMisc()->Visibilities().groups) AddGroup(group.name);
}

void CElementTree::ShowParticles(TemplateCore& core) {
  if (FindById(folder_id::kParticleClasses) != nullptr) return;
  QTreeWidgetItem* folder = InsertFixed(*RootItem(), RootItem()->childCount(), folder_id::kParticleClasses);
  for (const auto& specie : core.Species()) InsertSpecie(*folder, *specie);
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

void CElementTree::RemoveNode(QTreeWidgetItem& item) {
  if (item.parent() == nullptr) return;
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

}  // namespace tessal
