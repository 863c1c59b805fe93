#include "ui/element_tree.h"

#include <algorithm>
#include <memory>

#include "core/template_core.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kIndent = 14;

/// A node with what stands behind it.
class ElementItem final : public QTreeWidgetItem {
 public:
  CItemData data;
};

}  // namespace

std::string ElementCaption(const CEL_Element& element) {
  if (element.Kind() == ElementKind::DerivedOutput) return element.description.Text();
  if (element.Kind() == ElementKind::ExternalFunction) {
    return "User function '" + static_cast<const CEL_ExternalFunction&>(element).publicName.Text() + "'";
  }
  return element.symbol.Text();
}

std::string MarkedCaption(const CEL_Element& element) {
  const std::string caption = ElementCaption(element);
  return element.Loaded() ? caption : "*" + caption;
}

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

template <class Elements>
void CElementTree::InsertFolder(ElementKind kind, Uid id, const Elements& elements) {
  QTreeWidgetItem* folder =
      Insert(*RootItem(), RootItem()->childCount(), kind, id, std::string(KindText(kind)));
  for (const auto& element : elements) InsertElement(*folder, *element, folder->childCount());
}

void CElementTree::Build(TemplateCore& core) {
  clear();
  groupItems.clear();
  auto* root = MakeChild<ElementItem>();
  root->data.kind = node_kind::kRoot;
  root->data.id = folder_id::kRoot;
  root->setText(0, strings::kSetup);
  addTopLevelItem(root);
  InsertFolder(ElementKind::StateVariableList, folder_id::kStateVariables, core.StateVariables());
  InsertFolder(ElementKind::ConstantList, folder_id::kConstants, core.Constants());
  InsertFolder(ElementKind::ForcingList, folder_id::kForcings, core.Forcings());
  InsertFolder(ElementKind::AuxiliaryList, folder_id::kAuxiliaries, core.Auxiliaries());
  InsertFolder(ElementKind::ProcessList, folder_id::kProcesses, core.Processes());
  InsertFolder(ElementKind::DerivedOutputList, folder_id::kDerivedOutputs, core.DerivedOutputs());
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
  const auto addFolder = [this, branch, &specie](ElementKind listKind, const auto& members) {
    const CEL_Element& head = specie.Head(listKind);
    QTreeWidgetItem* list =
        Insert(*branch, branch->childCount(), listKind, head.GetUid(), head.symbol.Text());
    for (const auto& member : members) InsertElement(*list, *member, list->childCount());
  };
  // The forcings of a class are kept out on purpose.
  addFolder(ElementKind::SpecieStateVariableList, specie.stateVariables);
  addFolder(ElementKind::SpecieConstantList, specie.constants);
  addFolder(ElementKind::SpatialFunctionList, specie.spatialFunctions);
  addFolder(ElementKind::ArithmeticExpressionList, specie.arithmeticExpressions);
  addFolder(ElementKind::HorizontalVectorList, specie.horizontalVectors);
  addFolder(ElementKind::VerticalEquationList,
            std::vector<const CEL_Element*>{specie.verticalEquation.get()});
  return branch;
}

void CElementTree::ShowMisc(TemplateCore& core) {
  if (FindById(folder_id::kMiscellaneous) != nullptr || core.GetMisc() == nullptr) return;
  // Behind the collections and ahead of the particle classes.
  QTreeWidgetItem* particles = FindById(folder_id::kParticleClasses);
  const int place = particles == nullptr ? RootItem()->childCount() : RootItem()->indexOfChild(particles);
  QTreeWidgetItem* settings =
      Insert(*RootItem(), place, ElementKind::Miscellaneous, folder_id::kMiscellaneous, "Miscellaneous");
  const auto& functions = core.GetMisc()->ExternalFunctions();
  if (!functions.empty()) {
    QTreeWidgetItem* list =
        Insert(*settings, 0, node_kind::kPluginFunctions, folder_id::kPluginFunctions, "Plug-in Functions");
    for (const auto& function : functions) InsertElement(*list, *function, list->childCount());
  }
  Insert(*settings, settings->childCount(), ElementKind::VisibilityGroups, folder_id::kVisibilityGroups,
         "Visibility Groups");
  for (const VisibilityGroup& group : core.GetMisc()->Visibilities().groups) AddGroup(group.name);
}

void CElementTree::ShowParticles(TemplateCore& core) {
  if (FindById(folder_id::kParticleClasses) != nullptr) return;
  QTreeWidgetItem* folder = Insert(*RootItem(), RootItem()->childCount(), ElementKind::Specie,
                                   folder_id::kParticleClasses, "Particle Classes");
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
