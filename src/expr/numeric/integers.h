// Whole numbers out of floating-point arguments, defined for every argument.
#pragma once

#include <cmath>
#include <cstdint>
#include <optional>

namespace tessal {

/// The magnitude up to which calendar arithmetic and slot numbers are carried out: sums and products with the
/// constants of the calendar still fit 64 bits.
inline constexpr double kLargestWholeNumber = 1e15;

/// The value rounded toward minus infinity; nothing for NaN and beyond `kLargestWholeNumber`.
inline std::optional<std::int64_t> FloorToInteger(double value) {
  if (!(std::fabs(value) <= kLargestWholeNumber)) return std::nullopt;
  return static_cast<std::int64_t>(std::floor(value));
}

/// The value rounded toward 0; nothing for NaN and beyond `kLargestWholeNumber`.
inline std::optional<std::int64_t> TruncateToInteger(double value) {
  if (!(std::fabs(value) <= kLargestWholeNumber)) return std::nullopt;
  return static_cast<std::int64_t>(value);
}

/// Division rounded toward minus infinity, for a positive divisor.
constexpr std::int64_t FloorDivide(std::int64_t value, std::int64_t divisor) {
  return value / divisor - (value % divisor < 0 ? 1 : 0);
}

}  // namespace tessal
