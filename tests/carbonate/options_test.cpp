// What the setters of the carbonate system leave in effect.
#include <gtest/gtest.h>

#include <cmath>

#include "expr/carbonate/options.h"
#include "expr/carbonate/speciation.h"
#include "expr/carbonate/totals.h"
#include "support/catalogue_call.h"

namespace tessal {
namespace {

class CarbonateOptions : public testing::Test {
 protected:
  CarbonateOptions() { test::ResetNumbers(); }
};

TEST_F(CarbonateOptions, FactorsApplyOnTheWayInAndComeOffOnTheWayOut) {
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

TEST_F(CarbonateOptions, OneComputationServesAllSpeciesOfAWater) {
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
