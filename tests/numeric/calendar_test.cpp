// Serial dates, days of the year, the length of days and the phases of the moon.

#include <chrono>
#include <cmath>
#include <cstdint>
#include <limits>
#include <random>

#include <gtest/gtest.h>

#include "expr/numeric/calendar.h"
#include "expr/numeric/daylight.h"

namespace tessal {
namespace {

using std::chrono::days;
using std::chrono::sys_days;
using std::chrono::year_month_day;

struct Date {
  double year, month, day;
  bool operator==(const Date&) const = default;
};

Date DateOf(double serial) {
  return {YearOf(serial), MonthOf(serial), DayOf(serial)};
}

double SerialDay(const Date& date) {
  return SerialDate(date.year, date.month, date.day, 0, 0, 0);
}

/// The true calendar, from the standard library.
Date TrueDate(int daysAfterEndOf1899) {
  using namespace std::chrono_literals;
  const year_month_day date{sys_days{1899y / 12 / 30} + days{daysAfterEndOf1899}};
  return {static_cast<double>(static_cast<int>(date.year())),
          static_cast<double>(static_cast<unsigned>(date.month())),
          static_cast<double>(static_cast<unsigned>(date.day()))};
}

TEST(Calendar, AgreesWithTheTrueOneForTwoCyclesOfCenturiesButFor29February1900) {
  constexpr int kDaysIn400Years = 146097;
  for (int serial = 1 - 2 * kDaysIn400Years; serial <= 61 + 2 * kDaysIn400Years; ++serial) {
    // Day 60 is one that the true calendar lacks.
    const Date date = serial == 60 ? Date{1900, 2, 29} : TrueDate(serial < 60 ? serial + 1 : serial);
    ASSERT_EQ(DateOf(serial), date) << serial;
    ASSERT_EQ(SerialDay(date), serial);
    if (serial <= 60) continue;
    // Day 60 counts in the serial number only.
    const double fromJanuary = serial - SerialDay({date.year, 1, 1}) + (date.year == 1900 ? 0 : 1);
    ASSERT_EQ(DayNumber(date.year, date.month, date.day), fromJanuary) << serial;
  }
}

TEST(Calendar, FloorsDatesAndRunsOnIntoTheNextYear) {
  EXPECT_EQ(SerialDay({2023.9, 5.9, 17.9}), SerialDay({2023, 5, 17}));
  EXPECT_EQ(SerialDay({2023, 13, 1}), SerialDay({2024, 1, 1}));
  EXPECT_EQ(SerialDay({2023, 27, 1}), SerialDay({2025, 3, 1}));
  EXPECT_EQ(SerialDay({2023, 0, 31}), SerialDay({2022, 12, 31}));
  EXPECT_EQ(SerialDay({2023, 12, 32}), SerialDay({2024, 1, 1}));
}

TEST(Calendar, FarDatesComeBack) {
  constexpr unsigned kSeed = 31;
  std::mt19937_64 random(kSeed);
  for (int round = 0; round < 20000; ++round) {
    // From days to 2e14 of them, either way.
    const double size = std::ldexp(static_cast<double>(random() % 100000), round % 31);
    const double serial = round % 2 == 0 ? std::floor(size) : -std::floor(size);
    ASSERT_EQ(SerialDay(DateOf(serial)), serial) << "seed " << kSeed;
  }
}

TEST(Calendar, TimeOfDayIsCutOffWithinASecond) {
  for (int second = 0; second < 86400; ++second) {
    const int hour = second / 3600;
    const int minute = second / 60 % 60;
    const double time = SerialDate(2024, 5, 17, hour, minute, second % 60);
    const double read = HourOf(time) * 3600 + MinuteOf(time) * 60 + SecondOf(time);
    ASSERT_TRUE(read == second || read == second - 1) << second << " reads " << read;
    ASSERT_EQ(DayOf(time), 17);
  }
}

TEST(Calendar, FieldsStayWithinTheirRangesForEveryFraction) {
  constexpr unsigned kSeed = 77;
  std::mt19937_64 random(kSeed);
  for (int round = 0; round < 200000; ++round) {
    // Fractions a hair off whole hours, minutes and seconds are where rounding shows.
    const double unit = round % 3 == 0 ? 24 : round % 3 == 1 ? 1440 : 86400;
    double time = std::floor(static_cast<double>(random() % 90000)) / unit;
    for (std::uint64_t step = random() % 4; step > 0; --step)
      time = std::nextafter(time, round % 2 == 0 ? 1e9 : -1e9);
    const double hour = HourOf(time);
    const double minute = MinuteOf(time);
    const double second = SecondOf(time);
    ASSERT_TRUE(hour >= 0 && hour <= 23 && minute >= 0 && minute <= 59 && second >= 0 && second <= 59)
        << "seed " << kSeed << " time " << time;
  }
}

TEST(Calendar, WhatIsNoDateGivesNaN) {
  for (const double value : {std::numeric_limits<double>::quiet_NaN(), HUGE_VAL, -HUGE_VAL, 1e16, -1e300}) {
    for (double (*field)(double) : {YearOf, MonthOf, DayOf, HourOf, MinuteOf, SecondOf}) {
      EXPECT_TRUE(std::isnan(field(value))) << value;
    }
    EXPECT_TRUE(std::isnan(SerialDay({value, 1, 1})) && std::isnan(SerialDay({1, value, 1})) &&
                std::isnan(SerialDay({1, 1, value})))
        << value;
    EXPECT_TRUE(std::isnan(DayNumber(2000, value, 1))) << value;
  }
}

TEST(Daylight, DayLengthFollowsSeasonAndLatitude) {
  const struct {
    Date date;
    double latitude, hours, tolerance;
  } rows[] = {
      // Almanacs give the day with refraction and the sun's disc, 10 to 20 minutes longer; the formula
      // stretches the latitude a little.
      {{2023, 6, 21}, 0, 12, 1e-9},
      {{2023, 6, 21}, 40, 15.0, 0.15},
      {{2023, 12, 21}, 40, 9.33, 0.3},
      {{2023, 6, 21}, 55, 17.37, 0.15},
      {{2023, 12, 21}, 55, 7.15, 0.5},
      {{2023, 3, 22}, 55, 12, 0.1},
      {{2023, 12, 21}, -40, 15.0, 0.15},
      {{2023, 6, 21}, 70, 24, 0},
      {{2023, 12, 21}, 70, 0, 0},
      // Beyond 88.5 degrees the stretched latitude passes the pole.
      {{2023, 6, 21}, 90, 0, 0},
      {{2023, 12, 21}, 90, 24, 0},
  };
  for (const auto& row : rows) {
    const double length = RelativeDayLength(row.date.year, row.date.month, row.date.day, row.latitude);
    EXPECT_NEAR(24 * length, row.hours, row.tolerance) << row.date.month << " " << row.latitude;
    const double rise = Sunrise(row.date.year, row.date.month, row.date.day, row.latitude, 1);
    const double set = Sunset(row.date.year, row.date.month, row.date.day, row.latitude, 1);
    EXPECT_NEAR(set - rise, 24 * length, 1e-12);
    EXPECT_NEAR((set + rise) / 2, 13, 1e-12);
  }
}

TEST(Daylight, MoonIsFullOnTheDaysOfFullMoon) {
  const struct {
    double year, month, day, hour, minute, phase;
  } rows[] = {
      {2010, 1, 30, 6, 18, 1},   {2012, 5, 6, 3, 35, 1},     {2015, 9, 28, 2, 50, 1},
      {2018, 1, 31, 13, 27, 1},  {2023, 8, 31, 1, 35, 1},    {2017, 8, 21, 18, 30, 0.5},
      {2024, 4, 8, 18, 21, 0.5}, {2009, 12, 16, 12, 2, 0.5},
  };
  for (const auto& row : rows) {
    const double phase = MoonPhase(row.year, row.month, row.day, row.hour, row.minute, 0);
    // The true moon is up to 14 hours off the mean one.
    EXPECT_NEAR(phase, row.phase, 0.03) << row.year << " " << row.month;
  }
  EXPECT_DOUBLE_EQ(MoonPhase(2009, 12, 21, 20, 12, 36), MoonPhase(2010, 1, 10, 20, 12, 36));
}

}  // namespace
}  // namespace tessal
