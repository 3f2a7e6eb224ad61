// svy cogo intersect, perpendicular and tangents, and svy traverse adjust: answers checked on their loci,
// the documented order of solutions, line-numbered errors beside good rows, the JSON object of a traverse,
// and the shipped examples.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svy_runner.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::units::kDegToRad;
using svy_test::csvRow;
using svy_test::examplesPath;
using svy_test::runJson;
using svy_test::runSvy;

double distanceTo(const nlohmann::json& p, double n, double e, const char* nKey = "n", const char* eKey = "e") {
  return std::hypot(p[nKey].get<double>() - n, p[eKey].get<double>() - e);
}

// Signed offset of (n, e) from the line through (n0, e0) along azimuthDeg, positive to the right.
double offsetFrom(double n0, double e0, double azimuthDeg, double n, double e) {
  const double a = azimuthDeg * kDegToRad;
  return std::cos(a) * (e - e0) - std::sin(a) * (n - n0);
}

TEST(CogoIntersect, EveryModeOnBothLociInTheDocumentedOrder) {
  const double n1 = 5000000, e1 = 500000, n2 = 5000040, e2 = 500090;
  const nlohmann::json bb = runJson({"cogo", "intersect", "--mode", "bb"}, csvRow({n1, e1, 30, n2, e2, 300}));
  ASSERT_EQ(bb.size(), 1u);
  EXPECT_NEAR(offsetFrom(n1, e1, 30, bb[0]["n"], bb[0]["e"]), 0.0, 1e-8);
  EXPECT_NEAR(offsetFrom(n2, e2, 300, bb[0]["n"], bb[0]["e"]), 0.0, 1e-8);

  const nlohmann::json bd = runJson({"cogo", "intersect", "--mode", "bd"}, csvRow({n1, e1, 60, n2, e2, 50}));
  ASSERT_EQ(bd.size(), 2u);
  double previousAlong = -1e9;
  for (int i = 0; i < 2; ++i) {
    EXPECT_EQ(bd[i]["solution"], i + 1);
    EXPECT_NEAR(offsetFrom(n1, e1, 60, bd[i]["n"], bd[i]["e"]), 0.0, 1e-8);
    EXPECT_NEAR(distanceTo(bd[i], n2, e2), 50, 1e-8);
    const double along = distanceTo(bd[i], n1, e1);
    EXPECT_GT(along, previousAlong);
    previousAlong = along;
  }

  const nlohmann::json dd = runJson({"cogo", "intersect", "--mode", "dd"}, csvRow({n1, e1, 70, n2, e2, 60}));
  ASSERT_EQ(dd.size(), 2u);
  const double baseAz = std::atan2(e2 - e1, n2 - n1) / kDegToRad;
  for (int i = 0; i < 2; ++i) {
    EXPECT_NEAR(distanceTo(dd[i], n1, e1), 70, 1e-8);
    EXPECT_NEAR(distanceTo(dd[i], n2, e2), 60, 1e-8);
    EXPECT_EQ(offsetFrom(n1, e1, baseAz, dd[i]["n"], dd[i]["e"]) > 0, i == 0);
  }
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

// The point built at (along, offset) from the line comes back, foot included.
TEST(CogoPerpendicular, AlongAndOffsetRightOfTheLine) {
  const double n1 = 5000000, e1 = 500000, az = 123.4 * kDegToRad;
  const double n2 = n1 + 250 * std::cos(az), e2 = e1 + 250 * std::sin(az);
  for (const auto& [along, offset] : std::vector<std::pair<double, double>>{{100, 12.5}, {-20, -7}, {300, 0}}) {
    const double fn = n1 + along * std::cos(az), fe = e1 + along * std::sin(az);
    const double n = fn - offset * std::sin(az), e = fe + offset * std::cos(az);
    const nlohmann::json r = runJson({"cogo", "perpendicular"}, csvRow({n1, e1, n2, e2, n, e}));
    EXPECT_NEAR(r[0]["along"].get<double>(), along, 1e-9);
    EXPECT_NEAR(r[0]["offset"].get<double>(), offset, 1e-9);
    EXPECT_NEAR(distanceTo(r[0], fn, fe, "foot_n", "foot_e"), 0.0, 1e-9);
  }
}

// Tangents touch both circles; their number follows the circles' placement.
TEST(CogoTangents, CountsByPlacementAndTouchingPointsOnTheCircles) {
  const std::pair<double, std::size_t> cases[] = {{100, 4}, {50, 3}, {40, 2}, {10, 1}};
  for (const auto& [apart, count] : cases) {
    const nlohmann::json r = runJson({"cogo", "tangents"}, csvRow({5000000, 500000, 30, 5000000, 500000 + apart, 20}));
    ASSERT_EQ(r.size(), count) << apart;
    for (const auto& t : r) {
      EXPECT_NEAR(distanceTo(t, 5000000, 500000, "n_a", "e_a"), 30, 1e-9);
      EXPECT_NEAR(distanceTo(t, 5000000, 500000 + apart, "n_b", "e_b"), 20, 1e-9);
    }
  }
  const svy_test::SvyResult inside = runSvy({"cogo", "tangents"}, "0,0,30,0,5,20\n");
  EXPECT_EQ(inside.exitStatus, 1);
  EXPECT_EQ(inside.err, "svy: line 1: no common tangent: one circle lies inside the other\n");
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
