#include "expr/carbonate/ph_solvers.h"

#include <cmath>
#include <numbers>

#include "expr/carbonate/carbonate_water.h"
#include "expr/carbonate/sea_water.h"
#include "expr/carbonate/totals.h"
#include "expr/carbonate/units.h"

namespace tessal {

namespace {

constexpr double kNoSolution = -1;

constexpr double kFirstPh = 8;
constexpr int kMostSteps = 1000;
constexpr double kLongestStep = 1;
constexpr double kSmallestStep = 0.0001;

constexpr double kFirstHydrogen = 1e-7;
constexpr double kHydrogenTolerance = 1e-18;
constexpr int kMostRounds = 1000000;

/// The derivative of alkalinity with respect to pH, phosphate, silicate, bisulphate and hydrogen fluoride
/// left out: it only steers the iteration.
double AlkalinitySlope(double hydrogen, double borate, const CarbonateWater& water) {
  const EquilibriumConstants& k = water.constants;
  const double denominator = CarbonateDenominator(hydrogen, k);
  const double carbonate = hydrogen * (4 * hydrogen * k.k2 + k.k1 * k.k2 + hydrogen * hydrogen) * k.k1 *
                           water.carbon / (denominator * denominator);
  return std::numbers::ln10 *
         (carbonate + borate * hydrogen / (hydrogen + k.kb) + k.kw / hydrogen + hydrogen);
}

/// How far Newton's method moves the pH. Only steps upward are held short; ordinary waters never need the
/// other side.
double NewtonStep(double ph, const CarbonateWater& water) {
  const double hydrogen = std::pow(10, -ph);
  const AlkalinityTerms terms = AlkalinityAt(hydrogen, water);
  const double residual = water.alkalinity - terms.carbonate - terms.WithoutCarbonate();
  double step = residual / AlkalinitySlope(hydrogen, terms.borate, water);
  if (!std::isfinite(step)) return step;
  while (step > kLongestStep) step /= 2;
  return step;
}

/// What the simple solver needs of a parcel of water.
struct SimpleWater {
  double k1;
  double k2;
  double kb;
  double kw;
  double boron;
};

/// The sea water rows of the pressure tables written out, with a gas constant of 83.131; they hold whatever
/// the options are.
void CorrectForPressure(SimpleWater& water, double temperature, double pressure) {
  const double t = temperature;
  const double p = pressure;
  const double c = 1 / ((t + 273.15) * 83.131);
  water.kb *= std::exp((-0.00142 * c * p - (0.1622 * t - 29.48 - 0.002608 * t * t) * c) * p);
  water.k1 *= std::exp(((8.77e-5 * t - 0.00308) * 0.5 * c * p - (0.1271 * t - 25.5) * c) * p);
  water.k2 *= std::exp(((0.00113 - 0.0001475 * t) * 0.5 * c * p - (-15.82 - 0.0219 * t) * c) * p);
}

SimpleWater SimpleWaterAt(double salinity, double temperature, double depth) {
  SimpleWater water{.k1 = GetK1(salinity, temperature),
                    .k2 = GetK2(salinity, temperature),
                    .kb = GetKB(salinity, temperature),
                    .kw = GetKW(salinity, temperature),
                    .boron = BoronFromSalinity(salinity)};
  if (depth > 0) {
    CorrectForPressure(water, temperature, DepthToPressure(depth, salinity, temperature) - 1);
  }
  return water;
}

/// The hydrogen that balances the carbonate alkalinity left by borate and water at the hydrogen before.
double NextHydrogen(double hydrogen, double carbon, double alkalinity, const SimpleWater& water) {
  const double carbonate =
      alkalinity - water.boron * water.kb / (hydrogen + water.kb) - water.kw / hydrogen + hydrogen;
  const double linear = (carbonate - carbon) * water.k1;
  const double product = 4 * carbonate * (carbonate - 2 * carbon) * water.k1 * water.k2;
  return (std::sqrt(linear * linear - product) - linear) / (2 * carbonate);
}

}  // namespace

double CalculatePh(double dic, double alkalinity, double salinity, double temperature, double depth) {
  const CarbonateWater water = CarbonateWaterAt(dic, alkalinity, salinity, temperature, depth);
  double ph = kFirstPh;
  for (int round = 0; round < kMostSteps; ++round) {
    const double step = NewtonStep(ph, water);
    if (!std::isfinite(step)) return kNoSolution;
    ph += step;
    if (std::fabs(step) <= kSmallestStep) return ph;
  }
  return kNoSolution;
}

double CalculatePhSimply(double dic, double alkalinity, double salinity, double temperature, double depth) {
  const SimpleWater water = SimpleWaterAt(salinity, temperature, depth);
  const CarbonateSettings& settings = Carbonate();
  const double carbon = MolesFromMicromoles(dic) * settings.dicFactor;
  const double total = MolesFromMicromoles(alkalinity) * settings.alkalinityFactor;
  double hydrogen = kFirstHydrogen;
  double moved = hydrogen;
  int rounds = 0;
  // Written so that a NaN ends it.
  while (hydrogen > kHydrogenTolerance && moved > kHydrogenTolerance && rounds < kMostRounds) {
    const double next = NextHydrogen(hydrogen, carbon, total, water);
    moved = std::fabs(next - hydrogen);
    hydrogen = next;
    ++rounds;
  }
  // A guard only: the loop ends before.
  if (rounds > kMostRounds) return kNoSolution;
  return -std::log10(hydrogen);
}

}  // namespace tessal
