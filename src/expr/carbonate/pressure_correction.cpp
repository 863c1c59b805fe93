#include "expr/carbonate/pressure_correction.h"

#include <cmath>

namespace tessal {

double PressureFactor(const PressureCoefficients& coefficients, double temperature, double pressure) {
  constexpr double kGasConstant = 83.1451;
  const PressureCoefficients& c = coefficients;
  const double volume = c.v0 + (c.v1 + c.v2 * temperature) * temperature;
  const double compressibility = (c.k0 + (c.k1 + c.k2 * temperature) * temperature) / 1000;
  return std::exp((-volume + compressibility * pressure / 2) * pressure /
                  (kGasConstant * (temperature + 273.15)));
}

}  // namespace tessal
