#include "svymath/cogo/implicit_lines.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

using Pt = svy_math::TAbstractPoint2<double>;

double residual(const CLineCoeffs& l, const Pt& p) { return l.a * p[0] + l.b * p[1] + l.c; }

void expectLine(const CLineCoeffs& l, double a, double b, double c) {
  EXPECT_DOUBLE_EQ(l.a, a);
  EXPECT_DOUBLE_EQ(l.b, b);
  EXPECT_DOUBLE_EQ(l.c, c);
}

// ---------------------------------------------------------------------------------------------------
// The normalised shapes.

TEST(FindLineCoeffs, SlopeAndConstantXShapes) {
  CLineCoeffs l;
  ASSERT_TRUE(FindLineCoeffs(Pt(0, 0), Pt(2, 4), l));
  expectLine(l, 2, -1, 0);
  ASSERT_TRUE(FindLineCoeffs(Pt(3, 1), Pt(3, 5), l));
  expectLine(l, -1, 0, 3);
  // A horizontal line is a slope-form line with slope 0.
  ASSERT_TRUE(FindLineCoeffs(Pt(-1, 7), Pt(4, 7), l));
  expectLine(l, 0, -1, 7);
}

TEST(FindLineCoeffs, CoincidentPointsFailAndLeaveTheOutput) {
  CLineCoeffs l(9, 8, 7);
  EXPECT_FALSE(FindLineCoeffs(Pt(3, 1), Pt(3, 1), l));
  expectLine(l, 9, 8, 7);
  // Any difference above the subnormal guard is a line, however short.
  EXPECT_TRUE(FindLineCoeffs(Pt(3, 0), Pt(3, 1e-300), l));
  expectLine(l, -1, 0, 3);
}

// Both defining points satisfy the line, for lines in every direction.
class LineThroughTwoPoints : public ::testing::TestWithParam<std::pair<Pt, Pt>> {};

TEST_P(LineThroughTwoPoints, BothPointsLieOnTheLine) {
  const Pt p = GetParam().first;
  const Pt q = GetParam().second;
  CLineCoeffs l;
  ASSERT_TRUE(FindLineCoeffs(p, q, l));
  EXPECT_TRUE(l.b == -1.0 || (l.a == -1.0 && l.b == 0.0));
  // Residuals are in units of y; allow for the slope magnifying rounding of x.
  const double scale = 1e-15 * (1.0 + std::fabs(l.a)) * (std::fabs(p[0]) + std::fabs(p[1]) + 1.0);
  EXPECT_NEAR(residual(l, p), 0.0, 8 * scale);
  EXPECT_NEAR(residual(l, q), 0.0, 8 * scale);
}

INSTANTIATE_TEST_SUITE_P(
    Directions, LineThroughTwoPoints,
    ::testing::Values(std::make_pair(Pt(1, 2), Pt(4, 6)), std::make_pair(Pt(1, 2), Pt(-4, 6)),
                      std::make_pair(Pt(1, 2), Pt(-4, -6)), std::make_pair(Pt(1, 2), Pt(4, -6)),
                      std::make_pair(Pt(-5, 0.5), Pt(-5, -20)),
                      std::make_pair(Pt(10, 10), Pt(10.001, 2000)),
                      std::make_pair(Pt(5000000, 500000), Pt(5000123.25, 500321.5))));

// ---------------------------------------------------------------------------------------------------
// Perpendicular and intersection: the foot of a point on a line, against the projection formula.

TEST(FindPerpendicular, OfAConstantYLineIsAConstantXLine) {
  CLineCoeffs perp;
  ASSERT_TRUE(FindPerpendicular(CLineCoeffs(0, -1, 5), Pt(2, 7), perp));
  expectLine(perp, -1, 0, 2);
}

TEST(FindPerpendicular, OfAConstantXLineIsASlopeZeroLine) {
  CLineCoeffs perp;
  ASSERT_TRUE(FindPerpendicular(CLineCoeffs(-1, 0, 3), Pt(2, 7), perp));
  expectLine(perp, 0, -1, 7);
}

struct FootCase {
  Pt p, q;  // the line
  Pt point;  // the point dropped onto it
};

class FootOfPerpendicular : public ::testing::TestWithParam<FootCase> {};

TEST_P(FootOfPerpendicular, IntersectionOfLineAndPerpendicularIsTheProjection) {
  const FootCase& c = GetParam();
  CLineCoeffs line, perp;
  ASSERT_TRUE(FindLineCoeffs(c.p, c.q, line));
  ASSERT_TRUE(FindPerpendicular(line, c.point, perp));
  EXPECT_NEAR(residual(perp, c.point), 0.0, 1e-9);
  // The two directions are orthogonal: normals (a, b) are orthogonal too.
  EXPECT_NEAR(line.a * perp.a + line.b * perp.b, 0.0, 1e-12);

  Pt foot(0, 0);
  ASSERT_TRUE(FindLinesIntersection(line, perp, foot));
  const Pt d = c.q - c.p;
  const double t = ((c.point - c.p) * d) / (d * d);
  const Pt expected = c.p + d * t;
  EXPECT_NEAR(foot[0], expected[0], 1e-9);
  EXPECT_NEAR(foot[1], expected[1], 1e-9);
}

INSTANTIATE_TEST_SUITE_P(Lines, FootOfPerpendicular,
                         ::testing::Values(FootCase{Pt(0, 0), Pt(2, 4), Pt(5, -1)},
                                           FootCase{Pt(3, 1), Pt(3, 5), Pt(-2, 8)},
                                           FootCase{Pt(-1, 7), Pt(4, 7), Pt(0.5, 0.5)},
                                           FootCase{Pt(1, 1), Pt(-2, 5), Pt(1, 1)},
                                           FootCase{Pt(100, 200), Pt(130, 160), Pt(90, 150)}));

TEST(FindLinesIntersection, ParallelLinesFailAndLeaveThePoint) {
  Pt point(-3, -4);
  EXPECT_FALSE(FindLinesIntersection(CLineCoeffs(2, -1, 0), CLineCoeffs(2, -1, 5), point));
  EXPECT_FALSE(FindLinesIntersection(CLineCoeffs(-1, 0, 1), CLineCoeffs(-1, 0, 4), point));
  EXPECT_EQ(point[0], -3.0);
  EXPECT_EQ(point[1], -4.0);
}

TEST(FindLinesIntersection, ConstantXLineMeetsSlopeLine) {
  Pt point(0, 0);
  ASSERT_TRUE(FindLinesIntersection(CLineCoeffs(-1, 0, 3), CLineCoeffs(2, -1, 1), point));
  EXPECT_DOUBLE_EQ(point[0], 3.0);
  EXPECT_DOUBLE_EQ(point[1], 7.0);
}

// ---------------------------------------------------------------------------------------------------
// Quadratic roots.

struct RootsCase {
  double a, b, c;
  int count;
  double x1, x2;
};

class QuadraticRoots : public ::testing::TestWithParam<RootsCase> {};

TEST_P(QuadraticRoots, CountAndRoots) {
  const RootsCase& r = GetParam();
  double x1 = 99.0;
  double x2 = 99.0;
  EXPECT_EQ(SolutionTo2ndDegreePolynomial(r.a, r.b, r.c, x1, x2), r.count);
  EXPECT_NEAR(x1, r.x1, 1e-12 * (1.0 + std::fabs(r.x1)));
  EXPECT_NEAR(x2, r.x2, 1e-12 * (1.0 + std::fabs(r.x2)));
}

INSTANTIATE_TEST_SUITE_P(
    Table, QuadraticRoots,
    ::testing::Values(RootsCase{1, -3, 2, 2, 2, 1},       // two roots, the larger first for a > 0
                      RootsCase{-1, 3, -2, 2, 1, 2},      // a < 0: the order turns round
                      RootsCase{1, 2, 1, 1, -1, -1},      // double root
                      RootsCase{1, 0, 1, 0, 0, 0},        // no real root: both zeroed
                      RootsCase{0, 2, -4, 1, 2, 2},       // linear
                      RootsCase{1e-14, 2, -4, 1, 2, 2},   // a below 1e-13: linear
                      RootsCase{0, 1e-6, 3, 0, 0, 0},     // linear with a vanishing slope
                      RootsCase{2, -8, 8 + 1e-14, 1, 2, 2},  // D about -8e-14: a double root
                      RootsCase{2, -8, 8 + 4e-14, 0, 0, 0},  // D about -3.2e-13: none
                      RootsCase{4, 0, -9, 2, 1.5, -1.5}));

TEST(QuadraticRoots, AllZeroLeadingCoefficientsGiveOneNaNRoot) {
  // D = 0 is tested before a, so 0x^2 + 0x + 1 "has" the double root -0/0.
  double x1 = 0.0;
  double x2 = 0.0;
  EXPECT_EQ(SolutionTo2ndDegreePolynomial(0, 0, 1, x1, x2), 1);
  EXPECT_TRUE(std::isnan(x1));
  EXPECT_TRUE(std::isnan(x2));
}

TEST(QuadraticRoots, RootsOfBuiltPolynomialsSatisfyIt) {
  // a (x - r1)(x - r2) for well separated roots: each returned root makes the polynomial vanish.
  const double roots[][2] = {{-3.5, 12.25}, {0.001, 1000.0}, {-250.0, -0.5}, {7.0, -7.0}};
  for (double a : {1.0, -2.5, 1e-6, 3e4}) {
    for (const auto& r : roots) {
      SCOPED_TRACE(::testing::Message() << a << " " << r[0] << " " << r[1]);
      const double b = -a * (r[0] + r[1]);
      const double c = a * r[0] * r[1];
      double x1 = 0, x2 = 0;
      ASSERT_EQ(SolutionTo2ndDegreePolynomial(a, b, c, x1, x2), 2);
      const double hi = std::max(r[0], r[1]);
      const double lo = std::min(r[0], r[1]);
      EXPECT_NEAR(a > 0 ? x1 : x2, hi, 1e-9 * (1.0 + std::fabs(hi)));
      EXPECT_NEAR(a > 0 ? x2 : x1, lo, 1e-6 * (1.0 + std::fabs(lo)));
    }
  }
}

}  // namespace
