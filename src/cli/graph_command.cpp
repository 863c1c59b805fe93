// Prints who depends on whom.
#include <algorithm>
#include <array>
#include <nlohmann/json.hpp>
#include <optional>

#include "analysis/dependency_graph.h"
#include "cli/commands.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "core/symbol_ranking.h"
#include "core/template_core.h"
#include "expr/function_reference.h"
#include "platform/child_program.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

/// More nodes take the drawing program minutes, and nobody can read the drawing.
constexpr std::size_t kMostDrawnUnasked = 500;

struct KindWord {
  std::string_view word;
  ElementKind kind;
  ElementKind ofClasses = ElementKind::None;  ///< the same in particle classes
};
constexpr std::array kKindWords = {
    KindWord{"state", ElementKind::StateVariable, ElementKind::SpecieStateVariable},
    KindWord{"constant", ElementKind::Constant, ElementKind::SpecieConstant},
    KindWord{"forcing", ElementKind::Forcing, ElementKind::SpecieForcing},
    KindWord{"auxiliary", ElementKind::Auxiliary},
    KindWord{"process", ElementKind::Process},
    KindWord{"output", ElementKind::DerivedOutput},
    KindWord{"class", ElementKind::Specie},
    KindWord{"search", ElementKind::SpatialFunction},
    KindWord{"expression", ElementKind::ArithmeticExpression},
    KindWord{"movement", ElementKind::HorizontalVector, ElementKind::VerticalEquation},
};
constexpr std::string_view kAllKinds = "all";

/// The kinds of words; none, with a line on standard error, when one is no word for a kind.
std::optional<std::vector<ElementKind>> KindsOf(const std::vector<std::string>& words) {
  if (words.empty()) return UsualGraphKinds();
  std::vector<ElementKind> kinds;
  for (const std::string& word : words) {
    bool isKnown = false;
    std::string known(kAllKinds);
    for (const KindWord& row : kKindWords) {
      known += ", " + std::string(row.word);
      if (word != row.word && word != kAllKinds) continue;
      isKnown = true;
      kinds.insert(kinds.end(), {row.kind, row.ofClasses});
    }
    if (isKnown) continue;
    Complain("--kinds: '" + OnOneLine(word) + "' is none of " + known);
    return std::nullopt;
  }
  return kinds;
}

/// The identity of the element with a symbol; none, with a line on standard error, when there is none.
std::optional<Uid> FocusOf(const TemplateCore& core, const std::string& symbol) {
  std::vector<std::string> symbols;
  for (const SymbolRecord& record : core.SymbolTable()) {
    symbols.push_back(RecordSymbol(record));
    if (symbols.back() == symbol) return record.uid;
  }
  std::string line = "no element has the symbol '" + OnOneLine(symbol) + "'";
  const std::vector<const SymbolRecord*> ranked = SymbolsByRank(core, symbol, 1);
  const std::vector<std::string_view> near =
      NearestNames(symbol, std::vector<std::string_view>(symbols.begin(), symbols.end()));
  std::string nearest(near.empty() ? std::string_view() : near.front());
  if (nearest.empty() && !ranked.empty()) nearest = RecordSymbol(*ranked.front());
  if (!nearest.empty()) line += "; the nearest is '" + OnOneLine(nearest) + "'";
  Complain(line);
  return std::nullopt;
}

std::string GraphAsJson(const DependencyGraph& graph) {
  Json nodes = Json::array();
  for (const GraphNode& node : graph.nodes) {
    nodes.push_back({{"symbol", JsonText(node.symbol)},
                     {"kind", KindText(node.kind)},
                     {"unit", JsonText(node.unit)},
                     {"description", JsonText(node.description)},
                     {"level", node.level}});
  }
  Json edges = Json::array();
  for (const GraphEdge& edge : graph.edges) {
    edges.push_back({{"from", JsonText(graph.nodes[edge.source].symbol)},
                     {"to", JsonText(graph.nodes[edge.target].symbol)},
                     {"direct", edge.isDirect}});
  }
  return Json{{"nodes", nodes}, {"edges", edges}}.dump() + "\n";
}

ExitCode PrintDrawing(const DependencyGraph& graph, const GraphCall& call) {
  const bool isAskedFor = !call.focus.empty() || !call.kinds.empty();
  if (graph.nodes.size() > kMostDrawnUnasked && !isAskedFor) {
    Complain("the graph has " + std::to_string(graph.nodes.size()) +
             " nodes; --focus shows a part, and with --kinds all of it is drawn");
    return kCallFault;
  }
  const ChildResult drawing = RunChildProgram("dot", {"-Tsvg"}, GraphAsDot(graph));
  if (drawing.succeeded) {
    Print(drawing.output);
    return kFine;
  }
  Complain(drawing.started ? "the program dot failed: " + drawing.failure
                           : "svg needs the program dot of Graphviz: " + drawing.failure);
  return kCallFault;
}

}  // namespace

ExitCode RunGraph(const GraphCall& call) {
  const std::optional<std::vector<ElementKind>> kinds = KindsOf(call.kinds);
  TemplateCore& core = TheTemplate();
  if (!kinds || !LoadOrComplain(core, call.file)) return kCallFault;
  const EndsWithoutMemory end;
  GraphQuery query{.depth = call.depth, .direction = call.direction, .kinds = *kinds};
  if (!call.focus.empty()) {
    const std::optional<Uid> focus = FocusOf(core, call.focus);
    if (!focus) return kCallFault;
    query.focus = *focus;
  }
  const DependencyGraph graph = BuildGraph(core, query);
  if (!graph.isComplete)
    Complain("too many elements use others through what is not shown: edges are left out");
  switch (call.format) {
    case GraphFormat::Dot:
      Print(GraphAsDot(graph));
      return kFine;
    case GraphFormat::Mermaid:
      Print(GraphAsMermaid(graph));
      return kFine;
    case GraphFormat::Graphml:
      Print(GraphAsGraphml(graph));
      return kFine;
    case GraphFormat::Json:
      Print(GraphAsJson(graph));
      return kFine;
    default:
      return PrintDrawing(graph, call);
  }
}

}  // namespace tessal::cli
