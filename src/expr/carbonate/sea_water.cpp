#include "expr/carbonate/sea_water.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <limits>
#include <span>

namespace tessal {

namespace {

// Polynomials in temperature, lowest power first.
constexpr double kFreshWaterDensity[] = {999.842594,  6.793952e-2,  -9.095290e-3,
                                         1.001685e-4, -1.120083e-6, 6.536332e-9};
constexpr double kBySalinity[] = {8.24493e-1, -4.0899e-3, 7.6438e-5, -8.2467e-7, 5.3875e-9};
constexpr double kBySalinityAndRoot[] = {-5.72466e-3, 1.0227e-4, -1.6546e-6};
constexpr double kBySalinitySquared = 4.8314e-4;

constexpr double kBarPerPascal = 1e-5;

double Polynomial(std::span<const double> coefficients, double x) {
  double value = 0;
  for (std::size_t power = coefficients.size(); power-- > 0;) value = value * x + coefficients[power];
  return value;
}

/// In m/s2, near that of the middle latitudes; 1.5958 is twice the latitude in radians, about 45.7 degrees.
double Gravity() {
  static const double gravity = 9.806 - std::cos(1.5957989317367303) * (-0.01899999999999924);
  return gravity;
}

/// The last pressure that was computed; no arguments equal those of a fresh cache.
struct PressureCache {
  std::array<double, 3> arguments{std::numeric_limits<double>::quiet_NaN()};
  double pressure = 0;
};

PressureCache& LastPressure() {
  static PressureCache cache;
  return cache;
}

}  // namespace

double WaterDensity(double salinity, double temperature) {
  return Polynomial(kFreshWaterDensity, temperature) + Polynomial(kBySalinity, temperature) * salinity +
         Polynomial(kBySalinityAndRoot, temperature) * salinity * std::sqrt(salinity) +
         kBySalinitySquared * salinity * salinity;
}

double DepthToPressure(double depth, double salinity, double temperature) {
  PressureCache& last = LastPressure();
  const std::array arguments{depth, salinity, temperature};
  if (last.arguments != arguments) {
    last.arguments = arguments;
    last.pressure = 1 + WaterDensity(salinity, temperature) * depth * Gravity() * kBarPerPascal;
  }
  return last.pressure;
}

}  // namespace tessal
