#include "svymath/curves/spiral_base.h"

#include <cmath>

#include "svymath/foundation/constants.h"

namespace {

// Half the change of direction over a step may not exceed pi/16: beyond it the chord test below is no
// longer a fair bound of the chord's deviation and the step is refused outright.
constexpr double kMaxHalfTurnOfStep = svy_math::units::kPi / 16.0;

}  // namespace

CCurveSpiralTStoSCBase::CCurveSpiralTStoSCBase()
    : m_length(svy_math::undefinedValue()),
      m_radius(svy_math::undefinedValue()),
      m_finalNorth(svy_math::undefinedValue()),
      m_finalEast(svy_math::undefinedValue()) {
  m_spiralAngle.reset();
}

CCurveSpiralTStoSCBase::~CCurveSpiralTStoSCBase() = default;

void CCurveSpiralTStoSCBase::reset() {
  m_length = svy_math::undefinedValue();
  m_radius = svy_math::undefinedValue();
  m_spiralAngle.reset();
  m_finalNorth = svy_math::undefinedValue();
  m_finalEast = svy_math::undefinedValue();
}

bool CCurveSpiralTStoSCBase::isok() const { return !std::isnan(m_length) && m_spiralAngle.isok(); }

bool CCurveSpiralTStoSCBase::isDegenerate() const {
  return std::fabs(m_length) < svy_math::tol::kZero || std::fabs(m_radius) < svy_math::tol::kZero;
}

bool CCurveSpiralTStoSCBase::checkStepForDeviation(double step, double startLength, double maxDeviation) const {
  if (!isok() || isDegenerate()) return true;
  // The direction changes by (s2^2 - s1^2)/(2RL) over [s1, s2]; t is half of that.
  const double t = (2.0 * startLength + step) * step / (4.0 * m_length * m_radius);
  if (std::fabs(t) >= kMaxHalfTurnOfStep) return false;
  return std::fabs(std::tan(t) * step) < maxDeviation;
}

bool CCurveSpiralTStoSCBase::copy(const CCurveSpiralTStoSCBase* other) {
  if (other == nullptr || other->getMathSpiralType() != getMathSpiralType()) return false;
  if (other != this) *this = *other;
  return true;
}
