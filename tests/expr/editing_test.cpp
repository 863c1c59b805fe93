// What an expression says while it is edited, by a file of cases: in each line a bar marks the caret.
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <string>

#include "expr/caret_context.h"
#include "expr/function_catalogue.h"
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
