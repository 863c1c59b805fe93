// The command line as the option parser sees it: which commands there are, with which arguments and options,
// and what they are read into. Help, man page and completions are made from the same tree.
#pragma once

#include <CLI/CLI.hpp>
#include <functional>
#include <string>
#include <vector>

#include "cli/choices.h"
#include "cli/commands.h"
#include "cli/output.h"

namespace tessal::cli {

/// What the options of all commands are read into, and the command that was called.
struct CommandLine {
  std::string version;  ///< what `--version` prints
  std::string file;
  std::string otherFile;
  std::string name;
  std::vector<std::string> values;
  std::vector<std::string> settings;
  std::vector<std::string> ignored;
  bool onlyKeywords = false;
  bool force = false;
  bool asPage = false;
  Format format = Format::Text;
  CheckCall check;
  SaveCall save;
  RenameCall rename;
  MergeCall merge;
  FindCall find;
  HtmlCall html;
  TableCall table;
  UnitsCall units;
  LintCall lint;
  GraphCall graph;
  ExpressionCall expression;
  MatrixCall matrix;
  BalanceCall balance;
  std::function<ExitCode()> run;
};

inline constexpr const char* kToolSummary =
    "Reads, checks, documents and saves templates of aquatic process models.";

/// Makes the whole tree. The line outlives it.
void BuildCommandTree(CLI::App& app, CommandLine& line);

// The commands of each part, in the order of the help.
void AddTemplateCommands(CLI::App& app, CommandLine& line);
void AddAnalysisCommands(CLI::App& app, CommandLine& line);
void AddKeyFileCommands(CLI::App& app, CommandLine& line);
void AddExpressionCommands(CLI::App& app, CommandLine& line);
void AddCatalogueCommands(CLI::App& app, CommandLine& line);
void AddEditorCommands(CLI::App& app, CommandLine& line);

// The parts of the tool, as its help lists them.
inline constexpr const char* kTemplates = "Templates";
inline constexpr const char* kAnalyses = "Analyses";
inline constexpr const char* kKeyFiles = "Key files";
inline constexpr const char* kExpressions = "Expressions";
inline constexpr const char* kCatalogues = "Catalogues";
inline constexpr const char* kEditors = "Editors";

// What commands are made of.
CLI::App* AddCommand(CLI::App& parent, CommandLine& line, const char* group, const char* name,
                     const char* description, std::function<ExitCode()> run);
CLI::Option* AddFile(CLI::App& command, std::string& file);
/// An empty name means that none was given, so it can not be one.
CLI::Option* AddOutput(CLI::App& command, std::string& output, const char* description);
CLI::Option* AddForce(CLI::App& command, bool& force);

/// Notes the words that an option takes, as `WordsOf` gives them, for completions.
CLI::Option* OfferWords(CLI::Option* option, const std::string& words);
/// The words that were noted; empty for an option that takes any.
std::vector<std::string> OfferedWords(CLI::Option& option);

/// An option that takes one of a few words.
template <class Value>
CLI::Option* AddChoice(CLI::App& command, const char* name, const char* typeName, Choices<Value> choices,
                       Value& chosen) {
  const auto read = [&chosen, name, choices](const std::string& word) {
    const std::optional<Value> value = ValueOf(choices, word);
    if (!value) throw CLI::ValidationError(name, "'" + word + "' is none of " + WordsOf(choices));
    chosen = *value;
  };
  CLI::Option* option = command.add_option_function<std::string>(name, read, WordsOf(choices));
  return OfferWords(option->type_name(typeName), WordsOf(choices));
}

CLI::Option* AddFormat(CLI::App& command, CommandLine& line, Choices<Format> formats);

}  // namespace tessal::cli
