// The catalogues as listings, and what a host of the expression layer may compute.
#include <gtest/gtest.h>

#include <sstream>

#include "expr/builtin_catalogue.h"
#include "expr/evaluate.h"
#include "expr/function_catalogue.h"
#include "support/case_file.h"

namespace tessal {
namespace {

/// The numbers of values that a host may give a function.
std::string CountsComputed(const std::string& name) {
  std::string counts;
  for (std::size_t count = 0; count <= 16; ++count) {
    double value = -12345;
    const bool computes = EvaluateFunction(name, std::vector<double>(count, 0.5), value) == 1;
    EXPECT_NE(computes, value == -12345) << name << " of " << count;
    if (computes) counts += " " + std::to_string(count);
  }
  return counts;
}

TEST(Catalogues, FunctionsAreTheListing) {
  InitCatalogues();
  std::ostringstream listing;
  for (const CatalogueFunction& each : Functions()) {
    listing << each.id << ' ' << each.name << ' ' << each.internalName << " class " << each.functionClass
            << " (" << JoinedArguments(each) << ')' << (each.evaluator == nullptr ? " without evaluator" : "")
            << (each.traits.isDeprecated ? " deprecated" : "");
    const std::string counts = CountsComputed(each.name);
    listing << (counts.empty() ? "" : " computed from" + counts) << '\n';
    EXPECT_EQ(FindFunction(each.name), &each);
    CatalogueFunction found;
    EXPECT_EQ(GetFunctionById(each.id, found), 0U);
    EXPECT_EQ(found.name, each.name);
  }
  for (const CatalogueGroup& each : Groups()) listing << each.id << ' ' << each.name << '\n';
  test::ExpectListing("expr/cases/functions.txt", listing.str());
  EXPECT_EQ(Arguments().size(), 394U);
  ReleaseCatalogues();
}

TEST(Catalogues, BuiltinsAreTheListing) {
  std::ostringstream listing;
  for (const CatalogueBuiltin& each : Builtins()) {
    listing << each.id << ' ' << each.name << (each.kind == 1 ? " constant " : " forcing ")
            << LayerText(each.layer) << ' ' << VariationText(each.variation) << ' ' << each.unitType << " '"
            << each.unit << "' " << each.defaultValue << ' ' << each.minimum << ' ' << each.maximum
            << (IsDeprecatedBuiltin(each.id) ? " deprecated" : "") << '\n';
    CatalogueBuiltin found;
    EXPECT_EQ(GetBuiltinById(each.id, found), 0U);
    EXPECT_EQ(found.name, each.name);
  }
  for (const auto* ids : {&ConstantBuiltinIds(), &ForcingBuiltinIds()}) {
    for (const std::int32_t id : *ids) listing << id << ' ';
    listing << '\n';
  }
  test::ExpectListing("expr/cases/builtins.txt", listing.str());
}

TEST(Catalogues, ALookUpThatFindsNothingChangesNothing) {
  std::string text = "kept";
  std::int32_t count = -1;
  std::int32_t functionClass = -1;
  std::int32_t id = -1;
  for (const char* name : {"GET_K0", "S\xC3\x8DN", "", "ABS "}) {
    EXPECT_EQ(FindFunctionUpper(name, text, count, functionClass, id), 0) << name;
  }
  EXPECT_EQ(std::tie(text, count, functionClass, id), std::make_tuple("kept", -1, -1, -1));
  EXPECT_EQ(FindFunctionUpper("Arctan2", text, count, functionClass, id), 1);
  EXPECT_EQ(std::tie(text, count, functionClass, id), std::make_tuple("ARCTAN2", 2, 1, 4));

  CatalogueFunction function;
  CatalogueBuiltin builtin;
  for (const std::int32_t number : {0, 142}) EXPECT_EQ(GetFunctionById(number, function), 0x80040306U);
  for (const std::int32_t number : {0, 74}) EXPECT_EQ(GetBuiltinById(number, builtin), 0x80040306U);
  for (const std::int32_t place : {0, 3}) EXPECT_EQ(GetArgumentName(58, place, text), 0x80040306U);
  EXPECT_EQ(text, "ARCTAN2");
  EXPECT_EQ(FunctionIdByName("MAX"), 11);
  EXPECT_EQ(FunctionIdByName("max"), -1) << "this look-up takes names in upper case";
  EXPECT_TRUE(IsFunctionName(text = "max"));
  EXPECT_EQ(text, "MAX");
  EXPECT_FALSE(IsFunctionName(text = "max_"));
  EXPECT_EQ(text, "MAX_");
  for (const std::int32_t row : {-1, 9}) {
    EXPECT_EQ(VariationText(row), "NONE");
    EXPECT_EQ(LayerText(row), "NOT_SPECIFIED");
  }
}

TEST(Catalogues, AHostComputesInRadiansOrDegrees) {
  test::RunCases("expr/cases/evaluation.txt", [](const test::Case& each) -> test::Answer {
    return [input = each.input](const test::CaseCall& call) {
      AnglesAreDegrees() = call.words == "each in degrees";
      std::string answers = test::AnswerEach(input, [](const std::string& line) {
        std::istringstream words(line);
        std::string name;
        words >> name;
        const std::vector<double> values{std::istream_iterator<double>(words), {}};
        double value = 0;
        if (EvaluateFunction(name, values, value) == 0) return std::string("refused\n");
        std::ostringstream text;
        text.precision(12);
        text << value << '\n';
        return text.str();
      });
      AnglesAreDegrees() = false;
      return answers;
    };
  });
}

}  // namespace
}  // namespace tessal
