// svy time to-gps and from-gps: published week anchors, millisecond rounding that carries into the next day,
// and the round trip between the two verbs over the whole range.
#include <gtest/gtest.h>

#include <cstdio>
#include <ctime>
#include <string>

#include "svy_runner.h"

namespace {

using svy_test::runJson;

TEST(TimeVerbs, PublishedAnchorsBothWays) {
  // The GPS epoch, both week-number rollovers, published anchors of GNSS software test suites, day 366 of
  // 2000 (a Sunday: 2000-01-01 was a Saturday, 52 weeks and a day before), and times that round up to the
  // next day or week when written to the millisecond.
  const struct {
    const char* time;
    double week, secondsOfWeek, dayOfYear;
    bool exactText;
  } anchors[] = {
      {"1980-01-06T00:00:00.000", 0, 0.0, 6, true},           {"1999-01-01T00:00:00.000", 990, 432000.0, 1, true},
      {"1999-08-22T00:00:00.000", 1024, 0.0, 234, true},      {"2000-01-01T00:00:00.000", 1042, 518400.0, 1, true},
      {"2000-12-31T12:00:00.250", 1095, 43200.25, 366, true}, {"2019-04-07T00:00:00.000", 2048, 0.0, 97, true},
      {"1980-01-07T00:00:00.000", 0, 86399.9996, 7, false},   {"1980-01-13T00:00:00.000", 0, 604799.9999, 13, false},
      {"2018-05-06T00:01:00.000", 2000, 59.9996, 126, false}};
  for (const auto& a : anchors) {
    SCOPED_TRACE(a.time);
    const nlohmann::json from = runJson({"time", "from-gps"}, svy_test::csvRow({a.week, a.secondsOfWeek})).at(0);
    EXPECT_EQ(from["time"].get<std::string>(), a.time);
    EXPECT_EQ(from["day_of_year"].get<double>(), a.dayOfYear);
    if (!a.exactText) continue;
    const nlohmann::json to = runJson({"time", "to-gps"}, std::string(a.time) + "\n").at(0);
    EXPECT_EQ(to["week"].get<double>(), a.week);
    EXPECT_NEAR(to["seconds_of_week"].get<double>(), a.secondsOfWeek, 1e-6);
  }
}

// Calendar text -> GPS -> the same text, every 97th day from the epoch to the end of 2099 (the library's
// own tests cover every day), with a millisecond time of day that changes from row to row.
TEST(TimeVerbs, RoundTripOverTheWholeRange) {
  std::string times;
  for (long long millis = 0; millis < 3786480000000LL; millis += 97 * 86400000LL + 7919) {
    const std::time_t seconds = static_cast<std::time_t>(315964800 + millis / 1000);  // the GPS epoch in Unix time
    std::tm utc{};
    gmtime_r(&seconds, &utc);
    char text[80];
    std::snprintf(text, sizeof text, "%04d-%02d-%02dT%02d:%02d:%02d.%03lld\n", utc.tm_year + 1900, utc.tm_mon + 1,
                  utc.tm_mday, utc.tm_hour, utc.tm_min, utc.tm_sec, millis % 1000);
    times += text;
  }
  std::string gpsRows;
  for (const auto& g : runJson({"time", "to-gps"}, times)) {
    gpsRows += svy_test::csvRow({g["week"].get<double>(), g["seconds_of_week"].get<double>()});
  }
  std::string back;
  for (const auto& row : runJson({"time", "from-gps"}, gpsRows)) back += row["time"].get<std::string>() + "\n";
  EXPECT_EQ(back, times);
}

}  // namespace
