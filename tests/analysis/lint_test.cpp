// What lint finds, rule by rule, and graphs of uses. Templates are in the notation of lines; the examples
// come as they are.
#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <set>
#include <sstream>

#include "analysis/dependency_graph.h"
#include "analysis/lint.h"
#include "core/template_core.h"
#include "support/case_file.h"
#include "support/template_text.h"

namespace tessal::test {
namespace {

std::shared_ptr<TemplateCore> TemplateOf(const Case& each) {
  auto core = std::make_shared<TemplateCore>();
  EXPECT_TRUE(core->LoadText(TemplateFromNotation(each.input))) << each.title;
  return core;
}

/// The part of the element's field that the finding is about.
std::string PartOf(const TemplateCore& core, const AnalysisFinding& finding) {
  if (finding.place.length == 0) return {};
  const CEL_Element& element = *core.GetElement(finding.element);
  const std::string_view stored = (element.*element.PlaceWithLabel(finding.field)).Text();
  return " at '" +
         std::string(StripExpressionQuotes(stored).substr(finding.place.start, finding.place.length)) + "'";
}

TEST(Lint, FindsWhatItsCasesSayWithEveryRule) {
  std::set<std::string_view> fired;
  RunCases("analysis/cases/lint.txt", [&fired](const Case& each) -> Answer {
    return [&fired, core = TemplateOf(each)](const CaseCall& call) {
      std::string lines;
      for (const AnalysisFinding& finding : Lint(*core, {{call.words}, {}})) {
        fired.insert(finding.message->code);
        lines += finding.symbol + ": " + finding.text + PartOf(*core, finding) + "\n";
      }
      return lines;
    };
  });
  for (const std::string_view rule : LintRules()) EXPECT_TRUE(fired.contains(rule)) << rule;
}

/// Words of a call: kinds of elements by their numbers, then a focus, a direction and a depth.
GraphQuery QueryOf(const TemplateCore& core, const std::string& words) {
  std::istringstream stream(words);
  std::string kinds;
  std::string focus;
  std::string direction;
  std::size_t depth = 0;
  stream >> kinds >> focus >> direction;
  GraphQuery query;
  std::istringstream numbers(kinds);
  for (std::string number; std::getline(numbers, number, ',');) {
    query.kinds.push_back(static_cast<ElementKind>(std::stoi(number)));
  }
  for (const SymbolRecord& record : core.SymbolTable()) {
    if (RecordSymbol(record) == focus) query.focus = record.uid;
  }
  if (direction == "up") query.direction = GraphDirection::Up;
  if (direction == "down") query.direction = GraphDirection::Down;
  if (stream >> depth) query.depth = depth;
  return query;
}

TEST(Graph, IsWhatItsCasesSay) {
  RunCases("analysis/cases/graph.txt", [](const Case& each) -> Answer {
    return [core = TemplateOf(each)](const CaseCall& call) {
      const std::size_t blank = call.words.find(' ');
      const std::string format = call.words.substr(0, blank);
      const DependencyGraph graph = BuildGraph(*core, QueryOf(*core, call.words.substr(blank + 1)));
      if (format == "dot") return GraphAsDot(graph);
      if (format == "mermaid") return GraphAsMermaid(graph);
      if (format == "graphml") return GraphAsGraphml(graph);
      std::string text;
      for (const GraphNode& node : graph.nodes) text += node.symbol + " " + std::to_string(node.level) + "\n";
      for (const GraphEdge& edge : graph.edges) {
        text += graph.nodes[edge.source].symbol + (edge.isDirect ? " -> " : " ..> ") +
                graph.nodes[edge.target].symbol + "\n";
      }
      return text;
    };
  });
}

/// A template whose elements all go through one hidden auxiliary.
std::string Hourglass(int width) {
  std::string sum = "c0";
  std::string lines = "constant c0 1\n";
  for (int place = 1; place < width; ++place) {
    lines += "constant c" + std::to_string(place) + " 1\n";
    sum += "+c" + std::to_string(place);
  }
  lines += "auxiliary waist " + sum + "\n";
  for (int place = 0; place < width; ++place) {
    lines += "process p" + std::to_string(place) + " waist*" + std::to_string(place) + "\n";
  }
  return lines;
}

TEST(Graph, SaysWhenEdgesAreLeftOut) {
  constexpr int kWidth = 3000;
  TemplateCore core;
  ASSERT_TRUE(core.LoadText(TemplateFromNotation(Hourglass(kWidth))));
  const DependencyGraph bridged = BuildGraph(core, {.kinds = {ElementKind::Constant, ElementKind::Process}});
  EXPECT_FALSE(bridged.isComplete);
  EXPECT_EQ(bridged.nodes.size(), 2U * kWidth);
  const DependencyGraph direct =
      BuildGraph(core, {.kinds = {ElementKind::Constant, ElementKind::Auxiliary, ElementKind::Process}});
  EXPECT_TRUE(direct.isComplete);
  EXPECT_EQ(direct.edges.size(), 2U * kWidth);
}

TEST(Lint, IsFastInLongExpressions) {
  // As deep as they are long, with something to find at each node; and one IF in the other.
  constexpr int kLength = 20'000;
  std::string chain = "0/z";
  std::string nested = "z";
  for (int place = 0; place < kLength; ++place) chain += "+1.25/z";
  for (int place = 0; place < kLength / 10; ++place) nested = "IF z > 1 THEN (" + nested + ") ELSE z";
  TemplateCore core;
  ASSERT_TRUE(core.LoadText(TemplateFromNotation("constant z 0\nauxiliary a IF z > 0 THEN " + chain +
                                                 " ELSE 0\nauxiliary b " + nested + "\n")));
  const std::vector<AnalysisFinding> findings = Lint(core, {{"division-by-zero", "equal-branches"}, {}});
  ASSERT_EQ(findings.size(), 1U);
  EXPECT_EQ(findings.front().symbol, "b");
}

}  // namespace
}  // namespace tessal::test
