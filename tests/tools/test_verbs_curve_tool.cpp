// svy curve solve and svy spiral table: every way of giving the second curve quantity solves back to the
// same curve, the degree-of-curve options, refusals of impossible curves, and spiral tables that agree with
// the library's spiral data row by row.
#include "svy_runner.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svymath/curves/curve_data_spiral1r.h"
#include "svymath/curves/curve_formulas.h"

namespace {

using svy_test::runSvy;
using svy_test::splitCsvLine;

const std::vector<std::string> kSolveColumns = {"radius", "deg_curve_arc", "deg_curve_chord",
                                                "delta_deg", "length", "chord",
                                                "tangent", "external", "mid_ordinate"};

// The one data row of svy curve solve at full precision, as numbers.
std::vector<double> solve(const std::vector<std::string>& options) {
  std::vector<std::string> args = {"curve", "solve", "--full-precision"};
  args.insert(args.end(), options.begin(), options.end());
  const svy_test::SvyResult r = runSvy(args);
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  const std::vector<std::string> lines = r.lines();
  EXPECT_EQ(lines.size(), 2u);
  if (lines.size() != 2u) return {};
  EXPECT_EQ(splitCsvLine(lines[0]), kSolveColumns);
  std::vector<double> values;
  for (const std::string& field : splitCsvLine(lines[1])) values.push_back(std::stod(field));
  return values;
}

struct SolveCase {
  const char* option;
  int column;  // the output column holding that quantity
};

class CurveSolve : public ::testing::TestWithParam<SolveCase> {};

TEST_P(CurveSolve, EachQuantitySolvesBackToTheCurve) {
  for (const char* delta : {"12.5", "90", "151"}) {
    const std::vector<double> ref = solve({"--radius", "350", "--delta", delta});
    ASSERT_EQ(ref.size(), kSolveColumns.size());
    const std::string given = std::to_string(ref[GetParam().column]);
    const std::vector<double> back = solve({"--radius", "350", GetParam().option, given});
    ASSERT_EQ(back.size(), ref.size());
    // to_string keeps six decimals: the solved curve matches to that input precision.
    for (std::size_t i = 0; i < ref.size(); ++i) {
      EXPECT_NEAR(back[i], ref[i], 1e-3) << GetParam().option << " delta " << delta << " column " << i;
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Quantities, CurveSolve,
                         ::testing::Values(SolveCase{"--length", 4}, SolveCase{"--chord", 5},
                                           SolveCase{"--tangent", 6}, SolveCase{"--external", 7},
                                           SolveCase{"--mid-ordinate", 8}));

TEST(CurveSolve, MatchesLibraryAndCircleGeometry) {
  const std::vector<double> v = solve({"--radius", "100", "--delta", "90"});
  ASSERT_EQ(v.size(), kSolveColumns.size());
  EXPECT_DOUBLE_EQ(v[6], GetTangentFromDelta(90.0, 100.0));
  EXPECT_NEAR(v[4], 50.0 * 3.141592653589793, 1e-12);
  EXPECT_NEAR(v[5], 100.0 * std::sqrt(2.0), 1e-12);
  EXPECT_NEAR(v[7], 100.0 * (std::sqrt(2.0) - 1.0), 1e-12);
}

TEST(CurveSolve, DegreeOfCurveGivesTheRadius) {
  const std::vector<double> arc = solve({"--deg-arc", "1", "--length", "100"});
  ASSERT_EQ(arc.size(), kSolveColumns.size());
  EXPECT_DOUBLE_EQ(arc[0], 5729.5779513082325);
  EXPECT_NEAR(arc[3], 1.0, 1e-12);  // a 100-unit arc subtends one degree
  const std::vector<double> chord = solve({"--deg-chord", "2", "--chord", "100"});
  ASSERT_EQ(chord.size(), kSolveColumns.size());
  EXPECT_DOUBLE_EQ(chord[0], GetRadiusFromDegOfChord(2.0));
  EXPECT_NEAR(chord[3], 2.0, 1e-9);  // a 100-unit chord subtends two degrees
  EXPECT_NEAR(chord[2], 2.0, 1e-9);
}

TEST(CurveSolve, RefusesIncompleteOrImpossibleInput) {
  struct Refusal {
    std::vector<std::string> args;
    const char* message;
  };
  const std::vector<Refusal> refusals = {
      {{"--radius", "100"}, "give one more quantity"},
      {{"--delta", "20"}, "give the radius"},
      {{"--radius", "100", "--delta", "20", "--length", "5"}, "excludes"},
      {{"--radius", "100", "--deg-arc", "3", "--delta", "20"}, "excludes"},
      {{"--radius", "100", "--chord", "250"}, "no circular curve of radius 100 has chord 250"},
      {{"--radius", "100", "--mid-ordinate", "250"}, "no circular curve"},
      {{"--radius", "-5", "--delta", "20"}, "radius"},
  };
  for (const Refusal& refusal : refusals) {
    std::vector<std::string> args = {"curve", "solve"};
    args.insert(args.end(), refusal.args.begin(), refusal.args.end());
    const svy_test::SvyResult r = runSvy(args);
    EXPECT_EQ(r.exitStatus, 2) << refusal.message;
    EXPECT_NE(r.err.find(refusal.message), std::string::npos) << r.err;
    EXPECT_TRUE(r.out.empty());
  }
}

struct TableCase {
  const char* type;
  double length;
  double radius;
  double interval;
  bool exit;
};

class SpiralTable : public ::testing::TestWithParam<TableCase> {};

TEST_P(SpiralTable, RowsAgreeWithLibrary) {
  const TableCase c = GetParam();
  std::vector<std::string> args = {"spiral",           "table",
                                   "--full-precision", "--type",
                                   c.type,             "--length",
                                   std::to_string(c.length), "--radius",
                                   std::to_string(c.radius), "--interval",
                                   std::to_string(c.interval)};
  if (c.exit) args.push_back("--exit");
  const svy_test::SvyResult r = runSvy(args);
  ASSERT_EQ(r.exitStatus, 0) << r.err;
  const std::vector<std::string> lines = r.lines();
  ASSERT_GE(lines.size(), 3u);
  EXPECT_EQ(lines[0], "length,north,east,azimuth_deg,radius");
  const int whole = static_cast<int>(std::floor(c.length / c.interval + 1e-9));
  const bool endOnGrid = std::fabs(whole * c.interval - c.length) < 1e-9;
  EXPECT_EQ(lines.size(), static_cast<std::size_t>(whole + (endOnGrid ? 2 : 3)));

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
  const std::vector<std::string> curveEnd = splitCsvLine(c.exit ? lines[1] : lines.back());
  EXPECT_NEAR(std::stod(curveEnd[4]), c.radius, 1e-5 * std::fabs(c.radius));
}

INSTANTIATE_TEST_SUITE_P(Cases, SpiralTable,
                         ::testing::Values(TableCase{"clothoid", 100.0, 300.0, 10.0, false},
                                           TableCase{"clothoid", 75.0, -250.0, 20.0, false},
                                           TableCase{"cubic", 100.0, 400.0, 30.0, true},
                                           TableCase{"cubic", 60.0, -1000.0, 7.5, false}));

TEST(SpiralTable, RefusesImpossibleSpirals) {
  const svy_test::SvyResult tooSharp =
      runSvy({"spiral", "table", "--type", "cubic", "--length", "100", "--radius", "100", "--interval", "10"});
  EXPECT_EQ(tooSharp.exitStatus, 2);
  EXPECT_NE(tooSharp.err.find("no cubic spiral"), std::string::npos) << tooSharp.err;
  const svy_test::SvyResult tooMany =
      runSvy({"spiral", "table", "--length", "100", "--radius", "300", "--interval", "1e-9"});
  EXPECT_EQ(tooMany.exitStatus, 2);
  const svy_test::SvyResult badType =
      runSvy({"spiral", "table", "--type", "bloss", "--length", "100", "--radius", "300", "--interval", "1"});
  EXPECT_EQ(badType.exitStatus, 2);
  const svy_test::SvyResult zeroRadius =
      runSvy({"spiral", "table", "--length", "100", "--radius", "0", "--interval", "1"});
  EXPECT_EQ(zeroRadius.exitStatus, 2);
}

}  // namespace
