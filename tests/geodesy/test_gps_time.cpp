#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstdint>

#include "geodesy/csv_table.h"
#include "support/refdata.h"
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
  const std::int64_t shiftedMonth = month > 2 ? month - 3 : month + 9;
  const std::int64_t dayOfYear = (153 * shiftedMonth + 2) / 5 + day - 1;
  const std::int64_t dayOfEra = yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear;
  return era * 146097 + dayOfEra - 719468;
}

int daysInMonth(int year, int month) {
  return static_cast<int>(month == 12 ? daysFromCivil(year + 1, 1, 1) - daysFromCivil(year, 12, 1)
                                      : daysFromCivil(year, month + 1, 1) - daysFromCivil(year, month, 1));
}

const std::int64_t kEpochDays = daysFromCivil(1980, 1, 6);

struct CalendarTime {
  int year, month, day, dayOfYear, hour, minute;
  double second;
  double secondOfDay() const { return hour * 3600.0 + minute * 60.0 + second; }
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

// A spread of times of day: midnight, fractions, hour and minute boundaries, the last half second.
double timeOfDayFor(std::int64_t dayIndex, int variant) {
  static const double kFixed[] = {0.0, 0.25, 59.5, 3599.5, 3600.0, 43200.0, 45296.789, 86399.5};
  if (variant == 0) return kFixed[dayIndex % 8];
  return std::fmod(static_cast<double>(dayIndex) * 7919.37, 86400.0);
}

// Every day from 1901 to 2099 at two times of day, both directions, against the independent day count.
TEST(GpsTimeCalendar, EveryDayOfTheValidRangeMatchesIndependentDayCount) {
  std::int64_t dayIndex = 0;
  for (int year = 1901; year <= 2099; ++year) {
    for (int month = 1; month <= 12; ++month) {
      for (int day = 1; day <= daysInMonth(year, month); ++day, ++dayIndex) {
        const std::int64_t days = daysFromCivil(year, month, day) - kEpochDays;
        int dayOfYear = 0;
        mday_to_yday(year, month, day, &dayOfYear);
        ASSERT_EQ(dayOfYear, daysFromCivil(year, month, day) - daysFromCivil(year, 1, 1) + 1)
            << year << "-" << month << "-" << day;
        for (int variant = 0; variant < 2; ++variant) {
          const double timeOfDay = timeOfDayFor(dayIndex, variant);
          const int hour = static_cast<int>(timeOfDay / 3600.0);
          const int minute = static_cast<int>((timeOfDay - hour * 3600.0) / 60.0);
          const double second = timeOfDay - hour * 3600.0 - minute * 60.0;

          int week = 0;
          double secondsOfWeek = 0.0;
          ymdhms_to_gps(year, month, day, hour, minute, second, &week, &secondsOfWeek);
          const double sinceEpoch = static_cast<double>(days) * 86400.0 + timeOfDay;
          ASSERT_NEAR(week * kSecondsPerWeek + secondsOfWeek, sinceEpoch, kSecondTol)
              << year << "-" << month << "-" << day << " " << timeOfDay;
          if (days >= 0) {
            ASSERT_GE(secondsOfWeek, 0.0);
            ASSERT_LT(secondsOfWeek, kSecondsPerWeek);
          } else {
            ASSERT_LE(week, 0);
            ASSERT_GT(secondsOfWeek, -kSecondsPerWeek);
          }
          int weekByDay = 0;
          double secondsByDay = 0.0;
          ydhms_to_gps(year, dayOfYear, hour, minute, second, &weekByDay, &secondsByDay);
          ASSERT_EQ(weekByDay, week);
          ASSERT_EQ(secondsByDay, secondsOfWeek);

          // Back from a week by floor division, so that the seconds of week are never negative.
          const std::int64_t floorWeek = (days >= 0 ? days : days - 6) / 7;
          const double floorSeconds = static_cast<double>(days - 7 * floorWeek) * 86400.0 + timeOfDay;
          const CalendarTime back = fromGps(static_cast<int>(floorWeek), floorSeconds);
          ASSERT_EQ(back.year, year);
          ASSERT_EQ(back.month, month);
          ASSERT_EQ(back.day, day) << year << "-" << month;
          ASSERT_EQ(back.dayOfYear, dayOfYear);
          ASSERT_NEAR(back.secondOfDay(), timeOfDay, kSecondTol);
          ASSERT_GE(back.hour, 0);
          ASSERT_LT(back.hour, 24);
          ASSERT_GE(back.minute, 0);
          ASSERT_LT(back.minute, 60);
        }
      }
    }
  }
  EXPECT_EQ(dayIndex, daysFromCivil(2100, 1, 1) - daysFromCivil(1901, 1, 1));
}

// Generated calendar/GPS pairs: the epoch, week ends, both week-number rollovers, day 366, the end of the
// valid range, fractional seconds and published anchors (1999-01-01 is week 990, 432000 s).
TEST(GpsTimeCalendar, MatchesGeneratedVectors) {
  const svy_test::CsvTable table = svy_test::readCsvTable(svy_test::testdataPath("geodesy/gps_week_sow_vectors.csv"));
  ASSERT_EQ(table.rows.size(), 70u);
  for (const auto& row : table.rows) {
    const auto field = [&](const char* name) { return static_cast<int>(row.at(table.column(name))); };
    const double second = row[table.column("second")], expectedSeconds = row[table.column("seconds_of_week")];
    int week = 0;
    double secondsOfWeek = 0.0;
    ymdhms_to_gps(field("year"), field("month"), field("day"), field("hour"), field("minute"), second, &week,
                  &secondsOfWeek);
    EXPECT_NEAR(week * kSecondsPerWeek + secondsOfWeek, row[table.column("seconds_since_gps_epoch")], kSecondTol);
    if (field("gps_week") >= 0) {
      EXPECT_EQ(week, field("gps_week"));
      EXPECT_NEAR(secondsOfWeek, expectedSeconds, kSecondTol);
    }
    const CalendarTime back = fromGps(field("gps_week"), expectedSeconds);
    EXPECT_EQ(back.year, field("year"));
    EXPECT_EQ(back.month, field("month"));
    EXPECT_EQ(back.day, field("day"));
    EXPECT_EQ(back.dayOfYear, field("day_of_year"));
    EXPECT_EQ(back.hour, field("hour"));
    EXPECT_EQ(back.minute, field("minute"));
    EXPECT_NEAR(back.second, second, kSecondTol);
  }
}

// Before the epoch the week is truncated toward zero, so the seconds of week are negative
// (1979-12-31 is six days before the epoch).
TEST(GpsTimeCalendar, BeforeTheEpochTheWeekIsTruncatedTowardZero) {
  int week = -1;
  double secondsOfWeek = 0.0;
  ymdhms_to_gps(1979, 12, 31, 0, 0, 0.0, &week, &secondsOfWeek);
  EXPECT_EQ(week, 0);
  EXPECT_EQ(secondsOfWeek, -518400.0);
  ymdhms_to_gps(1901, 1, 1, 0, 0, 0.0, &week, &secondsOfWeek);
  EXPECT_EQ(week, -4122);
  EXPECT_EQ(secondsOfWeek, -432000.0);
}

// Inputs that cannot name a day give undefined results (NaN seconds, zero fields), never a table read
// out of bounds, an integer overflow or a hang.
TEST(GpsTimeCalendar, InputsThatNameNoDayGiveUndefinedResults) {
  int week = 7;
  double secondsOfWeek = 0.0;
  for (int month : {0, 13, -5, INT_MAX}) {
    ymdhms_to_gps(2020, month, 1, 0, 0, 0.0, &week, &secondsOfWeek);
    EXPECT_TRUE(std::isnan(secondsOfWeek)) << month;
    int dayOfYear = -1;
    mday_to_yday(2020, month, 1, &dayOfYear);
    EXPECT_EQ(dayOfYear, 0);
  }
  int dayOfYear = -1;
  mday_to_yday(2020, 12, INT_MAX, &dayOfYear);
  EXPECT_EQ(dayOfYear, 0);
  for (int year : {INT_MAX, INT_MIN}) {
    ymdhms_to_gps(year, 12, 31, 23, 59, 59.0, &week, &secondsOfWeek);
    EXPECT_TRUE(std::isnan(secondsOfWeek)) << year;
  }
  const double inf = std::numeric_limits<double>::infinity();
  const struct {
    int week;
    double secondsOfWeek;
  } gpsCases[] = {{0, std::nan("")}, {0, inf}, {0, -inf}, {INT_MIN, 0.0}, {INT_MAX, 1e300}, {-4123, 0.0}};
  for (const auto& c : gpsCases) {
    const CalendarTime t = fromGps(c.week, c.secondsOfWeek);
    EXPECT_EQ(t.year, 0);
    EXPECT_EQ(t.month, 0);
    EXPECT_EQ(t.dayOfYear, 0);
    EXPECT_TRUE(std::isnan(t.second)) << c.week << " " << c.secondsOfWeek;
  }
}

}  // namespace
