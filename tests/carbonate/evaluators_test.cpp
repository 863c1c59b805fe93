// The table of evaluators as the catalogue uses it.

#include <algorithm>
#include <cmath>
#include <limits>
#include <random>
#include <set>
#include <span>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "carbonate/catalogue_call.h"
#include "expr/evaluators.h"
#include "expr/numeric/data_slots.h"
#include "expr/numeric/random.h"

namespace tessal {
namespace {

constexpr std::size_t kMostArguments = 6;

TEST(Evaluators, StandOnceForEachFunctionThatNeedsNoEngine) {
  std::set<std::string_view> names;
  for (const EvaluatorRow& row : Evaluators()) {
    EXPECT_TRUE(names.insert(row.name).second) << row.name;
    EXPECT_NE(row.evaluator, nullptr) << row.name;
  }
  EXPECT_EQ(names.size(), 125U);
  for (const std::string_view name : {"F1", "X", "ANUTRC11", "ANUTRC12", "ANUTRC22", "ANUTRC13", "ANUTRC23",
                                      "ANUTRC33", "SECCHI_DEPTH", "AVERAGE_WATER_COLUMN", "SMOOTHING_AVERAGE",
                                      "MOVING_AVERAGE", "DISTANCE_TO", "INSIDE", "_GET_K1", "_GET_K2"}) {
    EXPECT_EQ(names.count(name), 0U) << name;
  }
}

TEST(Evaluators, TakeTheirArgumentsInCatalogueOrder) {
  const struct {
    std::string_view call;
    double value;
  } rows[] = {
      {"ABS(-2)", 2},
      {"ARCCOS(0)", 1.5707963267948966},
      {"ARCSIN(1)", 1.5707963267948966},
      {"ARCTAN(1)", 0.78539816339744828},
      {"ARCTAN2(1, 0)", 1.5707963267948966},
      {"COS(0)", 1},
      {"COSH(1)", 1.5430806348152437},
      {"EXP(1)", 2.7182818284590452},
      {"LN(2)", 0.69314718055994531},
      {"LOG10(1000)", 3},
      {"MAX(1, 2)", 1},
      {"MIN(1, 2)", 2},
      {"POW(2, 3)", 8},
      {"SIN(1)", 0.8414709848078965},
      {"SINH(1)", 1.1752011936438014},
      {"SQR(3)", 9},
      {"SQRT(9)", 3},
      {"TAN(1)", 1.5574077246549023},
      {"TANH(1)", 0.76159415595576489},
      {"FLOOR(-1.5)", -2},
      {"CEIL(-1.5)", -1},
      {"PI()", 3.141592653589793},
      {"MOD(5, 3)", 2},
      {"PER_DAY(3600)", 24},
      {"SET_RADIUS(3, 25)", 25},
      {"TERMINATE()", 0},
      {"_SET_ENGINESTATE(1, 2)", 0},
      {"_GET_ID(5)", 0},
  };
  for (const auto& row : rows) EXPECT_DOUBLE_EQ(Call(row.call), row.value) << row.call;
}

TEST(Evaluators, MissingValuesGiveNaNAndSurplusOnesAreIgnored) {
  const std::vector<double> values{4, 5, 6};
  const std::span<const double> all = values;
  const struct {
    std::string_view name;
    std::size_t needed;
  } rows[] = {{"PI", 0}, {"SQR", 1}, {"MOD", 2}, {"DAYNUMBER", 3}};
  for (const auto& row : rows) {
    const auto found =
        std::find_if(Evaluators().begin(), Evaluators().end(),
                     [&row](const EvaluatorRow& candidate) { return candidate.name == row.name; });
    ASSERT_NE(found, Evaluators().end()) << row.name;
    for (std::size_t given = 0; given <= all.size(); ++given) {
      EXPECT_EQ(std::isnan(found->evaluator(all.first(given))), given < row.needed)
          << row.name << " " << given;
    }
  }
}

TEST(Evaluators, AnswerEveryValueWithoutHarm) {
  const double values[] = {0.0,
                           -0.0,
                           1.0,
                           -1.0,
                           2.0,
                           7.5,
                           35.0,
                           100.0,
                           -273.15,
                           2000.0,
                           1e-320,
                           1e15,
                           -1e15,
                           1e16,
                           4e9,
                           -4e9,
                           1e19,
                           -1e19,
                           1e300,
                           -1e300,
                           HUGE_VAL,
                           -HUGE_VAL,
                           std::numeric_limits<double>::quiet_NaN()};
  constexpr unsigned kSeed = 20260101;
  std::mt19937 pick(kSeed);
  std::vector<double> arguments(kMostArguments);
  const auto fill = [&] {
    for (double& argument : arguments) argument = values[pick() % std::size(values)];
  };
  for (const EvaluatorRow& row : Evaluators()) {
    for (const double value : values) {
      std::fill(arguments.begin(), arguments.end(), value);
      row.evaluator(arguments);
    }
    for (int round = 0; round < 300; ++round) {
      fill();
      row.evaluator(arguments);
    }
  }
  ResetCarbonateForTest();
  ResetRandomNumbers();
  ClearDataSlots();
  EXPECT_NEAR(Call("CALC_PH(2100, 2300, 35, 25, 0)"), 7.83205042246, 1e-9);
}

}  // namespace
}  // namespace tessal
