#include "core/completion.h"

#include <gtest/gtest.h>

#include <set>
#include <sstream>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

std::set<std::string> SymbolsOffered(const TemplateCore& core, const CEL_Element& user) {
  std::set<std::string> symbols;
  for (const CaretPlace place : {CaretPlace::Value, CaretPlace::Target}) {
    for (const Completion& completion : CompletionsFor(core, user, place)) {
      if (completion.group == CompletionGroup::Symbol) symbols.emplace(completion.text);
    }
  }
  return symbols;
}

/// What the checks find in an expression of the element that uses every symbol there is.
std::string FindingsOfAll(TemplateCore& core, CEL_Element& user, const std::set<std::string>& symbols) {
  std::string expression = "0";
  for (const std::string& symbol : symbols) expression += "+" + symbol;
  std::string findings;
  user.ForEachExpression([&](const PropertyRow&, CEL_Property& property) {
    const std::string former = property.TextOf();
    property.SetText(expression);
    core.RebuildSymbolTable();
    Errors().Reset();
    core.ValidateTemplate();
    for (const ErrorRecord& record : Errors().Records()) {
      if (record.uid == user.GetUid()) findings += record.text + "\n";
    }
    property.SetText(former);
    core.RebuildSymbolTable();
  });
  return findings;
}

class CompletionOfExample : public ::testing::TestWithParam<const char*> {};

TEST_P(CompletionOfExample, OffersExactlyWhatTheChecksAllow) {
  test::LoadedTemplate loaded(
      test::ReadFile(std::string(TESSAL_SOURCE_DIR "/examples/") + GetParam() + ".tessal"));
  TemplateCore& core = *loaded;
  SetNotifyChanges(false);
  std::set<std::string> symbols;
  std::vector<CEL_Element*> users;
  for (const SymbolRecord& record : core.SymbolTable()) {
    const std::string symbol = record.element->symbol.TextOf();
    if (symbol.find(' ') == std::string::npos) symbols.insert(symbol);
    if (record.expression != nullptr) users.push_back(record.element);
  }
  ASSERT_FALSE(users.empty());
  for (CEL_Element* user : users) {
    const std::string findings = FindingsOfAll(core, *user, symbols);
    const std::set<std::string> offered = SymbolsOffered(core, *user);
    for (const std::string& symbol : symbols) {
      if (symbol == user->symbol.Text()) continue;
      const bool isAllowed = findings.find("'" + symbol + "'") == std::string::npos;
      EXPECT_EQ(offered.contains(symbol), isAllowed) << symbol << " in " << user->FullSymbol();
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Examples, CompletionOfExample,
                         ::testing::Values("asm1", "eutrophication", "fasham", "fish_larvae",
                                           "lake_management", "streeter_phelps"),
                         [](const auto& file) { return std::string(file.param); });

}  // namespace
}  // namespace tessal
