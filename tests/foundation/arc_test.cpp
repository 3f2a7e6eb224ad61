// Circular arc records: every setter, fed the same arc in its own terms, must give the same centre, radius,
// sweep, end point, middle point and tangents, all checked against positions computed here from the polar
// form of the arc. Setters that cannot define an arc leave the record untouched.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>
#include <utility>

#include "support/geometry.h"
#include "svymath/foundation/arc.h"
#include "svymath/foundation/constants.h"

namespace {

constexpr double kPi = svy_math::units::kPi;
constexpr double kTwoPi = svy_math::units::kTwoPi;

using svy_test::radians;

void expectSamePos(const C2dPos& actual, const C2dPos& expected, double tol, const std::string& what) {
  EXPECT_NEAR(svy_test::dist(actual, expected), 0.0, tol) << what;
}

// An arc in polar form: centre, radius, azimuth of the start seen from the centre, signed sweep
// (clockwise positive); the tangent is a quarter turn from the radius, towards the direction of travel.
struct PolarArc {
  const char* name;
  C2dPos centre;
  double radius, startRadial, sweep, tolerance;

  C2dPos at(double t) const {  // t = 0 at the start, 1 at the end
    const double r = startRadial + t * sweep;
    return C2dPos(centre.north() + radius * std::cos(r), centre.east() + radius * std::sin(r));
  }
  bool clockwise() const { return sweep > 0; }
  CMathAngle tangent(double t) const {
    return radians(startRadial + t * sweep + (clockwise() ? kPi / 2 : -kPi / 2));
  }

  void expect(const CArc& arc, const std::string& setter) const {
    EXPECT_TRUE(!arc.fullCircle && arc.clockwise == clockwise()) << setter;
    expectSamePos(arc.start, at(0), tolerance, setter + " start");
    expectSamePos(arc.center, centre, tolerance, setter + " centre");
    EXPECT_NEAR(arc.getRadius(), radius, tolerance) << setter;
    EXPECT_NEAR(arc.getSweep(), sweep, 1e-9) << setter;
    C2dPos p, m;
    CMathAngle az, az2;
    ASSERT_TRUE(arc.get_end_pos(p) && arc.get_start_tgdir(az) && arc.get_middle_pos_on_the_arc(m) &&
                arc.get_end_tgdir(az2)) << setter;
    expectSamePos(p, at(1), tolerance, setter + " finish");
    expectSamePos(m, at(0.5), tolerance, setter + " middle");
    EXPECT_TRUE(az.isEqual(tangent(0), 1e-9) && az2.isEqual(tangent(1), 1e-9)) << setter << " tangents";
  }
};

class ArcSetters : public ::testing::TestWithParam<PolarArc> {};

TEST_P(ArcSetters, AllAgreeOnTheSameArc) {
  const PolarArc& ref = GetParam();
  const bool cw = ref.clockwise();
  const C2dPos start = ref.at(0), finish = ref.at(1);
  CArc arc;
  const auto check = [&](bool set, const char* setter) {
    ASSERT_TRUE(set) << setter;
    ref.expect(arc, setter);
  };
  check(arc.set_start_center_finish(start, ref.centre, finish, cw), "start_center_finish");
  const CMathAngle startRadial = radians(ref.startRadial), finishRadial = radians(ref.startRadial + ref.sweep);
  check(arc.set_r_start_center_finish(ref.radius, startRadial, ref.centre, finishRadial, cw), "r_start_center_finish");
  check(arc.set_start_finish_bulge(start, finish, std::tan(ref.sweep / 4)), "bulge");
  check(arc.set_start_finish_startTgDir(start, finish, ref.tangent(0)), "startTgDir");
  check(arc.set_start_finish_finishTgDir(start, finish, ref.tangent(1)), "finishTgDir");
  check(arc.set_start_finish_plusPos(start, finish, ref.at(1.0 / 3)), "plusPos");
  check(arc.set_start_r_length(start, ref.tangent(0), ref.radius, ref.radius * std::fabs(ref.sweep), cw), "r_length");
  if (std::fabs(ref.sweep) > kPi) return;  // the remaining setters define arcs up to a half circle
  check(arc.set_r_start_finish(ref.radius, start, finish, cw), "r_start_finish");
  check(arc.set_start_center_cAngle(start, ref.centre, radians(std::fabs(ref.sweep)), cw), "start_center_cAngle");
  check(arc.set_start_finish_turn(start, finish, radians(ref.sweep)), "turn");
}

INSTANTIATE_TEST_SUITE_P(
    Cases, ArcSetters,
    ::testing::Values(PolarArc{"QuarterRight", C2dPos(0, 0), 100, 0.3, kPi / 2, 1e-9},
                      PolarArc{"QuarterLeft", C2dPos(10, -20), 50, -2.0, -kPi / 2, 1e-9},
                      PolarArc{"ShallowRight", C2dPos(-300, 40), 2500, 2.9, 0.01, 1e-7},
                      PolarArc{"NearHalfLeft", C2dPos(1, 1), 7, 1.0, -(kPi - 1e-3), 1e-9},
                      PolarArc{"MajorRight", C2dPos(0, 0), 30, -1.0, 1.5 * kPi, 1e-9},
                      PolarArc{"MajorLeft", C2dPos(5, 5), 12.5, 3.0, -1.75 * kPi, 1e-9},
                      PolarArc{"GridCoordinates", C2dPos(5123456.789, 512345.678), 350, 0.7, 0.8, 1e-6}),
    [](const ::testing::TestParamInfo<PolarArc>& param) { return std::string(param.param.name); });

// A half circle from a bulge of one and from a diameter chord (also a hair longer, from rounding); full
// circles from centre, radius and tangent (a full circle stores no central angle).
TEST(ArcSetters, HalfAndFullCircles) {
  CArc arc;
  C2dPos middle;
  CMathAngle az;
  ASSERT_TRUE(arc.set_start_finish_bulge(C2dPos(0, 0), C2dPos(0, 10), 1.0) && arc.get_middle_pos_on_the_arc(middle));
  expectSamePos(middle, C2dPos(5, 5), 1e-12, "clockwise from west to east passes north");
  ASSERT_TRUE(arc.set_r_start_finish(5.0, C2dPos(0, 0), C2dPos(0, 10), false) && arc.get_middle_pos_on_the_arc(middle));
  expectSamePos(middle, C2dPos(-5, 5), 1e-9, "middle");
  ASSERT_TRUE(arc.set_r_start_finish(5.0 - 1e-13, C2dPos(0, 0), C2dPos(0, 10), true));
  EXPECT_NEAR(std::fabs(arc.getSweep()), kPi, 1e-6);
  ASSERT_TRUE(arc.set_center_R_startAz_direction(C2dPos(10, 20), 5, radians(0), true));
  expectSamePos(arc.start, C2dPos(10, 15), 1e-12, "clockwise start lies west for a north tangent");
  EXPECT_TRUE(arc.fullCircle && arc.getSweep() == kTwoPi && arc.centralAngle.getRad() == 0);
  EXPECT_NEAR(arc.getLength(), kTwoPi * 5, 1e-12);
  ASSERT_TRUE(arc.get_start_tgdir(az) && arc.get_middle_pos_on_the_arc(middle));
  EXPECT_NEAR(az.getRad(), 0, 1e-12);
  expectSamePos(middle, C2dPos(10, 25), 1e-12, "opposite point");
  ASSERT_TRUE(arc.set_center_R_startAz_direction(C2dPos(10, 20), 5, radians(kPi / 2), false));
  expectSamePos(arc.start, C2dPos(5, 20), 1e-12, "counter-clockwise start lies south for an east tangent");
  EXPECT_DOUBLE_EQ(arc.getSweep(), -kTwoPi);
  ASSERT_TRUE(arc.set_center_R(C2dPos(1, 2), 3));
  EXPECT_TRUE(arc.fullCircle && std::fabs(arc.getRadius() - 3) < 1e-15);
  ASSERT_TRUE(arc.set_start_center_finish(C2dPos(0, 5), C2dPos(0, 0), C2dPos(0, 9), false));
  EXPECT_TRUE(arc.fullCircle);
  ASSERT_TRUE(arc.set_start_r_length(C2dPos(0, 0), radians(0), 2.0, kTwoPi * 2.0, true));
  EXPECT_TRUE(arc.fullCircle);
  expectSamePos(arc.center, C2dPos(0, 2), 1e-12, "centre right of a north tangent");
}

TEST(ArcFailures, LeaveTheRecordUnchanged) {
  const double nan = std::numeric_limits<double>::quiet_NaN();
  CArc arc;
  ASSERT_TRUE(arc.set_start_center_finish(C2dPos(0, 10), C2dPos(0, 0), C2dPos(10, 0), false));
  const CArc before = arc;
  const C2dPos a(0, 0), b(0, 10), c(0, 20);
  const bool results[] = {arc.set_center_R(a, 0),
                          arc.set_center_R_startAz_direction(a, -1, radians(0), true),
                          arc.set_center_R(a, nan),
                          arc.set_r_start_finish(4.9, a, b, true),  // chord beyond the diameter
                          arc.set_r_start_finish(5, a, a, true),
                          arc.set_start_center_finish(a, a, b, true),
                          arc.set_start_center_finish(b, a, a, true),
                          arc.set_start_center_cAngle(b, a, radians(0), true),
                          arc.set_start_finish_bulge(a, b, 0),
                          arc.set_start_finish_bulge(a, b, nan),
                          arc.set_start_finish_bulge(a, a, 1),
                          arc.set_start_finish_plusPos(a, c, b),  // collinear
                          arc.set_start_finish_plusPos(a, c, a),
                          arc.set_start_finish_startTgDir(a, b, radians(kPi / 2)),  // along the chord
                          arc.set_start_finish_finishTgDir(a, b, radians(-kPi / 2)),
                          arc.set_start_finish_turn(a, b, radians(0)),
                          arc.set_start_r_length(a, radians(0), 1, 7, true),  // beyond the circumference
                          arc.set_start_r_length(a, radians(0), 1, 0, true),
                          arc.set_start_center_finish(C2dPos(nan, 0), a, b, true)};
  for (const bool& r : results) EXPECT_FALSE(r) << "row " << (&r - results);
  EXPECT_TRUE(arc.start == before.start && arc.center == before.center && arc.clockwise == before.clockwise &&
              arc.centralAngle.getRad() == before.centralAngle.getRad() && arc.fullCircle == before.fullCircle);
  CMathAngle az;
  EXPECT_FALSE(CArc().get_start_tgdir(az));
}

}  // namespace
