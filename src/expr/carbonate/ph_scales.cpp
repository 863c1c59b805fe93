#include "expr/carbonate/ph_scales.h"

#include <cmath>

#include "expr/carbonate/constants.h"
#include "expr/carbonate/totals.h"

namespace tessal {

namespace {

constexpr double kSeaWaterScale = 2;
constexpr double kFreeScale = 3;
constexpr double kNbsScale = 4;

/// The pH on a scale less that on the total scale.
double ShiftFromTotal(double scale, double salinity, double temperature) {
  const PerSpecie totals = TotalsInEffect(salinity);
  const double bisulphate = totals.sulphate / GetKS(salinity, temperature);
  const double hydrogenFluoride = totals.fluoride / GetKF(salinity, temperature);
  const double seaWaterToTotal = (1 + bisulphate) / (1 + bisulphate + hydrogenFluoride);
  const double number = std::floor(scale);
  if (number == kSeaWaterScale) return std::log10(seaWaterToTotal);
  if (number == kFreeScale) return std::log10(1 + bisulphate);
  if (number == kNbsScale) return std::log10(seaWaterToTotal / ActivityCoefficient(salinity, temperature));
  return 0;
}

}  // namespace

double ConvertPh(double ph, double salinity, double temperature, double scaleIn, double scaleOut) {
  return ph - ShiftFromTotal(scaleIn, salinity, temperature) +
         ShiftFromTotal(scaleOut, salinity, temperature);
}

}  // namespace tessal
