// What a person at a terminal sees of a call over several files: how far it is, and at its end how much it
// found. Both go to standard error, and neither into a pipe.
#pragma once

#include <cstddef>
#include <string>

namespace tessal::cli {

/// Messages counted over files.
struct MessageCount {
  std::size_t messages = 0;
  std::size_t filesWithMessages = 0;
  std::size_t files = 0;

  void AddFile(std::size_t messagesOfFile);
  /// Such as "3 messages in 2 of 14 files".
  std::string Text() const;
};

/// Writes what was printed so far, and then the count, where standard error is a terminal.
void ShowCount(const MessageCount& count);

/// One line that is written again as the files are gone through, and is gone at the end. A call over a few
/// files shows none.
class FileProgress final {
 public:
  explicit FileProgress(std::size_t fileCount);
  FileProgress(const FileProgress&) = delete;
  FileProgress& operator=(const FileProgress&) = delete;
  ~FileProgress() { Hide(); }

  /// The next file is begun.
  void Next();
  /// Takes the line away, so that something else can be written.
  void Hide();

 private:
  std::size_t files;
  std::size_t begun = 0;
  bool isShown = false;
  bool isWanted;
};

}  // namespace tessal::cli
