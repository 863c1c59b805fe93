#include "expr/carbonate/settings_log.h"

#include "expr/carbonate/options.h"

namespace tessal {

namespace {

// "calcualtion" is the word by which readers of these files know them.
constexpr std::string_view kHeading[] = {"# Tessal pH calcualtion log file", "# Constant settings"};

std::string& Problems() {
  static std::string problems;
  return problems;
}

}  // namespace

bool SettingsLog::Open(const std::string& path) {
  file.close();
  file.clear();
  file.open(path);
  if (!file) {
    file.close();
    NoteCarbonateProblem("The log file '" + path + "' cannot be opened");
    return false;
  }
  name = path;
  for (const std::string_view line : kHeading) WriteLine(line);
  return file.is_open();
}

void SettingsLog::WriteLine(std::string_view line) {
  if (!file.is_open()) return;
  file << line << '\n' << std::flush;
  if (file) return;
  file.close();
  NoteCarbonateProblem("The log file '" + name + "' cannot be written");
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
