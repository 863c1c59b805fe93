// The command line: which commands there are, with which arguments and options.
#include <CLI/CLI.hpp>
#include <charconv>
#include <csignal>
#include <exception>
#include <functional>
#include <memory>
#include <new>
#include <string>
#include <system_error>
#include <vector>

#include "cli/call_faults.h"
#include "cli/choices.h"
#include "cli/commands.h"
#include "cli/help_text.h"
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
  std::string name;
  std::vector<std::string> values;
  std::vector<std::string> settings;
  std::vector<std::string> ignored;
  bool onlyKeywords = false;
  bool force = false;
  bool asPage = false;
  Format format = Format::Text;
  int lowestLevel = 0;
  SaveCall save;
  RenameCall rename;
  FindCall find;
  HtmlCall html;
  LintCall lint;
  GraphCall graph;
  UnitsCall units;
  ExpressionCall expression;
  MatrixCall matrix;
  BalanceCall balance;
  std::function<ExitCode()> run;
};

/// The parts of the tool, as its help lists them.
constexpr const char* kTemplates = "Templates";
constexpr const char* kAnalyses = "Analyses";
constexpr const char* kKeyFiles = "Key files";
constexpr const char* kExpressions = "Expressions";
constexpr const char* kCatalogues = "Catalogues";

CLI::App* AddCommand(CLI::App& parent, CommandLine& line, const char* group, const char* name,
                     const char* description, std::function<ExitCode()> run) {
  CLI::App* command = parent.add_subcommand(name, description)->group(group);
  command->callback([&line, run = std::move(run)] { line.run = run; });
  return command;
}

CLI::Option* AddFile(CLI::App& command, std::string& file) {
  return command.add_option("FILE", file, "a template file")->required();
}

/// An empty name means that none was given, so it can not be one.
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

/// An option that takes one of a few words.
template <class Value>
CLI::Option* AddChoice(CLI::App& command, const char* name, const char* typeName, Choices<Value> choices,
                       Value& chosen) {
  const auto read = [&chosen, name, choices](const std::string& word) {
    const std::optional<Value> value = ValueOf(choices, word);
    if (!value)
      throw CLI::ValidationError(name, "'" + ShownNumber(word) + "' is none of " + WordsOf(choices));
    chosen = *value;
  };
  return command.add_option_function<std::string>(name, read, WordsOf(choices))->type_name(typeName);
}

CLI::Option* AddFormat(CLI::App& command, CommandLine& line, Choices<Format> formats) {
  return AddChoice(command, "--format", "FORMAT", formats, line.format);
}

/// The level that a word or a number names. Numbers are read here, as the option parser does not know those
/// that are hidden from it.
int LevelIn(const std::string& text) {
  constexpr Choices<int> kWords = kLevels;
  if (const std::optional<int> level = ValueOf(kWords, CLI::ignore_case(text))) return *level;
  int level = 0;
  const auto read = std::from_chars(text.data(), text.data() + text.size(), level);
  if (read.ec != std::errc() || read.ptr != text.data() + text.size()) {
    throw CLI::ValidationError("--level", "'" + text + "' is no whole number and none of " + WordsOf(kWords));
  }
  return level;
}

void AddExplain(CLI::App& app, CommandLine& line) {
  CLI::App* explain = app.add_subcommand("explain", "says what the messages mean");
  explain->group(kTemplates);
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

void AddCheck(CLI::App& app, CommandLine& line) {
  CLI::App* check = AddCommand(app, line, kTemplates, "check", "lists the messages of templates",
                               [&line] { return RunCheck(line.files, line.format, line.lowestLevel); });
  check->add_option("PATH", line.files, "template files, folders of them, or - for standard input")
      ->required();
  AddFormat(*check, line, kCheckFormats);
  check
      ->add_option_function<std::string>(
          "--level", [&line](const std::string& text) { line.lowestLevel = LevelIn(ShownNumber(text)); },
          "hides messages below it: " + WordsOf(Choices<int>(kLevels)) + ", or 1 to 4")
      ->type_name("LEVEL");
}

void AddFind(CLI::App& app, CommandLine& line) {
  CLI::App* find = AddCommand(app, line, kTemplates, "find", "finds a pattern in texts and expressions",
                              [&line] { return RunFind(line.find); });
  AddFile(*find, line.find.file);
  find->add_option("PATTERN", line.find.pattern, "what to look for")->required();
  AddChoice(*find, "--in", "WHERE", Choices<FindIn>(kFindIn), line.find.in);
  find->add_flag("--regex", line.find.isRegex, "takes the pattern as a regular expression");
  find->add_flag("--whole", line.find.wholeSymbols, "finds whole symbols only");
  find->add_flag("--ignore-case", line.find.ignoreCase, "takes capitals and small letters as the same");
  AddChoice(*find, "--format", "FORMAT", kTableFormats, line.find.format);
}

void AddTemplateCommands(CLI::App& app, CommandLine& line) {
  AddCheck(app, line);
  AddExplain(app, line);

  CLI::App* symbols = AddCommand(app, line, kTemplates, "symbols", "lists the symbol table of a template",
                                 [&line] { return RunSymbols(line.file, line.format); });
  AddFile(*symbols, line.file);
  AddFormat(*symbols, line, kTableFormats);

  CLI::App* save = AddCommand(app, line, kTemplates, "save", "loads a template and saves it",
                              [&line] { return RunSave(line.save); });
  AddFile(*save, line.save.file);
  AddOutput(*save, line.save.output, "saves under this name, not in place");
  AddForce(*save, line.save.force);

  CLI::App* repair = AddCommand(app, line, kTemplates, "repair", "takes over values that a load passes over",
                                [&line] { return RunRepair(line.save); });
  AddFile(*repair, line.save.file);
  AddOutput(*repair, line.save.output, "saves under this name, not in place");
  AddForce(*repair, line.save.force);

  CLI::App* create = AddCommand(app, line, kTemplates, "new", "saves an empty template",
                                [&line] { return RunNew(line.file, line.force); });
  create->add_option("OUT", line.file, "the new file")->required();
  AddForce(*create, line.force);

  CLI::App* rename = AddCommand(app, line, kTemplates, "rename", "renames a symbol with all its uses",
                                [&line] { return RunRename(line.rename); });
  AddFile(*rename, line.rename.file);
  rename->add_option("OLD", line.rename.oldSymbol, "the symbol to rename")->required();
  rename->add_option("NEW", line.rename.newSymbol, "its new name")->required();
  rename->add_flag("--only-symbol", line.rename.onlySymbol, "leaves the uses as they are");
  CLI::Option* wholeWords =
      rename->add_flag("--whole-words", line.rename.wholeWords, "leaves longer names alone");
  rename->add_flag("--letter-rule", line.rename.letterRule, "changes longer names too, defined or not")
      ->excludes(wholeWords);
  AddOutput(*rename, line.rename.output, "saves under this name, not in place");
  AddForce(*rename, line.rename.force);

  AddFind(app, line);

  CLI::App* overview = AddCommand(app, line, kTemplates, "overview", "prints the overview table",
                                  [&line] { return RunOverview(line.file); });
  AddFile(*overview, line.file);

  CLI::App* html = AddCommand(app, line, kTemplates, "html", "writes the HTML documentation",
                              [&line] { return RunHtml(line.html); });
  AddFile(*html, line.html.file);
  html->add_flag("--mathjax", line.html.mathJax,
                 "has MathJax render the equations; --mathjax=ADDRESS names its script");
  html->add_flag("--safe", line.html.isSafe, "writes texts so that no markup in them takes effect");
  AddOutput(*html, line.html.output, "the page to write; without it HTML_doc beside the template takes it");
  html->add_flag("--force", line.html.force, "lets OUT replace a file that is no page");
}

/// A list of codes, with commas between them or in several options.
CLI::Option* AddCodes(CLI::App& command, const char* name, std::vector<std::string>& codes,
                      const char* description) {
  return command.add_option(name, codes, description)
      ->delimiter(',')
      ->allow_extra_args(false)
      ->type_name("CODES");
}

void AddLint(CLI::App& app, CommandLine& line) {
  CLI::App* lint = AddCommand(app, line, kAnalyses, "lint", "lists likely slips in templates",
                              [&line] { return RunLint(line.lint); });
  lint->add_option("PATH", line.lint.paths, "template files, folders of them, or - for standard input")
      ->required();
  AddCodes(*lint, "--select", line.lint.select, "looks for these alone");
  AddCodes(*lint, "--ignore", line.lint.ignore, "does not look for these");
  CLI::Option* baseline =
      lint->add_option("--baseline", line.lint.baseline, "leaves out the findings of that file");
  baseline->type_name("FILE");
  lint->add_option("--write-baseline", line.lint.newBaseline, "writes all findings to that file instead")
      ->type_name("FILE")
      ->excludes(baseline);
  lint->add_flag("--exit-zero", line.lint.exitZero, "ends with 0 in spite of findings");
  AddChoice(*lint, "--format", "FORMAT", Choices<Format>(kCheckFormats), line.lint.format);
}

void AddGraph(CLI::App& app, CommandLine& line) {
  CLI::App* graph = AddCommand(app, line, kAnalyses, "graph", "prints who depends on whom",
                               [&line] { return RunGraph(line.graph); });
  AddFile(*graph, line.graph.file);
  CLI::Option* focus =
      graph->add_option("--focus", line.graph.focus, "shows what lies around it")->type_name("SYMBOL");
  const auto readDepth = [&line](const std::string& hidden) {
    const std::string text = ShownNumber(hidden);
    std::size_t depth = 0;
    const auto read = std::from_chars(text.data(), text.data() + text.size(), depth);
    if (read.ec != std::errc() || read.ptr != text.data() + text.size()) {
      throw CLI::ValidationError("--depth", "'" + text + "' is no number of steps");
    }
    line.graph.depth = depth;
  };
  graph->add_option_function<std::string>("--depth", readDepth, "goes so many steps from the focus")
      ->type_name("N")
      ->needs(focus);
  AddChoice(*graph, "--direction", "DIRECTION", Choices<GraphDirection>(kGraphDirections),
            line.graph.direction)
      ->needs(focus);
  AddCodes(*graph, "--kinds", line.graph.kinds, "shows elements of these kinds, or all")->type_name("KINDS");
  AddChoice(*graph, "--format", "FORMAT", Choices<GraphFormat>(kGraphFormats), line.graph.format);
}

void AddUnits(CLI::App& app, CommandLine& line) {
  CLI::App* units = AddCommand(app, line, kAnalyses, "units", "finds units that do not go together",
                               [&line] { return RunUnits(line.units); });
  AddFile(*units, line.units.file);
  units->add_flag("--strict", line.units.isStrict, "tells mmol N from mmol C and other substances apart");
  units->add_flag("--list", line.units.isList, "lists how each unit text was read");
  AddChoice(*units, "--format", "FORMAT", Choices<Format>(kCheckFormats), line.units.format);
}

void AddAnalysisCommands(CLI::App& app, CommandLine& line) {
  AddUnits(app, line);

  CLI::App* matrix = AddCommand(app, line, kAnalyses, "matrix", "prints the process matrix",
                                [&line] { return RunMatrix(line.matrix); });
  AddFile(*matrix, line.matrix.file);
  matrix->add_option("--class", line.matrix.className, "the matrix of a particle class")->type_name("NAME");
  matrix->add_flag("--elementary", line.matrix.isElementary,
                   "replaces processes that are made of others by those");
  AddChoice(*matrix, "--format", "FORMAT", Choices<Format>(kMatrixFormats), line.matrix.format);

  CLI::App* balance = AddCommand(app, line, kAnalyses, "balance", "checks that pools keep their amount",
                                 [&line] { return RunBalance(line.balance); });
  AddFile(*balance, line.balance.file);
  balance->add_option("--pools", line.balance.poolsFile, "takes the pools of this key file")
      ->type_name("FILE");
  balance->add_option("--pool", line.balance.pools, "a further pool; may be repeated")
      ->allow_extra_args(false)
      ->type_name("NAME=EXPR");
  balance
      ->add_option("--boundary", line.balance.boundaries,
                   "processes through which a pool, or without a name all, come and go; may be repeated")
      ->allow_extra_args(false)
      ->type_name("NAME=P,P...");
  AddChoice(*balance, "--format", "FORMAT", kTableFormats, line.balance.format);

  AddLint(app, line);
  AddGraph(app, line);
}

void AddKeyFileCommands(CLI::App& app, CommandLine& line) {
  CLI::App* tree = AddCommand(app, line, kKeyFiles, "tree", "prints a key file as its item tree",
                              [&line] { return RunTree(line.file); });
  tree->add_option("FILE", line.file, "a key file")->required();

  CLI::App* diff = AddCommand(app, line, kKeyFiles, "diff", "compares two key files", [&line] {
    return RunDiff(line.file, line.otherFile, line.ignored, line.onlyKeywords);
  });
  diff->add_option("A", line.file, "a key file")->required();
  diff->add_option("B", line.otherFile, "another")->required();
  diff->add_option("--ignore", line.ignored, "leaves out names that match; may be repeated")
      ->allow_extra_args(false)
      ->type_name("REGEX");
  diff->add_flag("--keywords-only", line.onlyKeywords, "lists differing keywords, not differing sections");
}

void AddExpressionCommands(CLI::App& app, CommandLine& line) {
  CLI::App* expressions = app.add_subcommand("expr", "looks at one expression")->group(kExpressions);
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
      {"latex", "prints LaTeX", RunLatex},
      {"rewrite", "prints the engine's form", RunRewrite},
      {"check", "lists the findings", RunExpressionCheck},
      {"identifiers", "lists the identifiers", RunIdentifiers},
  };
  for (const Row& row : rows) {
    CLI::App* command = AddCommand(*expressions, line, "Commands", row.name, row.description,
                                   [&line, run = row.run] { return run(line.expression); });
    CLI::Option* text =
        command->add_option("EXPR", line.expression.text, "an expression, or - for standard input");
    CLI::Option* lines = command->add_flag("--lines", line.expression.eachLine,
                                           "takes each line of standard input as an expression");
    text->excludes(lines);
    command->parse_complete_callback([&line, text] {
      if (!line.expression.eachLine && text->count() == 0) throw CLI::RequiredError("EXPR");
    });
    if (row.run == RunMathml || row.run == RunLatex) {
      command->add_option("--symbol", line.expression.symbol, "the left side")->type_name("SYMBOL");
      command->add_flag("--derivative", line.expression.isDerivative, "the left side is a time derivative");
    }
  }
}

void AddCatalogue(CLI::App& app, CommandLine& line, const char* name, const char* description,
                  ExitCode (*run)(const CatalogueQuestion&)) {
  CLI::App* catalogue = app.add_subcommand(name, description)->group(kCatalogues);
  const CLI::Option* one = catalogue->add_option("NAME", line.name, "one of them");
  CLI::Option* describe = catalogue->add_flag("--describe", line.asPage, "says what they mean");
  AddFormat(*catalogue, line, kDescriptionFormats)->needs(describe);
  catalogue->callback([&line, one, run] {
    // An empty name is a name too, and no row's.
    const bool asksForOne = one->count() > 0;
    line.run = [&line, asksForOne, run] {
      CatalogueQuestion question{std::nullopt, line.asPage, line.format};
      if (asksForOne) question.name = line.name;
      return run(question);
    };
  });
}

void AddCatalogueCommands(CLI::App& app, CommandLine& line) {
  AddCatalogue(app, line, "functions", "lists the function catalogue", RunFunctions);
  AddCatalogue(app, line, "builtins", "lists the built-in variables", RunBuiltins);

  CLI::App* eval = AddCommand(app, line, kCatalogues, "eval", "computes a plain function",
                              [&line] { return RunEval(line.name, line.values); });
  eval->add_option("NAME", line.name, "the function")->required();
  eval->add_option("VALUE", line.values, "its values");

  CLI::App* call = AddCommand(app, line, kCatalogues, "call", "computes any function of the catalogue",
                              [&line] { return RunCall(line.name, line.values, line.settings); });
  call->add_option("NAME", line.name, "the function")->required();
  call->add_option("VALUE", line.values, "its values");
  call->add_option("--set", line.settings, "a function to call before; may be repeated")
      ->allow_extra_args(false)
      ->type_name("NAME=VALUE,VALUE...");
}

/// CLI11 parses a reversed list, without the program's name. Numbers are hidden from it, and shown again to
/// whatever takes them.
std::vector<std::string> ArgumentsForParser(int count, char** arguments) {
  std::vector<std::string> reversed;
  for (int place = count - 1; place > 0; --place) reversed.push_back(HiddenNumber(arguments[place]));
  return reversed;
}

void ShowNumbers(CommandLine& line) {
  for (std::string* text : {&line.file,
                            &line.otherFile,
                            &line.name,
                            &line.save.file,
                            &line.save.output,
                            &line.rename.file,
                            &line.rename.oldSymbol,
                            &line.rename.newSymbol,
                            &line.rename.output,
                            &line.find.file,
                            &line.find.pattern,
                            &line.html.file,
                            &line.html.output,
                            &line.units.file,
                            &line.lint.baseline,
                            &line.lint.newBaseline,
                            &line.graph.file,
                            &line.graph.focus,
                            &line.expression.text,
                            &line.expression.symbol,
                            &line.matrix.file,
                            &line.matrix.className,
                            &line.balance.file,
                            &line.balance.poolsFile}) {
    *text = ShownNumber(*text);
  }
  for (std::vector<std::string>* texts : {&line.files, &line.values, &line.settings, &line.ignored,
                                          &line.balance.pools, &line.balance.boundaries, &line.lint.paths,
                                          &line.lint.select, &line.lint.ignore, &line.graph.kinds}) {
    for (std::string& text : *texts) text = ShownNumber(text);
  }
}

int RunTool(int count, char** arguments) {
  CLI::App app{"Reads, checks, documents and saves templates of aquatic process models.", "tessal"};
  app.formatter(std::make_shared<HelpText>());
  app.set_help_flag("-h,--help", "prints this help");
  app.set_version_flag("--version", std::string("tessal ") + TESSAL_VERSION, "prints the version");
  app.require_subcommand(1);
  CommandLine line;
  AddTemplateCommands(app, line);
  AddAnalysisCommands(app, line);
  AddKeyFileCommands(app, line);
  AddExpressionCommands(app, line);
  AddCatalogueCommands(app, line);
  try {
    app.parse(ArgumentsForParser(count, arguments));
  } catch (const CLI::ParseError& stop) {
    const EndsWithoutMemory end;
    if (stop.get_exit_code() == 0) return app.exit(stop);
    Complain(CallFault(app, stop));
    return kCallFault;
  }
  ShowNumbers(line);
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
