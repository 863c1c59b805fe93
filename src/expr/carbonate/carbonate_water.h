// A parcel of sea water as the solver and the speciation see it: its constants, its totals, and what each
// acid adds to its alkalinity at a given acidity. In mol/kg, on the total pH scale.
#pragma once

#include "expr/carbonate/constants.h"
#include "expr/carbonate/settings.h"

namespace tessal {

struct CarbonateWater {
  EquilibriumConstants constants;
  PerSpecie totals;
  /// Total inorganic carbon and total alkalinity.
  double carbon;
  double alkalinity;
  /// Free hydrogen over that on the total scale.
  double freeFraction;
};

/// The parcel that a catalogue function's arguments describe: DIC and alkalinity in micromol/kg before their
/// factors, depth in m.
CarbonateWater CarbonateWaterAt(double dic, double alkalinity, double salinity, double temperature,
                                double depth);

/// The contributions to total alkalinity; the last three count negative. Dickson 1981, Deep-Sea Res.
/// 28A:609-623.
struct AlkalinityTerms {
  double carbonate;
  double borate;
  double hydroxide;
  double phosphate;
  double silicate;
  double freeHydrogen;
  double bisulphate;
  double hydrogenFluoride;

  double WithoutCarbonate() const {
    return borate + hydroxide + phosphate + silicate - freeHydrogen - bisulphate - hydrogenFluoride;
  }
};

/// The terms at a concentration of hydrogen.
AlkalinityTerms AlkalinityAt(double hydrogen, const CarbonateWater& water);

/// H^2 + H K1 + K1 K2, over which the carbonate species share the total carbon.
double CarbonateDenominator(double hydrogen, const EquilibriumConstants& constants);

}  // namespace tessal
