#include "svymath/cogo/implicit_lines.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

using Pt = svy_math::TAbstractPoint2<double>;

double residual(const CLineCoeffs& l, const Pt& p) { return l.a * p[0] + l.b * p[1] + l.c; }

void expectLine(const CLineCoeffs& l, double a, double b, double c) {
  EXPECT_TRUE(l.a == a && l.b == b && l.c == c) << l.a << " " << l.b << " " << l.c;
}

// The normalised shapes: slope form (b = -1) and constant x (a = -1, b = 0); coincident points fail.
TEST(FindLineCoeffs, NormalisedShapesAndCoincidentPoints) {
  CLineCoeffs l;
  ASSERT_TRUE(FindLineCoeffs(Pt(0, 0), Pt(2, 4), l));
  expectLine(l, 2, -1, 0);
  ASSERT_TRUE(FindLineCoeffs(Pt(-1, 7), Pt(4, 7), l));
  expectLine(l, 0, -1, 7);
  CLineCoeffs kept(9, 8, 7);
  EXPECT_FALSE(FindLineCoeffs(Pt(3, 1), Pt(3, 1), kept));
  expectLine(kept, 9, 8, 7);
  // Any difference above the subnormal guard is a line, however short.
  EXPECT_TRUE(FindLineCoeffs(Pt(3, 0), Pt(3, 1e-300), l));
  expectLine(l, -1, 0, 3);
  // Perpendiculars swap the shapes.
  ASSERT_TRUE(FindPerpendicular(CLineCoeffs(0, -1, 5), Pt(2, 7), l));
  expectLine(l, -1, 0, 2);
  ASSERT_TRUE(FindPerpendicular(CLineCoeffs(-1, 0, 3), Pt(2, 7), l));
  expectLine(l, 0, -1, 7);
  Pt point(-3, -4);  // parallel lines fail and leave the point
  EXPECT_FALSE(FindLinesIntersection(CLineCoeffs(2, -1, 0), CLineCoeffs(2, -1, 5), point) ||
               FindLinesIntersection(CLineCoeffs(-1, 0, 1), CLineCoeffs(-1, 0, 4), point));
  EXPECT_TRUE(point[0] == -3.0 && point[1] == -4.0);
}

// Both defining points lie on the line; the foot of a point (intersection of the line and its
// perpendicular through the point) is the vector projection.
TEST(ImplicitLines, DefiningPointsLieOnTheLineAndTheFootIsTheProjection) {
  const Pt cases[][3] = {{Pt(1, 2), Pt(-4, 6), Pt(5, -1)},        {Pt(-5, 0.5), Pt(-5, -20), Pt(-2, 8)},
                         {Pt(10, 10), Pt(10.001, 2000), Pt(3, 3)}, {Pt(1, 1), Pt(-2, 5), Pt(1, 1)},
                         {Pt(5000000, 500000), Pt(5000123.25, 500321.5), Pt(5000050, 500100)}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c[0][0] << " " << c[0][1] << " " << c[1][0] << " " << c[1][1]);
    CLineCoeffs line, perp;
    ASSERT_TRUE(FindLineCoeffs(c[0], c[1], line));
    EXPECT_TRUE(line.b == -1.0 || (line.a == -1.0 && line.b == 0.0));
    // Residuals are in units of y; allow for the slope magnifying rounding of x.
    const double scale = 8e-15 * (1.0 + std::fabs(line.a)) * (std::fabs(c[0][0]) + std::fabs(c[0][1]) + 1.0);
    EXPECT_TRUE(std::fabs(residual(line, c[0])) <= scale && std::fabs(residual(line, c[1])) <= scale);
    ASSERT_TRUE(FindPerpendicular(line, c[2], perp));
    Pt foot(0, 0);
    ASSERT_TRUE(FindLinesIntersection(line, perp, foot));
    const Pt d = c[1] - c[0];
    const Pt expected = c[0] + d * (((c[2] - c[0]) * d) / (d * d));
    EXPECT_TRUE(std::fabs(foot[0] - expected[0]) <= 1e-9 && std::fabs(foot[1] - expected[1]) <= 1e-9);
  }
}

TEST(QuadraticRoots, CountAndOrderOfTheRoots) {
  // Two roots, the larger first for a > 0 and turned round for a < 0; a double root; none (both zeroed); a
  // below 1e-13 is linear, also with a vanishing slope; D about -8e-14 is a double root, -3.2e-13 none.
  struct { double a, b, c; int count; double x1, x2; } const cases[] = {
      {1, -3, 2, 2, 2, 1}, {-1, 3, -2, 2, 1, 2},   {1, 2, 1, 1, -1, -1},        {1, 0, 1, 0, 0, 0},
      {1e-14, 2, -4, 1, 2, 2}, {0, 1e-6, 3, 0, 0, 0}, {2, -8, 8 + 1e-14, 1, 2, 2}, {2, -8, 8 + 4e-14, 0, 0, 0}};
  for (const auto& r : cases) {
    SCOPED_TRACE(::testing::Message() << r.a << " " << r.b << " " << r.c);
    double x1 = 99.0, x2 = 99.0;
    EXPECT_EQ(SolutionTo2ndDegreePolynomial(r.a, r.b, r.c, x1, x2), r.count);
    EXPECT_NEAR(x1, r.x1, 1e-12 * (1.0 + std::fabs(r.x1)));
    EXPECT_NEAR(x2, r.x2, 1e-12 * (1.0 + std::fabs(r.x2)));
  }
  // D = 0 is tested before a, so 0x^2 + 0x + 1 "has" the double root -0/0.
  double x1 = 0.0, x2 = 0.0;
  EXPECT_EQ(SolutionTo2ndDegreePolynomial(0, 0, 1, x1, x2), 1);
  EXPECT_TRUE(std::isnan(x1) && std::isnan(x2));
}

// a (x - r1)(x - r2) for well separated roots: the returned roots are r1 and r2.
TEST(QuadraticRoots, RootsOfBuiltPolynomials) {
  const double cases[][3] = {{-2.5, -3.5, 12.25}, {1e-6, 0.001, 1000.0}, {3e4, 0.001, 1000.0}, {3e4, -3.5, 12.25}};
  for (const auto& r : cases) {
    SCOPED_TRACE(::testing::Message() << r[0] << " " << r[1] << " " << r[2]);
    double x1 = 0, x2 = 0;
    ASSERT_EQ(SolutionTo2ndDegreePolynomial(r[0], -r[0] * (r[1] + r[2]), r[0] * r[1] * r[2], x1, x2), 2);
    EXPECT_NEAR(r[0] > 0 ? x1 : x2, r[2], 1e-9 * (1.0 + std::fabs(r[2])));
    EXPECT_NEAR(r[0] > 0 ? x2 : x1, r[1], 1e-6 * (1.0 + std::fabs(r[1])));
  }
}

}  // namespace
