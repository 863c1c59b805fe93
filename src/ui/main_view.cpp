#include "ui/main_view.h"

#include <QAction>
#include <QApplication>
#include <QFocusEvent>
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
#include <iterator>
#include <utility>

#include "core/document.h"
#include "ui/account_strip.h"
#include "ui/analysis_pane.h"
#include "ui/analysis_tools.h"
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
#include "ui/formula_preview.h"
#include "ui/help_window.h"
#include "ui/icons.h"
#include "ui/kept_splitter.h"
#include "ui/label.h"
#include "ui/message_bar.h"
#include "ui/node_kinds.h"
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
  analyses = MakeChild<CAnalysisTools>(
      AnalysisSurroundings{*this, document, *tree, *errorList, *findTools, [this] { CommitAll(); }});

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
  topBottom->addWidget(&analyses->Pane());
  topBottom->setStretchFactor(0, 1);
  topBottom->setChildrenCollapsible(false);
  topBottom->setSizes({4 * kUsualErrors, kUsualErrors});
  KeepSplitter(*topBottom);
  QWidget::setTabOrder(findTools->TreeFilter().focusProxy(), tree);
  ChainAfter(ChainAfter(ChainAfter(*tree, *messages), findTools->Pane()), analyses->Pane());

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
  analyses->CommitTyped();
  Commit();
  if (form && form->HasUnwritten()) Commit();
}

bool CMainView::HasUncommitted() const {
  return (form && !form->TypedValues().empty()) || (analyses != nullptr && analyses->HasTyped());
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

void CMainView::focusInEvent(QFocusEvent* focus) {
  // A host that gives the view the focus gives it to the tree. As a proxy, the tree would be the first stop
  // of the view, and Tab would pass over what lies before it. A view may come to the front before it is
  // filled.
  if (tree != nullptr) tree->setFocus(focus->reason());
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
  append(analyses->Commands());
  commands.push_back({.menu = strings::kHelpMenu, .text = {}, .action = helpContents});
  commands.push_back(
      {.menu = strings::kHelpMenu, .text = strings::kGuide, .run = [this] { OpenGuide(this); }});
  commands.push_back(
      {.menu = strings::kHelpMenu, .text = strings::kFunctions, .run = [this] { OpenReference(this, {}); }});
  commands.push_back(StrongColoursCommand());
  commands.push_back(FormulasCommand());
  return commands;
}

void CMainView::FocusForm() {
  const QList<QWidget*> stops = TabStopsIn(*form, *tree);
  const auto first = std::find_if(stops.begin(), stops.end(),
                                  [](const QWidget* stop) { return stop->isEnabled() && stop->isVisible(); });
  QWidget* target = first == stops.end() ? static_cast<QWidget*>(errorList) : *first;
  target->setFocus(Qt::TabFocusReason);
}

}  // namespace tessal
