// svy curve solve and svy spiral table: each second curve quantity solves back to the same curve, circle
// geometry, the degree-of-curve options, and spiral tables that agree with the library's spiral data.
#include "svy_runner.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svymath/curves/curve_data_spiral1r.h"
#include "svymath/curves/curve_formulas.h"

namespace {

using svy_test::runJson;
using svy_test::runSvy;
using svy_test::splitCsvLine;

nlohmann::json solve(std::vector<std::string> options) {
  options.insert(options.begin(), {"curve", "solve"});
  return runJson(options).at(0);
}

TEST(CurveSolve, EachQuantitySolvesBackToTheCurve) {
  for (const char* delta : {"12.5", "90", "151"}) {
    const nlohmann::json ref = solve({"--radius", "350", "--delta", delta});
    const std::pair<const char*, const char*> quantities[] = {
        {"--length", "length"}, {"--chord", "chord"}, {"--tangent", "tangent"}, {"--external", "external"},
        {"--mid-ordinate", "mid_ordinate"}};
    for (const auto& [option, quantity] : quantities) {
      const nlohmann::json back = solve({"--radius", "350", option, std::to_string(ref[quantity].get<double>())});
      // to_string keeps six decimals: the solved curve matches to that input precision.
      for (const auto& [column, value] : ref.items()) {
        EXPECT_NEAR(back[column].get<double>(), value.get<double>(), 1e-3) << option << ' ' << delta << ' ' << column;
      }
    }
  }
}

TEST(CurveSolve, CircleGeometryAndDegreeOfCurve) {
  const svy_test::SvyResult csv = runSvy({"curve", "solve", "--full-precision", "--radius", "100", "--delta", "90"});
  ASSERT_EQ(csv.lines().size(), 2u) << csv.err;
  EXPECT_EQ(csv.lines()[0],
            "radius,deg_curve_arc,deg_curve_chord,delta_deg,length,chord,tangent,external,mid_ordinate");
  const std::vector<std::string> v = splitCsvLine(csv.lines()[1]);
  EXPECT_DOUBLE_EQ(std::stod(v.at(6)), GetTangentFromDelta(90.0, 100.0));
  EXPECT_NEAR(std::stod(v.at(4)), 50.0 * 3.141592653589793, 1e-12);
  EXPECT_NEAR(std::stod(v.at(5)), 100.0 * std::sqrt(2.0), 1e-12);
  EXPECT_NEAR(std::stod(v.at(7)), 100.0 * (std::sqrt(2.0) - 1.0), 1e-12);

  const nlohmann::json arc = solve({"--deg-arc", "1", "--length", "100"});
  EXPECT_DOUBLE_EQ(arc["radius"].get<double>(), 5729.5779513082325);
  EXPECT_NEAR(arc["delta_deg"].get<double>(), 1.0, 1e-12);  // a 100-unit arc subtends one degree
  const nlohmann::json chord = solve({"--deg-chord", "2", "--chord", "100"});
  EXPECT_DOUBLE_EQ(chord["radius"].get<double>(), GetRadiusFromDegOfChord(2.0));
  EXPECT_NEAR(chord["delta_deg"].get<double>(), 2.0, 1e-9);  // a 100-unit chord subtends two degrees
  EXPECT_NEAR(chord["deg_curve_chord"].get<double>(), 2.0, 1e-9);
}

TEST(SpiralTable, RowsAgreeWithLibrary) {
  struct Case {
    const char* type;
    double length, radius, interval;
    bool exit;
  };
  const Case cases[] = {{"clothoid", 100.0, 300.0, 10.0, false},
                        {"clothoid", 75.0, -250.0, 20.0, false},
                        {"cubic", 100.0, 400.0, 30.0, true},
                        {"cubic", 60.0, -1000.0, 7.5, false}};
  for (const Case& c : cases) {
    SCOPED_TRACE(std::string(c.type) + " " + std::to_string(c.radius));
    std::vector<std::string> args = {"spiral", "table", "--full-precision", "--type", c.type,
                                     "--length", std::to_string(c.length), "--radius", std::to_string(c.radius),
                                     "--interval", std::to_string(c.interval)};
    if (c.exit) args.push_back("--exit");
    const std::vector<std::string> lines = runSvy(args).lines();
    ASSERT_GE(lines.size(), 3u);
    EXPECT_EQ(lines[0], "length,north,east,azimuth_deg,radius");
    // One row per whole interval, plus the start, plus the end when it is off the grid.
    const double whole = std::floor(c.length / c.interval + 1e-9);
    const bool endOnGrid = std::fabs(whole * c.interval - c.length) < 1e-9;
    EXPECT_EQ(lines.size(), static_cast<std::size_t>(whole) + (endOnGrid ? 2 : 3));
    CCurveDataSpiral1R spiral(std::string(c.type) == "cubic" ? eMathSpiralCubic : eMathSpiralEuler);
    ASSERT_TRUE(spiral.setLenAndR(c.length, c.radius, c.radius > 0.0, !c.exit));
    double previous = -1.0;
    for (std::size_t i = 1; i < lines.size(); ++i) {
      const std::vector<std::string> f = splitCsvLine(lines[i]);
      ASSERT_EQ(f.size(), 5u);
      const double s = std::stod(f[0]);
      EXPECT_GT(s, previous);
      previous = s;
      double n = 0.0, e = 0.0;
      ASSERT_TRUE(spiral.getPosAtLength(s, n, e));
      EXPECT_NEAR(std::stod(f[1]), n, 1e-12);
      EXPECT_NEAR(std::stod(f[2]), e, 1e-12);
      EXPECT_EQ(std::stod(f[2]) > 0.0, c.radius > 0.0 && s > 0.0);
      EXPECT_NEAR(std::stod(f[3]), spiral.GetAzimuth(s), 1e-12);
      const double k = spiral.getCurvatureAtLength(s);
      if (k == 0.0) {
        EXPECT_EQ(f[4], "inf");
      } else {
        EXPECT_NEAR(std::stod(f[4]), 1.0 / k, 1e-9 / std::fabs(k));
      }
    }
    EXPECT_NEAR(previous, c.length, 1e-9);
    // The curve end carries the given radius.
    EXPECT_NEAR(std::stod(splitCsvLine(c.exit ? lines[1] : lines.back())[4]), c.radius, 1e-5 * std::fabs(c.radius));
  }
}

}  // namespace
