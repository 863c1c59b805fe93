// The lock by which a second editor learns that a file is open in another. It lies beside the file, or, where
// that cannot be, in the user's state folder, and goes with the process that holds it.
#pragma once

#include <QLockFile>
#include <QString>
#include <memory>

namespace tessal {

inline const QString kLockSuffix = QStringLiteral(".lock");

/// The outcome of taking a lock. Without a holder and without a lock none is possible there.
struct TakenLock {
  std::unique_ptr<QLockFile> lock;
  QString holder;  ///< who has the lock, for people; empty when nobody else has
};

/// Takes a lock with that file. One whose process has died is taken over.
TakenLock Lock(const QString& lockFile);
/// Takes the lock of the document at the path.
TakenLock LockDocument(const QString& path);

}  // namespace tessal
