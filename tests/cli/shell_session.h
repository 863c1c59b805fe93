// A shell in which the tool is at hand: commands run in a folder of their own, beside a copy of the examples.
#pragma once

#include <string>

#include "support/temporary_folder.h"

namespace tessal::test {

struct ShellRun {
  int exitCode = -1;
  std::string output;
  std::string errors;
};

class ShellSession final {
 public:
  ShellSession();

  /// Makes a file in the session's folder.
  void Write(const std::string& name, const std::string& content) const;
  /// Runs a command, pipes and redirections among it, with an empty standard input.
  ShellRun Run(const std::string& command) const;

 private:
  TemporaryFolder folder;
  TemporaryFolder results;
};

}  // namespace tessal::test
