// Functions that are one formula each: values by hand or from the literature, and the edges.

#include <cmath>
#include <limits>
#include <string_view>

#include <gtest/gtest.h>

#include "expr/numeric/angles.h"
#include "expr/numeric/arithmetic.h"
#include "expr/numeric/data_slots.h"
#include "expr/numeric/light.h"
#include "expr/numeric/movement.h"
#include "expr/numeric/oxygen.h"
#include "expr/numeric/saturation_kinetics.h"
#include "expr/numeric/tables.h"
#include "expr/numeric/temperature_response.h"

namespace tessal {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

struct Value {
  std::string_view what;
  double computed;
  double expected;
};

template <std::size_t Count>
void ExpectValues(const Value (&rows)[Count]) {
  for (const Value& row : rows) {
    if (std::isnan(row.expected)) {
      EXPECT_TRUE(std::isnan(row.computed)) << row.what << " gives " << row.computed;
    } else {
      // An infinity has no neighbourhood.
      if (row.computed == row.expected) continue;
      EXPECT_NEAR(row.computed, row.expected, 1e-12 * std::fabs(row.expected)) << row.what;
    }
  }
}

TEST(Arithmetic, KeepsItsOddities) {
  ExpectValues({
      {"MAX is the smaller", CatalogueMax(1, 2), 1},
      {"MAX is the smaller", CatalogueMax(2, 1), 1},
      {"MAX of NaN first", CatalogueMax(kNaN, 1), kNaN},
      {"MAX of NaN second", CatalogueMax(1, kNaN), 1},
      {"MIN is the larger", CatalogueMin(1, 2), 2},
      {"MIN is the larger", CatalogueMin(2, 1), 2},
      {"MIN of NaN first", CatalogueMin(kNaN, 1), kNaN},
      {"sign of -0.1", Sign(-0.1), -1},
      {"sign of 0", Sign(-0.0), 0},
      {"sign of 7", Sign(7), 1},
      {"sign of NaN", Sign(kNaN), -1},
      {"MOD by 0", Remainder(5, 0), 0},
      {"MOD keeps the sign of the value", Remainder(-5, 3), -2},
      {"MOD of fractions", Remainder(5.5, 2), 1.5},
      {"exceedance", ExceedanceFrequency(3, 12), 25},
      {"exceedance of nothing", ExceedanceFrequency(0, 0), kNaN},
  });
}

TEST(Arithmetic, LogGammaAgreesWithTheLibrary) {
  for (double x = 0.05; x < 1e6; x *= 1.37) {
    EXPECT_NEAR(LogGamma(x), std::lgamma(x), 3e-10 * std::max(1.0, std::fabs(std::lgamma(x)))) << x;
  }
}

TEST(Angles, AreBroughtWithinOneTurn) {
  ExpectValues({
      {"half a turn", RadiansToDegrees(kPi), 180},
      {"a full turn stays", RadiansToDegrees(2 * kPi), 360},
      {"backwards", RadiansToDegrees(-kPi / 2), 270},
      {"one turn back", RadiansToDegrees(-2 * kPi), 0},
      {"90 degrees", DegreesToRadians(90), kPi / 2},
      {"450 degrees", DegreesToRadians(450), kPi / 2},
      {"-90 degrees", DegreesToRadians(-90), 1.5 * kPi},
      {"not finite", DegreesToRadians(HUGE_VAL), kNaN},
      {"not finite", RadiansToDegrees(-HUGE_VAL), kNaN},
      {"not a number", RadiansToDegrees(kNaN), kNaN},
  });
  for (const double huge : {1e10, -1e10, 1e300, -1e300, 1.7e308, -1.7e308}) {
    EXPECT_TRUE(RadiansToDegrees(huge) >= 0 && RadiansToDegrees(huge) <= 360) << huge;
    EXPECT_TRUE(DegreesToRadians(huge) >= 0 && DegreesToRadians(huge) <= 2 * kPi) << huge;
  }
}

TEST(Rates, FollowTheirFormulae) {
  ExpectValues({
      {"Arrhenius at its reference", Arrhenius20(1.07, 20), 1},
      {"Arrhenius ten degrees up", Arrhenius20(1.07, 30), 1.9671513572895665},
      {"Arrhenius 5 at its reference", Arrhenius5(1.07, 5), 1},
      {"Arrhenius 5 at 20", Arrhenius5(2, 8), 8},
      {"Lassiter at the optimum", Lassiter(0.1, 2.5, 20, 35, 20), 2.5},
      {"Lassiter at the inhibition", Lassiter(0.1, 2.5, 20, 35, 35), 0},
      {"Lassiter beyond the inhibition", Lassiter(0.1, 2.5, 20, 35, 36), kNaN},
      // ((35-10)/15)^1.5 * exp(-1) * 2.5
      {"Lassiter below", Lassiter(0.1, 2.5, 20, 35, 10), 1.97887631815151},
      {"half saturation", MichaelisMenten1(3, 3), 0.5},
      {"saturation to nothing", MichaelisMenten1(0, 0), kNaN},
      {"squared half saturation", MichaelisMenten2(3, 9), 0.5},
      {"inhibition", ReverseMichaelisMenten(3), 0.25},
      {"inhibition at -1", ReverseMichaelisMenten(-1), HUGE_VAL},
      {"light below 2 m", LightBelowLayer(100, 2, 0.5), 36.787944117144233},
      {"mean light", MeanLightInLayer(100, 2, 0.5), 63.212055882855767},
      {"no depth", MeanLightInLayer(1, 0, 1), 0},
      {"no extinction", MeanLightInLayer(1, 1, -1), 0},
      {"no number", MeanLightInLayer(1, kNaN, 1), 0},
  });
}

TEST(Oxygen, AgreesWithPublishedTables) {
  // Weiss 1970, in ml/l, and Standard Methods (after Benson and Krause 1984), in mg/l.
  constexpr double kMilligramsPerMillilitre = 1.4286326556852438;
  const struct {
    double salinity, temperature;
    double millilitres;
  } weiss[] = {{0, 0, 10.22}, {0, 20, 6.35}, {35, 0, 8.05}, {35, 10, 6.32}, {35, 20, 5.17}, {35, 30, 4.35}};
  for (const auto& row : weiss) {
    EXPECT_NEAR(OxygenSaturationWeiss(row.salinity, row.temperature) / kMilligramsPerMillilitre,
                row.millilitres, 0.006)
        << row.salinity << " " << row.temperature;
  }
  const struct {
    double temperature;
    double milligrams;
  } fresh[] = {{0, 14.62}, {5, 12.77}, {10, 11.29}, {15, 10.08}, {20, 9.09}, {25, 8.26}, {30, 7.56}};
  for (const auto& row : fresh) {
    EXPECT_NEAR(OxygenSaturationWeiss(0, row.temperature), row.milligrams, 0.025) << row.temperature;
    EXPECT_NEAR(OxygenSaturation(0, row.temperature), row.milligrams, 0.13) << row.temperature;
  }
  for (double salinity = 0; salinity <= 40; salinity += 5) {
    for (double temperature = 0; temperature <= 30; temperature += 5) {
      const double exact = OxygenSaturationWeiss(salinity, temperature);
      EXPECT_NEAR(OxygenSaturation(salinity, temperature), exact, (temperature > 25 ? 0.045 : 0.02) * exact)
          << salinity << " " << temperature;
    }
  }
  ExpectValues({
      {"cubic", OxygenSaturation(10, 10), 10.646726},
      {"absolute zero", OxygenSaturationWeiss(0, -273.15), kNaN},
  });
}

TEST(Movement, TurnsCompassDirections) {
  ExpectValues({
      {"x to the north", CosineComponent(2, 0), 2},
      {"y to the east", SineComponent(2, 90), 2},
      {"distance", Distance(1, 1, 1, 3, 4, 7), 7},
      {"bearing east", Bearing(0, 0, 1, 0), kPi / 2},
      {"bearing north is a full turn", Bearing(0, 0, 0, 1), 2 * kPi},
      {"bearing south", Bearing(0, 0, 0, -1), kPi},
      {"bearing west", Bearing(0, 0, -1, 0), 1.5 * kPi},
      {"bearing north-west", Bearing(0, 0, -1, 1), 1.75 * kPi},
      {"speeds at right angles", ResultingSpeed(3, 0, 4, 90), 5},
      {"speeds that cancel to a fifth", ResultingSpeed(3, 30, 2.5, 210), 0.5},
      {"direction between", ResultingDirection(1, 0, 1, 90), kPi / 4},
      {"direction of the faster", ResultingDirection(1, 300, 3, 120), 2 * kPi / 3},
      {"equal directions", AngleBetween(3, 45, 0, 45), 0},
      {"a turn apart", AngleBetween(3, 45, 5, 405), 0},
      {"right angle", AngleBetween(3, 0, 3, 90), kPi / 2},
      {"slow and fast", AngleBetween(4, 0, 2, 60), std::acos(0.25)},
      {"backwards", AngleBetween(-2, 0, 4, 60), std::acos(-0.25)},
      {"no speed", AngleBetween(0, 0, 0, 60), kNaN},
  });
}

TEST(Movement, HitStatesShareABitAmongTheLowestEight) {
  const struct {
    double value, conditions, hit;
  } rows[] = {{5, 4, 1},      {5, 2, 0},       {5.9, 1.9, 1},   {256, 256, 0},  {511, 128, 1},   {-1, 128, 1},
              {-256, 255, 0}, {1e300, 255, 0}, {-1e19, 255, 0}, {kNaN, 255, 0}, {HUGE_VAL, 1, 0}};
  for (const auto& row : rows)
    EXPECT_EQ(TestHitState(row.value, row.conditions), row.hit) << row.value << " " << row.conditions;
}

TEST(Tables, FindPlacesAndValues) {
  ExpectValues({
      {"below", TableIndex(0, 1, 2, 3, 4, 5), 1},
      {"at the first", TableIndex(1, 1, 2, 3, 4, 5), 1},
      {"at an inner breakpoint", TableIndex(2, 1, 2, 3, 4, 5), 2},
      {"between", TableIndex(2.5, 1, 2, 3, 4, 5), 2.5},
      {"at the last", TableIndex(5, 1, 2, 3, 4, 5), 5},
      {"above", TableIndex(6, 1, 2, 3, 4, 5), 5},
      {"uneven", TableIndex(30, 0, 10, 20, 60, 100), 3.25},
      {"equal breakpoints", TableIndex(2, 1, 2, 2, 2, 5), 2},
      {"behind equal breakpoints", TableIndex(3, 1, 2, 2, 2, 4), 4.5},
      {"falling breakpoints", TableIndex(3, 1, 9, 2, 4, 5), 1.25},
      {"no breakpoint", TableIndex(3, kNaN, kNaN, kNaN, kNaN, kNaN), 1},
      {"no value", TableIndex(kNaN, 1, 2, 3, 4, 5), kNaN},
      {"before the table", TableValue(0.5, 10, 20, 30, 40, 50), 0},
      {"behind the table", TableValue(5.1, 10, 20, 30, 40, 50), 0},
      {"no index", TableValue(kNaN, 10, 20, 30, 40, 50), 0},
      {"first entry", TableValue(1, 10, 20, 30, 40, 50), 10},
      {"last entry", TableValue(5, 10, 20, 30, 40, 50), 50},
      {"between entries", TableValue(3.25, 10, 20, 30, 50, 50), 35},
      {"beside an entry that isn't finite", TableValue(2, 10, 20, HUGE_VAL, 40, 50), 20},
  });
}

TEST(DataSlots, KeepTheSavedAndTheLoadedApart) {
  ClearDataSlots();
  ExpectValues({
      {"save", SaveInSlot(1.9, 42), 42},
      {"peek", PeekAtSlot(1), 42},
      {"load is another bank", LoadFromSlot(1), 0},
      {"last slot", SaveInSlot(100.9, 7), 7},
      {"peek at the last", PeekAtSlot(100), 7},
      {"save beyond", SaveInSlot(101, 1), -1},
      {"load of slot 0", LoadFromSlot(0.99), -1},
      {"peek of a negative slot", PeekAtSlot(-1), -1},
      {"no slot", SaveInSlot(kNaN, 1), -1},
      {"huge slot", LoadFromSlot(1e300), -1},
  });
  DataSlots().loaded = DataSlots().saved;
  EXPECT_EQ(LoadFromSlot(100), 7);
  ClearDataSlots();
  EXPECT_EQ(LoadFromSlot(100), 0);
  EXPECT_EQ(PeekAtSlot(1), 0);
}

}  // namespace
}  // namespace tessal
