#pragma once
// Internal: the side and distance of a point relative to a curve position, shared by the projections of the
// curve data records and the curve elements.
#include <cmath>

namespace svy_math {
namespace detail {

// Offset of (north, east) from the curve point (onNorth, onEast) whose tangent azimuth is azimuthRad:
// positive to the right of the direction of travel.
inline double offsetAcross(double north, double east, double onNorth, double onEast, double azimuthRad) {
  return -std::sin(azimuthRad) * (north - onNorth) + std::cos(azimuthRad) * (east - onEast);
}

// Distance from (north, east) to the curve point, carrying the sign of the offset across the tangent.
inline double signedDistance(double north, double east, double onNorth, double onEast, double azimuthRad) {
  const double distance = std::hypot(north - onNorth, east - onEast);
  return offsetAcross(north, east, onNorth, onEast, azimuthRad) < 0.0 ? -distance : distance;
}

}  // namespace detail
}  // namespace svy_math
