#include <charconv>
#include <system_error>

#include "cli/command_line.h"

namespace tessal::cli {

namespace {

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
                               [&line] { return RunCheck(line.check); });
  check->add_option("PATH", line.check.paths, "template files, folders of them, or - for standard input")
      ->required();
  AddChoice(*check, "--format", "FORMAT", Choices<Format>(kCheckFormats), line.check.format);
  const std::string levels = WordsOf(Choices<int>(kLevels));
  CLI::Option* level = check->add_option_function<std::string>(
      "--level", [&line](const std::string& text) { line.check.lowestLevel = LevelIn(text); },
      "hides messages below it: " + levels + ", or 1 to 4");
  OfferWords(level->type_name("LEVEL"), levels);
  check->add_flag("--quiet", line.check.isQuiet, "prints nothing: the exit code says whether there are any");
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

void AddChanges(CLI::App& app, CommandLine& line) {
  CLI::App* changes = AddCommand(app, line, kTemplates, "changes", "lists what differs between two templates",
                                 [&line] { return RunChanges(line.file, line.otherFile, line.format); });
  changes->add_option("A", line.file, "the former template")->required();
  changes->add_option("B", line.otherFile, "the later one")->required();
  AddFormat(*changes, line, kDescriptionFormats);
}

void AddMerge(CLI::App& app, CommandLine& line) {
  CLI::App* merge =
      AddCommand(app, line, kTemplates, "merge", "brings two changed states of a template together",
                 [&line] { return RunMerge(line.merge); });
  merge->add_option("BASE", line.merge.base, "the template that both come from")->required();
  merge->add_option("OURS", line.merge.ours, "the state that is kept in a conflict, and replaced")
      ->required();
  merge->add_option("THEIRS", line.merge.theirs, "the other state")->required();
  AddOutput(*merge, line.merge.output, "saves under this name, not in the place of OURS");
  AddForce(*merge, line.merge.force);
}

void AddTables(CLI::App& app, CommandLine& line) {
  const auto addOnly = [&line](CLI::App& command) {
    command.add_option("--only", line.table.only, "prints one table: states, parameters, processes...")
        ->type_name("NAME");
  };
  CLI::App* latex =
      AddCommand(app, line, kTemplates, "latex", "prints the tables of a model for a paper", [&line] {
        line.table.format = Format::Latex;
        return RunTable(line.table);
      });
  AddFile(*latex, line.table.file);
  addOnly(*latex);
  latex->add_flag("--body", line.table.isBody, "prints no document around them");

  CLI::App* table = AddCommand(app, line, kTemplates, "table", "prints the tables of a model",
                               [&line] { return RunTable(line.table); });
  AddFile(*table, line.table.file);
  addOnly(*table);
  AddChoice(*table, "--format", "FORMAT", Choices<Format>(kModelTableFormats), line.table.format);
}

}  // namespace

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
  AddChanges(app, line);
  AddMerge(app, line);

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

  AddTables(app, line);
}

}  // namespace tessal::cli
