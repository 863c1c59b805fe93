#include "app/open_document.h"

#include <QCoreApplication>
#include <QFile>
#include <QFileInfo>
#include <functional>
#include <optional>
#include <string>

namespace tessal {

namespace {

std::string Encoded(const QString& path) {
  return QFile::encodeName(path).toStdString();
}

}  // namespace

void OpenDocument::Show(const CMultiDocTemplate& docTemplate) {
  view = docTemplate.CreateView(*document);
  if (firstTitle.isEmpty()) firstTitle = QString::fromStdString(document->Title());
}

QString OpenDocument::Title() const {
  const QString title = QString::fromStdString(document->Title());
  return isReadOnly ? QCoreApplication::translate("OpenDocument", "%1 (read only)").arg(title) : title;
}

QString OpenDocument::Path() const {
  return QFile::decodeName(QByteArray::fromStdString(document->PathName()));
}

bool OpenDocument::Open(const QString& path) {
  file.Watch(path);
  if (!document->OnOpenDocument(Encoded(path))) return false;
  TakeName(path);
  return true;
}

bool OpenDocument::OpenCopy(const QString& path) {
  if (!document->OnOpenCopy(Encoded(path), {})) return false;
  isCopy = true;
  const QString title = QCoreApplication::translate("OpenDocument", "Copy of %1");
  document->SetTitle(title.arg(QFileInfo(path).fileName()).toStdString());
  return true;
}

bool OpenDocument::Recover(const FoundWork& work) {
  if (!work.path.isEmpty()) file.Watch(work.path);
  if (!document->OnOpenCopy(Encoded(work.file), Encoded(work.path))) return false;
  if (work.path.isEmpty()) {
    isCopy = true;
    firstTitle = QCoreApplication::translate("OpenDocument", "Recovered %1").arg(work.title).trimmed();
    document->SetTitle(firstTitle.toStdString());
  } else {
    TakeName(work.path);
  }
  recovery = RecoveryFile(work);
  document->SetModifiedFlag(true);
  return true;
}

bool OpenDocument::Save(const QString& path) {
  if (!document->OnSaveDocument(Encoded(path))) return false;
  DropWork();
  isReadOnly = false;
  file.Watch(path);
  TakeName(path);
  view->UpdateFrameTitle();
  return true;
}

void OpenDocument::TakeName(const QString& path) {
  document->SetPathName(Encoded(path));
  recovery = RecoveryFile(path);
}

void OpenDocument::SetReadOnly() {
  isReadOnly = true;
  // The file's own belongs to the editor that has the lock.
  recovery = RecoveryFile();
}

QString OpenDocument::KeepWork() {
  if (!document->IsModified() && !view->HasUncommitted()) {
    DropWork();
    return {};
  }
  std::optional<std::string> text;
  std::string reason;
  view->WithUncommitted([this, &text, &reason] { text = document->Copy(reason); });
  if (!text) return QString::fromStdString(reason);
  const std::size_t hash = std::hash<std::string>()(*text);
  if (hash == keptHash) return {};
  QString failure = recovery.Write(*text, firstTitle);
  if (failure.isEmpty()) keptHash = hash;
  return failure;
}

void OpenDocument::DropWork() {
  recovery.Remove();
  keptHash = 0;
}

}  // namespace tessal
