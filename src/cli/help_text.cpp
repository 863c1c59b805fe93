#include "cli/help_text.h"

namespace tessal::cli {

HelpText::HelpText() {
  label("SUBCOMMAND", "COMMAND");
  label("Positionals", "Arguments");
}

std::string HelpText::make_option_opts(const CLI::Option* option) const {
  const bool isFlag = option->get_type_size() == 0;
  return isFlag || option->get_positional() ? std::string() : " " + option->get_type_name();
}

}  // namespace tessal::cli
