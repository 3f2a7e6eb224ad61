// Frame transformations against a published worked example and by their algebra (inverse, orthogonality,
// the sign of a rotation); the Gauss-Markov step against its defining properties.
#include <gtest/gtest.h>

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/helmert.h"

namespace {

using svy_math::THelmertParams;
constexpr double kArcSecond = svy_math::units::kDegToRad / 3600.0;

// The published position-vector example: WGS 72 to WGS 84 with tz = 4.5 m, rz = 0.554", scale 0.219 ppm
// (values published to the centimetre).
TEST(Helmert, PublishedWorkedExample) {
  THelmertParams p;
  p.tz = 4.5;
  p.rz = 0.554 * kArcSecond;
  p.scalePpm = 0.219;
  for (const auto form : {svy_math::eHelmertSmallAngle, svy_math::eHelmertRigorous}) {
    Coord out;
    ASSERT_TRUE(ECRFCorrections(Coord(3657660.66, 255768.55, 5201382.11), p, form, false, out));
    EXPECT_NEAR(out.x(), 3657660.78, 0.006);
    EXPECT_NEAR(out.y(), 255778.43, 0.006);
    EXPECT_NEAR(out.z(), 5201387.75, 0.006);
  }
}

// Both forms invert exactly; they agree to r^2 |X| for frame-sized rotations; the rigorous one is
// orthogonal (distances scale by 1 + s exactly) at any angle, and a quarter turn about Z carries X onto Y.
TEST(Helmert, InverseOrthogonalityAndRotationSense) {
  THelmertParams p;
  p.tx = -0.0016, p.ty = -0.0019, p.tz = -0.0024;
  p.rx = 0.1 * kArcSecond * 1e-3, p.ry = -0.3 * kArcSecond, p.rz = 2.0 * kArcSecond;
  p.scalePpm = 0.02;
  const Coord a(4027894.0, 307045.6, 4919474.9), b(-2694892.5, -4297418.1, 3854273.2);
  Coord fa[2], fb, back;
  for (int form = 0; form < 2; ++form) {
    const auto f = static_cast<svy_math::EHelmertRotation>(form);
    ASSERT_TRUE(ECRFCorrections(a, p, f, false, fa[form]));
    ASSERT_TRUE(ECRFCorrections(fa[form], p, f, true, back));
    EXPECT_LT((back - a).Module(), 1e-8);
  }
  const double r2 = p.rx * p.rx + p.ry * p.ry + p.rz * p.rz;
  EXPECT_LT((fa[0] - fa[1]).Module(), r2 * a.Module());
  EXPECT_GT((fa[0] - fa[1]).Module(), 0.1 * r2 * a.Module());
  THelmertParams big;
  big.rx = 0.3, big.ry = -1.1, big.rz = 2.5, big.scalePpm = 5.0;
  Coord ga, gb;
  ASSERT_TRUE(ECRFCorrections(a, big, svy_math::eHelmertRigorous, false, ga));
  ASSERT_TRUE(ECRFCorrections(b, big, svy_math::eHelmertRigorous, false, gb));
  EXPECT_NEAR((ga - gb).Module(), (a - b).Module() * (1 + 5e-6), 1e-7);
  THelmertParams quarter;
  quarter.rz = svy_math::units::kHalfPi;
  ASSERT_TRUE(ECRFCorrections(Coord(1, 0, 0), quarter, svy_math::eHelmertRigorous, false, fb));
  EXPECT_LT((fb - Coord(0, 1, 0)).Module(), 1e-15);
  big.scalePpm = -1e6;
  EXPECT_FALSE(ECRFCorrections(a, big, svy_math::eHelmertRigorous, false, fb));
  EXPECT_FALSE(ECRFCorrections(Coord(std::nan(""), 0, 0), p, svy_math::eHelmertSmallAngle, true, fb));
}

// Two half steps make one step (the process is Markov); the variance tends to the steady state from any
// start; a zero step changes nothing; bad parameters fail.
TEST(GaussMarkov, ComposesAndSettles) {
  const double tau = 600.0, q = 0.04;
  for (const double dt : {0.0, 1e-3, 1.0, 30.0, 3600.0}) {
    double m1 = 0, v1 = 0, m2 = 0, v2 = 0, mh = 0, vh = 0;
    ASSERT_TRUE(firstOrderGaussMarkov(0.3, 0.01, tau, dt, q, m1, v1));
    ASSERT_TRUE(firstOrderGaussMarkov(0.3, 0.01, tau, dt / 2, q, mh, vh));
    ASSERT_TRUE(firstOrderGaussMarkov(mh, vh, tau, dt / 2, q, m2, v2));
    EXPECT_NEAR(m1, m2, 1e-15) << dt;
    EXPECT_NEAR(v1, v2, 1e-15) << dt;
    EXPECT_NEAR(m1, 0.3 * std::exp(-dt / tau), 1e-15);
  }
  double m = 5.0, v = 0.0;
  for (int i = 0; i < 200; ++i) ASSERT_TRUE(firstOrderGaussMarkov(m, v, tau, 60.0, q, m, v));
  EXPECT_NEAR(v, q, 1e-12);
  EXPECT_NEAR(m, 0.0, 1e-6);
  double out1 = 7, out2 = 7;
  EXPECT_FALSE(firstOrderGaussMarkov(0, 0, 0.0, 1, q, out1, out2));
  EXPECT_FALSE(firstOrderGaussMarkov(0, 0, tau, -1, q, out1, out2));
  EXPECT_FALSE(firstOrderGaussMarkov(0, -1, tau, 1, q, out1, out2));
  EXPECT_EQ(out1, 7.0);
}

}  // namespace
