#include "expr/numeric/arithmetic.h"

#include <cmath>

namespace tessal {

namespace {

constexpr double kSecondsPerDay = 86400.0;

constexpr double kLanczosCoefficients[] = {76.18009172947146,  -86.50532032941678,   24.01409824083091,
                                           -1.231739572450155, 0.001208650973866179, -5.395239384953e-6};
constexpr double kLanczosConstant = 1.000000000190015;
constexpr double kLanczosShift = 5.5;
constexpr double kLanczosFactor = 2.5066282746310007;

}  // namespace

double CatalogueMax(double x, double y) {
  return x > y ? y : x;
}

double CatalogueMin(double x, double y) {
  return y > x ? y : x;
}

double Square(double x) {
  return x * x;
}

double Sign(double x) {
  if (!(x >= 0)) return -1;
  if (!(x > 0)) return 0;
  return 1;
}

double Remainder(double value, double divisor) {
  return divisor == 0 ? 0 : std::fmod(value, divisor);
}

double StepsPerDay(double timestep) {
  return kSecondsPerDay / timestep;
}

double ExceedanceFrequency(double trueCases, double allCases) {
  return trueCases / allCases * 100;
}

double LogGamma(double x) {
  const double shifted = x + kLanczosShift;
  double series = kLanczosConstant;
  double divisor = x;
  for (const double coefficient : kLanczosCoefficients) {
    divisor += 1;
    series += coefficient / divisor;
  }
  return (x + 0.5) * std::log(shifted) - shifted + std::log(kLanczosFactor * series / x);
}

}  // namespace tessal
