// The setters of the carbonate system.

#include <cmath>
#include <limits>
#include <string_view>

#include <gtest/gtest.h>

#include "carbonate/catalogue_call.h"
#include "expr/carbonate/options.h"
#include "expr/carbonate/ph_solvers.h"
#include "expr/carbonate/speciation.h"
#include "expr/carbonate/totals.h"

namespace tessal {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

class CarbonateOptions : public testing::Test {
 protected:
  CarbonateOptions() { ResetCarbonateForTest(); }
};

TEST_F(CarbonateOptions, NumbersOutsideTheRangeCountAsOne) {
  const struct {
    std::string_view name;
    double (*set)(double);
    double largest;
  } rows[] = {
      {"K1K2", SetK1K2Option, 14}, {"KW", SetKWOption, 14}, {"KB", SetKBOption, 14}, {"KS", SetKSOption, 2},
      {"fH", SetFHOption, 14},     {"TB", SetTBOption, 4},  {"K", SetKOption, 14},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(row.set(row.largest), row.largest) << row.name;
    EXPECT_EQ(row.set(row.largest + 0.99), row.largest) << row.name;
    for (const double outside : {0.99, 0.0, -3.0, row.largest + 1, 1e300, -1e300, HUGE_VAL, kNaN}) {
      EXPECT_EQ(row.set(outside), 1) << row.name << " " << outside;
    }
  }
  SetK1K2Option(15);
  const double asFifteen = CalculatePh(2100, 2300, 35, 25, 0);
  SetK1K2Option(1);
  EXPECT_EQ(asFifteen, CalculatePh(2100, 2300, 35, 25, 0));
}

TEST_F(CarbonateOptions, SetGetSpecieReadsStoresAndReturnsToSalinity) {
  SetSpeciesFactors(2, 1, 1, 4, 1);
  const struct {
    double id;
    double value;
    double result;
  } steps[] = {
      {6, 1, -1},
      {0, 1, -1},
      {kNaN, 1, -1},
      {1e300, 1, -1},
      {1, 100, 100},
      {1.9, -5, 100},
      {1, -1, -1},
      // The mark of a computed total, over the factor.
      {1, -5, -0.5},
      {4, 3, 3},
      {4, -1, 3},
      {5, -1, 0},
      {2, 0, 0},
      {3, 28000, 28000},
  };
  for (const auto& step : steps) {
    EXPECT_EQ(SetGetSpecie(step.id, step.value), step.result) << step.id << " " << step.value;
  }
  EXPECT_DOUBLE_EQ(TotalsInEffect(35).boron, 415.7e-6);
  // A total that is no number shows in every result, until another one is set.
  EXPECT_TRUE(std::isnan(SetGetSpecie(1, kNaN)));
  EXPECT_TRUE(std::isnan(TotalsInEffect(35).boron));
  EXPECT_DOUBLE_EQ(TotalsInEffect(35).phosphate, 12e-6);
  EXPECT_EQ(TotalsInEffect(35).fluoride, 0);
  EXPECT_DOUBLE_EQ(TotalsInEffect(0).sulphate, 28000e-6);
}

TEST_F(CarbonateOptions, FactorsApplyOnTheWayInAndComeOffOnTheWayOut) {
  SetSpeciesFactors(10, 20, 40, 5, 8);
  EXPECT_DOUBLE_EQ(GetTotalBoron(35), 41.57);
  EXPECT_NEAR(GetTotalFluoride(35), 68.3258396884 / 20, 1e-9);
  EXPECT_NEAR(GetTotalSulphate(35), 28235.4341329 / 40, 1e-6);
  SetSpecies(41.57, -1, -1, 0.4, 6.25);
  EXPECT_DOUBLE_EQ(TotalsInEffect(1).boron, 415.7e-6);
  EXPECT_DOUBLE_EQ(TotalsInEffect(1).phosphate, 2e-6);
  EXPECT_DOUBLE_EQ(TotalsInEffect(1).silicate, 50e-6);
  // Totals that stand keep their amount when a factor changes.
  SetSpeciesFactors(1, 1, 1, 1, 1);
  EXPECT_DOUBLE_EQ(SetGetSpecie(1, -5), 415.7);

  SetDicAlkFactors(1000, 2000);
  const Speciation& species = SpeciationOf({8, 2, 0, 35, 20, 0});
  EXPECT_DOUBLE_EQ(species.dicEstimate, 2);
  EXPECT_NEAR(species.alkalinityEstimate, 1.1, 0.1);
  EXPECT_NEAR(species.bicarbonate, 1810, 20);
}

TEST_F(CarbonateOptions, OneComputationServesAllSpeciesOfAWater) {
  SetCarbonateDefaults();
  const std::uint64_t before = ComputedSpeciations();
  for (const char* name :
       {"GET_OH", "GET_HCO3", "GET_CO3", "GET_CO2", "GET_FCO2", "GET_DIC_EST", "GET_ALK_EST"}) {
    Call(std::string(name) + "(8.1, 2050, 2300, 35, 20, 0)");
  }
  EXPECT_EQ(ComputedSpeciations(), before + 1);
  Call("GET_OH(8.1, 2050, 2300, 35, 20, 1)");
  EXPECT_EQ(ComputedSpeciations(), before + 2);
}

TEST_F(CarbonateOptions, NoSetterLeavesAStaleSpecies) {
  const struct {
    std::string_view setter;
    std::string_view specie;
  } rows[] = {
      {"SET_K1K2_OPTION(4)", "GET_HCO3"},
      {"SET_KW_OPTION(7)", "GET_OH"},
      {"SET_KB_OPTION(6)", "GET_BALK"},
      {"SET_KS_OPTION(2)", "GET_HSO4"},
      {"SET_K1K2_OPTION(6); SET_FH_OPTION(7)", "GET_CO2"},
      {"SET_B_OPTION(2)", "GET_BALK"},
      {"SET_K_OPTION(10)", "GET_FCO2"},
      {"SET_SPECIES(100, 1, 1, 1, 1)", "GET_HF"},
      {"SET_DICALK_FACTORS(2, 1)", "GET_CO3"},
      {"SET_DICALK_FACTORS(1, 2)", "GET_CALK"},
      {"SETGET_SPECIE(4, 3)", "GET_PALK"},
      {"SETGET_SPECIE(5, 3)", "GET_SIALK"},
  };
  for (const auto& row : rows) {
    SetCarbonateDefaults();
    const std::string call = std::string(row.specie) + "(8.1, 2050, 2300, 35, 20, 0)";
    const double before = Call(call);
    CallEach(row.setter);
    EXPECT_NE(Call(call), before) << row.setter;
    SetCarbonateDefaults();
    EXPECT_EQ(Call(call), before) << row.setter;
  }
}

}  // namespace
}  // namespace tessal
