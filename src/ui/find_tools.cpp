#include "ui/find_tools.h"

#include <QAction>
#include <QApplication>
#include <QLineEdit>
#include <QScrollArea>
#include <algorithm>
#include <utility>

#include "core/document.h"
#include "core/explanation.h"
#include "ui/child.h"
#include "ui/dialogs.h"
#include "ui/element_tree.h"
#include "ui/error_list.h"
#include "ui/expression_field.h"
#include "ui/find_pane.h"
#include "ui/go_to_symbol.h"
#include "ui/node_kinds.h"
#include "ui/right_pane.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"
#include "ui/tree_filter.h"

namespace tessal {

namespace {

/// The node of a text's owner that is no element of the tree; None for an element, which has its own.
Uid FixedNodeOf(ElementKind kind) {
  if (kind == ElementKind::Root) return folder_id::kRoot;
  if (kind == ElementKind::Miscellaneous) return folder_id::kMiscellaneous;
  const bool isHead = kind >= ElementKind::StateVariableList && kind <= ElementKind::DerivedOutputList;
  if (!isHead) return Uid::None;
  const auto place = static_cast<std::size_t>(NumberOf(kind) - NumberOf(ElementKind::StateVariableList));
  return NodeRowOfElements(KindAfter(ElementKind::StateVariable, place)).folder;
}

/// The characters in a part of a UTF-8 text.
int Characters(const std::string& text, std::size_t start, std::size_t length) {
  return static_cast<int>(QString::fromStdString(text.substr(start, length)).size());
}

void ScrollTo(QWidget& field) {
  for (QWidget* around = field.parentWidget(); around != nullptr; around = around->parentWidget()) {
    if (auto* area = qobject_cast<QScrollArea*>(around)) area->ensureWidgetVisible(&field);
  }
}

}  // namespace

CFindTools::CFindTools(FindSurroundings surroundings)
    : QObject(&surroundings.view),
      around(std::move(surroundings)),
      filter(MakeChild<CTreeFilter>(around.tree, around.document.Core(), &around.view)),
      pane(MakeChild<CFindPane>(around.document, &around.view)) {
  pane->hide();
  connect(pane, &CFindPane::AboutToRead, this, [this] { around.commit(); });
  connect(pane, &CFindPane::AboutToRead, this, [this] { walksPane = true; });
  connect(pane, &CFindPane::PlaceChosen, this, &CFindTools::GoTo);
  connect(pane, &CFindPane::Replaced, this, &CFindTools::ShowReplaced);
  connect(pane, &CFindPane::Closed, this, [this] { around.tree.setFocus(Qt::OtherFocusReason); });
  connect(&around.messages, &CErrorList::Refreshed, filter, &CTreeFilter::Refresh);
  connect(&around.messages, &CErrorList::ExplanationRequested, this, &CFindTools::Explain);
  for (const Command& command : CommandRows()) {
    auto* action = MakeChild<QAction>(command.text, &around.view);
    action->setShortcut(QKeySequence(command.key));
    action->setShortcutContext(Qt::WidgetWithChildrenShortcut);
    connect(action, &QAction::triggered, this, command.run);
    around.view.addAction(action);
    commands.push_back({.menu = command.menu, .text = {}, .action = action});
  }
}

std::vector<CFindTools::Command> CFindTools::CommandRows() {
  return {
      {strings::kEditMenu, strings::kCommandFilter, QStringLiteral("Ctrl+F"), [this] { FilterTree(); }},
      {strings::kEditMenu, strings::kCommandFind, QStringLiteral("Ctrl+Shift+F"),
       [this] { FindInTemplate(); }},
      {strings::kEditMenu, strings::kCommandNextMatch, QStringLiteral("F3"), [this] { GoToMatch(1); }},
      {strings::kEditMenu, strings::kCommandFormerMatch, QStringLiteral("Shift+F3"),
       [this] { GoToMatch(-1); }},
      {strings::kGoMenu, strings::kCommandGoTo, QStringLiteral("Ctrl+K"), [this] { GoToSymbol(); }},
      {strings::kGoMenu, strings::kCommandUses, QStringLiteral("Shift+F12"),
       [this] { FindUsesOfSelected(); }},
      {strings::kGoMenu, strings::kCommandNextMessage, QStringLiteral("F8"),
       [this] { around.messages.GoToMessage(1); }},
      {strings::kGoMenu, strings::kCommandFormerMessage, QStringLiteral("Shift+F8"),
       [this] { around.messages.GoToMessage(-1); }},
  };
}

void CFindTools::FilterTree() {
  walksPane = false;
  filter->Begin();
}

void CFindTools::FindInTemplate() {
  // What is marked in a field is what one looks for.
  QString marked;
  if (const auto* field = qobject_cast<const QTextEdit*>(QApplication::focusWidget()))
    marked = field->textCursor().selectedText();
  if (const auto* line = qobject_cast<const QLineEdit*>(QApplication::focusWidget()))
    marked = line->selectedText();
  const bool isOneLine =
      !marked.contains(QChar::ParagraphSeparator) && !marked.contains(QChar::LineSeparator);
  const bool isWithin = pane->isAncestorOf(QApplication::focusWidget());
  walksPane = true;
  pane->Begin(isOneLine && !isWithin ? marked : QString());
}

void CFindTools::GoToMatch(int step) {
  if (walksPane && pane->isVisible() && pane->HasRows()) {
    pane->GoToRow(step);
  } else {
    filter->GoToMatch(step);
  }
}

void CFindTools::GoToSymbol() {
  around.commit();
  auto* window = MakeChild<CGoToSymbol>(around.document.Core(), &around.view);
  window->setAttribute(Qt::WA_DeleteOnClose);
  connect(window, &CGoToSymbol::SymbolChosen, this, [this](Uid uid) {
    SelectById(uid);
    around.tree.setFocus(Qt::OtherFocusReason);
  });
  window->open();
}

QString CFindTools::SelectedName() const {
  if (const auto* field = qobject_cast<const CAutoRichEditCtrl*>(QApplication::focusWidget())) {
    QTextCursor word = field->textCursor();
    word.select(QTextCursor::WordUnderCursor);
    if (!word.selectedText().isEmpty()) return word.selectedText();
  }
  QTreeWidgetItem* item = around.tree.currentItem();
  if (item == nullptr) return {};
  const CItemData& node = CElementTree::DataOf(*item);
  const CEL_Element* element = IsElement(node.id) ? around.document.Core().GetElement(node.id) : nullptr;
  if (element == nullptr) return {};
  if (node.kind == ElementKind::ExternalFunction)
    return ToScreen(static_cast<const CEL_ExternalFunction*>(element)->publicName.Text());
  return ToScreen(element->FullSymbol());
}

void CFindTools::FindUsesOfSelected() {
  const QString name = SelectedName();
  if (!name.isEmpty()) pane->ShowUses(name);
}

void CFindTools::SelectById(Uid uid) {
  const NumberHint element(NumberOf(uid));
  around.document.UpdateAllViews(nullptr, hint::kSelectElement, &element);
}

void CFindTools::GoTo(const FoundText& found, const TextMatch& match) {
  TemplateCore& core = around.document.Core();
  if (found.place.group > 0) {
    const NumberHint group(found.place.group - 1);
    around.document.UpdateAllViews(nullptr, hint::kSelectGroup, &group);
  } else {
    const Uid fixed = FixedNodeOf(found.kind);
    Uid node = fixed == Uid::None ? found.place.element : fixed;
    const CEL_Element* element = fixed == Uid::None ? core.GetElement(node) : nullptr;
    // The forcings of a particle class have no nodes: the way leads to the class.
    for (; element != nullptr && around.tree.FindById(node) == nullptr; element = element->Parent())
      node = element->Parent() == nullptr ? Uid::None : element->Parent()->GetUid();
    SelectById(node);
  }
  CRightPaneBase* form = around.form();
  if (form == nullptr) return;
  const CEL_Property* property = TextsByPlace(core).PropertyAt(found.place);
  const TextToShow text{found.place, property, Characters(found.text, 0, match.start),
                        Characters(found.text, match.start, match.length)};
  if (QWidget* field = form->ShowText(text)) {
    ScrollTo(*field);
  } else {
    // The field that had the focus may have gone.
    around.tree.setFocus(Qt::OtherFocusReason);
  }
}

void CFindTools::ShowReplaced() {
  TemplateCore& core = around.document.Core();
  const auto show = [this](const CEL_Element& element) {
    QTreeWidgetItem* item = around.tree.FindById(element.GetUid());
    if (item != nullptr) item->setText(0, ToScreen(MarkedCaption(element)));
  };
  // The captions that are texts of their own.
  for (const auto& output : core.DerivedOutputs()) show(*output);
  if (core.GetMisc() != nullptr) {
    for (const auto& function : core.GetMisc()->ExternalFunctions()) show(*function);
    const auto& groups = core.GetMisc()->Visibilities().groups;
    for (std::size_t place = 0; place < std::min(groups.size(), around.tree.GroupItems().size()); ++place)
      around.tree.GroupItems()[place]->setText(0, ToScreen(groups[place].name));
  }
  if (around.form() != nullptr) around.form()->Load();
  // Nothing is left to write: the messages and the marks of the document follow.
  around.document.UpdateAllViews(nullptr, hint::kCommit);
}

void CFindTools::Explain(const std::string& code) {
  const MessageRow* row = FindMessage(code);
  if (row != nullptr)
    around.dialogs.ShowDetails(&around.view, strings::kExplanation, ToScreen(ExplanationText(*row)));
}

}  // namespace tessal
