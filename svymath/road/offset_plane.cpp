#include "svymath/road/offset_plane.h"

#include <algorithm>
#include <cmath>

#include "svymath/alignments/horz_element_base.h"
#include "svymath/foundation/constants.h"
#include "svymath/road/offset_log.h"
#include "svyutils/svy_err_log.h"

SVY_RTTI_DEFINE(PlaneOffset, CRttiBase)

namespace {

using svy_math::tol::kSnap;
using svy_math::tol::kZero;

// Newton steps that polish the element's foot of a point: the element's own search leaves it within about
// 1e-10 m, so two steps reach rounding.
constexpr int kFootRefinements = 2;

// An angle in radians reduced to (-pi, pi].
double wrapPi(double angle) {
  angle = std::fmod(angle, svy_math::units::kTwoPi);
  if (angle > svy_math::units::kPi) angle -= svy_math::units::kTwoPi;
  if (angle <= -svy_math::units::kPi) angle += svy_math::units::kTwoPi;
  return angle;
}

}  // namespace

PlaneOffset::PlaneOffset(const CHorzAlntElemBase& element, double offset)
    : m_element(&element), m_offset(offset), m_elementLength(0.0), m_ok(false) {
  m_ok = std::isfinite(offset) && element.getHLengthInM(m_elementLength) && std::isfinite(m_elementLength) &&
         boClearsCentres(element, offset, offset);
}

PlaneOffset::~PlaneOffset() = default;

bool PlaneOffset::boClearsCentres(const CHorzAlntElemBase& element, double offsetAtStart, double offsetAtEnd) {
  double length = 0.0;
  if (!element.getHLengthInM(length) || !std::isfinite(length) || !std::isfinite(offsetAtStart) ||
      !std::isfinite(offsetAtEnd)) {
    return false;
  }
  double s = 0.0;
  for (int probe = 0; probe < svy_math::limits::kOffsetCurvatureProbes; ++probe) {
    double curvature = 0.0;
    if (!element.getCurvatureAtLength(s, curvature)) return false;
    const double offset = length > 0.0 ? offsetAtStart + (offsetAtEnd - offsetAtStart) * s / length : offsetAtStart;
    if (!(1.0 - offset * curvature > kZero)) return false;
    if (s >= length) return true;
    const double step = element.getStepForDeviation(s, svy_math::tol::kOffsetCurvatureProbe);
    if (!(step > 0.0)) return false;
    s = std::min(s + step, length);
  }
  svy_logging::svy_err_log(svy_math::kOffsetPointsLogSource, __LINE__, "");
  return false;
}

bool PlaneOffset::turnAt(double elementLength, double& turn) const {
  // Simpson's rule over the curvature (exact for arcs and clothoids) picks the branch; the azimuths give the
  // exact turn, so a curve group turning more than a half circle keeps its full turn.
  double k0 = 0.0, k1 = 0.0, k2 = 0.0, az0 = 0.0, az2 = 0.0;
  if (!m_element->getCurvatureAtLength(0.0, k0) || !m_element->getCurvatureAtLength(0.5 * elementLength, k1) ||
      !m_element->getCurvatureAtLength(elementLength, k2) || !m_element->getAzimuthAtLength(0.0, az0) ||
      !m_element->getAzimuthAtLength(elementLength, az2)) {
    return false;
  }
  const double estimate = elementLength * (k0 + 4.0 * k1 + k2) / 6.0;
  turn = estimate + wrapPi((az2 - az0) * svy_math::units::kDegToRad - estimate);
  return true;
}

bool PlaneOffset::getLengthAtElementLength(double elementLength, double& length) const {
  double turn = 0.0;
  if (!m_ok || !(elementLength >= -kSnap && elementLength <= m_elementLength + kSnap)) return false;
  elementLength = std::min(std::max(elementLength, 0.0), m_elementLength);
  if (!turnAt(elementLength, turn)) return false;
  length = elementLength - m_offset * turn;
  return true;
}

bool PlaneOffset::getLength(double& length) const { return getLengthAtElementLength(m_elementLength, length); }

bool PlaneOffset::getElementLengthAtLength(double length, double& elementLength) const {
  double total = 0.0;
  if (!getLength(total) || !(length >= -kSnap && length <= total + kSnap)) return false;
  length = std::min(std::max(length, 0.0), total);
  // The map s -> s - offset * turn(s) rises with slope 1 - offset * k > 0: Newton's method from the
  // proportional guess, kept inside the element.
  double s = total > 0.0 ? length * m_elementLength / total : 0.0;
  for (int i = 0; i < svy_math::limits::kOffsetLengthIterations; ++i) {
    double at = 0.0, curvature = 0.0;
    if (!getLengthAtElementLength(s, at) || !m_element->getCurvatureAtLength(s, curvature)) return false;
    const double step = (length - at) / (1.0 - m_offset * curvature);
    s = std::min(std::max(s + step, 0.0), m_elementLength);
    if (std::fabs(step) < svy_math::tol::kOffsetLengthConvergence) {
      elementLength = s;
      return true;
    }
  }
  svy_logging::svy_err_log(svy_math::kOffsetPointsLogSource, __LINE__, "");
  return false;
}

bool PlaneOffset::getPosNeAtLength(double length, double& north, double& east) const {
  double s = 0.0;
  return getElementLengthAtLength(length, s) && m_element->getPosAtLengthAndOffset(s, m_offset, north, east);
}

bool PlaneOffset::getAzimuthAtLength(double length, double& azimuthDeg) const {
  double s = 0.0;
  return getElementLengthAtLength(length, s) && m_element->getAzimuthAtLength(s, azimuthDeg);
}

bool PlaneOffset::getLengthAndOffset(double north, double east, double& length, double& offset) const {
  double s = 0.0, fromElement = 0.0, along = 0.0;
  if (!m_ok || !m_element->getLengthAndOffset(north, east, s, fromElement)) return false;
  // The element's foot is found to its own search tolerance, which a point far to the side magnifies on the
  // offset curve: Newton steps on the foot condition (the point's component along the tangent is zero) bring
  // it to rounding. Moving the foot by ds moves the point's tangent component by (1 - offset * k) ds.
  for (int i = 0; i < kFootRefinements; ++i) {
    double n = 0.0, e = 0.0, azimuth = 0.0, curvature = 0.0;
    if (!m_element->getPosNeAtLength(s, n, e) || !m_element->getAzimuthAtLength(s, azimuth) ||
        !m_element->getCurvatureAtLength(s, curvature)) {
      return false;
    }
    const double az = azimuth * svy_math::units::kDegToRad;
    const double dn = north - n, de = east - e;
    fromElement = -dn * std::sin(az) + de * std::cos(az);
    const double slope = 1.0 - fromElement * curvature;
    if (!(slope > kZero)) break;
    s = std::min(std::max(s + (dn * std::cos(az) + de * std::sin(az)) / slope, 0.0), m_elementLength);
  }
  double n = 0.0, e = 0.0, azimuth = 0.0;
  if (!m_element->getPosNeAtLength(s, n, e) || !m_element->getAzimuthAtLength(s, azimuth) ||
      !getLengthAtElementLength(s, along)) {
    return false;
  }
  const double az = azimuth * svy_math::units::kDegToRad;
  length = along;
  offset = -(north - n) * std::sin(az) + (east - e) * std::cos(az) - m_offset;
  return true;
}
