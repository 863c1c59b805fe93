// Every field of every form can be edited, and what was edited is what the file brings back.
#include <gtest/gtest.h>

#include <QCheckBox>
#include <QLabel>
#include <QTabWidget>
#include <QTest>

#include "core/error_registry.h"
#include "support/case_file.h"
#include "support/template_content.h"
#include "support/template_text.h"
#include "ui/editor.h"
#include "ui/element_form.h"
#include "ui/node_kinds.h"

namespace tessal {
namespace {

using test::Editor;

constexpr const char* kAllKinds =
    "small\noutput S*2\nsettings\nfunction Reeds\nfunction Rushes\ngroup G\nlevel one 1,2\nlevel two 3\n"
    "group H\nclass Fish\nclass.state Fish_m Fish_e\nclass.constant Fish_c 1\nclass.forcing Fish_f\n"
    "class.search Fish_s 1\nclass.search Fish_t 1\nclass.expression Fish_e Fish_m*2\nclass.movement 1 2\n"
    "class.movement k f\nclass.descent k\nclass Pike\nclass.state Pike_m 0\nclass.movement 1 1";

/// A node by its path of places, since an edit may change its caption.
using Path = std::vector<int>;

std::vector<Path> AllNodes(const QTreeWidgetItem& item, const Path& path = {}) {
  std::vector<Path> nodes = {path};
  for (int place = 0; place < item.childCount(); ++place) {
    Path below = path;
    below.push_back(place);
    const auto further = AllNodes(*item.child(place), below);
    nodes.insert(nodes.end(), further.begin(), further.end());
  }
  return nodes;
}

QTreeWidgetItem& NodeAt(Editor& editor, const Path& path) {
  QTreeWidgetItem* item = editor.Tree().RootItem();
  for (const int place : path) item = item->child(place);
  return *item;
}

QString EditOf(const QString& control, const QString& text) {
  // A symbol stays a symbol, a number a number, and an expression an expression.
  if (control == QStringLiteral("1097")) return text + QStringLiteral("_n");
  bool isNumber = false;
  text.toDouble(&isNumber);
  if (isNumber || text.isEmpty())
    return text == QStringLiteral("7") ? QStringLiteral("8") : QStringLiteral("7");
  return text + QStringLiteral(" + 1");
}

/// Edits a field as its user does, and leaves it; whether it could be edited.
bool Edit(Editor& editor, QWidget& field) {
  if (!field.isEnabled() || field.property("readOnly").toBool() || !field.isVisible()) return false;
  if (auto* combo = qobject_cast<QComboBox*>(&field)) {
    if (combo->count() < 2) return false;
    const int entry = (combo->currentIndex() + 1) % combo->count();
    combo->setCurrentIndex(entry);
    emit combo->activated(entry);
    return true;
  }
  const QString control = field.objectName();
  const QString typed = EditOf(control, Editor::TextOf(field));
  const QString label = field.accessibleName();
  editor.Type(label, typed);
  editor.View().OnCommit();
  QWidget* shown = editor.View().Form()->findChild<QWidget*>(control);
  EXPECT_EQ(shown == nullptr ? QString() : Editor::TextOf(*shown), typed) << label.toStdString();
  editor.LeaveField();
  return true;
}

/// Edits every field of the form that is open; how many there were.
int EditForm(Editor& editor) {
  int edited = 0;
  QStringList controls;
  for (const QWidget* field : editor.View().Form()->findChildren<QWidget*>()) {
    const bool isField = qobject_cast<const QLineEdit*>(field) || qobject_cast<const QComboBox*>(field) ||
                         qobject_cast<const CPlainTextField*>(field);
    bool isNumbered = false;
    field->objectName().toInt(&isNumbered);
    // The filter of the lists edits nothing.
    const bool isFilter = field->objectName() == QStringLiteral("1147") || field->objectName() == "1148";
    if (isField && isNumbered && !isFilter) controls.append(field->objectName());
  }
  for (const QString& control : controls) {
    auto* field = editor.View().Form()->findChild<QWidget*>(control);
    if (field != nullptr && Edit(editor, *field)) ++edited;
  }
  return edited;
}

std::string ContentOf(const std::string& path) {
  TemplateCore core;
  EXPECT_TRUE(core.LoadWrapper(path)) << Errors().JoinErrors();
  return test::TemplateContent(core);
}

void SweepTemplate(const std::string& text) {
  Editor editor(text);
  editor.User().answers = QList<Answer>(1000, Answer::NoToAll);
  int edited = 0;
  for (const Path& path : AllNodes(*editor.Tree().RootItem())) {
    editor.User().answers.prepend(Answer::Yes);
    editor.Tree().setCurrentItem(&NodeAt(editor, path));
    QCoreApplication::processEvents();
    edited += EditForm(editor);
    ASSERT_FALSE(testing::Test::HasFailure()) << NodeAt(editor, path).text(0).toStdString();
  }
  constexpr int kFewest = 60;
  EXPECT_GT(edited, kFewest);
  editor.View().OnCommit();
  editor.User().answers = {Answer::Yes};
  const std::string saved = editor.Path() + ".saved";
  ASSERT_TRUE(editor.Document().OnSaveDocument(saved));
  const std::string content = test::TemplateContent(editor.Core());
  EXPECT_EQ(ContentOf(saved), content);
}

/// What the fields of the form that is open do not explain: a label, or a choice that is no name of the
/// template's own.
QStringList Unexplained(Editor& editor) {
  const QStringList ownNames = {"Fish", "Pike", "Fish_m", "Pike_m", "S", "k", "f"};
  QStringList missing;
  QList<CElementForm*> forms = editor.View().Form()->findChildren<CElementForm*>();
  if (auto* whole = qobject_cast<CElementForm*>(editor.View().Form())) forms.append(whole);
  for (const CElementForm* form : forms) {
    for (const auto* label : form->findChildren<QLabel*>()) {
      const auto* line = qobject_cast<const QLineEdit*>(label->buddy());
      const bool isCount = line != nullptr && line->isReadOnly() && line->accessibleDescription().isEmpty();
      if (label->buddy() != nullptr && !isCount && label->toolTip().isEmpty()) missing.append(label->text());
    }
    for (const auto* combo : form->findChildren<QComboBox*>()) {
      for (int entry = 0; entry < combo->count(); ++entry) {
        const QString word = combo->itemText(entry);
        if (ownNames.contains(word)) continue;
        const QString tip = combo->itemData(entry, Qt::ToolTipRole).toString();
        const bool isShown = entry == combo->currentIndex();
        if (tip.isEmpty() || (isShown && !combo->toolTip().contains(word))) {
          missing.append(combo->accessibleName() + u' ' + word);
        }
      }
    }
  }
  return missing;
}

TEST(Forms, ExplainTheirFieldsAndTheWordsThatTheyOffer) {
  Editor editor(test::ModelText(kAllKinds));
  editor.Core().SetShowAllBuiltIns(true);
  int choices = 0;
  for (const Path& path : AllNodes(*editor.Tree().RootItem())) {
    editor.Tree().setCurrentItem(&NodeAt(editor, path));
    choices += static_cast<int>(editor.View().Form()->findChildren<QComboBox*>().size());
    EXPECT_EQ(Unexplained(editor), QStringList()) << editor.Selected().toStdString();
  }
  EXPECT_GE(choices, 50);
  // A search offers other words in each of its frameworks and purposes.
  editor.Select(QStringLiteral("Fish_s"));
  for (const char* framework : {"LAGRANGE", "EULER"}) {
    editor.Choose(QStringLiteral("Framework"), framework);
    for (const QString& purpose : Editor::Offered(editor.Field<QComboBox>(QStringLiteral("Purpose")))) {
      editor.Choose(QStringLiteral("Purpose"), purpose);
      EXPECT_EQ(Unexplained(editor), QStringList()) << framework << " " << purpose.toStdString();
    }
  }
}

class Sweep : public testing::TestWithParam<const char*> {};

TEST_P(Sweep, EveryFieldOfEveryFormIsStoredAndComesBackFromTheFile) {
  const std::string name = GetParam();
  SweepTemplate(name == "all_kinds" ? test::ModelText(kAllKinds)
                                    : test::ReadFile(TESSAL_SOURCE_DIR "/examples/" + name + ".tessal"));
}

INSTANTIATE_TEST_SUITE_P(Editor, Sweep,
                         testing::Values("asm1", "eutrophication", "fasham", "faults", "fish_larvae",
                                         "lake_management", "streeter_phelps", "all_kinds"),
                         [](const auto& file) { return file.param; });

}  // namespace
}  // namespace tessal
