#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstdint>
#include <limits>
#include <utility>

#include "svymath/geodesy/gps_time.h"

namespace {

constexpr double kSecondsPerWeek = 604800.0;
// Seconds of week reach 6e5 s; the conversions lose a few ulps (1e-10 s) on the way.
constexpr double kSecondTol = 1e-6;

// Independent day count: days from 1970-01-01 to a proleptic Gregorian date (the well-known
// days-from-civil algorithm over 400-year eras, with March as the first month of the computing year).
std::int64_t daysFromCivil(int year, int month, int day) {
  const std::int64_t y = year - (month <= 2 ? 1 : 0);
  const std::int64_t era = (y >= 0 ? y : y - 399) / 400;
  const std::int64_t yearOfEra = y - era * 400;
  const std::int64_t dayOfYear = (153 * (month > 2 ? month - 3 : month + 9) + 2) / 5 + day - 1;
  return era * 146097 + yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear - 719468;
}

struct CalendarTime {
  int year, month, day, dayOfYear, hour, minute;
  double second;
};

CalendarTime fromGps(int week, double secondsOfWeek) {
  CalendarTime t{};
  gps_to_ymdhms(week, secondsOfWeek, &t.year, &t.month, &t.day, &t.hour, &t.minute, &t.second);
  int yearByDay = 0, hour = 0, minute = 0;
  double second = 0.0;
  gps_to_ydhms(week, secondsOfWeek, &yearByDay, &t.dayOfYear, &hour, &minute, &second);
  EXPECT_EQ(yearByDay, t.year);
  return t;
}

// Every day from 1901 to 2099 at two times of day (fixed ones at boundaries and a spread), both directions
// and both calendar forms, against the independent day count. Before the epoch the week is truncated toward
// zero, so the seconds of week can be negative; back from a week by floor division they are never negative.
TEST(GpsTimeCalendar, EveryDayOfTheValidRangeMatchesIndependentDayCount) {
  static const double kFixed[] = {0.0, 0.25, 59.5, 3599.5, 3600.0, 43200.0, 45296.789, 86399.5};
  const std::int64_t epochDays = daysFromCivil(1980, 1, 6);
  std::int64_t dayIndex = 0;
  for (int year = 1901; year <= 2099; ++year)
    for (int month = 1; month <= 12; ++month) {
      const std::int64_t monthStart = daysFromCivil(year, month, 1);
      const int monthDays = static_cast<int>(daysFromCivil(year + month / 12, month % 12 + 1, 1) - monthStart);
      for (int day = 1; day <= monthDays; ++day, ++dayIndex) {
        SCOPED_TRACE(::testing::Message() << year << "-" << month << "-" << day);
        const std::int64_t days = monthStart + day - 1 - epochDays;
        int dayOfYear = 0;
        mday_to_yday(year, month, day, &dayOfYear);
        ASSERT_EQ(dayOfYear, monthStart + day - daysFromCivil(year, 1, 1));
        for (const double timeOfDay :
             {kFixed[dayIndex % 8], std::fmod(static_cast<double>(dayIndex) * 7919.37, 86400.0)}) {
          const int hour = static_cast<int>(timeOfDay / 3600.0);
          const int minute = static_cast<int>((timeOfDay - hour * 3600.0) / 60.0);
          const double second = timeOfDay - hour * 3600.0 - minute * 60.0;
          int week = 0, weekByDay = 0;
          double secondsOfWeek = 0.0, secondsByDay = 0.0;
          ymdhms_to_gps(year, month, day, hour, minute, second, &week, &secondsOfWeek);
          ASSERT_NEAR(week * kSecondsPerWeek + secondsOfWeek, static_cast<double>(days) * 86400.0 + timeOfDay,
                      kSecondTol);
          ASSERT_TRUE(days >= 0 ? secondsOfWeek >= 0.0 && secondsOfWeek < kSecondsPerWeek
                                : week <= 0 && secondsOfWeek > -kSecondsPerWeek)
              << week << " " << secondsOfWeek;
          ydhms_to_gps(year, dayOfYear, hour, minute, second, &weekByDay, &secondsByDay);
          ASSERT_EQ(weekByDay, week);
          ASSERT_EQ(secondsByDay, secondsOfWeek);

          const std::int64_t floorWeek = (days >= 0 ? days : days - 6) / 7;
          const CalendarTime back =
              fromGps(static_cast<int>(floorWeek), static_cast<double>(days - 7 * floorWeek) * 86400.0 + timeOfDay);
          ASSERT_TRUE(back.year == year && back.month == month && back.day == day && back.dayOfYear == dayOfYear);
          ASSERT_NEAR(back.hour * 3600.0 + back.minute * 60.0 + back.second, timeOfDay, kSecondTol);
          ASSERT_TRUE(back.hour >= 0 && back.hour < 24 && back.minute >= 0 && back.minute < 60);
        }
      }
    }
  EXPECT_EQ(dayIndex, daysFromCivil(2100, 1, 1) - daysFromCivil(1901, 1, 1));
  // Six days before the epoch, the start of the range, and a published anchor.
  const int anchors[][5] = {{1979, 12, 31, 0, -518400}, {1901, 1, 1, -4122, -432000}, {1999, 1, 1, 990, 432000}};
  for (const auto& a : anchors) {
    int week = -1;
    double secondsOfWeek = 0.0;
    ymdhms_to_gps(a[0], a[1], a[2], 0, 0, 0.0, &week, &secondsOfWeek);
    EXPECT_TRUE(week == a[3] && secondsOfWeek == a[4]) << a[0] << " " << week << " " << secondsOfWeek;
  }
}

// Inputs that cannot name a day give undefined results (NaN seconds, zero fields), never a table read
// out of bounds, an integer overflow or a hang.
TEST(GpsTimeCalendar, InputsThatNameNoDayGiveUndefinedResults) {
  const int calendarCases[][3] = {{2020, 0, 1}, {2020, 13, 1}, {2020, INT_MAX, 1}, {INT_MAX, 12, 31}, {INT_MIN, 12, 31}};
  for (const auto& c : calendarCases) {
    int week = 7, dayOfYear = -1;
    double secondsOfWeek = 0.0;
    ymdhms_to_gps(c[0], c[1], c[2], 23, 59, 59.0, &week, &secondsOfWeek);
    mday_to_yday(c[0], c[1], c[2], &dayOfYear);
    EXPECT_TRUE(std::isnan(secondsOfWeek) && (c[0] != 2020 || dayOfYear == 0)) << c[0] << " " << c[1] << " " << c[2];
  }
  int dayOfYear = -1;
  mday_to_yday(2020, 12, INT_MAX, &dayOfYear);
  EXPECT_EQ(dayOfYear, 0);
  const double inf = std::numeric_limits<double>::infinity();
  const std::pair<int, double> gpsCases[] = {{0, std::nan("")}, {0, -inf}, {INT_MIN, 0.0}, {INT_MAX, 1e300}, {-4123, 0.0}};
  for (const auto& [week, secondsOfWeek] : gpsCases) {
    const CalendarTime t = fromGps(week, secondsOfWeek);
    EXPECT_TRUE(t.year == 0 && t.month == 0 && t.dayOfYear == 0 && std::isnan(t.second)) << week << " " << secondsOfWeek;
  }
}

}  // namespace
