// The sample data shipped in examples/ runs through its verbs without a bad row.
#include "svy_runner.h"

#include "svymath/foundation/constants.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <string>
#include <vector>

namespace {

using svy_test::examplesPath;
using svy_test::runSvy;

TEST(SvyExamples, SampleTraverseCloses) {
  const svy_test::SvyResult r =
      runSvy({"--json", "--full-precision", "cogo", "inverse", examplesPath("traverse_legs.csv")});
  ASSERT_EQ(r.exitStatus, 0) << r.err;
  const nlohmann::json legs = nlohmann::json::parse(r.out);
  ASSERT_EQ(legs.size(), 5u);
  // Summing the legs as vectors from their azimuths and distances returns to the start.
  double north = 0.0;
  double east = 0.0;
  for (const auto& leg : legs) {
    const double azimuth = leg["azimuth_deg"].get<double>() * svy_math::units::kDegToRad;
    north += leg["distance"].get<double>() * std::cos(azimuth);
    east += leg["distance"].get<double>() * std::sin(azimuth);
  }
  EXPECT_NEAR(north, 0.0, 1e-9);
  EXPECT_NEAR(east, 0.0, 1e-9);
}

TEST(SvyExamples, EverySampleFileReadsWithoutBadRows) {
  const std::vector<std::vector<std::string>> runs = {
      {"cogo", "radiate", examplesPath("traverse_radiate.csv")},
      {"station", "format", "--interval", "1000", examplesPath("chainages.csv")},
      {"station", "parse", "--interval", "1000", examplesPath("stations.csv")},
      {"angle", "convert", "--from", "dms", "--to", "deg", examplesPath("angles_dms.csv")}};
  for (const auto& args : runs) {
    const svy_test::SvyResult r = runSvy(args);
    EXPECT_EQ(r.exitStatus, 0) << args[0] << ' ' << args[1] << ": " << r.err;
    EXPECT_EQ(r.err, "");
    EXPECT_GT(r.lines().size(), 3u) << args[0] << ' ' << args[1];
  }
}

}  // namespace
