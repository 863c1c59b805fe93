#include <charconv>
#include <system_error>

#include "cli/command_line.h"

namespace tessal::cli {

namespace {

void AddUnits(CLI::App& app, CommandLine& line) {
  CLI::App* units = AddCommand(app, line, kAnalyses, "units", "finds units that do not go together",
                               [&line] { return RunUnits(line.units); });
  AddFile(*units, line.units.file);
  units->add_flag("--strict", line.units.isStrict, "tells mmol N from mmol C and other substances apart");
  units->add_flag("--list", line.units.isList, "lists how each unit text was read");
  AddChoice(*units, "--format", "FORMAT", Choices<Format>(kCheckFormats), line.units.format);
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
  lint->add_flag("--quiet", line.lint.isQuiet, "prints no finding: the exit code says whether there are any");
  AddChoice(*lint, "--format", "FORMAT", Choices<Format>(kCheckFormats), line.lint.format);
}

void AddGraph(CLI::App& app, CommandLine& line) {
  CLI::App* graph = AddCommand(app, line, kAnalyses, "graph", "prints who depends on whom",
                               [&line] { return RunGraph(line.graph); });
  AddFile(*graph, line.graph.file);
  CLI::Option* focus =
      graph->add_option("--focus", line.graph.focus, "shows what lies around it")->type_name("SYMBOL");
  const auto readDepth = [&line](const std::string& text) {
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

void AddMatrix(CLI::App& app, CommandLine& line) {
  CLI::App* matrix = AddCommand(app, line, kAnalyses, "matrix", "prints the process matrix",
                                [&line] { return RunMatrix(line.matrix); });
  AddFile(*matrix, line.matrix.file);
  matrix->add_option("--class", line.matrix.className, "the matrix of a particle class")->type_name("NAME");
  matrix->add_flag("--elementary", line.matrix.isElementary,
                   "replaces processes that are made of others by those");
  AddChoice(*matrix, "--format", "FORMAT", Choices<Format>(kMatrixFormats), line.matrix.format);
}

void AddBalance(CLI::App& app, CommandLine& line) {
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
}

}  // namespace

void AddAnalysisCommands(CLI::App& app, CommandLine& line) {
  AddMatrix(app, line);
  AddBalance(app, line);
  AddUnits(app, line);
  AddLint(app, line);
  AddGraph(app, line);
}

}  // namespace tessal::cli
