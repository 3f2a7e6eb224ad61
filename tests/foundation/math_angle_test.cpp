// CMathAngle and svy_math::TAngle: closed range ends, the two equalities, unset arithmetic, cache
// consistency under the in-place reflections, rotations and azimuths in the north-east convention.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "support/geometry.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/tangle.h"

namespace {

using svy_test::radians;
constexpr double kPi = svy_math::units::kPi;
const double kNaN = std::numeric_limits<double>::quiet_NaN();
const double kInf = std::numeric_limits<double>::infinity();

CMathAngle unset() {
  CMathAngle a;
  a.reset();
  return a;
}

// Stored as radians in the closed range [-pi, pi]; non-finite input marks the angle NaN and huge input
// (also from products and sums) still ends in range.
TEST(AngleStore, ReducesToTheClosedRangeAndNeverHangs) {
  const double cases[][2] = {{180, kPi}, {-180, -kPi}, {540, kPi}, {-540, -kPi}, {270, -kPi / 2}, {720, 0}};
  for (const auto& c : cases) EXPECT_NEAR(CMathAngle(c[0]).getRad(), c[1], 1e-12) << c[0];
  EXPECT_TRUE(radians(kInf).isNan() && radians(-kInf).isNan() && CMathAngle(kNaN).isNan());
  EXPECT_EQ(radians(kNaN).getRad(), 0.0);
  CMathAngle a(30.0);
  for (double x : {1e300, -1e300}) {
    EXPECT_LE(std::fabs(radians(x).getRad()), kPi) << x;
    a *= x;
    EXPECT_TRUE(a.isok() && std::fabs(a.getRad()) <= kPi);
  }
  a *= kInf;
  EXPECT_TRUE(a.isNan());
  for (double x : {-170.0, 170.0})
    for (double y : {-100.0, 135.0}) EXPECT_TRUE((CMathAngle(x) + CMathAngle(y)).isEqual(CMathAngle(x + y), 1e-12));
}

// operator== compares the stored radians (no wrap at pi); isEqual wraps and is strict on both sides.
TEST(AngleEquality, OperatorEqualsHasNoWrapButIsEqualHas) {
  EXPECT_TRUE(radians(kPi) != radians(-kPi) && radians(kPi).isEqual(radians(-kPi), 1e-9));
  EXPECT_TRUE(radians(1e-13).isEqual(radians(2 * kPi - 1e-13), 1e-9) && radians(0.5) == radians(0.5 + 1e-13));
  const double step = std::ldexp(1.0, -20);  // exact differences
  EXPECT_FALSE(radians(0.5).isEqual(radians(0.5 + step), step) || radians(0.5 + step).isEqual(radians(0.5), step));
  EXPECT_TRUE(radians(0.5).isEqual(radians(0.5 + step), 2 * step));
  EXPECT_TRUE(unset() <= radians(0) && unset() >= radians(0) && radians(-1) < radians(0.5));
}

// Each setter in turn (a braced list is evaluated left to right): azimuths clockwise from north, the angle at
// a vertex clockwise from the first ray, a bulge four times its arc tangent reduced. A failing setter
// leaves the previous value.
TEST(AngleSetters, TangentAzimuthVertexBulgeAndDmsForms) {
  CMathAngle a(10.0);
  const C2dPos o(0, 0);
  struct {
    bool ok;
    double rad;
    bool expectedOk;
    double expected;
  } const results[] = {{a.setTg(0, 0), a.getRad(), true, 0},
                       {a.setTg(kInf, 1), a.getRad(), true, kPi / 2}, {a.setTg(kNaN, 1), a.getRad(), false, kPi / 2},
                       {a.setAz(o, C2dPos(-1, 0)), a.getRad(), true, kPi},
                       {a.setAz(C2dPos(-1, -1)), a.getRad(), true, -0.75 * kPi},
                       {a.setAz(10, 10, 10, 20), a.getRad(), true, kPi / 2},
                       {a.setAngle(C2dPos(0, 1), o, C2dPos(1, 0)), a.getRad(), true, -kPi / 2},
                       {a.setAngle(o, o, C2dPos(1, 0)), a.getRad(), false, -kPi / 2},
                       {a.setAngle(C2dPos(1, 0), o, C2dPos(kNaN, 0)), a.getRad(), false, -kPi / 2},
                       {a.setBulge(1), a.getRad(), true, kPi},
                       {a.setBulge(-0.5), a.getRad(), true, -4 * std::atan(0.5)},
                       {a.setBulge(2), a.getRad(), true, 4 * std::atan(2.0) - 2 * kPi},
                       {a.setBulge(kNaN), a.getRad(), false, 4 * std::atan(2.0) - 2 * kPi}};
  for (const auto& r : results)
    EXPECT_TRUE(r.ok == r.expectedOk && std::fabs(r.rad - r.expected) <= 1e-15) << "row " << (&r - results);
  a.setDMS(-12, 30, 36);  // the sign comes from the degrees; minus zero degrees is positive
  EXPECT_NEAR(a.getDeg(), -12.51, 1e-12);
  a.setDMS(-0.0, 30, 0);
  EXPECT_NEAR(a.getDeg(), 0.5, 1e-12);
  a.setChordAndR(10, 250);  // the chord-to-tangent angle's supplement
  EXPECT_NEAR(a.getRad(), kPi - 2 * std::asin(10.0 / 500), 1e-12);
  a.setChordAndR(3, 1);
  EXPECT_TRUE(a.isNan());
}

// A right angle has a zero tangent (and zero a zero cotangent); an angle that reduces to exactly 2 pi keeps
// that upper end and lies in no quadrant; DMS loses the sign below one degree.
TEST(AngleQueries, TangentsQuadrantsUpperEndAndDms) {
  EXPECT_TRUE(radians(-kPi / 2).getTg() == 0.0 && radians(0).getCtg() == 0.0);
  const double quadrants[][3] = {{45.0, 1, 1}, {135.0, 0, 1}, {-135.0, 0, 0}, {-45.0, 1, 0}};
  for (const auto& q : quadrants) {
    const TQuadrant got = CMathAngle(q[0]).getQuadrant();
    EXPECT_TRUE(got.northward == (q[1] != 0) && got.eastward == (q[2] != 0)) << q[0];
  }
  const TQuadrant q = radians(-1e-17).getQuadrant();  // -1e-17 + 2 pi rounds to exactly 2 pi
  EXPECT_FALSE(q.northward || q.eastward);
  EXPECT_EQ(radians(-1e-17).get0To2PI(), svy_math::units::kTwoPi);
  EXPECT_NEAR(radians(-kPi / 2).get0To360(), 270, 1e-12);
  int d = 0, m = 0;
  double s = 0;
  CMathAngle(-0.5).getDMS(d, m, s);
  EXPECT_EQ(d * 100 + m, 30);
  CMathAngle(-12.51).getDMS(d, m, s);
  EXPECT_TRUE(d == -12 && m == 30 && std::fabs(s - 36) < 1e-9);
  // A rounding hair below a whole degree carries into the degrees: never 0 degrees 60 minutes.
  for (double whole : {1.0, -1.0, 2.0}) {
    for (double x = whole, step = 0; step < 8; ++step) {
      x = std::nextafter(x, 0.0);
      CMathAngle(x).getDMS(d, m, s);
      EXPECT_TRUE(m < 60 && std::fabs(std::fabs(d) * 3600 + m * 60 + s - std::fabs(whole) * 3600) < 1e-6)
          << x << ": " << d << " " << m << " " << s;
    }
  }
  // Whole seconds survive the radian round trip without a 60 in any field.
  for (int sec = 0; sec < 360 * 3600; sec += 997) {
    CMathAngle(sec / 3600.0).getDMS(d, m, s);
    EXPECT_TRUE(m < 60 && s < 60 - 1e-12) << sec;
    EXPECT_NEAR(std::fabs(d) * 3600 + m * 60 + s, sec <= 180 * 3600 ? sec : 360 * 3600 - sec, 1e-6) << sec;
  }
}

TEST(AngleGeometry, DirectionsPositionsAndRotationsFollowTheNorthEastConvention) {
  const CMathAngle east(90.0);
  double n = 0, e = 0;
  east.getPosAlong(10, 100, 200, n, e);
  EXPECT_NEAR(svy_test::dist(C2dPos(n, e), C2dPos(100, 210)), 0, 1e-12);
  east.getPosAcross(5, 100, 200, n, e);  // right of east-bound travel is south
  EXPECT_NEAR(svy_test::dist(C2dPos(n, e), C2dPos(95, 200)), 0, 1e-12);
  n = 1;
  e = 0;
  east.getRotated(n, e);  // clockwise on the map: north turns to east
  EXPECT_TRUE(std::fabs(n) <= 1e-15 && std::fabs(e - 1) <= 1e-15);
  const C2dPos p(-1e5, 2e5);
  double rn = p.north(), re = p.east();
  CMathAngle(37.0).getRotated(rn, re);
  CMathAngle(37.0).getRotatedBack(rn, re);
  EXPECT_NEAR(svy_test::dist(C2dPos(rn, re), p), 0, 1e-9);
  C2dPos r;
  CMathAngle(180.0).getRotatedPoint(C2dPos(10, 10), C2dPos(11, 10), r);
  EXPECT_NEAR((r - C2dPos(9, 10)).Module(), 0, 1e-12);
  const C2dPos at30(std::cos(kPi / 6), std::sin(kPi / 6));
  EXPECT_TRUE(CMathAngle(30.0).isSameAsAzimuth(C2dPos(0, 0), at30) &&
              !CMathAngle(31.0).isSameAsAzimuth(C2dPos(0, 0), at30));
  EXPECT_TRUE(CMathAngle(89.0).isSharp() && !CMathAngle(-90.0).isSharp());
}

// Division by (nearly) zero gives 0 from the operator but NaN from the compound form; an unset left operand
// gives a set zero from the operators but stays unset in the compound forms; an unset right one is ignored.
TEST(AngleArithmetic, DivisionByZeroAndUnsetOperands) {
  const CMathAngle a(30.0);
  EXPECT_TRUE((a / 0.0).isok() && (a / 0.0).getRad() == 0 && (a / 1e-13).getRad() == 0);
  CMathAngle b(30.0);
  b /= 0.0;
  EXPECT_TRUE(b.isNan());
  EXPECT_NEAR((a - unset()).getDeg(), 30, 1e-12);
  const CMathAngle z = unset() + a;
  EXPECT_TRUE(z.isok() && z.getRad() == 0);
  CMathAngle u = unset();
  u += a;
  u *= 2;
  EXPECT_TRUE(u.isNan() && (unset() * 3.0).isok());
}

TEST(AngleCaches, ReflectionsKeepCachesConsistentWithTheValue) {
  using Reflect = void (CMathAngle::*)();
  for (double deg : {-170.0, -90.0, 0.0, 135.0, 180.0}) {
    for (Reflect reflect : {static_cast<Reflect>(&CMathAngle::setComplimentary), &CMathAngle::set90MinusThis,
                            &CMathAngle::setSupplementary, &CMathAngle::set180MinusThis, &CMathAngle::changeSign}) {
      CMathAngle warm(deg), cold(deg), none = unset();
      warm.getSin();
      warm.getCos();
      (warm.*reflect)();
      (cold.*reflect)();
      (none.*reflect)();
      EXPECT_TRUE(std::fabs(warm.getRad()) <= kPi && none.isNan() && warm.getRad() == cold.getRad()) << deg;
      EXPECT_NEAR(warm.getSin(), std::sin(warm.getRad()), 1e-15) << deg;
      EXPECT_NEAR(warm.getCos(), std::cos(warm.getRad()), 1e-15) << deg;
    }
  }
  CMathAngle a(30.0);
  a.setComplimentary();
  a.setSupplementary();
  a.changeSign();
  EXPECT_NEAR(a.getDeg(), -120, 1e-12);  // 90 - 30, then 180 - 60, negated
}

TEST(TAngleTwin, ConstructsFromRadiansAndSharesTheRules) {
  EXPECT_NEAR(CMathAngle(90.0).getRad(), svy_math::TAngle(kPi / 2).getRad(), 1e-15);
  EXPECT_DOUBLE_EQ(svy_math::TAngle(-kPi).getNegPIToPI(), kPi);
  EXPECT_NEAR(svy_math::TAngle(-kPi / 2).get0To2PI(), 1.5 * kPi, 1e-15);
  EXPECT_NEAR((svy_math::TAngle(kPi / 2) + svy_math::TAngle(kPi)).getDouble(), -kPi / 2, 1e-15);
  svy_math::TAngle q(1.0);
  EXPECT_EQ((q / 0.0).getDouble(), 0);
  q /= 0.0;
  EXPECT_TRUE(q.isNan() && svy_math::TAngle(kPi) != svy_math::TAngle(-kPi) &&
              svy_math::TAngle(0.1) < svy_math::TAngle(0.2));
  EXPECT_DOUBLE_EQ(svy_math::absoluteAngle(svy_math::TAngle(-1.0)).getDouble(), 1.0);
}

}  // namespace
