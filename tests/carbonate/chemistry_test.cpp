// What holds of the carbonate system for all waters and options, and what its setters leave in effect.

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
  double dic, alkalinity, salinity, temperature, depth;
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
  namespace sea = sea_water_pressure;
  namespace geosecs = geosecs_pressure;
  namespace fresh = fresh_water_pressure;
  using Constants = EquilibriumConstants;
  const struct {
    const char* what;
    double Constants::*constant;
    const PressureCoefficients *seaWater, *ofGeosecs, *freshWater;  // none where the option has no such term
  } rows[] = {{"K1", &Constants::k1, &sea::kK1, &geosecs::kK1, &fresh::kK1},
              {"K2", &Constants::k2, &sea::kK2, &geosecs::kK2, &fresh::kK2},
              {"KB", &Constants::kb, &sea::kKB, &geosecs::kKB, nullptr},
              {"KW", &Constants::kw, &sea::kKW, &sea::kKW, &fresh::kKW},
              {"KS", &Constants::ks, &sea::kKS, &sea::kKS, &sea::kKS},
              {"KF", &Constants::kf, &sea::kKF, &sea::kKF, &sea::kKF},
              {"KP1", &Constants::kp1, &sea::kKP1, &sea::kKP1, &sea::kKP1},
              {"KP2", &Constants::kp2, &sea::kKP2, &sea::kKP2, &sea::kKP2},
              {"KP3", &Constants::kp3, &sea::kKP3, &sea::kKP3, &sea::kKP3},
              {"KSi", &Constants::ksi, &sea::kKSi, &sea::kKSi, &sea::kKSi}};
  const double depth = 10 * (101.698075458 - 1) / 100.698075458 * 100;
  const double pressure = DepthToPressure(depth, 35, 10) - 1;
  for (int option = 1; option <= 14; ++option) {
    SetCarbonateDefaults();
    SetKOption(option);
    const Constants deep = ConstantsAt(35, 10, depth);
    const Constants surface = ConstantsAt(35, 10, 0);
    for (const auto& row : rows) {
      const PressureCoefficients* term = option == 8                  ? row.freshWater
                                         : option == 6 || option == 7 ? row.ofGeosecs
                                                                      : row.seaWater;
      if (term == nullptr || (option == 6 && row.constant == &Constants::kw)) continue;
      EXPECT_NEAR(deep.*row.constant / (surface.*row.constant), PressureFactor(*term, 10, pressure), 1e-12)
          << row.what << " of option " << option;
    }
  }
}

TEST_F(CarbonateChemistry, FactorsApplyOnTheWayInAndComeOffOnTheWayOut) {
  SetSpeciesFactors(10, 20, 40, 5, 8);
  SetSpecies(41.57, 3, 4, 0.4, 6.25);
  for (const double salinity : {0.0, 35.0}) {
    EXPECT_DOUBLE_EQ(TotalsInEffect(salinity).boron, 415.7e-6);
    EXPECT_DOUBLE_EQ(TotalsInEffect(salinity).fluoride, 60e-6);
    EXPECT_DOUBLE_EQ(TotalsInEffect(salinity).sulphate, 160e-6);
    EXPECT_DOUBLE_EQ(TotalsInEffect(salinity).phosphate, 2e-6);
    EXPECT_DOUBLE_EQ(TotalsInEffect(salinity).silicate, 50e-6);
  }
  // Totals that are set keep their amount when a factor changes.
  SetSpeciesFactors(1, 1, 1, 1, 1);
  EXPECT_DOUBLE_EQ(SetGetSpecie(1, -5), 415.7);
  // A total that is no number shows in every result, until another one is set.
  EXPECT_TRUE(std::isnan(SetGetSpecie(1, std::nan(""))));
  EXPECT_TRUE(std::isnan(TotalsInEffect(35).boron));

  SetDicAlkFactors(1000, 2000);
  const Speciation& species = SpeciationOf({8, 2, 0, 35, 20, 0});
  EXPECT_DOUBLE_EQ(species.dicEstimate, 2);
  EXPECT_NEAR(species.bicarbonate, 1810, 20);
}

TEST_F(CarbonateChemistry, OneComputationServesAllSpeciesOfAWater) {
  const std::uint64_t before = ComputedSpeciations();
  for (const char* name :
       {"GET_OH", "GET_HCO3", "GET_CO3", "GET_CO2", "GET_FCO2", "GET_DIC_EST", "GET_ALK_EST"}) {
    test::Call(std::string(name) + "(8.1, 2050, 2300, 35, 20, 0)");
  }
  EXPECT_EQ(ComputedSpeciations(), before + 1);
  test::Call("GET_OH(8.1, 2050, 2300, 35, 20, 1)");
  EXPECT_EQ(ComputedSpeciations(), before + 2);
}

}  // namespace
}  // namespace tessal
