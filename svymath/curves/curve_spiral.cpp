#include "svymath/curves/curve_spiral.h"

#include <cmath>

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CCurveSpiral, CGenericSpiral)

namespace {

using svy_math::tol::kProjectionLength;
using svy_math::tol::kZero;

// The element is sampled at this many intervals to bracket every foot point: a spiral turns by less than a
// quarter turn over a sample interval, so each interval holds at most one minimum of the distance.
constexpr int kProjectionSamples = 32;
// Cap of the refinement in one bracket. Newton converges in a handful of steps and the bisection fallback
// halves the bracket each step, so 100 steps reach below kProjectionLength for any bracket up to 1e20 m.
constexpr int kRefineIterationCap = 100;

// Tangential and normal components of the vector from the spiral point at s to the local point.
bool componentsAt(const CCurveDataSpiral& data, double north, double east, double s, double& along,
                  double& offset) {
  double onNorth = 0.0;
  double onEast = 0.0;
  if (!data.getPosAtLength(s, onNorth, onEast)) return false;
  const double azimuth = data.GetAzimuth(s) * svy_math::units::kDegToRad;
  const double dN = north - onNorth;
  const double dE = east - onEast;
  along = std::cos(azimuth) * dN + std::sin(azimuth) * dE;
  offset = -std::sin(azimuth) * dN + std::cos(azimuth) * dE;
  return std::isfinite(along) && std::isfinite(offset);
}

double snapToZero(double value) { return std::fabs(value) < kZero ? 0.0 : value; }

}  // namespace

struct CCurveSpiral::TFoot {
  double length = 0.0;    // length of the foot (or end) on the element
  double along = 0.0;     // component along the tangent there (0 at a true foot)
  double offset = 0.0;    // component square to the tangent, positive to the right
  bool interior = false;  // a foot of the perpendicular, not an end

  double distance() const { return std::hypot(along, offset); }
};

CCurveSpiral::~CCurveSpiral() = default;

CGenericSegment* CCurveSpiral::clone() const { return new CCurveSpiral(*this); }

bool CCurveSpiral::findFoot(double localNorth, double localEast, TFoot& foot) const {
  const double total = m_data.getTotalLength();
  if (!m_data.isok() || !(total >= 0.0) || !std::isfinite(total)) return false;
  TFoot best;
  if (!componentsAt(m_data, localNorth, localEast, 0.0, best.along, best.offset)) return false;
  double lo = 0.0;
  double loAlong = best.along;
  for (int i = 1; i <= kProjectionSamples; ++i) {
    const double hi = total * i / kProjectionSamples;
    TFoot sample;
    sample.length = hi;
    if (!componentsAt(m_data, localNorth, localEast, hi, sample.along, sample.offset)) return false;
    if (i == kProjectionSamples && sample.distance() < best.distance()) best = sample;
    // The distance has a minimum where the along component falls through zero.
    if (loAlong > 0.0 && sample.along <= 0.0) {
      double a = lo;
      double b = hi;
      double s = a + (b - a) * loAlong / (loAlong - sample.along);
      TFoot candidate;
      for (int iteration = 0; iteration < kRefineIterationCap; ++iteration) {
        candidate.length = s;
        if (!componentsAt(m_data, localNorth, localEast, s, candidate.along, candidate.offset)) return false;
        if (candidate.along > 0.0) {
          a = s;
        } else {
          b = s;
        }
        // d(along)/ds = -1 + curvature * offset: negative wherever the point is a distance minimum.
        const double slope = -1.0 + m_data.getCurvatureAtLength(s) * candidate.offset;
        double next = slope < 0.0 ? s - candidate.along / slope : 0.5 * (a + b);
        if (!(next > a && next < b)) next = 0.5 * (a + b);
        const bool converged = std::fabs(next - s) < kProjectionLength || b - a < kProjectionLength;
        s = next;
        if (converged) break;
      }
      candidate.length = s;
      if (!componentsAt(m_data, localNorth, localEast, s, candidate.along, candidate.offset)) return false;
      candidate.interior = true;
      if (candidate.distance() < best.distance()) best = candidate;
    }
    lo = hi;
    loAlong = sample.along;
  }
  foot = best;
  return true;
}

bool CCurveSpiral::getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const {
  double localNorth = 0.0;
  double localEast = 0.0;
  TFoot foot;
  if (!toLocal(north, east, localNorth, localEast) || !findFoot(localNorth, localEast, foot)) return false;
  len = foot.length;
  dist = foot.offset < 0.0 ? -foot.distance() : foot.distance();
  return true;
}

bool CCurveSpiral::getLengthAndOffset(double north, double east, double& length, double& offset) const {
  double localNorth = 0.0;
  double localEast = 0.0;
  TFoot foot;
  if (!toLocal(north, east, localNorth, localEast) || !findFoot(localNorth, localEast, foot)) return false;
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
