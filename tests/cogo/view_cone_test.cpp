// Views of targets: known directions to known screen positions, the cone's edges and faces, and the screen
// position against angles computed independently in the world frame.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "svymath/cogo/view_cone.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::T3dPosAndDirRotated;
using svy_math::TRectCone;
using svy_math::TViewParams;
using Point3 = svy_math::TAbstractPoint3<double>;
constexpr double kDeg = svy_math::units::kDegToRad;
const Point3 kEye(5000000.0, 500000.0, 100.0);

TViewParams view(double azimuthDeg, double elevationDeg, double fovDeg = 90.0) {
  TViewParams v;
  v.observer = kEye;
  v.azimuth = azimuthDeg * kDeg;
  v.elevation = elevationDeg * kDeg;
  v.fieldOfView = fovDeg * kDeg;
  v.screenWidth = 800;
  v.screenHeight = 600;
  return v;
}

// A 90 degree view is 800 x 600 pixels: the focal length is 400 pixels, and the vertical half-angle has a
// tangent of 0.75. Targets are given as offsets (dN, dE, dH) from the eye.
TEST(ViewCone, KnownTargetsLandOnKnownPixels) {
  const struct {
    double azimuth, elevation, dN, dE, dH;
    bool inside;
    double x, y;
  } cases[] = {
      {0, 0, 100, 0, 0, true, 400, 300},       {0, 0, 100, 100, 0, true, 800, 300},   // right edge
      {0, 0, 100, -100, 0, true, 0, 300},      {0, 0, 100, 0, 75, true, 400, 0},       // left and top edges
      {0, 0, 100, 0, -75, true, 400, 600},     {0, 0, 100, 100, 75, true, 800, 0},     // bottom edge, corner
      {0, 0, 100, 0, 76, false, 400, -4},      {0, 0, 100, 200, 0, false, 1200, 300},  // off screen, in front
      {90, 0, 0, 100, 0, true, 400, 300},      {90, 0, -50, 100, 0, true, 600, 300},   // right of east is south
      {180, 0, -100, 0, -25, true, 400, 400},  {270, 0, 0, -100, 0, true, 400, 300},
      {0, 30, 100, 0, 100 * std::tan(30 * kDeg), true, 400, 300},
      {0, 45, 100, 0, 0, false, 400, 700},     // the horizon lies tan(45) * 400 pixels below the centre
  };
  for (const auto& c : cases) {
    const TViewParams v = view(c.azimuth, c.elevation);
    const T3dPosAndDirRotated target(v, Point3(kEye[0] + c.dN, kEye[1] + c.dE, kEye[2] + c.dH));
    const TRectCone cone(v);
    double x = -1, y = -1;
    ASSERT_TRUE(cone.toScreen(target, x, y)) << c.azimuth << ' ' << c.dN << ' ' << c.dE;
    EXPECT_NEAR(x, c.x, 1e-9) << c.azimuth << ' ' << c.dN << ' ' << c.dE << ' ' << c.dH;
    EXPECT_NEAR(y, c.y, 1e-9) << c.azimuth << ' ' << c.dN << ' ' << c.dE << ' ' << c.dH;
    EXPECT_EQ(cone.contains(target), c.inside) << c.azimuth << ' ' << c.dN << ' ' << c.dE << ' ' << c.dH;
    EXPECT_NEAR(std::hypot(target.pos[0], target.pos[1], target.pos[2]), std::hypot(c.dN, c.dE, c.dH), 1e-9);
  }
}

// The four faces: directions on each edge (from azimuth and elevation) are inside, a microradian beyond
// is outside; behind the observer, at the observer and invalid views give nothing.
TEST(ViewCone, EdgesBehindAndInvalidViews) {
  const TViewParams v = view(30, 0, 60);
  const TRectCone cone(v);
  const double halfWidth = 30 * kDeg, halfHeight = 0.5 * v.verticalFieldOfView();
  EXPECT_NEAR(std::tan(halfHeight), std::tan(halfWidth) * 0.75, 1e-15);
  for (double side : {-1.0, 1.0}) {
    EXPECT_TRUE(cone.contains(T3dPosAndDirRotated::FromDirection(v, v.azimuth + side * halfWidth, 0)));
    EXPECT_FALSE(cone.contains(T3dPosAndDirRotated::FromDirection(v, v.azimuth + side * (halfWidth + 1e-6), 0)));
    EXPECT_TRUE(cone.contains(T3dPosAndDirRotated::FromDirection(v, v.azimuth, side * halfHeight)));
    EXPECT_FALSE(cone.contains(T3dPosAndDirRotated::FromDirection(v, v.azimuth, side * (halfHeight + 1e-6))));
  }
  double x = -1, y = -1;
  const T3dPosAndDirRotated behind = T3dPosAndDirRotated::FromDirection(v, v.azimuth + svy_math::units::kPi, 0);
  const T3dPosAndDirRotated side = T3dPosAndDirRotated::FromDirection(v, v.azimuth + 90 * kDeg, 0);
  const T3dPosAndDirRotated atEye(v, kEye);
  // Square to the side the forward component is a rounding residue: far off the screen, never inside.
  EXPECT_FALSE(cone.contains(side));
  for (const T3dPosAndDirRotated* t : {&behind, &atEye}) {
    EXPECT_FALSE(cone.contains(*t));
    EXPECT_FALSE(cone.toScreen(*t, x, y));
  }
  EXPECT_TRUE(x == -1 && y == -1);
  EXPECT_EQ(atEye.dir, Point3(0.0));

  TViewParams bad[5] = {v, v, v, v, v};
  bad[0].fieldOfView = 0, bad[1].fieldOfView = svy_math::units::kPi, bad[2].screenHeight = 0;
  bad[3].elevation = 2.0, bad[4].observer[0] = std::numeric_limits<double>::quiet_NaN();
  for (const TViewParams& b : bad) {
    const TRectCone none(b);
    EXPECT_FALSE(b.isValid() || none.isValid() || none.contains(Point3(0, 0, 1)) || none.toScreen(Point3(0, 0, 1), x, y));
    EXPECT_TRUE(std::isnan(b.verticalFieldOfView()));
  }
}

// The pixel distance from the centre gives the angle off the view axis (atan(r / focal)), and for a level
// view the pixel column gives the horizontal angle; both equal angles computed in the world frame.
TEST(ViewCone, ScreenPositionsAgreeWithWorldAngles) {
  std::mt19937_64 random(3);
  std::uniform_real_distribution<double> unit(-1.0, 1.0);
  for (int i = 0; i < 500; ++i) {
    const TViewParams v = view(180 * unit(random), i % 2 ? 0.0 : 80 * unit(random), 100 + 50 * unit(random));
    const TRectCone cone(v);
    const double focal = 400 / std::tan(0.5 * v.fieldOfView);
    const double targetAz = v.azimuth + 0.8 * unit(random), targetEl = v.elevation * 0.5 + 0.4 * unit(random);
    const double distance = 1000 * (1.5 + unit(random));
    const Point3 offset(distance * std::cos(targetEl) * std::cos(targetAz),
                        distance * std::cos(targetEl) * std::sin(targetAz), distance * std::sin(targetEl));
    const T3dPosAndDirRotated target(v, kEye + offset);
    const Point3 axis(std::cos(v.elevation) * std::cos(v.azimuth), std::cos(v.elevation) * std::sin(v.azimuth),
                      std::sin(v.elevation));
    const double offAxis = std::acos((axis[0] * offset[0] + axis[1] * offset[1] + axis[2] * offset[2]) / distance);
    double x = 0, y = 0;
    if (!cone.toScreen(target, x, y)) {
      EXPECT_GE(offAxis, 0.5 * svy_math::units::kPi - 1e-9);
      continue;
    }
    EXPECT_NEAR(std::atan(std::hypot(x - 400, y - 300) / focal), offAxis, 1e-9);
    if (v.elevation == 0.0) {
      EXPECT_NEAR(std::atan((x - 400) / focal), std::remainder(targetAz - v.azimuth, 2 * svy_math::units::kPi), 1e-9);
    }
    EXPECT_EQ(cone.contains(target), x >= 0 && x <= 800 && y >= 0 && y <= 600) << x << ' ' << y;
  }
}

}  // namespace
