#include "expr/carbonate/carbonate_water.h"

#include "expr/carbonate/totals.h"
#include "expr/carbonate/units.h"

namespace tessal {

namespace {

double PhosphateAlkalinity(double hydrogen, double total, const EquilibriumConstants& k) {
  const double cubed = hydrogen * hydrogen * hydrogen;
  const double secondStep = k.kp1 * k.kp2 * hydrogen;
  const double thirdStep = k.kp1 * k.kp2 * k.kp3;
  return total * (secondStep + 2 * thirdStep - cubed) /
         (hydrogen * hydrogen * k.kp1 + cubed + secondStep + thirdStep);
}

}  // namespace

CarbonateWater CarbonateWaterAt(double dic, double alkalinity, double salinity, double temperature,
                                double depth) {
  CarbonateWater water{.constants = ConstantsAt(salinity, temperature, depth),
                       .totals = TotalsInEffect(salinity),
                       .carbon = MolesFromMicromoles(dic) * Carbonate().dicFactor,
                       .alkalinity = MolesFromMicromoles(alkalinity) * Carbonate().alkalinityFactor,
                       .freeFraction = 1};
  water.freeFraction = 1 / (1 + water.totals.sulphate / water.constants.ks);
  return water;
}

double CarbonateDenominator(double hydrogen, const EquilibriumConstants& constants) {
  return hydrogen * constants.k1 + hydrogen * hydrogen + constants.k1 * constants.k2;
}

AlkalinityTerms AlkalinityAt(double hydrogen, const CarbonateWater& water) {
  const EquilibriumConstants& k = water.constants;
  const PerSpecie& totals = water.totals;
  const double freeHydrogen = hydrogen * water.freeFraction;
  return {
      .carbonate = (2 * k.k2 + hydrogen) * k.k1 * water.carbon / CarbonateDenominator(hydrogen, k),
      .borate = totals.boron * k.kb / (hydrogen + k.kb),
      .hydroxide = k.kw / hydrogen,
      .phosphate = PhosphateAlkalinity(hydrogen, totals.phosphate, k),
      .silicate = totals.silicate * k.ksi / (hydrogen + k.ksi),
      .freeHydrogen = freeHydrogen,
      .bisulphate = totals.sulphate / (1 + k.ks / freeHydrogen),
      .hydrogenFluoride = totals.fluoride / (1 + k.kf / freeHydrogen),
  };
}

}  // namespace tessal
