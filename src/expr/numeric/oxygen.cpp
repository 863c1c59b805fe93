#include "expr/numeric/oxygen.h"

#include <cmath>

namespace tessal {

double OxygenSaturation(double salinity, double temperature) {
  const double quadratic = 0.007991 - 3.74e-5 * salinity - 7.7774e-5 * temperature;
  const double linear = 0.00256 * salinity - 0.41022;
  const double constant = 14.65 - 0.0841 * salinity;
  return (quadratic * temperature + linear) * temperature + constant;
}

double OxygenSaturationWeiss(double salinity, double temperature) {
  constexpr double kMilligramsPerMillilitre = 1.4286326556852438;
  const double x = (temperature + 273.15) / 100;
  const double freshWater = 143.3483 * std::log(x) + 249.6339 / x - 173.4292 - 21.8492 * x;
  const double salinityTerm = salinity * (0.014259 * x - 0.033096 - 0.0017 * x * x);
  return kMilligramsPerMillilitre * std::exp(freshWater + salinityTerm);
}

}  // namespace tessal
