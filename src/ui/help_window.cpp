#include "ui/help_window.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QMessageBox>
#include <QTextBrowser>
#include <QUrl>
#include <array>

#include "ui/child.h"
#include "ui/strings.h"

namespace tessal {

namespace {

const QString kWindowName = QStringLiteral("help");
const QString kPage = QStringLiteral("TessalOnline.html");
constexpr QSize kUsualSize(720, 560);

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

}  // namespace

QString FindHelpPage(const QString& programFolder) {
  // A folder that is not known would be the current one, which holds whatever somebody put there.
  if (QDir::isRelativePath(programFolder)) return {};
  for (const char* folder : kFolders) {
    const QString path = QDir(programFolder).filePath(QString::fromLatin1(folder) + u'/' + kPage);
    if (QFileInfo::exists(path)) return QDir::cleanPath(path);
  }
  return {};
}

void OpenHelp(QWidget* parent, int topic) {
  const QString programFolder = QCoreApplication::applicationDirPath();
  const QString path = FindHelpPage(programFolder);
  if (path.isEmpty()) {
    QMessageBox::warning(
        parent, strings::kError,
        QStringLiteral("The help page %1 is missing.").arg(QDir(programFolder).filePath(kPage)));
    return;
  }
  QTextBrowser& window = HelpWindowOf(*parent->window());
  QUrl url = QUrl::fromLocalFile(path);
  url.setFragment(QString::number(topic));
  window.setSource(url);
  window.show();
  window.raise();
  window.activateWindow();
}

}  // namespace tessal
