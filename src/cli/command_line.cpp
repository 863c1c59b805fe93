#include "cli/command_line.h"

#include <memory>
#include <utility>

#include "cli/help_text.h"
#include "cli/numbers.h"

namespace tessal::cli {

namespace {

/// Numbers are hidden from the parser, which would take "-1" for an option, and shown again to whatever takes
/// them.
void ShowNumbers(CLI::App& app) {
  const auto show = [](std::string& text) {
    text = ShownNumber(text);
    return std::string();
  };
  for (CLI::Option* option :
       app.get_options([](const CLI::Option* one) { return one->get_items_expected_max() > 0; })) {
    option->transform(CLI::Validator(show, ""));
  }
  for (CLI::App* command : app.get_subcommands([](CLI::App*) { return true; })) ShowNumbers(*command);
}

}  // namespace

CLI::App* AddCommand(CLI::App& parent, CommandLine& line, const char* group, const char* name,
                     const char* description, std::function<ExitCode()> run) {
  CLI::App* command = parent.add_subcommand(name, description)->group(group);
  command->callback([&line, run = std::move(run)] { line.run = run; });
  return command;
}

CLI::Option* AddFile(CLI::App& command, std::string& file) {
  return command.add_option("FILE", file, "a template file")->required();
}

CLI::Option* AddOutput(CLI::App& command, std::string& output, const char* description) {
  const auto read = [&output](const std::string& name) {
    if (name.empty()) throw CLI::ValidationError("--output", "the name of the file is empty");
    output = name;
  };
  return command.add_option_function<std::string>("--output", read, description)->type_name("OUT");
}

CLI::Option* AddForce(CLI::App& command, bool& force) {
  return command.add_flag("--force", force, "replaces an existing file");
}

CLI::Option* OfferWords(CLI::Option* option, const std::string& words) {
  // A check that refuses nothing: what the option does with a word is its own. Its name is what it is for.
  return option->check(CLI::Validator([](std::string& /*text*/) { return std::string(); }, "", words));
}

std::vector<std::string> OfferedWords(CLI::Option& option) {
  try {
    for (int place = 0;; ++place) {
      const std::string words = option.get_validator(place)->get_name();
      if (words.empty()) continue;
      std::vector<std::string> list = CLI::detail::split(words, ',');
      for (std::string& word : list) CLI::detail::trim(word);
      return list;
    }
  } catch (const CLI::OptionNotFound&) {
    return {};
  }
}

CLI::Option* AddFormat(CLI::App& command, CommandLine& line, Choices<Format> formats) {
  return AddChoice(command, "--format", "FORMAT", formats, line.format);
}

void BuildCommandTree(CLI::App& app, CommandLine& line) {
  app.formatter(std::make_shared<HelpText>());
  app.set_help_flag("-h,--help", "prints this help");
  app.set_version_flag(
      "--version", [&line] { return line.version; }, "prints the version and the build");
  app.require_subcommand(1);
  AddTemplateCommands(app, line);
  AddAnalysisCommands(app, line);
  AddKeyFileCommands(app, line);
  AddExpressionCommands(app, line);
  AddCatalogueCommands(app, line);
  AddEditorCommands(app, line);
  ShowNumbers(app);
}

}  // namespace tessal::cli
