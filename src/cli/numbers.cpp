#include "cli/numbers.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>
#include <locale>
#include <sstream>
#include <system_error>

#include "platform/number_text.h"

namespace tessal::cli {

namespace {

/// Comes before a hidden argument, and before one that begins with it itself.
constexpr char kHidden = '\x01';

/// A number that no double holds, which `std::from_chars` refuses: infinite, or 0 and its neighbours.
double RoundedOutOfRange(std::string_view text) {
  std::istringstream stream{std::string(text)};
  stream.imbue(std::locale::classic());
  // Without memory there is no number, not another one.
  stream.exceptions(std::ios::badbit);
  double value = 0.0;
  const bool inRange = static_cast<bool>(stream >> value);
  return inRange ? value : std::copysign(std::numeric_limits<double>::infinity(), value);
}

}  // namespace

std::optional<double> NumberOf(std::string_view text) {
  if (text.starts_with('+') && !text.starts_with("+-")) text.remove_prefix(1);
  double value = 0.0;
  const auto read = std::from_chars(text.data(), text.data() + text.size(), value);
  if (read.ptr != text.data() + text.size() || read.ec == std::errc::invalid_argument) return std::nullopt;
  return read.ec == std::errc::result_out_of_range ? RoundedOutOfRange(text) : value;
}

std::string NumberText(double value) {
  // The sign of a NaN says nothing.
  return std::isnan(value) ? "nan" : ShortestNumberText(value);
}

std::optional<std::vector<double>> NumbersOf(const std::vector<std::string>& texts) {
  std::vector<double> values;
  for (const std::string& text : texts) {
    const std::optional<double> value = NumberOf(text);
    if (!value) return std::nullopt;
    values.push_back(*value);
  }
  return values;
}

std::vector<std::string> SplitAtCommas(std::string_view text) {
  std::vector<std::string> pieces;
  if (text.empty()) return pieces;
  std::size_t start = 0;
  while (start <= text.size()) {
    const std::size_t end = std::min(text.find(',', start), text.size());
    pieces.emplace_back(text.substr(start, end - start));
    start = end + 1;
  }
  return pieces;
}

std::string HiddenNumber(const std::string& argument) {
  const bool isHidden = argument.starts_with(kHidden) || (argument.starts_with('-') && NumberOf(argument));
  return isHidden ? kHidden + argument : argument;
}

std::string ShownNumber(const std::string& argument) {
  return argument.starts_with(kHidden) ? argument.substr(1) : argument;
}

}  // namespace tessal::cli
