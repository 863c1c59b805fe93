// A run of the real tool, for tests.
#pragma once

#include <string>
#include <vector>

namespace tessal::test {

struct ToolRun {
  int exitCode = -1;
  std::string output;
  std::string errors;
};

/// Runs the tool with arguments and a standard input, in a folder.
ToolRun RunTool(const std::vector<std::string>& arguments, const std::string& input = "",
                const std::string& folder = ".");

/// Runs a line of the shell in which $T is the tool; its exit code.
int RunShell(const std::string& line);

}  // namespace tessal::test
