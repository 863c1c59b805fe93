#include "app/document_places.h"

#include <QCryptographicHash>
#include <QDir>
#include <QFile>
#include <QFileInfo>

namespace tessal {

QString StateFolder() {
  const QString given = qEnvironmentVariable("XDG_STATE_HOME");
  const QString base =
      QDir::isAbsolutePath(given) ? given : QDir::home().filePath(QStringLiteral(".local/state"));
  return QDir(base).filePath(QStringLiteral("tessal"));
}

QString MakeStateFolder() {
  const QString folder = StateFolder();
  if (QFileInfo(folder).isDir()) return {};
  if (!QDir().mkpath(folder)) return QStringLiteral("can not make the folder '%1'").arg(folder);
  QFile::setPermissions(folder, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
  return {};
}

QString BesideDocument(const QString& path, const QString& suffix) {
  const QFileInfo file(path);
  return file.path() + QStringLiteral("/.~") + file.fileName() + suffix;
}

QString InStateFolder(const QString& path, const QString& suffix) {
  const QByteArray hash = QCryptographicHash::hash(QFile::encodeName(path), QCryptographicHash::Sha1);
  return QDir(StateFolder()).filePath(QString::fromLatin1(hash.toHex()) + suffix);
}

}  // namespace tessal
