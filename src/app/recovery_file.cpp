#include "app/recovery_file.h"

#include <sys/stat.h>
#include <unistd.h>

#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QUuid>

#include "app/document_lock.h"
#include "app/document_places.h"
#include "platform/file_replacement.h"

namespace tessal {

namespace {

const QString kWorkSuffix = QStringLiteral(".recovery");
const QString kPathSuffix = QStringLiteral(".path");
const QString kTitleSuffix = QStringLiteral(".title");
const QString kUnnamedPrefix = QStringLiteral("unnamed-");

std::string Encoded(const QString& path) {
  return QFile::encodeName(path).toStdString();
}

/// A plain file of this user: whoever put a link or a file of theirs there gets nothing written into it.
bool IsOwnFile(const QString& path) {
  struct stat status = {};
  return lstat(Encoded(path).c_str(), &status) == 0 && S_ISREG(status.st_mode) && status.st_uid == geteuid();
}

bool IsThere(const QString& path) {
  struct stat status = {};
  return lstat(Encoded(path).c_str(), &status) == 0;
}

bool HoldsWork(const QString& file) {
  return IsOwnFile(file) && QFileInfo(file).size() > 0;
}

/// Writes in one step into a file that only its owner may read. The empty text, or the reason.
QString WritePrivate(const QString& file, std::string_view content) {
  if (IsThere(file) && !IsOwnFile(file))
    return QStringLiteral("can not replace '%1': it is no file of this user").arg(file);
  return QString::fromStdString(WriteFreshFile(Encoded(file), content));
}

/// Notes which document has work left, for the next start. Work that no note names is offered when its
/// document is opened, and not before: a failure is no loss.
void NoteDocument(const QString& path) {
  if (!MakeStateFolder().isEmpty()) return;
  WriteFreshFile(Encoded(InStateFolder(path, kPathSuffix)), Encoded(path));
}

void RemoveOwn(const QString& file) {
  if (IsOwnFile(file)) QFile::remove(file);
}

QString ReadNote(const QString& note) {
  std::string failure;
  const std::optional<std::string> path = ReadWholeFile(Encoded(note), failure);
  return path ? QFile::decodeName(QByteArray::fromStdString(*path)) : QString();
}

/// One line, whoever wrote it.
QString ReadTitle(const QString& work) {
  return IsOwnFile(work + kTitleSuffix) ? ReadNote(work + kTitleSuffix).simplified() : QString();
}

}  // namespace

FoundWork FindWork(const QString& path) {
  FoundWork found{QString(), path};
  for (const QString& file : {BesideDocument(path, kWorkSuffix), InStateFolder(path, kWorkSuffix)}) {
    const bool isNewer =
        found.file.isEmpty() || QFileInfo(file).lastModified() > QFileInfo(found.file).lastModified();
    if (HoldsWork(file) && isNewer) found.file = file;
  }
  return found;
}

QList<FoundWork> FindAllWork() {
  QList<FoundWork> works;
  const QDir folder(StateFolder());
  for (const QString& note : folder.entryList({u'*' + kPathSuffix}, QDir::Files, QDir::Name)) {
    const QString path = ReadNote(folder.filePath(note));
    if (!path.isEmpty() && !LockDocument(path).holder.isEmpty()) continue;
    const FoundWork work = FindWork(path);
    if (!path.isEmpty() && work.IsThere()) {
      works.append(work);
    } else {
      QFile::remove(folder.filePath(note));
    }
  }
  const QStringList unnamed =
      folder.entryList({kUnnamedPrefix + u'*' + kWorkSuffix}, QDir::Files, QDir::Time);
  for (const QString& name : unnamed) {
    const QString file = folder.filePath(name);
    if (HoldsWork(file) && Lock(file + kLockSuffix).holder.isEmpty())
      works.append({file, QString(), ReadTitle(file)});
  }
  return works;
}

RecoveryFile::RecoveryFile(const FoundWork& work) : document(work.path), written(work.file) {
  if (document.isEmpty()) inUse = Lock(written + kLockSuffix).lock;
}

QString RecoveryFile::Write(std::string_view content, const QString& title) {
  if (document.isEmpty()) return WriteUnnamed(content, title);
  if (written.isEmpty()) NoteDocument(document);
  const QString beside = BesideDocument(document, kWorkSuffix);
  if (!WritePrivate(beside, content).isEmpty()) return WriteInState(content);
  // What was left in the other place is older.
  if (written != beside) RemoveOwn(InStateFolder(document, kWorkSuffix));
  written = beside;
  return {};
}

QString RecoveryFile::WriteInState(std::string_view content) {
  if (QString failure = MakeStateFolder(); !failure.isEmpty()) return failure;
  // Also where the writing fails: it may be in place, with its lasting in doubt.
  written = NameInState();
  return WritePrivate(written, content);
}

QString RecoveryFile::WriteUnnamed(std::string_view content, const QString& title) {
  QString failure = WriteInState(content);
  // Work without a title is offered all the same.
  const QString noted = written + kTitleSuffix;
  if (failure.isEmpty() && !IsThere(noted)) WriteFreshFile(Encoded(noted), Encoded(title));
  return failure;
}

QString RecoveryFile::NameInState() {
  if (!document.isEmpty()) return InStateFolder(document, kWorkSuffix);
  if (!written.isEmpty()) return written;
  const QString name = kUnnamedPrefix + QUuid::createUuid().toString(QUuid::WithoutBraces) + kWorkSuffix;
  QString file = QDir(StateFolder()).filePath(name);
  inUse = Lock(file + kLockSuffix).lock;
  return file;
}

void RecoveryFile::Remove() {
  if (written.isEmpty()) return;
  if (document.isEmpty()) RemoveOwn(written + kTitleSuffix);
  RemoveOwn(written);
  written.clear();
  inUse.reset();
  if (document.isEmpty()) return;
  RemoveOwn(BesideDocument(document, kWorkSuffix));
  RemoveOwn(InStateFolder(document, kWorkSuffix));
  RemoveOwn(InStateFolder(document, kPathSuffix));
}

}  // namespace tessal
