// svy area: the sample parcel's area against its closed form, subdivisions whose pieces read back into
// svy area with the requested area, the JSON shape, and the one-line errors.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svy_runner.h"

namespace {

using svy_test::runSvy;

constexpr double kPi = 3.14159265358979323846;

// Circular segment and arc length of a minor arc of radius r on chord c.
double segmentArea(double r, double c) {
  const double angle = 2 * std::asin(c / (2 * r));
  return 0.5 * r * r * (angle - std::sin(angle));
}
double arcLength(double r, double c) { return 2 * r * std::asin(c / (2 * r)); }

const std::string kParcel = svy_test::examplesPath("parcel_with_arcs.csv");
// 100 x 60 m, the east side bulging out (r 80), the north side in (r 40).
const double kParcelArea = 6000.0 + segmentArea(80, 100) - segmentArea(40, 60);

TEST(AreaVerb, ParcelMatchesItsClosedForm) {
  const nlohmann::json j = svy_test::runJson({"area", kParcel});
  ASSERT_EQ(j.size(), 1u);
  EXPECT_NEAR(j[0]["area"].get<double>(), kParcelArea, 1e-6);
  EXPECT_NEAR(j[0]["perimeter"].get<double>(), 160.0 + arcLength(80, 100) + arcLength(40, 60), 1e-9);
  // A disc of two half-circle rows, whichever way round.
  for (const char* d : {"cw", "ccw"}) {
    const std::string rows = std::string("0,0,5,") + d + "\n10,0,5," + d + "\n";
    EXPECT_NEAR(svy_test::runJson({"area"}, rows)[0]["area"].get<double>(), 25 * kPi, 1e-9);
  }
}

TEST(AreaVerb, SubdivisionPiecesReadBackWithTheirAreas) {
  const std::vector<std::vector<std::string>> modes = {
      {"--parallel", "0"}, {"--parallel", "35", "--side", "right"}, {"--hinge", "5000000,500060"}};
  for (const auto& mode : modes) {
    std::vector<std::string> args = {"--full-precision", "area", "subdivide", "--area", "2000", kParcel};
    args.insert(args.end(), mode.begin(), mode.end());
    const svy_test::SvyResult r = runSvy(args);
    ASSERT_EQ(r.exitStatus, 0) << r.err;
    // Rows part,area,vertex,n,e,radius,direction: the piece's rows are the input form of svy area.
    std::string piece;
    for (const std::string& line : r.lines()) {
      const std::vector<std::string> f = svy_test::splitCsvLine(line);
      if (f[0] == "piece") piece += f[3] + "," + f[4] + "," + f[5] + "," + f[6] + "\n";
    }
    const nlohmann::json back = svy_test::runJson({"area"}, piece);
    EXPECT_NEAR(back[0]["area"].get<double>(), 2000.0, 1.5e-3) << mode[0];

    args.insert(args.begin(), "--json");
    const nlohmann::json j = nlohmann::json::parse(runSvy(args).out, nullptr, false);
    ASSERT_TRUE(j.is_object());
    EXPECT_EQ(j["cut"].size(), 2u);
    EXPECT_NEAR(j["piece"]["area"].get<double>() + j["rest"]["area"].get<double>(), kParcelArea, 2e-3);
    for (const auto& arc : j["rest"].value("arcs", nlohmann::json::array())) {
      EXPECT_LT(arc["from"].get<std::size_t>(), j["rest"]["vertices"].size());
      EXPECT_TRUE(arc["direction"] == "cw" || arc["direction"] == "ccw");
    }
  }
}

TEST(AreaVerb, ErrorsAreOneLine) {
  const struct {
    std::vector<std::string> args;
    std::string input;
    int status;
    std::string message;
  } cases[] = {
      {{"area"}, "0,0\n0,10\nx,3\n10,10\n10,0\n", 1, "svy: line 3: n and e must be numbers"},
      {{"area"}, "0,0\n0,10,2,cw\n10,10\n", 1, "svy: line 2: no arc of radius 2.0000 reaches the next vertex"},
      {{"area"}, "0,0\n0,10\n10,0\n10,10\n", 1, "svy: the boundary crosses itself"},
      {{"area"}, "0,0\n0,10\n", 1, "svy: a boundary needs three vertices, or two with an arc"},
      {{"area"}, "0,0,5\n10,0\n5,5\n0,5\n", 1, "svy: line 1: direction: expected cw or ccw after a radius"},
      {{"area", "subdivide", "--area", "101", "--parallel", "0"}, "0,0\n0,10\n10,10\n10,0\n", 1,
       "svy: the requested area exceeds the boundary's area"},
      {{"area", "subdivide", "--area", "10", "--hinge", "5,5"}, "0,0\n0,10\n10,10\n10,0\n", 1,
       "svy: the hinge point is not on the boundary"},
      {{"area", "subdivide", "--area", "10"}, "0,0\n0,10\n10,10\n", 2, "svy: give --parallel AZ_DEG or --hinge N,E"},
  };
  for (const auto& c : cases) {
    const svy_test::SvyResult r = runSvy(c.args, c.input);
    EXPECT_EQ(r.exitStatus, c.status) << c.message;
    EXPECT_EQ(r.errLines(), std::vector<std::string>{c.message});
  }
}

}  // namespace
