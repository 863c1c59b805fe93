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

void OpenInSplitter(QWidget& part, int usualHeight) {
  if (part.isVisible()) return;
  part.show();
  auto* splitter = qobject_cast<QSplitter*>(part.parentWidget());
  if (splitter == nullptr || part.height() >= usualHeight) return;
  QList<int> sizes = splitter->sizes();
  const int missing = usualHeight - part.height();
  // What lies above gives the room that it has.
  sizes[0] -= missing;
  sizes[splitter->indexOf(&part)] += missing;
  splitter->setSizes(sizes);
}

}  // namespace tessal
