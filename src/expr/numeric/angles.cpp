#include "expr/numeric/angles.h"

#include <cmath>
#include <limits>

namespace tessal {

namespace {

/// The angle plus or minus whole turns. Angles from 0 to one turn stay as they are; a larger one ends above
/// 0, so that two turns give one.
double WithinOneTurn(double angle, double turn) {
  if (!std::isfinite(angle)) return std::numeric_limits<double>::quiet_NaN();
  if (angle >= 0 && angle <= turn) return angle;
  const double rest = std::fmod(angle, turn);
  if (angle > turn) return rest > 0 ? rest : turn;
  return rest < 0 ? rest + turn : 0;
}

}  // namespace

double Pi() {
  return kPi;
}

double RadiansToDegrees(double radians) {
  // Beyond this the degrees would be infinite; so many turns may go first.
  constexpr double kLargestRadians = std::numeric_limits<double>::max() / kDegreesPerRadian;
  const double reduced = std::fabs(radians) > kLargestRadians ? std::fmod(radians, 2 * kPi) : radians;
  return WithinOneTurn(reduced * kDegreesPerRadian, 360);
}

double DegreesToRadians(double degrees) {
  return WithinOneTurn(degrees * kRadiansPerDegree, 2 * kPi);
}

}  // namespace tessal
