// A user who does anything at all: random keys, clicks, choices, menus and dialogs over every page of the
// editor, from a seed that is printed. After each action the template is whole: its table is that of a fresh
// rebuild, and the tree shows its elements in their order.
#include <gtest/gtest.h>

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QInputMethodEvent>
#include <QMenu>
#include <QPushButton>
#include <QStandardPaths>
#include <QTabWidget>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>
#include <QToolBar>
#include <cstdio>
#include <cstdlib>
#include <iterator>
#include <random>
#include <sstream>

#include "support/case_file.h"
#include "support/template_content.h"
#include "support/template_text.h"
#include "ui/editor.h"
#include "ui/expression_palette.h"
#include "ui/expression_panel.h"
#include "ui/folder_elements.h"
#include "ui/found_list.h"
#include "ui/node_kinds.h"
#include "ui/row_table.h"

namespace {

using namespace tessal;

constexpr const char* kWords[] = {"a",
                                  "k*f + 1",
                                  "Fish_e / 2",
                                  "IF k > 1 THEN a ELSE S",
                                  "",
                                  "  two words ",
                                  "x!",
                                  "Specie_1",
                                  "1e400",
                                  "-3.5",
                                  "MAX(a, k)",
                                  "a + ^",
                                  "[XPOS]",
                                  "Group_1",
                                  "\xC3\xA9t\xC3\xA9",
                                  "External(1)",
                                  "p * new_symbol_7",
                                  "KeyWord",
                                  "2,5",
                                  "Fish::Age"};

/// The whole table as text, but for the numbers of inputs: a value is shown as it was at the last rebuild.
std::string TableText(const TemplateCore& core) {
  std::ostringstream text;
  for (const SymbolRecord& record : core.SymbolTable()) {
    text << record.sequence << ' ' << core.RecordSymbol(record) << ' ' << NumberOf(record.uid) << ' '
         << (record.expression != nullptr ? record.expression->TextOf() : std::string()) << ':';
    for (const std::uint32_t used : record.references) text << ' ' << used;
    text << " by";
    for (const std::uint32_t user : record.referencedBy) text << ' ' << user;
    text << '\n';
  }
  for (const auto& undefined : core.UndefinedSymbols()) text << "? " << undefined->symbol << '\n';
  return text.str();
}

/// A folder's children and elements, side by side.
std::string ListOrders(const QTreeWidgetItem& folder, const std::vector<const CEL_Element*>& elements) {
  std::string text;
  for (int place = 0; place < folder.childCount(); ++place) {
    text += "\n  " + folder.child(place)->text(0).toStdString() + " | " +
            elements[static_cast<std::size_t>(place)]->symbol.TextOf();
  }
  return text + "\n";
}

class Monkey final {
 public:
  explicit Monkey(unsigned seed) : random(seed), editor(std::make_unique<test::Editor>(StartText(seed))) {}

  /// One action; its name.
  std::string Act();
  /// What is wrong after it; empty when the template and the tree are whole.
  std::string Fault();

 private:
  static std::string StartText(unsigned seed) { return test::RandomTemplate(seed, 40); }

  std::size_t Pick(std::size_t count) { return count == 0 ? 0 : random() % count; }
  bool Sometimes(std::size_t oneIn) { return Pick(oneIn) == 0; }
  Answer AnyAnswer() { return static_cast<Answer>(Pick(4)); }
  QString Word() { return QString::fromUtf8(kWords[Pick(std::size(kWords))]); }
  template <class Widget>
  Widget* AnyOf();
  void PrepareAnswers();
  void CloseWhatOpens();

  std::string SelectNode();
  std::string UseNodeMenu();
  std::string TypeText();
  std::string TypeExpression();
  std::string ChooseEntry();
  std::string ClickButton();
  std::string UseRows();
  std::string RunCommand();
  std::string RunKeyCommand();
  std::string UseFound();
  std::string PressKey();
  std::string UseErrorList();
  std::string Save();
  std::string TakeBackAndDoAgain();

  std::mt19937 random;
  std::unique_ptr<test::Editor> editor;
  std::string lost;  ///< what an action has found to be lost
};

template <class Widget>
Widget* Monkey::AnyOf() {
  QList<Widget*> fitting;
  for (Widget* widget : editor->View().findChildren<Widget*>()) {
    if (widget->isVisible() && widget->isEnabled()) fitting.append(widget);
  }
  return fitting.isEmpty() ? nullptr
                           : fitting[static_cast<qsizetype>(Pick(static_cast<std::size_t>(fitting.size())))];
}

void Monkey::PrepareAnswers() {
  editor->User().answers = {AnyAnswer(), AnyAnswer(), AnyAnswer()};
  editor->User().choices = {static_cast<int>(Pick(10)) - 1, static_cast<int>(Pick(10)) - 1};
  editor->User().TakeLog();
}

/// A menu or a dialog waits for its user: an entry is chosen, or it is closed.
void Monkey::CloseWhatOpens() {
  QTimer::singleShot(0, &editor->View(), [this] {
    if (auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget())) {
      const auto actions = menu->actions();
      QAction* action = actions.isEmpty()
                            ? nullptr
                            : actions[static_cast<qsizetype>(Pick(static_cast<std::size_t>(actions.size())))];
      if (action != nullptr && action->isEnabled() && !Sometimes(4)) action->trigger();
      menu->close();
    } else if (QWidget* popup = QApplication::activePopupWidget()) {
      popup->close();
    } else if (QWidget* dialog = QApplication::activeModalWidget()) {
      dialog->close();
    }
  });
}

std::string Monkey::SelectNode() {
  QList<QTreeWidgetItem*> nodes;
  for (QTreeWidgetItemIterator item(&editor->Tree()); *item != nullptr; ++item) nodes.append(*item);
  QTreeWidgetItem* node = nodes[static_cast<qsizetype>(Pick(static_cast<std::size_t>(nodes.size())))];
  editor->Tree().setCurrentItem(node);
  return "select " + node->text(0).toStdString();
}

std::string Monkey::UseNodeMenu() {
  const std::string name = SelectNode();
  editor->Tree().scrollToItem(editor->Tree().currentItem());
  CloseWhatOpens();
  emit editor->Tree().customContextMenuRequested(
      editor->Tree().visualItemRect(editor->Tree().currentItem()).center());
  return "menu, " + name;
}

std::string Monkey::TypeText() {
  QWidget* field = Sometimes(2) ? static_cast<QWidget*>(AnyOf<QLineEdit>()) : AnyOf<CPlainTextField>();
  if (field == nullptr) return "nothing to type into";
  field->setFocus();
  if (Sometimes(2)) QTest::keyClick(field, Qt::Key_A, Qt::ControlModifier);
  // As an input method does it: the keys of a test know no letters but those of ASCII.
  QInputMethodEvent typed;
  typed.setCommitString(Word());
  QApplication::sendEvent(field, &typed);
  return "type into " + field->objectName().toStdString();
}

/// By keys, with the list of completions that they open, and the menus beside the field.
std::string Monkey::TypeExpression() {
  auto* panel = AnyOf<CExpressionPanel>();
  if (panel == nullptr) return "no expression";
  constexpr const char* kTyped[] = {"te", "MAX(", "[",  "sq",     "IF ",    "(",  ")",   "k",
                                    "+",  ", ",   "^2", " THEN ", "KILL{(", "1e", "::+ "};
  CAutoRichEditCtrl& field = panel->Field();
  field.setFocus();
  QTest::keyClicks(&field, kTyped[Pick(std::size(kTyped))]);
  if (QWidget* list = QApplication::activePopupWidget()) {
    if (Sometimes(2)) QTest::keyClick(list, Qt::Key_Down);
    QTest::keyClick(list, Sometimes(3) ? Qt::Key_Escape : Qt::Key_Return);
  }
  if (Sometimes(4)) {
    QMenu& palette = *panel->findChild<CExpressionPalette*>()->menu();
    emit palette.aboutToShow();
    const auto groups = palette.actions();
    const auto entries =
        groups[static_cast<qsizetype>(Pick(static_cast<std::size_t>(groups.size())))]->menu()->actions();
    if (entries.isEmpty()) return "an empty menu of the palette";
    QAction* entry = entries[static_cast<qsizetype>(Pick(static_cast<std::size_t>(entries.size())))];
    // A comment that loses its end reaches the next expression, and would make each rebuild another.
    if (!entry->text().startsWith(QStringLiteral("/*"))) entry->trigger();
  }
  return "type into an expression";
}

std::string Monkey::ChooseEntry() {
  auto* combo = AnyOf<QComboBox>();
  if (combo == nullptr || combo->count() == 0) return "no choice";
  const int entry = static_cast<int>(Pick(static_cast<std::size_t>(combo->count())));
  const std::string name = combo->objectName().toStdString();
  combo->setCurrentIndex(entry);
  emit combo->activated(entry);
  return "choose " + std::to_string(entry) + " in " + name;
}

std::string Monkey::ClickButton() {
  auto* button = AnyOf<QAbstractButton>();
  if (button == nullptr) return "no button";
  const std::string name = button->objectName().toStdString() + " " + button->text().toStdString();
  CloseWhatOpens();
  button->setFocus();
  QTest::mouseClick(button, Qt::LeftButton);
  return "click " + name;
}

std::string Monkey::UseRows() {
  auto* table = AnyOf<CRowTable>();
  if (table == nullptr || table->Model().rowCount() == 0) return "no rows";
  table->SelectRow(static_cast<int>(Pick(static_cast<std::size_t>(table->Model().rowCount()))));
  const int column = static_cast<int>(Pick(static_cast<std::size_t>(table->Model().columnCount())));
  const QModelIndex cell = table->Model().index(table->CurrentRow(), column);
  const std::string name = table->objectName().toStdString();
  if (Sometimes(3)) {
    table->Model().setData(cell, Word(),
                           (table->Model().flags(cell) & Qt::ItemIsEditable) != 0 ? Qt::EditRole : -1);
    return "edit a cell of " + name;
  }
  if (Sometimes(3)) emit table->RowEntered(table->CurrentRow());
  return "row of " + name;
}

std::string Monkey::RunCommand() {
  QList<QAction*> actions;
  for (const QToolBar* bar : editor->View().findChildren<QToolBar*>()) {
    if (!bar->isVisible()) continue;
    for (QAction* action : bar->actions()) {
      if (action->isEnabled()) actions.append(action);
    }
  }
  if (actions.isEmpty()) return "no command";
  QAction* action = actions[static_cast<qsizetype>(Pick(static_cast<std::size_t>(actions.size())))];
  const std::string name = action->text().toStdString();
  CloseWhatOpens();
  action->trigger();
  return "command " + name;
}

/// A command of the view that has a key: to find, to filter, to go somewhere.
std::string Monkey::RunKeyCommand() {
  const QList<QAction*> actions = editor->View().actions();
  QAction* action = actions[static_cast<qsizetype>(Pick(static_cast<std::size_t>(actions.size())))];
  const std::string name = action->text().toStdString();
  CloseWhatOpens();
  action->trigger();
  return "key command " + name;
}

/// A row of what was found is left out, or gone to.
std::string Monkey::UseFound() {
  auto* list = AnyOf<CFoundList>();
  if (list == nullptr || list->Rows().rowCount() == 0) return "nothing found";
  const QModelIndex cell =
      list->Rows().index(static_cast<int>(Pick(static_cast<std::size_t>(list->Rows().rowCount()))), 0);
  list->setCurrentIndex(cell);
  if (Sometimes(2)) {
    list->Rows().setData(cell, Sometimes(2) ? Qt::Checked : Qt::Unchecked, Qt::CheckStateRole);
    return "choose a replacement";
  }
  emit list->RowChosen(cell.row());
  return "go to what was found";
}

std::string Monkey::PressKey() {
  QWidget* target = QApplication::focusWidget() == nullptr ? &editor->View() : QApplication::focusWidget();
  constexpr Qt::Key kKeys[] = {Qt::Key_Tab,    Qt::Key_Return, Qt::Key_Escape, Qt::Key_Up,
                               Qt::Key_Down,   Qt::Key_Left,   Qt::Key_Right,  Qt::Key_Delete,
                               Qt::Key_Insert, Qt::Key_F2,     Qt::Key_Z,      Qt::Key_Backtab};
  constexpr Qt::KeyboardModifier kModifiers[] = {Qt::NoModifier, Qt::NoModifier, Qt::AltModifier,
                                                 Qt::ControlModifier};
  const Qt::Key key = kKeys[Pick(std::size(kKeys))];
  CloseWhatOpens();
  QTest::keyClick(target, key, kModifiers[Pick(std::size(kModifiers))]);
  return "key " + std::to_string(key);
}

std::string Monkey::UseErrorList() {
  CErrorList& list = editor->View().ErrorList();
  if (list.topLevelItemCount() == 0) return "no messages";
  QTreeWidgetItem* row =
      list.topLevelItem(static_cast<int>(Pick(static_cast<std::size_t>(list.topLevelItemCount()))));
  list.scrollToItem(row);
  CloseWhatOpens();
  QTest::mouseClick(list.viewport(), Sometimes(4) ? Qt::RightButton : Qt::LeftButton, {},
                    list.visualItemRect(row).center());
  return "message";
}

std::string Monkey::Save() {
  const std::string path = editor->Path() + ".saved";
  editor->View().OnCommit();
  editor->User().answers = {Answer::Yes};
  if (!editor->Document().OnSaveDocument(path)) return "save refused";
  return "save";
}

/// Takes some steps back and does them again: the template is the same to the byte.
std::string Monkey::TakeBackAndDoAgain() {
  editor->View().CommitAll();
  // As in the checks: the table of before is that of a rebuild.
  SetNotifyChanges(true);
  TemplateCore& core = editor->Core();
  core.RebuildSymbolTable();
  std::string reason;
  const auto before = core.CopyText(reason);
  const std::size_t steps = Pick(core.History().UndoCount() + 1);
  const auto take = [this](const QString& name, std::size_t count) {
    editor->Tree().setFocus();
    for (const ViewCommand& command : editor->View().Commands()) {
      if (command.action == nullptr || !command.action->text().startsWith(name)) continue;
      for (std::size_t step = 0; step < count; ++step) command.action->trigger();
    }
  };
  const std::size_t left = core.History().UndoCount() - steps;
  take(QStringLiteral("&Undo"), steps);
  if (core.History().UndoCount() != left) {
    lost = "undo has taken back to step " + std::to_string(core.History().UndoCount()) + " instead of " +
           std::to_string(left) + ", by " + std::to_string(steps) + "; next to it are '" +
           std::string(core.History().UndoName()) + "' and '" + std::string(core.History().RedoName()) + "'";
  }
  take(QStringLiteral("&Redo"), steps);
  const auto after = core.CopyText(reason);
  if (before != after) lost = "steps that were taken back and done again have left another template";
  return "back and again " + std::to_string(steps);
}

std::string Monkey::Act() {
  PrepareAnswers();
  std::string (Monkey::*const kActions[])() = {
      &Monkey::SelectNode,    &Monkey::SelectNode,     &Monkey::UseNodeMenu,  &Monkey::TypeText,
      &Monkey::TypeText,      &Monkey::TypeExpression, &Monkey::ChooseEntry,  &Monkey::ChooseEntry,
      &Monkey::ClickButton,   &Monkey::UseRows,        &Monkey::UseRows,      &Monkey::RunCommand,
      &Monkey::PressKey,      &Monkey::PressKey,       &Monkey::UseErrorList, &Monkey::RunKeyCommand,
      &Monkey::RunKeyCommand, &Monkey::UseFound};
  if (Sometimes(100)) return TakeBackAndDoAgain();
  const std::string name = Sometimes(200) ? Save() : (this->*kActions[Pick(std::size(kActions))])();
  QCoreApplication::processEvents();
  QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
  if (QWidget* left = QApplication::activePopupWidget()) left->close();
  return name;
}

std::string Monkey::Fault() {
  if (!lost.empty()) return lost;
  TemplateCore& core = editor->Core();
  if (!NotifyChanges()) {
    // A group that was made from the menu leaves the listeners off until the next element is made.
    SetNotifyChanges(true);
    core.RebuildSymbolTable();
  }
  const std::string table = TableText(core);
  core.RebuildSymbolTable();
  const std::string fresh = TableText(core);
  if (table != fresh) return "the table is not that of a rebuild:\n" + table + "---\n" + fresh;
  for (QTreeWidgetItemIterator item(&editor->Tree()); *item != nullptr; ++item) {
    const CItemData& node = CElementTree::DataOf(**item);
    const auto elements = ElementsOfFolder(core, node);
    const bool isFolder = !IsElement(node.id) || node.kind >= ElementKind::Root;
    if (!isFolder || elements.empty()) continue;
    if (static_cast<std::size_t>((*item)->childCount()) != elements.size())
      return "a folder has other children";
    for (int place = 0; place < (*item)->childCount(); ++place) {
      if (CElementTree::DataOf(*(*item)->child(place)).id !=
          elements[static_cast<std::size_t>(place)]->GetUid())
        return "the tree has another order in " + (*item)->text(0).toStdString() +
               ListOrders(**item, elements);
    }
  }
  return {};
}

int Run(unsigned seed, int actions) {
  std::printf("editor: %d actions from seed %u\n", actions, seed);
  std::fflush(stdout);
  Monkey monkey(seed);
  std::string last[20];
  for (int count = 0; count < actions; ++count) {
    last[count % 20] = monkey.Act();
    if (std::getenv("MONKEY_TRACE") != nullptr)
      std::fprintf(stderr, "%d %s\n", count, last[count % 20].c_str());
    const std::string fault = monkey.Fault();
    if (fault.empty()) continue;
    std::printf("after action %d of seed %u: %s\n", count, seed, fault.c_str());
    for (int back = 0; back < 20; ++back) std::printf("  %s\n", last[(count + 1 + back) % 20].c_str());
    return 1;
  }
  return 0;
}

}  // namespace

int main(int count, char** arguments) {
  const QTemporaryDir settings;
  qputenv("XDG_CONFIG_HOME", settings.path().toUtf8());
  qputenv("QT_QPA_PLATFORM", "offscreen");
  QApplication application(count, arguments);
  QApplication::setOrganizationName(QStringLiteral("Tessal"));
  QApplication::setApplicationName(QStringLiteral("monkey"));
  testing::InitGoogleTest(&count, arguments);
  const int actions = count > 1 ? std::atoi(arguments[1]) : 20000;
  const unsigned seed = count > 2 ? static_cast<unsigned>(std::atoi(arguments[2])) : std::random_device{}();
  return Run(seed, actions);
}
