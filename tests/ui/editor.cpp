#include "ui/editor.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QInputMethodEvent>
#include <QTest>
#include <QTreeWidgetItemIterator>

#include "ui/text_bytes.h"

namespace tessal::test {

void ScriptedUser::ShowMessage(const std::string& text) {
  log.append(ToScreen(text));
}

bool ScriptedUser::AskYesNo(const std::string& question) {
  return Ask(nullptr, ToScreen(question));
}

void ScriptedUser::Warn(QWidget* /*parent*/, const QString& text) {
  log.append(text);
}

void ScriptedUser::ShowFailure(QWidget* /*parent*/, const QString& text) {
  log.append(text);
}

bool ScriptedUser::Ask(QWidget* /*parent*/, const QString& question) {
  log.append(question);
  if (answers.empty()) return true;
  const bool answer = answers.front();
  answers.pop_front();
  return answer;
}

int ScriptedUser::ChooseKind(QWidget* /*parent*/, const QString& symbol, std::uint32_t mask) {
  log.append(QStringLiteral("kind of %1 in %2").arg(symbol).arg(mask));
  if (choices.empty()) return -1;
  const int choice = choices.front();
  choices.pop_front();
  return choice;
}

QString ScriptedUser::ChooseDocumentationFile(QWidget* /*parent*/, const QString& /*start*/) {
  return documentationFile;
}

bool ScriptedUser::OpenWithSystem(const QString& target) {
  log.append(QStringLiteral("open ") + target);
  return openable.contains(target);
}

void ScriptedUser::ShowHelp(QWidget* /*parent*/, int topic) {
  log.append(QStringLiteral("help %1").arg(topic));
}

QStringList ScriptedUser::TakeLog() {
  return std::exchange(log, {});
}

TemplateText SmallModel() {
  TemplateText text;
  text.StateVariable("S", "p").Constant("k").Forcing("f").Auxiliary("a", "k*f").Process("p", "a*S");
  return text;
}

Editor::Editor(const std::string& templateText)
    : path(folder.Write("model.tessal", templateText)), document(std::make_unique<CTessalDoc>(user)) {
  if (!document->OnOpenDocument(path)) return;
  document->SetPathName(path);
  view = std::make_unique<CMainView>(*document, user);
  document->AddView(*view);
  view->OnInitialUpdate();
  constexpr QSize kScreen(1000, 700);
  view->resize(kScreen);
  view->show();
  view->activateWindow();
  EXPECT_TRUE(QTest::qWaitForWindowActive(view.get()));
}

Editor::~Editor() {
  view.reset();
  // Forms that were replaced wait for the event loop to delete them.
  QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

QTreeWidgetItem* Editor::Node(const QString& caption) {
  for (QTreeWidgetItemIterator item(&Tree()); *item != nullptr; ++item) {
    if ((*item)->text(0) == caption) return *item;
  }
  ADD_FAILURE() << "no node " << caption.toStdString();
  return Tree().RootItem();
}

void Editor::Select(const QString& caption) {
  Tree().setFocus();
  Tree().setCurrentItem(Node(caption));
  QCoreApplication::processEvents();
}

QStringList Editor::Children(const QString& caption) {
  QStringList captions;
  const QTreeWidgetItem* node = Node(caption);
  for (int place = 0; place < node->childCount(); ++place) captions.append(node->child(place)->text(0));
  return captions;
}

QString Editor::Text(int number) {
  auto& control = Field<QWidget>(number);
  if (const auto* line = qobject_cast<QLineEdit*>(&control)) return line->text();
  if (const auto* combo = qobject_cast<QComboBox*>(&control)) return combo->currentText();
  return qobject_cast<CPlainTextField*>(&control)->ContentText();
}

void Editor::Type(int number, const QString& text) {
  auto& control = Field<QWidget>(number);
  control.setFocus();
  QTest::keyClick(&control, Qt::Key_A, Qt::ControlModifier);
  QTest::keyClick(&control, Qt::Key_Delete);
  // As an input method does it: the keys of a test know no letters but those of ASCII.
  QInputMethodEvent typed;
  typed.setCommitString(text);
  QApplication::sendEvent(&control, &typed);
}

void Editor::Enter(int number, const QString& text) {
  Type(number, text);
  LeaveField();
}

void Editor::LeaveField() {
  Tree().setFocus();
}

void Editor::Choose(int number, const QString& caption) {
  auto& combo = Field<QComboBox>(number);
  const int entry = combo.findText(caption);
  ASSERT_GE(entry, 0) << caption.toStdString();
  combo.setCurrentIndex(entry);
  emit combo.activated(entry);
}

QStringList Editor::Offered(int number) {
  QStringList captions;
  const auto& combo = Field<QComboBox>(number);
  for (int entry = 0; entry < combo.count(); ++entry) captions.append(combo.itemText(entry));
  return captions;
}

QStringList Editor::Rows() {
  QStringList rows;
  const CErrorList& list = view->ErrorList();
  for (int row = 0; row < list.topLevelItemCount(); ++row) {
    const QTreeWidgetItem* item = list.topLevelItem(row);
    rows.append(item->text(0) + QStringLiteral(": ") + item->text(1));
  }
  return rows;
}

}  // namespace tessal::test
