// The command line tool: reads its call, runs the command and flushes what it printed.
#include <csignal>
#include <exception>
#include <new>
#include <string>
#include <vector>

#include "cli/call_faults.h"
#include "cli/command_line.h"
#include "cli/numbers.h"
#include "cli/output.h"
#include "expr/carbonate/options.h"
#include "platform/build_info.h"

namespace tessal::cli {

namespace {

/// CLI11 parses a reversed list, without the program's name. Numbers are hidden from it.
std::vector<std::string> ArgumentsForParser(int count, char** arguments) {
  std::vector<std::string> reversed;
  for (int place = count - 1; place > 0; --place) reversed.push_back(HiddenNumber(arguments[place]));
  return reversed;
}

int RunTool(int count, char** arguments) {
  CLI::App app{kToolSummary, "tessal"};
  CommandLine line;
  line.version = BuildText("tessal");
  BuildCommandTree(app, line);
  try {
    app.parse(ArgumentsForParser(count, arguments));
  } catch (const CLI::ParseError& stop) {
    const EndsWithoutMemory end;
    if (stop.get_exit_code() == 0) return app.exit(stop);
    Complain(CallFault(app, stop));
    return kCallFault;
  }
  const ExitCode exitCode = line.run();
  // The option file and its log fail no command, but nobody should compute with other settings than those
  // meant.
  if (!CarbonateProblem().empty()) Complain(OnOneLine(CarbonateProblem()));
  return FlushOutput() ? exitCode : kCallFault;
}

}  // namespace

}  // namespace tessal::cli

int main(int count, char** arguments) {
  // A closed pipe shows as a failed write, which ends the tool quietly.
  std::signal(SIGPIPE, SIG_IGN);
  try {
    return tessal::cli::RunTool(count, arguments);
  } catch (const std::bad_alloc&) {
    tessal::cli::ComplainOfMemory();
    return tessal::cli::kCallFault;
  } catch (const std::exception& failure) {
    tessal::cli::Complain(failure.what());
    return tessal::cli::kCallFault;
  }
}
