// Angles: pi, and the change between degrees and radians.
#pragma once

#include <numbers>

namespace tessal {

inline constexpr double kPi = std::numbers::pi;
inline constexpr double kRadiansPerDegree = 0.017453292519943295;
inline constexpr double kDegreesPerRadian = 57.29577951308232;

/// Degrees to radians as they are, without reduction to one turn.
constexpr double Radians(double degrees) {
  return degrees * kRadiansPerDegree;
}

/// `PI`.
double Pi();

/// `RAD2DEG`: radians to degrees within 0 to 360 (both included); NaN for an argument that isn't finite.
double RadiansToDegrees(double radians);

/// `DEG2RAD`: degrees to radians within 0 to 2 pi (both included); NaN for an argument that isn't finite.
double DegreesToRadians(double degrees);

}  // namespace tessal
