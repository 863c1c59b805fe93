#include "pictures/editor_pictures.h"

#include <QAbstractButton>
#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QDir>
#include <QFileInfo>
#include <QInputMethodEvent>
#include <QLabel>
#include <QMenuBar>
#include <QPainter>
#include <QSettings>
#include <QStyle>
#include <QTabBar>
#include <QTest>
#include <QTreeWidgetItemIterator>
#include <algorithm>
#include <map>
#include <stdexcept>
#include <vector>

#include "app/open_document.h"
#include "module/exports.h"
#include "platform/docview.h"
#include "ui/analysis_pane.h"
#include "ui/analysis_tools.h"
#include "ui/element_tree.h"
#include "ui/error_list.h"
#include "ui/find_pane.h"
#include "ui/find_tools.h"
#include "ui/main_view.h"
#include "ui/right_pane.h"

namespace tessal::pictures {

namespace {

constexpr QSize kUsualSize(1000, 680);

[[noreturn]] void Fail(const QString& what) {
  throw std::runtime_error(what.toStdString());
}

/// What a widget or an action is called by people.
QString NameOf(const QString& name, QString text) {
  return name.isEmpty() ? text.remove(u'&') : name;
}

/// Lets everything come to rest that follows from what was done.
void Settle() {
  QCoreApplication::processEvents();
  QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
  QCoreApplication::processEvents();
}

QPalette DarkPalette() {
  const QColor ground(38, 38, 40);
  QPalette palette(QColor(60, 60, 63), ground);
  palette.setColor(QPalette::Base, QColor(56, 56, 58));
  palette.setColor(QPalette::Highlight, QColor(20, 100, 150));
  palette.setColor(QPalette::Link, QColor(90, 170, 250));
  return palette;
}

/// The same picture with 256 colours at most, which makes small files: of colours that look the same the one
/// that it has most of, and the most frequent of those.
QImage WithFewColours(const QImage& picture) {
  constexpr QRgb kLook = 0xFFF8F8F8;
  std::map<QRgb, std::map<QRgb, int>> looks;
  for (int row = 0; row < picture.height(); ++row) {
    for (int column = 0; column < picture.width(); ++column) {
      const QRgb colour = picture.pixel(column, row);
      ++looks[colour & kLook][colour];
    }
  }
  std::vector<std::pair<int, QRgb>> byCount;
  for (const auto& [look, colours] : looks) {
    const auto less = [](const auto& left, const auto& right) { return left.second < right.second; };
    const auto most = std::max_element(colours.begin(), colours.end(), less);
    byCount.emplace_back(-most->second, most->first);
  }
  std::sort(byCount.begin(), byCount.end());
  constexpr std::size_t kMostColours = 256;
  QList<QRgb> table;
  for (std::size_t place = 0; place < std::min(byCount.size(), kMostColours); ++place)
    table.append(byCount[place].second);
  return picture.convertToFormat(QImage::Format_Indexed8, table, Qt::ThresholdDither);
}

void PressMenuEntry(const QList<QAction*>& entries, const QString& text) {
  for (QAction* entry : entries) {
    if (NameOf({}, entry->text()).startsWith(text) && entry->isEnabled()) return entry->trigger();
  }
  Fail("no command " + text);
}

}  // namespace

EditorPictures::EditorPictures(QString examplesFolder, QString outputFolder)
    : examples(std::move(examplesFolder)), output(std::move(outputFolder)) {}

void EditorPictures::Do(const QString& line) {
  using Verb = std::function<void(EditorPictures&, const QString& first, const QString& second)>;
  static const std::map<QString, Verb> kVerbs = {
      {"new",
       [](auto& self, auto&, auto&) {
         self.Start();
         self.window->NewDocument();
       }},
      {"open", [](auto& self, auto& name, auto&) { self.Open(name); }},
      {"palette", [](auto& self, auto& name, auto&) { self.UsePalette(name); }},
      {"size",
       [](auto& self, auto& size, auto&) {
         self.window->resize(size.section(u' ', 0, 0).toInt(), size.section(u' ', 1).toInt());
       }},
      {"select",
       [](auto& self, auto& caption, auto&) {
         self.View().Tree().setFocus();
         self.View().Tree().setCurrentItem(&self.Node(caption));
       }},
      {"expand", [](auto& self, auto& caption, auto&) { self.Node(caption).setExpanded(true); }},
      {"collapse", [](auto& self, auto& caption, auto&) { self.Node(caption).setExpanded(false); }},
      {"type", [](auto& self, auto& name, auto& text) { self.Type(name, text); }},
      {"enter",
       [](auto& self, auto& name, auto& text) {
         self.Type(name, text);
         self.View().Tree().setFocus();
       }},
      {"focus", [](auto& self, auto& name, auto&) { self.Control(name).setFocus(); }},
      {"keys", [](auto& self, auto& keys, auto&) { self.PressKeys(keys); }},
      {"choose", [](auto& self, auto& name, auto& entry) { self.Choose(name, entry); }},
      {"press", [](auto& self, auto& name, auto&) { self.Press(name); }},
      {"tab", [](auto& self, auto& text, auto&) { self.ShowTab(text); }},
      {"command", [](auto& self, auto& text, auto&) { self.RunCommand(text); }},
      {"answer", [](auto& self, auto& first,
                    auto& second) { self.AddAnswer(second.isEmpty() ? first : first + ": " + second); }},
      {"pause", [](auto&, auto& time, auto&) { QTest::qWait(time.toInt()); }},
      {"picture", [](auto& self, auto& file, auto&) { self.TakeWindow(file); }},
      {"part", [](auto& self, auto& file, auto& name) { self.TakePart(file, name); }},
      {"save", [](auto& self, auto& name, auto&) { self.Save(name); }},
  };
  const QString verb = line.section(u' ', 0, 0);
  const QString rest = line.section(u' ', 1);
  const auto known = kVerbs.find(verb);
  if (known == kVerbs.end()) Fail("no verb " + verb);
  // A question that was closed gives the focus back to nobody on a screen without a window manager.
  const bool isOver = QApplication::activePopupWidget() != nullptr;
  if (window && !isOver && !window->isActiveWindow() && QApplication::activeModalWidget() == nullptr)
    QApplication::setActiveWindow(window.get());
  // A field may be emptied: then nothing follows the colon.
  const QString first = rest.section(QStringLiteral(": "), 0, 0);
  known->second(*this, first.endsWith(u':') ? first.chopped(1) : first,
                rest.section(QStringLiteral(": "), 1));
  Settle();
  if (!answers.Failure().isEmpty()) Fail(answers.Failure());
}

void EditorPictures::Start() {
  Finish();
  QSettings().clear();
  window = std::make_unique<HostWindow>(std::unique_ptr<CMultiDocTemplate>(CvGetDocTemplatePtr(0)),
                                        QStringLiteral("Tessal"));
  window->resize(kUsualSize);
  window->show();
  window->activateWindow();
}

void EditorPictures::Open(const QString& name) {
  Start();
  if (!window->OpenFile(QDir(examples).filePath(name))) Fail("cannot open " + name);
}

CMainView& EditorPictures::View() const {
  if (!window || window->Current() == nullptr) Fail(QStringLiteral("no template is open"));
  return dynamic_cast<CMainView&>(*window->Current()->Widget());
}

QWidget& EditorPictures::Control(const QString& name) const {
  QWidget* longer = nullptr;
  for (QWidget* widget : window->findChildren<QWidget*>()) {
    const auto* button = qobject_cast<const QAbstractButton*>(widget);
    const QString shown = NameOf(widget->accessibleName(), button != nullptr ? button->text() : QString());
    if (!widget->isVisible()) continue;
    if (shown == name) return *widget;
    // What is locked says so after its name.
    if (longer == nullptr && shown.startsWith(name + u' ')) longer = widget;
  }
  if (longer == nullptr) Fail("no control " + name);
  return *longer;
}

QTreeWidgetItem& EditorPictures::Node(const QString& caption) const {
  for (QTreeWidgetItemIterator item(&View().Tree()); *item != nullptr; ++item) {
    QString place;
    for (const QTreeWidgetItem* part = *item; part != nullptr; part = part->parent())
      place.prepend(u'/' + part->text(0));
    // A star is for elements that nobody has looked at yet.
    if (place.remove(u'*').endsWith(u'/' + caption)) return **item;
  }
  Fail("no node " + caption);
}

void EditorPictures::Type(const QString& name, const QString& text) {
  QWidget& control = Control(name);
  control.setFocus();
  QTest::keyClick(&control, Qt::Key_A, Qt::ControlModifier);
  QTest::keyClick(&control, Qt::Key_Delete);
  // As an input method does it: test keys know no letters but those of ASCII.
  QInputMethodEvent typed;
  typed.setCommitString(text);
  QApplication::sendEvent(&control, &typed);
}

void EditorPictures::PressKeys(const QString& keys) {
  for (qsizetype place = 0; place < keys.size(); ++place) {
    QWidget* popup = QApplication::activePopupWidget();
    QWidget* target = popup != nullptr ? popup : QApplication::focusWidget();
    if (target == nullptr) Fail(QStringLiteral("nothing has the focus"));
    const qsizetype end = keys[place] == u'<' ? keys.indexOf(u'>', place) : -1;
    if (end < 0) {
      QTest::keyClicks(target, keys.mid(place, 1));
      continue;
    }
    const QKeyCombination key = QKeySequence(keys.mid(place + 1, end - place - 1))[0];
    QTest::keyClick(target, key.key(), key.keyboardModifiers());
    place = end;
  }
}

void EditorPictures::Choose(const QString& name, const QString& entry) {
  auto& combo = dynamic_cast<QComboBox&>(Control(name));
  const int place = combo.findText(entry);
  if (place < 0) Fail(name + " does not offer " + entry);
  combo.setCurrentIndex(place);
  emit combo.activated(place);
}

void EditorPictures::Press(const QString& name) {
  dynamic_cast<QAbstractButton&>(Control(name)).click();
}

void EditorPictures::ShowTab(const QString& text) {
  for (QTabBar* bar : window->findChildren<QTabBar*>()) {
    for (int place = 0; place < bar->count() && bar->isVisible(); ++place) {
      if (NameOf({}, bar->tabText(place)) == text) return bar->setCurrentIndex(place);
    }
  }
  Fail("no tab " + text);
}

void EditorPictures::RunCommand(const QString& text) {
  QList<QAction*> entries;
  for (const QAction* menu : window->menuBar()->actions()) {
    if (menu->menu() != nullptr) entries.append(menu->menu()->actions());
  }
  PressMenuEntry(entries, text);
}

void EditorPictures::Finish() {
  window.reset();
  if (answers.Left() > 0) Fail(QStringLiteral("a question was not asked"));
}

void EditorPictures::AddAnswer(const QString& words) {
  const QString file = words.contains(QStringLiteral(": ")) ? words.section(QStringLiteral(": "), 0, 0) : "";
  const QString buttons = file.isEmpty() ? words : words.section(QStringLiteral(": "), 1);
  QuestionAnswer answer{buttons.split(QStringLiteral(", ")), {}};
  if (!file.isEmpty()) answer.look = [this, file] { TakeWindow(file); };
  answers.Add(std::move(answer));
}

void EditorPictures::UsePalette(const QString& name) {
  QApplication::setPalette(name == QLatin1StringView("dark") ? DarkPalette()
                                                             : QApplication::style()->standardPalette());
}

void EditorPictures::TakeWindow(const QString& file) {
  Settle();
  QPixmap picture = window->grab();
  QPainter painter(&picture);
  for (QWidget* over : QApplication::topLevelWidgets()) {
    if (over == window.get() || !over->isVisible()) continue;
    const QRect frame(over->pos() - window->pos(), over->size());
    painter.drawPixmap(frame.topLeft(), over->grab());
    // What a window manager would draw around it.
    painter.setPen(QApplication::palette().color(QPalette::Mid));
    painter.drawRect(frame.adjusted(0, 0, -1, -1));
  }
  painter.end();
  Write(picture, file);
}

void EditorPictures::TakePart(const QString& file, const QString& name) {
  Settle();
  const std::map<QString, QWidget*> parts = {
      {"page", View().findChild<QLabel*>(QStringLiteral("1125"))->parentWidget()},
      {"tree", &View().Tree()},
      {"messages", View().ErrorList().parentWidget()},
      {"find", &View().FindTools().Pane()},
      {"analyses", &View().Analyses().Pane()}};
  const auto part = parts.find(name);
  Write((part == parts.end() ? Control(name) : *part->second).grab(), file);
}

void EditorPictures::Write(const QPixmap& picture, const QString& file) const {
  const QString path = QDir(output).filePath(file);
  QDir().mkpath(QFileInfo(path).path());
  const QImage small = WithFewColours(picture.toImage());
  if (!small.save(path, "PNG", 0)) Fail("cannot write " + path);
}

void EditorPictures::Save(const QString& name) {
  const QString path = QDir(output).filePath(QStringLiteral("examples/") + name);
  QDir().mkpath(QFileInfo(path).path());
  View().OnCommit();
  if (!window->Current()->Save(path)) Fail("cannot save " + path);
}

}  // namespace tessal::pictures
