// The host with the editor's module in it: documents that come and go, and work that must not be lost.
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QApplication>
#include <QDir>
#include <QDropEvent>
#include <QFileDialog>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QMimeData>
#include <QRegularExpression>
#include <QStatusBar>
#include <QTabWidget>
#include <QTest>
#include <QTimer>
#include <QTreeWidget>
#include <array>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>
#include <memory>
#include <numeric>
#include <set>
#include <sstream>
#include <stdexcept>
#include <utility>

#include "app/comparison_dialog.h"
#include "app/document_places.h"
#include "app/editor_module.h"
#include "app/host_window.h"
#include "app/notice_bar.h"
#include "app/open_document.h"
#include "app/recent_files.h"
#include "app/start_page.h"
#include "platform/docview.h"
#include "support/case_file.h"
#include "support/qt_print.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::TemplateText;
using test::TemporaryFolder;

/// The module stays loaded for the life of the program, as it does in the host.
EditorModule& Module() {
  static EditorModule module;
  static const bool loaded = module.Load({QStringLiteral(TESSAL_MODULE)});
  EXPECT_TRUE(loaded) << module.Failure().toStdString();
  return module;
}

/// Answers the boxes that come up while it lives, in order and then with OK, and keeps their texts.
class BoxAnswers final : public QObject {
 public:
  BoxAnswers() {
    connect(&timer, &QTimer::timeout, this, &BoxAnswers::Answer);
    timer.start(1);
  }
  QStringList answers;  ///< the captions of buttons
  QStringList texts;
  QString saveAs;  ///< what a file dialog gets

 private:
  void Answer() {
    QWidget* modal = QApplication::activeModalWidget();
    if (auto* box = qobject_cast<QMessageBox*>(modal)) {
      texts.append(box->text());
      const QString answer = answers.isEmpty() ? "OK" : answers.takeFirst();
      for (QAbstractButton* button : box->buttons()) {
        if (button->text().remove(u'&').remove("...") == answer) return button->click();
      }
      box->reject();
    } else if (auto* comparison = qobject_cast<ComparisonDialog*>(modal)) {
      auto* rows = comparison->findChild<QTreeWidget*>();
      for (int row = 0; row < rows->topLevelItemCount(); ++row) {
        QStringList columns;
        for (int column = 0; column < rows->columnCount(); ++column)
          columns.append(rows->topLevelItem(row)->text(column));
        texts.append(columns.join(" | "));
      }
      comparison->reject();
    } else if (auto* files = qobject_cast<QFileDialog*>(modal); files != nullptr && files->isEnabled()) {
      // Answered once; a box that this brings up must find the timer free.
      files->setEnabled(false);
      QTimer::singleShot(0, files, [this, files] {
        // A name that is typed takes the selection away.
        for (auto* list : files->findChildren<QAbstractItemView*>())
          if (list->selectionModel() != nullptr) list->clearSelection();
        files->findChild<QLineEdit*>()->setText(saveAs);
        static_cast<QDialog&>(*files).accept();
      });
    }
  }

  QTimer timer;
};

/// A function that the module exports.
template <class Function>
Function* Export(const char* name) {
  QLibrary library(QStringLiteral(TESSAL_MODULE));
  const auto function = reinterpret_cast<Function*>(library.resolve(name));
  if (function == nullptr) throw std::runtime_error(name);
  return function;
}

/// A host driven by the lines of a file of cases. A case's input names the files of its folder: each a model
/// with a constant of that value, or cut off. The answer to a call is what boxes said, whether it was
/// refused, and all that there is to see when that has changed.
class HostScript final {
 public:
  explicit HostScript(const std::string& files) {
    QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
    ClearRecentFiles();
    qputenv("XDG_STATE_HOME", QByteArray::fromStdString(state.Path().string()));
    std::istringstream input(files);
    for (std::string name, value; input >> name >> value;) Write(name, value);
    Show(0);
  }

  std::string Answer(const test::CaseCall& call) {
    const QStringList words = QString::fromStdString(call.words).split(u' ');
    QStringList lines;
    if (!kCalls.at(words[0])(*this, words.mid(1))) lines.append("refused");
    lines = std::exchange(boxes.texts, {}) + lines;
    const QStringList present = Look();
    if (std::exchange(former, present) != present) lines += present;
    QString text = lines.join(u'\n').replace(Path(""), "FOLDER/");
    text.replace(StateFolder(), "STATE");
    text.replace(QRegularExpression(R"(process \d+ on [^ )]+)"), "PROCESS");
    return text.isEmpty() ? "" : text.toStdString() + "\n";
  }

 private:
  HostWindow& Window() const { return *windows.at(editor); }

  /// Brings an editor to the front, and starts it when it is not there.
  void Show(std::size_t number) {
    editor = number;
    if (!windows.at(editor)) {
      windows[editor] = std::make_unique<HostWindow>(Module().MakeDocTemplate(), Module().EditorName());
      Window().Timer().SetIntervals(kNever, kNever);
    }
    Window().show();
    Window().activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(&Window()));
  }

  /// The editor ends as by a signal, and is started again.
  bool Crash() {
    windows.at(editor).reset();
    Show(editor);
    Window().OfferLeftWork({});
    return true;
  }

  /// One of the two intervals passes.
  bool Pass(std::chrono::milliseconds pause, std::chrono::milliseconds wait) {
    Window().Timer().SetIntervals(pause, wait);
    QTest::qWait(20);
    Window().Timer().SetIntervals(kNever, kNever);
    return true;
  }

  /// The files that an editor keeps beside others and in the state folder, with their permissions.
  bool LookBehind() {
    for (const QString& name : {Path(""), StateFolder()}) {
      const QDir hidden(name);
      const bool isState = name == StateFolder();
      for (const QString& entry : hidden.entryList(QDir::Files | QDir::Hidden, QDir::Name)) {
        if (!isState && !entry.startsWith(".~")) continue;
        const QString file = hidden.filePath(entry);
        const QString text = QString::fromStdString(test::ReadFile(file.toStdString()));
        QString line =
            (isState ? "state " : "") +
            QString(entry).replace(QRegularExpression("[0-9a-f]{8}-[0-9a-f-]{27}|[0-9a-f]{40}"), "ID");
        if (entry.endsWith(".recovery"))
          line += " " + QString::number(int(std::filesystem::status(file.toStdString()).permissions()), 8) +
                  " " + QRegularExpression("ONLINE_HELP = '.+'").match(text).captured();
        boxes.texts.append(line);
      }
    }
    return true;
  }

  /// What the bar says and offers, once it is there; one of its buttons is pressed, if it is named.
  bool UseNotice(const QString& button, int patience) {
    auto* bar = Window().findChild<NoticeBar*>();
    if (!QTest::qWaitFor([bar] { return bar->isVisible(); }, patience)) return false;
    // A second look may find more.
    if (button.isEmpty()) QTest::qWait(patience / 8);
    if (!bar->isVisible()) return false;
    for (auto* label : bar->findChildren<QLabel*>())
      if (button.isEmpty() && !label->text().isEmpty()) boxes.texts.append(label->text());
    for (auto* each : bar->findChildren<QAbstractButton*>()) {
      if (each->isVisible() && button.isEmpty()) boxes.texts.append("  " + each->text());
      if (each->isVisible() && each->text().remove("...") == button) return each->click(), true;
    }
    return button.isEmpty();
  }

  QString Path(const QString& name) const { return QString::fromStdString(folder.File(name.toStdString())); }

  void Write(const std::string& name, const std::string& value) const {
    folder.Write(name, value == "cut" ? "[TESSAL_SETUP]\n[CONSTANTS]\nDESC"
                                      : TemplateText().Constant("k", value).Misc().Text());
  }

  /// The title, the tabs, and the files of the folder with their online help.
  QStringList Look() const {
    QStringList lines{Window().isVisible() ? Window().windowTitle() : "no window"};
    const auto* tabs = Window().findChild<QTabWidget*>();
    for (int tab = 0; tab < tabs->count(); ++tab)
      lines.append((tab == tabs->currentIndex() ? "* " : "  ") + tabs->tabText(tab));
    for (const QString& name : QDir(Path("")).entryList(QDir::Files)) {
      const QString text = QString::fromStdString(test::ReadFile(Path(name).toStdString()));
      lines.append("file " + name + " " + QRegularExpression("ONLINE_HELP = '.+'").match(text).captured());
    }
    return lines;
  }

  /// Types into the online help of the constant; nothing is committed yet.
  bool Edit(const QString& text) {
    QWidget* shown = Window().Current()->Widget();
    auto* tree = shown->findChild<QTreeWidget*>("1127");
    tree->setCurrentItem(tree->findItems("k", Qt::MatchExactly | Qt::MatchRecursive).at(0));
    // The form that was left waits for the event loop to delete it.
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    auto* field = shown->findChild<QWidget*>("1083");
    field->setFocus();
    QTest::keyClicks(field, text);
    return true;
  }

  /// Makes a constant by the menu of their folder.
  bool Touch() {
    auto* tree = Window().Current()->Widget()->findChild<QTreeWidget*>("1127");
    QTimer::singleShot(0, tree, [] {
      auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
      menu->actions().at(0)->trigger();
      menu->close();
    });
    emit tree->customContextMenuRequested(tree->visualItemRect(tree->topLevelItem(0)->child(1)).center());
    // The click that a user makes.
    QTest::keyClick(tree, Qt::Key_Shift);
    return true;
  }

  bool Drop(const QStringList& names) {
    QMimeData dropped;
    QList<QUrl> urls;
    for (const QString& name : names) urls.append(QUrl::fromLocalFile(Path(name)));
    dropped.setUrls(urls);
    QDragEnterEvent enter(QPoint(1, 1), Qt::CopyAction, &dropped, Qt::LeftButton, {});
    QApplication::sendEvent(&Window(), &enter);
    QDropEvent drop(QPointF(1, 1), Qt::CopyAction, &dropped, Qt::LeftButton, {});
    QApplication::sendEvent(&Window(), &drop);
    return enter.isAccepted();
  }

  /// The entries of a menu; one of them is chosen, if it is named.
  bool UseMenu(const QString& title, const QString& entry) {
    for (const QAction* menu : Window().menuBar()->actions()) {
      if (menu->text().remove(u'&') != title || !menu->isVisible()) continue;
      for (QAction* action : menu->menu()->actions()) {
        const QString text = action->text().remove(u'&');
        if (entry.isEmpty() && !text.isEmpty()) {
          boxes.texts.append((action->isChecked() ? "x " : "  ") + text +
                             (action->isEnabled() ? "" : " (grey)"));
        }
        if (!entry.isEmpty() && text == entry) return action->trigger(), true;
      }
      return entry.isEmpty();
    }
    return false;
  }

  /// What the page without a document offers; one of it is pressed, if it is named.
  bool UseStartPage(const QString& name) {
    QCoreApplication::processEvents();
    for (auto* link : Window().findChild<StartPage*>()->findChildren<QAbstractButton*>()) {
      const QString text = link->accessibleName();
      if (!link->isVisible() || text.isEmpty()) continue;
      if (name.isEmpty()) boxes.texts.append(text);
      if (text == name) return link->click(), true;
    }
    return name.isEmpty();
  }

  /// Somebody else writes a file.
  bool Change(const std::string& name) const {
    Write(name, "2");
    return Touch(name);
  }

  bool Touch(const std::string& name) const {
    const auto later = std::filesystem::file_time_type::clock::now() + std::chrono::hours(1);
    std::filesystem::last_write_time(folder.File(name), later);
    return true;
  }

  using Call = bool (*)(HostScript& host, const QStringList& words);
  static const std::map<QString, Call> kCalls;

  static constexpr std::chrono::hours kNever{1};

  TemporaryFolder folder;
  TemporaryFolder state;
  BoxAnswers boxes;
  std::array<std::unique_ptr<HostWindow>, 2> windows;
  std::size_t editor = 0;
  QStringList former;
};

const std::map<QString, HostScript::Call> HostScript::kCalls = {
    {"open", [](auto& host, auto& words) { return host.Window().OpenFile(host.Path(words[0])); }},
    {"drop", [](auto& host, auto& words) { return host.Drop(words); }},
    {"new", [](auto& host, auto& /*words*/) { return host.Window().NewDocument(), true; }},
    {"edit", [](auto& host, auto& words) { return host.Edit(words.join(u' ')); }},
    {"commit", [](auto& host, auto& /*words*/) { return host.Window().Current()->View().OnCommit(), true; }},
    // A folder's menu makes an element.
    {"touch", [](auto& host, auto& /*words*/) { return host.Touch(); }},
    {"menu",
     [](auto& host, auto& words) { return host.UseMenu(words[0], QStringList(words.mid(1)).join(u' ')); }},
    {"start", [](auto& host, auto& words) { return host.UseStartPage(words.join(u' ')); }},
    {"name", [](auto& host, auto& words) { return host.boxes.saveAs = host.Path(words[0]), true; }},
    {"save", [](auto& host, auto& /*words*/) { return host.Window().SaveCurrent(); }},
    {"save-as", [](auto& host, auto& /*words*/) { return host.Window().SaveCurrentAs(); }},
    {"close", [](auto& host, auto& /*words*/) { return host.Window().CloseCurrent(); }},
    {"quit", [](auto& host, auto& /*words*/) { return host.Window().close(); }},
    {"tab",
     [](auto& host, auto& words) {
       return host.Window().template findChild<QTabWidget*>()->setCurrentIndex(words[0].toInt()), true;
     }},
    {"focus",
     [](auto& host, auto& /*words*/) {
       return host.boxes.texts.append(QApplication::focusWidget()->objectName()), true;
     }},
    // A blank in a caption is an underscore.
    {"press",
     [](auto& host, auto& words) {
       host.boxes.answers = words;
       return host.boxes.answers.replaceInStrings("_", " "), true;
     }},
    {"recent", [](auto& host, auto& /*words*/) { return host.boxes.texts = RecentFiles(), true; }},
    {"delete", [](auto& host, auto& words) { return QFile::remove(host.Path(words[0])); }},
    {"make-folder", [](auto& host, auto& words) { return QDir().mkdir(host.Path(words[0])); }},
    {"change", [](auto& host, auto& words) { return host.Change(words[0].toStdString()); }},
    {"touch-file", [](auto& host, auto& words) { return host.Touch(words[0].toStdString()); }},
    {"rename-file",
     [](auto& host, auto& words) {
       return std::rename(host.folder.File(words[0].toStdString()).c_str(),
                          host.folder.File(words[1].toStdString()).c_str()) == 0;
     }},
    {"editor", [](auto& host, auto& words) { return host.Show(words[0].toUInt() - 1), true; }},
    {"crash", [](auto& host, auto& /*words*/) { return host.Crash(); }},
    {"pause",
     [](auto& host, auto& /*words*/) { return host.Pass(std::chrono::milliseconds(1), HostScript::kNever); }},
    {"work-on",
     [](auto& host, auto& /*words*/) { return host.Pass(HostScript::kNever, std::chrono::milliseconds(1)); }},
    {"status",
     [](auto& host, auto& /*words*/) {
       return host.boxes.texts.append(host.Window().statusBar()->currentMessage()), true;
     }},
    // A file where the editor's folder for the user's state would be.
    {"block-state", [](auto& host, auto& /*words*/) { return host.state.Write("tessal", ""), true; }},
    {"unblock-state",
     [](auto& host, auto& /*words*/) { return std::filesystem::remove(host.state.File("tessal")); }},
    {"kept", [](auto& host, auto& /*words*/) { return host.LookBehind(); }},
    {"notice", [](auto& host, auto& words) { return host.UseNotice(words.join(u' '), 2000); }},
    {"quiet", [](auto& host, auto& /*words*/) { return !host.UseNotice({}, 400); }},
};

class Cases : public ::testing::TestWithParam<const char*> {};

TEST_P(Cases, SayWhatTheHostDoes) {
  test::RunCases("app/cases/" + std::string(GetParam()) + ".txt", [](const test::Case& each) {
    const auto script = std::make_shared<HostScript>(each.input);
    return [script](const test::CaseCall& call) { return script->Answer(call); };
  });
}

INSTANTIATE_TEST_SUITE_P(Host, Cases, ::testing::Values("host", "recovery"),
                         [](const auto& file) { return std::string(file.param); });

TEST(Module, GivesItsOneDocumentTemplate) {
  auto* const get = Export<CMultiDocTemplate*(int)>("CvGetDocTemplatePtr");
  auto* const name = Export<int(std::string*)>("CvGetEditorString");
  EXPECT_EQ(Export<int()>("CvGetNumDocTemplates")(), 1);
  EXPECT_EQ(get(1), nullptr);
  EXPECT_EQ(get(-1), nullptr);
  const std::unique_ptr<CMultiDocTemplate> first(get(0));
  const std::unique_ptr<CMultiDocTemplate> second(get(0));
  ASSERT_TRUE(first && second);
  EXPECT_NE(first, second) << "each call makes a new one";
  EXPECT_EQ(first->ResourceNumber(), 676);
  EXPECT_EQ(first->GetDocString(CMultiDocTemplate::kFilterName), "TESSAL Files (*.tessal)");
  EXPECT_EQ(first->GetDocString(CMultiDocTemplate::kFileTypeName), "Tessal Setup.Document");
  std::string text = "before";
  EXPECT_EQ(name(nullptr), 0);
  EXPECT_EQ(name(&text), 1);
  EXPECT_EQ(text, "Tessal");
  for (const char* none :
       {"CvGetBitmapId", "CvGetNumToolbars", "CvGetToolbarString", "CvInitToolbar", "CvCreateToolbar"}) {
    EXPECT_EQ(Export<int()>(none)(), 0) << none;
  }
}

TEST(Module, ThatIsMissingOrWrongIsNamed) {
  const TemporaryFolder folder;
  const QString noise = QString::fromStdString(folder.Write("libtessal_editor.so", "no library"));
  struct Row {
    QStringList places;
    QString named;
  };
  for (const Row& row :
       {Row{EditorModule::UsualPlaces("/nowhere/bin"), "/nowhere/lib/tessal/libtessal_editor.so"},
        Row{{noise}, noise}, Row{{QStringLiteral(TESSAL_OTHER_LIBRARY)}, "not an editor module"}}) {
    EditorModule module;
    EXPECT_FALSE(module.Load(row.places));
    EXPECT_TRUE(module.Failure().contains(row.named)) << module.Failure().toStdString();
  }
}

TEST(Module, IsNotTakenFromTheCurrentFolder) {
  const TemporaryFolder folder;
  for (const char* place : {"inner", "lib", "lib/tessal"}) {
    std::filesystem::create_directory(folder.File(place));
    std::filesystem::create_symlink(TESSAL_MODULE, folder.File(std::string(place) + "/libtessal_editor.so"));
  }
  const QString former = QDir::currentPath();
  QDir::setCurrent(QString::fromStdString(folder.File("inner")));
  for (const QString unknown : {"", ".", "..", "../inner"}) {
    EXPECT_FALSE(EditorModule().Load(EditorModule::UsualPlaces(unknown))) << unknown.toStdString();
  }
  EXPECT_TRUE(EditorModule().Load(EditorModule::UsualPlaces(QDir::currentPath())))
      << "a folder that is known";
  QDir::setCurrent(former);
}

/// The commands of all menus, as the guide lists them.
std::string MenuTable(const HostWindow& window, const std::string& head) {
  QStringList rows;
  for (const QAction* menu : window.menuBar()->actions()) {
    for (const QAction* command : menu->menu()->actions()) {
      if (command->isSeparator() || !command->isVisible()) continue;
      QStringList keys;
      for (const QKeySequence& key : command->shortcuts()) keys.append(key.toString());
      rows.append(QStringLiteral("| %1 | %2 | %3 |").arg(menu->text(), command->text(), keys.join(" or ")));
    }
  }
  return head + rows.join(u'\n').remove(u'&').remove("...").append(u'\n').toStdString();
}

TEST(Host, HasTheMenusThatTheGuideLists) {
  HostWindow window(Module().MakeDocTemplate(), Module().EditorName());
  window.NewDocument();
  std::string page = test::ReadFile(TESSAL_SOURCE_DIR "/docs/guide/keyboard.md");
  const std::string head = "| Menu | Command | Keys |\n|---|---|---|\n";
  const std::size_t start = page.find(head);
  ASSERT_NE(start, std::string::npos);
  page.replace(start, page.find("\n\n", start) + 1 - start, MenuTable(window, head));
  test::ExpectPage("../docs/guide/keyboard.md", page);
}

long ResidentPages() {
  std::ifstream sizes("/proc/self/statm");
  long resident = 0;
  sizes >> resident >> resident;
  return resident;
}

TEST(Host, HasTheKeysOfTheManual) {
  HostWindow window(Module().MakeDocTemplate(), Module().EditorName());
  window.NewDocument();
  std::set<std::string> lines;
  for (const QAction* action : window.findChildren<QAction*>()) {
    const QString text = QString(action->text()).remove(u'&').remove("...");
    const QString keys = QKeySequence::listToString(action->shortcuts(), QKeySequence::PortableText);
    if (!keys.isEmpty()) lines.insert((text + "\t" + keys + "\n").toStdString());
  }
  test::ExpectPage("../src/manual/editor_keys.txt",
                   std::accumulate(lines.begin(), lines.end(), std::string()));
}

/// The program itself, where there is no display.
std::string CallEditor(const std::string& arguments) {
  const TemporaryFolder folder;
  const std::string output = folder.File("output");
  const int status =
      std::system(("env -u DISPLAY -u WAYLAND_DISPLAY -u QT_QPA_PLATFORM '" TESSAL_EDITOR "' " + arguments +
                   " >'" + output + "' 2>&1")
                      .c_str());
  return test::ReadFile(output) + "[" + std::to_string(WEXITSTATUS(status)) + "]";
}

TEST(Editor, AnswersQuestionsAboutItsCallWithoutADisplay) {
  const std::string help = CallEditor("--help");
  EXPECT_TRUE(help.starts_with("Edits templates") && help.ends_with("[0]")) << help;
  for (const char* option : {"-h,--help ", "-v,--version ", "--module FILE ", "--platform NAME "}) {
    EXPECT_NE(help.find(option), std::string::npos) << option;
  }
  const std::string version = CallEditor("-v");
  EXPECT_TRUE(version.starts_with("tessal-editor 1") && version.ends_with("revision 1\n[0]")) << version;
  EXPECT_EQ(CallEditor("--frob x.tessal"), "tessal-editor: Unknown option 'frob'.\n[2]");
  EXPECT_EQ(CallEditor("--module"), "tessal-editor: Missing value after '--module'.\n[2]");
}

TEST(Host, FiftyDocumentsLeaveNoMemoryInUse) {
  HostWindow window(Module().MakeDocTemplate(), Module().EditorName());
  long before = 0;
  for (int time = 0; time < 50; ++time) {
    if (time == 25) before = ResidentPages();
    ASSERT_TRUE(window.OpenFile(QStringLiteral(TESSAL_SOURCE_DIR "/examples/eutrophication.tessal")));
    QCoreApplication::processEvents();
    ASSERT_TRUE(window.CloseCurrent());
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
  }
  // A document of this size with its view holds about a megabyte: each one that stayed would show.
  constexpr long kMostGrowth = 15L * 1024 * 1024;
  EXPECT_LT((ResidentPages() - before) * sysconf(_SC_PAGESIZE), kMostGrowth);
}

}  // namespace
}  // namespace tessal
