// What the carbonate system keeps between calls: the selected formulae, fixed totals and conversion factors.
// The functions of `options.h` change it.
#pragma once

#include <cstdint>

#include "expr/carbonate/option_tables.h"

namespace tessal {

/// A number for each substance whose total can be set.
struct PerSpecie {
  double boron;
  double fluoride;
  double sulphate;
  double phosphate;
  double silicate;
};

inline constexpr double kFromSalinity = -1;

struct CarbonateSettings {
  const CarbonicAcidOption* carbonicAcid = kCarbonicAcidOptions.data();
  const ConstantOption* water = kWaterOptions.data();
  const ConstantOption* boricAcid = kBoricAcidOptions.data();
  const ConstantOption* bisulphate = kBisulphateOptions.data();
  const ActivityOption* activity = kActivityOptions.data();
  const BoronOption* boron = kBoronOptions.data();
  /// Micromoles per kilogram; a negative total of the first three is computed from salinity.
  PerSpecie totals{kFromSalinity, kFromSalinity, kFromSalinity, 0, 0};
  PerSpecie factors{1, 1, 1, 1, 1};
  double dicFactor = 1;
  double alkalinityFactor = 1;
};

/// The settings of the process.
const CarbonateSettings& Carbonate();

/// The same, to be changed. Each call begins a new revision.
CarbonateSettings& ChangeCarbonate();

/// Grows whenever settings may have changed: a result computed at an earlier revision may be out of date.
std::uint64_t CarbonateRevision();

}  // namespace tessal
