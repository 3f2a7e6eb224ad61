#include "svymath/curves/curve_formulas.h"

#include <cmath>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

using svy_math::tol::kCurveRadiusZero;
using svy_math::tol::kZero;
using svy_math::units::kDegToRad;
using svy_math::units::kRadToDeg;

namespace {

// The exact chord test of GetDeltaFromChordLength: C/2R may exceed 1 by this much and still count as a
// diameter (a half turn) rather than an impossible chord.
constexpr double kDiameterSlack = 1.000000000001;

bool isHalfTurn(double delta, bool inclusive) {
  const double off = std::fabs(std::fabs(delta) - svy_math::units::kHalfCircleDeg);
  return inclusive ? off <= svy_math::tol::kHalfTurnDeg : off < svy_math::tol::kHalfTurnDeg;
}

bool isFinite(const C2dPos& p) { return std::isfinite(p.north()) && std::isfinite(p.east()); }

double distance(const C2dPos& a, const C2dPos& b) { return std::hypot(b.north() - a.north(), b.east() - a.east()); }

// Fills the values that follow from the radius and the signed deflection.
void fillFromDelta(double radius, double delta, TArcParams& arc) {
  const double r = std::fabs(radius);
  const double d = std::fabs(delta);
  arc.radius = radius;
  arc.delta = delta;
  arc.length = GetLengthFromDelta(d, r);
  arc.chord = GetChordLenFromDelta(d, r);
  arc.tangent = GetTangentFromDelta(d, r);
  arc.external = GetExternalFromDelta(d, r);
  arc.midOrdinate = GetMidOrdFromDelta(d, r);
}

}  // namespace

double GetRadiusFromDegOfCurve(double degOfCurve) {
  const double rad = degOfCurve * kDegToRad;
  if (!(rad >= svy_math::tol::kDegOfCurveZeroRad)) return 0.0;
  return svy_math::units::kDegOfCurveBase / rad;
}

double GetDegOfCurveFromRadius(double radius) {
  if (!(radius >= kCurveRadiusZero)) return 0.0;
  return svy_math::units::kRadiusOfOneDegreeCurve / radius;
}

double GetRadiusFromDegOfChord(double degOfChord) {
  const double rad = degOfChord * kDegToRad;
  if (std::fabs(rad - svy_math::units::kPi) < kZero) return svy_math::units::kDegOfCurveHalfBase;
  if (rad > svy_math::tol::kDegOfCurveZeroRad && rad < svy_math::units::kPi) {
    return svy_math::units::kDegOfCurveHalfBase / std::sin(rad / 2.0);
  }
  return 0.0;
}

double GetDegOfChordFromRadius(double radius) {
  if (radius >= svy_math::units::kDegOfCurveHalfBase) {
    return 2.0 * std::asin(svy_math::units::kDegOfCurveHalfBase / radius) * kRadToDeg;
  }
  return isValidRadiusForDegOfChord(radius) ? svy_math::units::kHalfCircleDeg : 0.0;
}

bool isValidRadiusForDegOfChord(double radius) { return radius + kZero >= svy_math::units::kDegOfCurveHalfBase; }

double GetDeltaFromLength(double length, double radius) {
  if (!(radius >= kCurveRadiusZero)) return 0.0;
  return length / radius * kRadToDeg;
}

double GetLengthFromDelta(double delta, double radius) { return delta * kDegToRad * radius; }

double GetChordLenFromDelta(double delta, double radius) { return 2.0 * radius * std::sin(delta * kDegToRad / 2.0); }

double GetChordLenFromLength(double length, double radius) {
  return GetChordLenFromDelta(GetDeltaFromLength(length, radius), radius);
}

double GetDeltaFromChordLength(double chord, double radius) {
  if (std::fabs(radius) < kZero) return 0.0;
  const double x = chord / (2.0 * radius);
  if (std::fabs(x) < 1.0) return 2.0 * std::asin(x) * kRadToDeg;
  if (x <= kDiameterSlack) return svy_math::units::kHalfCircleDeg;
  if (x >= -kDiameterSlack) return -svy_math::units::kHalfCircleDeg;
  return 0.0;
}

double GetLengthFromChordLength(double chord, double radius) {
  return GetDeltaFromChordLength(chord, radius) * kDegToRad * radius;
}

double GetTangentFromDelta(double delta, double radius) {
  if (isHalfTurn(delta, false)) return svy_math::undefinedValue();
  return std::tan(delta * kDegToRad / 2.0) * radius;
}

double GetTangentFromLength(double length, double radius) {
  return GetTangentFromDelta(GetDeltaFromLength(length, radius), radius);
}

double GetDeltaFromTangent(double tangent, double radius) { return 2.0 * atan3(tangent, radius) * kRadToDeg; }

double GetLengthFromTangent(double tangent, double radius) {
  return GetDeltaFromTangent(tangent, radius) * kDegToRad * radius;
}

double GetExternalFromDelta(double delta, double radius) {
  if (isHalfTurn(delta, true)) return svy_math::undefinedValue();
  const double r = std::fabs(radius);
  return std::fabs(r / std::cos(delta * kDegToRad / 2.0) - r);
}

double GetExternalFromLength(double length, double radius) {
  return GetExternalFromDelta(GetDeltaFromLength(length, radius), radius);
}

double GetDeltaFromExternal(double external, double radius) {
  const double e = std::fabs(external);
  const double r = std::fabs(radius);
  if (!(r >= kZero)) return 0.0;
  const double ratio = r / (r + e);
  if (!(ratio >= -1.0 && ratio <= 1.0)) return 0.0;
  return 2.0 * std::acos(ratio) * kRadToDeg;
}

double GetLengthFromExternal(double external, double radius) {
  return GetDeltaFromExternal(external, radius) * kDegToRad * radius;
}

double GetMidOrdFromDelta(double delta, double radius) { return (1.0 - std::cos(delta * kDegToRad / 2.0)) * radius; }

double GetMidOrdFromLength(double length, double radius) {
  return GetMidOrdFromDelta(GetDeltaFromLength(length, radius), radius);
}

double GetDeltaFromMidOrd(double midOrdinate, double radius) {
  if (!(std::fabs(radius) >= kZero)) return 0.0;
  const double v = 1.0 - midOrdinate / radius;
  if (!(v >= -1.0 && v <= 1.0)) return 0.0;
  return 2.0 * std::acos(v) * kRadToDeg;
}

double GetLengthFromMidOrd(double midOrdinate, double radius) {
  return GetDeltaFromMidOrd(midOrdinate, radius) * kDegToRad * radius;
}

double GetSpiralLength(double spiralParam, double radius) {
  if (!(std::fabs(radius) >= kCurveRadiusZero)) return 0.0;
  return spiralParam * spiralParam / std::fabs(radius);
}

double GetSpiralConstant(double length, double radius) { return std::sqrt(std::fabs(length) * std::fabs(radius)); }

bool GetArcTangentParams(const C2dPos& pi, double azimuthIn, double azimuthOut, double radius, TArcParams& arc) {
  if (!isFinite(pi) || !std::isfinite(azimuthIn) || !std::isfinite(azimuthOut) || !std::isfinite(radius)) {
    return false;
  }
  const double r = std::fabs(radius);
  const double delta = ModDeg180(azimuthOut - azimuthIn, false);
  if (!(r >= kZero) || std::fabs(delta) < kZero || isHalfTurn(delta, true)) return false;
  const CMathAngle in(azimuthIn);
  const CMathAngle out(azimuthOut);
  const double signedRadius = delta > 0.0 ? r : -r;
  TArcParams result;
  fillFromDelta(signedRadius, delta, result);
  in.getPosAlong(-result.tangent, pi, result.start);
  out.getPosAlong(result.tangent, pi, result.end);
  in.getPosAcross(signedRadius, result.start, result.centre);
  arc = result;
  return true;
}

bool GetArc3PointsParams(const C2dPos& p1, const C2dPos& p2, const C2dPos& p3, TArcParams& arc) {
  if (!isFinite(p1) || !isFinite(p2) || !isFinite(p3)) return false;
  // Work relative to p1: grid coordinates (N 5 000 000) would otherwise lose digits in the products.
  const double bn = p2.north() - p1.north();
  const double be = p2.east() - p1.east();
  const double cn = p3.north() - p1.north();
  const double ce = p3.east() - p1.east();
  const double lb = std::hypot(bn, be);
  const double lc = std::hypot(cn, ce);
  if (!(lb >= kZero) || !(lc >= kZero) || !(distance(p2, p3) >= kZero)) return false;
  // In (north, east) axes a positive cross product is a clockwise (right) turn p1 -> p2 -> p3.
  const double cross = bn * ce - be * cn;
  if (!(std::fabs(cross) > kZero * lb * lc)) return false;
  const double den = 2.0 * cross;
  const double un = (ce * lb * lb - be * lc * lc) / den;
  const double ue = (bn * lc * lc - cn * lb * lb) / den;
  TArcParams result;
  result.centre = C2dPos(p1.north() + un, p1.east() + ue);
  const double r = std::hypot(un, ue);
  CMathAngle toStart;
  CMathAngle toEnd;
  toStart.setAz(result.centre, p1);
  toEnd.setAz(result.centre, p3);
  // The sweep from p1 to p3 in the direction of travel, which passes p2.
  const double sweep = cross > 0.0 ? Normalize0ToLt2Pi(toEnd.getRad() - toStart.getRad())
                                   : Normalize0ToLt2Pi(toStart.getRad() - toEnd.getRad());
  const double sweepDeg = sweep * kRadToDeg;
  fillFromDelta(cross > 0.0 ? r : -r, cross > 0.0 ? sweepDeg : -sweepDeg, result);
  result.start = p1;
  result.end = p3;
  arc = result;
  return true;
}
