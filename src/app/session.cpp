#include "app/session.h"

#include <QFileInfo>
#include <QSettings>

namespace tessal {

namespace {

const QString kFiles = QStringLiteral("session/files");
const QString kPath = QStringLiteral("path");
const QString kPlace = QStringLiteral("place");
const QString kFront = QStringLiteral("session/front");
const QString kRestores = QStringLiteral("session/restores");

}  // namespace

Session KeptSession() {
  Session session;
  QSettings settings;
  const int front = settings.value(kFront).toInt();
  const int count = settings.beginReadArray(kFiles);
  for (int number = 0; number < count; ++number) {
    settings.setArrayIndex(number);
    SessionFile file{settings.value(kPath).toString(), settings.value(kPlace).toByteArray().toStdString()};
    if (!QFileInfo::exists(file.path)) continue;
    if (number == front) session.front = static_cast<int>(session.files.size());
    session.files.push_back(std::move(file));
  }
  settings.endArray();
  return session;
}

void KeepSession(const Session& session) {
  QSettings settings;
  settings.remove(kFiles);
  settings.setValue(kFront, session.front);
  settings.beginWriteArray(kFiles);
  int number = 0;
  for (const SessionFile& file : session.files) {
    settings.setArrayIndex(number++);
    settings.setValue(kPath, file.path);
    settings.setValue(kPlace, QByteArray::fromStdString(file.place));
  }
  settings.endArray();
}

bool RestoresSession() {
  return QSettings().value(kRestores, false).toBool();
}

void SetRestoresSession(bool restores) {
  QSettings().setValue(kRestores, restores);
}

}  // namespace tessal
