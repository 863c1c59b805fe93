#include "app/watched_file.h"

#include <sys/stat.h>

#include <QCryptographicHash>
#include <QFile>
#include <QFileInfo>

namespace tessal {

namespace {

constexpr int kSettlingTime = 150;  // milliseconds

QByteArray ContentHash(const QString& path) {
  QFile opened(path);
  QCryptographicHash hash(QCryptographicHash::Sha1);
  return opened.open(QIODevice::ReadOnly) && hash.addData(&opened) ? hash.result() : QByteArray();
}

}  // namespace

WatchedFile::WatchedFile() {
  settling.setSingleShot(true);
  settling.setInterval(kSettlingTime);
  connect(&settling, &QTimer::timeout, this, &WatchedFile::Look);
  const auto settle = [this] { settling.start(); };
  connect(&watcher, &QFileSystemWatcher::fileChanged, this, settle);
  connect(&watcher, &QFileSystemWatcher::directoryChanged, this, settle);
}

WatchedFile::Stamp WatchedFile::StampOf(const QString& path) {
  struct stat status = {};
  if (stat(QFile::encodeName(path).constData(), &status) != 0) return {};
  return {true, status.st_mtim.tv_sec, status.st_mtim.tv_nsec, status.st_size, status.st_ino};
}

void WatchedFile::Watch(const QString& path) {
  if (!watcher.files().isEmpty()) watcher.removePaths(watcher.files());
  if (!watcher.directories().isEmpty()) watcher.removePaths(watcher.directories());
  file = path;
  TakeAsKnown();
}

void WatchedFile::TakeAsKnown() {
  stamp = StampOf(file);
  content = ContentHash(file);
  state = FileState::AsKnown;
  WatchAgain();
}

/// A file that was replaced is another one, and no longer watched; its folder still is.
void WatchedFile::WatchAgain() {
  if (file.isEmpty()) return;
  const QString folder = QFileInfo(file).path();
  if (!watcher.directories().contains(folder)) watcher.addPath(folder);
  if (!watcher.files().contains(file) && QFileInfo::exists(file)) watcher.addPath(file);
}

FileState WatchedFile::StateOnDisk() {
  const Stamp present = StampOf(file);
  if (present == stamp) return FileState::AsKnown;
  if (!present.exists) return FileState::Gone;
  if (!stamp.exists || ContentHash(file) != content) return FileState::Changed;
  stamp = present;
  return FileState::AsKnown;
}

FileState WatchedFile::Look() {
  if (file.isEmpty()) return state;
  WatchAgain();
  const FileState former = state;
  state = StateOnDisk();
  if (state != former) emit StateChanged();
  return state;
}

}  // namespace tessal
