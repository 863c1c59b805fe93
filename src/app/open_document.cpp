#include "app/open_document.h"

#include <QFile>
#include <QFileInfo>

namespace tessal {

QString OpenDocument::Path() const {
  return QFile::decodeName(QByteArray::fromStdString(document->PathName()));
}

bool OpenDocument::Open(const QString& path) {
  if (!document->OnOpenDocument(QFile::encodeName(path).toStdString())) return false;
  TakeName(path);
  return true;
}

bool OpenDocument::Save(const QString& path) {
  if (!document->OnSaveDocument(QFile::encodeName(path).toStdString())) return false;
  TakeName(path);
  view->UpdateFrameTitle();
  return true;
}

bool OpenDocument::IsFileChanged() const {
  const QFileInfo file(Path());
  return fileTime.isValid() && file.exists() && file.lastModified() != fileTime;
}

void OpenDocument::TakeName(const QString& path) {
  document->SetPathName(QFile::encodeName(path).toStdString());
  fileTime = QFileInfo(path).lastModified();
}

}  // namespace tessal
