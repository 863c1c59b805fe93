// What is wrong with a call that the option parser refuses, in words for people.
#pragma once

#include <CLI/CLI.hpp>
#include <string>

namespace tessal::cli {

/// One line about a refused call. What nothing knows, an option or a command, comes before what is missing:
/// the missing argument may well be the value of a misspelt option.
std::string CallFault(const CLI::App& app, const CLI::ParseError& refusal);

}  // namespace tessal::cli
