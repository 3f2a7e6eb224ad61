// The sample data shipped in examples/ runs through its verbs without a bad row.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svy_runner.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_test::examplesPath;

TEST(SvyExamples, EverySampleFileReadsWithoutBadRowsAndTheTraverseCloses) {
  const std::vector<std::vector<std::string>> runs = {
      {"cogo", "radiate", examplesPath("traverse_radiate.csv")},
      {"station", "format", "--interval", "1000", examplesPath("chainages.csv")},
      {"station", "parse", "--interval", "1000", examplesPath("stations.csv")},
      {"angle", "convert", "--from", "dms", "--to", "deg", examplesPath("angles_dms.csv")}};
  for (const auto& args : runs) {
    const svy_test::SvyResult r = svy_test::runSvy(args);
    EXPECT_EQ(r.exitStatus, 0) << args[0] << ' ' << args[1] << ": " << r.err;
    EXPECT_EQ(r.err, "");
    EXPECT_GT(r.lines().size(), 3u) << args[0] << ' ' << args[1];
  }
  // Summing the legs as vectors from their azimuths and distances returns to the start.
  const nlohmann::json legs = svy_test::runJson({"cogo", "inverse", examplesPath("traverse_legs.csv")});
  ASSERT_EQ(legs.size(), 5u);
  double north = 0.0, east = 0.0;
  for (const auto& leg : legs) {
    const double azimuth = leg["azimuth_deg"].get<double>() * svy_math::units::kDegToRad;
    north += leg["distance"].get<double>() * std::cos(azimuth);
    east += leg["distance"].get<double>() * std::sin(azimuth);
  }
  EXPECT_NEAR(std::hypot(north, east), 0.0, 1e-9);
}

}  // namespace
