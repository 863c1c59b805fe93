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

/// The path of the page, or of the first place where it was looked for when it lies nowhere.
QString HelpPagePath() {
  const QDir programs(QCoreApplication::applicationDirPath());
  // A folder that is not known would be the current one, which holds whatever somebody put there.
  if (programs.isRelative()) return kPage;
  for (const char* folder : kFolders) {
    const QString path = programs.filePath(QString::fromLatin1(folder) + u'/' + kPage);
    if (QFileInfo::exists(path)) return QDir::cleanPath(path);
  }
  return programs.filePath(kPage);
}

}  // namespace

void OpenHelp(QWidget* parent, int topic) {
  const QString path = HelpPagePath();
  if (QDir::isRelativePath(path) || !QFileInfo::exists(path)) {
    QMessageBox::warning(parent, strings::kError, QStringLiteral("The help page %1 is missing.").arg(path));
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
