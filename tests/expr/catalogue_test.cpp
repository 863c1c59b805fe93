#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <set>

#include "expr/builtin_catalogue.h"
#include "expr/function_catalogue.h"

namespace tessal {
namespace {

TEST(FunctionCatalogue, HoldsItsRows) {
  EXPECT_EQ(Functions().size(), 141U);
  EXPECT_EQ(Arguments().size(), 394U);
  std::set<std::int32_t> ids;
  for (const CatalogueFunction& function : Functions()) {
    ids.insert(function.id);
    EXPECT_EQ(function.internalName, function.name);
  }
  EXPECT_EQ(ids.size(), 141U);
  EXPECT_EQ(*ids.begin(), 1);
  EXPECT_EQ(*ids.rbegin(), 141);
  // The one row out of the order of ids.
  const auto row = std::find_if(Functions().begin(), Functions().end(),
                                [](const CatalogueFunction& function) { return function.id == 138; });
  EXPECT_EQ(std::prev(row)->id, 101);
  EXPECT_EQ(std::next(row)->id, 102);
}

TEST(FunctionCatalogue, ClassesAreAsTheEngineReadsThem) {
  std::map<std::int32_t, int> counts;
  for (const CatalogueFunction& function : Functions()) ++counts[function.functionClass];
  EXPECT_EQ(counts[3], 6);
  EXPECT_EQ(counts[4] + counts[5] + counts[6] + counts[7], 4);
  EXPECT_EQ(FindFunction("floor")->functionClass, 2);
  EXPECT_EQ(FindFunction("Sign")->functionClass, 1);
}

TEST(FunctionCatalogue, FindsNamesInAnyCase) {
  std::string internalName;
  std::int32_t count = -1;
  std::int32_t functionClass = -1;
  std::int32_t id = -1;
  for (const char* name : {"sin", "Sin", "SIN"}) {
    EXPECT_EQ(FindFunctionUpper(name, internalName, count, functionClass, id), 1);
    EXPECT_EQ(id, 14);
    EXPECT_EQ(count, 1);
  }
  EXPECT_EQ(FindFunctionUpper("exceedance_frequency", internalName, count, functionClass, id), 1);
  EXPECT_EQ(id, 43);
  EXPECT_EQ(FindFunctionUpper("_get_k1", internalName, count, functionClass, id), 1);
  EXPECT_EQ(id, 90);
  EXPECT_EQ(FindFunctionUpper("GET_K0", internalName, count, functionClass, id), 0);
  EXPECT_EQ(id, 90) << "untouched when nothing is found";
  EXPECT_EQ(FindFunction("S\xC3\x8DN"), nullptr);

  std::string name = "max";
  EXPECT_TRUE(IsFunctionName(name));
  EXPECT_EQ(name, "MAX");
  EXPECT_EQ(FunctionIdByName("MAX"), 11);
  EXPECT_EQ(FunctionIdByName("max"), -1);
}

TEST(FunctionCatalogue, AnswersByNumber) {
  CatalogueFunction function;
  EXPECT_EQ(GetFunctionById(141, function), 0U);
  EXPECT_EQ(function.name, "MOONPHASE");
  EXPECT_EQ(GetFunctionById(142, function), 0x80040306U);
  std::string name = "kept";
  EXPECT_EQ(GetArgumentName(58, 1, name), 0U);
  EXPECT_EQ(name, "Propability");
  EXPECT_EQ(GetArgumentName(58, 3, name), 0x80040306U);
  EXPECT_EQ(name, "Propability");
  EXPECT_EQ(JoinedArguments(*FindFunction("SET_KS_OPTION")), "Option (1-2)");
  for (const std::int32_t id : {21, 22, 43, 44, 49}) EXPECT_TRUE(IsDeprecatedFunction(id)) << id;
  EXPECT_FALSE(IsDeprecatedFunction(42));
}

TEST(FunctionCatalogue, SetUpGivesEvaluatorsToAllButTheEnginesOwn) {
  InitCatalogues();
  const std::set<std::string> without = {"F1",
                                         "X",
                                         "ANUTRC11",
                                         "ANUTRC12",
                                         "ANUTRC22",
                                         "ANUTRC13",
                                         "ANUTRC23",
                                         "ANUTRC33",
                                         "SECCHI_DEPTH",
                                         "AVERAGE_WATER_COLUMN",
                                         "SMOOTHING_AVERAGE",
                                         "MOVING_AVERAGE",
                                         "DISTANCE_TO",
                                         "INSIDE",
                                         "_GET_K1",
                                         "_GET_K2"};
  for (const CatalogueFunction& function : Functions()) {
    EXPECT_EQ(function.evaluator == nullptr, without.contains(function.name)) << function.name;
  }
  ReleaseCatalogues();
}

TEST(BuiltinCatalogue, HoldsItsRowsAndLists) {
  ASSERT_EQ(Builtins().size(), 73U);
  for (std::size_t place = 0; place < Builtins().size(); ++place) {
    EXPECT_EQ(Builtins()[place].id, static_cast<std::int32_t>(place + 1));
    EXPECT_EQ(Builtins()[place].unitType, 999);
  }
  CatalogueBuiltin row;
  EXPECT_EQ(GetBuiltinById(0, row), 0x80040306U);
  EXPECT_EQ(GetBuiltinById(74, row), 0x80040306U);
  ASSERT_EQ(GetBuiltinById(73, row), 0U);
  EXPECT_EQ(row.unit, "()");
  EXPECT_EQ(LayerText(row.layer), "WS");
  EXPECT_EQ(VariationText(row.variation), "HORISONTAL");
  EXPECT_EQ(VariationText(9), "NONE");

  EXPECT_EQ(ConstantBuiltinIds().size() + ForcingBuiltinIds().size(), 73U);
  const auto nameOf = [](std::int32_t id) { return Builtins()[static_cast<std::size_t>(id - 1)].name; };
  for (const auto* ids : {&ConstantBuiltinIds(), &ForcingBuiltinIds()}) {
    EXPECT_TRUE(std::is_sorted(ids->begin(), ids->end(), [&](std::int32_t left, std::int32_t right) {
      return nameOf(left) < nameOf(right);
    }));
  }
  int deprecated = 0;
  for (std::int32_t id = 0; id <= 74; ++id) deprecated += IsDeprecatedBuiltin(id) ? 1 : 0;
  EXPECT_EQ(deprecated, 27);
}

}  // namespace
}  // namespace tessal
