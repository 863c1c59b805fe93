// What holds of the carbonate system for all waters and options.

#include <cmath>
#include <string>

#include <gtest/gtest.h>

#include "expr/carbonate/constants.h"
#include "expr/carbonate/option_tables.h"
#include "expr/carbonate/options.h"
#include "expr/carbonate/ph_scales.h"
#include "expr/carbonate/ph_solvers.h"
#include "expr/carbonate/sea_water.h"
#include "expr/carbonate/settings.h"
#include "expr/carbonate/speciation.h"
#include "expr/carbonate/totals.h"
#include "support/catalogue_call.h"

namespace tessal {
namespace {

class CarbonateChemistry : public testing::Test {
 protected:
  CarbonateChemistry() { test::ResetNumbers(); }
};

struct Water {
  double dic;
  double alkalinity;
  double salinity;
  double temperature;
  double depth;
};

std::string Text(const Water& water) {
  return "DIC " + std::to_string(water.dic) + " TA " + std::to_string(water.alkalinity) + " S " +
         std::to_string(water.salinity) + " T " + std::to_string(water.temperature) + " depth " +
         std::to_string(water.depth);
}

template <typename Check>
void ForEachWater(const Check& check) {
  for (const double salinity : {0.0, 0.5, 5.0, 20.0, 35.0, 45.0}) {
    for (const double temperature : {0.0, 10.0, 25.0, 40.0}) {
      for (const double depth : {0.0, 10.0, 1000.0, 6000.0}) {
        for (const double ratio : {0.5, 0.95, 1.05, 1.2})
          check(Water{2000, 2000 * ratio, salinity, temperature, depth});
      }
    }
  }
}

/// The pH by halving of the interval on the alkalinity that the speciation sums: no slope, no starting point.
double BisectedPh(const Water& water) {
  double low = 2;
  double high = 13;
  for (int round = 0; round < 60; ++round) {
    const double ph = (low + high) / 2;
    Speciation species{};
    ComputeSpeciation({ph, water.dic, 0, water.salinity, water.temperature, water.depth}, species);
    (species.alkalinityEstimate < water.alkalinity ? low : high) = ph;
  }
  return low;
}

TEST_F(CarbonateChemistry, AlkalinityOfTheSpeciesAtTheSolvedPhIsTheGivenOne) {
  for (int option = 1; option <= 14; ++option) {
    SetKOption(option);
    SetKSOption(option % 2 + 1);
    SetTBOption(option % 4 + 1);
    SetSpecies(-1, -1, -1, option % 3, option % 5 * 10);
    const bool needsSalt = option == 6 || option == 7;
    ForEachWater([&](const Water& water) {
      const double ph =
          CalculatePh(water.dic, water.alkalinity, water.salinity, water.temperature, water.depth);
      if (needsSalt && water.salinity == 0) {
        EXPECT_EQ(ph, -1) << Text(water);
        return;
      }
      const Speciation& species =
          SpeciationOf({ph, water.dic, 0, water.salinity, water.temperature, water.depth});
      EXPECT_NEAR(species.alkalinityEstimate, water.alkalinity, 1e-6 * water.alkalinity)
          << "option " << option << " " << Text(water);
      EXPECT_NEAR(ph, BisectedPh(water), 1e-6 * ph) << "option " << option << " " << Text(water);
      EXPECT_NEAR(species.bicarbonate + species.carbonate + species.carbonDioxide, water.dic, 1e-8)
          << Text(water);
    });
  }
}

TEST_F(CarbonateChemistry, SimpleSolverBalancesCarbonateBorateAndWater) {
  ForEachWater([](const Water& water) {
    const double ph =
        CalculatePhSimply(water.dic, water.alkalinity, water.salinity, water.temperature, water.depth);
    const double full =
        CalculatePh(water.dic, water.alkalinity, water.salinity, water.temperature, water.depth);
    // What the simple solver leaves out matters little near pH 8, more in acid water.
    const double tolerance = water.alkalinity > water.dic ? 0.01 : 0.02;
    EXPECT_NEAR(ph, full, tolerance) << Text(water);
  });
}

TEST_F(CarbonateChemistry, SpeciesOfTheBalanceAddUp) {
  SetSpecies(-1, -1, -1, 2, 50);
  const Speciation s = SpeciationOf({8.05, 2050, 2300, 35, 20, 500});
  EXPECT_NEAR(s.carbonateAlkalinity + s.borateAlkalinity + s.hydroxide + s.phosphateAlkalinity +
                  s.silicateAlkalinity - s.freeHydrogen - s.bisulphate - s.hydrogenFluoride,
              2300, 1e-9);
  EXPECT_NEAR(s.freeHydrogen * (1 + TotalsInEffect(35).sulphate / ConstantsAt(35, 20, 500).ks),
              1e6 * std::pow(10, -8.05), 1e-12);
}

TEST_F(CarbonateChemistry, EstimateFromPhAndOneQuantityReturnsTheOther) {
  const double ph = CalculatePh(2050, 2300, 30, 15, 200);
  EXPECT_NEAR(SpeciationOf({ph, 2050, 0, 30, 15, 200}).alkalinityEstimate, 2300, 1e-3);
  EXPECT_NEAR(SpeciationOf({ph, 0, 2300, 30, 15, 200}).dicEstimate, 2050, 1e-3);

  Speciation species{};
  EXPECT_NEAR(ComputeSpeciation({ph, 2050, 2300, 30, 15, 200}, species), 0, 1e-20);
  const double distance = ComputeSpeciation({ph, 2050, 0, 30, 15, 200}, species);
  EXPECT_NEAR(distance, 2300.0 * 2300.0, 5);
}

TEST_F(CarbonateChemistry, ScalesConvertThereAndBack) {
  SetSpecies(-1, 80, 30000, 0, 0);
  for (const double in : {1, 2, 3, 4, 7}) {
    for (const double out : {1, 2, 3, 4, 7}) {
      const double converted = ConvertPh(8.1, 33, 12, in, out);
      EXPECT_NEAR(ConvertPh(converted, 33, 12, out, in), 8.1, 1e-12) << in << " " << out;
    }
  }
  // Fixed totals act on scales: more sulphate, more distance to the free scale.
  const double withFixed = ConvertPh(8.1, 33, 12, 1, 3);
  SetCarbonateDefaults();
  EXPECT_GT(withFixed, ConvertPh(8.1, 33, 12, 1, 3));
}

TEST_F(CarbonateChemistry, FixedTotalsActInTheBalanceAndNotInTheConstants) {
  const EquilibriumConstants before = ConstantsAt(35, 20, 0);
  const double simply = CalculatePhSimply(2100, 2300, 35, 20, 0);
  const double ph = CalculatePh(2100, 2300, 35, 20, 0);
  SetSpecies(800, 200, 60000, 5, 100);
  const EquilibriumConstants after = ConstantsAt(35, 20, 0);
  EXPECT_EQ(after.k1, before.k1);
  EXPECT_EQ(after.kw, before.kw);
  EXPECT_EQ(after.kp3, before.kp3);
  EXPECT_EQ(CalculatePhSimply(2100, 2300, 35, 20, 0), simply);
  EXPECT_LT(CalculatePh(2100, 2300, 35, 20, 0), ph - 0.01);
  EXPECT_DOUBLE_EQ(GetTotalBoron(35), 415.7);
  const Speciation& species = SpeciationOf({8, 2100, 2300, 35, 20, 0});
  EXPECT_NEAR(species.borateAlkalinity, 800e-6 * after.kb / (1e-8 + after.kb) * 1e6, 1e-9);
  EXPECT_NEAR(species.freeHydrogen, 1e-2 / (1 + 60000e-6 / after.ks), 1e-12);
}

TEST_F(CarbonateChemistry, PressureActsOnlyBelowTheSurface) {
  const double surface = CalculatePh(2100, 2300, 35, 25, 0);
  EXPECT_EQ(CalculatePh(2100, 2300, 35, 25, -100), surface);
  EXPECT_LT(CalculatePh(2100, 2300, 35, 25, 1), surface);
  EXPECT_EQ(DepthToPressure(0, 35, 10), 1);
  EXPECT_NE(DepthToPressure(100, 35, 10), DepthToPressure(100, 35, 11));
}

TEST_F(CarbonateChemistry, PressureTermsFollowTheOptionOfTheirConstant) {
  const double depth = 10 * (101.698075458 - 1) / 100.698075458 * 100;
  const double pressure = DepthToPressure(depth, 35, 10) - 1;
  for (int option = 1; option <= 14; ++option) {
    SetCarbonateDefaults();
    SetKOption(option);
    const EquilibriumConstants deep = ConstantsAt(35, 10, depth);
    const EquilibriumConstants surface = ConstantsAt(35, 10, 0);
    const bool geosecs = option == 6 || option == 7;
    const bool fresh = option == 8;
    const auto expect = [&](double ratio, const PressureCoefficients& coefficients, const char* what) {
      EXPECT_NEAR(ratio, PressureFactor(coefficients, 10, pressure), 1e-12)
          << what << " of option " << option;
    };
    expect(deep.k1 / surface.k1,
           geosecs ? geosecs_pressure::kK1
           : fresh ? fresh_water_pressure::kK1
                   : sea_water_pressure::kK1,
           "K1");
    expect(deep.k2 / surface.k2,
           geosecs ? geosecs_pressure::kK2
           : fresh ? fresh_water_pressure::kK2
                   : sea_water_pressure::kK2,
           "K2");
    if (!fresh) expect(deep.kb / surface.kb, geosecs ? geosecs_pressure::kKB : sea_water_pressure::kKB, "KB");
    if (option != 6)
      expect(deep.kw / surface.kw, fresh ? fresh_water_pressure::kKW : sea_water_pressure::kKW, "KW");
    expect(deep.ks / surface.ks, sea_water_pressure::kKS, "KS");
    expect(deep.kf / surface.kf, sea_water_pressure::kKF, "KF");
    expect(deep.kp1 / surface.kp1, sea_water_pressure::kKP1, "KP1");
    expect(deep.kp2 / surface.kp2, sea_water_pressure::kKP2, "KP2");
    expect(deep.kp3 / surface.kp3, sea_water_pressure::kKP3, "KP3");
    expect(deep.ksi / surface.ksi, sea_water_pressure::kKSi, "KSi");
  }
}

}  // namespace
}  // namespace tessal
