// What an expression says while it is edited, by a file of cases: in each line a bar marks the caret.
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <string>
#include <vector>

#include "expr/caret_context.h"
#include "expr/expression_shape.h"
#include "expr/function_catalogue.h"
#include "expr/node_span.h"
#include "expr/parser.h"
#include "expr/plain_language.h"
#include "support/case_file.h"

namespace tessal {
namespace {

std::string Marked(const std::string& text, LexemeSpan span) {
  return "'" + text.substr(span.start, span.length) + "' at " + std::to_string(span.start);
}

std::string Context(const std::string& line) {
  const std::size_t caret = line.find('|');
  const std::string text = line.substr(0, caret) + line.substr(caret + 1);
  constexpr std::array<const char*, 5> kPlaces = {"value", "operator", "property", "target", "nothing"};
  const CaretContext context = ContextAt(text, caret);
  std::string answer = kPlaces.at(static_cast<std::size_t>(context.place));
  if (context.word.length > 0) answer += ", word " + Marked(text, context.word);
  if (context.call) {
    answer +=
        ", argument " + std::to_string(context.call->argument) + " of " + Marked(text, context.call->name);
  }
  if (const auto pair = BracketAt(text, caret)) {
    answer += ", " + Marked(text, pair->bracket) + " and " +
              (pair->partner ? Marked(text, *pair->partner) : std::string("none"));
  }
  return answer + "\n";
}

TEST(Editing, KnowsWhatLiesAtTheCaret) {
  test::RunCases("expr/cases/caret.txt", [](const test::Case& each) -> test::Answer {
    return [input = each.input](const test::CaseCall& /*call*/) { return test::AnswerEach(input, Context); };
  });
}

std::string TreeText(const ExpressionNode& node) {
  std::string tree;
  node.WalkInOrder(
      [&tree](NodeKind kind, std::string_view text, std::int32_t depth) {
        tree +=
            std::to_string(depth) + ':' + std::to_string(static_cast<int>(kind)) + std::string(text) + ' ';
      },
      nullptr, nullptr);
  return tree;
}

/// Those parts of an expression whose text is not that of the same part when it is parsed alone.
std::string PartsThatDiffer(const std::string& text) {
  const ScannerRest rest;
  const auto parsed = ParseExpression(text);
  std::string differing;
  std::vector<const ExpressionNode*> open;
  if (parsed->Tree() != nullptr) open.push_back(parsed->Tree());
  while (!open.empty()) {
    const ExpressionNode& node = *open.back();
    open.pop_back();
    const bool isCondition = node.Kind() == NodeKind::Comparison;
    const bool isWhole = isCondition || node.Kind() <= NodeKind::Arithmetic ||
                         node.Kind() == NodeKind::Property || node.Kind() == NodeKind::Negate ||
                         node.Kind() == NodeKind::Interaction || node.Text() == "IF";
    // What the grammar put in for AND, OR and NOT is in no text.
    const bool isLogic = isCondition && LogicOf(node).has_value();
    if (isWhole) {
      const std::string part(TextOf(node, text));
      const std::string alone = isCondition ? "IF " + part + " THEN 1 ELSE 0" : part;
      const auto again = ParseExpression(alone);
      const ExpressionNode* tree = again->Tree();
      if (tree != nullptr && isCondition) tree = tree->Child(1);
      if (tree == nullptr || TreeText(*tree) != TreeText(node)) differing += part + '\n';
    }
    if (isLogic) {
      open.push_back(&LogicOf(node)->left);
      open.push_back(&LogicOf(node)->right);
      continue;
    }
    for (std::int32_t slot = 1; slot <= node.ChildCount(); ++slot) open.push_back(node.Child(slot));
  }
  return differing;
}

TEST(Editing, FindsThePlaceOfEachPart) {
  for (const char* text :
       {"a+b*c-d/(e+f)*-g", "-(a+b)*(-c) - -d", "((a))*((b+c))", "f(a, -b)*PI() + g(h((x)), [AGE])",
        "IF a>b AND NOT (c<d OR e==f) THEN -IF g>1 THEN 2 ELSE h ELSE (i+j)*k", "$x*2 + 1/$y",
        "IF(NOT a>b, (c), IF(d+1>e AND f>g OR h>i, j, k))", "EXCEEDANCE_FREQUENCY(a+1 > b)*c",
        "KILL{(Larva, [AGE]+1)}", "TRANSFER{(Fish, 1), (Mass, [XPOS], 1, 0, (a+b), -c)} + 2",
        "IF (a+b)*c > (d) THEN ([XPOS]) ELSE (f())", "/* a */ a + /* b */ (b /* c */) * c"}) {
    EXPECT_EQ(PartsThatDiffer(text), "") << text;
  }
}

/// The faults of a text: what is underlined, and the sentences.
std::string Faults(const std::string& text) {
  std::string rows;
  for (const ExpressionFault& fault : FindLanguageFaults(text)) {
    rows += Marked(text, fault.at) + ": " + fault.plain + "\n";
  }
  return rows;
}

TEST(Editing, SaysInPlainLanguageWhatIsWrong) {
  InitCatalogues();
  test::RunCases("expr/cases/faults.txt", [](const test::Case& each) -> test::Answer {
    return [input = each.input](const test::CaseCall& /*call*/) { return test::AnswerEach(input, Faults); };
  });
  ReleaseCatalogues();
}

}  // namespace
}  // namespace tessal
