#include "ui/editor.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QInputMethodEvent>
#include <QMenu>
#include <QTest>
#include <QTimer>
#include <QTreeWidgetItemIterator>
#include <stdexcept>

#include "support/template_text.h"
#include "ui/row_table.h"

namespace tessal::test {

namespace {

constexpr const char* kSmallModel = "state S p\nconstant k 1\nforcing f\nauxiliary a k*f\nprocess p a*S";

template <class Value>
Value TakeFirst(QList<Value>& values, Value whenUsedUp) {
  return values.isEmpty() ? whenUsedUp : values.takeFirst();
}

}  // namespace

tessal::Answer ScriptedUser::Ask(QWidget* /*parent*/, const QString& question) {
  log.append(question);
  return TakeFirst(answers, tessal::Answer::Yes);
}

tessal::Answer ScriptedUser::AskOneOfMany(QWidget* parent, const QString& question) {
  const tessal::Answer answer = Ask(parent, question);
  log.append(QStringLiteral("(or No to All)"));
  return answer;
}

tessal::Answer ScriptedUser::AskToReplace(QWidget* parent, const QString& question) {
  const tessal::Answer answer = Ask(parent, question);
  log.append(QStringLiteral("(or whole names only)"));
  return answer;
}

LossAnswer ScriptedUser::AskAboutLosses(const std::string& /*path*/, const std::vector<std::string>& losses) {
  QStringList lines("asked about losses");
  for (const std::string& loss : losses) lines.append(QString::fromStdString(loss));
  log.append(lines.join(QStringLiteral("\n")));
  return lossAnswer;
}

int ScriptedUser::ChooseKind(QWidget* /*parent*/, const QString& symbol, std::uint32_t mask) {
  log.append(QStringLiteral("kind of %1 in %2").arg(symbol).arg(mask));
  return TakeFirst(choices, -1);
}

ExportAnswer ScriptedUser::ChooseExportFile(QWidget* /*parent*/, const ExportQuestion& question) {
  log.append(question.title + QStringLiteral(" to ") + question.proposal + QStringLiteral(" of ") +
             question.filter);
  if (!question.option.isEmpty()) log.append(QStringLiteral("[x] ") + question.option);
  return {exportFile.isNull() ? question.proposal : exportFile, exportOption};
}

bool ScriptedUser::OpenWithSystem(const QString& target) {
  log.append(QStringLiteral("open ") + target);
  return openable.contains(target);
}

std::string ModelText(std::string lines) {
  constexpr std::string_view kSmall = "small";
  if (lines.starts_with(kSmall)) lines.replace(0, kSmall.size(), kSmallModel);
  return TemplateFromNotation(lines);
}

Editor::Editor(const std::string& templateText)
    : path(folder.Write("model.tessal", templateText)), document(std::make_unique<CTessalDoc>(user)) {
  if (!document->OnOpenDocument(path)) throw std::runtime_error("the template does not open");
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
    QString place;
    for (const QTreeWidgetItem* part = *item; part != nullptr; part = part->parent())
      place.prepend(u'/' + part->text(0));
    if (place.endsWith(u'/' + caption)) return *item;
  }
  throw std::runtime_error("no node " + caption.toStdString());
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

QWidget& Editor::Labelled(const QString& label) {
  for (QWidget* control : view->Form()->findChildren<QWidget*>()) {
    if (control->accessibleName() == label) return *control;
  }
  throw std::runtime_error("no control " + label.toStdString());
}

QString Editor::TextOf(const QWidget& control) {
  if (const auto* field = qobject_cast<const CPlainTextField*>(&control)) return field->ContentText();
  if (const auto* table = qobject_cast<const CRowTable*>(&control)) return RowsOf(*table).join(u'\n');
  const auto* combo = qobject_cast<const QComboBox*>(&control);
  return combo != nullptr ? combo->currentText() : control.property("text").toString();
}

QStringList Editor::RowsOf(const CRowTable& table) {
  QStringList rows;
  const CRowModel& model = table.Model();
  for (int row = 0; row < model.rowCount(); ++row) {
    QStringList cells;
    for (int column = 0; column < model.columnCount(); ++column) {
      cells.append(model.index(row, column).data().toString());
    }
    rows.append((row == table.CurrentRow() ? "> " : "  ") + cells.join(QStringLiteral(" | ")));
  }
  return rows;
}

void Editor::Type(const QString& label, const QString& text) {
  QWidget& control = Labelled(label);
  control.setFocus();
  QTest::keyClick(&control, Qt::Key_A, Qt::ControlModifier);
  QTest::keyClick(&control, Qt::Key_Delete);
  // As an input method does it: the keys of a test know no letters but those of ASCII.
  QInputMethodEvent typed;
  typed.setCommitString(text);
  QApplication::sendEvent(&control, &typed);
}

void Editor::Choose(const QString& label, const QString& caption) {
  auto& combo = Field<QComboBox>(label);
  const int entry = combo.findText(caption);
  if (entry < 0) throw std::runtime_error("no choice " + caption.toStdString());
  combo.setCurrentIndex(entry);
  emit combo.activated(entry);
}

QStringList Editor::Offered(const QComboBox& combo) {
  QStringList captions;
  for (int entry = 0; entry < combo.count(); ++entry) captions.append(combo.itemText(entry));
  return captions;
}

QStringList Editor::UseMenu(const QString& caption, const QString& entry) {
  QStringList captions;
  Tree().scrollToItem(Node(caption));
  QTimer::singleShot(0, &Tree(), [&captions, &entry] {
    auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
    if (menu == nullptr) return;
    for (QAction* action : menu->actions()) {
      captions.append(action->text() + (action->isEnabled() ? "" : " (grey)"));
      if (action->text() == entry) action->trigger();
    }
    menu->close();
  });
  emit Tree().customContextMenuRequested(Tree().visualItemRect(Node(caption)).center());
  QCoreApplication::processEvents();
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
