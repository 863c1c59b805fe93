// What the main view does to the template, and how it shows what has become of it: creating, deleting and
// moving elements and groups, and acts that change several at once.
#include "ui/main_view.h"

#include <QApplication>
#include <QLineEdit>
#include <QMenu>
#include <algorithm>

#include "core/document.h"
#include "ui/control_ids.h"
#include "ui/dialogs.h"
#include "ui/element_tree.h"
#include "ui/error_list.h"
#include "ui/folder_elements.h"
#include "ui/node_kinds.h"
#include "ui/offered_creation.h"
#include "ui/right_pane.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

QTreeWidgetItem* CMainView::FolderFor(const CreateRequest& request) const {
  const Uid folder = NodeRowOfElements(request.kind).folder;
  return tree->FindById(folder != Uid::None ? folder : request.ownerId);
}

Uid CMainView::CreateElement(const CreateRequest& request) {
  const ElementKind elementKind = request.kind;
  if (elementKind == ElementKind::VisibilityGroup || elementKind == ElementKind::VisibilityGroups) {
    SetNotifyChanges(false);
    document.UpdateAllViews(nullptr, hint::kAddGroup);
    const NumberHint last(static_cast<std::int32_t>(tree->GroupItems().size()) - 1);
    document.UpdateAllViews(nullptr, hint::kSelectGroup, &last);
    return Uid::None;
  }
  const Uid created = Core().CreateElement(request).uid;
  if (created != Uid::None) InsertCreated(request, created);
  return created;
}

void CMainView::InsertCreated(const CreateRequest& request, Uid created) {
  const CEL_Element* element = Core().GetElement(created);
  if (request.kind == ElementKind::Specie) tree->ShowParticles(Core());
  QTreeWidgetItem* folder = FolderFor(request);
  if (element == nullptr || folder == nullptr) return;
  // A folder that was made only now holds the element already.
  QTreeWidgetItem* item = tree->FindById(element->GetUid());
  if (item == nullptr && element->Kind() == ElementKind::Specie) {
    item = tree->InsertSpecie(*folder, static_cast<const CEL_Lagrange_Specie&>(*element));
  } else if (item == nullptr) {
    item = tree->InsertElement(*folder, *element, PlaceOf(*element, *folder));
  }
  item->setText(0, ToScreen(MarkedCaption(*element)));
}

int CMainView::PlaceOf(const CEL_Element& element, QTreeWidgetItem& folder) const {
  // Where it is in the template, which may not be at the end: a new element is put before its users.
  const auto elements = ElementsOfFolder(Core(), CElementTree::DataOf(folder));
  return static_cast<int>(std::find(elements.begin(), elements.end(), &element) - elements.begin());
}

void CMainView::OpenContextMenu(const QPoint& point) {
  QTreeWidgetItem* item = tree->itemAt(point);
  if (item == nullptr) return;
  const CItemData node = CElementTree::DataOf(*item);
  const NodeCommands commands = CommandsOfNode(node, Core());
  if (commands.kindToCreate == ElementKind::None) return;
  QMenu menu(this);
  QAction* create = menu.addAction(strings::kCreateNew, this, [this, node] { CreateFromMenu(node); });
  create->setEnabled(commands.canCreate);
  if (commands.offersDelete) {
    QAction* remove =
        menu.addAction(strings::kDelete, this, [this, node] { DeleteFromMenu(node.id, node.groupIndex); });
    remove->setEnabled(commands.canDelete);
  }
  menu.exec(tree->viewport()->mapToGlobal(point));
}

void CMainView::CreateFromMenu(const CItemData& clicked) {
  const NodeCommands commands = CommandsOfNode(clicked, Core());
  CreateRequest request;
  request.kind = commands.kindToCreate;
  request.ownerId = commands.ownerId;
  const Uid uid = CreateElement(request);
  if (uid != Uid::None) {
    SelectById(uid);
    FocusSymbol();
  }
  errorList->RefreshErrorList(Core());
  MarkDocument();
}

void CMainView::CreateBeside() {
  QTreeWidgetItem* item = tree->currentItem();
  if (item == nullptr) return;
  CommitAll();
  const CItemData node = CElementTree::DataOf(*item);
  const NodeCommands commands = CommandsOfNode(node, Core());
  if (commands.kindToCreate != ElementKind::None && commands.canCreate) CreateFromMenu(node);
}

void CMainView::FocusSymbol() {
  auto* symbol = form ? form->findChild<QLineEdit*>(QString::number(control_id::kSymbol)) : nullptr;
  if (symbol == nullptr || !symbol->isEnabled()) return FocusForm();
  symbol->setFocus(Qt::ShortcutFocusReason);
  symbol->selectAll();
}

QString CMainView::FocusedControl() const {
  const QWidget* focus = QApplication::focusWidget();
  return form && focus != nullptr && form->isAncestorOf(focus) ? focus->objectName() : QString();
}

void CMainView::Act(const std::function<StepEffect()>& act) {
  CommitAll();
  const QString control = FocusedControl();
  // It shows what may go.
  CloseForm();
  Follow(act());
  QWidget* again = form && !control.isEmpty() ? form->findChild<QWidget*>(control) : nullptr;
  if (again != nullptr && again->isEnabled()) {
    again->setFocus(Qt::OtherFocusReason);
  } else {
    tree->setFocus(Qt::OtherFocusReason);
  }
}

QTreeWidgetItem* CMainView::NodeOfSubject(const StepEffect& effect) const {
  QTreeWidgetItem* node = IsElement(effect.subject) ? tree->FindById(effect.subject) : nullptr;
  const auto group = static_cast<std::size_t>(effect.group);
  if (node == nullptr && effect.group > 0) {
    node = group <= tree->GroupItems().size() ? tree->GroupItems()[group - 1]
                                              : tree->FindById(folder_id::kVisibilityGroups);
  }
  return node == nullptr ? tree->currentItem() : node;
}

void CMainView::Follow(const StepEffect& effect) {
  tree->Follow(Core());
  for (const Uid uid : effect.changed) {
    if (const CEL_Element* element = Core().GetElement(uid)) tree->FollowCaption(*element);
  }
  QTreeWidgetItem* node = NodeOfSubject(effect);
  if (node == tree->currentItem()) {
    OnSelectionChanged(node, nullptr);
  } else {
    tree->setCurrentItem(node);
  }
  if (node != nullptr) tree->scrollToItem(node);
  errorList->RefreshErrorList(Core());
  MarkDocument();
}

void CMainView::MoveSelected(int step) {
  QTreeWidgetItem* item = tree->currentItem();
  if (item == nullptr || item->parent() == nullptr) return;
  Commit();
  const QTreeWidgetItem* folder = item->parent();
  QTreeWidgetItem* neighbour = folder->child(folder->indexOfChild(item) + step);
  if (neighbour == nullptr) return;
  const CItemData& moved = CElementTree::DataOf(*item);
  const CItemData& target = CElementTree::DataOf(*neighbour);
  if (moved.kind != target.kind || !Core().MoveElement(moved.id, target.id, step < 0)) return;
  tree->MoveNode(*item, step);
  errorList->RefreshErrorList(Core());
  MarkDocument();
}

void CMainView::DeleteNode(QTreeWidgetItem& item) {
  if (tree->currentItem() == &item) {
    QTreeWidgetItem* parent = item.parent();
    QTreeWidgetItem* next = parent == nullptr ? nullptr : parent->child(parent->indexOfChild(&item) + 1);
    if (next == nullptr && parent != nullptr) next = parent->child(parent->indexOfChild(&item) - 1);
    if (next == nullptr) next = parent;
    if (next != nullptr) tree->setCurrentItem(next);
  }
  tree->RemoveNode(item);
}

void CMainView::DeleteFromMenu(Uid id, std::int32_t groupIndex) {
  if (groupIndex > 0) {
    DeleteGroup(groupIndex - 1);
  } else {
    // A form with something unwritten may use the element by now.
    CommitAll();
    QTreeWidgetItem* item = tree->FindById(id);
    if (item == nullptr || !Core().CanDelete(id)) return;
    DeleteNode(*item);
    Core().DeleteElement(id);
  }
  if (form) form->OnStructureChanged();
  errorList->RefreshErrorList(Core());
  MarkDocument();
}

void CMainView::DeleteGroup(std::int32_t position) {
  const auto& groups = tree->GroupItems();
  const auto place = static_cast<std::size_t>(position);
  if (position < 0 || place >= groups.size()) return;
  if (tree->currentItem() == groups[place]) tree->setCurrentItem(groups[place]->parent());
  Core().RemoveVisibilityGroup(position + 1);
  tree->RemoveGroup(place);
}

void CMainView::CreateSymbol(const std::string& symbol) {
  // What is being entered may define the symbol, or use it no more.
  Commit();
  const auto offer = Core().OfferOf(symbol);
  if (!offer || !CreateOfferedKind(*offer, document, dialogs, this)) return;
  if (form) form->Load();
  errorList->RefreshErrorList(Core());
  MarkDocument();
}

}  // namespace tessal
