// How the tool's help looks.
#pragma once

#include <CLI/CLI.hpp>
#include <string>

namespace tessal::cli {

/// Shows after an option only the name of its value: the usage line says what is required.
class HelpText final : public CLI::Formatter {
 public:
  HelpText();
  std::string make_option_opts(const CLI::Option* option) const override;
};

}  // namespace tessal::cli
