// A program that runs beside a test, and ends with the object that started it.
#pragma once

#include <sys/types.h>

#include <chrono>
#include <string>
#include <vector>

namespace tessal::test {

class Program final {
 public:
  /// Starts a program, in a process group of its own, so that what it starts itself ends with it. The word
  /// `{report}` in its arguments becomes the number of a file descriptor that it may report on.
  explicit Program(std::vector<std::string> words);
  Program(const Program&) = delete;
  Program& operator=(const Program&) = delete;
  ~Program();

  /// The first line that the program wrote to the descriptor of its reports; empty when it wrote none in
  /// time.
  std::string FirstReport(std::chrono::milliseconds limit) const;

  pid_t Id() const { return process; }
  bool IsRunning() const;

 private:
  pid_t process = -1;
  int reports = -1;
};

/// Whether a program of that name, or path, can be run.
bool CanRun(const std::string& program);

}  // namespace tessal::test
