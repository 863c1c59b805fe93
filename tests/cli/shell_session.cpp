#include "cli/shell_session.h"

#include <sys/wait.h>

#include <cstdlib>
#include <filesystem>

namespace tessal::test {

ShellSession::ShellSession() {
  std::filesystem::copy(TESSAL_SOURCE_DIR "/examples", folder.Path() / "examples");
  std::filesystem::create_directory(folder.Path() / "build");
}

void ShellSession::Write(const std::string& name, const std::string& content) const {
  folder.Write(name, content);
}

ShellRun ShellSession::Run(const std::string& command) const {
  const std::string output = results.File("output");
  const std::string errors = results.File("errors");
  const std::string line = "unset NO_COLOR; export LC_ALL=C PATH='" TESSAL_TOOL_FOLDER "':\"$PATH\"; cd '" +
                           folder.Path().string() + "' && (" + command + "\n) </dev/null >'" + output +
                           "' 2>'" + errors + "'";
  const int status = std::system(line.c_str());
  return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, ReadFile(output), ReadFile(errors)};
}

}  // namespace tessal::test
