#include "elements/version_stamp.h"

#include <charconv>
#include <cmath>
#include <optional>

namespace tessal {

namespace {

constexpr std::string_view kBranchPrefix = "$Branch: Rel";
constexpr std::string_view kRevisionPrefix = "$Revision: ";
constexpr std::string_view kBranchStamp = TESSAL_BRANCH_STAMP;
constexpr std::string_view kRevisionStamp = TESSAL_REVISION_STAMP;

std::string_view SkipBlanks(std::string_view text) {
  const std::size_t first = text.find_first_not_of(" \t");
  return first == std::string_view::npos ? std::string_view() : text.substr(first);
}

/// The number at the start of the text, which then begins after it.
std::optional<int> TakeNumber(std::string_view& text) {
  text = SkipBlanks(text);
  int number = 0;
  const auto result = std::from_chars(text.data(), text.data() + text.size(), number);
  if (result.ec != std::errc()) return std::nullopt;
  text.remove_prefix(static_cast<std::size_t>(result.ptr - text.data()));
  return number;
}

std::optional<int> NumberAfter(std::string_view prefix, std::string_view stamp) {
  if (!stamp.starts_with(prefix)) return std::nullopt;
  stamp.remove_prefix(prefix.size());
  return TakeNumber(stamp);
}

/// The year of a date of the form "Nov 24 2026".
std::optional<int> YearOf(std::string_view date) {
  date = SkipBlanks(date);
  const std::size_t monthEnd = date.find_first_of(" \t");
  if (monthEnd == std::string_view::npos) return std::nullopt;
  date.remove_prefix(monthEnd);
  if (!TakeNumber(date)) return std::nullopt;
  return TakeNumber(date);
}

}  // namespace

double VersionFromStamps(std::string_view branchStamp, std::string_view revisionStamp,
                         std::string_view buildDate) {
  // Versions made before a release was branched off sort after every release of their time.
  constexpr int kUnreleasedOffset = 100;
  double release = 0.0;
  if (const auto number = NumberAfter(kBranchPrefix, branchStamp)) {
    release = *number;
  } else if (const auto year = YearOf(buildDate)) {
    release = *year + kUnreleasedOffset;
  }
  return RoundVersion(release + NumberAfter(kRevisionPrefix, revisionStamp).value_or(1) * 0.001);
}

double SoftwareVersion() {
  return VersionFromStamps(kBranchStamp, kRevisionStamp, {});
}

double ParserVersion() {
  return SoftwareVersion();
}

double RoundVersion(double version) {
  // Divided and not multiplied, so that the value is the nearest to its three decimals, and has a short text.
  return std::floor(version * 1000.0 + 0.5) / 1000.0;
}

}  // namespace tessal
