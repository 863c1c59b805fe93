// The species of the carbonate system at a given pH, on the total scale. Concentrations and contributions to
// alkalinity are in micromol/kg. The arguments are those of the pH solvers and the pH.
//
// An expression usually asks for several species of the same water: the last water is kept, and as long as
// all six arguments are equal and no setting has changed, its results are used again.
#pragma once

#include <cstdint>

namespace tessal {

/// A water sample as the catalogue's functions take it. DIC and alkalinity in micromol/kg before their
/// factors; where one of the two isn't above 0 the other and the pH give an estimate of it.
struct WaterSample {
  double ph;
  double dic;
  double alkalinity;
  double salinity;
  double temperature;
  double depth;

  bool operator==(const WaterSample&) const = default;
};

struct Speciation {
  double hydroxide;
  double bicarbonate;
  double carbonate;
  double carbonDioxide;
  /// In microatmospheres.
  double fugacity;
  /// Before their factors, like the arguments.
  double dicEstimate;
  double alkalinityEstimate;
  double carbonateAlkalinity;
  double borateAlkalinity;
  double silicateAlkalinity;
  double phosphateAlkalinity;
  double hydrogenFluoride;
  double freeHydrogen;
  double bisulphate;
};

/// Computes all species. Returns the squared distance of the estimated alkalinity and DIC from the given
/// ones.
double ComputeSpeciation(const WaterSample& sample, Speciation& result);

/// The species of a sample, from the last computation if it was the same sample under the same settings.
const Speciation& SpeciationOf(const WaterSample& sample);

/// How many samples `SpeciationOf` has had to compute since the process began.
std::uint64_t ComputedSpeciations();

}  // namespace tessal
