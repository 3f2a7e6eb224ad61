#include "svymath/road/cross_section_slope.h"

#include <cmath>

#include "svymath/foundation/constants.h"

using svy_math::tol::kZero;

namespace {

bool isZero(double x) { return -kZero < x && x < kZero; }

// A rise over run inside the zero tolerance is stored as a flat slope (run over rise 0).
double runRiseOf(double riseRun) { return isZero(riseRun) ? 0.0 : 1.0 / riseRun; }

double riseRunOf(double runRise) {
  if (std::isnan(runRise)) return runRise;
  return isZero(runRise) ? 0.0 : 1.0 / runRise;
}

}  // namespace

CRoadCrossSectionSlope::CRoadCrossSectionSlope(const CRoadCrossSection& section, bool rightSide)
    : CRoadCrossSectionSlope(section, rightSide, svy_math::undefinedValue(), svy_math::undefinedValue()) {}

CRoadCrossSectionSlope::CRoadCrossSectionSlope(const CRoadCrossSection& section, bool rightSide, double cutRunRise,
                                               double fillRunRise)
    : m_section(section),
      m_rightSide(rightSide),
      m_cutRunRise(cutRunRise),
      m_fillRunRise(fillRunRise),
      m_explicitHinge(false),
      m_hingeElevation(svy_math::undefinedValue()),
      m_hingeOffset(svy_math::undefinedValue()) {}

CRoadCrossSectionSlope::~CRoadCrossSectionSlope() = default;

bool CRoadCrossSectionSlope::hasCut() const { return !std::isnan(m_cutRunRise); }
bool CRoadCrossSectionSlope::hasFill() const { return !std::isnan(m_fillRunRise); }
bool CRoadCrossSectionSlope::hasFlatCutSlope() const { return hasCut() && isZero(m_cutRunRise); }
bool CRoadCrossSectionSlope::hasFlatFillSlope() const { return hasFill() && isZero(m_fillRunRise); }
double CRoadCrossSectionSlope::getCutSlopeRiseRun() const { return riseRunOf(m_cutRunRise); }
double CRoadCrossSectionSlope::getFillSlopeRiseRun() const { return riseRunOf(m_fillRunRise); }
void CRoadCrossSectionSlope::setCutSlopeRiseRun(double riseRun) { m_cutRunRise = runRiseOf(riseRun); }
void CRoadCrossSectionSlope::setFillSlopeRiseRun(double riseRun) { m_fillRunRise = runRiseOf(riseRun); }
void CRoadCrossSectionSlope::clearCut() { m_cutRunRise = svy_math::undefinedValue(); }
void CRoadCrossSectionSlope::clearFill() { m_fillRunRise = svy_math::undefinedValue(); }

void CRoadCrossSectionSlope::setHingePoint(double offset, double elevation) {
  m_explicitHinge = true;
  m_hingeOffset = offset;
  m_hingeElevation = elevation;
}

void CRoadCrossSectionSlope::setHingePoint(const CRoadCrossSectPoint* point) {
  if (point == nullptr) {
    resetHingePoint();
    return;
  }
  setHingePoint(point->getOffset(), point->getElevation());
}

const CRoadCrossSectPoint* CRoadCrossSectionSlope::getDefaultHingePoint() const {
  return m_rightSide ? m_section.getRightMostPoint() : m_section.getLeftMostPoint();
}

bool CRoadCrossSectionSlope::getHingePoint(double& offset, double& elevation) const {
  double o = 0.0;
  double z = 0.0;
  if (!getHingePointOffset(o) || !getHingePointElevation(z)) return false;
  offset = o;
  elevation = z;
  return true;
}

bool CRoadCrossSectionSlope::getHingePointElevation(double& elevation) const { return hingeValue(true, elevation); }

bool CRoadCrossSectionSlope::getHingePointOffset(double& offset) const { return hingeValue(false, offset); }

bool CRoadCrossSectionSlope::hingeValue(bool elevation, double& value) const {
  const CRoadCrossSectPoint* point = m_explicitHinge ? nullptr : getDefaultHingePoint();
  const double v = m_explicitHinge    ? (elevation ? m_hingeElevation : m_hingeOffset)
                   : point != nullptr ? (elevation ? point->getElevation() : point->getOffset())
                                      : svy_math::undefinedValue();
  if (std::isnan(v)) return false;
  value = v;
  return true;
}

double CRoadCrossSectionSlope::convertOffsetToLocal(double offset) const {
  double hinge = 0.0;
  if (!getHingePointOffset(hinge)) hinge = 0.0;
  return m_rightSide ? offset - hinge : hinge - offset;
}

double CRoadCrossSectionSlope::convertToClOffset(double local) const {
  double hinge = 0.0;
  if (!getHingePointOffset(hinge)) hinge = 0.0;
  return m_rightSide ? hinge + local : hinge - local;
}

bool CRoadCrossSectionSlope::isOffsetAtSlope(double offset) const {
  double hinge = 0.0;
  if (!getHingePointOffset(hinge) || (!hasCut() && !hasFill())) return false;
  if (m_rightSide ? offset >= hinge : offset <= hinge) return true;
  return std::fabs(offset - hinge) < svy_math::tol::kSnap;
}

bool CRoadCrossSectionSlope::isCatchPointAvailable(double groundElevation) const {
  double hinge = 0.0;
  if (!getHingePointElevation(hinge)) return false;
  if (hasCut()) {
    if (m_cutRunRise > 0.0 && groundElevation >= hinge) return true;
    if (isZero(m_cutRunRise)) return true;
  }
  if (!hasFill()) return false;
  return (m_fillRunRise < 0.0 && groundElevation < hinge) || isZero(m_fillRunRise);
}

bool CRoadCrossSectionSlope::getCatchPointOffset(double groundElevation, double& offset, double* runRise) const {
  double hinge = 0.0;
  if (!getHingePointElevation(hinge)) return false;
  const bool steepCut = hasCut() && !isZero(m_cutRunRise);
  const bool steepFill = hasFill() && !isZero(m_fillRunRise);
  // The cut slope first; when it is not taken or does not reach the ground outward, the fill slope.
  if (steepCut && !(groundElevation < hinge && steepFill) &&
      catchOnSlope(m_cutRunRise, groundElevation, hinge, offset, runRise)) {
    return true;
  }
  if (steepFill && (groundElevation < hinge || !hasCut() || isZero(m_cutRunRise))) {
    return catchOnSlope(m_fillRunRise, groundElevation, hinge, offset, runRise);
  }
  return false;
}

bool CRoadCrossSectionSlope::catchOnSlope(double runRise, double groundElevation, double hingeElevation, double& offset,
                                          double* runRiseOut) const {
  const double catchOffset = convertToClOffset(runRise * (groundElevation - hingeElevation));
  if (!isOffsetAtSlope(catchOffset)) return false;
  offset = catchOffset;
  if (runRiseOut != nullptr) *runRiseOut = runRise;
  return true;
}

bool CRoadCrossSectionSlope::heightFromSlope(double offset, double runRise, double& height) const {
  double hinge = 0.0;
  if (std::isnan(runRise) || !getHingePointElevation(hinge)) return false;
  height = hinge + convertOffsetToLocal(offset) * riseRunOf(runRise);
  return true;
}

bool CRoadCrossSectionSlope::getHeightFromCutSlope(double offset, double& height) const {
  return heightFromSlope(offset, m_cutRunRise, height);
}

bool CRoadCrossSectionSlope::getHeightFromFillSlope(double offset, double& height) const {
  return heightFromSlope(offset, m_fillRunRise, height);
}

bool CRoadCrossSectionSlope::getHeightFromSlopeAuto(double offset, double groundElevation, double& height,
                                                    double* runRise) const {
  double hinge = 0.0;
  if (!getHingePointElevation(hinge)) return false;
  double chosen = svy_math::undefinedValue();
  if (hasCut() && (!hasFill() || hinge <= groundElevation)) {
    chosen = m_cutRunRise;
  } else if (hasFill() && (!hasCut() || groundElevation < hinge)) {
    chosen = m_fillRunRise;
  } else {
    return false;
  }
  if (!heightFromSlope(offset, chosen, height)) return false;
  if (runRise != nullptr) *runRise = chosen;
  return true;
}
