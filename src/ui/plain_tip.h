// Texts of a template as tips: plain, whatever they hold, and wrapped at a width that can be read.
#pragma once

#include <QString>

namespace tessal {

/// A tip guesses whether its text is rich; this one says so, and shows every character as it is.
inline QString PlainTip(const QString& text) {
  return QStringLiteral("<qt>") + text.toHtmlEscaped() + QStringLiteral("</qt>");
}

}  // namespace tessal
