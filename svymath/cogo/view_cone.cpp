#include "svymath/cogo/view_cone.h"

#include <cmath>

#include "svymath/foundation/constants.h"

namespace svy_math {
namespace {

constexpr double kHalf = 0.5;

}  // namespace

bool TViewParams::isValid() const {
  return std::isfinite(observer[0]) && std::isfinite(observer[1]) && std::isfinite(observer[2]) &&
         std::isfinite(azimuth) && elevation >= -units::kHalfPi && elevation <= units::kHalfPi &&
         fieldOfView > 0.0 && fieldOfView < units::kPi && screenWidth > 0 && screenHeight > 0;
}

double TViewParams::verticalFieldOfView() const {
  if (!isValid()) return undefinedValue();
  return 2.0 * std::atan(std::tan(kHalf * fieldOfView) * screenHeight / screenWidth);
}

T3dPosAndDirRotated::T3dPosAndDirRotated() : pos(0.0), dir(0.0) {}

T3dPosAndDirRotated::T3dPosAndDirRotated(const TViewParams& view, const TAbstractPoint3<double>& target)
    : T3dPosAndDirRotated(view, target[0] - view.observer[0], target[1] - view.observer[1],
                          target[2] - view.observer[2]) {}

T3dPosAndDirRotated T3dPosAndDirRotated::FromDirection(const TViewParams& view, double azimuth, double elevation) {
  const double horizontal = std::cos(elevation);
  return T3dPosAndDirRotated(view, horizontal * std::cos(azimuth), horizontal * std::sin(azimuth),
                             std::sin(elevation));
}

T3dPosAndDirRotated::T3dPosAndDirRotated(const TViewParams& view, double dN, double dE, double dH) {
  const double sinAz = std::sin(view.azimuth);
  const double cosAz = std::cos(view.azimuth);
  const double sinEl = std::sin(view.elevation);
  const double cosEl = std::cos(view.elevation);
  // Axes of the observer's frame in (N, E, H): right = (-sin az, cos az, 0),
  // up = (-sin el cos az, -sin el sin az, cos el), forward = (cos el cos az, cos el sin az, sin el).
  const double level = dN * cosAz + dE * sinAz;  // the horizontal component along the view azimuth
  pos[0] = -dN * sinAz + dE * cosAz;
  pos[1] = -sinEl * level + cosEl * dH;
  pos[2] = cosEl * level + sinEl * dH;
  const double length = std::hypot(pos[0], pos[1], pos[2]);
  dir = pos;
  if (length > 0.0) dir /= length;
}

TRectCone::TRectCone(const TViewParams& view) : m_valid(view.isValid()) {
  if (!m_valid) return;
  m_tanHalfWidth = std::tan(kHalf * view.fieldOfView);
  m_tanHalfHeight = m_tanHalfWidth * view.screenHeight / view.screenWidth;
  m_centreX = kHalf * view.screenWidth;
  m_centreY = kHalf * view.screenHeight;
  m_focal = m_centreX / m_tanHalfWidth;
}

bool TRectCone::contains(const TAbstractPoint3<double>& direction) const {
  const double forward = direction[2];
  if (!m_valid || !(forward > 0.0)) return false;
  const double margin = 1.0 + tol::kViewConeEdge;
  return std::fabs(direction[0]) <= m_tanHalfWidth * margin * forward &&
         std::fabs(direction[1]) <= m_tanHalfHeight * margin * forward;
}

bool TRectCone::toScreen(const TAbstractPoint3<double>& direction, double& x, double& y) const {
  const double forward = direction[2];
  if (!m_valid || !(forward > 0.0)) return false;
  const double screenX = m_centreX + m_focal * (direction[0] / forward);
  const double screenY = m_centreY - m_focal * (direction[1] / forward);
  if (!std::isfinite(screenX) || !std::isfinite(screenY)) return false;
  x = screenX;
  y = screenY;
  return true;
}

}  // namespace svy_math
