// The reference of functions and built-ins: complete, in the catalogues' words, and true of what is computed.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <map>

#include "expr/builtin_catalogue.h"
#include "expr/builtin_reference.h"
#include "expr/function_catalogue.h"
#include "expr/function_reference.h"
#include "expr/semantic_checks.h"
#include "expr/word_reference.h"
#include "support/catalogue_call.h"

namespace tessal {
namespace {

using Kind = UnitRule::Kind;

TEST(Reference, HasOneRowForEachFunctionWithItsArguments) {
  std::size_t rows = 0;
  for (const FunctionGroup& group : FunctionGroups()) rows += group.functions.size();
  EXPECT_EQ(rows, Functions().size());
  for (const CatalogueFunction& function : Functions()) {
    const FunctionReference* row = ReferenceOfFunction(function.name);
    ASSERT_NE(row, nullptr) << function.name;
    EXPECT_EQ(row->name, function.name);
    std::string names;
    for (const ArgumentReference& argument : row->arguments) {
      names += (names.empty() ? "" : ",") + std::string(argument.name);
      EXPECT_FALSE(argument.meaning.empty()) << function.name;
      EXPECT_TRUE(RuleOfUnit(*row, argument.unit)) << function.name << " " << argument.unit;
    }
    EXPECT_EQ(names, JoinedArguments(function)) << function.name;
    EXPECT_TRUE(row->purpose.ends_with('.') && !row->result.empty()) << function.name;
    EXPECT_TRUE(RuleOfUnit(*row, row->resultUnit)) << function.name << " " << row->resultUnit;
    EXPECT_EQ(GroupOfFunction(*row).title == "Deprecated", function.traits.isDeprecated) << function.name;
    // As many formulae as the argument's name says: "Option (1-14)".
    const std::size_t formulae = FormulaeOf(*row).size();
    if (formulae > 0) {
      EXPECT_NE(names.find("-" + std::to_string(formulae) + ")"), std::string::npos) << names;
    }
  }
  EXPECT_EQ(FormulaeOf(*ReferenceOfFunction("set_ks_option")).size(), 2U);
  EXPECT_EQ(ReferenceOfFunction("GET_K0"), nullptr);
}

TEST(Reference, HasOneRowForEachBuiltin) {
  ASSERT_EQ(BuiltinReferences().size(), Builtins().size());
  for (std::size_t place = 0; place < Builtins().size(); ++place) {
    const BuiltinReference& row = BuiltinReferences()[place];
    EXPECT_EQ(row.name, Builtins()[place].name);
    EXPECT_EQ(ReferenceOfBuiltin(row.name), &row);
    EXPECT_TRUE(row.purpose.ends_with('.') && !row.use.empty() && !row.unit.empty()) << row.name;
  }
  EXPECT_NE(ReferenceOfBuiltin("temperature"), nullptr);
  EXPECT_EQ(ReferenceOfBuiltin("HEAT"), nullptr);
  // Quantities that the catalogue measures in one unit have one in the reference too.
  std::map<std::string_view, std::string_view> units = {{"", "1"}, {"mg/", "unknown"}, {"auto", "unknown"}};
  for (const CatalogueBuiltin& builtin : Builtins()) {
    const std::string_view unit = ReferenceOfBuiltin(builtin.name)->unit;
    EXPECT_EQ(units.emplace(builtin.unit, unit).first->second, unit) << builtin.name;
  }
}

TEST(Reference, HasOneRowForEachWordOfTheLanguage) {
  EXPECT_EQ(PropertyReferences().size(), PropertyNames().size());
  EXPECT_EQ(VerbReferences().size(), InteractionVerbs().size());
  for (const auto words : {PropertyNames(), InteractionVerbs()}) {
    for (const std::string_view word : words) {
      const WordReference* row = ReferenceOfWord(word);
      ASSERT_NE(row, nullptr) << word;
      EXPECT_TRUE(row->meaning.ends_with('.')) << word;
      EXPECT_EQ(row->unit.empty(), IsInteractionVerb(word)) << word;
    }
  }
  EXPECT_EQ(ReferenceOfWord("xpos"), nullptr) << "the check takes capitals alone";
}

/// By what a quantity with that rule grows when all that may have any unit is measured in units a `scale`-th
/// as large.
double GrowthOf(const FunctionReference& function, const UnitRule& rule, const std::vector<double>& values,
                double scale) {
  if (rule.kind == Kind::Any) return scale;
  if (rule.kind != Kind::OfArgument) return 1;
  const double power = rule.powerArgument ? values[*rule.powerArgument] : rule.power;
  const UnitRule argument = *RuleOfUnit(function, function.arguments[rule.argument].unit);
  return std::pow(GrowthOf(function, argument, values, scale), power);
}

TEST(Reference, ResultsChangeWithTheUnitsOfArgumentsAsTheRulesSay) {
  constexpr double kScale = 4;
  int checked = 0;
  for (const CatalogueFunction& function : Functions()) {
    const FunctionReference& row = *ReferenceOfFunction(function.name);
    const std::optional<UnitRule> ofResult = RuleOfUnit(row, row.resultUnit);
    // What rounds to whole numbers goes by the unit.
    const bool rounds = row.range == "whole numbers";
    if (function.evaluator == nullptr || ofResult->kind == Kind::Unknown || rounds) continue;
    for (const double step : {0.7, -0.45}) {
      std::vector<double> values(row.arguments.size());
      for (std::size_t place = 0; place < values.size(); ++place) {
        values[place] = 2 + step * static_cast<double>(place);
      }
      std::vector<double> scaled;
      for (std::size_t place = 0; place < values.size(); ++place) {
        const UnitRule rule = *RuleOfUnit(row, row.arguments[place].unit);
        scaled.push_back(values[place] * GrowthOf(row, rule, values, kScale));
      }
      if (scaled == values) continue;
      test::ResetNumbers();
      const double before = function.evaluator(values);
      test::ResetNumbers();
      const double after = function.evaluator(scaled);
      if (std::isnan(before) && std::isnan(after)) continue;
      const double expected = before * GrowthOf(row, *ofResult, values, kScale);
      EXPECT_NEAR(after, expected, 1e-9 * std::fabs(expected)) << CallText(row) << " " << step;
      ++checked;
    }
  }
  EXPECT_GE(checked, 50);
  test::ResetNumbers();
}

TEST(Reference, SaysUnitsInWords) {
  const FunctionReference& power = *ReferenceOfFunction("POW");
  EXPECT_EQ(CallText(power), "POW(x, y)");
  EXPECT_EQ(CallText(*ReferenceOfFunction("PI")), "PI()");
  const std::pair<const char*, const char*> cases[] = {
      {"any", "any unit"},
      {"1", "1"},
      {"as x", "the unit of x"},
      {"as x^2", "the unit of x, squared"},
      {"as x^0.5", "the unit of x, to the power of 0.5"},
      {"as x^y", "the unit of x, to the power of y"},
      {"umol/kg", "umol/kg"},
  };
  for (const auto& [unit, words] : cases) EXPECT_EQ(UnitInWords(power, unit), words) << unit;
  for (const char* unit : {"as z", "as x^z", "as x^2y", "as "}) {
    EXPECT_FALSE(RuleOfUnit(power, unit)) << unit;
  }
}

TEST(Reference, FindsTheNearestNames) {
  constexpr std::string_view kNames[] = {"SIN", "SINH", "SIGN", "SQRT", "LAMBERT_BEER_1", "LAMBERT_BEER_2"};
  const auto nearest = [&kNames](std::string_view typed) { return NearestNames(typed, kNames); };
  using Names = std::vector<std::string_view>;
  EXPECT_EQ(nearest("sine"), (Names{"SIN", "SINH"})) << "one letter in four";
  EXPECT_EQ(nearest("sqr"), Names{"SQRT"});
  EXPECT_EQ(nearest("LAMBERTBEER2"), (Names{"LAMBERT_BEER_2", "LAMBERT_BEER_1"})) << "the nearest first";
  EXPECT_EQ(nearest(""), Names{});
  EXPECT_EQ(nearest("temperature"), Names{});
}

}  // namespace
}  // namespace tessal
