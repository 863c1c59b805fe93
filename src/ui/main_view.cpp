#include "ui/main_view.h"

#include <QAction>
#include <QApplication>
#include <QFontInfo>
#include <QKeyEvent>
#include <QLineEdit>
#include <QMenu>
#include <QScreen>
#include <QScrollArea>
#include <QSplitter>
#include <QTimer>
#include <QToolBar>
#include <QToolButton>
#include <QVBoxLayout>
#include <algorithm>
#include <iterator>
#include <string_view>
#include <utility>

#include "core/document.h"
#include "ui/account_strip.h"
#include "ui/child.h"
#include "ui/control_ids.h"
#include "ui/create_hint.h"
#include "ui/dialogs.h"
#include "ui/edit_commands.h"
#include "ui/element_tree.h"
#include "ui/error_list.h"
#include "ui/export_commands.h"
#include "ui/expression_colours.h"
#include "ui/expression_panel.h"
#include "ui/find_pane.h"
#include "ui/find_tools.h"
#include "ui/folder_elements.h"
#include "ui/formula_preview.h"
#include "ui/help_window.h"
#include "ui/icons.h"
#include "ui/kept_splitter.h"
#include "ui/label.h"
#include "ui/message_bar.h"
#include "ui/node_kinds.h"
#include "ui/offered_creation.h"
#include "ui/right_pane.h"
#include "ui/strings.h"
#include "ui/tab_order.h"
#include "ui/text_bytes.h"
#include "ui/text_zoom.h"
#include "ui/tree_filter.h"

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
      : unrecorded(template_.History()),
        core(template_),
        wasModified(template_.Modified()),
        values(std::move(typedValues)) {
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
  RecordingOff unrecorded;
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
  zoom = MakeChild<CTextZoom>(*this);
  edits = MakeChild<CEditCommands>(*this, dialogs);
  edits->AddTo(*editBar);
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
  helpContents = MakeChild<QAction>(strings::kContents, this);
  helpContents->setShortcut(QKeySequence::HelpContents);
  helpContents->setShortcutContext(Qt::WidgetWithChildrenShortcut);
  connect(helpContents, &QAction::triggered, this, &CMainView::ShowHelp);
  addAction(helpContents);
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
  editBar = MakeChild<QToolBar>(this);
  editBar->setIconSize(kIcons);
  editBar->setAccessibleName(strings::kEditing);
}

void CMainView::BuildLayout() {
  tree = MakeChild<CElementTree>(this);
  tree->setMinimumWidth(kSmallestTree);
  tree->installEventFilter(this);
  QWidget* messages = MakeMessages();
  findTools = MakeChild<CFindTools>(FindSurroundings{*this, document, dialogs, *tree, *errorList,
                                                     [this] { CommitAll(); }, [this] { return form.get(); }});

  auto* treeDetail = MakeChild<QSplitter>(Qt::Horizontal, this);
  treeDetail->setObjectName(QStringLiteral("TreeDetail"));
  treeDetail->addWidget(MakeTree());
  treeDetail->addWidget(MakeTitleDetail());
  treeDetail->setStretchFactor(1, 1);
  treeDetail->setMinimumHeight(kSmallestUpper);
  treeDetail->setChildrenCollapsible(false);
  treeDetail->setSizes({kUsualTree, 3 * kUsualTree});
  KeepSplitter(*treeDetail);

  auto* topBottom = MakeChild<QSplitter>(Qt::Vertical, this);
  topBottom->setObjectName(QStringLiteral("TopBottom"));
  topBottom->addWidget(treeDetail);
  topBottom->addWidget(messages);
  topBottom->addWidget(&findTools->Pane());
  topBottom->setStretchFactor(0, 1);
  topBottom->setChildrenCollapsible(false);
  topBottom->setSizes({4 * kUsualErrors, kUsualErrors});
  KeepSplitter(*topBottom);
  QWidget::setTabOrder(&findTools->TreeFilter(), tree);
  ChainAfter(ChainAfter(*tree, *messages), findTools->Pane());

  auto* layout = MakeChild<QVBoxLayout>(this);
  layout->setContentsMargins(kMargin, 0, kMargin, kMargin);
  layout->setSpacing(0);
  auto* bars = MakeChild<QHBoxLayout>();
  bars->addWidget(toolBar);
  bars->addWidget(editBar, 1);
  layout->addLayout(bars);
  layout->addWidget(topBottom, 1);
}

QWidget* CMainView::MakeTree() {
  auto* filtered = MakeChild<QWidget>(this);
  auto* layout = MakeChild<QVBoxLayout>(filtered);
  layout->setContentsMargins(0, 0, 0, 0);
  layout->setSpacing(0);
  layout->addWidget(&findTools->TreeFilter());
  layout->addWidget(tree, 1);
  return filtered;
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
  layout->addWidget(MakeChild<CMessageBar>(*errorList, messages));
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
  if (edits != nullptr) edits->Update();
  UpdateStatus();
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
    case hint::kStructure:
      tree->Follow(Core());
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
  edits->Update();
  // A click selects the row under the pointer, where a node that the commit has made may lie by then.
  QTimer::singleShot(0, this, [this] {
    QTreeWidgetItem* item = tree->currentItem();
    if (item != nullptr && !item->isSelected())
      tree->setCurrentItem(item, 0, QItemSelectionModel::ClearAndSelect);
  });
}

void CMainView::CloseForm() {
  shown = nullptr;
  caretText.clear();
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
  for (const auto* panel : form->findChildren<CExpressionPanel*>()) {
    connect(panel, &CExpressionPanel::CaretMoved, this, [this](int line, int column) {
      caretText = strings::kStatusGap + strings::kCaretPlace.arg(line).arg(column);
      UpdateStatus();
    });
  }
  // From the tree into the form, and from its last field on to the messages.
  ChainAfter(*tree, *form);
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

void CMainView::Say(const QString& text) {
  UpdateStatus(text.toStdString());
}

std::string CMainView::StatusText() const {
  const auto count = Core().CountNamedElements() + Core().GetSpecieCount();
  const QString elements = count == 1 ? strings::kOneElement : strings::kElementCount.arg(count);
  const int rows = errorList->topLevelItemCount();
  const QString messages = rows == 1 ? strings::kOneMessage : strings::kMessageCount.arg(rows);
  return (elements + strings::kStatusGap + messages + caretText).toStdString();
}

namespace {

// How a place is written: what sort of node it is, and what names it.
constexpr std::string_view kSymbolPlace = "symbol ";
constexpr std::string_view kNodePlace = "node ";
constexpr std::string_view kGroupPlace = "group ";
constexpr std::string_view kListPlace = "list ";

}  // namespace

std::string CMainView::Place() const {
  QTreeWidgetItem* item = tree->currentItem();
  if (item == nullptr) return {};
  const CItemData& node = CElementTree::DataOf(*item);
  if (node.groupIndex > 0) return std::string(kGroupPlace) + std::to_string(node.groupIndex);
  if (!IsElement(node.id)) return std::string(kNodePlace) + std::to_string(NumberOf(node.id));
  if (const CEL_Lagrange_Specie* specie = Core().GetParentSpecie(node.id)) {
    return std::string(kListPlace) + std::to_string(NumberOf(node.kind)) + ' ' + specie->symbol.TextOf();
  }
  const CEL_Element* element = Core().GetElement(node.id);
  return element == nullptr ? std::string() : std::string(kSymbolPlace) + element->FullSymbol();
}

void CMainView::GoTo(const std::string& place) {
  const std::string_view text = place;
  const auto rest = [text](std::string_view sort) { return std::string(text.substr(sort.size())); };
  if (text.starts_with(kGroupPlace))
    return SelectGroup(QString::fromStdString(rest(kGroupPlace)).toInt() - 1);
  if (text.starts_with(kNodePlace)) return SelectById(Uid{QString::fromStdString(rest(kNodePlace)).toInt()});
  std::uint32_t sequence = 0;
  if (text.starts_with(kSymbolPlace) && Core().FindSymbol(rest(kSymbolPlace), sequence)) {
    return SelectById(Core().FindRecordBySequence(sequence)->uid);
  }
  if (!text.starts_with(kListPlace)) return;
  const QString list = ToScreen(rest(kListPlace));
  const std::string name = list.section(u' ', 1).toStdString();
  for (const auto& specie : Core().Species()) {
    for (const auto& head : specie->Heads()) {
      if (specie->symbol.Text() == name && NumberOf(head->Kind()) == list.section(u' ', 0, 0).toInt()) {
        return SelectById(head->GetUid());
      }
    }
  }
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

bool CMainView::eventFilter(QObject* watched, QEvent* happened) {
  if (watched == tree && happened->type() == QEvent::KeyPress && form) {
    const auto* key = static_cast<QKeyEvent*>(happened);
    if (key->key() == Qt::Key_Tab && key->modifiers() == Qt::NoModifier) {
      FocusForm();
      return true;
    }
  }
  return QWidget::eventFilter(watched, happened);
}

std::vector<ViewCommand> CMainView::Commands() {
  std::vector<ViewCommand> commands;
  const auto append = [&commands](std::vector<ViewCommand> some) {
    std::move(some.begin(), some.end(), std::back_inserter(commands));
  };
  append(ExportCommands(document, dialogs, *this));
  append(edits->Commands());
  append(zoom->Commands());
  for (QAction* action : {back, forward})
    commands.push_back({.menu = strings::kGoMenu, .text = {}, .action = action});
  commands.push_back({.menu = strings::kGoMenu, .text = {}});
  append(findTools->Commands());
  commands.push_back({.menu = strings::kHelpMenu, .text = {}, .action = helpContents});
  commands.push_back(
      {.menu = strings::kHelpMenu, .text = strings::kFunctions, .run = [this] { OpenReference(this, {}); }});
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
  const QList<QWidget*> stops = TabStopsIn(*form, *tree);
  const auto first = std::find_if(stops.begin(), stops.end(),
                                  [](const QWidget* stop) { return stop->isEnabled() && stop->isVisible(); });
  QWidget* target = first == stops.end() ? static_cast<QWidget*>(errorList) : *first;
  target->setFocus(Qt::TabFocusReason);
}

}  // namespace tessal
