#include "ui/edit_commands.h"

#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QKeyEvent>
#include <QLineEdit>
#include <QTextEdit>
#include <QToolBar>
#include <algorithm>
#include <iterator>

#include "core/document.h"
#include "core/element_copies.h"
#include "ui/child.h"
#include "ui/dialogs.h"
#include "ui/element_tree.h"
#include "ui/folder_elements.h"
#include "ui/icons.h"
#include "ui/main_view.h"
#include "ui/node_kinds.h"
#include "ui/right_pane.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// Where the keys of a command count: anywhere in the view, or in its tree.
enum class Reach { View, Tree };

struct CommandRow {
  const QString& text;
  QKeySequence key;
  Reach reach;
  IconCommand icon;
  bool endsGroup;
  bool inToolBar;
};

// In the order of the menu.
const std::array<CommandRow, 11>& CommandRows() {
  static const std::array<CommandRow, 11> kRows = {{
      {strings::kUndo, QKeySequence::Undo, Reach::View, IconCommand::Undo, false, true},
      {strings::kRedo, QKeySequence::Redo, Reach::View, IconCommand::Redo, true, true},
      {strings::kCut, QKeySequence::Cut, Reach::View, IconCommand::Cut, false, true},
      {strings::kCopy, QKeySequence::Copy, Reach::View, IconCommand::Copy, false, true},
      {strings::kPaste, QKeySequence::Paste, Reach::View, IconCommand::Paste, false, true},
      {strings::kDuplicate, QKeySequence(Qt::CTRL | Qt::Key_D), Reach::View, IconCommand::Duplicate, true,
       false},
      {strings::kNewElement, QKeySequence(Qt::Key_Insert), Reach::Tree, IconCommand::New, false, true},
      {strings::kDeleteElement, QKeySequence(Qt::Key_Delete), Reach::Tree, IconCommand::Delete, false, true},
      {strings::kRenameElement, QKeySequence(Qt::Key_F2), Reach::Tree, IconCommand::Rename, true, false},
      {strings::kMoveElementUp, QKeySequence(Qt::ALT | Qt::Key_Up), Reach::Tree, IconCommand::MoveUp, false,
       false},
      {strings::kMoveElementDown, QKeySequence(Qt::ALT | Qt::Key_Down), Reach::Tree, IconCommand::MoveDown,
       false, false},
  }};
  return kRows;
}

QString CountText(std::size_t count) {
  return count == 1 ? strings::kOneElement : strings::kElementCount.arg(count);
}

bool CanUndoText(const QWidget* field) {
  if (const auto* line = qobject_cast<const QLineEdit*>(field)) return line->isUndoAvailable();
  const auto* text = qobject_cast<const QTextEdit*>(field);
  return text != nullptr && !text->isReadOnly() && text->document()->isUndoAvailable();
}

bool CanRedoText(const QWidget* field) {
  if (const auto* line = qobject_cast<const QLineEdit*>(field)) return line->isRedoAvailable();
  const auto* text = qobject_cast<const QTextEdit*>(field);
  return text != nullptr && !text->isReadOnly() && text->document()->isRedoAvailable();
}

}  // namespace

CEditCommands::CEditCommands(CMainView& mainView, UserDialogs& userDialogs)
    : QObject(&mainView), view(mainView), dialogs(userDialogs) {
  for (std::size_t place = 0; place < kCommandCount; ++place) {
    const CommandRow& row = CommandRows()[place];
    auto* action = MakeChild<QAction>(IconOfCommand(row.icon), row.text, this);
    action->setShortcuts(place == Redo ? QList{QKeySequence(Qt::CTRL | Qt::SHIFT | Qt::Key_Z),
                                               QKeySequence(Qt::CTRL | Qt::Key_Y)}
                                       : QList{row.key});
    action->setShortcutContext(row.reach == Reach::View ? Qt::WidgetWithChildrenShortcut
                                                        : Qt::WidgetShortcut);
    row.reach == Reach::View ? view.addAction(action) : view.Tree().addAction(action);
    connect(action, &QAction::triggered, this, [this, place] { Run(static_cast<Command>(place)); });
    actions[place] = action;
  }
  connect(qApp, &QApplication::focusChanged, this, [this](QWidget* /*old*/, QWidget* now) {
    if (now == nullptr || !view.isAncestorOf(now)) return;
    WatchField(now);
    Update();
  });
}

TemplateCore& CEditCommands::Core() const {
  return view.Document().Core();
}

void CEditCommands::AddTo(QToolBar& bar) const {
  bar.addSeparator();
  for (std::size_t place = 0; place < kCommandCount; ++place) {
    const CommandRow& row = CommandRows()[place];
    if (row.inToolBar) bar.addAction(actions[place]);
    if (row.endsGroup) bar.addSeparator();
  }
}

std::vector<ViewCommand> CEditCommands::Commands() const {
  std::vector<ViewCommand> commands;
  for (std::size_t place = 0; place < kCommandCount; ++place) {
    commands.push_back({.menu = strings::kEditMenu, .text = {}, .action = actions[place]});
    if (CommandRows()[place].endsGroup) commands.push_back({.menu = strings::kEditMenu, .text = {}});
  }
  return commands;
}

void CEditCommands::Update() {
  EditHistory& history = Core().History();
  const auto name = [this](Command command, std::string_view step) {
    const QString plain = CommandRows()[command].text;
    const QString words = step.empty() ? QString() : u' ' + ToScreen(std::string(step));
    // An ampersand in a symbol marks no key.
    actions[command]->setText(plain + QString(words).replace(u'&', QStringLiteral("&&")));
    actions[command]->setToolTip(QString(plain).remove(u'&') + words);
    actions[command]->setStatusTip(QString(plain).remove(u'&') + words);
    // A field with something typed can take it back.
    actions[command]->setEnabled(!step.empty() || view.HasUncommitted());
  };
  name(Undo, history.UndoName());
  name(Redo, history.RedoName());
  QTreeWidgetItem* item = view.Tree().currentItem();
  if (item == nullptr) return;
  const CItemData& data = CElementTree::DataOf(*item);
  const NodeCommands node = CommandsOfNode(data, Core());
  actions[New]->setEnabled(node.kindToCreate != ElementKind::None && node.canCreate);
  const QWidget* focus = QApplication::focusWidget();
  const bool isInText =
      qobject_cast<const QLineEdit*>(focus) != nullptr || qobject_cast<const QTextEdit*>(focus) != nullptr;
  const std::vector<Uid> selected = Selected();
  const bool hasCopyable = std::any_of(selected.begin(), selected.end(), [this](Uid uid) {
    const CEL_Element* element = Core().GetElement(uid);
    return element != nullptr && CanCopy(*element);
  });
  for (const Command command : {Cut, Copy}) actions[command]->setEnabled(isInText || hasCopyable);
  for (const Command command : {Duplicate, MoveUp, MoveDown}) actions[command]->setEnabled(hasCopyable);
  actions[Delete]->setEnabled(hasCopyable || data.groupIndex > 0);
}

void CEditCommands::WatchField(QWidget* field) {
  field->removeEventFilter(this);
  field->installEventFilter(this);
}

bool CEditCommands::eventFilter(QObject* watched, QEvent* happened) {
  if (happened->type() != QEvent::ShortcutOverride) return false;
  auto* key = static_cast<QKeyEvent*>(happened);
  const auto* field = qobject_cast<const QWidget*>(watched);
  const auto matches = [this, key](Command command) {
    const auto keys = actions[command]->shortcuts();
    return std::any_of(keys.begin(), keys.end(),
                       [key](const QKeySequence& each) { return each[0] == key->keyCombination(); });
  };
  if ((matches(Undo) && !CanUndoText(field)) || (matches(Redo) && !CanRedoText(field))) {
    happened->ignore();
    return true;
  }
  return false;
}

bool CEditCommands::RunInField(Command command) const {
  QWidget* field = QApplication::focusWidget();
  if (field == nullptr || !view.isAncestorOf(field)) return false;
  const auto run = [command, field](auto* text, bool hasSelection, bool isReadOnly) {
    switch (command) {
      case Undo:
        return CanUndoText(field) && (text->undo(), true);
      case Redo:
        return CanRedoText(field) && (text->redo(), true);
      case Cut:
        return hasSelection && !isReadOnly && (text->cut(), true);
      case Copy:
        return hasSelection && (text->copy(), true);
      case Paste:
        return !isReadOnly && (text->paste(), true);
      default:
        return false;
    }
  };
  if (auto* line = qobject_cast<QLineEdit*>(field))
    return run(line, line->hasSelectedText(), line->isReadOnly());
  auto* text = qobject_cast<QTextEdit*>(field);
  return text != nullptr && run(text, text->textCursor().hasSelection(), text->isReadOnly());
}

void CEditCommands::Run(Command command) {
  if (RunInField(command)) return;
  switch (command) {
    case Undo:
      return TakeStep(&CTessalDoc::Undo, strings::kUndone);
    case Redo:
      return TakeStep(&CTessalDoc::Redo, strings::kRedone);
    case Cut:
    case Copy:
      return CutOrCopy(command == Cut);
    case Paste:
      return PasteFromClipboard();
    case Duplicate:
      return DuplicateSelected();
    case New:
      return view.CreateBeside();
    case Delete:
      return DeleteSelected();
    case Rename:
      return view.FocusSymbol();
    case MoveUp:
    case MoveDown:
      return view.MoveSelected(command == MoveUp ? -1 : 1);
  }
}

void CEditCommands::TakeStep(std::optional<StepEffect> (CTessalDoc::*take)(), const QString& said) {
  QString name;
  view.Act([this, take, &name] {
    const std::optional<StepEffect> effect = (view.Document().*take)();
    if (effect) name = ToScreen(effect->name);
    return effect.value_or(StepEffect());
  });
  if (!name.isEmpty()) view.Say(said.arg(name));
}

std::vector<Uid> CEditCommands::Selected() const {
  const QWidget* focus = QApplication::focusWidget();
  const CRightPaneBase* form = view.Form();
  if (form != nullptr && focus != nullptr && form->isAncestorOf(focus)) {
    std::vector<Uid> rows = form->SelectedElements();
    if (!rows.empty()) return rows;
  }
  QTreeWidgetItem* item = view.Tree().currentItem();
  if (item == nullptr || !IsElement(CElementTree::DataOf(*item).id)) return {};
  return {CElementTree::DataOf(*item).id};
}

void CEditCommands::CutOrCopy(bool removes) {
  view.CommitAll();
  const CopiedText copied = TextOfElements(Core(), Selected());
  if (!copied.refusal.empty()) return dialogs.Warn(&view, ToScreen(copied.refusal));
  if (copied.text.empty()) return;
  const std::size_t count = Selected().size();
  QApplication::clipboard()->setText(ToScreen(copied.text));
  if (removes) return DeleteSelected();
  view.Say(strings::kCopied.arg(CountText(count)));
}

void CEditCommands::PasteFromClipboard() {
  view.CommitAll();
  const std::string text = FromScreen(QApplication::clipboard()->text(), "", view.Document().Encoding());
  const std::vector<Uid> selected = Selected();
  const QTreeWidgetItem* item = view.Tree().currentItem();
  CopyPlace place;
  if (!selected.empty()) place.after = selected.back();
  for (; item != nullptr; item = item->parent()) {
    const Uid id = CElementTree::DataOf(const_cast<QTreeWidgetItem&>(*item)).id;
    const CEL_Element* element = IsElement(id) ? Core().GetElement(id) : nullptr;
    if (element != nullptr && element->Kind() == ElementKind::Specie) place.specie = id;
  }
  const PastedElements pasted = Make([this, &text, &place] { return PasteElements(Core(), text, place); });
  if (pasted.refusal.empty()) view.Say(strings::kPasted.arg(CountText(pasted.uids.size())));
}

void CEditCommands::DuplicateSelected() {
  view.CommitAll();
  const std::vector<Uid> selected = Selected();
  if (selected.empty()) return;
  const PastedElements made = Make([this, &selected] { return DuplicateElements(Core(), selected); });
  if (made.uids.size() == 1) view.FocusSymbol();
}

PastedElements CEditCommands::Make(const std::function<PastedElements()>& make) {
  PastedElements made;
  view.Act([&made, &make] {
    made = make();
    StepEffect effect;
    if (!made.uids.empty()) effect.subject = made.uids.front();
    return effect;
  });
  if (!made.refusal.empty()) dialogs.Warn(&view, ToScreen(made.refusal));
  return made;
}

void CEditCommands::DeleteSelected() {
  view.CommitAll();
  const QTreeWidgetItem* item = view.Tree().currentItem();
  const std::vector<Uid> selected = Selected();
  if (item == nullptr) return;
  const CItemData& node = CElementTree::DataOf(const_cast<QTreeWidgetItem&>(*item));
  if (selected.empty()) {
    if (node.groupIndex > 0) view.DeleteFromMenu(node.id, node.groupIndex);
    return;
  }
  std::vector<Uid> kept;
  view.Act([this, &kept, &selected] {
    kept = Core().DeleteElements(selected);
    return StepEffect();
  });
  const QString names = SymbolsOf(Core(), kept);
  if (!names.isEmpty()) dialogs.Warn(&view, strings::kStillUsed.arg(names));
}

}  // namespace tessal
