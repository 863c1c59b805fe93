#include "app/document_lock.h"

#include <QCoreApplication>
#include <QDateTime>
#include <QFile>
#include <QFileInfo>

#include "app/document_places.h"

namespace tessal {

namespace {

/// A lock that says nothing was left by a process that ended while it took it, once it has this age.
constexpr qint64 kSecondsToWrite = 5;

QString HolderOf(const QLockFile& lock) {
  qint64 process = 0;
  QString host;
  QString application;
  if (!lock.getLockInfo(&process, &host, &application))
    return QCoreApplication::translate("DocumentLock", "unknown process");
  return QCoreApplication::translate("DocumentLock", "process %1 on %2").arg(process).arg(host);
}

bool IsAbandoned(const QLockFile& lock) {
  qint64 process = 0;
  QString host;
  QString application;
  if (lock.getLockInfo(&process, &host, &application)) return false;
  const QDateTime made = QFileInfo(lock.fileName()).lastModified();
  return made.isValid() && made.secsTo(QDateTime::currentDateTime()) > kSecondsToWrite;
}

}  // namespace

TakenLock Lock(const QString& lockFile) {
  TakenLock taken{std::make_unique<QLockFile>(lockFile), {}};
  // However old: a document may be open for days.
  taken.lock->setStaleLockTime(0);
  if (taken.lock->tryLock(0)) return taken;
  if (taken.lock->error() == QLockFile::LockFailedError) {
    if (IsAbandoned(*taken.lock) && QFile::remove(lockFile) && taken.lock->tryLock(0)) return taken;
    if (taken.lock->error() == QLockFile::LockFailedError) taken.holder = HolderOf(*taken.lock);
  }
  taken.lock.reset();
  return taken;
}

TakenLock LockDocument(const QString& path) {
  TakenLock taken = Lock(BesideDocument(path, kLockSuffix));
  if (taken.lock || !taken.holder.isEmpty()) return taken;
  // It cannot be beside the file: the user's own editors at least learn of each other.
  return MakeStateFolder().isEmpty() ? Lock(InStateFolder(path, kLockSuffix)) : std::move(taken);
}

}  // namespace tessal
