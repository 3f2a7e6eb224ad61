#include "svymath/geodesy/local_datum.h"

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/local_frame.h"

namespace svy_math {
namespace {

using Vec3 = TAbstractPoint3<double>;

bool isFinite(const Vec3& v) { return std::isfinite(v[0]) && std::isfinite(v[1]) && std::isfinite(v[2]); }

}  // namespace

Vec3 neu_to_xyz(const Vec3& blh, const Vec3& enu) {
  const double sinB = std::sin(blh[0]), cosB = std::cos(blh[0]), sinL = std::sin(blh[1]), cosL = std::cos(blh[1]);
  const double e = enu[0], n = enu[1], u = enu[2];
  // Component along the meridian plane, outward from the polar axis.
  const double outward = -sinB * n + cosB * u;
  return Vec3(cosL * outward - sinL * e, sinL * outward + cosL * e, cosB * n + sinB * u);
}

bool TLocDatum::blh2loc(const GeoCoord& blh, Vec3& ptl) const {
  if (!initialized || !isFinite(blh)) return false;
  ptl = blh_to_neu(origin, Coord().blh2xyz(blh) - originXyz);
  return true;
}

bool TLocDatum::loc2blh(const Vec3& ptl, GeoCoord& blh) const {
  if (!initialized || !isFinite(ptl)) return false;
  const Coord xyz = originXyz + neu_to_xyz(origin, ptl);
  GeoCoord g;
  g.xyz2blh(xyz);
  if (!isFinite(g)) return false;
  blh = g;
  return true;
}

bool InitializeLPS2(TLocDatum& datum, const GeoCoord& origin, double north0, double east0, double height0,
                    double rotation) {
  if (!isFinite(origin) || std::fabs(origin.lat()) > units::kHalfPi || !std::isfinite(north0) ||
      !std::isfinite(east0) || !std::isfinite(height0) || !std::isfinite(rotation))
    return false;
  datum.origin = origin;
  datum.north0 = north0;
  datum.east0 = east0;
  datum.height0 = height0;
  datum.rotation = rotation;
  datum.originXyz.blh2xyz(origin);
  datum.initialized = true;
  return true;
}

bool PtlToENCoords(const TLocDatum& datum, const Vec3& ptl, TCoords& en) {
  if (!datum.initialized || !isFinite(ptl)) return false;
  // Site azimuth = true azimuth - rotation: turn the (north, east) vector anticlockwise by the rotation.
  const double c = std::cos(datum.rotation), s = std::sin(datum.rotation);
  en.north = datum.north0 + c * ptl[1] + s * ptl[0];
  en.east = datum.east0 - s * ptl[1] + c * ptl[0];
  en.height = datum.height0 + ptl[2];
  return true;
}

bool ENCoordsToPtl(const TLocDatum& datum, const TCoords& en, Vec3& ptl) {
  if (!datum.initialized || !std::isfinite(en.north) || !std::isfinite(en.east) || !std::isfinite(en.height))
    return false;
  const double c = std::cos(datum.rotation), s = std::sin(datum.rotation);
  const double dn = en.north - datum.north0, de = en.east - datum.east0;
  ptl = Vec3(s * dn + c * de, c * dn - s * de, en.height - datum.height0);
  return true;
}

bool WGSCoordsToPtl(const TLocDatum& datum, double latDeg, double lonDeg, double height, Vec3& ptl) {
  if (!(std::fabs(latDeg) <= units::kRightAngleDeg)) return false;
  return datum.blh2loc(GeoCoord(latDeg * units::kDegToRad, lonDeg * units::kDegToRad, height), ptl);
}

bool PtlToWGSCoords(const TLocDatum& datum, const Vec3& ptl, double& latDeg, double& lonDeg, double& height) {
  GeoCoord g;
  if (!datum.loc2blh(ptl, g)) return false;
  latDeg = g.lat() * units::kRadToDeg;
  lonDeg = std::remainder(g.lon() * units::kRadToDeg, units::kFullCircleDeg);
  height = g.height();
  return true;
}

bool PtlTodENU(const TLocDatum& datum, const Vec3& from, const Vec3& to, Vec3& denu) {
  GeoCoord atFrom;
  if (!datum.loc2blh(from, atFrom) || !isFinite(to)) return false;
  // Both points share the origin's frame: their difference, back to earth-centred axes, then into the frame
  // at `from`.
  denu = blh_to_neu(atFrom, neu_to_xyz(datum.origin, to - from));
  return true;
}

}  // namespace svy_math
