#include "expr/numeric/tables.h"

#include <array>
#include <cmath>
#include <cstddef>

namespace tessal {

namespace {

constexpr std::size_t kEntries = 5;

}  // namespace

double TableIndex(double value, double a, double b, double c, double d, double e) {
  if (std::isnan(value)) return value;
  if (value <= a) return 1;
  if (value > e) return kEntries;
  const std::array<double, kEntries> breakpoints{a, b, c, d, e};
  std::size_t upper = 1;
  while (upper + 1 < kEntries && breakpoints[upper] < value) ++upper;
  const double low = breakpoints[upper - 1];
  const double high = breakpoints[upper];
  const double fraction = high > low ? (value - low) / (high - low) : 0;
  return static_cast<double>(upper) + fraction;
}

double TableValue(double index, double a, double b, double c, double d, double e) {
  if (!(index >= 1 && index <= kEntries)) return 0;
  const std::array<double, kEntries> entries{a, b, c, d, e};
  const auto lower = static_cast<std::size_t>(index);
  const double low = entries[lower - 1];
  const double fraction = index - static_cast<double>(lower);
  // At an entry the neighbour must not count, even if it isn't finite.
  return fraction > 0 ? low + fraction * (entries[lower] - low) : low;
}

}  // namespace tessal
