#include "cli/command_line.h"

namespace tessal::cli {

namespace {

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

}  // namespace

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

void AddEditorCommands(CLI::App& app, CommandLine& line) {
  AddCommand(app, line, kEditors, "lsp", "serves text editors by the language server protocol",
             [] { return RunLanguageServer(); });
}

}  // namespace tessal::cli
