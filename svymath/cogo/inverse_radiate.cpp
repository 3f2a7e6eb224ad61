#include "svymath/cogo/inverse_radiate.h"

#include <cmath>

#include "svymath/foundation/constants.h"

namespace {

using svy_math::tol::kZero;
using svy_math::units::kDegToRad;
using svy_math::units::kRadToDeg;
using svy_math::units::kTwoPi;

// Azimuth of the plane direction (dE, dN), clockwise from north: atan2(dE, dN), plus 2 pi when negative.
double azimuthOf(double dE, double dN) {
  const double azimuth = std::atan2(dE, dN);
  return azimuth < 0.0 ? azimuth + kTwoPi : azimuth;
}

bool isStrictlyZero(double x) { return -kZero < x && x < kZero; }

// a equals b within t, bounds included.
bool equalWithin(double a, double b, double t) { return b - t <= a && a <= b + t; }

bool hasFinitePlaneComponents(const TCoords& p) {
  return std::isfinite(p.north) && std::isfinite(p.east);
}

}  // namespace

bool Inverse2D(const double& e1, const double& n1, const double& e2, const double& n2,
               double& azimuth, double& distance) {
  const double dE = e2 - e1;
  const double dN = n2 - n1;
  distance = std::sqrt(dN * dN + dE * dE);
  azimuth = (isStrictlyZero(dE) && isStrictlyZero(dN)) ? 0.0 : azimuthOf(dE, dN);
  return std::isfinite(distance) && std::isfinite(azimuth);
}

bool Inverse3D(const double& e1, const double& n1, const double& z1, const double& e2,
               const double& n2, const double& z2, double& azimuth, double& slopeDistance,
               double& zenith) {
  const double dE = e2 - e1;
  const double dN = n2 - n1;
  const double dZ = z2 - z1;
  const double horizontal = std::sqrt(dE * dE + dN * dN);
  const double slope = std::sqrt(horizontal * horizontal + dZ * dZ);
  if (isStrictlyZero(slope)) return false;
  azimuth = azimuthOf(dE, dN);
  zenith = std::acos(dZ / slope);
  slopeDistance = slope;
  return true;
}

bool Radiate2D(const double& e, const double& n, const double& azimuth, const double& distance,
               double& eastOut, double& northOut) {
  eastOut = e + distance * std::sin(azimuth);
  northOut = n + distance * std::cos(azimuth);
  return true;
}

void Compute2DPoint(double e, double n, double distance, double azimuthDeg, double addedAngleDeg,
                    double& eastOut, double& northOut) {
  const double direction = (azimuthDeg + addedAngleDeg) * kDegToRad;
  eastOut = e + distance * std::sin(direction);
  northOut = n + distance * std::cos(direction);
}

void Compute2DPointBLH(double latitude, double longitude, double distance, double azimuthDeg,
                       double addedAngleDeg, double& latitudeOut, double& longitudeOut) {
  using svy_math::units::kSphereDegPerMetre;
  using svy_math::units::kSphereEarthRadius;
  const double direction = (azimuthDeg + addedAngleDeg) * kDegToRad;
  const double newLatitude = latitude + std::cos(direction) * distance * kSphereDegPerMetre;
  // Radius of the parallel at the mean latitude of the step.
  const double parallelRadius =
      std::cos((newLatitude + latitude) / 2.0 * kDegToRad) * kSphereEarthRadius;
  latitudeOut = newLatitude;
  longitudeOut = parallelRadius >= svy_math::tol::kPoleParallelRadius
                     ? longitude + std::sin(direction) * distance * kRadToDeg / parallelRadius
                     : longitude;
}

int Compute3DPoint(const TCoords& from, const TCoords& through, double distance, TCoords& out) {
  const double dN = through.north - from.north;
  const double dE = through.east - from.east;
  const double dZ = through.height - from.height;
  const double length = std::sqrt(dN * dN + dE * dE + dZ * dZ);
  // Written as a negated comparison so that a NaN length fails too; an infinite one has no direction.
  if (!(length >= svy_math::tol::kMinLineLength3D) || !std::isfinite(length)) return 0;
  const double scale = distance / length;
  out.north = through.north + dN * scale;
  out.east = through.east + dE * scale;
  out.height = through.height + dZ * scale;
  return 1;
}

double HorizontalDistance(double x1, double y1, double x2, double y2) {
  const double dx = x2 - x1;
  const double dy = y2 - y1;
  return std::sqrt(dx * dx + dy * dy);
}

int dENSoutInfo(double a, double b, double height, double angleDeg, double& aOut, double& bOut,
                double& heightOut) {
  heightOut = height;
  aOut = 0.0;
  bOut = 0.0;
  if (a * a + b * b < svy_math::tol::kVectorLengthSqZero) return 0;
  const double theta = angleDeg * kDegToRad;
  const double cosTheta = std::cos(theta);
  const double sinTheta = std::sin(theta);
  aOut = a * cosTheta - b * sinTheta;
  bOut = a * sinTheta + b * cosTheta;
  return 1;
}

bool boCompute2DDistanceBetweenCoords(const TCoords& p1, const TCoords& p2, double& distance) {
  if (!hasFinitePlaneComponents(p1) || !hasFinitePlaneComponents(p2)) return false;
  const double dN = p1.north - p2.north;
  const double dE = p1.east - p2.east;
  distance = std::sqrt(dN * dN + dE * dE);
  return std::isfinite(distance);
}

bool boComputeAzimuthBetweenCoords(const TCoords& p1, const TCoords& p2, double& azimuth) {
  using svy_math::tol::kSamePoint;
  if (!hasFinitePlaneComponents(p1) || !hasFinitePlaneComponents(p2)) return false;
  if (equalWithin(p1.east, p2.east, kSamePoint) && equalWithin(p1.north, p2.north, kSamePoint))
    return false;
  double distance = 0.0;
  return Inverse2D(p1.east, p1.north, p2.east, p2.north, azimuth, distance);
}
