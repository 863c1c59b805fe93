// The unsaved work of a document, in a file of its own beside that of the document or in the user's state
// folder: written again and again while the document is edited, found at the next start when the process has
// ended before the work was saved or given up. Only its owner may read it, and it is whole at every moment.
#pragma once

#include <QList>
#include <QLockFile>
#include <QString>
#include <memory>
#include <string_view>

namespace tessal {

/// Unsaved work that nobody is busy with.
struct FoundWork {
  QString file;     ///< that holds the work
  QString path;     ///< of the document; empty for one without a file
  QString title{};  ///< what a document without a file was called; empty when that is not known

  bool IsThere() const { return !file.isEmpty(); }
};

/// The work left for the document at the path, the newer where there are two; none where nothing was left, or
/// what lies there is empty or somebody else's.
FoundWork FindWork(const QString& path);
/// All work that was left, also that of documents without a file, but for what running editors hold.
QList<FoundWork> FindAllWork();

class RecoveryFile final {
 public:
  /// For a document without a file.
  RecoveryFile() = default;
  /// For the document at the path.
  explicit RecoveryFile(const QString& path) : document(path) {}
  /// Goes on with what was found.
  explicit RecoveryFile(const FoundWork& work);

  /// Puts the content into the file, which is beside the document's or, where that cannot be, in the state
  /// folder. The empty text, or the reason; what was written before is then still there. The title is noted
  /// with the first content of a document without a file.
  QString Write(std::string_view content, const QString& title);
  /// Removes what was written or found.
  void Remove();

 private:
  QString WriteInState(std::string_view content);
  QString WriteUnnamed(std::string_view content, const QString& title);
  /// The file in the state folder; one without a document gets a name of its own.
  QString NameInState();

  QString document;
  QString written;  ///< the file that was written last, or tried; empty before the first write
  std::unique_ptr<QLockFile> inUse;  ///< of a document without a file, so that no other editor offers it
};

}  // namespace tessal
