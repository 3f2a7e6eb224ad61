// svy geo to-ecef, to-geodetic and enu: published worked examples, the round trip between the first two
// verbs, and the reporting of rows that give no result.
#include "svy_runner.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <sstream>
#include <string>
#include <vector>

namespace {

using svy_test::runSvy;

nlohmann::json runJson(const std::vector<std::string>& args, const std::string& input) {
  std::vector<std::string> all = {"--json", "--full-precision"};
  all.insert(all.end(), args.begin(), args.end());
  const svy_test::SvyResult r = runSvy(all, input);
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  return nlohmann::json::parse(r.out);
}

// Published worked example (geographic to geocentric): 53 deg 48' 33.820" N, 2 deg 07' 46.380" E, 73 m.
// The values are given to the millimetre on an ellipsoid within 0.4 mm of the library's.
TEST(GeoToEcef, PublishedWorkedExample) {
  std::ostringstream row;
  row.precision(17);
  row << 53.0 + 48.0 / 60.0 + 33.820 / 3600.0 << ',' << 2.0 + 7.0 / 60.0 + 46.380 / 3600.0 << ",73\n";
  const nlohmann::json rows = runJson({"geo", "to-ecef"}, row.str());
  ASSERT_EQ(rows.size(), 1u);
  EXPECT_NEAR(rows[0]["x"].get<double>(), 3771793.968, 1.5e-3);
  EXPECT_NEAR(rows[0]["y"].get<double>(), 140253.342, 1.5e-3);
  EXPECT_NEAR(rows[0]["z"].get<double>(), 5124304.349, 1.5e-3);
}

// Geodetic -> Cartesian -> geodetic through both verbs; longitudes come back in (-180, 180].
TEST(GeoToGeodetic, RoundTripThroughBothVerbs) {
  const std::vector<std::vector<double>> points = {{0, 0, 0},         {53.8, 2.13, 73},      {-33.86, 151.21, 58},
                                                   {40.7, -74.0, 10},  {-45, -179.9999, 5},   {12, 180, 100},
                                                   {89.9999, 45, 2e3}, {-89.5, -120, -400},   {27.98, 86.92, 8848.86},
                                                   {0, -90, 2.02e7}};
  std::ostringstream input;
  input.precision(17);
  for (const auto& p : points) input << p[0] << ',' << p[1] << ',' << p[2] << '\n';
  const nlohmann::json ecef = runJson({"geo", "to-ecef"}, input.str());
  ASSERT_EQ(ecef.size(), points.size());
  std::ostringstream xyz;
  xyz.precision(17);
  for (const auto& row : ecef) xyz << row["x"].get<double>() << ',' << row["y"].get<double>() << ',' << row["z"].get<double>() << '\n';
  const nlohmann::json back = runJson({"geo", "to-geodetic"}, xyz.str());
  ASSERT_EQ(back.size(), points.size());
  for (std::size_t i = 0; i < points.size(); ++i) {
    // 1e-10 degree is 0.01 mm; the latitude iteration leaves a few micrometres.
    EXPECT_NEAR(back[i]["lat_deg"].get<double>(), points[i][0], 1e-10) << i;
    const double expectedLon = points[i][1] == -180.0 ? 180.0 : points[i][1];
    EXPECT_NEAR(back[i]["lon_deg"].get<double>(), expectedLon, 1e-9) << i;
    EXPECT_GT(back[i]["lon_deg"].get<double>(), -180.0);
    EXPECT_LE(back[i]["lon_deg"].get<double>(), 180.0);
    EXPECT_NEAR(back[i]["h"].get<double>(), points[i][2], 1e-5) << i;
  }
}

// Published worked example (geocentric to topocentric) about the origin 55 N, 5 E, 200 m; the azimuth,
// elevation and distance follow from east, north, up and the straight-line distance.
TEST(GeoEnu, PublishedWorkedExampleWithPolarForm) {
  const double x = 3771793.968, y = 140253.342, z = 5124304.349;
  const double x0 = 3652755.3058, y0 = 319574.6799, z0 = 5201547.3536;
  std::ostringstream input;
  input.precision(17);
  input << x << ',' << y << ',' << z << '\n';
  const nlohmann::json rows = runJson({"geo", "enu", "--origin", "55,5,200"}, input.str());
  ASSERT_EQ(rows.size(), 1u);
  const double east = rows[0]["east"].get<double>(), north = rows[0]["north"].get<double>(),
               up = rows[0]["up"].get<double>();
  EXPECT_NEAR(east, -189013.869, 1.5e-3);
  EXPECT_NEAR(north, -128642.040, 1.5e-3);
  EXPECT_NEAR(up, -4220.171, 1.5e-3);
  const double distance = std::sqrt((x - x0) * (x - x0) + (y - y0) * (y - y0) + (z - z0) * (z - z0));
  // The verb places the origin on its own ellipsoid, 0.1 mm from the published origin.
  EXPECT_NEAR(rows[0]["distance"].get<double>(), distance, 1.5e-3);
  EXPECT_NEAR(rows[0]["azimuth_deg"].get<double>(), 180.0 + std::atan2(-east, -north) * 180.0 / M_PI, 1e-9);
  EXPECT_NEAR(rows[0]["elevation_deg"].get<double>(), std::asin(up / distance) * 180.0 / M_PI, 1e-9);
}

TEST(GeoEnu, PointAtTheOriginHasNoDirection) {
  const nlohmann::json ecef = runJson({"geo", "to-ecef"}, "-33.5,151.25,20\n");
  std::ostringstream input;
  input.precision(17);
  input << ecef[0]["x"].get<double>() << ',' << ecef[0]["y"].get<double>() << ',' << ecef[0]["z"].get<double>() << '\n';
  const nlohmann::json rows = runJson({"geo", "enu", "--origin", "-33.5,151.25,20"}, input.str());
  ASSERT_EQ(rows.size(), 1u);
  EXPECT_TRUE(rows[0]["azimuth_deg"].is_null());
  EXPECT_TRUE(rows[0]["elevation_deg"].is_null());
  EXPECT_NEAR(rows[0]["distance"].get<double>(), 0.0, 1e-8);
}

TEST(GeoVerbs, BadRowsAreReportedAndGoodRowsStillWritten) {
  const svy_test::SvyResult r = runSvy({"geo", "to-ecef"}, "10,20,30\n91,0,0\n-10,-20,-30\n");
  EXPECT_EQ(r.exitStatus, 1);
  EXPECT_EQ(r.lines().size(), 3u) << r.out;
  ASSERT_EQ(r.errLines().size(), 1u);
  EXPECT_EQ(r.errLines()[0], "svy: line 2: latitude must lie within -90 to 90 degrees");
}

TEST(GeoVerbs, OriginMustBeThreeNumbersWithALatitude) {
  for (const char* origin : {"55,5", "55,5,x", "95,5,0", ""}) {
    const svy_test::SvyResult r = runSvy({"geo", "enu", "--origin", origin}, "1,2,3\n");
    EXPECT_EQ(r.exitStatus, 2) << origin;
    EXPECT_NE(r.err.find("--origin"), std::string::npos) << r.err;
  }
  EXPECT_EQ(runSvy({"geo", "enu"}, "1,2,3\n").exitStatus, 2);
}

}  // namespace
