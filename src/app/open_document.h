// A document that the host holds open: the document, the view on it, and what the host knows of its file and
// keeps beside it.
#pragma once

#include <QLockFile>
#include <QString>
#include <cstddef>
#include <memory>

#include "app/recovery_file.h"
#include "app/watched_file.h"
#include "platform/docview.h"

namespace tessal {

class OpenDocument final {
 public:
  explicit OpenDocument(std::unique_ptr<CDocument> made) : document(std::move(made)) {}

  /// Makes the view; the host then puts its widget into a tab.
  void Show(const CMultiDocTemplate& docTemplate);

  CDocument& Document() const { return *document; }
  CView& View() const { return *view; }
  QWidget* Widget() const { return view->Widget(); }
  /// The document's title, and whether it is read-only.
  QString Title() const;

  /// The path of the document's file; empty before the first save.
  QString Path() const;

  // Opening. Each returns false when it failed; the document has then shown why.
  bool Open(const QString& path);
  /// Opens the content of a file in a document without one.
  bool OpenCopy(const QString& path);
  /// Opens unsaved work that was left.
  bool Recover(const FoundWork& work);

  /// Saves what the document holds; the caller commits what is being entered. The document stays modified,
  /// and keeps its name, when that fails.
  bool Save(const QString& path);

  /// The lock on the document's file; none where none is possible, and for a document without a file.
  void SetLock(std::unique_ptr<QLockFile> taken) { lock = std::move(taken); }
  std::unique_ptr<QLockFile> TakeLock() { return std::move(lock); }
  /// Another editor has the file: it is saved under other names only.
  void SetReadOnly();
  bool IsReadOnly() const { return isReadOnly; }
  /// Made by nothing but the command for new documents.
  bool IsFresh() const { return Path().isEmpty() && !isCopy; }

  WatchedFile& File() { return file; }

  /// Writes what is unsaved, committed or not, into the recovery file; removes that when nothing is unsaved.
  /// The empty text, or why it could not be written.
  QString KeepWork();
  /// The unsaved work was saved or given up.
  void DropWork();

 private:
  void TakeName(const QString& path);

  std::unique_ptr<CDocument> document;
  std::unique_ptr<CView> view;  // goes before the document that it looks at
  WatchedFile file;
  RecoveryFile recovery;
  QString firstTitle;        ///< by which its unsaved work is offered while it has no file
  std::size_t keptHash = 0;  ///< of the work that was written last
  std::unique_ptr<QLockFile> lock;
  bool isReadOnly = false;
  bool isCopy = false;
};

}  // namespace tessal
