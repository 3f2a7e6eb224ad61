#include "svymath/curves/curve_data_spiral1r.h"

#include <cmath>

#include "svymath/curves/curve_projection.h"
#include "svymath/curves/spiral_factory.h"
#include "svymath/curves/spiral_length_range.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kProjectionLength;
using svy_math::tol::kZero;

namespace {

// The kind code of spiral data, shared with the alignment's spiral element.
constexpr int kSpiralDataType = 2;

// Projection of a point onto the spiral: where the pieces cannot rule out a hidden minimum, the element is
// sampled at this many intervals to bracket every foot point (a spiral turns by less than a quarter turn
// over a sample interval, so each interval holds at most one minimum of the distance).
constexpr int kProjectionSamples = 32;
// Largest sharpest curvature times length of a projection piece: a piece then turns by at most half a
// radian (well inside the half turn that keeps the stationary points of the distance to two), and points
// within half the radius of it pass the bound that rules out a hidden minimum.
constexpr double kPieceCurvatureLength = 0.5;
// Cap of the refinement in one bracket. Newton converges in a handful of steps and the bisection fallback
// halves the bracket each step, so 100 steps reach below kProjectionLength for any bracket up to 1e20 m.
constexpr int kRefineIterationCap = 100;

// The step search narrows the largest admissible chord to this fraction of the step.
constexpr double kStepRelTol = 1e-9;
constexpr int kStepMaxHalvings = 64;
constexpr int kStepMaxBisections = 64;

// A radius value that stands for the tangent: zero, infinite or undefined.
bool isTangentRadius(double r) { return !(std::fabs(r) >= kZero) || std::isinf(r); }
}  // namespace

CCurveDataSpiral1R::CCurveDataSpiral1R(AlntMathSpiralType type) : m_law(svy_math::createSpiralLaw(type)) {}

CCurveDataSpiral1R::CCurveDataSpiral1R(const CCurveDataSpiral1R& other)
    : m_law(other.m_law->clone()), m_isTSSC(other.m_isTSSC), m_flags(other.m_flags) {}

CCurveDataSpiral1R& CCurveDataSpiral1R::operator=(const CCurveDataSpiral1R& other) {
  if (this != &other) {
    CCurveSpiralTStoSCBase* law = other.m_law->clone();
    delete m_law;
    m_law = law;
    m_isTSSC = other.m_isTSSC;
    m_flags = other.m_flags;
  }
  return *this;
}

CCurveDataSpiral1R::~CCurveDataSpiral1R() { delete m_law; }

int CCurveDataSpiral1R::static_type() { return kSpiralDataType; }

void CCurveDataSpiral1R::reset() {
  m_law->reset();
  m_isTSSC = true;
  onDefinitionChanged();
}

void CCurveDataSpiral1R::resetType(AlntMathSpiralType type) {
  delete m_law;
  m_law = svy_math::createSpiralLaw(type);
  onDefinitionChanged();
}

bool CCurveDataSpiral1R::recreateSimpleSpiral(AlntMathSpiralType type) {
  const double length = m_law->getLength();
  const double radius = m_law->getRadius();
  const bool lawRight = radius >= 0.0;
  const bool wasDefined = m_law->isok();
  resetType(type);
  if (!wasDefined) return false;
  const bool ok = m_law->setLenAndR(length, radius, lawRight);
  onDefinitionChanged();
  return ok;
}

bool CCurveDataSpiral1R::setLenAndR(double L, double R, bool toTheRight, bool isTSSC) {
  const bool ok = m_law->setLenAndR(L, R, isTSSC ? toTheRight : !toTheRight);
  m_isTSSC = isTSSC;
  onSpiralRedefined();
  onDefinitionChanged();
  return ok;
}

bool CCurveDataSpiral1R::setLenAndR(double L, AlntElementLengthDisplay lengthDisplay, double R,
                                    AlntElementRadiusDisplay radiusDisplay, bool toTheRight, bool isTSSC) {
  m_flags = svy_math::withLengthDisplay(svy_math::withRadiusDisplay(m_flags, radiusDisplay), lengthDisplay);
  return setLenAndR(L, R, toTheRight, isTSSC);
}

bool CCurveDataSpiral1R::setLenAndSpPrm(double L, double K, bool isTSSC) {
  const bool ok = m_law->setLenAndSpPrm(L, isTSSC ? K : -K);
  m_isTSSC = isTSSC;
  onSpiralRedefined();
  onDefinitionChanged();
  return ok;
}

bool CCurveDataSpiral1R::setLenAndTwoR(double L, double R1, double R2, bool toTheRight, bool isTSSC) {
  const bool tangent1 = isTangentRadius(R1);
  const bool tangent2 = isTangentRadius(R2);
  if (tangent1 && tangent2) {
    m_law->reset();
    m_isTSSC = isTSSC;
    onDefinitionChanged();
    return false;
  }
  if (tangent1 || tangent2) return setLenAndR(L, tangent1 ? R2 : R1, toTheRight, isTSSC);
  const double flat = std::fmax(std::fabs(R1), std::fabs(R2));
  const double sharp = std::fmin(std::fabs(R1), std::fabs(R2));
  const bool ok = m_law->setLenAndTwoR(L, flat, sharp, isTSSC ? toTheRight : !toTheRight);
  if (!ok) m_law->reset();
  m_isTSSC = isTSSC;
  onDefinitionChanged();
  return ok;
}

bool CCurveDataSpiral1R::setTurnRight(bool toTheRight) {
  if (!m_law->isok()) return false;
  const double radius = m_isTSSC ? m_law->getRadius() : -m_law->getRadius();
  const bool ok = m_law->setLenAndR(m_law->getLength(), radius, m_isTSSC ? toTheRight : !toTheRight);
  onDefinitionChanged();
  return ok;
}

double CCurveDataSpiral1R::getTotalLength() const { return m_law->getLength(); }

double CCurveDataSpiral1R::GetAzimuth(double s) const {
  if (m_isTSSC) return m_law->GetAzimuth(s);
  return m_law->GetAzimuth(lawLength(s)) - m_law->getSpiralAngle().getDeg();
}

bool CCurveDataSpiral1R::fullPosAtLength(double s, double& north, double& east) const {
  if (m_isTSSC) return m_law->getPosAtLength(s, north, east);
  double n = 0.0;
  double e = 0.0;
  if (!m_law->getPosAtLength(lawLength(s), n, e)) return false;
  // Curve to tangent: the frame has its origin at the law's end point and its north axis along the law's
  // end tangent reversed (the direction of travel), east to the right of it.
  const double dN = n - m_law->getFinalNorthing();
  const double dE = e - m_law->getFinalEasting();
  const double cosT = m_law->getSpiralAngle().getCos();
  const double sinT = m_law->getSpiralAngle().getSin();
  north = -(dN * cosT + dE * sinT);
  east = dN * sinT - dE * cosT;
  return true;
}

bool CCurveDataSpiral1R::getPosAtLength(double s, double& north, double& east) const {
  return svy_math::checkLengthOrLog(m_law->isok(), s, getTotalLength(), __LINE__) && fullPosAtLength(s, north, east);
}

double CCurveDataSpiral1R::getCurvatureAtLength(double s) const {
  if (!m_law->isok()) return 0.0;
  if (m_isTSSC) return m_law->getCurvatureAtLength(s);
  return -m_law->getCurvatureAtLength(lawLength(s));
}

double CCurveDataSpiral1R::fullStepForDeviation(double s, double dev, double limit) const {
  const double remaining = limit - s;
  if (!(remaining > 0.0)) return 0.0;
  // Under a CS-to-ST element the step covers the law backwards, ending at law length L - s.
  auto fits = [&](double step) {
    return m_law->checkStepForDeviation(step, m_isTSSC ? s : lawLength(s) - step, dev);
  };
  if (fits(remaining)) return remaining;
  // The chord's deviation grows with the step: halve until it fits, then bisect between fit and misfit.
  double bad = remaining;
  double good = 0.5 * remaining;
  for (int i = 0; i < kStepMaxHalvings && !fits(good); ++i) {
    bad = good;
    good *= 0.5;
  }
  for (int i = 0; i < kStepMaxBisections && bad - good > kStepRelTol * bad; ++i) {
    const double mid = 0.5 * (good + bad);
    if (fits(mid)) {
      good = mid;
    } else {
      bad = mid;
    }
  }
  return good;
}

double CCurveDataSpiral1R::getStepForDeviation(double s, double dev) const {
  const double total = getTotalLength();
  if (!svy_math::checkLengthOrLog(true, s, total, __LINE__)) return 0.0;
  if (!(dev > 0.0)) return total - s;
  return fullStepForDeviation(s, dev, total);
}

double CCurveDataSpiral1R::TFoot::distance() const { return std::hypot(along, offset); }

bool CCurveDataSpiral1R::componentsAt(double north, double east, double s, double& along, double& offset) const {
  double onNorth = 0.0;
  double onEast = 0.0;
  if (!getPosAtLength(s, onNorth, onEast)) return false;
  const double azimuth = GetAzimuth(s) * svy_math::units::kDegToRad;
  const double dN = north - onNorth;
  const double dE = east - onEast;
  along = std::cos(azimuth) * dN + std::sin(azimuth) * dE;
  offset = svy_math::detail::offsetAcross(north, east, onNorth, onEast, azimuth);
  return std::isfinite(along) && std::isfinite(offset);
}

bool CCurveDataSpiral1R::refineFoot(double north, double east, double a, double b, double aAlong, double bAlong,
                                    TFoot& candidate) const {
  double s = a + (b - a) * aAlong / (aAlong - bAlong);
  for (int iteration = 0; iteration < kRefineIterationCap; ++iteration) {
    if (!componentsAt(north, east, s, candidate.along, candidate.offset)) return false;
    if (candidate.along > 0.0) {
      a = s;
    } else {
      b = s;
    }
    // d(along)/ds = -1 + curvature * offset: negative wherever the point is a distance minimum.
    const double slope = -1.0 + getCurvatureAtLength(s) * candidate.offset;
    double next = slope < 0.0 ? s - candidate.along / slope : 0.5 * (a + b);
    // A Newton step below the tolerance has converged, even where it rounds onto an end of the bracket (s
    // is one of them); only a real step out of the bracket falls back to bisection.
    const bool settled = std::fabs(next - s) < kProjectionLength;
    if (settled) {
      next = std::fmin(std::fmax(next, a), b);
    } else if (!(next > a && next < b)) {
      next = 0.5 * (a + b);
    }
    s = next;
    if (settled || b - a < kProjectionLength) break;
  }
  candidate.length = s;
  candidate.interior = true;
  return componentsAt(north, east, s, candidate.along, candidate.offset);
}

double CCurveDataSpiral1R::sharpestCurvature() const { return 1.0 / std::fabs(m_law->getRadius()); }

int CCurveDataSpiral1R::projectionPieces(double total) const {
  const double pieces = std::ceil(sharpestCurvature() * total / kPieceCurvatureLength);
  if (!(pieces <= kProjectionSamples)) return 0;
  return pieces < 1.0 ? 1 : static_cast<int>(pieces);
}

// The element is cut into pieces that turn by at most half a radian. The curvature of a spiral is monotone,
// so its centres of curvature form a convex arc; the normals of a piece are the tangents of that arc, and at
// most two of them pass through any point: the distance from the point has at most two stationary lengths
// on a piece. When the along component falls through zero between the ends of a piece, that is its one
// minimum. When it has the same sign at both ends there is none, unless the point lies beyond a centre of
// curvature of the piece (curvature * offset > 1 somewhere on it). The offsets on a piece are bounded by the
// distances to its ends and its length, the curvature by that of the law's sharp end; where these bounds
// cannot exclude a hidden minimum, the element is searched again at kProjectionSamples intervals.
bool CCurveDataSpiral1R::findFoot(double north, double east, TFoot& foot) const {
  const double total = getTotalLength();
  if (!isok() || !(total >= 0.0) || !std::isfinite(total)) return false;
  const int pieces = projectionPieces(total);
  if (pieces > 0) {
    const EFootScan scan = scanFoot(north, east, total, pieces, true, foot);
    if (scan != EFootScan::kDense) return scan == EFootScan::kFound;
  }
  return scanFoot(north, east, total, kProjectionSamples, false, foot) == EFootScan::kFound;
}

CCurveDataSpiral1R::EFootScan CCurveDataSpiral1R::scanFoot(double north, double east, double total, int intervals,
                                                           bool boundPieces, TFoot& foot) const {
  TFoot best;
  if (!componentsAt(north, east, 0.0, best.along, best.offset)) return EFootScan::kFailed;
  const double sharpest = boundPieces ? sharpestCurvature() : 0.0;
  double lo = 0.0;
  double loAlong = best.along;
  double loDistance = best.distance();
  for (int i = 1; i <= intervals; ++i) {
    const double hi = total * i / intervals;
    TFoot sample;
    sample.length = hi;
    if (!componentsAt(north, east, hi, sample.along, sample.offset)) return EFootScan::kFailed;
    if (i == intervals && sample.distance() < best.distance()) best = sample;
    if (loAlong > 0.0 && sample.along <= 0.0) {
      TFoot candidate;
      if (!refineFoot(north, east, lo, hi, loAlong, sample.along, candidate)) return EFootScan::kFailed;
      if (candidate.distance() < best.distance()) best = candidate;
    } else if (boundPieces && (loAlong > 0.0) == (sample.along > 0.0) &&
               !(sharpest * 0.5 * (loDistance + sample.distance() + hi - lo) < 1.0)) {
      return EFootScan::kDense;
    }
    lo = hi;
    loAlong = sample.along;
    loDistance = sample.distance();
  }
  foot = best;
  return EFootScan::kFound;
}

bool CCurveDataSpiral1R::getShortestDistAndCurveLen(double north, double east, double& dist,
                                                    double& len) const {
  TFoot foot;
  if (!findFoot(north, east, foot)) return false;
  len = foot.length;
  dist = foot.offset < 0.0 ? -foot.distance() : foot.distance();
  return true;
}

double CCurveDataSpiral1R::getFinalNorthing() const {
  double n = svy_math::undefinedValue();
  double e = svy_math::undefinedValue();
  if (m_law->isok()) getPosAtLength(getTotalLength(), n, e);
  return n;
}

double CCurveDataSpiral1R::getFinalEasting() const {
  double n = svy_math::undefinedValue();
  double e = svy_math::undefinedValue();
  if (m_law->isok()) getPosAtLength(getTotalLength(), n, e);
  return e;
}

bool CCurveDataSpiral1R::getFinalAzimut(CMathAngle& azimuth) const {
  if (!m_law->isok()) return false;
  azimuth.setDeg(GetAzimuth(getTotalLength()));
  return true;
}

double CCurveDataSpiral1R::getFinalAzimutInRad() const {
  if (!m_law->isok()) return 0.0;
  return GetAzimuth(getTotalLength()) * svy_math::units::kDegToRad;
}

double CCurveDataSpiral1R::getRadius() const {
  if (!m_law->isok()) return 0.0;
  return m_isTSSC ? m_law->getRadius() : -m_law->getRadius();
}

double CCurveDataSpiral1R::getSpiralParam() const {
  if (!m_law->isok()) return 0.0;
  return std::sqrt(std::fabs(m_law->getRadius() * m_law->getLength()));
}

double CCurveDataSpiral1R::getLengthAtAzimuth(const CMathAngle& angle) const {
  if (m_isTSSC) return m_law->getLengthAtAzimuth(angle);
  // Under a CS-to-ST element the direction has turned by angle where the law's direction is theta + angle.
  return m_law->getLength() - m_law->getLengthAtAzimuth(m_law->getSpiralAngle() + angle);
}

bool CCurveDataSpiral1R::isToTheRight() const { return getRadius() >= 0.0; }

bool CCurveDataSpiral1R::isToTheLeft() const { return getRadius() <= 0.0; }

bool CCurveDataSpiral1R::GetSpiralElement(double& length, double& radius, bool& toTheRight,
                                          bool& isTSSC) const {
  if (!m_law->isok()) return false;
  length = getTotalLength();
  radius = getRadius();
  toTheRight = isToTheRight();
  isTSSC = m_isTSSC;
  return true;
}

bool CCurveDataSpiral1R::GetSpiralElement(double& length, AlntElementLengthDisplay& lengthDisplay, double& radius,
                                          AlntElementRadiusDisplay& radiusDisplay, bool& toTheRight,
                                          bool& isTSSC) const {
  if (!GetSpiralElement(length, radius, toTheRight, isTSSC)) return false;
  lengthDisplay = svy_math::getLengthDisplay(m_flags);
  radiusDisplay = svy_math::getRadiusDisplay(m_flags);
  return true;
}
