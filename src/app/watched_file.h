// What others do to the file of an open document, reported as soon as it happens: rewritten in place,
// replaced by a rename, or deleted. A write that leaves the content as it was is no change.
#pragma once

#include <QByteArray>
#include <QFileSystemWatcher>
#include <QObject>
#include <QString>
#include <QTimer>
#include <cstdint>

namespace tessal {

enum class FileState : std::uint8_t { AsKnown, Changed, Gone };

class WatchedFile final : public QObject {
  Q_OBJECT

 public:
  WatchedFile();

  /// Watches the file at the path, which counts as known as it is now: before a load, so that nothing written
  /// during it is missed, and after a save.
  void Watch(const QString& path);
  /// Looks at the disk.
  FileState Look();
  /// What the last look has found.
  FileState State() const { return state; }
  /// What the last look has found is known from now on.
  void TakeAsKnown();

 signals:
  /// A look has found another state than the last one.
  void StateChanged();

 private:
  /// What changes when a file is written, without its content.
  struct Stamp {
    bool exists = false;
    std::int64_t seconds = 0;
    std::int64_t nanoseconds = 0;
    std::int64_t size = 0;
    std::uint64_t inode = 0;
    bool operator==(const Stamp&) const = default;
  };

  static Stamp StampOf(const QString& path);
  FileState StateOnDisk();
  void WatchAgain();

  QString file;
  Stamp stamp;
  QByteArray content;  ///< its hash
  FileState state = FileState::AsKnown;
  QFileSystemWatcher watcher;
  QTimer settling;  ///< a program may need several steps for what is one change
};

}  // namespace tessal
