// The formulae of the carbonate system by option number, with their sources. Entry 0 of a table is option 1.
#pragma once

#include <array>
#include <string_view>

#include "expr/carbonate/formula.h"
#include "expr/carbonate/pressure_correction.h"

namespace tessal {

/// The first and second dissociation of carbonic acid come as a pair.
struct CarbonicAcidOption {
  const Formula& k1;
  const Formula& k2;
  const PressureCoefficients& k1Pressure;
  const PressureCoefficients& k2Pressure;
  std::string_view source;
};

/// One constant, or the activity coefficient of hydrogen.
struct ConstantOption {
  const Formula& formula;
  const PressureCoefficients& pressure;
  std::string_view source;
};

struct ActivityOption {
  const Formula& formula;
  std::string_view source;
};

/// Total boron in mol/kg of sea water for each unit of salinity.
struct BoronOption {
  double perSalinity;
  std::string_view source;
};

extern const std::array<CarbonicAcidOption, 14> kCarbonicAcidOptions;
extern const std::array<ConstantOption, 14> kWaterOptions;
extern const std::array<ConstantOption, 14> kBoricAcidOptions;
extern const std::array<ConstantOption, 2> kBisulphateOptions;
extern const std::array<ActivityOption, 14> kActivityOptions;
extern const std::array<BoronOption, 4> kBoronOptions;

/// Constants without a choice. Hydrogen fluoride: Dickson and Riley 1979, Mar. Chem. 7:89-99. Phosphoric and
/// silicic acid: Yao and Millero 1995, Aquat. Geochem. 1:53-88. Solubility of CO2, in mol/(kg atm): Weiss
/// 1974, Mar. Chem. 2:203-215.
extern const Formula kHydrogenFluoride;
extern const Formula kPhosphoricAcid1;
extern const Formula kPhosphoricAcid2;
extern const Formula kPhosphoricAcid3;
extern const Formula kSilicicAcid;
extern const Formula kCarbonDioxideSolubility;

}  // namespace tessal
