#include "ui/documentation_link.h"

#include <QDir>
#include <QFileInfo>
#include <algorithm>

#include "platform/host_settings.h"
#include "ui/dialogs.h"

namespace tessal {

namespace {

constexpr int kFileNotFound = 2;
constexpr int kNoManualsAddress = -100;
const QString kManualsFolder = QStringLiteral("Corvane/Manuals/CORVANE");

/// The name after the last folder, whichever system the path comes from.
QString BareName(const QString& path) {
  return path.sliced(std::max(path.lastIndexOf(u'/'), path.lastIndexOf(u'\\')) + 1);
}

QString FailureText(const QString& text, int code) {
  return QStringLiteral("Failed to open\n%1\n\nReturn code %2 (0x%3)")
      .arg(text)
      .arg(code)
      .arg(static_cast<unsigned>(code) & 0xFFFFU, 4, 16, QChar(u'0'));
}

}  // namespace

QString OpenDocumentationFile(const QString& text, UserDialogs& dialogs, const QString& folder) {
  const bool isRelative = !folder.isEmpty() && QFileInfo(text).isRelative();
  if (text.isEmpty() || dialogs.OpenWithSystem(isRelative ? QDir(folder).filePath(text) : text)) return {};
  const QString root = QString::fromStdString(InstallRoot());
  if (!root.isEmpty()) {
    const QString manual = QDir(root).filePath(kManualsFolder + u'/' + text);
    if (QFileInfo::exists(manual) && dialogs.OpenWithSystem(manual)) return {};
  }
  const QString address = QString::fromStdString(ManualsAddress());
  if (address.isEmpty()) return FailureText(text, kNoManualsAddress);
  const QString target = QStringLiteral("%1/2017/General/%2").arg(address, BareName(text));
  return dialogs.OpenWithSystem(target) ? QString() : FailureText(text, kFileNotFound);
}

}  // namespace tessal
