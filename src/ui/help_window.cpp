#include "ui/help_window.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QMessageBox>
#include <QTextBrowser>
#include <QUrl>
#include <array>

#include "expr/builtin_reference.h"
#include "expr/function_reference.h"
#include "expr/word_reference.h"
#include "ui/child.h"
#include "ui/strings.h"

namespace tessal {

namespace {

const QString kWindowName = QStringLiteral("help");
const QString kTopics = QStringLiteral("TessalOnline.html");
const QString kGuide = QStringLiteral("guide/index.html");
const QString kFunctions = QStringLiteral("Functions.html");
const QString kBuiltins = QStringLiteral("Builtins.html");
/// Wide enough for the pictures of the guide.
constexpr QSize kUsualSize(920, 700);

/// Where the page may lie, seen from the executable.
constexpr std::array<const char*, 2> kFolders = {".", "../share/tessal"};

/// The one help window of a window; it goes with it.
QTextBrowser& HelpWindowOf(QWidget& owner) {
  auto* window = owner.findChild<QTextBrowser*>(kWindowName, Qt::FindDirectChildrenOnly);
  if (window == nullptr) {
    window = MakeChild<QTextBrowser>(&owner);
    window->setObjectName(kWindowName);
    window->setWindowFlag(Qt::Window);
    window->setWindowTitle(strings::kHelp);
    window->setOpenExternalLinks(true);
    window->resize(kUsualSize);
  }
  return *window;
}

QString FindPage(const QString& programFolder, const QString& page) {
  // A folder that is not known would be the current one, which holds whatever somebody put there.
  if (QDir::isRelativePath(programFolder)) return {};
  for (const char* folder : kFolders) {
    const QString path = QDir(programFolder).filePath(QString::fromLatin1(folder) + u'/' + page);
    if (QFileInfo::exists(path)) return QDir::cleanPath(path);
  }
  return {};
}

void ShowPage(QWidget* parent, const QString& page, const QString& anchor) {
  const QString programFolder = QCoreApplication::applicationDirPath();
  const QString path = FindPage(programFolder, page);
  if (path.isEmpty()) {
    QMessageBox::warning(
        parent, strings::kError,
        QStringLiteral("The help page %1 is missing.").arg(QDir(programFolder).filePath(page)));
    return;
  }
  QTextBrowser& window = HelpWindowOf(*parent->window());
  QUrl url = QUrl::fromLocalFile(path);
  url.setFragment(anchor);
  window.setSource(url);
  window.show();
  window.raise();
  window.activateWindow();
}

}  // namespace

QString FindHelpPage(const QString& programFolder) {
  return FindPage(programFolder, kTopics);
}

void OpenHelp(QWidget* parent, int topic) {
  ShowPage(parent, kTopics, QString::number(topic));
}

void OpenGuide(QWidget* parent) {
  ShowPage(parent, kGuide, {});
}

void OpenReference(QWidget* parent, const QString& name) {
  const std::string text = name.toStdString();
  if (const BuiltinReference* builtin = ReferenceOfBuiltin(text)) {
    ShowPage(parent, kBuiltins, QString::fromStdString(std::string(builtin->name)));
    return;
  }
  std::string_view anchor;
  if (const FunctionReference* function = ReferenceOfFunction(text)) anchor = function->name;
  if (const WordReference* word = ReferenceOfWord(text)) anchor = word->word;
  ShowPage(parent, kFunctions, QString::fromStdString(std::string(anchor)));
}

}  // namespace tessal
