#include "ui/script.h"

#include <gtest/gtest.h>

#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QDirIterator>
#include <QFileInfo>
#include <QLabel>
#include <QMenu>
#include <QPushButton>
#include <QTest>
#include <QTextBlock>
#include <QTimer>
#include <QToolBar>
#include <QToolButton>
#include <algorithm>
#include <set>

#include "ui/analysis_actions.h"
#include "ui/create_hint.h"
#include "ui/expression_actions.h"
#include "ui/find_pane.h"
#include "ui/find_tools.h"
#include "ui/found_list.h"
#include "ui/go_to_symbol.h"
#include "ui/message_bar.h"
#include "ui/page_actions.h"
#include "ui/text_bytes.h"
#include "ui/tree_filter.h"

namespace tessal::test {

namespace {

/// What follows a call's verb: "Description: Rate" has two parts.
struct Words {
  explicit Words(const std::string& text)
      : all(text),
        first(ToScreen(text).section(QStringLiteral(": "), 0, 0)),
        second(ToScreen(text).section(QStringLiteral(": "), 1)) {}
  int Number() const { return first.toInt(); }

  std::string all;
  QString first;
  QString second;
};

/// The captions of the nodes that are shown, by their depth.
void AppendShown(const QTreeWidgetItem& item, QStringList& shown, int depth = 0) {
  if (item.isHidden()) return;
  shown.append(QString(2 * depth, u' ') + item.text(0));
  for (int place = 0; place < item.childCount() && item.isExpanded(); ++place)
    AppendShown(*item.child(place), shown, depth + 1);
}

std::string Lines(const QStringList& lines) {
  return lines.isEmpty() ? "none\n" : lines.join(u'\n').toStdString() + "\n";
}

void Hint(Editor& editor, int number, const UpdateHint& argument) {
  editor.Document().UpdateAllViews(nullptr, number, &argument);
}

/// "9: k2" is a hint about a node, "13: 2" about a number.
void SendHint(Editor& editor, const Words& words) {
  bool isNumber = false;
  const std::int32_t number = words.second.toInt(&isNumber);
  const bool isNode = !isNumber && !words.second.isEmpty();
  Hint(editor, words.Number(), NumberHint(isNode ? NumberOf(editor.IdOf(words.second)) : number));
}

/// "9 in Constants: rate": the hint to create an element of a kind.
void Create(Editor& editor, const Words& words) {
  CreateRequest request;
  const QStringList kindAndOwner = words.first.split(QStringLiteral(" in "));
  request.kind = ElementKind{kindAndOwner[0].toInt()};
  if (kindAndOwner.size() > 1) request.ownerId = editor.IdOf(kindAndOwner[1]);
  request.symbol = words.second.toStdString();
  Hint(editor, hint::kCreateElement, CreateHint(request));
}

std::string History(Editor& editor) {
  std::string text;
  emit editor.View().HistoryMenu().aboutToShow();
  for (const QAction* entry : editor.View().HistoryMenu().actions()) {
    text += (entry->isChecked() ? "* " : "  ") + entry->text().toStdString() + "\n";
  }
  for (const QAction* action : editor.View().findChild<QToolBar*>()->actions()) {
    if (action->isEnabled()) text += action->text().toStdString() + "|";
  }
  return text + "\n";
}

/// "Expression: 2" is the point of a field at a place in its text.
std::pair<CAutoRichEditCtrl&, QPoint> PointIn(Editor& editor, const Words& words) {
  auto& field = editor.Field<CAutoRichEditCtrl>(words.first);
  QTextCursor cursor(field.document());
  cursor.setPosition(words.second.toInt());
  return {field, field.cursorRect(cursor).center() + QPoint(2, 0)};
}

void RightClick(Editor& editor, const Words& words) {
  const auto [field, point] = PointIn(editor, words);
  QContextMenuEvent click(QContextMenuEvent::Mouse, point, field.viewport()->mapToGlobal(point));
  QApplication::sendEvent(field.viewport(), &click);
}

/// "Expression: 2-5" marks the text between two places, and leaves the focus there.
void Mark(Editor& editor, const Words& words) {
  auto& field = editor.Field<CPlainTextField>(words.first);
  const QStringList places = words.second.split(u'-');
  QTextCursor cursor(field.document());
  cursor.setPosition(places[0].toInt());
  cursor.setPosition(places[1].toInt(), QTextCursor::KeepAnchor);
  field.setTextCursor(cursor);
  field.setFocus();
}

void UseMenuKey(Editor& editor, const Words& words) {
  QContextMenuEvent byKey(QContextMenuEvent::Keyboard, QPoint(0, 0), QPoint(0, 0));
  QApplication::sendEvent(editor.Field<CAutoRichEditCtrl>(words.first).viewport(), &byKey);
}

std::string Looks(const QTextCharFormat& looks) {
  std::string text;
  if (looks.hasProperty(QTextFormat::ForegroundBrush)) {
    text += " " + looks.foreground().color().name().toStdString();
  }
  if (looks.fontWeight() == QFont::Bold) text += " bold";
  if (looks.fontItalic()) text += " italic";
  if (looks.fontUnderline()) text += " link";
  return text;
}

/// The parts of an expression, a given one or the one shown, that look alike, each with its looks.
std::string Colours(Editor& editor, const Words& words) {
  auto& field = editor.Field<CAutoRichEditCtrl>("Expression");
  if (!words.all.empty()) field.SetColouredText(ToScreen(words.all).replace("\\n", "\n").toStdString());
  std::string text;
  for (auto block = field.document()->begin(); block.isValid(); block = block.next()) {
    QString shown = block.text();
    shown.insert(block.layout()->preeditAreaPosition(), block.layout()->preeditAreaText());
    QList<QTextLayout::FormatRange> ranges = block.layout()->formats();
    std::sort(ranges.begin(), ranges.end(), [](auto& left, auto& right) { return left.start < right.start; });
    int reached = 0;
    const auto append = [&text, &shown, &reached](int end, const QTextCharFormat& looks) {
      if (end <= reached) return;
      text += shown.mid(reached, end - reached).toStdString() + Looks(looks) + "\n";
      reached = end;
    };
    for (const QTextLayout::FormatRange& range : ranges) {
      append(range.start, {});
      append(range.start + range.length, range.format);
    }
    append(static_cast<int>(shown.size()), {});
    // Looks that were part of the text would be taken over by what is typed.
    for (auto part = block.begin(); !part.atEnd(); ++part) text += Looks(part.fragment().charFormat());
  }
  return text + (words.all.empty() || field.textCursor().position() == 0 ? "" : "the caret is elsewhere\n");
}

/// Presses Tab as often as asked, and names what has the focus after each.
std::string PressTab(Editor& /*editor*/, const Words& words) {
  std::string text;
  for (int left = words.Number(); left > 0; --left) {
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
    text += QApplication::focusWidget()->accessibleName().toStdString() + "\n";
  }
  return text;
}

/// Presses a button, and closes the dialog that this may open.
void Press(Editor& editor, const Words& words) {
  QTimer::singleShot(0, &editor.View(), [&editor] {
    QWidget* dialog = QApplication::activeModalWidget();
    if (dialog == nullptr) return;
    editor.User().ShowMessage("dialog " + dialog->windowTitle().toStdString());
    dialog->close();
  });
  QTest::mouseClick(&editor.Field(words.first), Qt::LeftButton);
  QCoreApplication::processEvents();
}

void ClickError(Editor& editor, const Words& words) {
  CErrorList& list = editor.View().ErrorList();
  const QRect row = list.visualItemRect(list.topLevelItem(words.Number()));
  QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, row.center());
}

/// "0: Create" uses the entry of a row's menu that has this in it, by the menu key.
std::string RowMenu(Editor& editor, const Words& words) {
  CErrorList& list = editor.View().ErrorList();
  list.setCurrentItem(list.topLevelItem(words.Number()));
  QString entries;
  QTimer::singleShot(0, &list, [&entries, &words] {
    auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
    if (menu == nullptr) return;
    for (QAction* action : menu->actions()) entries += action->text() + u'\n';
    for (QAction* action : menu->actions()) {
      if (!words.second.isEmpty() && action->text().remove(u'&').startsWith(words.second))
        menu->setActiveAction(action);
    }
    QTest::keyClick(menu, words.second.isEmpty() ? Qt::Key_Escape : Qt::Key_Return);
  });
  QContextMenuEvent byKey(QContextMenuEvent::Keyboard, QPoint(0, 0), QPoint(0, 0));
  QApplication::sendEvent(list.viewport(), &byKey);
  QCoreApplication::processEvents();
  QApplication::setActiveWindow(&editor.View());
  return entries.isEmpty() ? "none\n" : entries.toStdString();
}

/// The nodes that carry a mark, with what its tip says.
std::string Marks(Editor& editor, const Words& /*words*/) {
  std::string text;
  for (QTreeWidgetItemIterator item(&editor.Tree()); *item != nullptr; ++item) {
    const QString mark = (*item)->data(0, Qt::AccessibleDescriptionRole).toString();
    if (!mark.isEmpty()) text += mark.toStdString() + "\n";
  }
  return text.empty() ? "none\n" : text;
}

/// "Export Overview" runs the command of the view whose text has this in it, and lists the files then there.
/// The action of the edit menu whose text begins so.
QAction* EditAction(Editor& editor, const QString& text) {
  for (const ViewCommand& command : editor.View().Commands()) {
    if (command.action != nullptr && command.action->text().remove(u'&').startsWith(text))
      return command.action;
  }
  return nullptr;
}

void UseEditMenu(Editor& editor, const Words& words) {
  QAction* action = EditAction(editor, words.first);
  ASSERT_TRUE(action != nullptr && action->isEnabled()) << words.all;
  action->trigger();
}

/// What can be taken back and done again, and whether there is anything to save.
std::string Steps(Editor& editor, const Words& /*words*/) {
  std::string text;
  for (const char* name : {"Undo", "Redo"}) {
    const QAction* action = EditAction(editor, QString::fromLatin1(name));
    text += action->isEnabled() ? action->text().remove(u'&').toStdString() + "\n" : "";
  }
  const bool isMarked = editor.Document().Title().find("Modified") != std::string::npos;
  return text + (isMarked && editor.Document().IsModified() ? "modified\n" : "as saved\n");
}

std::string RunCommand(Editor& editor, const Words& words) {
  for (const ViewCommand& command : editor.View().Commands()) {
    if (command.run && ToScreen(command.text).remove(u'&').contains(words.first)) command.run();
  }
  QDirIterator file(QFileInfo(ToScreen(editor.Path())).path(), QDir::Files, QDirIterator::Subdirectories);
  QStringList found;
  while (file.hasNext()) found.append(file.next());
  found.sort();
  return Lines(found);
}

void EnterError(Editor& editor, const Words& words) {
  CErrorList& list = editor.View().ErrorList();
  list.setFocus();
  list.setCurrentItem(list.topLevelItem(words.Number()));
  QTest::keyClick(&list, Qt::Key_Return);
}

void Revisit(Editor& editor, const Words& words) {
  emit editor.View().HistoryMenu().aboutToShow();
  editor.View().HistoryMenu().actions().at(words.Number())->trigger();
}

std::string Clipboard(Editor& editor, const Words& /*words*/) {
  QString text = QApplication::clipboard()->text();
  return text.replace(QString::fromStdString(editor.Path()), QStringLiteral("PATH")).toStdString() + '\n';
}

std::string Save(Editor& editor, const Words& words) {
  return editor.Document().OnSaveDocument(editor.Path() + words.all) ? "saved\n" : "not saved\n";
}

/// What the pane shows: its state, then its rows, what is marked between angles and a box for a choice.
std::string Found(Editor& editor, const Words& /*words*/) {
  const CFindPane& pane = editor.View().FindTools().Pane();
  if (!pane.isVisible()) return "no pane\n";
  const auto& list = *pane.findChild<CFoundList*>();
  QStringList lines = {pane.findChild<QLabel*>(QStringLiteral("FindState"))->text()};
  for (int row = 0; row < list.Rows().rowCount(); ++row) {
    QStringList cells;
    for (int column = 0; column < list.Rows().columnCount(); ++column) {
      MarkedText marked = list.Rows().Marked(list.Rows().index(row, column));
      for (auto mark = marked.marks.rbegin(); mark != marked.marks.rend(); ++mark)
        marked.text.insert(mark->first + mark->second, u'>').insert(mark->first, u'<');
      cells.append(marked.text);
    }
    const QVariant box = list.Rows().index(row, 0).data(Qt::CheckStateRole);
    const QString choice = !box.isValid() ? QString() : (box.toInt() == Qt::Checked ? "[x] " : "[ ] ");
    lines.append((row == list.currentIndex().row() ? "* " : "  ") + choice +
                 cells.join(QStringLiteral(" | ")));
  }
  return Lines(lines);
}

/// The bar of the messages, then the rows that are shown, with a mark where they are selected.
std::string ShownMessages(Editor& editor, const Words& /*words*/) {
  const CErrorList& list = editor.View().ErrorList();
  QStringList bar;
  for (const auto* button : editor.View().findChild<CMessageBar*>()->findChildren<QToolButton*>())
    bar.append(button->text() + (button->isChecked() ? "" : " hidden"));
  QStringList lines = {bar.join(u'|')};
  for (int place = 0; place < list.topLevelItemCount(); ++place) {
    const QTreeWidgetItem& row = *list.topLevelItem(place);
    if (!row.isHidden()) lines.append((row.isSelected() ? "* " : "  ") + row.text(0) + ": " + row.text(1));
  }
  return Lines(lines);
}

/// What has the focus, with what is marked in it.
std::string Focus(Editor& /*editor*/, const Words& /*words*/) {
  const QWidget* focus = QApplication::focusWidget();
  if (focus == nullptr) return "nothing\n";
  QString marked;
  if (const auto* line = qobject_cast<const QLineEdit*>(focus)) marked = line->selectedText();
  if (const auto* field = qobject_cast<const QTextEdit*>(focus)) marked = field->textCursor().selectedText();
  return focus->accessibleName().toStdString() + ": " + marked.toStdString() + "\n";
}

/// "g_r" shows what the window that goes to symbols offers for the letters; "g_r: 2" goes to the second row.
std::string GoToSymbol(Editor& editor, const Words& words) {
  // A window or a menu that was closed before gives nothing back on a screen without a window manager.
  QApplication::setActiveWindow(&editor.View());
  QTest::keyClick(&editor.Tree(), Qt::Key_K, Qt::ControlModifier);
  // The window before it may be about to go.
  auto* window = editor.View().findChildren<CGoToSymbol*>().last();
  QTest::keyClicks(window->findChild<QLineEdit*>(), words.first);
  QStringList offered;
  const auto& list = *window->findChild<QTreeWidget*>();
  for (int place = 0; place < list.topLevelItemCount(); ++place)
    offered.append(list.topLevelItem(place)->text(0) + " | " + list.topLevelItem(place)->text(1));
  for (int row = words.second.toInt(); row > 1; --row) QTest::keyClick(window->focusWidget(), Qt::Key_Down);
  QTest::keyClick(window->focusWidget(), words.second.isEmpty() ? Qt::Key_Escape : Qt::Key_Return);
  return Lines(offered);
}

/// A control of the whole window by its name, or by what follows its count.
QWidget& Control(Editor& editor, const QString& name) {
  for (QWidget* widget : editor.View().findChildren<QWidget*>()) {
    const auto* button = qobject_cast<const QAbstractButton*>(widget);
    const QString shown =
        button != nullptr && widget->accessibleName().isEmpty() ? button->text() : widget->accessibleName();
    if (widget->isVisible() && (shown == name || shown.endsWith(u' ' + name))) return *widget;
  }
  throw std::runtime_error("no control " + name.toStdString());
}

const std::map<std::string, void (*)(Editor& editor, const Words& words)> kActions = {
    {"select", [](Editor& editor, auto& words) { editor.Select(words.first); }},
    {"type", [](Editor& editor, auto& words) { editor.Type(words.first, words.second); }},
    {"enter",
     [](Editor& editor, auto& words) {
       editor.Type(words.first, words.second);
       editor.LeaveField();
     }},
    // Without the keys of a user: the focus stays where it is.
    {"set", [](Editor& editor, auto& words) { editor.Field<QLineEdit>(words.first).setText(words.second); }},
    {"choose", [](Editor& editor, auto& words) { editor.Choose(words.first, words.second); }},
    {"focus", [](Editor& editor, auto& words) { editor.Field(words.first).setFocus(); }},
    {"leave", [](Editor& editor, auto& /*words*/) { editor.LeaveField(); }},
    {"press", Press},
    {"key",
     [](auto& /*editor*/, auto& words) {
       if (QApplication::focusWidget() == nullptr) throw std::runtime_error("nothing has the focus");
       const QKeyCombination keys = QKeySequence(words.first)[0];
       QTest::keyClick(QApplication::focusWidget(), keys.key(), keys.keyboardModifiers());
     }},
    {"keys",
     [](auto& /*editor*/, auto& words) { QTest::keyClicks(QApplication::focusWidget(), words.first); }},
    {"mark", Mark},
    // What an input method shows before it is sure.
    {"compose",
     [](auto& /*editor*/, auto& words) {
       QInputMethodEvent unsure(words.first, {});
       QApplication::sendEvent(QApplication::focusWidget(), &unsure);
     }},
    // Typing pauses long enough.
    {"pause",
     [](Editor& editor, auto& /*words*/) {
       for (auto* timer : editor.View().findChildren<QTimer*>(QStringLiteral("TypingPause"))) {
         EXPECT_TRUE(QTest::qWaitFor([timer] { return !timer->isActive(); }));
       }
     }},
    {"commit", [](Editor& editor, auto& /*words*/) { editor.View().OnCommit(); }},
    {"answer",
     [](Editor& editor, auto& words) {
       const std::map<char, tessal::Answer> letters = {{'y', tessal::Answer::Yes},
                                                       {'n', tessal::Answer::No},
                                                       {'a', tessal::Answer::NoToAll},
                                                       {'w', tessal::Answer::WholeNames},
                                                       {'c', tessal::Answer::Cancelled}};
       for (const char letter : words.all) editor.User().answers.push_back(letters.at(letter));
     }},
    {"pick", [](Editor& editor, auto& words) { editor.User().choices.push_back(words.Number()); }},
    {"export-to",
     [](Editor& editor, auto& words) {
       editor.User().exportFile =
           ToScreen(words.all).replace("FOLDER", QFileInfo(ToScreen(editor.Path())).path());
     }},
    {"browse", [](Editor& editor, auto& words) { editor.User().documentationFile = words.first; }},
    {"hint", SendHint},
    {"create", Create},
    {"rename-group",
     [](Editor& editor, auto& words) {
       Hint(editor, hint::kRenameGroup, RenameGroupHint(words.Number(), words.second.toStdString()));
     }},
    {"use-menu", [](Editor& editor, auto& words) { editor.UseMenu(words.first, words.second); }},
    {"click-node",
     [](Editor& editor, auto& words) {
       const QPoint point = editor.Tree().visualItemRect(editor.Node(words.first)).center();
       QTest::mouseClick(editor.Tree().viewport(), Qt::LeftButton, {}, point);
       QCoreApplication::processEvents();
     }},
    {"click-error", ClickError},
    {"enter-error", EnterError},
    {"follow-error",
     [](Editor& editor, auto& words) { emit editor.View().ErrorList().ElementChosen(Uid{words.Number()}); }},
    {"go",
     [](Editor& editor, auto& words) {
       editor.View().findChild<QToolBar*>()->actions().at(words.first == "back" ? 0 : 1)->trigger();
     }},
    {"revisit", Revisit},
    {"use",
     [](Editor& editor, auto& words) {
       auto& button = dynamic_cast<QAbstractButton&>(Control(editor, words.first));
       button.click();
     }},
    {"type-into",
     [](Editor& editor, auto& words) {
       auto& line = dynamic_cast<QLineEdit&>(Control(editor, words.first));
       line.setFocus();
       line.selectAll();
       words.second.isEmpty() ? line.clear() : QTest::keyClicks(&line, words.second);
       QCoreApplication::processEvents();
     }},
    {"choose-in",
     [](Editor& editor, auto& words) {
       auto& combo = dynamic_cast<QComboBox&>(Control(editor, words.first));
       combo.setCurrentIndex(combo.findText(words.second));
     }},
    {"enter-cell",
     [](Editor& editor, auto& words) { EnterCell(Control(editor, words.first), words.second); }},
    {"tick-row",
     [](Editor& editor, auto& words) {
       auto& list = *editor.View().FindTools().Pane().template findChild<CFoundList*>();
       list.setCurrentIndex(list.Rows().index(words.Number() - 1, 0));
       QTest::keyClick(&list, Qt::Key_Space);
     }},
    {"select-rows",
     [](Editor& editor, auto& words) {
       CErrorList& list = editor.View().ErrorList();
       for (const QString& row : words.first.split(u' ')) list.topLevelItem(row.toInt())->setSelected(true);
     }},
    {"right-click", RightClick},
    {"menu-key", UseMenuKey},
    {"edit", UseEditMenu},
};

const std::map<std::string, std::string (*)(Editor& editor, const Words& words)> kLooks = {
    {"children", [](Editor& editor, auto& words) { return Lines(editor.Children(words.first)); }},
    {"menu", [](Editor& editor, auto& words) { return Lines(editor.UseMenu(words.first, "")); }},
    {"rows", [](Editor& editor, auto& /*words*/) { return Lines(editor.Rows()); }},
    {"offered", [](Editor& editor,
                   auto& words) { return Lines(Editor::Offered(editor.Field<QComboBox>(words.first))); }},
    {"tip",
     [](Editor& editor, auto& words) {
       const auto [field, point] = PointIn(editor, words);
       return field.TipOf(field.LinkAt(point)).toStdString() + "\n";
     }},
    {"history", [](Editor& editor, auto& /*words*/) { return History(editor); }},
    {"colours", Colours},
    {"row-menu", RowMenu},
    {"insert",
     [](Editor& editor, auto& words) {
       return InsertFromPalette(editor, words.first, words.second.section(u'/', 0, 0),
                                words.second.section(u'/', 1));
     }},
    {"formula", [](Editor& editor, auto& words) { return UseFormula(editor, words.first, words.second); }},
    {"hover", [](Editor& editor, auto& words) { return TipIn(editor, words.first, words.second.toInt()); }},
    {"press-keys", [](Editor& editor, auto& words) { return PressKeys(editor, words.first, words.second); }},
    {"marks", Marks},
    {"analysis", [](Editor& editor, auto& /*words*/) { return AnalysisText(editor); }},
    {"unit-note", [](Editor& editor, auto& /*words*/) { return UnitNoteText(editor); }},
    {"found", Found},
    {"shown-messages", ShownMessages},
    {"focused", Focus},
    {"go-to", GoToSymbol},
    {"shown-nodes",
     [](Editor& editor, auto& /*words*/) {
       QCoreApplication::processEvents();
       QStringList shown;
       AppendShown(*editor.Tree().RootItem(), shown);
       for (const QLabel* label : editor.View().FindTools().TreeFilter().findChildren<QLabel*>()) {
         if (label->isVisible()) shown.append(label->text());
       }
       return Lines(shown);
     }},
    {"command", RunCommand},
    {"steps", Steps},
    {"tabs", PressTab},
    {"save", Save},
    {"commands", [](Editor& editor, auto& /*words*/) { return CommandsText(editor); }},
    {"clipboard", Clipboard},
    {"selection",
     [](Editor& editor, auto& /*words*/) {
       QStringList captions;
       for (const QTreeWidgetItem* item : editor.Tree().selectedItems()) captions.append(item->text(0));
       return Lines(captions);
     }},
    {"title",
     [](Editor& editor, auto& /*words*/) {
       return editor.View().findChild<QLabel*>(QStringLiteral("1125"))->text().toStdString() + "; " +
              CElementTree::ShownText(*editor.Tree().currentItem()).toStdString() + "\n";
     }},
};

/// The lines that went, then those that came.
std::string Changes(const std::vector<std::string>& before, const std::vector<std::string>& after) {
  std::string text;
  const auto append = [&text](const char* mark, const auto& lines, std::multiset<std::string> others) {
    for (const std::string& line : lines) {
      if (const auto same = others.find(line); same != others.end()) {
        others.erase(same);
      } else {
        text += mark + line + "\n";
      }
    }
  };
  append("- ", before, {after.begin(), after.end()});
  append("+ ", after, {before.begin(), before.end()});
  return text;
}

void AppendNodes(const QTreeWidgetItem& item, const std::string& path, std::vector<std::string>& state) {
  for (int place = 0; place < item.childCount(); ++place) {
    const QTreeWidgetItem& child = *item.child(place);
    const std::string caption = path + child.text(0).toStdString();
    const std::int32_t group = CElementTree::DataOf(*item.child(place)).groupIndex;
    state.push_back("node " + caption + (group == 0 ? "" : " #" + std::to_string(group)));
    AppendNodes(child, caption + "/", state);
  }
}

}  // namespace

Script::Script(const std::string& model)
    : editor(std::make_unique<Editor>(ModelText(model))), former(Look()) {}

std::string Script::Answer(const CaseCall& call) {
  std::string rest = call.words;
  const std::string verb = rest.substr(0, rest.find(' '));
  const Words words(rest.erase(0, verb.size() + 1));
  std::string answer;
  try {
    if (const auto look = kLooks.find(verb); look != kLooks.end()) {
      answer = look->second(*editor, words);
    } else if (!ActOnPage(*editor, verb, words.first, words.second)) {
      kActions.at(verb)(*editor, words);
    }
  } catch (const std::exception& problem) {
    ADD_FAILURE() << call.words << ": " << problem.what();
  }
  QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
  for (const QString& line : editor->User().TakeLog()) answer += line.toStdString() + "\n";
  answer = ToScreen(answer).replace(QFileInfo(ToScreen(editor->Path())).path(), "FOLDER").toStdString();
  const State present = Look();
  answer += Changes(former.lines, present.lines);
  // Another node's form is another form.
  if (present.node == former.node) answer += Changes(former.form, present.form);
  former = present;
  return answer;
}

Script::State Script::Look() {
  State state;
  state.node = CElementTree::DataOf(*editor->Tree().currentItem()).id;
  state.lines = {editor->Document().Title(), "selected " + editor->Selected().toStdString()};
  if (!NotifyChanges()) state.lines.emplace_back("listeners are off");
  AppendNodes(*editor->Tree().RootItem(), "", state.lines);
  for (const QString& row : editor->Rows()) state.lines.push_back("error " + row.toStdString());
  AppendTemplate(state.lines);
  for (const QWidget* field : editor->View().Form()->findChildren<QWidget*>()) {
    const bool isButton = qobject_cast<const QPushButton*>(field) || qobject_cast<const QToolButton*>(field);
    if (field->accessibleName().isEmpty() || isButton) continue;
    state.form.push_back("[" + field->accessibleName().toStdString() + "] " +
                         Editor::TextOf(*field).toStdString() + (field->isEnabled() ? "" : " (locked)"));
  }
  return state;
}

void Script::AppendTemplate(std::vector<std::string>& state) {
  std::vector<const CEL_Element*> elements;
  for (const SymbolRecord& record : editor->Core().SymbolTable()) elements.push_back(record.element);
  if (editor->Core().GetMisc() != nullptr) elements.push_back(editor->Core().GetMisc());
  for (const CEL_Element* element : elements) {
    const std::string& name = names.try_emplace(element->GetUid(), element->symbol.TextOf()).first->second;
    std::vector<ElementField> fields;
    element->GetFields(fields);
    for (const ElementField& field : fields)
      state.push_back(name + "." + field.name + " = " + FieldText(field));
  }
}

}  // namespace tessal::test
