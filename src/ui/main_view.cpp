#include "ui/main_view.h"

#include <QAction>
#include <QFontInfo>
#include <QKeyEvent>
#include <QMenu>
#include <QScreen>
#include <QScrollArea>
#include <QSplitter>
#include <QTimer>
#include <QToolBar>
#include <QToolButton>
#include <QVBoxLayout>
#include <algorithm>

#include "core/document.h"
#include "ui/account_strip.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/create_hint.h"
#include "ui/dialogs.h"
#include "ui/element_tree.h"
#include "ui/error_list.h"
#include "ui/export_commands.h"
#include "ui/expression_colours.h"
#include "ui/folder_elements.h"
#include "ui/formula_preview.h"
#include "ui/help_window.h"
#include "ui/icons.h"
#include "ui/kept_splitter.h"
#include "ui/label.h"
#include "ui/node_kinds.h"
#include "ui/offered_creation.h"
#include "ui/right_pane.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kSmallestTree = 100;
constexpr int kSmallestForm = 200;
constexpr int kSmallestUpper = 150;
constexpr int kSmallestErrors = 50;
constexpr QSize kSmallestView(500, 300);
constexpr int kTitleWeight = 700;
constexpr int kTitleHeight = 14;
constexpr int kUsualTree = 260;
constexpr int kUsualErrors = 140;
constexpr int kMargin = 4;
constexpr QSize kIcons(18, 18);

std::int32_t NumberOf(const UpdateHint* argument) {
  const auto* number = dynamic_cast<const NumberHint*>(argument);
  return number == nullptr ? 0 : number->number;
}

/// What is typed, in the model for its lifetime.
class TypedInModel final {
 public:
  TypedInModel(std::vector<TypedValue> typedValues, TemplateCore& template_)
      : core(template_), wasModified(template_.Modified()), values(std::move(typedValues)) {
    for (const TypedValue& value : values) value.store();
  }
  TypedInModel(const TypedInModel&) = delete;
  TypedInModel& operator=(const TypedInModel&) = delete;
  ~TypedInModel() {
    for (const TypedValue& value : values) value.takeBack();
    core.SetModified(wasModified);
  }

 private:
  NotificationsOff silent;
  TemplateCore& core;
  bool wasModified;
  std::vector<TypedValue> values;
};

}  // namespace

CMainView::CMainView(CTessalDoc& shownDocument, UserDialogs& userDialogs)
    : document(shownDocument), dialogs(userDialogs) {
  // On a small screen, or a large scale, no more than the window around it can have.
  constexpr double kPartOfScreen = 0.75;
  setMinimumSize(kSmallestView.boundedTo(screen()->availableGeometry().size() * kPartOfScreen));
}

CMainView::~CMainView() {
  // The form holds on to its node's data: it goes first.
  form.reset();
  document.RemoveView(*this);
}

TemplateCore& CMainView::Core() const {
  return document.Core();
}

void CMainView::OnInitialUpdate() {
  BuildToolBar();
  BuildLayout();
  connect(errorList, &CErrorList::Refreshed, this,
          [this] { tree->ShowMessages(errorList->MessagesOfElements()); });
  connect(errorList, &CErrorList::Refreshed, this, [this] { accountStrip->Show(Core().Account()); });
  connect(accountStrip, &CAccountStrip::ReadRequested, this, &CMainView::ReadPassedOver);
  connect(accountStrip, &CAccountStrip::DetailsRequested, this, &CMainView::ShowAccount);
  connect(errorList, &CErrorList::CreateSymbolRequested, this, &CMainView::CreateSymbol);
  tree->Build(Core());
  connect(tree, &QTreeWidget::currentItemChanged, this, &CMainView::OnSelectionChanged);
  connect(tree, &QTreeWidget::customContextMenuRequested, this, &CMainView::OpenContextMenu);
  connect(errorList, &CErrorList::ElementChosen, this, &CMainView::SelectById);
  auto* help = MakeChild<QAction>(strings::kHelp, this);
  help->setShortcut(QKeySequence::HelpContents);
  help->setShortcutContext(Qt::WidgetWithChildrenShortcut);
  connect(help, &QAction::triggered, this, &CMainView::ShowHelp);
  addAction(help);
  // The first selection fills the list of messages too.
  tree->setCurrentItem(tree->RootItem());
  // A host that gives the view the focus gives it to the tree.
  setFocusProxy(tree);
  UpdateNavigation();
}

void CMainView::BuildToolBar() {
  toolBar = MakeChild<QToolBar>(this);
  toolBar->setObjectName(QString::number(control_id::kNavigation));
  toolBar->setIconSize(kIcons);
  back = toolBar->addAction(IconOfCommand(IconCommand::Back), strings::kNavigateBack, this,
                            [this] { SelectById(history.Back()); });
  forward = toolBar->addAction(IconOfCommand(IconCommand::Forward), strings::kNavigateForward, this,
                               [this] { SelectById(history.Forward()); });
  back->setShortcut(QKeySequence::Back);
  forward->setShortcut(QKeySequence::Forward);
  historyMenu = MakeChild<QMenu>(this);
  connect(historyMenu, &QMenu::aboutToShow, this, &CMainView::FillHistoryMenu);
  auto* button = MakeChild<QToolButton>(toolBar);
  button->setText(strings::kNavigationHistory);
  button->setIcon(IconOfCommand(IconCommand::History));
  button->setToolTip(strings::kNavigationHistory);
  button->setMenu(historyMenu);
  button->setPopupMode(QToolButton::InstantPopup);
  historyAction = toolBar->addWidget(button);
}

void CMainView::BuildLayout() {
  tree = MakeChild<CElementTree>(this);
  tree->setMinimumWidth(kSmallestTree);
  tree->installEventFilter(this);

  auto* treeDetail = MakeChild<QSplitter>(Qt::Horizontal, this);
  treeDetail->setObjectName(QStringLiteral("TreeDetail"));
  treeDetail->addWidget(tree);
  treeDetail->addWidget(MakeTitleDetail());
  treeDetail->setStretchFactor(1, 1);
  treeDetail->setMinimumHeight(kSmallestUpper);
  treeDetail->setChildrenCollapsible(false);
  treeDetail->setSizes({kUsualTree, 3 * kUsualTree});
  KeepSplitter(*treeDetail);

  auto* topBottom = MakeChild<QSplitter>(Qt::Vertical, this);
  topBottom->setObjectName(QStringLiteral("TopBottom"));
  topBottom->addWidget(treeDetail);
  topBottom->addWidget(MakeMessages());
  topBottom->setStretchFactor(0, 1);
  topBottom->setChildrenCollapsible(false);
  topBottom->setSizes({4 * kUsualErrors, kUsualErrors});
  KeepSplitter(*topBottom);

  auto* layout = MakeChild<QVBoxLayout>(this);
  layout->setContentsMargins(kMargin, 0, kMargin, kMargin);
  layout->setSpacing(0);
  layout->addWidget(toolBar);
  layout->addWidget(topBottom, 1);
}

QWidget* CMainView::MakeMessages() {
  auto* messages = MakeChild<QWidget>(this);
  accountStrip = MakeChild<CAccountStrip>(messages);
  errorList = MakeChild<CErrorList>(messages);
  errorList->setMinimumHeight(kSmallestErrors);
  auto* layout = MakeChild<QVBoxLayout>(messages);
  layout->setContentsMargins(0, 0, 0, 0);
  layout->setSpacing(0);
  layout->addWidget(accountStrip);
  layout->addWidget(errorList, 1);
  return messages;
}

void CMainView::ReadPassedOver() {
  // What is being entered belongs to the values of before.
  CommitAll();
  Core().TakeOverPassedOver();
  const CEL_Miscanellous* settings = Core().GetMisc();
  if (settings != nullptr) {
    const auto& groups = settings->Visibilities().groups;
    for (std::size_t place = tree->GroupItems().size(); place < groups.size(); ++place) {
      tree->AddGroup(groups[place].name);
    }
  }
  ReplaceForm(tree->currentItem());
  RefreshCaption(shown);
  MarkDocument();
  errorList->RefreshErrorList(Core());
}

void CMainView::ShowAccount() {
  dialogs.ShowDetails(this, strings::kAccountTitle, AccountDetails(Core().Account()));
}

QWidget* CMainView::MakeTitleDetail() {
  title = MakeChild<CLabel>(this);
  title->setObjectName(QString::number(control_id::kTitle));
  title->SetFontWeight(kTitleWeight);
  // As wide as the form under it, however long the name.
  title->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
  // Where the user's font is larger than usual, the title is no smaller than the text under it.
  title->SetFontHeight(std::max(kTitleHeight, QFontInfo(font()).pixelSize() + 2));

  auto* area = MakeChild<QScrollArea>(this);
  area->setWidgetResizable(true);
  area->setFrameShape(QFrame::NoFrame);
  // Nobody would see that it has the focus.
  area->setFocusPolicy(Qt::NoFocus);
  holder = MakeChild<QWidget>(area);
  holder->setObjectName(QString::number(control_id::kRightPane));
  holderLayout = MakeChild<QVBoxLayout>(holder);
  holderLayout->setContentsMargins(0, 0, 0, 0);
  area->setWidget(holder);

  auto* titleDetail = MakeChild<QWidget>(this);
  titleDetail->setObjectName(QStringLiteral("TitleDetail"));
  titleDetail->setMinimumWidth(kSmallestForm);
  auto* rows = MakeChild<QVBoxLayout>(titleDetail);
  rows->setContentsMargins(0, 0, 0, 0);
  rows->addWidget(title);
  rows->addWidget(area, 1);
  return titleDetail;
}

void CMainView::MarkDocument() {
  if (Core().Modified()) document.SetModifiedFlag(true);
}

void CMainView::OnUpdate(const CView* /*sender*/, int hintNumber, const UpdateHint* argument) {
  const std::int32_t number = NumberOf(argument);
  switch (hintNumber) {
    case hint::kShowMisc:
      number != 0 ? tree->ShowMisc(Core()) : tree->RemoveBranch(folder_id::kMiscellaneous);
      break;
    case hint::kShowParticles:
      number != 0 ? tree->ShowParticles(Core()) : tree->RemoveBranch(folder_id::kParticleClasses);
      break;
    case hint::kSelectElement:
      SelectById(Uid{number});
      break;
    case hint::kCommit:
      Commit();
      break;
    case hint::kCreateElement:
      if (const auto* request = dynamic_cast<const CreateHint*>(argument)) CreateElement(request->request);
      break;
    case hint::kDeleteItem:
      if (QTreeWidgetItem* item = tree->FindById(Uid{number})) DeleteNode(*item);
      break;
    case hint::kMoveUp:
    case hint::kMoveDown:
      if (QTreeWidgetItem* item = tree->FindById(Uid{number}))
        tree->MoveNode(*item, hintNumber == hint::kMoveUp ? -1 : 1);
      break;
    case hint::kAddGroup: {
      const std::int32_t group = Core().AddVisibilityGroup();
      if (group > 0) tree->AddGroup(Core().GroupText(group));
      break;
    }
    case hint::kDeleteGroup:
      DeleteGroup(number);
      break;
    case hint::kSelectGroup:
      SelectGroup(number);
      break;
    case hint::kRenameGroup:
      if (const auto* rename = dynamic_cast<const RenameGroupHint*>(argument)) {
        const auto position = static_cast<std::size_t>(rename->position);
        const auto& groups = tree->GroupItems();
        if (position < groups.size()) groups[position]->setText(0, ToScreen(rename->name));
      }
      break;
    default:
      break;
  }
  MarkDocument();
}

void CMainView::OnActivate() {
  errorList->RefreshErrorList(Core());
}

void CMainView::OnSelectionChanged(QTreeWidgetItem* current, QTreeWidgetItem* /*previous*/) {
  // The form still shows the node that is being left: its entries are written before it goes.
  CommitAll();
  RefreshCaption(current);
  ReplaceForm(current);
  if (current != nullptr) {
    const CItemData& node = CElementTree::DataOf(*current);
    history.Add(node.id, CElementTree::ShownText(*current).toStdString());
    helpNumber = NodeRowOf(node).help;
  }
  UpdateNavigation();
  // A click selects the row under the pointer, where a node that the commit has made may lie by then.
  QTimer::singleShot(0, this, [this] {
    QTreeWidgetItem* item = tree->currentItem();
    if (item != nullptr && !item->isSelected())
      tree->setCurrentItem(item, 0, QItemSelectionModel::ClearAndSelect);
  });
}

void CMainView::CloseForm() {
  shown = nullptr;
  if (!form) return;
  // What led here may be a signal of one of the form's own controls.
  form->Close();
  form->hide();
  holderLayout->removeWidget(form.get());
  form.release()->deleteLater();
}

void CMainView::ReplaceForm(QTreeWidgetItem* item) {
  CloseForm();
  if (item == nullptr) return;
  shown = item;
  form = MakeForm({document, dialogs, CElementTree::DataOf(*item)}, holder);
  holderLayout->addWidget(form.get());
  form->Load();
  // From the last field on to the messages.
  const QList<QWidget*> stops = StopsOfForm();
  if (!stops.isEmpty()) QWidget::setTabOrder(stops.last(), errorList);
}

void CMainView::Commit() {
  if (form) {
    form->Commit();
    MarkDocument();
  }
  RefreshCaption(shown);
  errorList->RefreshErrorList(Core());
}

void CMainView::CommitAll() {
  Commit();
  if (form && form->HasUnwritten()) Commit();
}

bool CMainView::HasUncommitted() const {
  return form && !form->TypedValues().empty();
}

void CMainView::WithUncommitted(const std::function<void()>& run) {
  const TypedInModel typed(form ? form->TypedValues() : std::vector<TypedValue>(), Core());
  run();
}

void CMainView::RefreshCaption(QTreeWidgetItem* item) {
  if (item == nullptr) return;
  const CItemData& node = CElementTree::DataOf(*item);
  const CEL_Element* element = IsElement(node.id) ? Core().GetElement(node.id) : nullptr;
  const bool isFolder = node.kind >= ElementKind::Root;
  if (element != nullptr && !isFolder) {
    const QString caption = ToScreen(MarkedCaption(*element));
    item->setText(0, caption);
  }
  title->setText(CElementTree::ShownText(*item));
}

void CMainView::ShowHelp() {
  dialogs.ShowHelp(this, kFirstHelpTopic + helpNumber);
}

void CMainView::SelectById(Uid id) {
  QTreeWidgetItem* item = tree->FindById(id);
  if (item == nullptr) return;
  tree->setCurrentItem(item);
  tree->scrollToItem(item);
}

void CMainView::SelectGroup(std::int32_t position) {
  const auto& groups = tree->GroupItems();
  const auto place = static_cast<std::size_t>(position);
  if (position < 0 || place >= groups.size()) return;
  tree->setCurrentItem(groups[place]);
  tree->scrollToItem(groups[place]);
}

void CMainView::UpdateNavigation() {
  back->setEnabled(history.CanGoBack());
  forward->setEnabled(history.CanGoForward());
  historyAction->setEnabled(history.CanGoBack() || history.CanGoForward());
}

void CMainView::FillHistoryMenu() {
  historyMenu->clear();
  std::ptrdiff_t place = 0;
  for (const CHistoryData& entry : history.Entries()) {
    QAction* action =
        historyMenu->addAction(ToScreen(entry.caption), this, [this, id = entry.id] { SelectById(id); });
    action->setCheckable(true);
    action->setChecked(place++ == history.Position());
  }
}

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
  if (uid != Uid::None) SelectById(uid);
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

bool CMainView::eventFilter(QObject* watched, QEvent* happened) {
  if (watched == tree && happened->type() == QEvent::KeyPress && form) {
    const auto* key = static_cast<QKeyEvent*>(happened);
    if (key->key() == Qt::Key_Tab && key->modifiers() == Qt::NoModifier) {
      FocusForm();
      return true;
    }
    if (key->modifiers() == Qt::AltModifier && (key->key() == Qt::Key_Up || key->key() == Qt::Key_Down)) {
      MoveSelected(key->key() == Qt::Key_Up ? -1 : 1);
      return true;
    }
  }
  return QWidget::eventFilter(watched, happened);
}

QList<QWidget*> CMainView::StopsOfForm() const {
  QList<QWidget*> stops;
  for (QWidget* next = tree->nextInFocusChain(); next != tree; next = next->nextInFocusChain()) {
    if (form->isAncestorOf(next) && (next->focusPolicy() & Qt::TabFocus) != 0) stops.append(next);
  }
  return stops;
}

std::vector<ViewCommand> CMainView::Commands() {
  std::vector<ViewCommand> commands = ExportCommands(document, dialogs, *this);
  commands.push_back(StrongColoursCommand());
  commands.push_back(FormulasCommand());
  return commands;
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

void CMainView::FocusForm() {
  const QList<QWidget*> stops = StopsOfForm();
  const auto first = std::find_if(stops.begin(), stops.end(),
                                  [](const QWidget* stop) { return stop->isEnabled() && stop->isVisible(); });
  QWidget* target = first == stops.end() ? static_cast<QWidget*>(errorList) : *first;
  target->setFocus(Qt::TabFocusReason);
}

}  // namespace tessal
