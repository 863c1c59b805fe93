// The host with the editor's module in it: documents that come and go, and work that must not be lost.
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QAction>
#include <QApplication>
#include <QDir>
#include <QDropEvent>
#include <QFileDialog>
#include <QLineEdit>
#include <QMenuBar>
#include <QMessageBox>
#include <QMimeData>
#include <QTabWidget>
#include <QTest>
#include <QTimer>
#include <QTreeWidget>
#include <QTreeWidgetItemIterator>
#include <deque>
#include <filesystem>
#include <fstream>

#include "app/editor_module.h"
#include "app/host_window.h"
#include "app/open_document.h"
#include "app/recent_files.h"
#include "platform/docview.h"
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
  std::deque<QMessageBox::StandardButton> answers;
  QStringList texts;
  QString saveAs;  ///< what a file dialog gets

 private:
  void Answer() {
    QWidget* modal = QApplication::activeModalWidget();
    if (auto* box = qobject_cast<QMessageBox*>(modal)) {
      texts.append(box->text());
      QMessageBox::StandardButton button = QMessageBox::Ok;
      if (!answers.empty()) {
        button = answers.front();
        answers.pop_front();
      }
      if (QAbstractButton* pressed = box->button(button)) {
        pressed->click();
      } else {
        box->reject();
      }
    } else if (auto* files = qobject_cast<QFileDialog*>(modal); files != nullptr && files->isEnabled()) {
      // Answered once; a box that this brings up must find the timer free.
      files->setEnabled(false);
      QTimer::singleShot(0, files, [this, files] { Choose(*files); });
    }
  }

  void Choose(QFileDialog& files) const {
    if (saveAs.isEmpty()) {
      files.reject();
      return;
    }
    files.findChild<QLineEdit*>()->setText(saveAs);
    static_cast<QDialog&>(files).accept();
  }

  QTimer timer;
};

class Host : public testing::Test {
 protected:
  Host() : window(Module().MakeDocTemplate(), Module().EditorName()) {
    QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
    window.show();
    window.activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(&window));
  }

  QString Model(const char* name, const std::string& value = "1") {
    return QString::fromStdString(folder.Write(name, TemplateText().Constant("k", value).Misc().Text()));
  }

  /// Selects the constant and types a description; nothing is committed yet.
  void Edit(const QString& text) {
    auto* tree = window.Current()->Widget()->findChild<QTreeWidget*>("1127");
    for (QTreeWidgetItemIterator item(tree); *item != nullptr; ++item) {
      if ((*item)->text(0) == "k") tree->setCurrentItem(*item);
    }
    auto* field = window.Current()->Widget()->findChild<QWidget*>("1083");
    ASSERT_NE(field, nullptr);
    field->setFocus();
    QTest::keyClicks(field, text);
  }

  TemporaryFolder folder;
  BoxAnswers boxes;
  HostWindow window;
};

TEST(Module, GivesItsOneDocumentTemplate) {
  QLibrary library(QStringLiteral(TESSAL_MODULE));
  const auto count = reinterpret_cast<int (*)()>(library.resolve("CvGetNumDocTemplates"));
  const auto get = reinterpret_cast<CMultiDocTemplate* (*)(int)>(library.resolve("CvGetDocTemplatePtr"));
  const auto name = reinterpret_cast<int (*)(std::string*)>(library.resolve("CvGetEditorString"));
  ASSERT_TRUE(count && get && name);
  EXPECT_EQ(count(), 1);
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
    const auto function = reinterpret_cast<int (*)()>(library.resolve(none));
    ASSERT_TRUE(function) << none;
    EXPECT_EQ(function(), 0) << none;
  }
}

TEST(Module, ThatIsMissingOrWrongIsNamed) {
  const TemporaryFolder folder;
  EditorModule missing;
  EXPECT_FALSE(missing.Load(EditorModule::UsualPlaces("/nowhere/bin")));
  EXPECT_TRUE(missing.Failure().contains("/nowhere/lib/tessal/libtessal_editor.so"))
      << missing.Failure().toStdString();
  const QString noise = QString::fromStdString(folder.Write("libtessal_editor.so", "no library"));
  EditorModule wrong;
  EXPECT_FALSE(wrong.Load({noise}));
  EXPECT_TRUE(wrong.Failure().contains(noise)) << wrong.Failure().toStdString();
  EditorModule other;
  const QString foreign = "/lib/x86_64-linux-gnu/libz.so.1";
  if (!QFile::exists(foreign)) GTEST_SKIP() << "no other library at hand";
  EXPECT_FALSE(other.Load({foreign}));
  EXPECT_TRUE(other.Failure().contains("no module of an editor"));
}

TEST_F(Host, OpensEachFileOnceInATabOfItsOwn) {
  const QString first = Model("one.tessal");
  const QString second = Model("two & three.tessal");
  auto* tabs = window.findChild<QTabWidget*>();
  QMimeData dropped;
  dropped.setUrls({QUrl::fromLocalFile(first), QUrl::fromLocalFile(second)});
  QDragEnterEvent enter(QPoint(1, 1), Qt::CopyAction, &dropped, Qt::LeftButton, {});
  QApplication::sendEvent(&window, &enter);
  EXPECT_TRUE(enter.isAccepted());
  QDropEvent drop(QPointF(1, 1), Qt::CopyAction, &dropped, Qt::LeftButton, {});
  QApplication::sendEvent(&window, &drop);
  EXPECT_EQ(window.DocumentCount(), 2);
  EXPECT_EQ(tabs->tabText(1), "two && three.tessal");
  EXPECT_TRUE(window.OpenFile(QString::fromStdString(folder.File("./one.tessal"))));
  EXPECT_EQ(window.DocumentCount(), 2);
  EXPECT_EQ(window.Current()->Path(), QFileInfo(first).canonicalFilePath());
  EXPECT_EQ(RecentFiles().mid(0, 2),
            (QStringList{QFileInfo(second).canonicalFilePath(), window.Current()->Path()}));
  QFile::remove(second);
  EXPECT_EQ(RecentFiles().front(), window.Current()->Path()) << "files that are gone are not offered";
}

TEST_F(Host, TellsOfAFileThatDoesNotLoadAndOpensNothing) {
  EXPECT_FALSE(window.OpenFile(QString::fromStdString(folder.File("missing.tessal"))));
  const QString cut = QString::fromStdString(folder.Write("cut.tessal", "[TESSAL_SETUP]\n[CONSTANTS]\nDESC"));
  EXPECT_FALSE(window.OpenFile(cut));
  EXPECT_EQ(window.DocumentCount(), 0);
  ASSERT_EQ(boxes.texts.size(), 2);
  EXPECT_TRUE(boxes.texts[0].startsWith("Failed to load file '")) << boxes.texts[0].toStdString();
  EXPECT_TRUE(boxes.texts[0].contains("-FATAL-"));
}

TEST_F(Host, SavesWhatIsBeingEnteredAndTakesTheMarkOff) {
  const QString path = Model("m.tessal");
  ASSERT_TRUE(window.OpenFile(path));
  EXPECT_EQ(window.windowTitle(), QString::fromUtf8("m.tessal \u2013 Tessal"));
  EXPECT_EQ(QApplication::focusWidget()->objectName(), "1127") << "the keyboard begins in the tree";
  Edit("typed");
  EXPECT_TRUE(window.SaveCurrent());
  EXPECT_TRUE(QString::fromStdString(test::ReadFile(path.toStdString())).contains("typed"));
  EXPECT_EQ(window.windowTitle(), QString::fromUtf8("m.tessal \u2013 Tessal"));
  Edit(" more");
  window.Current()->View().OnCommit();
  EXPECT_EQ(window.windowTitle(), QString::fromUtf8("m.tessal - Modified \u2013 Tessal"));
  EXPECT_EQ(window.findChild<QTabWidget*>()->tabText(0), "m.tessal - Modified");
}

TEST_F(Host, NewDocumentsAskForAName) {
  window.NewDocument();
  window.NewDocument();
  EXPECT_EQ(window.Current()->Title(), "Tessal2");
  boxes.saveAs = QString::fromStdString(folder.File("made"));
  EXPECT_TRUE(window.SaveCurrent());
  EXPECT_EQ(window.Current()->Title(), "made.tessal");
  EXPECT_TRUE(QFile::exists(boxes.saveAs + ".tessal"));
  // A file that another tab holds is not written over.
  window.NewDocument();
  boxes.saveAs += ".tessal";
  boxes.answers = {QMessageBox::Yes};
  EXPECT_FALSE(window.SaveCurrentAs());
  ASSERT_FALSE(boxes.texts.isEmpty());
  EXPECT_TRUE(boxes.texts.last().contains("open in another tab")) << boxes.texts.last().toStdString();
}

TEST_F(Host, AFailedSaveReachesTheUserAndLeavesTheDocumentModified) {
  const QString path = Model("m.tessal");
  ASSERT_TRUE(window.OpenFile(path));
  Edit("typed");
  std::filesystem::remove(path.toStdString());
  std::filesystem::create_directory(path.toStdString());
  boxes.answers = {QMessageBox::Yes};
  EXPECT_FALSE(window.SaveCurrent());
  ASSERT_FALSE(boxes.texts.isEmpty());
  EXPECT_TRUE(boxes.texts.last().startsWith("Failed to save file '")) << boxes.texts.last().toStdString();
  EXPECT_TRUE(window.Current()->Document().IsModified());
}

TEST_F(Host, AsksBeforeItWritesOverSomebodyElsesChange) {
  const QString path = Model("m.tessal");
  ASSERT_TRUE(window.OpenFile(path));
  Edit("mine");
  Model("m.tessal", "2");
  std::filesystem::last_write_time(path.toStdString(),
                                   std::filesystem::file_time_type::clock::now() + std::chrono::hours(1));
  boxes.answers = {QMessageBox::No, QMessageBox::Yes};
  EXPECT_FALSE(window.SaveCurrent());
  EXPECT_FALSE(QString::fromStdString(test::ReadFile(path.toStdString())).contains("mine"));
  EXPECT_TRUE(window.SaveCurrent());
  EXPECT_TRUE(QString::fromStdString(test::ReadFile(path.toStdString())).contains("mine"));
  EXPECT_EQ(boxes.texts.size(), 2);
}

TEST_F(Host, AsksBeforeUnsavedWorkIsLost) {
  const QString path = Model("m.tessal");
  ASSERT_TRUE(window.OpenFile(path));
  const std::string before = test::ReadFile(path.toStdString());
  Edit("typed");
  boxes.answers = {QMessageBox::Cancel, QMessageBox::Cancel, QMessageBox::Save};
  EXPECT_FALSE(window.CloseCurrent());
  EXPECT_FALSE(window.close()) << "Cancel keeps the window too";
  EXPECT_EQ(test::ReadFile(path.toStdString()), before);
  EXPECT_TRUE(window.CloseCurrent());
  EXPECT_TRUE(QString::fromStdString(test::ReadFile(path.toStdString())).contains("typed"));
  EXPECT_EQ(boxes.texts.size(), 3);
  EXPECT_EQ(window.DocumentCount(), 0);

  ASSERT_TRUE(window.OpenFile(path));
  Edit("thrown away");
  boxes.answers = {QMessageBox::Discard};
  EXPECT_TRUE(window.close());
  EXPECT_FALSE(QString::fromStdString(test::ReadFile(path.toStdString())).contains("thrown away"));
}

TEST_F(Host, EachTabShowsAndSavesByItsOwnMessages) {
  const QString good = Model("good.tessal");
  const QString faulty = Model("faulty.tessal", "-5");
  ASSERT_TRUE(window.OpenFile(good));
  ASSERT_TRUE(window.OpenFile(faulty));
  // The list of messages is one for all documents; the one in front fills it.
  window.findChild<QTabWidget*>()->setCurrentIndex(0);
  boxes.answers = {QMessageBox::Yes};
  EXPECT_TRUE(window.SaveCurrent());
  EXPECT_TRUE(boxes.texts.isEmpty());
  window.findChild<QTabWidget*>()->setCurrentIndex(1);
  EXPECT_TRUE(window.SaveCurrent());
  EXPECT_EQ(boxes.texts, QStringList{"This setup contains some errors or warnings.\nProceed anyway?"});
}

long ResidentKilobytes() {
  std::ifstream status("/proc/self/status");
  std::string word;
  while (status >> word) {
    long value = 0;
    if (word == "VmRSS:" && status >> value) return value;
  }
  return 0;
}

TEST_F(Host, FiftyDocumentsLeaveNothingBehind) {
  const QString path = QStringLiteral(TESSAL_SOURCE_DIR "/examples/eutrophication.tessal");
  const auto openAndClose = [this, &path](int times) {
    for (int time = 0; time < times; ++time) {
      ASSERT_TRUE(window.OpenFile(path));
      QCoreApplication::processEvents();
      ASSERT_TRUE(window.CloseCurrent());
      QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
  };
  constexpr int kHalf = 25;
  openAndClose(kHalf);
  const long before = ResidentKilobytes();
  openAndClose(kHalf);
  // A document of this size with its view holds about a megabyte: each one that stayed would show.
  constexpr long kMostGrowth = 15L * 1024;
  EXPECT_LT(ResidentKilobytes() - before, kMostGrowth);
}

}  // namespace
}  // namespace tessal
