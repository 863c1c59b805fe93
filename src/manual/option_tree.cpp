#include "manual/option_tree.h"

#include <algorithm>
#include <array>
#include <stdexcept>
#include <string_view>

#include "app/editor_options.h"
#include "cli/command_line.h"

namespace tessal::manual {

namespace {

struct ValueRow {
  std::string_view name;
  Offer argument;  ///< what is offered for an argument of this name
  Offer option;    ///< and for an option's value
};

/// By the names that the help shows.
constexpr ValueRow kValues[] = {
    {"FILE", Offer::Templates, Offer::Files},        {"PATH", Offer::Templates, Offer::Files},
    {"A", Offer::Templates, Offer::Files},           {"B", Offer::Templates, Offer::Files},
    {"BASE", Offer::Templates, Offer::Files},        {"OURS", Offer::Templates, Offer::Files},
    {"THEIRS", Offer::Templates, Offer::Files},      {"OUT", Offer::Templates, Offer::Files},
    {"CODE", Offer::Nothing, Offer::Nothing},        {"CODES", Offer::Nothing, Offer::Nothing},
    {"EXPR", Offer::Nothing, Offer::Nothing},        {"GEOMETRY", Offer::Nothing, Offer::Nothing},
    {"ID", Offer::Nothing, Offer::Nothing},          {"KINDS", Offer::Nothing, Offer::Nothing},
    {"LEVEL", Offer::Nothing, Offer::Nothing},       {"N", Offer::Nothing, Offer::Nothing},
    {"NAME", Offer::Nothing, Offer::Nothing},        {"NAME=EXPR", Offer::Nothing, Offer::Nothing},
    {"NAME=P,P...", Offer::Nothing, Offer::Nothing}, {"NAME=VALUE,VALUE...", Offer::Nothing, Offer::Nothing},
    {"NEW", Offer::Nothing, Offer::Nothing},         {"OLD", Offer::Nothing, Offer::Nothing},
    {"PATTERN", Offer::Nothing, Offer::Nothing},     {"REGEX", Offer::Nothing, Offer::Nothing},
    {"SYMBOL", Offer::Nothing, Offer::Nothing},      {"VALUE", Offer::Nothing, Offer::Nothing},
};

/// What nobody has decided on stops the build.
const ValueRow& RowOfValue(std::string_view name) {
  const auto* hit = std::find_if(std::begin(kValues), std::end(kValues),
                                 [name](const ValueRow& row) { return row.name == name; });
  if (hit == std::end(kValues)) {
    throw std::logic_error("completions do not know what to offer for " + std::string(name));
  }
  return *hit;
}

CallPart PartOf(CLI::Option& option, bool isOfKeyFiles) {
  CallPart part;
  part.meaning = option.get_description();
  part.isRequired = option.get_required();
  part.isRepeated = option.get_items_expected_max() > 1;
  part.words = cli::OfferedWords(option);
  const bool isFlag = option.get_type_size() == 0 || option.get_items_expected_max() == 0;
  if (option.get_positional()) {
    part.names = {option.get_name(true)};
    part.offer = RowOfValue(part.names.front()).argument;
    if (isOfKeyFiles && part.offer == Offer::Templates) part.offer = Offer::Files;
    return part;
  }
  for (const std::string& name : option.get_snames()) part.names.push_back("-" + name);
  for (const std::string& name : option.get_lnames()) part.names.push_back("--" + name);
  if (isFlag) return part;
  part.value = option.get_type_name();
  part.offer = part.words.empty() ? RowOfValue(part.value).option : Offer::Words;
  return part;
}

Command CommandOf(CLI::App& app, const std::string& above) {
  Command command;
  command.name = app.get_name();
  command.path = above.empty() ? command.name : above + " " + command.name;
  command.group = app.get_group();
  command.meaning = app.get_description();
  for (CLI::Option* option : app.get_options()) {
    CallPart part = PartOf(*option, command.group == cli::kKeyFiles);
    (option->get_positional() ? command.arguments : command.options).push_back(std::move(part));
  }
  for (CLI::App* each : app.get_subcommands({})) command.commands.push_back(CommandOf(*each, command.path));
  return command;
}

CallPart PartOf(const EditorOption& option) {
  CallPart part;
  if (!option.letter.empty()) part.names.push_back("-" + std::string(option.letter));
  part.names.push_back("--" + std::string(option.name));
  part.value = option.value;
  part.meaning = option.meaning;
  if (!option.value.empty()) part.offer = RowOfValue(option.value).option;
  return part;
}

}  // namespace

Command ToolTree() {
  CLI::App app{cli::kToolSummary, "tessal"};
  cli::CommandLine line;
  cli::BuildCommandTree(app, line);
  return CommandOf(app, "");
}

Command EditorTree() {
  Command editor;
  editor.name = editor.path = "tessal-editor";
  editor.meaning = kEditorSummary;
  CallPart files;
  files.names = {std::string(kEditorFiles.name)};
  files.meaning = kEditorFiles.meaning;
  files.offer = Offer::Templates;
  files.isRepeated = true;
  editor.arguments.push_back(files);
  for (const EditorOption& option : kEditorOptions) editor.options.push_back(PartOf(option));
  for (const EditorOption& option : kToolkitOptions) editor.options.push_back(PartOf(option));
  return editor;
}

}  // namespace tessal::manual
