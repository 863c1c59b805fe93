// The carbonate system against values from the literature and from a reference calculation.

#include <cmath>
#include <numbers>
#include <string_view>

#include <gtest/gtest.h>

#include "expr/carbonate/constants.h"
#include "expr/carbonate/formula.h"
#include "expr/carbonate/option_tables.h"
#include "expr/carbonate/options.h"
#include "expr/carbonate/pressure_correction.h"
#include "expr/carbonate/sea_water.h"
#include "support/catalogue_call.h"

namespace tessal {
namespace {

constexpr double kRelative = 1e-9;

class CheckValues : public testing::Test {
 protected:
  CheckValues() { test::ResetNumbers(); }
};

double LogPublished(const Formula& formula) {
  return std::log(FormulaBasis(35, 25).Evaluate(formula));
}

TEST_F(CheckValues, FormulaeGiveTheNumbersOfTheirAuthors) {
  const double log10 = std::numbers::ln10;
  const struct {
    std::string_view what;
    double computed, published, halfDigit;
  } rows[] = {
      {"ln K0", std::log(GetK0(35, 25)), -3.5617, 5e-5},
      {"K0 at 0, 20", GetK0(0, 20), 0.03916, 5e-6},
      {"K0 at 35, 0", GetK0(35, 0), 0.06287, 5e-6},
      {"K0 at 35, 20", GetK0(35, 20), 0.03241, 5e-6},
      {"ln K1, Roy", LogPublished(kCarbonicAcidOptions[0].k1), -13.4847, 5e-5},
      {"ln K2, Roy", LogPublished(kCarbonicAcidOptions[0].k2), -20.5504, 5e-5},
      {"log K1, Lueker", LogPublished(kCarbonicAcidOptions[9].k1) / log10, -5.8472, 5e-5},
      {"log K2, Lueker", LogPublished(kCarbonicAcidOptions[9].k2) / log10, -8.9660, 5e-5},
      {"log K1, Millero 2006", LogPublished(kCarbonicAcidOptions[12].k1) / log10, -5.8401, 5e-5},
      {"log K2, Millero 2006", LogPublished(kCarbonicAcidOptions[12].k2) / log10, -8.9636, 5e-5},
      {"ln KB", std::log(GetKB(35, 25)), -19.7964, 5e-5},
      {"ln KW", LogPublished(kWaterOptions[0].formula) - 0.015, -30.434, 5e-4},
      {"ln KS", std::log(GetKS(35, 25)), -2.30, 5e-3},
      {"ln KP1", LogPublished(kPhosphoricAcid1) - 0.015, -3.71, 5e-3},
      {"ln KP2", LogPublished(kPhosphoricAcid2) - 0.015, -13.727, 5e-4},
      {"ln KP3", LogPublished(kPhosphoricAcid3) - 0.015, -20.24, 5e-3},
      {"ln KSi", LogPublished(kSilicicAcid) - 0.015, -21.61, 5e-3},
      {"density 0, 5", WaterDensity(0, 5), 999.96675, 5e-6},
      {"density 0, 25", WaterDensity(0, 25), 997.04796, 5e-6},
      {"density 35, 5", WaterDensity(35, 5), 1027.67547, 5e-6},
      {"density 35, 25", WaterDensity(35, 25), 1023.34306, 5e-6},
  };
  for (const auto& row : rows) EXPECT_NEAR(row.computed, row.published, row.halfDigit) << row.what;
}

TEST_F(CheckValues, EachOptionHasItsPairOfCarbonicAcidConstants) {
  const struct {
    double publishedPK1, publishedPK2, k1, k2;
  } rows[] = {
      {5.856327, 8.924918, 1.39210753962e-06, 1.1887254858e-09},
      {5.850841, 8.925441, 1.37872989546e-06, 1.1611258437e-09},
      {5.850235, 8.941903, 1.38065562343e-06, 1.11793725991e-09},
      {5.837229, 8.955397, 1.42262540787e-06, 1.08373534367e-09},
      {5.845719, 8.945437, 1.39508629173e-06, 1.10887635548e-09},
      {6.000043, 9.114133, 1.37069582336e-06, 1.05402665761e-09},
      {6.000043, 9.114133, 1.37069582336e-06, 1.05402665761e-09},
      {6.351480, 10.329716, 4.45163794246e-07, 4.68041429321e-11},
      {6.005078, 9.126096, 1.35489610604e-06, 1.02538701364e-09},
      {5.847153, 8.965951, 1.42182813714e-06, 1.08155474722e-09},
      {5.835841, 8.949810, 1.42718228806e-06, 1.0977659086e-09},
      {5.827281, 8.946400, 1.45558881126e-06, 1.10641984968e-09},
      {5.840144, 8.963631, 1.41310912873e-06, 1.0633822769e-09},
      {5.841268, 8.960903, 1.40945811873e-06, 1.07008251278e-09},
  };
  int option = 0;
  for (const auto& row : rows) {
    const CarbonicAcidOption& formulae = kCarbonicAcidOptions.at(static_cast<std::size_t>(option));
    ++option;
    EXPECT_NEAR(-LogPublished(formulae.k1) / std::numbers::ln10, row.publishedPK1, 5e-7) << option;
    EXPECT_NEAR(-LogPublished(formulae.k2) / std::numbers::ln10, row.publishedPK2, 5e-7) << option;
    SetK1K2Option(option);
    EXPECT_NEAR(GetK1(35, 25), row.k1, kRelative * row.k1) << option;
    EXPECT_NEAR(GetK2(35, 25), row.k2, kRelative * row.k2) << option;
  }
}

TEST_F(CheckValues, PressureRaisesEachConstantByItsFactor) {
  namespace sea = sea_water_pressure;
  namespace geosecs = geosecs_pressure;
  namespace fresh = fresh_water_pressure;
  const struct {
    std::string_view what;
    const PressureCoefficients& coefficients;
    double factor;
  } rows[] = {
      {"K1", sea::kK1, 1.107879661},
      {"K2", sea::kK2, 1.070423624},
      {"KB", sea::kKB, 1.126184219},
      {"KW", sea::kKW, 1.083245987},
      {"KS", sea::kKS, 1.076484048},
      {"KF", sea::kKF, 1.042486285},
      {"KP1", sea::kKP1, 1.057755511},
      {"KP2", sea::kKP2, 1.095224777},
      {"KP3", sea::kKP3, 1.110551337},
      {"KSi", sea::kKSi, 1.126184219},
      {"GEOSECS K1", geosecs::kK1, 1.104267459},
      {"GEOSECS K2", geosecs::kK2, 1.070324737},
      {"GEOSECS KB", geosecs::kKB, 1.119379598},
      {"fresh K1", fresh::kK1, 1.129533390},
      {"fresh K2", fresh::kK2, 1.129129125},
      {"fresh KW", fresh::kKW, 1.104193328},
  };
  for (const auto& row : rows) {
    EXPECT_NEAR(PressureFactor(row.coefficients, 10, 100), row.factor, 5e-10) << row.what;
  }
}

}  // namespace
}  // namespace tessal
