#include "ui/kept_splitter.h"

#include <QSettings>
#include <QSplitter>

namespace tessal {

void KeepSplitter(QSplitter& splitter) {
  const QString key = QStringLiteral("splitters/") + splitter.objectName();
  splitter.restoreState(QSettings().value(key).toByteArray());
  QObject::connect(&splitter, &QSplitter::splitterMoved, &splitter,
                   [&splitter, key] { QSettings().setValue(key, splitter.saveState()); });
}

}  // namespace tessal
