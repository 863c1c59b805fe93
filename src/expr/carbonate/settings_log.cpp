#include "expr/carbonate/settings_log.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>

#include "expr/carbonate/options.h"

namespace tessal {

namespace {

// "calcualtion" is the word by which readers of these files know them.
constexpr std::string_view kFirstLine = "# Tessal pH calcualtion log file\n";
constexpr std::string_view kSecondLine = "# Constant settings\n";

std::string& Problems() {
  static std::string problems;
  return problems;
}

/// A file that was made just now, or none when the name is taken. Links are not followed.
Descriptor NewLog(const std::string& path) {
  constexpr mode_t kReadWriteForAll = 0666;
  return Descriptor(open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, kReadWriteForAll));
}

/// A log of earlier, emptied; none for anything else, a link or one of several names of a file included.
Descriptor OlderLog(const std::string& path) {
  Descriptor file(open(path.c_str(), O_RDWR | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
  struct stat status = {};
  std::array<char, kFirstLine.size()> start{};
  const bool isLog = file.IsOpen() && fstat(file.Number(), &status) == 0 && S_ISREG(status.st_mode) &&
                     status.st_nlink == 1 && pread(file.Number(), start.data(), start.size(), 0) > 0 &&
                     std::string_view(start.data(), start.size()) == kFirstLine;
  return isLog && ftruncate(file.Number(), 0) == 0 ? std::move(file) : Descriptor();
}

bool IsNameTaken(const std::string& path) {
  struct stat status = {};
  return lstat(path.c_str(), &status) == 0;
}

}  // namespace

void SettingsLog::Name(const std::string& path) {
  Close();
  name = path;
}

void SettingsLog::Close() {
  file = Descriptor();
  name.clear();
  kept.clear();
}

void SettingsLog::WriteLine(std::string_view line) {
  if (name.empty()) return;
  std::string text(line);
  text += '\n';
  if (isReading && !IsOpen()) {
    kept += text;
    return;
  }
  if (!IsOpen()) Open();
  if (IsOpen()) Write(text);
}

void SettingsLog::Open() {
  file = NewLog(name);
  if (!IsOpen()) file = OlderLog(name);
  if (IsOpen()) {
    Write(std::string(kFirstLine).append(kSecondLine).append(kept));
    kept.clear();
  } else {
    GiveUp(IsNameTaken(name) ? "is not replaced: it is no earlier log" : "cannot be opened");
  }
}

void SettingsLog::Write(std::string_view text) {
  if (!WriteAll(file.Number(), text)) GiveUp("cannot be written");
}

void SettingsLog::GiveUp(std::string_view problem) {
  NoteCarbonateProblem("The log file '" + name + "' " + std::string(problem));
  Close();
}

SettingsLog& CarbonateLog() {
  static SettingsLog log;
  return log;
}

void NoteCarbonateProblem(std::string_view problem) {
  std::string& problems = Problems();
  if (!problems.empty()) problems += "; ";
  problems += problem;
}

void ForgetCarbonateProblems() {
  Problems().clear();
}

const std::string& CarbonateProblem() {
  return Problems();
}

}  // namespace tessal
