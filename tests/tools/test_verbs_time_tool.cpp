// svy time to-gps and from-gps: published week anchors, the round trip between the two verbs over the whole
// range, and millisecond rounding that carries into the next day.
#include "svy_runner.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <ctime>
#include <string>
#include <vector>

namespace {

using svy_test::runJson;

struct Anchor {
  const char* time;
  int week;
  double secondsOfWeek;
  int dayOfYear;
};

// The GPS epoch, both week-number rollovers, published anchors of GNSS software test suites, and day 366
// of 2000 (a Sunday: 2000-01-01 was a Saturday, 52 weeks and a day before).
const Anchor kAnchors[] = {{"1980-01-06T00:00:00.000", 0, 0.0, 6},
                           {"1999-01-01T00:00:00.000", 990, 432000.0, 1},
                           {"1999-08-22T00:00:00.000", 1024, 0.0, 234},
                           {"2000-01-01T00:00:00.000", 1042, 518400.0, 1},
                           {"2000-12-31T12:00:00.250", 1095, 43200.25, 366},
                           {"2019-04-07T00:00:00.000", 2048, 0.0, 97}};

TEST(TimeVerbs, PublishedAnchorsBothWays) {
  std::string times;
  std::string gps;
  for (const Anchor& a : kAnchors) {
    times += std::string(a.time) + "\n";
    gps += std::to_string(a.week) + "," + std::to_string(a.secondsOfWeek) + "\n";
  }
  const nlohmann::json toGps = runJson({"time", "to-gps"}, times);
  const nlohmann::json fromGps = runJson({"time", "from-gps"}, gps);
  ASSERT_EQ(toGps.size(), std::size(kAnchors));
  ASSERT_EQ(fromGps.size(), std::size(kAnchors));
  for (std::size_t i = 0; i < std::size(kAnchors); ++i) {
    EXPECT_EQ(toGps[i]["week"].get<double>(), kAnchors[i].week) << kAnchors[i].time;
    EXPECT_NEAR(toGps[i]["seconds_of_week"].get<double>(), kAnchors[i].secondsOfWeek, 1e-6) << kAnchors[i].time;
    EXPECT_EQ(fromGps[i]["time"].get<std::string>(), kAnchors[i].time);
    EXPECT_EQ(fromGps[i]["day_of_year"].get<double>(), kAnchors[i].dayOfYear);
  }
  // Text is written to the millisecond: a time that rounds up to the next day, or week, shows that day.
  const nlohmann::json carried = runJson({"time", "from-gps"}, "0,86399.9996\n0,604799.9999\n2000,59.9996\n");
  ASSERT_EQ(carried.size(), 3u);
  EXPECT_EQ(carried[0]["time"].get<std::string>(), "1980-01-07T00:00:00.000");
  EXPECT_EQ(carried[1]["time"].get<std::string>(), "1980-01-13T00:00:00.000");
  EXPECT_EQ(carried[1]["day_of_year"].get<double>(), 13);
  EXPECT_EQ(carried[2]["time"].get<std::string>(), "2018-05-06T00:01:00.000");
}

// Calendar text -> GPS -> the same text, every 97th day from the epoch to the end of 2099 (the library's
// own tests cover every day), with a millisecond time of day that changes from row to row.
TEST(TimeVerbs, RoundTripOverTheWholeRange) {
  std::string times;
  std::vector<std::string> expected;
  for (long long millisSinceEpoch = 0; millisSinceEpoch < 3786480000000LL; millisSinceEpoch += 97 * 86400000LL + 7919) {
    const long long days = millisSinceEpoch / 86400000 + 3657;  // days since 1970-01-01
    const std::time_t seconds = static_cast<std::time_t>(days * 86400 + millisSinceEpoch % 86400000 / 1000);
    std::tm utc{};
    gmtime_r(&seconds, &utc);
    char text[40];
    std::snprintf(text, sizeof text, "%04d-%02d-%02dT%02d:%02d:%02d.%03lld", utc.tm_year + 1900, utc.tm_mon + 1,
                  utc.tm_mday, utc.tm_hour, utc.tm_min, utc.tm_sec, millisSinceEpoch % 1000);
    times += std::string(text) + "\n";
    expected.emplace_back(text);
  }
  const nlohmann::json gps = runJson({"time", "to-gps"}, times);
  ASSERT_EQ(gps.size(), expected.size());
  std::string gpsRows;
  for (const auto& g : gps) {
    char text[64];
    std::snprintf(text, sizeof text, "%.0f,%.17g\n", g["week"].get<double>(), g["seconds_of_week"].get<double>());
    gpsRows += text;
  }
  const nlohmann::json back = runJson({"time", "from-gps"}, gpsRows);
  ASSERT_EQ(back.size(), expected.size());
  for (std::size_t i = 0; i < expected.size(); ++i) EXPECT_EQ(back[i]["time"].get<std::string>(), expected[i]);
}

}  // namespace
