// The log of the carbonate settings, a text file that the option file may ask for, and the word that reaches
// the user when the option file or the log is at fault. Whoever starts a program in a folder has not asked
// for what its option file says: naming a log touches no file, and only an older log is ever replaced.
#pragma once

#include <string>
#include <string_view>

#include "platform/descriptor.h"

namespace tessal {

class SettingsLog final {
 public:
  /// Closes an open log. The lines from now on are for the file of that name.
  void Name(const std::string& path);

  /// From here to `EndReading` lines of a log that is not open yet are kept for it: the option file's reading
  /// is no computation.
  void BeginReading() { isReading = true; }
  void EndReading() { isReading = false; }

  /// Writes one line, at once; does nothing while no log is named. The first line of a computation opens the
  /// file, with a heading. A log that cannot be opened, that would replace something else, or that takes no
  /// more is given up, and the problem noted.
  void WriteLine(std::string_view line);

  bool IsOpen() const { return file.IsOpen(); }
  void Close();

 private:
  void Open();
  void Write(std::string_view text);
  /// Notes the problem, and that there is no log from now on.
  void GiveUp(std::string_view problem);

  std::string name;
  std::string kept;
  Descriptor file;
  bool isReading = false;
};

/// The log of the process. Once opened it stays open until the process ends or another file takes its place.
SettingsLog& CarbonateLog();

/// Adds to what `CarbonateProblem` says.
void NoteCarbonateProblem(std::string_view problem);

/// Forgets the problems of an earlier reading.
void ForgetCarbonateProblems();

}  // namespace tessal
