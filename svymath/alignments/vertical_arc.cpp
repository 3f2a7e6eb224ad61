#include "svymath/alignments/vertical_arc.h"

#include <cmath>

#include "svymath/alignments/alignment_log.h"
#include "svymath/alignments/vertical_visitor.h"
#include "svymath/curves/spiral_length_range.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

using svy_math::isUndefined;
using svy_math::tol::kSnap;
using svy_math::tol::kZero;
using svy_math::units::kPercent;

SVY_RTTI_DEFINE(CAlntVeArc, CAlntVe)

CAlntVeArc::CAlntVeArc()
    : m_startHeight(svy_math::undefinedValue()),
      m_length(svy_math::undefinedValue()),
      m_radius(svy_math::undefinedValue()) {
  m_startDir.reset();
  m_endDir.reset();
}

CAlntVeArc::~CAlntVeArc() = default;

void CAlntVeArc::setGrades(double startGrade, double endGrade, double radius) {
  m_startDir.reset();
  m_endDir.reset();
  m_startDir.setTg(startGrade / kPercent, 1.0);
  m_endDir.setTg(endGrade / kPercent, 1.0);
  // Fill the angles' sine and cosine caches now, so that the const queries never write them and an element
  // may be read by several threads at once.
  m_startDir.getSin();
  m_startDir.getCos();
  m_endDir.getSin();
  m_endDir.getCos();
  // A crest turns downwards (negative radius), a sag upwards; equal grades need no curve.
  if (std::fabs(startGrade - endGrade) < kZero) {
    m_radius = 0.0;
  } else {
    m_radius = startGrade > endGrade ? -std::fabs(radius) : std::fabs(radius);
  }
}

void CAlntVeArc::setGradesAndR(double startGrade, double endGrade, double radius) {
  setGrades(startGrade, endGrade, radius);
  m_length = isSimplePoint() ? 0.0 : std::fabs(getCentralAngle() * m_radius);
}

void CAlntVeArc::setGradesAndLen(double startGrade, double endGrade, double length) {
  setGradesAndR(startGrade, endGrade, computeRadius(startGrade, endGrade, length));
}

void CAlntVeArc::setCenterGradesAndR(const C2dPos& centre, double startGrade, double endGrade, double radius) {
  setGradesAndR(startGrade, endGrade, radius);
  // The start is where the radius to the circle is square to the start grade.
  setStartHtAndChain(centre[1] - m_radius * m_startDir.getCos(), centre[0] + m_radius * m_startDir.getSin());
}

void CAlntVeArc::setRadius(double radius) { setGradesAndR(getStartGrade(), getEndGrade(), radius); }

double CAlntVeArc::computeRadius(double startGrade, double endGrade, double length) {
  const double turn = std::atan(endGrade / kPercent) - std::atan(startGrade / kPercent);
  return std::fabs(turn) < kZero ? 0.0 : length / turn;
}

bool CAlntVeArc::computeRadius() {
  if (isUndefined(m_length) || m_startDir.isNan() || m_endDir.isNan()) return false;
  setGradesAndLen(getStartGrade(), getEndGrade(), m_length);
  return true;
}

void CAlntVeArc::setStartHtAndChain(double height, double chainage) {
  m_startHeight = height;
  onStartChainageUpdate(chainage);
}

double CAlntVeArc::getCentralAngle() const { return m_endDir.getRad() - m_startDir.getRad(); }

bool CAlntVeArc::isSimplePoint() const { return std::fabs(m_radius) < kZero; }

bool CAlntVeArc::isok() const {
  return CAlntElemImpl::isok() && !isUndefined(m_startHeight) && !isUndefined(m_length) &&
         !isUndefined(m_radius) && m_startDir.isok() && m_endDir.isok();
}

bool CAlntVeArc::getCenterStaAndHt(double& chainage, double& height) const {
  double start = 0.0;
  if (!isok() || isSimplePoint() || !readStartChainage(start)) return false;
  chainage = start - m_radius * m_startDir.getSin();
  height = m_startHeight + m_radius * m_startDir.getCos();
  return true;
}

bool CAlntVeArc::getFinalStaAndHt(double& chainage, double& height) const {
  double end = 0.0;
  const double h = getFinalHt();
  if (!getFinalChainageInM(end) || isUndefined(h)) return false;
  chainage = end;
  height = h;
  return true;
}

double CAlntVeArc::sinAt(double s) const { return m_startDir.getSin() + s / m_radius; }

bool CAlntVeArc::snapLength(double& s) const {
  if (svy_math::snapToRange(s, 0.0, m_length)) return true;
  svy_logging::svy_err_log(svy_math::kAlntElementsLogSource, __LINE__, "");
  return false;
}

int CAlntVeArc::getHtAtLen(double length, double& height) const {
  double s = length;
  if (!isok()) return eVeHtAfterEnd;
  if (!snapLength(s)) return s < 0.0 ? eVeHtBeforeStart : eVeHtAfterEnd;
  if (isSimplePoint()) {
    height = m_startHeight;
    return eVeHtOk;
  }
  const double sinTheta = sinAt(s);
  const double cosSq = 1.0 - sinTheta * sinTheta;
  if (!(cosSq >= 0.0)) return eVeHtAfterEnd;  // past the circle's vertical tangent
  // h0 + R (cos theta1 - cos theta), written without the cancellation of two values near R:
  // cos theta1 - cos theta = (sin^2 theta - sin^2 theta1) / (cos theta1 + cos theta) and
  // R^2 (sin^2 theta - sin^2 theta1) = s (s + 2 R sin theta1).
  const double cosSum = m_startDir.getCos() + std::sqrt(cosSq);
  height = m_startHeight + s * (s + 2.0 * m_radius * m_startDir.getSin()) / (m_radius * cosSum);
  return eVeHtOk;
}

bool CAlntVeArc::getGradeAtLength(double length, double& grade) const {
  double s = length;
  if (!isok() || !snapLength(s)) return false;
  if (isSimplePoint()) {
    grade = getStartGrade();
    return true;
  }
  const double sinTheta = sinAt(s);
  const double cosSq = 1.0 - sinTheta * sinTheta;
  if (!(cosSq > 0.0)) return false;
  grade = sinTheta / std::sqrt(cosSq) * kPercent;
  return true;
}

double CAlntVeArc::getFinalHt() const {
  double height = svy_math::undefinedValue();
  getHtAtLen(m_length, height);
  return height;
}

double CAlntVeArc::getStartGrade() const {
  return m_startDir.isok() ? m_startDir.getTg() * kPercent : svy_math::undefinedValue();
}

double CAlntVeArc::getEndGrade() const {
  return m_endDir.isok() ? m_endDir.getTg() * kPercent : svy_math::undefinedValue();
}

bool CAlntVeArc::getExtremum(double& chainage, double& height, bool& isMax) const {
  double start = 0.0;
  if (!isok() || isSimplePoint() || !readStartChainage(start)) return false;
  // The grade is zero where the circle is level, at the centre's chainage: s = -R sin theta1.
  double s = -m_radius * m_startDir.getSin();
  if (s < -kSnap || s > m_length + kSnap) return false;
  s = std::fmin(std::fmax(s, 0.0), m_length);
  chainage = start + s;
  // h0 - R (1 - cos theta1), with 1 - cos theta1 = sin^2 theta1 / (1 + cos theta1).
  const double sinStart = m_startDir.getSin();
  height = m_startHeight - m_radius * sinStart * sinStart / (1.0 + m_startDir.getCos());
  isMax = m_radius < 0.0;
  return true;
}

bool CAlntVeArc::getAsLs(CLsInfo& info) const {
  double start = 0.0;
  if (!isok() || !readStartChainage(start)) return false;
  // The tangents meet |R tan(dtheta / 2)| along the start tangent from the start.
  const double tangent = isSimplePoint() ? 0.0 : std::fabs(m_radius * std::tan(0.5 * getCentralAngle()));
  info = CLsInfo(start + tangent * m_startDir.getCos(), m_startHeight + tangent * m_startDir.getSin(), m_length,
                 start, m_radius);
  return true;
}

double CAlntVeArc::getStepForDeviation(double length, double deviation) const {
  double s = length;
  if (!isok() || !svy_math::snapToRange(s, 0.0, m_length)) return 0.0;
  if (isSimplePoint()) return m_length - s;
  // The height's second derivative by chainage is 1 / (R cos^3 theta), largest where the curve is steepest:
  // at one of its ends.
  const double cosMin = std::fmin(m_startDir.getCos(), m_endDir.getCos());
  return chordStep(deviation, 1.0 / (std::fabs(m_radius) * cosMin * cosMin * cosMin), m_length - s);
}

CAlntVe* CAlntVeArc::clone() const { return new CAlntVeArc(*this); }

bool CAlntVeArc::isEqual(const CAlntVe* other) const {
  const CAlntVeArc* o = cast(other);
  return o != nullptr && sameStart(*o) && sameValue(m_startHeight, o->m_startHeight) &&
         sameValue(m_length, o->m_length) && sameValue(m_radius, o->m_radius) &&
         m_startDir.isEqual(o->m_startDir, kZero) && m_endDir.isEqual(o->m_endDir, kZero);
}

void CAlntVeArc::Accept(CAlntVeVisitor& visitor) { visitor.Visit(*this); }

void CAlntVeArc::Accept(CAlntVeVisitor_const& visitor) const { visitor.Visit(*this); }
