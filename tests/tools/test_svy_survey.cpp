// svy geo inverse/direct, localize and resect on the shipped examples: round trips between verbs, the
// flagged blunder of the example control, and bad rows.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svy_runner.h"

namespace {

using svy_test::csvRow;
using svy_test::examplesPath;
using svy_test::runJson;
using svy_test::runSvy;
using svy_test::SvyResult;

// Each example pair's inverse fed to the direct problem lands on the second point (1e-9 degree is 0.1 mm),
// and arrives with the forward azimuth the inverse gave.
TEST(SvyGeodesic, InverseThenDirectReturnsToTheSecondPoint) {
  const nlohmann::json pairs = runJson({"geo", "inverse", examplesPath("geodesic_pairs.csv")});
  ASSERT_EQ(pairs.size(), 4u);
  const double input[][4] = {
      {47.3769, 8.5417, 47.3770, 8.5430}, {-33.8568, 151.2153, 51.5007, -0.1246}, {0.5, 10, -0.4, -170.4}, {60, 30, 70, -150}};
  for (size_t i = 0; i < pairs.size(); ++i) {
    const nlohmann::json& p = pairs[i];
    const nlohmann::json end = runJson({"geo", "direct"}, csvRow({input[i][0], input[i][1], p["azimuth1_deg"].get<double>(),
                                                                  p["distance"].get<double>()}))[0];
    EXPECT_NEAR(end["lat_deg"].get<double>(), input[i][2], 1e-9) << i;
    EXPECT_NEAR(std::remainder(end["lon_deg"].get<double>() - input[i][3], 360.0), 0.0, 1e-9) << i;
    EXPECT_NEAR(std::remainder(end["azimuth2_deg"].get<double>() - p["azimuth2_deg"].get<double>(), 360.0), 0.0, 1e-7);
  }
  EXPECT_EQ(runJson({"geo", "direct", examplesPath("geodesic_shots.csv")}).size(), 3u);
  const SvyResult bad = runSvy({"geo", "inverse"}, "0,0,1,1\n95,0,0,0\n");
  EXPECT_EQ(bad.exitStatus, 1);
  EXPECT_EQ(bad.lines().size(), 2u);
  EXPECT_NE(bad.err.find("line 2: latitude must lie within"), std::string::npos) << bad.err;
}

// Grid/ground: distances from the base scale by the combined factor (here from the site: 0.9996 times the
// height factor of 450 m, about 70.6 ppm), and grid-to-ground returns the ground points. Helmert: the
// published WGS 72 to WGS 84 example, and back with --inverse.
TEST(SvyGeoSite, GridGroundAndHelmert) {
  const std::vector<std::string> site = {"--base", "5213400,498700", "--site", "47.1,450,0.9996"};
  std::vector<std::string> args = {"--full-precision", "geo", "ground-to-grid"};
  args.insert(args.end(), site.begin(), site.end());
  args.push_back(examplesPath("ground_points.csv"));
  const SvyResult grid = runSvy(args);
  ASSERT_EQ(grid.exitStatus, 0) << grid.err;
  const std::vector<std::string> p = svy_test::split(grid.lines()[2], ',');
  const double factor = std::hypot(std::stod(p[0]) - 5213400, std::stod(p[1]) - 498700) / std::hypot(250.2, 50.9);
  EXPECT_NEAR(factor, 0.9996 * (1 - 450.0 / 6.3787e6), 2e-7);
  args = {"--full-precision", "geo", "grid-to-ground"};
  args.insert(args.end(), site.begin(), site.end());
  const std::vector<std::string> back = svy_test::split(runSvy(args, grid.out).lines()[3], ',');
  EXPECT_NEAR(std::stod(back[0]), 5213480.7, 1e-8);
  EXPECT_NEAR(std::stod(back[1]), 499110.3, 1e-8);
  EXPECT_EQ(runSvy({"geo", "ground-to-grid", "--base", "0,0"}, "1,1\n").exitStatus, 2);
  const nlohmann::json wgs84 =
      runJson({"geo", "helmert", "--params", "0,0,4.5,0,0,0.554,0.219", examplesPath("frame_points.csv")})[0];
  EXPECT_NEAR(wgs84["x"].get<double>(), 3657660.78, 0.006);
  EXPECT_NEAR(wgs84["y"].get<double>(), 255778.43, 0.006);
  EXPECT_NEAR(wgs84["z"].get<double>(), 5201387.75, 0.006);
  const nlohmann::json wgs72 = runJson({"geo", "helmert", "--params", "0,0,4.5,0,0,0.554,0.219", "--inverse"},
                                       csvRow({wgs84["x"].get<double>(), wgs84["y"].get<double>(), wgs84["z"].get<double>()}))[0];
  EXPECT_NEAR(wgs72["x"].get<double>(), 3657660.66, 1e-8);
  EXPECT_NEAR(wgs72["z"].get<double>(), 5201382.11, 1e-8);
}

// The example control: the fit's transformation applied to the site points and back; the blunder C4 is the
// one point flagged; too few points fail with a message.
TEST(SvyLocalize, FitApplyAndBackWithTheBlunderFlagged) {
  const nlohmann::json fit = runJson({"localize", "fit", examplesPath("site_control.csv")})[0];
  const nlohmann::json residuals = runJson({"localize", "fit", "--residuals", examplesPath("site_control.csv")});
  ASSERT_EQ(residuals.size(), 6u);
  for (const nlohmann::json& r : residuals)
    EXPECT_EQ(r["flag"].get<std::string>(), r["id"].get<std::string>() == "C4" ? "outlier" : "") << r["id"];
  const auto text = [&fit](const char* key) {
    const std::string row = csvRow({fit[key].get<double>()});
    return row.substr(0, row.size() - 1);
  };
  const std::vector<std::string> transform = {"--scale", text("scale"), "--rotation", text("rotation_deg"),
                                              "--shift", text("shift_n") + "," + text("shift_e")};
  std::vector<std::string> apply = {"--full-precision", "localize", "apply"};
  apply.insert(apply.end(), transform.begin(), transform.end());
  const SvyResult there = runSvy(apply, "n,e\n1000,2000\n1500.25,1700.75\n");
  ASSERT_EQ(there.exitStatus, 0) << there.err;
  apply.push_back("--inverse");
  const SvyResult back = runSvy(apply, there.out);
  EXPECT_EQ(back.lines().size(), 3u);
  const std::vector<std::string> first = svy_test::split(back.lines()[2], ',');
  EXPECT_NEAR(std::stod(first[0]), 1500.25, 1e-9);
  EXPECT_NEAR(std::stod(first[1]), 1700.75, 1e-9);
  const SvyResult few = runSvy({"localize", "fit"}, "A,0,0,10,10\nB,x,0,1,1\n");
  EXPECT_EQ(few.exitStatus, 1);
  EXPECT_NE(few.err.find("line 2: n_from: 'x' is not a number"), std::string::npos) << few.err;
  EXPECT_NE(few.err.find("at least two control points"), std::string::npos) << few.err;
}

// The example setup was generated from the station N 5213400, E 498700, H 412.35, orientation 37 degrees,
// with millimetre-level noise: the result lies within three of its stated standard deviations. A bad row
// is reported and the others still solve; without the instrument height the command is refused.
TEST(SvyResect, ExampleSetupGivesItsStationBack) {
  const nlohmann::json r = runJson({"resect", "--instrument-height", "1.55", examplesPath("resection.csv")})[0];
  const double truth[][2] = {{5213400.0, r["sd_n"].get<double>()}, {498700.0, r["sd_e"].get<double>()},
                             {412.35, r["sd_h"].get<double>()}};
  const char* keys[] = {"n", "e", "h"};
  for (int k = 0; k < 3; ++k) {
    EXPECT_GT(truth[k][1], 0.0);
    EXPECT_LT(std::fabs(r[keys[k]].get<double>() - truth[k][0]), 3.0 * truth[k][1]) << keys[k];
  }
  EXPECT_NEAR(r["orientation_deg"].get<double>(), 37.0, 1e-3);
  const std::string rows = svy_test::readWhole(examplesPath("resection.csv"));
  const SvyResult bad = runSvy({"resect", "--instrument-height", "1.55"}, rows + "P5,1,2,3,x,,,\n");
  EXPECT_EQ(bad.exitStatus, 1);
  EXPECT_EQ(bad.lines().size(), 2u);
  EXPECT_NE(bad.err.find("line 8: hz_deg: 'x' is not a number"), std::string::npos) << bad.err;
  EXPECT_EQ(runSvy({"resect"}, rows).exitStatus, 2);
  const SvyResult few = runSvy({"resect", "--instrument-height", "1.5"}, "A,100,100,10,45,,,\n");
  EXPECT_EQ(few.exitStatus, 1);
  EXPECT_NE(few.err.find("too few observations"), std::string::npos) << few.err;
}

}  // namespace
