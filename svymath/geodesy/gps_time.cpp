#include "svymath/geodesy/gps_time.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>

#include "svymath/foundation/constants.h"

namespace svy_math {
namespace {

using units::kDaysPerWeek;
using units::kSecondsPerDay;

// Modified Julian Dates of the GPS epoch (1980-01-06) and of the start of the day count (1901-01-01).
constexpr std::int64_t kMjdGpsEpoch = 44244;
constexpr std::int64_t kMjd1901 = 15385;
constexpr int kFirstYear = 1901;
// Four years of 365, 365, 365 and 366 days, starting with 1901.
constexpr std::int64_t kDaysPerCycle = 1461;
constexpr std::int64_t kDaysPerCommonYear = 365;
// A day of the year times this is a first guess of the month index (0-based), low by at most one:
// 1 / 31.25 stays below every month's start.
constexpr double kMonthGuessPerDay = 0.032;

// Days before the first of each month, by kind of year: [0] common, [1] leap.
constexpr std::array<std::array<int, 12>, 2> kDaysBeforeMonth = {{
    {{0, 31, 59, 90, 120, 151, 181, 212, 243, 273, 304, 334}},
    {{0, 31, 60, 91, 121, 152, 182, 213, 244, 274, 305, 335}}}};
constexpr std::array<int, 2> kDaysInYear = {365, 366};

// The same with a closing entry, the length of the year, so that month m spans entries m-1 .. m.
constexpr std::array<std::array<int, 13>, 2> withYearLength() {
  std::array<std::array<int, 13>, 2> table{};
  for (std::size_t leap = 0; leap < 2; ++leap) {
    for (std::size_t m = 0; m < 12; ++m) table[leap][m] = kDaysBeforeMonth[leap][m];
    table[leap][12] = kDaysInYear[leap];
  }
  return table;
}
constexpr std::array<std::array<int, 13>, 2> kDaysBeforeMonthClosed = withYearLength();

// Row of the tables for the year: 1 for a leap year (every year divisible by 4), else 0.
std::size_t leapIndex(int year) { return year % 4 == 0 ? 1 : 0; }

bool isMonth(int month) { return month >= 1 && month <= 12; }

// MJD of day `dayOfYear` of `year` (day 1 is 1 January); 64-bit so that absurd years cannot overflow.
std::int64_t mjdOfDayOfYear(int year, std::int64_t dayOfYear) {
  const std::int64_t y = static_cast<std::int64_t>(year) - kFirstYear;
  return dayOfYear + (y / 4) * kDaysPerCycle + (y % 4) * kDaysPerCommonYear + (kMjd1901 - 1);
}

void mjdToGps(std::int64_t mjd, int hour, int minute, double second, int* week, double* secondsOfWeek) {
  const std::int64_t daysSinceEpoch = mjd - kMjdGpsEpoch;
  const std::int64_t wholeWeeks = daysSinceEpoch / kDaysPerWeek;
  if (wholeWeeks < std::numeric_limits<int>::min() || wholeWeeks > std::numeric_limits<int>::max()) {
    *week = 0;
    *secondsOfWeek = undefinedValue();
    return;
  }
  const double dayFraction =
      ((second / units::kSecondsPerMinute + minute) / units::kSecondsPerMinute + hour) / units::kHoursPerDay;
  *week = static_cast<int>(wholeWeeks);
  *secondsOfWeek = (static_cast<double>(daysSinceEpoch - kDaysPerWeek * wholeWeeks) + dayFraction) * kSecondsPerDay;
}

// Splits GPS time into year, day of year and time of day. Returns false (outputs untouched) when the
// time is not finite or falls before 1901 or beyond the 32-bit day count, where the cycle arithmetic has
// no meaning.
bool gpsToYearDay(int week, double secondsOfWeek, int* year, int* dayOfYear, int* hour, int* minute,
                  double* second) {
  const double mjd = static_cast<double>(kDaysPerWeek) * week + secondsOfWeek / kSecondsPerDay +
                     static_cast<double>(kMjdGpsEpoch);
  const double dayCount = std::trunc(mjd) - static_cast<double>(kMjd1901);
  if (!(dayCount >= 0.0 && dayCount <= static_cast<double>(std::numeric_limits<int>::max()))) return false;
  const std::int64_t d = static_cast<std::int64_t>(dayCount);
  const std::int64_t q = d / kDaysPerCycle;
  const std::int64_t r = d - kDaysPerCycle * q;
  // The 1461st day of a cycle (r = 1460) belongs to the fourth, leap, year: the second term pulls it back.
  const std::int64_t yearInCycle = r / kDaysPerCommonYear - r / (kDaysPerCycle - 1);
  *year = static_cast<int>(4 * q + kFirstYear + yearInCycle);
  *dayOfYear = static_cast<int>(r - kDaysPerCommonYear * yearInCycle + 1);

  const double f = std::fmod(secondsOfWeek, kSecondsPerDay) / kSecondsPerDay;
  *hour = static_cast<int>(std::trunc(f * units::kHoursPerDay));
  *minute = static_cast<int>(std::trunc(f * units::kMinutesPerDay - units::kSecondsPerMinute * *hour));
  *second = f * kSecondsPerDay - units::kSecondsPerHour * *hour - units::kSecondsPerMinute * *minute;
  return true;
}

void setUndefinedTime(int* year, int* hour, int* minute, double* second) {
  *year = 0;
  *hour = 0;
  *minute = 0;
  *second = undefinedValue();
}

}  // namespace

void mday_to_yday(int year, int month, int day, int* dayOfYear) {
  // 64-bit sum: a day near the int limit gives 0 like a bad month instead of overflowing.
  const std::int64_t sum =
      isMonth(month) ? kDaysBeforeMonth[leapIndex(year)][static_cast<std::size_t>(month - 1)] + std::int64_t{day} : 0;
  *dayOfYear = sum <= std::numeric_limits<int>::max() ? static_cast<int>(sum) : 0;
}

void ymdhms_to_gps(int year, int month, int day, int hour, int minute, double second, int* week,
                   double* secondsOfWeek) {
  if (!isMonth(month)) {
    *week = 0;
    *secondsOfWeek = undefinedValue();
    return;
  }
  const std::int64_t dayOfYear = static_cast<std::int64_t>(day) + kDaysBeforeMonth[leapIndex(year)][static_cast<std::size_t>(month - 1)];
  mjdToGps(mjdOfDayOfYear(year, dayOfYear), hour, minute, second, week, secondsOfWeek);
}

void ydhms_to_gps(int year, int dayOfYear, int hour, int minute, double second, int* week,
                  double* secondsOfWeek) {
  mjdToGps(mjdOfDayOfYear(year, dayOfYear), hour, minute, second, week, secondsOfWeek);
}

void gps_to_ydhms(int week, double secondsOfWeek, int* year, int* dayOfYear, int* hour, int* minute,
                  double* second) {
  if (!gpsToYearDay(week, secondsOfWeek, year, dayOfYear, hour, minute, second)) {
    setUndefinedTime(year, hour, minute, second);
    *dayOfYear = 0;
  }
}

void gps_to_ymdhms(int week, double secondsOfWeek, int* year, int* month, int* day, int* hour, int* minute,
                   double* second) {
  int dayOfYear = 0;
  if (!gpsToYearDay(week, secondsOfWeek, year, &dayOfYear, hour, minute, second)) {
    setUndefinedTime(year, hour, minute, second);
    *month = 0;
    *day = 0;
    return;
  }
  // dayOfYear is 1..366 here, so the guess m0 is 0..11 and every index below is inside the table.
  const auto& table = kDaysBeforeMonthClosed[leapIndex(*year)];
  const int m0 = static_cast<int>(std::trunc(dayOfYear * kMonthGuessPerDay));
  const int k = dayOfYear > table[static_cast<std::size_t>(m0 + 1)] ? 1 : 0;
  *month = m0 + 1 + k;
  *day = dayOfYear - table[static_cast<std::size_t>(m0 + k)];
}

}  // namespace svy_math
