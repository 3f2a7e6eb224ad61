#include "svymath/road/cross_section_point.h"

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/road/cross_section.h"

SVY_RTTI_DEFINE(CRoadCrossSectPoint, CRttiBase)
SVY_RTTI_DEFINE(CRoadCrossSectOffsPoint, CRoadCrossSectPoint)

using svy_math::tol::kZero;

CRoadCrossSectPoint::CRoadCrossSectPoint() : m_section(nullptr), m_left(nullptr), m_right(nullptr) {}

CRoadCrossSectPoint::~CRoadCrossSectPoint() {
  if (m_section != nullptr) m_section->onPointDetaching(*this);
}

C2dPos CRoadCrossSectPoint::getPosition() const { return getPosAtOffset(getOffset(), false); }

C2dPos CRoadCrossSectPoint::getElevAndOffs() const { return C2dPos(getElevation(), getOffset()); }

C2dPos CRoadCrossSectPoint::getPosAtOffset(double offset, bool fromThisPoint) const {
  const double fromCentre = fromThisPoint ? getOffset() + offset : offset;
  if (m_section != nullptr) return m_section->getPosAtOffset(fromCentre);
  return C2dPos(0.0, fromCentre);
}

double CRoadCrossSectPoint::getElevationFromSurfaceRight(double offset) const {
  return m_right != nullptr ? getElevationFromSurface(offset, *m_right) : svy_math::undefinedValue();
}

double CRoadCrossSectPoint::getElevationFromSurfaceLeft(double offset) const {
  return m_left != nullptr ? getElevationFromSurface(offset, *m_left) : svy_math::undefinedValue();
}

double CRoadCrossSectPoint::getSlopeRatio(const CRoadCrossSectPoint& other) const {
  const double rise = other.getElevation() - getElevation();
  if (-kZero < rise && rise < kZero) return 0.0;
  const double run = other.getOffset() - getOffset();
  if (-kZero < run && run < kZero) {
    return rise >= 0.0 ? svy_math::tol::kVerticalSlopeRatio : -svy_math::tol::kVerticalSlopeRatio;
  }
  return rise / run;
}

double CRoadCrossSectPoint::getSlopeRatioLeft() const { return m_left != nullptr ? m_left->getSlopeRatio(*this) : 0.0; }

double CRoadCrossSectPoint::getSlopeRatioRight() const { return m_right != nullptr ? getSlopeRatio(*m_right) : 0.0; }

double CRoadCrossSectPoint::getElevationFromSurface(double offset, const CRoadCrossSectPoint& other) const {
  const double run = other.getOffset() - getOffset();
  if (-kZero < run && run < kZero) return svy_math::undefinedValue();
  // Interpolated from the nearer end, so that the result at either point is that point's own elevation.
  const double t = (offset - getOffset()) / run;
  return t <= 0.5 ? getElevation() + t * (other.getElevation() - getElevation())
                  : other.getElevation() + (t - 1.0) * (other.getElevation() - getElevation());
}

double CRoadCrossSectPoint::calcOffsetFromSurface(double elevation, const CRoadCrossSectPoint& other) const {
  const double rise = other.getElevation() - getElevation();
  if (-kZero < rise && rise < kZero) return svy_math::undefinedValue();
  return getOffset() + (elevation - getElevation()) / rise * (other.getOffset() - getOffset());
}

CRoadCrossSectOffsPoint::CRoadCrossSectOffsPoint(double offset, double elevation, const svy_text::CSvyString& name,
                                                 unsigned featureIndex)
    : m_offset(offset), m_elevation(elevation), m_name(name), m_featureIndex(featureIndex) {}

CRoadCrossSectOffsPoint::~CRoadCrossSectOffsPoint() = default;
