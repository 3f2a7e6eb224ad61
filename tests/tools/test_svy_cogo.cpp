// svy cogo intersect, perpendicular and tangents, and svy traverse adjust: closed-form rows in the documented
// order (the geometry itself is tested in the library's tests), line-numbered errors beside good rows, the
// JSON object of a traverse, and the shipped examples.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <utility>
#include <vector>

#include "svy_runner.h"

namespace {

using svy_test::csvRow;
using svy_test::examplesPath;
using svy_test::runJson;
using svy_test::runSvy;

// One row per verb with answers in closed form: the column order, the numbering of the solutions and their
// order (bd: along the bearing; dd: right of 1 -> 2 first; tangents: right of the centre line first).
TEST(CogoVerbs, ClosedFormRowsInTheDocumentedColumnsAndOrder) {
  struct { std::vector<std::string> args; const char* row; std::vector<std::string> lines; } const cases[] = {
      {{"intersect", "--mode", "bb"}, "0,0,45,0,100,315\n", {"solution,n,e", "1,50.0000,50.0000"}},
      // 50 -+ sqrt(20^2 - 10^2) along the easting.
      {{"intersect", "--mode", "bd"}, "0,0,90,10,50,20\n", {"solution,n,e", "1,0.0000,32.6795", "2,0.0000,67.3205"}},
      // The chord lies (80^2 + 50^2 - 40^2) / 160 = 45.625 along the base, sqrt(50^2 - 45.625^2) either side.
      {{"intersect", "--mode", "dd"}, "0,0,50,0,80,40\n", {"solution,n,e", "1,-20.4538,45.6250", "2,20.4538,45.6250"}},
      {{"perpendicular"}, "0,0,100,0,30,4\n", {"along,offset,foot_n,foot_e", "30.0000,4.0000,30.0000,0.0000"}},
      // From a point 100 m from the centre of a circle of radius 60, the tangents are 80 m long (3-4-5).
      {{"tangents"}, "0,0,0,100,0,60\n", {"tangent,n_a,e_a,n_b,e_b", "1,0.0000,0.0000,64.0000,48.0000",
                                            "2,0.0000,0.0000,64.0000,-48.0000"}}};
  for (const auto& c : cases) {
    std::vector<std::string> args{"cogo"};
    args.insert(args.end(), c.args.begin(), c.args.end());
    const svy_test::SvyResult r = runSvy(args, c.row);
    EXPECT_EQ(r.exitStatus, 0) << r.err;
    EXPECT_EQ(r.lines(), c.lines) << c.args[0];
  }
  // Circles apart, touching outside, crossing and touching inside have 4, 3, 2 and 1 common tangents.
  const std::pair<double, std::size_t> counts[] = {{100, 4}, {50, 3}, {40, 2}, {10, 1}};
  for (const auto& [apart, count] : counts)
    EXPECT_EQ(runJson({"cogo", "tangents"}, csvRow({5000000, 500000, 30, 5000000, 500000 + apart, 20})).size(), count);
}

TEST(CogoIntersect, NoSolutionRowsAreReportedByLineAndTheOthersStillComeOut) {
  struct { const char* mode; std::string rows; const char* message; } const cases[] = {
      {"bb", "0,0,45,0,100,315\n0,0,45,10,0,225\n", "svy: line 2: the bearings are parallel"},
      {"bd", "0,0,90,10,50,20\n0,0,90,10,50,5\n", "svy: line 2: the bearing passes farther than the distance from point 2"},
      {"dd", "0,0,50,0,80,40\n0,0,10,0,80,40\n", "svy: line 2: the circles do not meet"},
      {"dd", "0,0,50,0,80,40\n0,0,10,0,0,40\n", "svy: line 2: the centres coincide"}};
  for (const auto& c : cases) {
    const svy_test::SvyResult r = runSvy({"cogo", "intersect", "--mode", c.mode}, c.rows);
    EXPECT_EQ(r.exitStatus, 1);
    EXPECT_EQ(r.errLines(), std::vector<std::string>{c.message});
    EXPECT_GE(r.lines().size(), 2u);
    EXPECT_EQ(r.lines()[1].substr(0, 2), "1,");
  }
}

// The square loop booked 100.03 N, 100 E, 100 S, 99.97 W misses by (0.03, 0.03): compass corrections follow
// the distance run, and the last point is the start again exactly.
TEST(TraverseAdjust, JsonObjectWithMisclosureAndPointsEndingOnTheKnownEnd) {
  const std::string legs = "azimuth_deg,distance\n0,100.03\n90,100\n180,100\n270,99.97\n";
  const nlohmann::json r = runJson({"traverse", "adjust", "--rule", "compass", "--start", "5000000,500000",
                                    "--end", "5000000,500000"}, legs);
  EXPECT_NEAR(r["misclosure"]["n"].get<double>(), 0.03, 1e-9);
  EXPECT_NEAR(r["misclosure"]["linear"].get<double>(), 0.03 * std::sqrt(2.0), 1e-9);
  EXPECT_NEAR(r["misclosure"]["precision"].get<double>(), 400 / (0.03 * std::sqrt(2.0)), 1e-6);
  const nlohmann::json& points = r["points"];
  ASSERT_EQ(points.size(), 4u);
  const double run[] = {100.03, 200.03, 300.03, 400};
  for (int i = 0; i < 4; ++i) EXPECT_NEAR(points[i]["correction_e"].get<double>(), -0.03 * run[i] / 400, 1e-9);
  EXPECT_EQ(points[3]["n"].get<double>(), 5000000.0);
  EXPECT_EQ(points[3]["e"].get<double>(), 500000.0);
  // A missing leg stops the adjustment: the bad row is reported and no point is written.
  const svy_test::SvyResult bad = runSvy({"traverse", "adjust", "--start", "0,0"}, "0,100\n90,x\n");
  EXPECT_EQ(bad.exitStatus, 1);
  EXPECT_EQ(bad.lines(), std::vector<std::string>{"point,n,e,correction_n,correction_e"});
  EXPECT_EQ(bad.errLines().at(0), "svy: line 2: distance: 'x' is not a number");
}

TEST(SvyExamples, TheCogoAndTraverseSamplesAnswer) {
  const std::vector<std::vector<std::string>> runs = {
      {"cogo", "intersect", "--mode", "bb", examplesPath("intersect_bearings.csv")},
      {"cogo", "intersect", "--mode", "bd", examplesPath("intersect_bearing_distance.csv")},
      {"cogo", "intersect", "--mode", "dd", examplesPath("intersect_distances.csv")},
      {"cogo", "perpendicular", examplesPath("perpendicular_offsets.csv")},
      {"cogo", "tangents", examplesPath("circle_tangents.csv")},
      {"traverse", "adjust", "--rule", "transit", "--start", "5000,2000", examplesPath("traverse_parcel12_legs.csv")}};
  for (const auto& args : runs) {
    const svy_test::SvyResult r = runSvy(args);
    EXPECT_EQ(r.exitStatus, 0) << args[1] << ": " << r.err;
    EXPECT_GE(r.lines().size(), 3u) << args[1];
  }
  // The parcel traverse closes on station 1 and was booked to about 1:77 000.
  const nlohmann::json parcel = runJson({"traverse", "adjust", "--start", "5000,2000", examplesPath("traverse_parcel12_legs.csv")});
  EXPECT_GT(parcel["misclosure"]["precision"].get<double>(), 50000);
  EXPECT_EQ(parcel["points"].back()["n"].get<double>(), 5000.0);
}

}  // namespace
