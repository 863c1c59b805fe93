#include "ui/documentation_link.h"

#include <QDir>
#include <QFileInfo>
#include <QUrl>
#include <algorithm>
#include <array>

#include "platform/host_settings.h"
#include "ui/dialogs.h"
#include "ui/strings.h"

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

/// What may be done with a target that a template names. A template comes from anybody.
enum class Trust : std::uint8_t { Open, Ask, Refuse };

/// What a system shows and does not run, by the ends of file names.
constexpr std::array kDocuments = {"pdf", "doc",  "docx", "odt",  "rtf",  "txt", "md",  "htm",  "html",
                                   "ps",  "djvu", "xls",  "xlsx", "ods",  "csv", "ppt", "pptx", "odp",
                                   "tex", "png",  "jpg",  "gif",  "jpeg", "svg", "tif", "tiff"};

/// What starts something else though it has no execute permission.
constexpr std::array kStarters = {"desktop", "exe", "bat",      "cmd", "com",
                                  "sh",      "jar", "appimage", "run", "py"};

template <class Names>
bool IsOneOf(const Names& names, const QString& suffix) {
  return std::any_of(names.begin(), names.end(),
                     [&suffix](const char* name) { return suffix == QLatin1StringView(name); });
}

Trust TrustOfFile(const QString& path) {
  const QFileInfo named(path);
  const QFileInfo file(named.canonicalFilePath());
  if (!file.isFile() || file.isExecutable()) return Trust::Refuse;
  for (const QFileInfo& each : {named, file}) {
    if (IsOneOf(kStarters, each.suffix().toLower())) return Trust::Refuse;
  }
  const bool isDocument = IsOneOf(kDocuments, file.suffix().toLower());
  return isDocument && IsOneOf(kDocuments, named.suffix().toLower()) ? Trust::Open : Trust::Ask;
}

/// A name that leads nowhere may be tried: the system will not find it.
Trust TrustOf(const QString& target) {
  constexpr int kLongestDrive = 1;
  // The system finds files that are written in the manner of another one.
  for (const QString& path : {target, QString(target).replace(u'\\', u'/')}) {
    if (QFileInfo::exists(path)) return TrustOfFile(path);
  }
  const QUrl address(target, QUrl::StrictMode);
  if (address.isLocalFile()) {
    return QFileInfo::exists(address.toLocalFile()) ? TrustOfFile(address.toLocalFile()) : Trust::Open;
  }
  const QString scheme = address.scheme();
  const bool isWeb = scheme == QLatin1StringView("http") || scheme == QLatin1StringView("https");
  return isWeb || scheme.size() <= kLongestDrive ? Trust::Open : Trust::Ask;
}

/// What became of a target: opened, not found, or not opened because it is not to be.
enum class Opening : std::uint8_t { Opened, NotFound, Declined, Refused };

Opening Open(const QString& target, UserDialogs& dialogs) {
  switch (TrustOf(target)) {
    case Trust::Refuse:
      return Opening::Refused;
    case Trust::Ask:
      if (dialogs.Ask(nullptr, strings::kAskOpenTarget.arg(target)) != Answer::Yes) return Opening::Declined;
      break;
    case Trust::Open:
      break;
  }
  return dialogs.OpenWithSystem(target) ? Opening::Opened : Opening::NotFound;
}

}  // namespace

QString OpenDocumentationFile(const QString& text, UserDialogs& dialogs, const QString& folder) {
  if (text.isEmpty()) return {};
  const bool isRelative = !folder.isEmpty() && QFileInfo(text).isRelative() && QUrl(text).scheme().size() < 2;
  QStringList targets{isRelative ? QDir(folder).filePath(text) : text};
  const QString root = QString::fromStdString(InstallRoot());
  const QString manual = QDir(root).filePath(kManualsFolder + u'/' + text);
  if (!root.isEmpty() && QFileInfo::exists(manual)) targets.append(manual);
  const QString address = QString::fromStdString(ManualsAddress());
  if (!address.isEmpty()) targets.append(QStringLiteral("%1/2017/General/%2").arg(address, BareName(text)));
  for (const QString& target : targets) {
    const Opening opening = Open(target, dialogs);
    if (opening == Opening::Refused) return strings::kTargetRefused.arg(target);
    if (opening != Opening::NotFound) return {};
  }
  return FailureText(text, address.isEmpty() ? kNoManualsAddress : kFileNotFound);
}

}  // namespace tessal
