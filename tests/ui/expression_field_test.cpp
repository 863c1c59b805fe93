// Expressions in colour, their links, and the dialogs beside the forms.
#include <gtest/gtest.h>

#include <QContextMenuEvent>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QTest>
#include <QTimer>

#include "support/template_text.h"
#include "ui/auto_create_dialog.h"
#include "ui/editor.h"
#include "ui/expression_colours.h"
#include "ui/expression_editor_dialog.h"

namespace tessal {
namespace {

using test::Editor;
using test::TemplateText;

constexpr int kExpression = 1115;

TemplateText Model() {
  TemplateText text;
  text.StateVariable("S", "p").Constant("k").With("DESCRIPTION", "'Rate <of> decay'").Forcing("f");
  text.Auxiliary("a", "k*f").Process("p", "a*S");
  return text;
}

/// The looks of the character at a place.
QTextCharFormat LooksAt(const QTextEdit& field, int place) {
  QTextCursor cursor(field.document());
  cursor.setPosition(place + 1);
  return cursor.charFormat();
}

TEST(Colours, TellWhatANameMeans) {
  Editor editor(Model().Text());
  ASSERT_TRUE(editor.IsOpen());
  struct Row {
    const char* text;
    int place;
    QRgb colour;
    bool bold;
    bool italic;
    bool link;
  };
  constexpr Row kRows[] = {
      {"k", 0, qRgb(230, 0, 230), true, false, true},
      {"1+f", 2, qRgb(230, 115, 0), true, false, true},
      {"a", 0, qRgb(0, 230, 0), true, false, true},
      {"p", 0, qRgb(0, 115, 230), true, false, true},
      {"S", 0, qRgb(0, 0, 255), true, false, true},
      {"sin(1)", 0, qRgb(0, 155, 0), true, true, false},
      {"kill", 0, qRgb(0, 155, 0), true, true, false},
      {"nobody", 0, qRgb(255, 0, 0), true, false, false},
      {"2.5e3", 0, qRgb(255, 0, 255), true, true, false},
      {"1+1", 1, qRgb(0, 0, 0), true, false, false},
      {"IF 1 THEN 2 ELSE 3", 0, qRgb(64, 64, 64), true, true, false},
      {"1/* two\nlines */+\nnobody", 18, qRgb(255, 0, 0), true, false, false},
  };
  editor.Select("a");
  auto& field = editor.Field<CAutoRichEditCtrl>(kExpression);
  for (const Row& row : kRows) {
    field.SetColouredText(row.text);
    const QTextCharFormat looks = LooksAt(field, row.place);
    EXPECT_EQ(looks.foreground().color().rgb(), row.colour) << row.text;
    EXPECT_EQ(looks.fontWeight() == QFont::Bold, row.bold) << row.text;
    EXPECT_EQ(looks.fontItalic(), row.italic) << row.text;
    EXPECT_EQ(looks.isAnchor(), row.link) << row.text;
    EXPECT_EQ(field.textCursor().position(), 0);
  }
  // What does not scan stays as it is, and leaves nothing behind in the next text.
  field.SetColouredText("k # 1");
  EXPECT_FALSE(LooksAt(field, 0).hasProperty(QTextFormat::ForegroundBrush));
  field.SetColouredText("k /* open");
  field.SetColouredText("MAX(k,f)");
  EXPECT_FALSE(LooksAt(field, 5).hasProperty(QTextFormat::ForegroundBrush)) << "a comma is plain";
}

TEST(Colours, StayReadableOnADarkGround) {
  const QColor dark(30, 30, 30);
  for (const QRgb told :
       {qRgb(0, 0, 255), qRgb(0, 0, 0), qRgb(64, 64, 64), qRgb(0, 155, 0), qRgb(255, 0, 0)}) {
    EXPECT_EQ(ReadableColour(QColor(told), Qt::white), QColor(told)) << "the told colour on a light ground";
    EXPECT_GE(ReadableColour(QColor(told), dark).lightness(), 150);
  }
}

TEST(Links, ShowTheirElementAndJumpToIt) {
  Editor editor(Model().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("a");
  auto& field = editor.Field<CAutoRichEditCtrl>(kExpression);
  const auto pointOf = [&field](int place) {
    QTextCursor cursor(field.document());
    cursor.setPosition(place);
    return field.cursorRect(cursor).center() + QPoint(2, 0);
  };
  const auto rightClick = [&field](const QPoint& point) {
    QContextMenuEvent click(QContextMenuEvent::Mouse, point, field.viewport()->mapToGlobal(point));
    QApplication::sendEvent(field.viewport(), &click);
  };
  const std::uint32_t uid = field.LinkAt(pointOf(0));
  EXPECT_EQ(uid, editor.Core().GetConstant(0).GetUid());
  EXPECT_EQ(field.TipOf(uid), "[Constant] Rate <of> decay");
  EXPECT_EQ(field.LinkAt(pointOf(1)), 0U) << "an operator is no link";
  rightClick(pointOf(2));
  EXPECT_EQ(editor.Selected(), "f");
  QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);

  auto& users = editor.Field<CAutoRichEditCtrl>(1094);
  QContextMenuEvent byKey(QContextMenuEvent::Keyboard, QPoint(0, 0), QPoint(0, 0));
  QApplication::sendEvent(users.viewport(), &byKey);
  EXPECT_EQ(editor.Selected(), "a") << "the menu key goes to the name at the caret";
}

TEST(Typing, ShowsTheParsersMessageAndWritesNothing) {
  Editor editor(Model().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("a");
  auto& field = editor.Field<CAutoRichEditCtrl>(kExpression);
  EXPECT_EQ(field.ParserMessage(), "");
  editor.Type(kExpression, "k*(f");
  EXPECT_TRUE(field.ParserMessage().startsWith("Line ")) << field.ParserMessage().toStdString();
  bool isShown = false;
  for (const QLabel* label : editor.View().Form()->findChildren<QLabel*>()) {
    isShown = isShown || label->text() == field.ParserMessage();
  }
  EXPECT_TRUE(isShown);
  EXPECT_TRUE(editor.Rows().isEmpty());
  EXPECT_EQ(editor.Core().GetAuxiliary(0).expression.Text(), "k*f");
  // An open comment that is only looked at does not reach into the next scan.
  editor.Type(kExpression, "k /*");
  field.SetColouredText("k");
  EXPECT_TRUE(LooksAt(field, 0).isAnchor());
}

TEST(AutoCreate, OffersTheKindsOfTheMask) {
  CAutoCreateDlg one("rate", 16, nullptr);
  EXPECT_EQ(one.windowTitle(), "rate");
  for (std::size_t index = 0; index < one.Radios().size(); ++index) {
    EXPECT_EQ(one.Radios()[index]->isEnabled(), index == 4) << index;
    EXPECT_EQ(one.Radios()[index]->isChecked(), index == 4) << index;
  }
  one.accept();
  EXPECT_EQ(one.ChosenIndex(), -1) << "closed in another way than by its buttons";

  CAutoCreateDlg several("rate", 486, nullptr);
  several.show();
  EXPECT_TRUE(several.Radios()[1]->isChecked());
  several.Radios()[6]->click();
  const auto buttons = several.findChildren<QPushButton*>();
  ASSERT_EQ(buttons.size(), 2);
  for (QPushButton* button : buttons) {
    if (button->text().contains("OK")) button->click();
  }
  EXPECT_EQ(several.ChosenIndex(), 6);

  CAutoCreateDlg skipped("rate", 31, nullptr);
  for (QPushButton* button : skipped.findChildren<QPushButton*>()) {
    if (button->text() == "Skip") button->click();
  }
  EXPECT_EQ(skipped.ChosenIndex(), -1);
}

TEST(ExpressionEditor, IsAShellThatChangesNothing) {
  Editor editor(Model().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("a");
  QStringList keys;
  QTimer::singleShot(0, &editor.View(), [&keys] {
    auto* dialog = qobject_cast<CExpressionEditorDlg*>(QApplication::activeModalWidget());
    ASSERT_NE(dialog, nullptr);
    for (QPushButton* key : dialog->findChildren<QPushButton*>()) {
      if (key->objectName().isEmpty()) continue;
      keys.append(key->objectName());
      key->click();
    }
    dialog->accept();
  });
  QTest::mouseClick(&editor.Field<QWidget>(1023), Qt::LeftButton);
  EXPECT_EQ(keys.size(), 33);
  EXPECT_EQ(editor.Text(kExpression), "k*f");
}

}  // namespace
}  // namespace tessal
