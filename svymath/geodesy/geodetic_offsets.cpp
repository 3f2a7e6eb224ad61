// Offsets of positions: geodetic positions moved by north/east/up metres (the horizontal part along the
// geodesic, see geodesic.h), and earth-centred positions moved by, or related through, local-level vectors.
#include <cmath>

#include "svymath/geodesy/geo_coord.h"
#include "svymath/geodesy/geodetic_offsets.h"
#include "svymath/geodesy/geodesic.h"
#include "svymath/geodesy/local_datum.h"
#include "svymath/geodesy/local_frame.h"

namespace svy_math {
namespace {

bool isFinite(const TAbstractPoint3<double>& v) {
  return std::isfinite(v[0]) && std::isfinite(v[1]) && std::isfinite(v[2]);
}

}  // namespace

bool OffsetWgsCoords(const GeoCoord& from, double dNorth, double dEast, double dUp, GeoCoord& to) {
  double lat = 0.0, lon = 0.0;
  if (!std::isfinite(from.height()) || !std::isfinite(dUp) ||
      !shiftLatLonByDelta(from.lat(), from.lon(), dNorth, dEast, lat, lon))
    return false;
  to = GeoCoord(lat, lon, from.height() + dUp);
  return true;
}

bool GetOffsetFromWgsCoords(const GeoCoord& from, const GeoCoord& to, double& dNorth, double& dEast, double& dUp) {
  if (!std::isfinite(from.height()) || !std::isfinite(to.height()) ||
      !GetNeOffsetFromLatLon(from.lat(), from.lon(), to.lat(), to.lon(), dNorth, dEast))
    return false;
  dUp = to.height() - from.height();
  return true;
}

}  // namespace svy_math

bool Coord::offsetCoord(const svy_math::TAbstractPoint3<double>& enu) {
  if (!svy_math::isFinite(*this) || !svy_math::isFinite(enu)) return false;
  const GeoCoord here = GeoCoord().xyz2blh(*this);
  *this += svy_math::neu_to_xyz(here, enu);
  return true;
}

bool Coord::relatCoord(const Coord& other, svy_math::TAbstractPoint3<double>& enu) const {
  if (!svy_math::isFinite(*this) || !svy_math::isFinite(other)) return false;
  enu = svy_math::blh_to_neu(GeoCoord().xyz2blh(*this), other - *this);
  return true;
}
