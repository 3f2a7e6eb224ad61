#include "svymath/curves/curve_spiral.h"

#include <cmath>

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CCurveSpiral, CGenericSpiral)

namespace {

double snapToZero(double value) { return std::fabs(value) < svy_math::tol::kZero ? 0.0 : value; }

}  // namespace

CCurveSpiral::~CCurveSpiral() = default;

CGenericSegment* CCurveSpiral::clone() const { return new CCurveSpiral(*this); }

bool CCurveSpiral::getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const {
  double localNorth = 0.0;
  double localEast = 0.0;
  return toLocal(north, east, localNorth, localEast) &&
         m_data.getShortestDistAndCurveLen(localNorth, localEast, dist, len);
}

bool CCurveSpiral::getLengthAndOffset(double north, double east, double& length, double& offset) const {
  double localNorth = 0.0;
  double localEast = 0.0;
  CCurveDataSpiral::TFoot foot;
  if (!toLocal(north, east, localNorth, localEast) || !m_data.findFoot(localNorth, localEast, foot)) return false;
  // Beside an end, the length runs on along that end's tangent.
  const double along = snapToZero(foot.interior ? foot.length : foot.length + foot.along);
  if (!checkDistanceAlongIsOnLine(along)) return false;
  length = along;
  offset = snapToZero(foot.offset);
  return true;
}

bool CCurveSpiral::getShortestDistanceToPoint(double north, double east, double& distance) const {
  double dist = 0.0;
  double len = 0.0;
  if (!getShortestDistAndCurveLen(north, east, dist, len)) return false;
  distance = std::fabs(dist);
  return true;
}

double CCurveSpiral::getStartRadius() const { return m_data.getStartRadius(); }

double CCurveSpiral::getEndRadius() const { return m_data.getFinalRadius(); }

double CCurveSpiral::getSpiralParam() const { return m_data.getSpiralParam(); }

double CCurveSpiral::getLengthAtAzimuth(const CMathAngle& azimuth) const {
  return m_data.getLengthAtAzimuth(azimuth - m_orgAz);
}
