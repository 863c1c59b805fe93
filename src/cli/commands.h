// The commands of the tool. Each prints its result and returns how it ended.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "analysis/dependency_graph.h"
#include "cli/output.h"
#include "core/find.h"

namespace tessal::cli {

enum class Format { Text, Json, Sarif, Github, Gitlab, Junit, Gcc, Markdown, Html, Csv, Latex };

// Templates.
struct CheckCall {
  std::vector<std::string> paths;
  Format format = Format::Text;
  int lowestLevel = 0;
  bool isQuiet = false;  ///< the exit code says it all; only files that could not be loaded are named
};
ExitCode RunCheck(const CheckCall& call);
/// What one message means, all messages as a list, and as a page.
ExitCode RunExplain(const std::string& code);
ExitCode RunExplainAll();
ExitCode RunExplainPage();
ExitCode RunSymbols(const std::string& file, Format format);
/// With an empty output a plain save in place, else a save under that name, which is refused when a file has
/// it, unless forced.
struct SaveCall {
  std::string file;
  std::string output;
  bool force = false;
};
ExitCode RunSave(const SaveCall& call);
/// Takes over what the load passes over, prints its account, and saves.
ExitCode RunRepair(const SaveCall& call);
ExitCode RunNew(const std::string& output, bool overwrite);
struct RenameCall {
  std::string file;
  std::string oldSymbol;
  std::string newSymbol;
  bool onlySymbol = false;
  bool wholeWords = false;
  bool letterRule = false;
  std::string output;
  bool force = false;
};
ExitCode RunRename(const RenameCall& call);
/// What differs; ends with a fault of the content where something does.
ExitCode RunChanges(const std::string& former, const std::string& later, Format format);
/// With an empty output the merged template replaces ours. Ends with a fault of the content with a conflict.
struct MergeCall {
  std::string base;
  std::string ours;
  std::string theirs;
  std::string output;
  bool force = false;
};
ExitCode RunMerge(const MergeCall& call);
/// Ends as a search does: with a fault of the content where nothing is found.
struct FindCall {
  std::string file;
  std::string pattern;
  FindIn in = FindIn::All;
  bool isRegex = false;
  bool wholeSymbols = false;
  bool ignoreCase = false;
  Format format = Format::Text;
};
ExitCode RunFind(const FindCall& call);
ExitCode RunOverview(const std::string& file);
/// With an empty output the page goes to its usual place. What is no page is replaced only when forced, and
/// never there.
struct HtmlCall {
  std::string file;
  std::string mathJax;  ///< a flag: the word "true" where no address is given
  bool isSafe = false;
  std::string output;
  bool force = false;
};
ExitCode RunHtml(const HtmlCall& call);

/// The tables of a model: as Markdown, as comma-separated values, as JSON, or as LaTeX.
struct TableCall {
  std::string file;
  std::string only;     ///< the name of one table; empty for all
  bool isBody = false;  ///< LaTeX for a document of one's own
  Format format = Format::Markdown;
};
ExitCode RunTable(const TableCall& call);

// Analyses. Each ends with a fault of the content where it finds something.
struct MatrixCall {
  std::string file;
  std::string className;  ///< of a particle class; empty for the template's own state variables
  bool isElementary = false;
  Format format = Format::Text;
};
ExitCode RunMatrix(const MatrixCall& call);
struct BalanceCall {
  std::string file;
  std::string poolsFile;                ///< a key file with pools, in the place of those of the template
  std::vector<std::string> pools;       ///< NAME=EXPR
  std::vector<std::string> boundaries;  ///< NAME=P,P or, for all pools, P,P
  Format format = Format::Text;
};
ExitCode RunBalance(const BalanceCall& call);
/// The clashes of units; or, as a list, how the unit texts were read.
struct UnitsCall {
  std::string file;
  bool isStrict = false;  ///< substances are dimensions
  bool isList = false;
  Format format = Format::Text;
};
ExitCode RunUnits(const UnitsCall& call);

// Key files.
ExitCode RunTree(const std::string& file);
ExitCode RunDiff(const std::string& left, const std::string& right, const std::vector<std::string>& ignored,
                 bool onlyKeywords);

// Analyses.
struct LintCall {
  std::vector<std::string> paths;
  std::vector<std::string> select;
  std::vector<std::string> ignore;
  std::string baseline;     ///< a file of findings that are not listed
  std::string newBaseline;  ///< where all findings go as a baseline, in the place of a report
  bool exitZero = false;
  bool isQuiet = false;  ///< the exit code says it all
  Format format = Format::Text;
};
ExitCode RunLint(const LintCall& call);
enum class GraphFormat { Dot, Mermaid, Graphml, Json, Svg };
struct GraphCall {
  std::string file;
  std::string focus;  ///< a symbol; empty for the whole template
  std::optional<std::size_t> depth;
  GraphDirection direction = GraphDirection::Both;
  std::vector<std::string> kinds;  ///< words; the usual ones when empty
  GraphFormat format = GraphFormat::Dot;
};
ExitCode RunGraph(const GraphCall& call);

// Expressions. The text "-" means standard input.
struct ExpressionCall {
  std::string text;
  bool eachLine = false;  ///< standard input, one expression a line
  std::string symbol;
  bool isDerivative = false;
};
ExitCode RunTokens(const ExpressionCall& call);
ExitCode RunParse(const ExpressionCall& call);
ExitCode RunMathml(const ExpressionCall& call);
ExitCode RunLatex(const ExpressionCall& call);
ExitCode RunRewrite(const ExpressionCall& call);
ExitCode RunExpressionCheck(const ExpressionCall& call);
ExitCode RunIdentifiers(const ExpressionCall& call);

// Catalogues.
/// The rows of a catalogue, or what they mean in words; all of them, or the one of a name.
struct CatalogueQuestion {
  std::optional<std::string> name;
  bool describe = false;
  Format format = Format::Text;  ///< of what they mean
};
ExitCode RunFunctions(const CatalogueQuestion& question);
ExitCode RunBuiltins(const CatalogueQuestion& question);
ExitCode RunEval(const std::string& name, const std::vector<std::string>& values);
ExitCode RunCall(const std::string& name, const std::vector<std::string>& values,
                 const std::vector<std::string>& settings);

/// The language server protocol over standard input and output, until the client ends it. 0 when it was shut
/// down before, 1 when not, 2 for input that is none of the protocol's.
ExitCode RunLanguageServer();

}  // namespace tessal::cli
