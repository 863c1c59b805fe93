// What no line of a file of cases can say: enormous texts, colours, dialogs that wait, and a system that
// opens documents.
#include <gtest/gtest.h>

#include <QClipboard>
#include <QDir>
#include <QLabel>
#include <QMimeData>
#include <QPushButton>
#include <QRadioButton>
#include <QRegularExpression>
#include <QSplitter>
#include <QTest>
#include <QTextBlock>
#include <QTextBrowser>
#include <QTextLayout>
#include <QTimer>
#include <filesystem>
#include <map>
#include <set>

#include "elements/external_function.h"
#include "support/case_file.h"
#include "ui/account_strip.h"
#include "ui/auto_create_dialog.h"
#include "ui/documentation_link.h"
#include "ui/editor.h"
#include "ui/element_form.h"
#include "ui/expression_colours.h"
#include "ui/function_tips.h"
#include "ui/help_window.h"
#include "ui/icons.h"
#include "ui/main_view.h"
#include "ui/node_kinds.h"

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

TEST(Account, IsShownUntilWhatWasPassedOverIsRead) {
  Editor editor(ModelText("constant kp 7 | -UNIT; COLOUR='red'"));
  CAccountStrip& strip = editor.View().AccountStrip();
  const auto text = [&strip] { return strip.findChild<QLabel*>()->text(); };
  const auto button = [&strip](const QString& caption) {
    for (QPushButton* each : strip.findChildren<QPushButton*>()) {
      if (each->text().remove(u'&') == caption) return each;
    }
    return static_cast<QPushButton*>(nullptr);
  };
  ASSERT_TRUE(strip.isVisibleTo(&editor.View()));
  EXPECT_EQ(
      text(),
      "3 values of this file could not be read. 1 part of this file will not be kept as it is by a save.");
  editor.User().TakeLog();
  button("Details")->click();
  EXPECT_TRUE(editor.User().TakeLog().value(0).contains("DEFAULT_VALUE = 7 of kp was not read"));
  button("Read Them")->click();
  EXPECT_EQ(text(), "1 part of this file will not be kept as it is by a save.");
  EXPECT_FALSE(button("Read Them")->isVisibleTo(&strip));
  EXPECT_EQ(editor.Core().GetConstant(0).defaultValue.RealValue(), 7.0);
  EXPECT_TRUE(editor.Document().IsModified());
  ASSERT_TRUE(editor.Document().OnSaveDocument(editor.Path()));
  editor.View().OnActivate();
  EXPECT_FALSE(strip.isVisibleTo(&editor.View())) << "the file holds what the template does";
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

/// One form of each kind of node of an example.
void WalkForms(const std::string& example) {
  Editor editor(test::ReadFile(TESSAL_SOURCE_DIR "/examples/" + example + ".tessal"));
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
      // Who sees a button and who hears it give it the same name, but for signs such as "...".
      const auto* button = qobject_cast<const QAbstractButton*>(stop);
      if (button != nullptr && button->text().contains(QRegularExpression(QStringLiteral("\\w")))) {
        EXPECT_TRUE(stop->accessibleName().startsWith(button->text().remove(u'&')))
            << stop->accessibleName().toStdString();
      }
      stops.append(stop->accessibleName());
    }
    EXPECT_LT(stops.size(), kMostStops)
        << (*item)->text(0).toStdString() << ": " << stops.join(u'|').toStdString();
    EXPECT_EQ(stops.removeDuplicates(), 0) << (*item)->text(0).toStdString();
    std::set<QKeySequence> keys;
    for (const char* menu : {"Alt+F", "Alt+E", "Alt+G", "Alt+V", "Alt+H"}) keys.insert(QKeySequence(menu));
    for (const QLabel* label : editor.View().Form()->findChildren<QLabel*>()) {
      if (label->buddy() == nullptr) continue;
      EXPECT_TRUE(keys.insert(QKeySequence::mnemonic(label->text())).second) << label->text().toStdString();
      EXPECT_TRUE(label->buddy()->accessibleName().startsWith(QString(label->text()).remove(u'&')));
    }
    for (qsizetype left = stops.size(); left > 0; --left)
      QTest::keyClick(QApplication::focusWidget(), Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_TRUE(editor.Tree().hasFocus()) << (*item)->text(0).toStdString();
  }
}

TEST(Forms, AreWalkedWithTabUpToTheMessagesAndHaveAKeyForEachField) {
  WalkForms("fish_larvae");
  WalkForms("lake_management");
}

TEST(Colours, StayReadableOnADarkGround) {
  const QColor dark(30, 30, 30);
  for (const QRgb given :
       {qRgb(0, 0, 255), qRgb(0, 0, 0), qRgb(64, 64, 64), qRgb(0, 155, 0), qRgb(255, 0, 0)}) {
    EXPECT_EQ(ReadableColour(QColor(given), Qt::white), QColor(given)) << "unchanged on a light ground";
    EXPECT_GE(ReadableColour(QColor(given), dark).lightness(), 150);
  }
}

TEST(Colours, AreStrongOnAnyGroundOnRequest) {
  EXPECT_DOUBLE_EQ(ContrastRatio(Qt::black, Qt::white), 21.0);
  EXPECT_NEAR(ContrastRatio(QColor(119, 119, 119), Qt::white), 4.478, 0.001);
  constexpr int kStep = 51;
  for (const QRgb ground : {qRgb(255, 255, 255), qRgb(239, 239, 239), qRgb(0, 0, 0), qRgb(35, 38, 41),
                            qRgb(118, 118, 118), qRgb(128, 90, 150)}) {
    for (int rgb = 0; rgb < 216; ++rgb) {
      const QColor given(rgb / 36 * kStep, rgb / 6 % 6 * kStep, rgb % 6 * kStep);
      const QColor strong = StrongColour(given, ground);
      EXPECT_GE(ContrastRatio(strong, ground), kStrongContrast)
          << given.name().toStdString() << " on " << QColor(ground).name().toStdString();
      if (ContrastRatio(given, ground) >= kStrongContrast) {
        EXPECT_EQ(strong, given) << "left as it is";
      }
    }
  }
}

/// The colours of all words that a field shows.
std::set<QRgb> ColoursOf(const QTextEdit& field) {
  std::set<QRgb> colours;
  for (const auto& part : field.document()->firstBlock().layout()->formats())
    colours.insert(part.format.foreground().color().rgb());
  return colours;
}

TEST(Colours, ChangeInAllFieldsAtOnce) {
  Editor editor(ModelText("small"));
  editor.Select("a");
  auto& field = editor.Field<CAutoRichEditCtrl>("Expression");
  const std::set<QRgb> usual = ColoursOf(field);
  UseStrongColours(true);
  for (const QRgb colour : ColoursOf(field))
    EXPECT_GE(ContrastRatio(QColor(colour), Qt::white), kStrongContrast);
  EXPECT_NE(ColoursOf(field), usual);
  UseStrongColours(false);
  EXPECT_EQ(ColoursOf(field), usual);
}

TEST(Tips, NumberTheArgumentsOfAUserFunction) {
  TemplateCore core;
  CEL_ExternalFunction& function = core.GetMisc()->AddExternalFunction();
  function.publicName.SetText("mine");
  function.parameters.SetInt(2);
  EXPECT_EQ(TipOfCall(core, "mine", 1), "mine(argument 1, <b>argument 2</b>)");
  function.parameters.SetInt(-1);
  EXPECT_EQ(TipOfCall(core, "mine", 0), "mine()");
  EXPECT_EQ(TipOfCall(core, "Mine", 0), "") << "its case counts";
}

TEST(Icons, AreAllDrawnAndAllDifferent) {
  std::vector<std::pair<QIcon, std::string>> icons;
  for (ElementKind kind = ElementKind::None; kind <= node_kind::kPluginFunctions; kind = KindAfter(kind, 1)) {
    if (kind != ElementKind::Unknown && NodeRowOfElements(kind).kind == kind)
      icons.emplace_back(IconOfKind(kind), "kind " + std::to_string(NumberOf(kind)));
  }
  for (int command = 0; command <= static_cast<int>(IconCommand::History); ++command)
    icons.emplace_back(IconOfCommand(IconCommand{command}), "command " + std::to_string(command));
  for (std::uint32_t level = 1; level <= 4; ++level)
    icons.emplace_back(IconOfLevel(level), "level " + std::to_string(level));
  std::map<QByteArray, std::string> seen;
  for (const auto& [icon, name] : icons) {
    const QImage drawn = icon.pixmap(QSize(16, 16), 1.0).toImage();
    const QByteArray pixels(reinterpret_cast<const char*>(drawn.constBits()), drawn.sizeInBytes());
    EXPECT_GT(std::set<char>(pixels.begin(), pixels.end()).size(), 2U) << name << " is empty";
    EXPECT_TRUE(seen.emplace(pixels, name).second) << name << " looks like " << seen[pixels];
  }
  EXPECT_TRUE(IconOfLevel(0).isNull() && IconOfLevel(5).isNull());
}

TEST(Icons, OfCommandsFollowThePalette) {
  const QIcon icon = IconOfCommand(IconCommand::New);
  const auto middle = [&icon] { return icon.pixmap(QSize(16, 16), 1.0).toImage().pixelColor(8, 8); };
  const QPalette former = QApplication::palette();
  QApplication::setPalette(QPalette(QColor(40, 40, 40)));
  EXPECT_GT(middle().lightness(), 200);
  QApplication::setPalette(QPalette(QColor(240, 240, 240)));
  EXPECT_LT(middle().lightness(), 50);
  QApplication::setPalette(former);
}

TEST(Messages, LeaveTheirTextTwoThirdsOfTheList) {
  const std::string longName(300, 'x');
  Editor editor(ModelText("constant " + longName + " -1"));
  const CErrorList& list = editor.View().ErrorList();
  EXPECT_LE(list.columnWidth(0), list.viewport()->width() / 3);
  EXPECT_EQ(list.columnWidth(0) + list.columnWidth(1), list.viewport()->width())
      << "no scrolling to the side";
  EXPECT_TRUE(list.topLevelItem(0)->toolTip(0).contains(QString::fromStdString(longName)));
}

TEST(Tree, FindsNodesThatComeAndGo) {
  Editor editor(ModelText("small\nsettings"));
  const Uid gone = editor.IdOf("k");
  editor.Select("f");
  const NumberHint hideMisc(0);
  const NumberHint showMisc(1);
  editor.Document().UpdateAllViews(nullptr, hint::kShowMisc, &hideMisc);
  EXPECT_EQ(editor.Tree().FindById(folder_id::kVisibilityGroups), nullptr) << "went with its branch";
  editor.Document().UpdateAllViews(nullptr, hint::kShowMisc, &showMisc);
  EXPECT_EQ(editor.Tree().FindById(folder_id::kMiscellaneous), editor.Node("Miscellaneous"));
  const NumberHint removed(NumberOf(gone));
  editor.Document().UpdateAllViews(nullptr, hint::kDeleteItem, &removed);
  EXPECT_EQ(editor.Tree().FindById(gone), nullptr);
  for (QTreeWidgetItemIterator item(&editor.Tree()); *item != nullptr; ++item)
    EXPECT_EQ(editor.Tree().FindById(CElementTree::DataOf(**item).id), *item);
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
                      {&UserDialogs::AskOneOfMany, "close", Answer::Cancelled},
                      {&UserDialogs::AskToReplace, "&Yes", Answer::Yes},
                      {&UserDialogs::AskToReplace, "&Leave Longer Names Alone", Answer::WholeNames},
                      {&UserDialogs::AskToReplace, "Escape", Answer::Cancelled}};
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

TEST(Documentation, NoProgramIsStartedAndNothingUnusualOpensWithoutAQuestion) {
  test::ScriptedUser user;
  const test::TemporaryFolder folder;
  const QString place = QString::fromStdString(folder.Path().string());
  for (const char* name : {"model.pdf", "run.pdf", "tool.desktop", "data.xyz"}) folder.Write(name, "x");
  std::filesystem::permissions(folder.File("run.pdf"), std::filesystem::perms::owner_all);
  std::filesystem::create_symlink("run.pdf", folder.File("link.pdf"));
  std::filesystem::create_symlink("tool.desktop", folder.File("other.pdf"));
  QString text;
  for (const QString name :
       {"model.pdf", "https://example.org/a?b", "run.pdf", "link.pdf", "tool.desktop", "other.pdf", ".",
        "data.xyz", "mailto:all@example.org", "file:///bin/sh", "smb://host/share/x.pdf"}) {
    user.answers = {Answer::No};
    const QString failure = OpenDocumentationFile(name, user, place);
    text += "== " + name + '\n' + user.TakeLog().join(u'\n') + '\n' + failure.section(u'\n', 0, 0) + '\n';
  }
  text.replace(place, "FOLDER");
  test::ExpectListing("ui/cases/documentation_trust.txt", text.toStdString());
}

TEST(Help, IsNotTakenFromTheCurrentFolder) {
  const test::TemporaryFolder folder;
  const QString page = QString::fromStdString(folder.Write("TessalOnline.html", "<p>not ours</p>"));
  const QString former = QDir::currentPath();
  QDir::setCurrent(QString::fromStdString(folder.Path().string()));
  for (const QString unknown : {"", "."}) {
    EXPECT_EQ(FindHelpPage(unknown), "");
  }
  EXPECT_EQ(FindHelpPage(QDir::currentPath()), page);
  QDir::setCurrent(former);
}

TEST(Help, OpensTheReferenceAtAName) {
  QWidget owner;
  const std::pair<const char*, const char*> cases[] = {
      {"sinh", "SINH(x)"}, {"Temperature", "TEMPERATURE"}, {"GET_HSO4", "GET_HSO4("}, {"XPOS", "XPOS"},
      {"", "Functions"},   {"nobody", "Functions"}};
  for (const auto& [name, heading] : cases) {
    OpenReference(&owner, QString::fromLatin1(name));
    const auto* window = owner.findChild<QTextBrowser*>(QStringLiteral("help"));
    ASSERT_NE(window, nullptr);
    const auto isAtTop = [window, start = QString::fromLatin1(heading)] {
      const QTextBlock top = window->cursorForPosition({0, 0}).block();
      return top.text().startsWith(start) || top.next().text().startsWith(start);
    };
    EXPECT_TRUE(QTest::qWaitFor(isAtTop, 1000))
        << name << " shows " << window->cursorForPosition({0, 0}).block().text().toStdString();
  }
}

}  // namespace
}  // namespace tessal
