#include "cli/file_progress.h"

#include <unistd.h>

#include <cstdio>

#include "cli/output.h"

namespace tessal::cli {

namespace {

/// Fewer are done before anybody can read how far it is.
constexpr std::size_t kManyFiles = 20;
/// How often the line is written again, whatever the number of files.
constexpr std::size_t kSteps = 100;

bool IsTerminal() {
  return isatty(STDERR_FILENO) != 0;
}

std::string Counted(std::size_t count, const char* what) {
  return std::to_string(count) + " " + what + (count == 1 ? "" : "s");
}

}  // namespace

void MessageCount::AddFile(std::size_t messagesOfFile) {
  ++files;
  messages += messagesOfFile;
  if (messagesOfFile > 0) ++filesWithMessages;
}

std::string MessageCount::Text() const {
  if (messages == 0) return "no messages in " + Counted(files, "file");
  const std::string of = filesWithMessages == files ? "" : std::to_string(filesWithMessages) + " of ";
  return Counted(messages, "message") + " in " + of + Counted(files, "file");
}

void ShowCount(const MessageCount& count) {
  if (!IsTerminal()) return;
  FlushOutput();
  std::fprintf(stderr, "%s\n", count.Text().c_str());
}

FileProgress::FileProgress(std::size_t fileCount)
    : files(fileCount), isWanted(fileCount >= kManyFiles && IsTerminal()) {}

void FileProgress::Next() {
  if (!isWanted) return;
  ++begun;
  const bool isStep = begun * kSteps / files != (begun - 1) * kSteps / files;
  if (!isStep) return;
  std::fprintf(stderr, "\r%zu of %zu files", begun, files);
  isShown = true;
}

void FileProgress::Hide() {
  if (isShown) std::fputs("\r\x1b[K", stderr);
  isShown = false;
}

}  // namespace tessal::cli
