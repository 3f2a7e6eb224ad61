// svy geo to-ecef, to-geodetic and enu: published worked examples and the round trip between the first two.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svy_runner.h"

namespace {

using svy_test::csvRow;
using svy_test::runJson;

// Published worked examples: 53 deg 48' 33.820" N, 2 deg 07' 46.380" E, 73 m to geocentric, and that point
// about the origin 55 N, 5 E, 200 m to topocentric. The values are given to the millimetre on an ellipsoid
// within 0.4 mm of the library's; azimuth and elevation follow from east, north, up and the distance.
TEST(GeoVerbs, PublishedWorkedExamples) {
  const nlohmann::json ecef = runJson(
      {"geo", "to-ecef"}, csvRow({53.0 + 48.0 / 60.0 + 33.820 / 3600.0, 2.0 + 7.0 / 60.0 + 46.380 / 3600.0, 73}));
  const double xyz[] = {3771793.968, 140253.342, 5124304.349};
  const char* axes[] = {"x", "y", "z"};
  for (int i = 0; i < 3; ++i) EXPECT_NEAR(ecef.at(0)[axes[i]].get<double>(), xyz[i], 1.5e-3) << axes[i];

  const nlohmann::json r = runJson({"geo", "enu", "--origin", "55,5,200"}, csvRow({xyz[0], xyz[1], xyz[2]})).at(0);
  const double east = r["east"].get<double>(), north = r["north"].get<double>(), up = r["up"].get<double>();
  EXPECT_NEAR(east, -189013.869, 1.5e-3);
  EXPECT_NEAR(north, -128642.040, 1.5e-3);
  EXPECT_NEAR(up, -4220.171, 1.5e-3);
  const double distance = std::sqrt(std::pow(xyz[0] - 3652755.3058, 2) + std::pow(xyz[1] - 319574.6799, 2) +
                                    std::pow(xyz[2] - 5201547.3536, 2));
  EXPECT_NEAR(r["distance"].get<double>(), distance, 1.5e-3);
  EXPECT_NEAR(r["azimuth_deg"].get<double>(), 180.0 + std::atan2(-east, -north) * 180.0 / M_PI, 1e-9);
  EXPECT_NEAR(r["elevation_deg"].get<double>(), std::asin(up / distance) * 180.0 / M_PI, 1e-9);

  // A point at the origin has no direction.
  const nlohmann::json o = runJson({"geo", "to-ecef"}, "-33.5,151.25,20\n").at(0);
  const nlohmann::json atOrigin = runJson({"geo", "enu", "--origin", "-33.5,151.25,20"},
                                          csvRow({o["x"].get<double>(), o["y"].get<double>(), o["z"].get<double>()}));
  EXPECT_TRUE(atOrigin.at(0)["azimuth_deg"].is_null());
  EXPECT_TRUE(atOrigin.at(0)["elevation_deg"].is_null());
  EXPECT_NEAR(atOrigin.at(0)["distance"].get<double>(), 0.0, 1e-8);
}

// Geodetic -> Cartesian -> geodetic through both verbs; longitudes come back in (-180, 180].
TEST(GeoVerbs, RoundTripThroughBothVerbs) {
  const std::vector<std::vector<double>> points = {{0, 0, 0},          {53.8, 2.13, 73},    {-33.86, 151.21, 58},
                                                   {40.7, -74.0, 10},  {-45, -179.9999, 5}, {12, 180, 100},
                                                   {89.9999, 45, 2e3}, {-89.5, -120, -400}, {27.98, 86.92, 8848.86},
                                                   {0, -90, 2.02e7},   {10, -180, 0}};
  std::string input;
  for (const auto& p : points) input += csvRow({p[0], p[1], p[2]});
  std::string xyz;
  for (const auto& row : runJson({"geo", "to-ecef"}, input)) {
    xyz += csvRow({row["x"].get<double>(), row["y"].get<double>(), row["z"].get<double>()});
  }
  const nlohmann::json back = runJson({"geo", "to-geodetic"}, xyz);
  ASSERT_EQ(back.size(), points.size());
  for (std::size_t i = 0; i < points.size(); ++i) {
    // 1e-10 degree is 0.01 mm; the latitude iteration leaves a few micrometres.
    EXPECT_NEAR(back[i]["lat_deg"].get<double>(), points[i][0], 1e-10) << i;
    EXPECT_NEAR(back[i]["lon_deg"].get<double>(), points[i][1] == -180.0 ? 180.0 : points[i][1], 1e-9) << i;
    EXPECT_NEAR(back[i]["h"].get<double>(), points[i][2], 1e-5) << i;
  }
}

}  // namespace
