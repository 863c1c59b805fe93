// The command line: which commands there are, with which arguments and options.
#include <CLI/CLI.hpp>
#include <charconv>
#include <csignal>
#include <exception>
#include <functional>
#include <map>
#include <string>
#include <system_error>
#include <vector>

#include "cli/commands.h"
#include "cli/numbers.h"
#include "cli/output.h"
#include "expr/carbonate/options.h"

namespace tessal::cli {

namespace {

/// What the options of all commands are read into, and the command that was called.
struct CommandLine {
  std::vector<std::string> files;
  std::string file;
  std::string otherFile;
  std::string output;
  std::string name;
  std::vector<std::string> values;
  std::vector<std::string> settings;
  std::vector<std::string> ignored;
  bool onlyKeywords = false;
  bool force = false;
  bool mathJax = false;
  bool asPage = false;
  Format format = Format::Text;
  int lowestLevel = 0;
  RenameCall rename;
  ExpressionCall expression;
  std::function<ExitCode()> run;
};

const std::map<std::string, Format> kCheckFormats = {
    {"text", Format::Text}, {"json", Format::Json}, {"sarif", Format::Sarif}};
const std::map<std::string, Format> kTableFormats = {{"text", Format::Text}, {"json", Format::Json}};

CLI::App* AddCommand(CLI::App& parent, CommandLine& line, const char* name, const char* description,
                     std::function<ExitCode()> run) {
  CLI::App* command = parent.add_subcommand(name, description);
  command->callback([&line, run = std::move(run)] { line.run = run; });
  return command;
}

CLI::Option* AddFile(CLI::App& command, std::string& file) {
  return command.add_option("FILE", file, "a template file")->required();
}

/// The level that a text names. Read here, as the option parser does not know the hidden negative numbers.
int LevelIn(const std::string& text) {
  int level = 0;
  const auto read = std::from_chars(text.data(), text.data() + text.size(), level);
  if (read.ec != std::errc() || read.ptr != text.data() + text.size()) {
    throw CLI::ConversionError(text, "--level");
  }
  return level;
}

void AddExplain(CLI::App& app, CommandLine& line) {
  CLI::App* explain = app.add_subcommand("explain", "says what the messages mean");
  CLI::Option* code = explain->add_option("CODE", line.name, "the code of one message");
  explain->add_flag("--markdown", line.asPage, "prints the page of all messages")->excludes(code);
  explain->callback([&line, code] {
    const bool asksForOne = code->count() > 0;
    line.run = [&line, asksForOne] {
      if (asksForOne) return RunExplain(line.name);
      return line.asPage ? RunExplainPage() : RunExplainAll();
    };
  });
}

void AddTemplateCommands(CLI::App& app, CommandLine& line) {
  CLI::App* check = AddCommand(app, line, "check", "lists the messages of templates",
                               [&line] { return RunCheck(line.files, line.format, line.lowestLevel); });
  check->add_option("FILE", line.files, "template files")->required();
  check->add_option("--format", line.format, "text, json or sarif")
      ->transform(CLI::CheckedTransformer(kCheckFormats));
  check
      ->add_option_function<std::string>(
          "--level", [&line](const std::string& text) { line.lowestLevel = LevelIn(ShownNumber(text)); },
          "hides messages below this level")
      ->type_name("LEVEL");

  AddExplain(app, line);

  CLI::App* symbols = AddCommand(app, line, "symbols", "lists the symbol table of a template",
                                 [&line] { return RunSymbols(line.file, line.format); });
  AddFile(*symbols, line.file);
  symbols->add_option("--format", line.format, "text or json")
      ->transform(CLI::CheckedTransformer(kTableFormats));

  CLI::App* save = AddCommand(app, line, "save", "loads a template and saves it",
                              [&line] { return RunSave(line.file, line.output); });
  AddFile(*save, line.file);
  save->add_option("--output", line.output, "saves under this name");

  CLI::App* create = AddCommand(app, line, "new", "saves an empty template",
                                [&line] { return RunNew(line.file, line.force); });
  create->add_option("OUT", line.file, "the new file")->required();
  create->add_flag("--force", line.force, "replaces an existing file");

  CLI::App* rename = AddCommand(app, line, "rename", "renames a symbol with all its uses",
                                [&line] { return RunRename(line.rename); });
  AddFile(*rename, line.rename.file);
  rename->add_option("OLD", line.rename.oldSymbol, "the symbol to rename")->required();
  rename->add_option("NEW", line.rename.newSymbol, "its new name")->required();
  rename->add_flag("--only-symbol", line.rename.onlySymbol, "leaves the uses as they are");
  rename->add_option("--output", line.rename.output, "saves under this name");

  CLI::App* overview = AddCommand(app, line, "overview", "prints the overview table",
                                  [&line] { return RunOverview(line.file); });
  AddFile(*overview, line.file);

  CLI::App* html = AddCommand(app, line, "html", "writes the HTML documentation",
                              [&line] { return RunHtml(line.file, line.mathJax, line.output); });
  AddFile(*html, line.file);
  html->add_flag("--mathjax", line.mathJax, "has MathJax render the equations");
  html->add_option("--output", line.output, "the page to write");
}

void AddKeyFileCommands(CLI::App& app, CommandLine& line) {
  CLI::App* tree = AddCommand(app, line, "tree", "prints a key file as its item tree",
                              [&line] { return RunTree(line.file); });
  tree->add_option("FILE", line.file, "a key file")->required();

  CLI::App* diff = AddCommand(app, line, "diff", "compares two key files", [&line] {
    return RunDiff(line.file, line.otherFile, line.ignored, line.onlyKeywords);
  });
  diff->add_option("A", line.file, "a key file")->required();
  diff->add_option("B", line.otherFile, "another")->required();
  diff->add_option("--ignore", line.ignored, "leaves out names that match")->allow_extra_args(false);
  diff->add_flag("--keywords-only", line.onlyKeywords, "lists keywords only");
}

void AddExpressionCommands(CLI::App& app, CommandLine& line) {
  CLI::App* expressions = app.add_subcommand("expr", "looks at one expression");
  expressions->require_subcommand(1);
  struct Row {
    const char* name;
    const char* description;
    ExitCode (*run)(const ExpressionCall&);
  };
  const Row rows[] = {
      {"tokens", "lists the tokens", RunTokens},
      {"parse", "prints the tree", RunParse},
      {"mathml", "prints the MathML block", RunMathml},
      {"rewrite", "prints the engine's form", RunRewrite},
      {"check", "lists the findings", RunExpressionCheck},
      {"identifiers", "lists the identifiers", RunIdentifiers},
  };
  for (const Row& row : rows) {
    CLI::App* command = AddCommand(*expressions, line, row.name, row.description,
                                   [&line, run = row.run] { return run(line.expression); });
    CLI::Option* text =
        command->add_option("EXPR", line.expression.text, "an expression, or - for standard input");
    CLI::Option* lines = command->add_flag("--lines", line.expression.eachLine,
                                           "each line of standard input is an expression");
    text->excludes(lines);
    command->parse_complete_callback([&line, command, text] {
      // An unknown option is told as such, not as a missing expression.
      if (line.expression.eachLine || text->count() > 0 || command->remaining_size() > 0) return;
      throw CLI::RequiredError("EXPR");
    });
    if (row.run == RunMathml) {
      command->add_option("--symbol", line.expression.symbol, "the left side");
      command->add_flag("--derivative", line.expression.isDerivative, "the left side is a time derivative");
    }
  }
}

void AddCatalogueCommands(CLI::App& app, CommandLine& line) {
  CLI::App* functions = app.add_subcommand("functions", "lists the function catalogue");
  const CLI::Option* one = functions->add_option("NAME", line.name, "one function");
  functions->callback([&line, one] {
    // An empty name is a name too, and no function's.
    const bool asksForOne = one->count() > 0;
    line.run = [&line, asksForOne] { return asksForOne ? RunFunction(line.name) : RunFunctions(); };
  });
  AddCommand(app, line, "builtins", "lists the built-in variables", [] { return RunBuiltins(); });

  CLI::App* eval = AddCommand(app, line, "eval", "computes a plain function",
                              [&line] { return RunEval(line.name, line.values); });
  eval->add_option("NAME", line.name, "the function")->required();
  eval->add_option("VALUE", line.values, "its values");

  CLI::App* call = AddCommand(app, line, "call", "computes any function of the catalogue",
                              [&line] { return RunCall(line.name, line.values, line.settings); });
  call->add_option("NAME", line.name, "the function")->required();
  call->add_option("VALUE", line.values, "its values");
  call->add_option("--set", line.settings, "a function to call first: NAME=VALUE,VALUE...")
      ->allow_extra_args(false);
}

/// CLI11 parses a reversed list, without the program's name. Numbers are hidden from it, and shown again to
/// whatever takes them.
std::vector<std::string> ArgumentsForParser(int count, char** arguments) {
  std::vector<std::string> reversed;
  for (int place = count - 1; place > 0; --place) reversed.push_back(HiddenNumber(arguments[place]));
  return reversed;
}

void ShowNumbers(CommandLine& line) {
  for (std::string* text :
       {&line.file, &line.otherFile, &line.output, &line.name, &line.rename.file, &line.rename.oldSymbol,
        &line.rename.newSymbol, &line.rename.output, &line.expression.text, &line.expression.symbol}) {
    *text = ShownNumber(*text);
  }
  for (std::vector<std::string>* texts : {&line.files, &line.values, &line.settings, &line.ignored}) {
    for (std::string& text : *texts) text = ShownNumber(text);
  }
}

/// The argument that stands where a command is awaited and is none; nothing when that is not what is wrong.
const char* UnknownCommand(const CLI::App& app, int count, char** arguments) {
  const CLI::App* called = &app;
  int place = 1;
  for (; !called->get_subcommands().empty(); ++place) called = called->get_subcommands().front();
  const bool awaitsCommand = called->get_require_subcommand_min() > 0;
  return awaitsCommand && place < count && *arguments[place] != '-' ? arguments[place] : nullptr;
}

int RunTool(int count, char** arguments) {
  CLI::App app{"Reads, checks, documents and saves templates of aquatic process models.", "tessal"};
  app.set_version_flag("--version", std::string("tessal ") + TESSAL_VERSION);
  app.require_subcommand(1);
  CommandLine line;
  AddTemplateCommands(app, line);
  AddKeyFileCommands(app, line);
  AddExpressionCommands(app, line);
  AddCatalogueCommands(app, line);
  try {
    app.parse(ArgumentsForParser(count, arguments));
  } catch (const CLI::ParseError& stop) {
    if (stop.get_exit_code() == 0) return app.exit(stop);
    const char* unknown = UnknownCommand(app, count, arguments);
    Complain(unknown != nullptr ? "unknown command '" + std::string(unknown) + "'"
                                : ShownNumber(stop.what()));
    return kCallFault;
  }
  ShowNumbers(line);
  const ExitCode exitCode = line.run();
  // The option file and its log fail no command, but nobody should compute with other settings than those
  // meant.
  if (!CarbonateProblem().empty()) Complain(CarbonateProblem());
  return FlushOutput() ? exitCode : kCallFault;
}

}  // namespace

}  // namespace tessal::cli

int main(int count, char** arguments) {
  // A closed pipe shows as a failed write, which ends the tool quietly.
  std::signal(SIGPIPE, SIG_IGN);
  try {
    return tessal::cli::RunTool(count, arguments);
  } catch (const std::exception& failure) {
    tessal::cli::Complain(failure.what());
    return tessal::cli::kCallFault;
  }
}
