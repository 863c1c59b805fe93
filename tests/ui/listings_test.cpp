// Every node of the examples: its place, its menu, its help topic and its form, and that looking changes
// nothing.
#include <gtest/gtest.h>

#include <QComboBox>
#include <QPushButton>
#include <QTabWidget>
#include <iterator>
#include <map>

#include "support/case_file.h"
#include "ui/auto_create_dialog.h"
#include "ui/editor.h"
#include "ui/expression_editor_dialog.h"
#include "ui/node_kinds.h"
#include "ui/row_table.h"

namespace tessal {
namespace {

using test::Editor;

/// The owner of what a menu makes: a folder's number, a node, or a list head that has no node.
std::string OwnerText(Editor& editor, Uid id) {
  if (NumberOf(id) < 0) return std::to_string(NumberOf(id));
  for (const auto& head : editor.Core().ListHeads()) {
    if (head->GetUid() == id) return "head " + std::to_string(NumberOf(head->Kind()));
  }
  const QTreeWidgetItem* node = editor.Tree().FindById(id);
  return node == nullptr ? "?" : (node->parent()->text(0) + u'/' + node->text(0)).toStdString();
}

std::string NodeText(Editor& editor, const QTreeWidgetItem& item, const CItemData& data) {
  const NodeCommands commands = CommandsOfNode(data, editor.Core());
  std::string text;
  for (const QTreeWidgetItem* above = item.parent(); above != nullptr; above = above->parent()) text += " ";
  text += item.text(0).toStdString() + ": kind " + std::to_string(NumberOf(data.kind));
  if (NumberOf(data.id) < 0) text += ", id " + std::to_string(NumberOf(data.id));
  if (data.groupIndex != 0) text += ", group " + std::to_string(data.groupIndex);
  text += ", help " + std::to_string(editor.View().HelpNumber());
  if (commands.kindToCreate != ElementKind::None) {
    text += std::string(commands.canCreate ? ", makes " : ", would make ") +
            std::to_string(NumberOf(commands.kindToCreate)) + " in " + OwnerText(editor, commands.ownerId);
  }
  if (commands.offersDelete) text += commands.canDelete ? ", goes" : ", stays";
  return text + (item.isExpanded() ? ", open\n" : "\n");
}

/// A line for the contents of a form. A control is described before it where it is not as it was the last
/// time in a form for that kind: number, class, label, state and choices.
std::string FormText(const QWidget& form, ElementKind kindOfNode, std::map<std::string, std::string>& seen) {
  std::string descriptions;
  std::string contents;
  std::string rows;
  for (const QWidget* control : form.findChildren<QWidget*>()) {
    const std::string id = control->objectName().toStdString();
    if (id.empty() || id.starts_with("qt_") || id.starts_with("Scroll")) continue;
    std::string text =
        id + " " + control->metaObject()->className() + " " + control->accessibleName().toStdString();
    if (!control->isEnabled()) text += " (locked)";
    if (control->property("readOnly").toBool()) text += " (read only)";
    if (const auto* combo = qobject_cast<const QComboBox*>(control)) {
      text += ": " + Editor::Offered(*combo).join(QStringLiteral(" | ")).toStdString();
    }
    if (const auto* table = qobject_cast<const CRowTable*>(control)) {
      for (int column = 0; column < table->Model().columnCount(); ++column) {
        text += (column == 0 ? ": " : " | ") +
                table->Model().headerData(column, Qt::Horizontal, Qt::DisplayRole).toString().toStdString();
      }
    }
    const std::string key = std::to_string(NumberOf(kindOfNode)) + " " + id;
    if (std::exchange(seen[key], text) != text) descriptions += "  " + text + "\n";
    if (const auto* table = qobject_cast<const CRowTable*>(control)) {
      rows += Editor::RowsOf(*table).join(u'\n').toStdString() + "\n";
      continue;
    }
    contents += (contents.empty() ? "" : " | ") + Editor::TextOf(*control).toStdString();
  }
  return descriptions + contents + "\n" + rows;
}

TEST(Examples, ShowTheirNodesAndFormsAndAreNotChangedByALook) {
  std::string nodes;
  std::string forms;
  std::map<std::string, std::string> controlsSeen;
  for (const std::string name :
       {"eutrophication", "fasham", "faults", "fish_larvae", "lake_management", "streeter_phelps", "asm1"}) {
    Editor editor(test::ReadFile(TESSAL_SOURCE_DIR "/examples/" + name + ".tessal"));
    // The names that a template leaves undefined are asked about once, and here with No.
    editor.User().answers = QList<Answer>(std::ssize(editor.Core().UndefinedSymbols()), Answer::No);
    nodes += "== " + name + "\n";
    forms += "== " + name + "\n";
    for (QTreeWidgetItemIterator item(&editor.Tree()); *item != nullptr; ++item) {
      editor.Tree().setCurrentItem(*item);
      // The overview is filled when it is seen.
      for (auto* pages : editor.View().Form()->findChildren<QTabWidget*>()) pages->setCurrentIndex(1);
      for (QWidget* field : editor.View().Form()->findChildren<QWidget*>()) field->setFocus();
      const CItemData& data = CElementTree::DataOf(**item);
      nodes += NodeText(editor, **item, data);
      forms += FormText(*editor.View().Form(), data.kind, controlsSeen);
    }
    editor.View().OnCommit();
    nodes += editor.Rows().join(u'\n').toStdString() + "\n";
    EXPECT_FALSE(editor.Document().IsModified()) << name;
  }
  test::ExpectListing("ui/cases/nodes_of_examples.txt", nodes);
  test::ExpectListing("ui/cases/forms_of_examples.txt", forms);
}

TEST(Listings, Dialogs) {
  std::string text;
  for (const std::uint32_t mask : {16U, 486U, 31U, 0U}) {
    CAutoCreateDlg dialog("rate", mask, nullptr);
    dialog.show();
    text += "== " + dialog.windowTitle().toStdString() + " in " + std::to_string(mask) + "\n";
    for (const auto* button : dialog.findChildren<QAbstractButton*>()) {
      text += button->objectName().toStdString() + " " + button->text().remove(u'&').toStdString() +
              (button->isEnabled() ? "" : " (locked)") + (button->isChecked() ? " (ticked)" : "") +
              (button->hasFocus() ? " (focus)" : "") + "\n";
    }
  }
  CExpressionEditorDlg keypad(nullptr);
  text += "== " + keypad.windowTitle().toStdString() + "\n";
  for (const auto* button : keypad.findChildren<QPushButton*>()) {
    text += button->objectName().toStdString() + " " + button->text().remove(u'&').toStdString() + "\n";
  }
  test::ExpectListing("ui/cases/dialogs.txt", text);
}

}  // namespace
}  // namespace tessal
