#include "analysis/dependency_graph.h"

#include <algorithm>
#include <limits>

#include "analysis/declared_values.h"
#include "core/template_core.h"

namespace tessal {

namespace {

constexpr std::size_t kNoPlace = std::numeric_limits<std::size_t>::max();

/// The elements of a template and their uses, by place. The two records of a movement are one element.
class UseGraph final {
 public:
  UseGraph(const TemplateCore& core, const GraphQuery& query) {
    std::vector<std::size_t> placeOfRecord;
    for (const SymbolRecord& record : core.SymbolTable()) {
      const bool isNew = elements.empty() || elements.back()->element != record.element;
      if (isNew) elements.push_back(&record);
      placeOfRecord.push_back(elements.size() - 1);
    }
    users.resize(elements.size());
    used.resize(elements.size());
    isShown.resize(elements.size());
    for (const SymbolRecord& record : core.SymbolTable()) {
      const std::size_t user = placeOfRecord[record.sequence - 1];
      for (const std::uint32_t sequence : record.references) Add(placeOfRecord[sequence - 1], user);
    }
    for (std::size_t place = 0; place < elements.size(); ++place) {
      const SymbolRecord& record = *elements[place];
      const bool isFocus = query.focus != Uid::None && record.uid == query.focus;
      if (isFocus) focus = place;
      const bool isWanted =
          std::find(query.kinds.begin(), query.kinds.end(), record.kind) != query.kinds.end();
      isShown[place] = isFocus || isWanted ? 1 : 0;
    }
  }

  std::size_t Size() const { return elements.size(); }
  const SymbolRecord& Record(std::size_t place) const { return *elements[place]; }
  bool IsShown(std::size_t place) const { return isShown[place] != 0; }
  /// None where the query has no focus, or one that is no element of the template.
  std::size_t Focus() const { return focus; }
  const std::vector<std::size_t>& Next(std::size_t place, GraphDirection direction) const {
    return direction == GraphDirection::Up ? used[place] : users[place];
  }

 private:
  void Add(std::size_t usedPlace, std::size_t user) {
    // The second record of a movement may use what the first uses.
    if (!users[usedPlace].empty() && users[usedPlace].back() == user) return;
    users[usedPlace].push_back(user);
    used[user].push_back(usedPlace);
  }

  std::vector<const SymbolRecord*> elements;
  std::vector<std::vector<std::size_t>> users;
  std::vector<std::vector<std::size_t>> used;
  std::vector<char> isShown;
  std::size_t focus = kNoPlace;
};

/// Finds the shown elements next to a shown one, directly or through hidden ones.
class Bridges final {
 public:
  explicit Bridges(const UseGraph& bridged) : graph(bridged), visits(graph.Size()) {}

  struct Neighbour {
    std::size_t place;
    bool isDirect;
  };

  /// In the order of the template, each once. Neighbours beyond the limit of the whole walk are left out.
  std::vector<Neighbour> Of(std::size_t place, GraphDirection direction) {
    std::vector<Neighbour> neighbours;
    std::vector<std::size_t> hidden;
    ++visit;
    Take(place, direction, true, neighbours, hidden);
    while (!hidden.empty()) {
      const std::size_t through = hidden.back();
      hidden.pop_back();
      Take(through, direction, false, neighbours, hidden);
    }
    std::sort(neighbours.begin(), neighbours.end(),
              [](const Neighbour& left, const Neighbour& right) { return left.place < right.place; });
    return neighbours;
  }

  bool IsComplete() const { return steps < kMostSteps; }

 private:
  /// Enough for any template that somebody draws, and done in a fraction of a second.
  static constexpr std::size_t kMostSteps = 2'000'000;

  void Take(std::size_t from, GraphDirection direction, bool isDirect, std::vector<Neighbour>& neighbours,
            std::vector<std::size_t>& hidden) {
    for (const std::size_t next : graph.Next(from, direction)) {
      // Direct uses are as many as the template has, and all of them are found.
      if (!isDirect && ++steps >= kMostSteps) return;
      if (std::exchange(visits[next], visit) == visit) continue;
      if (graph.IsShown(next)) {
        neighbours.push_back({next, isDirect});
      } else {
        hidden.push_back(next);
      }
    }
  }

  const UseGraph& graph;
  std::vector<std::size_t> visits;  ///< the last walk that came by
  std::size_t visit = 0;
  std::size_t steps = 0;
};

/// The levels of the elements around the focus; none for those that are too far.
std::vector<std::optional<int>> LevelsAround(const UseGraph& graph, const GraphQuery& query,
                                             Bridges& bridges) {
  std::vector<std::optional<int>> levels(graph.Size());
  levels[graph.Focus()] = 0;
  for (const GraphDirection direction : {GraphDirection::Up, GraphDirection::Down}) {
    if (query.direction != direction && query.direction != GraphDirection::Both) continue;
    const int sign = direction == GraphDirection::Up ? -1 : 1;
    std::vector<std::size_t> ring{graph.Focus()};
    std::vector<char> met(graph.Size());
    met[graph.Focus()] = 1;
    for (int step = 1; !ring.empty() && (!query.depth || static_cast<std::size_t>(step) <= *query.depth);
         ++step) {
      std::vector<std::size_t> nextRing;
      for (const std::size_t place : ring) {
        for (const Bridges::Neighbour& neighbour : bridges.Of(place, direction)) {
          if (std::exchange(met[neighbour.place], 1) != 0) continue;
          nextRing.push_back(neighbour.place);
          // What is on both sides belongs to the nearer one.
          std::optional<int>& level = levels[neighbour.place];
          if (!level || step < std::abs(*level)) level = sign * step;
        }
      }
      ring = std::move(nextRing);
    }
  }
  return levels;
}

GraphNode NodeOf(const SymbolRecord& record, int level) {
  return {.uid = record.uid,
          .symbol = RecordSymbol(record),
          .kind = record.kind,
          .unit = std::string(DeclaredUnit(*record.element).value_or(std::string_view())),
          .description = std::string(record.element->description.Text()),
          .level = level};
}

}  // namespace

std::vector<ElementKind> UsualGraphKinds() {
  return {ElementKind::StateVariable, ElementKind::Process, ElementKind::SpecieStateVariable,
          ElementKind::ArithmeticExpression};
}

DependencyGraph BuildGraph(const TemplateCore& core, const GraphQuery& query) {
  const UseGraph uses(core, query);
  Bridges bridges(uses);
  DependencyGraph graph;
  if (query.focus != Uid::None && uses.Focus() == kNoPlace) return graph;
  std::vector<std::optional<int>> levels(uses.Size(), 0);
  if (query.focus != Uid::None) levels = LevelsAround(uses, query, bridges);
  std::vector<std::size_t> nodeOf(uses.Size(), kNoPlace);
  for (std::size_t place = 0; place < uses.Size(); ++place) {
    if (!uses.IsShown(place) || !levels[place]) continue;
    nodeOf[place] = graph.nodes.size();
    graph.nodes.push_back(NodeOf(uses.Record(place), *levels[place]));
  }
  for (std::size_t place = 0; place < uses.Size(); ++place) {
    if (nodeOf[place] == kNoPlace) continue;
    for (const Bridges::Neighbour& user : bridges.Of(place, GraphDirection::Down)) {
      if (nodeOf[user.place] == kNoPlace) continue;
      graph.edges.push_back({nodeOf[place], nodeOf[user.place], user.isDirect});
    }
  }
  graph.isComplete = bridges.IsComplete();
  return graph;
}

}  // namespace tessal
