// Who depends on whom in a template, as a graph: all of it, or what lies around one symbol.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "elements/element_kind.h"
#include "platform/uid.h"

namespace tessal {

class TemplateCore;

enum class GraphDirection : std::uint8_t {
  Up,    ///< what influences the focus
  Down,  ///< what the focus influences
  Both
};

struct GraphQuery {
  Uid focus = Uid::None;               ///< none for the whole template
  std::optional<std::size_t> depth{};  ///< steps from the focus; none for all
  GraphDirection direction = GraphDirection::Both;
  std::vector<ElementKind> kinds{};  ///< the focus is shown in any case
};

struct GraphNode {
  Uid uid = Uid::None;
  std::string symbol;
  ElementKind kind = ElementKind::None;
  std::string unit;
  std::string description;
  int level = 0;  ///< steps from the focus, below 0 for what influences it; 0 without a focus
};

/// The target uses the source. Elements of kinds that are not shown are bridged: a use through them is an
/// edge.
struct GraphEdge {
  std::size_t source;  ///< places among the nodes
  std::size_t target;
  bool isDirect;
  bool operator==(const GraphEdge&) const = default;
};

struct DependencyGraph {
  std::vector<GraphNode> nodes;  ///< in the order of the template
  std::vector<GraphEdge> edges;  ///< by source, then target
  /// False where so much is bridged that edges are left out: uses through elements that are not shown could
  /// be as many as the square of the template.
  bool isComplete = true;
};

/// State variables and processes, of the template and of particle classes: what is shown when nothing is
/// asked.
std::vector<ElementKind> UsualGraphKinds();

DependencyGraph BuildGraph(const TemplateCore& core, const GraphQuery& query);

std::string GraphAsDot(const DependencyGraph& graph);
std::string GraphAsMermaid(const DependencyGraph& graph);
std::string GraphAsGraphml(const DependencyGraph& graph);

}  // namespace tessal
