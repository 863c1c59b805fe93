// A document that the host holds open: the document, the view on it, and what the host knows of its file.
#pragma once

#include <QDateTime>
#include <QString>
#include <memory>

#include "platform/docview.h"

namespace tessal {

class OpenDocument final {
 public:
  explicit OpenDocument(std::unique_ptr<CDocument> made) : document(std::move(made)) {}

  /// Makes the view; the host then puts its widget into a tab.
  void Show(const CMultiDocTemplate& docTemplate) { view = docTemplate.CreateView(*document); }

  CDocument& Document() const { return *document; }
  CView& View() const { return *view; }
  QWidget* Widget() const { return view->Widget(); }
  QString Title() const { return QString::fromStdString(document->Title()); }

  /// The path of the document's file; empty before the first save.
  QString Path() const;
  bool Open(const QString& path);
  /// Saves what the document holds; the caller commits what is being entered. The document stays modified,
  /// and keeps its name, when that fails.
  bool Save(const QString& path);
  /// Whether the document's file was written by somebody else since this document read or wrote it.
  bool IsFileChanged() const;

 private:
  void TakeName(const QString& path);

  std::unique_ptr<CDocument> document;
  std::unique_ptr<CView> view;  // goes before the document that it looks at
  QDateTime fileTime;
};

}  // namespace tessal
