// The log of the carbonate settings, a text file that the option file may ask for, and the word that reaches
// the user when the option file or the log is at fault.
#pragma once

#include <fstream>
#include <string>
#include <string_view>

namespace tessal {

class SettingsLog final {
 public:
  /// Closes an open log, opens the file for writing and writes its heading. False, with the problem noted, if
  /// it can't be opened.
  bool Open(const std::string& path);

  /// Writes one line, at once; does nothing while no log is open. A log that takes no more is closed, and the
  /// problem noted.
  void WriteLine(std::string_view line);

  bool IsOpen() const { return file.is_open(); }
  void Close() { file.close(); }

 private:
  std::ofstream file;
  std::string name;
};

/// The log of the process. Once opened it stays open until the process ends or another file takes its place.
SettingsLog& CarbonateLog();

/// Adds to what `CarbonateProblem` says.
void NoteCarbonateProblem(std::string_view problem);

/// Forgets the problems of an earlier reading.
void ForgetCarbonateProblems();

}  // namespace tessal
