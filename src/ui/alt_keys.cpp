#include "ui/alt_keys.h"

namespace tessal {

namespace {

/// What the menus of a host open with.
const QString kMenuKeys = QStringLiteral("fegyvh");

bool StartsWord(const QString& label, qsizetype place) {
  return place == 0 || !label[place - 1].isLetterOrNumber();
}

bool AnyPlace(const QString& /*label*/, qsizetype /*place*/) {
  return true;
}

}  // namespace

QStringList WithAltKeys(const QStringList& labels) {
  QStringList marked = labels;
  QString taken = kMenuKeys;
  for (const auto mayBeKey : {StartsWord, AnyPlace}) {
    for (QString& label : marked) {
      for (qsizetype place = 0; place < label.size() && !label.contains(u'&'); ++place) {
        const QChar letter = label[place];
        if (!letter.isLetter() || !mayBeKey(label, place) || taken.contains(letter, Qt::CaseInsensitive))
          continue;
        taken.append(letter);
        label.insert(place, u'&');
      }
    }
  }
  return marked;
}

}  // namespace tessal
