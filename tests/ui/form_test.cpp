// The forms: when the template is written, what is asked meanwhile, and what the fields show afterwards.
#include <gtest/gtest.h>

#include <QClipboard>
#include <QMimeData>
#include <QTest>
#include <filesystem>
#include <memory>

#include "core/error_registry.h"
#include "support/template_text.h"
#include "ui/documentation_link.h"
#include "ui/editor.h"
#include "ui/text_bytes.h"

namespace tessal {
namespace {

using test::Editor;
using test::SmallModel;
using test::TemplateText;

constexpr int kSymbol = 1097;
constexpr int kDescription = 1074;
constexpr int kOnlineHelp = 1083;
constexpr int kDocumentation = 1076;
constexpr int kScope = 1055;
constexpr int kSpatial = 1056;
constexpr int kUnit = 1079;
constexpr int kUnitType = 1045;
constexpr int kDefault = 1071;
constexpr int kMinimum = 1085;
constexpr int kExpression = 1115;
constexpr int kReferencedIn = 1094;

TEST(Commit, ComesWithTheLossOfFocusAndNotBefore) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  CEL_Constant& constant = editor.Core().GetConstant(0);
  editor.Select("k");
  editor.Type(kDescription, "Rate");
  EXPECT_EQ(constant.description.Text(), "");
  EXPECT_FALSE(editor.Document().IsModified());
  editor.Field<QWidget>(kOnlineHelp).setFocus();
  EXPECT_EQ(constant.description.Text(), "Rate");
  EXPECT_TRUE(editor.Document().IsModified());
  EXPECT_EQ(editor.Document().Title(), "model.tessal - Modified");

  editor.Type(kOnlineHelp, "  of decay ");
  QTest::keyClick(&editor.Field<QLineEdit>(kOnlineHelp), Qt::Key_Return);
  EXPECT_EQ(constant.onlineHelp.Text(), "of decay");
  EXPECT_EQ(editor.Text(kOnlineHelp), "of decay") << "the form shows what the template holds";

  // The messages follow each commit.
  editor.Enter(kDefault, "-3");
  EXPECT_EQ(editor.Rows(), QStringList{"k: Warning: The (default) value is lower than the minimum!"});
  editor.Enter(kMinimum, "-5");
  EXPECT_TRUE(editor.Rows().isEmpty());
}

TEST(Commit, AnExpressionWaitsForAnotherReason) {
  Editor editor(SmallModel().Constant("k2").Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("a");
  editor.Enter(kExpression, "k*k2");
  EXPECT_EQ(editor.Core().GetAuxiliary(0).expression.Text(), "k*f") << "leaving the field is none";
  editor.Choose(1050, "NO");
  EXPECT_EQ(editor.Core().GetAuxiliary(0).expression.Text(), "k*k2");
  editor.Type(kExpression, "f+k2");
  editor.Tree().setCurrentItem(editor.Node("Constants"));
  EXPECT_EQ(editor.Core().GetAuxiliary(0).expression.Text(), "f+k2");
  editor.Select("a");
  editor.Type(kExpression, "k");
  editor.View().OnCommit();
  EXPECT_EQ(editor.Core().GetAuxiliary(0).expression.Text(), "k")
      << "a save takes along what is being entered";
}

TEST(Commit, LookingAtEveryNodeChangesNothing) {
  for (const auto& entry : std::filesystem::directory_iterator(TESSAL_SOURCE_DIR "/examples")) {
    if (entry.path().extension() != ".tessal") continue;
    Editor editor(test::ReadFile(entry.path().string()));
    ASSERT_TRUE(editor.IsOpen()) << entry.path();
    // The names that a template leaves undefined are asked about once, and here with No.
    editor.User().answers.assign(editor.Core().UndefinedSymbols().size(), false);
    for (QTreeWidgetItemIterator item(&editor.Tree()); *item != nullptr; ++item) {
      editor.Tree().setCurrentItem(*item);
      ASSERT_FALSE(editor.Core().Modified()) << entry.path() << (*item)->text(0).toStdString();
      for (QWidget* field : editor.View().Form()->findChildren<QWidget*>()) field->setFocus();
    }
    editor.View().OnCommit();
    EXPECT_FALSE(editor.Document().IsModified()) << entry.path();
  }
}

TEST(Rename, AsksAndRefusesInItsOrder) {
  struct Row {
    const char* node;
    const char* entered;
    bool answer;
    QStringList log;
    const char* symbol;
    const char* expression;  // of the auxiliary that uses the constant
  };
  const Row rows[] = {
      {"k", "1k", true, {"'1k' is not a valid identifier!"}, "k", "k*f"},
      {"k", "IF", true, {"'IF' is invalid because it is an Tessal keyword!"}, "k", "k*f"},
      {"k", "a", true, {"An item with the name 'a' already exists!"}, "k", "k*f"},
      {"k", "  decay ", true, {"Replace all occurence of 'k' with 'decay'?"}, "decay", "decay*f"},
      {"k", " k  ", true, {}, "k", "k*f"},
      {"spare", "other", true, {}, "other", "k*f"},
  };
  for (const Row& row : rows) {
    Editor editor(SmallModel().Constant("spare").Text());
    ASSERT_TRUE(editor.IsOpen());
    editor.Select(row.node);
    editor.Enter(kSymbol, row.entered);
    EXPECT_EQ(editor.User().TakeLog(), row.log) << row.entered;
    EXPECT_EQ(editor.Text(kSymbol), row.symbol);
    EXPECT_EQ(editor.Selected(), row.symbol) << "the tree follows";
    EXPECT_EQ(editor.Core().GetAuxiliary(0).expression.Text(), row.expression);
  }
}

TEST(Rename, WithoutItsUsesLeavesThemUndefined) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("k");
  editor.User().answers = {false, false};
  editor.Enter(kSymbol, "decay");
  EXPECT_EQ(editor.User().TakeLog(),
            (QStringList{"Replace all occurence of 'k' with 'decay'?",
                         "There are undefined symbols!\n\nDo you want to create symbol 'k' ?"}));
  EXPECT_EQ(editor.Rows(), QStringList{"a: Undefined symbol k"});
}

TEST(Rename, WritesNothingElse) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("k");
  auto& symbol = editor.Field<QLineEdit>(kSymbol);
  symbol.setText("decay");
  editor.Type(kDescription, "lost");
  editor.LeaveField();
  EXPECT_EQ(editor.Core().GetConstant(0).symbol.Text(), "decay");
  EXPECT_EQ(editor.Core().GetConstant(0).description.Text(), "");
  EXPECT_EQ(editor.Text(kDescription), "");
}

TEST(Undefined, AsksOnceInTheOrderOfAppearance) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("a");
  editor.Type(kExpression, "one+two+three");
  editor.User().answers = {false, true, true};
  constexpr int kConstantChoice = 1;
  editor.User().choices = {kConstantChoice, -1};
  editor.View().OnCommit();
  const QString question = "There are undefined symbols!\n\nDo you want to create symbol '%1' ?";
  EXPECT_EQ(editor.User().TakeLog(),
            (QStringList{question.arg("one"), question.arg("two"), "kind of two in 15", question.arg("three"),
                         "kind of three in 15"}));
  EXPECT_EQ(editor.Children("Constants"), (QStringList{"k", "*two"}));
  EXPECT_EQ(editor.Text(kExpression), "one+two+three");
  EXPECT_EQ(editor.Rows(), (QStringList{"a: Undefined symbol one", "a: Undefined symbol three"}));
  editor.View().OnCommit();
  EXPECT_EQ(editor.User().TakeLog(), QStringList()) << "a name is asked about once";
}

TEST(Undefined, ParticleKindsGoIntoTheClassOfTheUser) {
  Editor editor(
      TemplateText().Specie("A", "A_up", {{"A_up", "1"}}).Specie("B", "B_up", {{"B_up", "B_rate"}}).Text());
  ASSERT_TRUE(editor.IsOpen());
  constexpr int kSpecieConstantChoice = 6;
  editor.User().choices = {kSpecieConstantChoice};
  editor.View().OnCommit();
  EXPECT_EQ(editor.User().TakeLog().last(), "kind of B_rate in 487");
  EXPECT_EQ(editor.Core().GetSpecie(0).constants.size(), 0U);
  ASSERT_EQ(editor.Core().GetSpecie(1).constants.size(), 1U);
  EXPECT_EQ(editor.Node("*B_rate")->parent()->parent()->text(0), "B");
}

TEST(Choice, ReachesTheTemplateAtOnceAndBringsWhatHangsOnIt) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("k");
  editor.Choose(kUnitType, "Process rate");
  EXPECT_EQ(editor.Text(kUnit), "/d");
  EXPECT_FALSE(editor.Field<QWidget>(kUnit).isEnabled()) << "a locked field is grey, with its text";
  editor.Choose(kUnitType, "User defined");
  EXPECT_TRUE(editor.Field<QWidget>(kUnit).isEnabled());

  // A built-in quantity brings its data and locks them.
  editor.Select("f");
  const QStringList builtIns = editor.Offered(1042);
  ASSERT_GT(builtIns.size(), 1);
  EXPECT_EQ(builtIns.front(), "User defined") << "this list keeps its own order";
  editor.Choose(1042, "RELATIVE_DEPTH");
  EXPECT_EQ(editor.Text(1062), "NO");
  EXPECT_EQ(editor.Text(kUnit), "()");
  EXPECT_EQ(editor.Text(kDefault), "-1");
  for (const int locked : {kScope, kSpatial, kUnit, kUnitType, kDefault, kMinimum, 1084}) {
    EXPECT_FALSE(editor.Field<QWidget>(locked).isEnabled()) << locked;
  }
  editor.Choose(1042, "User defined");
  EXPECT_TRUE(editor.Field<QWidget>(kUnit).isEnabled());
  EXPECT_EQ(editor.Text(kUnit), "()");

  // Other lists are sorted by caption.
  QStringList scopes = editor.Offered(kScope);
  QStringList sorted = scopes;
  sorted.sort();
  EXPECT_EQ(scopes, sorted);
}

TEST(Choice, ANewScopeBringsItsSpatialVariation) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("p");
  ASSERT_EQ(editor.Text(kSpatial), "HORIZONTAL_AND_VERTICAL");
  editor.Choose(kScope, "SED");
  EXPECT_EQ(editor.Text(kSpatial), "HORIZONTAL");
}

TEST(Numbers, AreReadByTheRulesOfFiles) {
  struct Row {
    const char* entered;
    double value;
    const char* shown;
  };
  constexpr Row kRows[] = {
      {"2.5", 2.5, "2.5"}, {"1e-3", 0.001, "0.001"}, {"+7", 7, "7"},  {"1,5", 1, "1"},
      {"abc", 0, "0"},     {"4 mg", 4, "4"},         {"nan", 9, "9"}, {"inf", 9, "9"},
      {"", 0, "0"},        {" 6 ", 6, "6"},          {"009", 9, "9"},
  };
  for (const Row& row : kRows) {
    Editor editor(SmallModel().Text());
    ASSERT_TRUE(editor.IsOpen());
    editor.Core().GetConstant(0).defaultValue.SetReal(9);
    editor.Select("k");
    editor.Enter(kDefault, row.entered);
    EXPECT_EQ(editor.Core().GetConstant(0).defaultValue.RealValue(), row.value) << row.entered;
    EXPECT_EQ(editor.Text(kDefault), row.shown) << row.entered;
  }
}

TEST(Texts, OfFilesStayToTheByteUnlessEdited) {
  const std::string longText(5000, 'x');
  const std::string western = "gr\xFCn und blau";
  Editor editor(SmallModel()
                    .Constant("long")
                    .With("DESCRIPTION", "|" + longText + "|")
                    .With("ONLINE_HELP", "|" + longText + "|")
                    .Constant("western")
                    .With("DESCRIPTION", "|" + western + "|")
                    .Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("long");
  editor.Enter(kUnit, "kg");
  EXPECT_EQ(editor.Core().GetConstant(1).description.Text(), longText);
  EXPECT_EQ(editor.Core().GetConstant(1).onlineHelp.Text(), longText);

  editor.Select("western");
  EXPECT_EQ(editor.Text(kDescription), QString::fromUtf8("gr\u00FCn und blau"));
  editor.Enter(kUnit, "kg");
  EXPECT_EQ(editor.Core().GetConstant(2).description.Text(), western);
  editor.Enter(kDescription, QString::fromUtf8("s\u00FC\u00DF"));
  EXPECT_EQ(editor.Core().GetConstant(2).description.Text(), "s\xFC\xDF")
      << "in the encoding of the text before";
}

void Paste(QWidget& field, const QString& plain) {
  auto mime = std::make_unique<QMimeData>();
  mime->setText(plain);
  mime->setHtml("<b>rich</b>");
  QApplication::clipboard()->setMimeData(mime.release());
  field.setFocus();
  QTest::keyClick(&field, Qt::Key_A, Qt::ControlModifier);
  QTest::keyClick(&field, Qt::Key_V, Qt::ControlModifier);
}

TEST(Texts, WhatIsPastedArrivesAsPlainTextWithinTheLimit) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  CEL_Auxilliary_Variable& auxiliary = editor.Core().GetAuxiliary(0);
  constexpr qsizetype kMegabyte = 1 << 20;
  const QString enormous(kMegabyte, u'1');
  editor.Select("a");
  for (const int field : {kOnlineHelp, kDescription, kExpression})
    Paste(editor.Field<QWidget>(field), enormous);
  editor.View().OnCommit();
  for (const CEL_Property* text : {&auxiliary.onlineHelp, &auxiliary.description, &auxiliary.expression}) {
    EXPECT_EQ(text->Text(), std::string(4096, '1'));
  }
  Paste(editor.Field<QWidget>(kDescription),
        QStringLiteral("two\nlines") + QChar(u'\0') + QStringLiteral("!"));
  Paste(editor.Field<QWidget>(kExpression), QStringLiteral("k\n + f"));
  editor.View().OnCommit();
  EXPECT_EQ(auxiliary.description.Text(), "two\nlines!");
  EXPECT_EQ(auxiliary.expression.Text(), "k\n + f");
  // A full field takes nothing more, wherever it is typed.
  Paste(editor.Field<QWidget>(kDescription), enormous);
  auto& full = editor.Field<CPlainTextField>(kDescription);
  full.moveCursor(QTextCursor::Start);
  QTest::keyClicks(&full, "22");
  EXPECT_EQ(full.ContentText(), QString(4096, u'1'));
}

TEST(ReferencedIn, NamesTheUsers) {
  Editor editor(SmallModel().DerivedOutput("k").Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("a");
  EXPECT_EQ(editor.Text(kReferencedIn), "p");
  editor.Select("S");
  EXPECT_EQ(editor.Text(kReferencedIn), "p");
  EXPECT_TRUE(editor.Field<CAutoRichEditCtrl>(kReferencedIn).isReadOnly());
  editor.Core().GetAuxiliary(0).expression.SetText("1");
  editor.Select("f");
  EXPECT_EQ(editor.Text(kReferencedIn), "Not used !");
}

TEST(Settings, ParticleFieldsAreOpenWithAParticleClass) {
  constexpr int kBearing = 1054;
  constexpr int kSearchTree = 1041;
  for (const bool particles : {false, true}) {
    TemplateText text = SmallModel().Misc("DOCUMENT_REVISION = 7\n");
    if (particles) text.Specie("Fish", "Fish_up", {{"Fish_up", "1"}});
    Editor editor(text.Text());
    ASSERT_TRUE(editor.IsOpen());
    editor.Select("Miscellaneous");
    EXPECT_EQ(editor.Field<QWidget>(kBearing).isEnabled(), particles);
    EXPECT_EQ(editor.Field<QWidget>(kSearchTree).isEnabled(), particles);
  }
  Editor editor(SmallModel().Misc("DOCUMENT_REVISION = 7\n").Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("Miscellaneous");
  EXPECT_EQ(editor.Text(1077), "2017.001");
  EXPECT_EQ(editor.Text(1098), "7");
  EXPECT_EQ(editor.Offered(1043).size(), 7);
  editor.Enter(1095, "99999999999");
  EXPECT_EQ(editor.Core().GetMisc()->randSeed.IntValue(), 2147483647);
  editor.Enter(1095, "42");
  EXPECT_EQ(editor.Core().GetMisc()->randSeed.IntValue(), 42);
  editor.Choose(1043, "Debug level 3");
  EXPECT_EQ(editor.Core().GetMisc()->debugLevel.IntValue(), 3);
  EXPECT_TRUE(editor.Document().IsModified());
}

TEST(Documentation, IsLookedForInThreePlaces) {
  test::ScriptedUser user;
  const test::TemporaryFolder root;
  std::filesystem::create_directories(root.Path() / "Corvane/Manuals/CORVANE");
  root.Write("Corvane/Manuals/CORVANE/there.pdf", "x");
  qputenv("TESSAL_INSTALL_ROOT", root.Path().string().c_str());
  const QString manual = QString::fromStdString(root.File("Corvane/Manuals/CORVANE/there.pdf"));

  EXPECT_EQ(OpenDocumentationFile("", user), "");
  EXPECT_EQ(user.TakeLog(), QStringList()) << "nothing happens without a name";
  user.openable = {"here.pdf", manual};
  EXPECT_EQ(OpenDocumentationFile("here.pdf", user), "");
  EXPECT_EQ(user.TakeLog(), QStringList{"open here.pdf"});
  EXPECT_EQ(OpenDocumentationFile("there.pdf", user), "");
  EXPECT_EQ(user.TakeLog(), (QStringList{"open there.pdf", "open " + manual}));
  EXPECT_EQ(OpenDocumentationFile("gone.pdf", user), "Failed to open\ngone.pdf\n\nReturn code -100 (0xff9c)");
  qputenv("TESSAL_MANUALS_URI", "http://manuals.example");
  const QString address = "http://manuals.example/2017/General/gone.pdf";
  user.TakeLog();
  EXPECT_EQ(OpenDocumentationFile("docs\\gone.pdf", user),
            "Failed to open\ndocs\\gone.pdf\n\nReturn code 2 (0x0002)");
  EXPECT_EQ(user.TakeLog().last(), "open " + address);
  user.openable.append(address);
  EXPECT_EQ(OpenDocumentationFile("docs/gone.pdf", user), "");
  qunsetenv("TESSAL_MANUALS_URI");
  qunsetenv("TESSAL_INSTALL_ROOT");
}

TEST(Documentation, AChosenFileWaitsForTheNextCommit) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("k");
  editor.User().documentationFile = "/docs/manual";
  QTest::mouseClick(&editor.Field<QWidget>(1021), Qt::LeftButton);
  EXPECT_EQ(editor.Text(kDocumentation), "/docs/manual.pdf");
  EXPECT_EQ(editor.Core().GetConstant(0).documentation.Text(), "");
  editor.View().OnCommit();
  EXPECT_EQ(editor.Core().GetConstant(0).documentation.Text(), "/docs/manual.pdf");
  QTest::mouseClick(&editor.Field<QWidget>(1129), Qt::LeftButton);
  EXPECT_EQ(editor.User().TakeLog(),
            (QStringList{"open /docs/manual.pdf",
                         "Failed to open\n/docs/manual.pdf\n\nReturn code -100 (0xff9c)"}));
}

TEST(Document, AsksBeforeItSavesMessagesOfItsOwn) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("k");
  editor.Enter(kDefault, "-1");
  editor.User().answers = {false};
  const std::string before = test::ReadFile(editor.Path());
  EXPECT_FALSE(editor.Document().OnSaveDocument(editor.Path()));
  EXPECT_EQ(editor.User().TakeLog(),
            QStringList{"This setup contains some errors or warnings.\nProceed anyway?"});
  EXPECT_EQ(test::ReadFile(editor.Path()), before);
  EXPECT_TRUE(editor.Document().IsModified());
  EXPECT_TRUE(editor.Document().OnSaveDocument(editor.Path()));
  EXPECT_FALSE(editor.Document().IsModified());

  // A save under a new name makes the settings, and the tree shows them.
  EXPECT_EQ(editor.Tree().FindById(folder_id::kMiscellaneous), nullptr);
  EXPECT_TRUE(editor.Document().OnSaveDocument(editor.Path() + "2.tessal"));
  EXPECT_NE(editor.Tree().FindById(folder_id::kMiscellaneous), nullptr);
}

}  // namespace
}  // namespace tessal
