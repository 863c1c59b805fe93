#include "cli/call_faults.h"

#include <algorithm>
#include <vector>

#include "cli/numbers.h"

namespace tessal::cli {

namespace {

bool IsOption(const std::string& argument) {
  return argument.size() > 1 && argument.front() == '-';
}

/// The innermost command that was called.
const CLI::App& Called(const CLI::App& app) {
  const CLI::App* called = &app;
  while (!called->get_subcommands().empty()) called = called->get_subcommands().front();
  return *called;
}

}  // namespace

std::string CallFault(const CLI::App& app, const CLI::ParseError& refusal) {
  std::vector<std::string> unknown = app.remaining(true);
  std::erase(unknown, "--");
  const bool needsCommand = Called(app).get_require_subcommand_min() > 0;
  if (needsCommand && !unknown.empty() && !IsOption(unknown.front())) {
    return "unknown command '" + ShownNumber(unknown.front()) + "'";
  }
  const auto option = std::find_if(unknown.begin(), unknown.end(), IsOption);
  if (option != unknown.end()) return "unknown option '" + *option + "'";
  if (!unknown.empty()) return "unexpected argument '" + ShownNumber(unknown.front()) + "'";
  if (needsCommand) return "a command is required";
  return ShownNumber(refusal.what());
}

}  // namespace tessal::cli
