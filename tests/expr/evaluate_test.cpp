// Which functions a host may evaluate, and how angles and arguments reach them.

#include <cmath>
#include <numbers>
#include <set>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "expr/evaluate.h"
#include "expr/function_catalogue.h"

namespace tessal {
namespace {

constexpr double kUntouched = -12345;

class EvaluateFunctionTest : public testing::Test {
 protected:
  void SetUp() override { InitCatalogues(); }
  void TearDown() override {
    AnglesAreDegrees() = false;
    ReleaseCatalogues();
  }

  static double Evaluate(const std::string& name, const std::vector<double>& values) {
    double value = kUntouched;
    EXPECT_EQ(EvaluateFunction(name, values, value), 1) << name;
    return value;
  }
};

TEST_F(EvaluateFunctionTest, ComputesPlainMathematicsAndRefusesTheRest) {
  const std::set<std::string> plain = {"ABS",  "ARCCOS", "ARCSIN", "ARCTAN2", "ARCTAN",  "COS", "COSH", "EXP",
                                       "LN",   "LOG10",  "MAX",    "MIN",     "POW",     "SIN", "SINH", "SQR",
                                       "SQRT", "TAN",    "TANH",   "DEG2RAD", "RAD2DEG", "SIGN"};
  for (const CatalogueFunction& function : Functions()) {
    const bool computes = plain.contains(function.name);
    for (int count = 0; count <= 16; ++count) {
      const std::vector<double> values(static_cast<std::size_t>(count), 0.5);
      double value = kUntouched;
      const int answer = EvaluateFunction(function.name, values, value);
      EXPECT_EQ(answer, computes && count == function.argumentCount ? 1 : 0)
          << function.name << " of " << count;
      EXPECT_EQ(value == kUntouched, answer == 0) << function.name;
    }
  }
  double value = kUntouched;
  EXPECT_EQ(EvaluateFunction("NOBODY", {}, value), 0);
  EXPECT_EQ(value, kUntouched);
  EXPECT_EQ(Evaluate("sQr", {3}), 9);
}

TEST_F(EvaluateFunctionTest, SwapsTheArgumentsOfTheArcTangentOfTwo) {
  EXPECT_DOUBLE_EQ(Evaluate("ARCTAN2", {1, 2}), std::atan2(2, 1));
  EXPECT_EQ(Evaluate("POW", {2, 3}), 8);
}

TEST_F(EvaluateFunctionTest, DegreesReachFunctionsOfAnglesOnly) {
  AnglesAreDegrees() = true;
  const double pi = std::numbers::pi;
  const struct {
    const char* name;
    std::vector<double> values;
    double result;
  } rows[] = {
      {"COS", {60}, 0.5},
      {"COSH", {180}, std::cosh(pi)},
      {"SIN", {30}, 0.5},
      {"SINH", {180}, std::sinh(pi)},
      {"TAN", {45}, 1},
      {"TANH", {90}, std::tanh(pi / 2)},
      {"ARCCOS", {0.5}, 60},
      {"ARCSIN", {0.5}, 30},
      {"ARCTAN", {1}, 45},
      {"ARCTAN2", {2, 1}, std::atan2(1, 2) * 180 / pi},
      {"EXP", {1}, std::numbers::e},
      {"RAD2DEG", {pi}, 180},
      {"SQRT", {180}, std::sqrt(180.0)},
  };
  for (const auto& row : rows)
    EXPECT_NEAR(Evaluate(row.name, row.values), row.result, 1e-14 * row.result) << row.name;
}

}  // namespace
}  // namespace tessal
