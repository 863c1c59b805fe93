#include "app/recent_files.h"

#include <QFileInfo>
#include <QSettings>
#include <algorithm>

namespace tessal {

namespace {

const QString kKey = QStringLiteral("recentFiles");

}  // namespace

QStringList RecentFiles() {
  QStringList files = QSettings().value(kKey).toStringList();
  files.erase(std::remove_if(files.begin(), files.end(),
                             [](const QString& path) { return !QFileInfo::exists(path); }),
              files.end());
  return files;
}

void AddRecentFile(const QString& path) {
  const QString full = QFileInfo(path).absoluteFilePath();
  QStringList files = QSettings().value(kKey).toStringList();
  files.removeAll(full);
  files.prepend(full);
  QSettings().setValue(kKey, files.mid(0, kMostRecentFiles));
}

QString RecentFileCaption(const QString& path) {
  const QFileInfo file(path);
  QString caption = file.fileName() + QStringLiteral("  \u2013  ") + file.path();
  return caption.replace(u'&', QStringLiteral("&&"));
}

void ClearRecentFiles() {
  QSettings().remove(kKey);
}

}  // namespace tessal
