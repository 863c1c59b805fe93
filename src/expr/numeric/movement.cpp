#include "expr/numeric/movement.h"

#include <cmath>
#include <cstdint>
#include <utility>

#include "expr/numeric/angles.h"

namespace tessal {

namespace {

struct Vector {
  double x;
  double y;
};

/// Between a compass angle (clockwise from north) and a mathematical one (counter-clockwise from east),
/// either way: the rule is its own inverse but for whole turns.
double TurnedCompass(double angle) {
  constexpr double kQuarterTurn = kPi / 2;
  return angle < kQuarterTurn ? kQuarterTurn - angle : 5 * kQuarterTurn - angle;
}

Vector Movement(double speed, double direction) {
  const double angle = TurnedCompass(Radians(direction));
  return {.x = speed * std::cos(angle), .y = speed * std::sin(angle)};
}

Vector Sum(const Vector& first, const Vector& second) {
  return {.x = first.x + second.x, .y = first.y + second.y};
}

/// The lowest 8 bits of the whole part in two's complement. Every number of 2^61 or more has zeros there.
std::uint8_t LowestBits(double value) {
  if (!std::isfinite(value)) return 0;
  const double low = std::fmod(std::trunc(value), 256);
  return static_cast<std::uint8_t>(static_cast<std::int32_t>(low));
}

}  // namespace

double CosineComponent(double speed, double direction) {
  return std::cos(Radians(direction)) * speed;
}

double SineComponent(double speed, double direction) {
  return std::sin(Radians(direction)) * speed;
}

double Distance(double x1, double y1, double z1, double x2, double y2, double z2) {
  return std::hypot(x2 - x1, y2 - y1, z2 - z1);
}

double Bearing(double x1, double y1, double x2, double y2) {
  return TurnedCompass(std::atan2(y2 - y1, x2 - x1));
}

double ResultingSpeed(double speed1, double direction1, double speed2, double direction2) {
  const Vector sum = Sum(Movement(speed1, direction1), Movement(speed2, direction2));
  return std::hypot(sum.x, sum.y);
}

double ResultingDirection(double speed1, double direction1, double speed2, double direction2) {
  const Vector sum = Sum(Movement(speed1, direction1), Movement(speed2, direction2));
  return TurnedCompass(std::atan2(sum.y, sum.x));
}

double AngleBetween(double speed1, double direction1, double speed2, double direction2) {
  const double cosine = std::cos(Radians(direction1 - direction2));
  if (cosine == 1) return 0;
  if (std::fabs(speed1) > std::fabs(speed2)) std::swap(speed1, speed2);
  return std::acos(speed1 / speed2 * cosine);
}

double TestHitState(double value, double conditions) {
  return (LowestBits(value) & LowestBits(conditions)) > 0 ? 1 : 0;
}

}  // namespace tessal
