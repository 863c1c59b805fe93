// Calendar arithmetic on serial dates. A serial date counts whole days since 30 December 1899, with the time
// of day as its fraction. The series counts a 29 February 1900 that never was, as day 60, so that dates
// before it are one day off the true calendar; from 1 March 1900 on it agrees with the Gregorian calendar.
// Dates beyond 1e15 days or years, and NaN, give NaN.
#pragma once

namespace tessal {

/// The serial date of a moment. Year, month and day are floored; the months beyond 12 run on into the next
/// year. Hours, minutes and seconds may be any numbers. The Gregorian day number is that of Fliegel and Van
/// Flandern 1968, Commun. ACM 11:657.
double SerialDate(double year, double month, double day, double hour, double minute, double second);

/// `YEAR`, `MONTH`, `DAY` of a serial date, in whole numbers.
double YearOf(double time);
double MonthOf(double time);
double DayOf(double time);

/// `HOUR` (0 to 23), `MINUTE` (0 to 59), `SECOND` (0 to 59) of a serial date, in whole numbers. They are cut
/// off, not rounded: a time whose fraction lies a hair below a full minute is still in the minute before.
double HourOf(double time);
double MinuteOf(double time);
double SecondOf(double time);

/// `DAYNUMBER`: the day of the year, 1 for 1 January. Day and month may have fractions; the month's is cut
/// off. NaN for a month outside 1 to 12.
double DayNumber(double year, double month, double day);

}  // namespace tessal
