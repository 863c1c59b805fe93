#include "platform/kvf_number.h"

#include <algorithm>
#include <charconv>
#include <limits>
#include <system_error>

namespace tessal {

namespace {

/// Whether a number too large or too small for 64 bits is too large: its first digit is before the
/// point, the exponent counted in.
bool IsHuge(std::string_view digits) {
  const std::size_t exponentSign = digits.find_first_of("eE");
  const std::string_view mantissa = digits.substr(0, exponentSign);
  const std::size_t first = mantissa.find_first_of("123456789");
  if (first == std::string_view::npos) return false;
  const std::size_t point = std::min(mantissa.find('.'), mantissa.size());
  const auto magnitude = static_cast<std::int64_t>(point) - static_cast<std::int64_t>(first);
  if (exponentSign == std::string_view::npos) return magnitude > 0;
  std::string_view exponentText = digits.substr(exponentSign + 1);
  if (exponentText.starts_with('+')) exponentText.remove_prefix(1);
  std::int64_t exponent = 0;
  const auto read = std::from_chars(exponentText.data(), exponentText.data() + exponentText.size(), exponent);
  if (read.ec == std::errc::result_out_of_range) return !exponentText.starts_with('-');
  return magnitude + exponent > 0;
}

template <class Number>
bool Fits(std::string_view text) {
  if (text.starts_with('+')) text.remove_prefix(1);
  Number value{};
  const auto read = std::from_chars(text.data(), text.data() + text.size(), value);
  return read.ec != std::errc::result_out_of_range;
}

}  // namespace

std::int32_t KvfInteger(std::string_view text) {
  const bool negative = text.starts_with('-');
  if (text.starts_with('+')) text.remove_prefix(1);
  std::int32_t value = 0;
  const auto read = std::from_chars(text.data(), text.data() + text.size(), value);
  if (read.ec != std::errc::result_out_of_range) return value;
  return negative ? std::numeric_limits<std::int32_t>::min() : std::numeric_limits<std::int32_t>::max();
}

double KvfReal(std::string_view text) {
  const bool negative = text.starts_with('-');
  if (text.starts_with('+')) text.remove_prefix(1);
  double value = 0.0;
  const auto read = std::from_chars(text.data(), text.data() + text.size(), value);
  if (read.ec != std::errc::result_out_of_range) return value;
  const double limit = IsHuge(text) ? std::numeric_limits<double>::max() : 0.0;
  return negative ? -limit : limit;
}

bool KvfIntegerFits(std::string_view text) {
  return Fits<std::int32_t>(text);
}

bool KvfRealFits(std::string_view text) {
  return Fits<double>(text);
}

}  // namespace tessal
