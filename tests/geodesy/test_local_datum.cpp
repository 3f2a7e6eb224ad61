// Local datum, site plane coordinates, grid/ground scaling and the radii of curvature: against an
// independent local Cartesian frame, geodesic distances, and by round trips.
#include <gtest/gtest.h>

#include <GeographicLib/LocalCartesian.hpp>
#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geodesic.h"
#include "svymath/geodesy/geodetic_offsets.h"
#include "svymath/geodesy/geomath_consts.h"
#include "svymath/geodesy/grid_ground.h"
#include "svymath/geodesy/local_datum.h"

namespace {

using Vec3 = svy_math::TAbstractPoint3<double>;
using svy_math::TGeomathConsts;
using svy_math::units::kDegToRad;

const GeographicLib::Geocentric& independentEarth() {
  static const GeographicLib::Geocentric earth(TGeomathConsts::a(), TGeomathConsts::f());
  return earth;
}

// Origins over the globe (a pole and the antimeridian too) and points up to 50 km away: Ptl against the
// independent frame, back to geodetic, through site plane coordinates with a rotation and back, and the
// vector between two local points read in the frame at the first.
TEST(LocalDatum, MatchesIndependentFrameAndRoundTrips) {
  const double origins[][3] = {{47.4, 8.5, 450.0}, {-33.9, 151.2, 20.0}, {89.99, 0.0, 0.0}, {0.0, 179.9, -30.0}};
  for (const auto& o : origins) {
    svy_math::TLocDatum datum;
    ASSERT_TRUE(InitializeLPS2(datum, GeoCoord(o[0] * kDegToRad, o[1] * kDegToRad, o[2]), 5.0e6, 5.0e5, 400.0,
                               12.0 * kDegToRad));
    const GeographicLib::LocalCartesian frame(o[0], o[1], o[2], independentEarth());
    for (const double d : {0.0, 0.001, 0.3}) {
      const double lat = std::min(90.0, o[0] + d), lon = o[1] - d, h = o[2] + 100.0 * d;
      Vec3 ptl, ptlAtA;
      double enu[3];
      frame.Forward(lat, lon, h, enu[0], enu[1], enu[2]);
      ASSERT_TRUE(WGSCoordsToPtl(datum, lat, lon, h, ptl));
      for (int k = 0; k < 3; ++k) EXPECT_NEAR(ptl[k], enu[k], 1e-7) << o[0] << " " << d;
      double latBack = 0, lonBack = 0, hBack = 0;
      ASSERT_TRUE(PtlToWGSCoords(datum, ptl, latBack, lonBack, hBack));
      EXPECT_NEAR(latBack, lat, 1e-11);
      EXPECT_NEAR(std::remainder(lonBack - lon, 360.0) * std::cos(lat * kDegToRad), 0.0, 1e-11);
      EXPECT_NEAR(hBack, h, 1e-6);
      TCoords en;
      ASSERT_TRUE(PtlToENCoords(datum, ptl, en));
      ASSERT_TRUE(ENCoordsToPtl(datum, en, ptlAtA));
      EXPECT_LT((ptlAtA - ptl).Module(), 1e-8);
      // The vector from the origin's Ptl (0, 0, 0) to this point read at the origin is the Ptl itself; read
      // at this point, it is the independent frame's view of the origin from here (not at the pole, where
      // the frame's east depends on a longitude the pole does not have).
      Vec3 denu;
      ASSERT_TRUE(PtlTodENU(datum, Vec3(0, 0, 0), ptl, denu));
      EXPECT_LT((denu - ptl).Module(), 1e-7);
      if (lat == 90.0) continue;
      const GeographicLib::LocalCartesian here(lat, lon, h, independentEarth());
      ASSERT_TRUE(PtlTodENU(datum, ptl, Vec3(0, 0, 0), denu));
      here.Forward(o[0], o[1], o[2], enu[0], enu[1], enu[2]);
      for (int k = 0; k < 3; ++k) EXPECT_NEAR(denu[k], enu[k], 1e-7);
    }
  }
}

// Site plane coordinates: a true-north vector of 100 m with the site's grid north 30 degrees clockwise of
// true north has the site azimuth -30 degrees; the height follows up from height0.
TEST(LocalDatum, SiteRotationAndFailures) {
  svy_math::TLocDatum datum;
  TCoords en;
  Vec3 ptl;
  EXPECT_FALSE(PtlToENCoords(datum, Vec3(0, 0, 0), en));
  EXPECT_FALSE(datum.blh2loc(GeoCoord(0.1, 0.1, 0), ptl));
  EXPECT_FALSE(InitializeLPS2(datum, GeoCoord(1.6, 0, 0)));
  EXPECT_FALSE(InitializeLPS2(datum, GeoCoord(0.5, std::nan(""), 0)));
  ASSERT_TRUE(InitializeLPS2(datum, GeoCoord(0.8, 0.1, 300.0), 1000.0, 2000.0, 50.0, 30.0 * kDegToRad));
  ASSERT_TRUE(PtlToENCoords(datum, Vec3(0.0, 100.0, -2.0), en));
  EXPECT_NEAR(en.north, 1000.0 + 100.0 * std::cos(30.0 * kDegToRad), 1e-12);
  EXPECT_NEAR(en.east, 2000.0 - 100.0 * std::sin(30.0 * kDegToRad), 1e-12);
  EXPECT_DOUBLE_EQ(en.height, 48.0);
  EXPECT_FALSE(WGSCoordsToPtl(datum, 91.0, 0.0, 0.0, ptl));
}

// Radii of curvature against geodesic distances: a short meridian arc is M dB, a short step east along the
// parallel is (1 / invlon) dL; the Gaussian radius lies between M and N.
TEST(GeomathConsts, RadiiMatchGeodesicDistances) {
  const double dAngle = 1e-6;  // radians: arcs of ~6 m, where chord and arc agree to 1e-12
  for (const double latDeg : {0.0, 23.5, 45.0, 67.0, 89.0}) {
    const double lat = latDeg * kDegToRad;
    double s = 0, az1 = 0, az2 = 0;
    ASSERT_TRUE(invers(lat - dAngle / 2, 0.3, lat + dAngle / 2, 0.3, s, az1, az2));
    EXPECT_NEAR(s / dAngle, TGeomathConsts::meridianRadius(lat), 1e-3) << latDeg;
    double lat2 = 0, lon2 = 0;
    ASSERT_TRUE(shiftLatLonByDelta(lat, 0.3, 0.0, 1.0, lat2, lon2));
    EXPECT_NEAR((lon2 - 0.3) / invlon(lat), 1.0, 1e-9) << latDeg;
    const double r = TGeomathConsts::gaussianRadius(lat);
    EXPECT_LE(TGeomathConsts::meridianRadius(lat), r);
    EXPECT_LE(r, TGeomathConsts::primeVerticalRadius(lat));
  }
  EXPECT_EQ(cosphi(svy_math::units::kHalfPi), 0.0);
  EXPECT_EQ(invlon(-svy_math::units::kHalfPi), std::numeric_limits<double>::infinity());
  EXPECT_NEAR(TGeomathConsts::b(), 6356752.314, 1e-3);  // the published polar semi-axis of the ellipsoid
}

// Grid/ground: the height factor is the ratio of lengths on the ellipsoid to lengths at the site's height
// (between the east-west and north-south ratios); grid and ground round trip at survey coordinates and
// every distance from the base scales by the factor.
TEST(GridGround, CombinedFactorAndRoundTrips) {
  const double lat = 46.0 * kDegToRad, h = 1200.0, k0 = 0.9996;
  const double factor = CombinedScaleFactor(lat, h, k0);
  const double m = TGeomathConsts::meridianRadius(lat), n = TGeomathConsts::primeVerticalRadius(lat);
  EXPECT_GT(factor / k0, m / (m + h));
  EXPECT_LT(factor / k0, n / (n + h));
  EXPECT_DOUBLE_EQ(CombinedScaleFactor(lat, 0.0, k0), k0);
  const C2dPos base(5.1e6, 4.9e5);
  for (const C2dPos& ground : {C2dPos(5.1e6 + 1234.567, 4.9e5 - 876.5), C2dPos(5.1e6, 4.9e5), C2dPos(5.0e6, 5.3e5)}) {
    C2dPos grid, back;
    ASSERT_TRUE(GroundToGrid(base, factor, ground, grid));
    ASSERT_TRUE(GridToGround(base, factor, grid, back));
    EXPECT_LT((back - ground).Module(), 2e-9);
    EXPECT_NEAR((grid - base).Module(), factor * (ground - base).Module(), 1e-8);
  }
  C2dPos out(1, 2);
  EXPECT_FALSE(GroundToGrid(base, 0.0, base, out));
  EXPECT_FALSE(GridToGround(base, std::nan(""), base, out));
  EXPECT_TRUE(std::isnan(CombinedScaleFactor(2.0, 0.0, 1.0)));
  EXPECT_TRUE(std::isnan(CombinedScaleFactor(0.0, -7.0e6, 1.0)));
}

// Offsets: a geodetic position moved by north/east/up and measured back; an earth-centred one moved by a
// local vector, related back, and read against the independent local frame.
TEST(GeodeticOffsets, RoundTripsAndIndependentFrame) {
  const double cases[][6] = {{47.4, 8.5, 450.0, 12.5, -7.25, 3.0}, {-89.5, 120.0, 0.0, 1500.0, 2500.0, -40.0},
                             {0.0, -179.9999, 10.0, -0.001, 0.002, 0.0}};
  for (const auto& c : cases) {
    const GeoCoord start(c[0] * kDegToRad, c[1] * kDegToRad, c[2]);
    GeoCoord moved;
    double dn = 0, de = 0, du = 0;
    ASSERT_TRUE(OffsetWgsCoords(start, c[3], c[4], c[5], moved));
    ASSERT_TRUE(GetOffsetFromWgsCoords(start, moved, dn, de, du));
    EXPECT_NEAR(dn, c[3], 1e-8);
    EXPECT_NEAR(de, c[4], 1e-8);
    EXPECT_NEAR(du, c[5], 1e-9);
    const Coord origin = Coord().blh2xyz(start);
    Coord p = origin;
    Vec3 enu;
    ASSERT_TRUE(p.offsetCoord(Vec3(c[4], c[3], c[5])));
    ASSERT_TRUE(origin.relatCoord(p, enu));
    EXPECT_LT((enu - Vec3(c[4], c[3], c[5])).Module(), 1e-8);
    const GeographicLib::LocalCartesian frame(c[0], c[1], c[2], independentEarth());
    double lat = 0, lon = 0, h = 0, x = 0, y = 0, z = 0;
    independentEarth().Reverse(p.x(), p.y(), p.z(), lat, lon, h);
    frame.Forward(lat, lon, h, x, y, z);
    EXPECT_LT((Vec3(x, y, z) - enu).Module(), 1e-6);
  }
  GeoCoord out;
  EXPECT_FALSE(OffsetWgsCoords(GeoCoord(0, 0, std::nan("")), 1, 1, 1, out));
  Coord bad(std::nan(""), 0, 0);
  EXPECT_FALSE(bad.offsetCoord(Vec3(1, 1, 1)));
}

}  // namespace
