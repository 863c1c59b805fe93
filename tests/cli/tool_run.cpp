#include "cli/tool_run.h"

#include <sys/wait.h>

#include <cstdlib>

#include "support/temporary_folder.h"

namespace tessal::test {

namespace {

std::string ShellQuoted(const std::string& text) {
  std::string quoted = "'";
  for (const char character : text)
    quoted += character == '\'' ? std::string("'\\''") : std::string(1, character);
  return quoted + "'";
}

}  // namespace

int RunShell(const std::string& line) {
  const int status = std::system(("T=" + ShellQuoted(TESSAL_TOOL) + "; " + line).c_str());
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

ToolRun RunTool(const std::vector<std::string>& arguments, const std::string& input,
                const std::string& folder) {
  const TemporaryFolder scratch;
  std::string line = "cd " + ShellQuoted(folder) + " && \"$T\"";
  for (const std::string& argument : arguments) line += " " + ShellQuoted(argument);
  line += " <" + scratch.Write("in", input) + " >" + scratch.File("out") + " 2>" + scratch.File("err");
  ToolRun run;
  run.exitCode = RunShell(line);
  run.output = ReadFile(scratch.File("out"));
  run.errors = ReadFile(scratch.File("err"));
  return run;
}

}  // namespace tessal::test
