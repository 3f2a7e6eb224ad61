#include "svymath/curves/spiral_euler.h"

#include <cmath>

#include "svymath/curves/spiral_fresnel.h"
#include "svymath/curves/spiral_length_range.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kZero;

CEulerSpiralTStoSC::CEulerSpiralTStoSC() = default;

CCurveSpiralTStoSCBase* CEulerSpiralTStoSC::clone() const { return new CEulerSpiralTStoSC(*this); }

bool CEulerSpiralTStoSC::setLenAndR(double L, double R, bool toTheRight) {
  reset();
  m_length = L;
  const double radius = toTheRight ? std::fabs(R) : -std::fabs(R);
  m_spiralAngle.setRad(std::fabs(radius) < kZero ? 0.0 : L / (2.0 * radius));
  m_radius = radius;
  return true;
}

bool CEulerSpiralTStoSC::setLenAndSpPrm(double L, double K) {
  reset();
  m_length = L;
  m_radius = std::fabs(L) < kZero ? K / L : 0.0;
  m_spiralAngle.setRad(std::fabs(K) < kZero ? 0.0 : L * L / (2.0 * K));
  return true;
}

bool CEulerSpiralTStoSC::setLenAndTwoR(double L, double R1, double R2, bool toTheRight) {
  // Curvature is proportional to length, so the part from R1 to R2 starts at L*R2/(R1 - R2) on the full
  // spiral. Equal radii (no such part) give no finite full length.
  const double fullLength = L + L * R2 / (R1 - R2);
  if (!std::isfinite(fullLength) || fullLength <= 0.0) return false;
  return setLenAndR(fullLength, R2, toTheRight);
}

double CEulerSpiralTStoSC::GetAzimuth(double s) const {
  const double rl = m_radius * m_length;
  if (!(std::fabs(rl) >= kZero)) return 0.0;
  return s * s * svy_math::units::kRadToDeg / (2.0 * rl);
}

double CEulerSpiralTStoSC::getLengthAtAzimuth(const CMathAngle& angle) const {
  const double rl = m_radius * m_length;
  if (!(std::fabs(rl) >= kZero)) return 0.0;
  const double square = 2.0 * rl * angle.getRad();
  if (square < 0.0) return 0.0;
  return std::sqrt(square);
}

double CEulerSpiralTStoSC::getCurvatureAtLength(double s) const {
  const double rl = m_radius * m_length;
  if (!(std::fabs(rl) >= kZero)) return 0.0;
  return s / rl;
}

bool CEulerSpiralTStoSC::getPosAtLength(double s, double& north, double& east) const {
  if (!svy_math::checkLengthOrLog(isok(), s, m_length, __LINE__)) return false;
  if (isDegenerate()) {
    north = 0.0;
    east = 0.0;
    return true;
  }
  const double k = std::sqrt(std::fabs(m_radius) * m_length * svy_math::units::kPi);
  double S = 0.0;
  double C = 0.0;
  svy_math::fresnelCS(s / k, S, C);
  north = C * k;
  east = m_radius < 0.0 ? -S * k : S * k;
  return true;
}

void CEulerSpiralTStoSC::fillFinalPos() const {
  if (!std::isnan(m_finalNorth) && !std::isnan(m_finalEast)) return;
  double north = 0.0;
  double east = 0.0;
  if (getPosAtLength(m_length, north, east)) {
    m_finalNorth = north;
    m_finalEast = east;
  }
}

double CEulerSpiralTStoSC::getFinalNorthing() const {
  fillFinalPos();
  return m_finalNorth;
}

double CEulerSpiralTStoSC::getFinalEasting() const {
  fillFinalPos();
  return m_finalEast;
}
