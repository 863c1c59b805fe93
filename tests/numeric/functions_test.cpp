// The functions of the catalogue: values by hand or from the literature, and the edges.
#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "expr/function_catalogue.h"
#include "expr/numeric/arithmetic.h"
#include "expr/numeric/data_slots.h"
#include "expr/numeric/oxygen.h"
#include "support/case_file.h"
#include "support/catalogue_call.h"

namespace tessal {
namespace {

class CatalogueValues : public testing::TestWithParam<const char*> {
 protected:
  void TearDown() override { test::ResetNumbers(); }
};

TEST_P(CatalogueValues, HaveTheValuesOfTheCases) {
  test::RunCases(GetParam(), [](const test::Case& each) -> test::Answer {
    return [input = each.input](const test::CaseCall&) { return test::AnswerEach(input, test::FreshCall); };
  });
}

INSTANTIATE_TEST_SUITE_P(Cases, CatalogueValues,
                         testing::Values("numeric/cases/functions.txt", "carbonate/cases/functions.txt"));

TEST_F(CatalogueValues, LogGammaAgreesWithTheLibrary) {
  for (double x = 0.05; x < 1e6; x *= 1.37) {
    EXPECT_NEAR(LogGamma(x), std::lgamma(x), 3e-10 * std::max(1.0, std::fabs(std::lgamma(x)))) << x;
  }
}

TEST_F(CatalogueValues, OxygenAgreesWithPublishedTables) {
  // Weiss 1970, in ml/l, and Standard Methods (after Benson and Krause 1984), in mg/l.
  constexpr double kMilligramsPerMillilitre = 1.4286326556852438;
  const double weiss[][3] = {{0, 0, 10.22},  {0, 20, 6.35},  {35, 0, 8.05},
                             {35, 10, 6.32}, {35, 20, 5.17}, {35, 30, 4.35}};
  for (const auto& [salinity, temperature, millilitres] : weiss) {
    EXPECT_NEAR(OxygenSaturationWeiss(salinity, temperature) / kMilligramsPerMillilitre, millilitres, 0.006);
  }
  const double fresh[][2] = {{0, 14.62}, {5, 12.77}, {10, 11.29}, {15, 10.08},
                             {20, 9.09}, {25, 8.26}, {30, 7.56}};
  for (const auto& [temperature, milligrams] : fresh) {
    EXPECT_NEAR(OxygenSaturationWeiss(0, temperature), milligrams, 0.025) << temperature;
    EXPECT_NEAR(OxygenSaturation(0, temperature), milligrams, 0.13) << temperature;
  }
}

TEST_F(CatalogueValues, TheSlotsOfALoadAreAnotherBank) {
  EXPECT_EQ(test::Call("SAVE(100, 7)"), 7);
  DataSlots().loaded = DataSlots().saved;
  EXPECT_EQ(test::Call("SAVE(100, 8); LOAD(100)"), 7);
  ClearDataSlots();
  EXPECT_EQ(test::Call("LOAD(100)"), 0);
}

TEST_F(CatalogueValues, AnswerEveryValueWithoutHarm) {
  const double kNone = std::nan("");
  const std::vector<double> values = {0.0,     -0.0,   1.0,    -1.0,   2.0,      7.5,       35.0, 100.0,
                                      -273.15, 2000.0, 1e-320, 1e15,   -1e15,    1e16,      4e9,  -4e9,
                                      1e19,    -1e19,  1e300,  -1e300, HUGE_VAL, -HUGE_VAL, kNone};
  std::mt19937 pick(20260101);
  for (const CatalogueFunction& function : Functions()) {
    if (function.evaluator == nullptr) continue;
    std::vector<double> arguments(static_cast<std::size_t>(function.argumentCount));
    for (int round = 0; round < 100; ++round) {
      const double same =
          static_cast<std::size_t>(round) < values.size() ? values[static_cast<std::size_t>(round)] : 0;
      for (double& argument : arguments) argument = same != 0 ? same : values[pick() % values.size()];
      const double value = function.evaluator(arguments);
      const bool isAngle = function.name == "RAD2DEG" || function.name == "DEG2RAD";
      EXPECT_TRUE(!isAngle || !std::isfinite(arguments[0]) || (value >= 0 && value <= 360)) << arguments[0];
    }
  }
}

}  // namespace
}  // namespace tessal
