// svy time: calendar time (YYYY-MM-DDThh:mm:ss[.fff], on the GPS time scale: no time zone, no leap seconds)
// to and from GPS week and seconds of week. Times from the GPS epoch (1980-01-06) to the end of 2099.
#include "row_io.h"
#include "verbs.h"

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/gps_time.h"

#include <CLI/CLI.hpp>

#include <cctype>
#include <cmath>
#include <cstdio>
#include <memory>
#include <string>
#include <vector>

namespace {

using svy_math::units::kSecondsPerDay;

constexpr int kFirstGpsYear = 1980;
constexpr int kEpochMonth = 1;
constexpr int kEpochDay = 6;
constexpr int kLastYear = 2099;
constexpr int kMonthsPerYear = 12;
constexpr int kDaysInDecember = 31;
constexpr int kHoursPerDay = 24;
constexpr int kMinutesPerHour = 60;
constexpr double kSecondsPerMinute = svy_math::units::kSecondsPerMinute;
constexpr double kSecondsPerWeek = svy_math::units::kDaysPerWeek * kSecondsPerDay;
// The text carries milliseconds: seconds of week are written, and read back into text, to 1 ms.
constexpr int kSecondDecimals = 3;
constexpr long long kMillisPerSecond = 1000;
constexpr long long kMillisPerDay = 86400LL * kMillisPerSecond;
constexpr long long kMillisPerWeek = 7 * kMillisPerDay;
constexpr long long kMillisPerHour = 3600LL * kMillisPerSecond;
constexpr long long kMillisPerMinute = 60LL * kMillisPerSecond;
constexpr int kMaxFractionDigits = 9;

struct CalendarTime {
  int year = 0, month = 0, day = 0, hour = 0, minute = 0;
  double second = 0.0;
};

// Reads `count` decimal digits at text[pos] into value.
bool readDigits(const std::string& text, std::size_t pos, std::size_t count, int& value) {
  if (pos + count > text.size()) return false;
  value = 0;
  for (std::size_t i = pos; i < pos + count; ++i) {
    if (!std::isdigit(static_cast<unsigned char>(text[i]))) return false;
    value = value * 10 + (text[i] - '0');
  }
  return true;
}

// Days in a month by the library's cumulative-days tables.
int daysInMonth(int year, int month) {
  int first = 0;
  int next = 0;
  mday_to_yday(year, month, 1, &first);
  if (month == kMonthsPerYear) return kDaysInDecember;
  mday_to_yday(year, month + 1, 1, &next);
  return next - first;
}

// Parses YYYY-MM-DDThh:mm:ss with an optional fraction of 1 to 9 digits; checks the fields' ranges.
bool parseCalendarTime(const std::string& text, CalendarTime& t, std::string& error) {
  int wholeSecond = 0;
  const bool shapeOk = text.size() >= 19 && readDigits(text, 0, 4, t.year) && text[4] == '-' &&
                       readDigits(text, 5, 2, t.month) && text[7] == '-' && readDigits(text, 8, 2, t.day) &&
                       text[10] == 'T' && readDigits(text, 11, 2, t.hour) && text[13] == ':' &&
                       readDigits(text, 14, 2, t.minute) && text[16] == ':' && readDigits(text, 17, 2, wholeSecond);
  int fraction = 0;
  const std::size_t fractionDigits = text.size() > 20 ? text.size() - 20 : 0;
  // Only a text of the full shape has a character 19 to look at.
  const bool fractionOk =
      shapeOk && (text.size() == 19 || (text[19] == '.' && fractionDigits >= 1 &&
                                        fractionDigits <= kMaxFractionDigits &&
                                        readDigits(text, 20, fractionDigits, fraction)));
  if (!fractionOk) {
    error = "expected a time YYYY-MM-DDThh:mm:ss[.fff], got " + svy_tool::quoteForMessage(text);
    return false;
  }
  t.second = wholeSecond + fraction / std::pow(10.0, static_cast<double>(fractionDigits));
  const bool beforeEpoch = t.year < kFirstGpsYear ||
                           (t.year == kFirstGpsYear && t.month == kEpochMonth && t.day < kEpochDay);
  if (t.month < 1 || t.month > kMonthsPerYear || t.day < 1 || t.day > daysInMonth(t.year, t.month) ||
      t.hour >= kHoursPerDay || t.minute >= kMinutesPerHour || t.second >= kSecondsPerMinute) {
    error = "no such date or time: " + svy_tool::quoteForMessage(text);
    return false;
  }
  if (beforeEpoch || t.year > kLastYear) {
    error = "times run from the GPS epoch 1980-01-06 to 2099-12-31, got " + svy_tool::quoteForMessage(text);
    return false;
  }
  return true;
}

std::string formatCalendarTime(int year, int month, int day, long long millisOfDay) {
  char text[64];
  std::snprintf(text, sizeof text, "%04d-%02d-%02dT%02lld:%02lld:%02lld.%03lld", year, month, day,
                millisOfDay / kMillisPerHour, millisOfDay % kMillisPerHour / kMillisPerMinute,
                millisOfDay % kMillisPerMinute / kMillisPerSecond, millisOfDay % kMillisPerSecond);
  return text;
}

void addToGps(CLI::App& family) {
  CLI::App* verb =
      family.add_subcommand("to-gps", "Calendar time to GPS week and seconds of week: rows YYYY-MM-DDThh:mm:ss[.fff]");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{{"time"}, false, {{"week", 0}, {"seconds_of_week", kSecondDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          CalendarTime t;
          if (!parseCalendarTime(row.fields[0], t, error)) return false;
          int week = 0;
          double secondsOfWeek = 0.0;
          ymdhms_to_gps(t.year, t.month, t.day, t.hour, t.minute, t.second, &week, &secondsOfWeek);
          out = {static_cast<double>(week), secondsOfWeek};
          return true;
        }));
  });
}

void addFromGps(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "from-gps", "GPS week and seconds of week to calendar time and day of year: rows week,seconds_of_week");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{{"week", "seconds_of_week"}, true, {{"time", 0}, {"day_of_year", 0}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const double weekValue = row.numbers[0];
          const double secondsOfWeek = row.numbers[1];
          if (!(weekValue >= 0.0 && weekValue == std::floor(weekValue) && weekValue < 1e6)) {
            error = "the week must be a whole number from 0";
            return false;
          }
          if (!(secondsOfWeek >= 0.0 && secondsOfWeek < kSecondsPerWeek)) {
            error = "seconds of week must lie in [0, 604800)";
            return false;
          }
          // Rounded to the written millisecond first, so that the text never shows 60 seconds.
          int week = static_cast<int>(weekValue);
          long long millisOfWeek = std::llround(secondsOfWeek * kMillisPerSecond);
          if (millisOfWeek == kMillisPerWeek) {
            ++week;
            millisOfWeek = 0;
          }
          const long long dayOfWeek = millisOfWeek / kMillisPerDay;
          int year = 0, month = 0, day = 0, hour = 0, minute = 0, dayOfYear = 0;
          double second = 0.0;
          const double startOfDay = static_cast<double>(dayOfWeek) * kSecondsPerDay;
          gps_to_ymdhms(week, startOfDay, &year, &month, &day, &hour, &minute, &second);
          gps_to_ydhms(week, startOfDay, &year, &dayOfYear, &hour, &minute, &second);
          if (year > kLastYear) {
            error = "times run to 2099-12-31";
            return false;
          }
          out = {formatCalendarTime(year, month, day, millisOfWeek % kMillisPerDay), static_cast<double>(dayOfYear)};
          return true;
        }));
  });
}

}  // namespace

void registerTimeVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("time", "GPS week and seconds of week against calendar time (no leap seconds)");
  family->require_subcommand(1);
  addToGps(*family);
  addFromGps(*family);
}
