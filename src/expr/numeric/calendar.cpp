#include "expr/numeric/calendar.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <optional>

#include "expr/numeric/integers.h"

namespace tessal {

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

/// The day of the series that the true calendar doesn't have, 29 February 1900.
constexpr std::int64_t kCountedLeapDay = 60;
/// From the sum of `GregorianDaySum` to the serial date.
constexpr std::int64_t kDaySumOfSerialZero = 2447094;
/// From the sum of `GregorianDaySum` to the Julian day number.
constexpr std::int64_t kDaySumOfJulianZero = 32075;
constexpr double kDaysPerSecond = 1.1574074074074073e-5;

constexpr double kDaysBeforeMonth[] = {0, 31, 59, 90, 120, 151, 181, 212, 243, 273, 304, 334};

struct Date {
  std::int64_t year;
  std::int64_t month;
  std::int64_t day;
};

struct TimeOfDay {
  double hour;
  double minute;
  double second;
};

std::int64_t GregorianDaySum(const Date& date) {
  const std::int64_t years = date.year + 4800;
  // -1 for January and February, which belong to the year before as far as leap days go.
  const std::int64_t yearShift = FloorDivide(date.month - 3, 12);
  return FloorDivide(1461 * (years + yearShift), 4) +
         FloorDivide(367 * (date.month - 2 - 12 * yearShift), 12) -
         FloorDivide(3 * FloorDivide(years + 100 + yearShift, 100), 4) + date.day;
}

Date GregorianDate(std::int64_t julianDay) {
  std::int64_t rest = julianDay + 68569;
  const std::int64_t cycles = FloorDivide(4 * rest, 146097);
  rest -= FloorDivide(146097 * cycles + 3, 4);
  const std::int64_t year = FloorDivide(4000 * (rest + 1), 1461001);
  rest -= FloorDivide(1461 * year, 4) - 31;
  const std::int64_t month = FloorDivide(80 * rest, 2447);
  const std::int64_t monthOverflow = month / 11;
  return {.year = 100 * (cycles - 49) + year + monthOverflow,
          .month = month + 2 - 12 * monthOverflow,
          .day = rest - FloorDivide(2447 * month, 80)};
}

bool IsCountedLeapDay(const Date& date) {
  return date.year == 1900 && date.month == 2 && date.day == 29;
}

std::int64_t SerialDay(const Date& date) {
  if (IsCountedLeapDay(date)) return kCountedLeapDay;
  const std::int64_t serial = GregorianDaySum(date) - kDaySumOfSerialZero;
  return serial > kCountedLeapDay ? serial : serial - 1;
}

std::optional<Date> DateOf(double time) {
  const std::optional<std::int64_t> serial = FloorToInteger(time);
  if (!serial) return std::nullopt;
  if (*serial == kCountedLeapDay) return Date{.year = 1900, .month = 2, .day = 29};
  const std::int64_t trueDay = *serial > kCountedLeapDay ? *serial : *serial + 1;
  return GregorianDate(trueDay + kDaySumOfSerialZero - kDaySumOfJulianZero);
}

double FieldOf(double time, std::int64_t Date::*field) {
  const std::optional<Date> date = DateOf(time);
  return date ? static_cast<double>((*date).*field) : kNaN;
}

/// Each field is the floor of what the fields before it left. Rounding can leave a rest a hair outside its
/// unit, so the fields are held within their ranges.
double FieldOf(double time, double TimeOfDay::*field) {
  if (!(std::fabs(time) <= kLargestWholeNumber)) return kNaN;
  double rest = time - std::floor(time);
  TimeOfDay timeOfDay{};
  timeOfDay.hour = std::clamp(std::floor(rest * 24), 0.0, 23.0);
  rest -= timeOfDay.hour / 24;
  timeOfDay.minute = std::clamp(std::floor(rest * 1440), 0.0, 59.0);
  rest -= timeOfDay.minute / 1440;
  timeOfDay.second = std::clamp(std::floor(rest * 86400), 0.0, 59.0);
  return timeOfDay.*field;
}

bool IsLeapYear(double year) {
  const double wholeYear = std::trunc(year);
  const auto divisibleBy = [wholeYear](double divisor) { return std::fmod(wholeYear, divisor) == 0; };
  return (divisibleBy(4) && !divisibleBy(100)) || divisibleBy(400);
}

}  // namespace

double SerialDate(double year, double month, double day, double hour, double minute, double second) {
  const std::optional<std::int64_t> wholeYear = FloorToInteger(year);
  const std::optional<std::int64_t> wholeMonth = FloorToInteger(month);
  const std::optional<std::int64_t> wholeDay = FloorToInteger(day);
  if (!wholeYear || !wholeMonth || !wholeDay) return kNaN;
  const std::int64_t serialDay = SerialDay({.year = *wholeYear, .month = *wholeMonth, .day = *wholeDay});
  return static_cast<double>(serialDay) + (hour * 3600 + minute * 60 + second) * kDaysPerSecond;
}

double YearOf(double time) {
  return FieldOf(time, &Date::year);
}

double MonthOf(double time) {
  return FieldOf(time, &Date::month);
}

double DayOf(double time) {
  return FieldOf(time, &Date::day);
}

double HourOf(double time) {
  return FieldOf(time, &TimeOfDay::hour);
}

double MinuteOf(double time) {
  return FieldOf(time, &TimeOfDay::minute);
}

double SecondOf(double time) {
  return FieldOf(time, &TimeOfDay::second);
}

double DayNumber(double year, double month, double day) {
  const std::optional<std::int64_t> wholeMonth = TruncateToInteger(month);
  if (!wholeMonth || *wholeMonth < 1 || *wholeMonth > 12) return kNaN;
  const double leapDay = month > 2 && IsLeapYear(year) ? 1 : 0;
  return day + kDaysBeforeMonth[*wholeMonth - 1] + leapDay;
}

}  // namespace tessal
