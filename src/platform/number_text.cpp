#include "platform/number_text.h"

#include <array>
#include <charconv>
#include <cmath>

namespace tessal {

namespace {

/// What `std::to_chars` makes of a value and the further arguments.
template <class... Form>
std::string TextOf(double value, Form... form) {
  // Plain numbers below 1e15 and all with an exponent need fewer characters.
  std::array<char, 32> buffer{};
  const auto written = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value, form...);
  return {buffer.data(), written.ptr};
}

}  // namespace

std::string ShortestNumberText(double value) {
  return TextOf(value);
}

std::string PlainNumberText(double value) {
  // The shortest form on its own would make 1e-04 of 0.0001 and 1e+05 of 100000.
  constexpr double kSmallestPlain = 1e-4;
  constexpr double kLargestPlain = 1e15;
  const double size = std::abs(value);
  const bool isPlain = size == 0.0 || (size >= kSmallestPlain && size < kLargestPlain);
  return TextOf(value, isPlain ? std::chars_format::fixed : std::chars_format::scientific);
}

std::string SixDigitNumberText(double value) {
  constexpr int kStreamPrecision = 6;
  return TextOf(value, std::chars_format::general, kStreamPrecision);
}

}  // namespace tessal
