// What no line of a file of cases can say: enormous texts, colours, dialogs that wait, and a system that
// opens documents.
#include <gtest/gtest.h>

#include <QClipboard>
#include <QLabel>
#include <QMimeData>
#include <QPushButton>
#include <QRadioButton>
#include <QSplitter>
#include <QTest>
#include <QTimer>
#include <filesystem>
#include <map>
#include <set>

#include "support/case_file.h"
#include "ui/auto_create_dialog.h"
#include "ui/documentation_link.h"
#include "ui/editor.h"
#include "ui/element_form.h"
#include "ui/expression_colours.h"

namespace tessal {
namespace {

using test::Editor;
using test::ModelText;

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
  Editor editor(ModelText("small"));
  CEL_Auxilliary_Variable& auxiliary = editor.Core().GetAuxiliary(0);
  const QString enormous(1 << 20, u'1');
  editor.Select("a");
  for (const char* label : {"Online help", "Description", "Expression"}) Paste(editor.Field(label), enormous);
  editor.View().OnCommit();
  for (const CEL_Property* text : {&auxiliary.onlineHelp, &auxiliary.description, &auxiliary.expression}) {
    EXPECT_EQ(text->Text(), std::string(4096, '1'));
  }
  Paste(editor.Field("Description"), QStringLiteral("two\nlines") + QChar(u'\0') + u'!');
  Paste(editor.Field("Expression"), QStringLiteral("k\n + f"));
  editor.View().OnCommit();
  EXPECT_EQ(auxiliary.description.Text(), "two\nlines!");
  EXPECT_EQ(auxiliary.expression.Text(), "k\n + f");
  // A full field takes nothing more, wherever it is typed.
  Paste(editor.Field("Description"), enormous);
  auto& full = editor.Field<CPlainTextField>("Description");
  full.moveCursor(QTextCursor::Start);
  QTest::keyClicks(&full, "22");
  EXPECT_EQ(full.ContentText(), QString(4096, u'1'));
}

TEST(Texts, BeyondTheLimitStayAsTheFileHasThem) {
  const std::string longText(5000, 'x');
  Editor editor(
      ModelText("constant long 1 | DESCRIPTION=|" + longText + "|; ONLINE_HELP=|" + longText + "|"));
  editor.Select("long");
  editor.Type("Unit", "kg");
  editor.LeaveField();
  const CEL_Constant& constant = editor.Core().GetConstant(0);
  EXPECT_EQ(constant.unit.Text(), "kg");
  EXPECT_EQ(constant.description.Text(), longText);
  EXPECT_EQ(constant.onlineHelp.Text(), longText);
}

TEST(Forms, ShareTheirHeightBetweenExpressionsAndBoxTheirCounts) {
  constexpr FormField kFields[] = {
      {.control = 1114,
       .label = "Direction",
       .editor = FieldEditor::Expression,
       .property = [](CEL_Element& element) -> CEL_Property& { return element.description; },
       .keypad = 1019},
      {.control = 1116,
       .label = "Speed",
       .editor = FieldEditor::Expression,
       .property = [](CEL_Element& element) -> CEL_Property& { return element.onlineHelp; },
       .keypad = 1034},
      {.control = 1096,
       .label = "Letters",
       .editor = FieldEditor::Count,
       .property = nullptr,
       .count = [](const CEL_Element& element) { return element.description.Text().size(); }},
  };
  Editor editor(ModelText("constant k 1 | DESCRIPTION=|1+2|"));
  CItemData item = CElementTree::DataOf(*editor.Node("k"));
  CElementForm form(kFields, {editor.Document(), editor.User(), item}, nullptr);
  constexpr QSize kSize(500, 400);
  form.resize(kSize);
  form.show();
  form.Load();
  EXPECT_TRUE(QTest::qWaitForWindowExposed(&form));
  const QList<int> heights = form.findChild<QSplitter*>("Split")->sizes();
  EXPECT_LE(std::abs(heights.at(0) - heights.at(1)), 1);
  EXPECT_TRUE(form.findChild<QPushButton*>("1019") != nullptr &&
              form.findChild<QPushButton*>("1034") != nullptr);
  auto* count = form.findChild<QWidget*>("1102")->findChild<QLineEdit*>("1096");
  EXPECT_EQ(count->text(), "3");
  EXPECT_TRUE(count->isReadOnly());
  form.findChild<CAutoRichEditCtrl*>("1114")->setPlainText("k");
  form.findChild<CAutoRichEditCtrl*>("1116")->setPlainText("k+k");
  form.Commit();
  EXPECT_EQ(editor.Core().GetConstant(0).description.Text(), "k");
  EXPECT_EQ(editor.Core().GetConstant(0).onlineHelp.Text(), "k+k");
  EXPECT_EQ(count->text(), "1");
}

TEST(Forms, AreWalkedWithTabUpToTheMessagesAndHaveAKeyForEachField) {
  Editor editor(test::ReadFile(TESSAL_SOURCE_DIR "/examples/fish_larvae.tessal"));
  editor.User().answers = {Answer::NoToAll};
  // What a window of 800 by 600 leaves under its menus.
  constexpr QSize kSmallScreen(800, 525);
  editor.View().resize(kSmallScreen);
  std::set<ElementKind> kinds;
  for (QTreeWidgetItemIterator item(&editor.Tree()); *item != nullptr; ++item) {
    if (!kinds.insert(CElementTree::DataOf(**item).kind).second) continue;
    editor.Tree().setCurrentItem(*item);
    // One column, and two again.
    for (const QSize size : {QSize(500, 400), kSmallScreen}) {
      editor.View().resize(size);
      QCoreApplication::processEvents();
    }
    QCoreApplication::processEvents();
    editor.Tree().setFocus();
    for (const auto* field : editor.View().Form()->findChildren<CAutoRichEditCtrl*>()) {
      if (field->isReadOnly()) continue;
      EXPECT_EQ(field->visibleRegion().boundingRect(), field->rect())
          << (*item)->text(0).toStdString() << " is seen only after scrolling";
    }
    QStringList stops;
    constexpr int kMostStops = 40;
    while (stops.size() < kMostStops && !editor.View().ErrorList().hasFocus()) {
      QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
      const QWidget* stop = QApplication::focusWidget();
      EXPECT_FALSE(stop->accessibleName().isEmpty()) << stop->metaObject()->className();
      stops.append(stop->accessibleName());
    }
    EXPECT_LT(stops.size(), kMostStops)
        << (*item)->text(0).toStdString() << ": " << stops.join(u'|').toStdString();
    EXPECT_EQ(stops.removeDuplicates(), 0) << (*item)->text(0).toStdString();
    std::set<QKeySequence> keys = {QKeySequence("Alt+F"), QKeySequence("Alt+H"), QKeySequence("Alt+V")};
    for (const QLabel* label : editor.View().Form()->findChildren<QLabel*>()) {
      if (label->buddy() == nullptr) continue;
      EXPECT_TRUE(keys.insert(QKeySequence::mnemonic(label->text())).second) << label->text().toStdString();
      EXPECT_EQ(QString(label->text()).remove(u'&'), label->buddy()->accessibleName());
    }
    for (qsizetype left = stops.size(); left > 0; --left)
      QTest::keyClick(QApplication::focusWidget(), Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_TRUE(editor.Tree().hasFocus()) << (*item)->text(0).toStdString();
  }
}

TEST(Colours, StayReadableOnADarkGround) {
  const QColor dark(30, 30, 30);
  for (const QRgb given :
       {qRgb(0, 0, 255), qRgb(0, 0, 0), qRgb(64, 64, 64), qRgb(0, 155, 0), qRgb(255, 0, 0)}) {
    EXPECT_EQ(ReadableColour(QColor(given), Qt::white), QColor(given)) << "unchanged on a light ground";
    EXPECT_GE(ReadableColour(QColor(given), dark).lightness(), 150);
  }
}

TEST(AutoCreate, GivesTheTickedKindOnOkOnly) {
  for (const auto& [caption, chosen] : std::map<QString, int>{{"OK", 6}, {"Skip", -1}, {"", -1}}) {
    CAutoCreateDlg dialog("rate", 486, nullptr);
    dialog.Radios()[6]->click();
    for (QPushButton* button : dialog.findChildren<QPushButton*>()) {
      if (button->text().remove(u'&') == caption) button->click();
    }
    if (caption.isEmpty()) dialog.accept();
    EXPECT_EQ(dialog.ChosenIndex(), chosen) << caption.toStdString();
  }
}

TEST(Questions, AreNotAnsweredByEscapeOrTheCloseButton) {
  struct Row {
    Answer (UserDialogs::*ask)(QWidget* parent, const QString& question);
    QString action;
    Answer answer;
  };
  const Row rows[] = {{&UserDialogs::Ask, "&Yes", Answer::Yes},
                      {&UserDialogs::Ask, "&No", Answer::No},
                      {&UserDialogs::Ask, "Escape", Answer::Cancelled},
                      {&UserDialogs::Ask, "close", Answer::Cancelled},
                      {&UserDialogs::AskOneOfMany, "N&o to All", Answer::NoToAll},
                      {&UserDialogs::AskOneOfMany, "close", Answer::Cancelled}};
  for (const Row& row : rows) {
    QTimer::singleShot(0, qApp, [&row] {
      QWidget* box = QApplication::activeModalWidget();
      const auto buttons = box->findChildren<QPushButton*>();
      for (QPushButton* button : buttons) {
        if (button->text() == row.action) return button->click();
      }
      if (row.action == "close") return static_cast<void>(box->close());
      QTest::keyClick(buttons.first(), Qt::Key_Escape);
    });
    EXPECT_EQ((ScreenDialogs().*row.ask)(nullptr, "Really?"), row.answer) << row.action.toStdString();
  }
}

TEST(History, KeepsThirtyNodesNewestFirst) {
  CNavigationHistory history;
  EXPECT_EQ(history.Back(), Uid::None) << "an empty list finds nothing";
  EXPECT_EQ(history.Position(), -1);
  for (std::int32_t id = 1; id <= 31; ++id) history.Add(Uid{id}, std::to_string(id));
  EXPECT_EQ(history.Entries().size(), 30U);
  EXPECT_EQ(history.Entries().front().id, Uid{31});
  EXPECT_EQ(history.Entries().back().id, Uid{2}) << "the oldest went";
  for (int step = 0; step < 40; ++step) history.Back();
  EXPECT_EQ(history.Position(), 29);
  history.Add(Uid{99}, "99");
  EXPECT_EQ(history.Entries().back().id, Uid{99}) << "entered before the present one, which made it the 31st";
}

TEST(Documentation, IsLookedForInThreePlaces) {
  test::ScriptedUser user;
  const test::TemporaryFolder root;
  const std::string folder = "Corvane/Manuals/CORVANE";
  std::filesystem::create_directories(root.Path() / folder);
  user.openable = {"here.pdf", QString::fromStdString(root.Write(folder + "/there.pdf", "x")),
                   "http://manuals.example/2017/General/known.pdf"};
  qputenv("TESSAL_INSTALL_ROOT", root.Path().string().c_str());
  QString text;
  for (const QString name : {"", "here.pdf", "there.pdf", "gone.pdf", "docs/known.pdf", "docs\\gone.pdf"}) {
    qputenv("TESSAL_MANUALS_URI", name.startsWith("docs") ? "http://manuals.example" : "");
    const QString failure = OpenDocumentationFile(name, user);
    text += "== " + name + '\n' + user.TakeLog().join(u'\n') + '\n' + failure + '\n';
  }
  qunsetenv("TESSAL_MANUALS_URI");
  qunsetenv("TESSAL_INSTALL_ROOT");
  text.replace(QString::fromStdString(root.Path().string()), "ROOT");
  test::ExpectListing("ui/cases/documentation.txt", text.toStdString());
}

}  // namespace
}  // namespace tessal
