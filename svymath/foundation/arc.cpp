#include "svymath/foundation/arc.h"

#include <cmath>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

namespace {

namespace units = svy_math::units;
namespace tol = svy_math::tol;

bool isFinite(const C2dPos& p) { return std::isfinite(p.north()) && std::isfinite(p.east()); }
bool isPositive(double radius) { return radius > tol::kZero && std::isfinite(radius); }
double azimuth(const C2dPos& from, const C2dPos& to) {
  return std::atan2(to.east() - from.east(), to.north() - from.north());
}
// The unit normal to the right of a direction of azimuth a: (N = -sin a, E = cos a).
C2dPos rightNormal(double az) { return C2dPos(-std::sin(az), std::cos(az)); }

// A sweep (radians, clockwise positive) that makes a proper arc: not zero, less than a whole circle.
bool isProperSweep(double sweep) {
  const double m = std::fabs(sweep);
  return m >= tol::kZero && m <= units::kTwoPi - tol::kZero;
}

// The arc about centre starting at start and sweeping sweep radians (clockwise positive); a sweep of zero
// or of a whole turn (within the zero tolerance) is a whole circle in the given direction.
bool arcAboutCentre(const C2dPos& start, const C2dPos& centre, double sweep, bool clockwise, CArc& arc) {
  if (!isFinite(start) || !isFinite(centre) || std::isnan(sweep)) return false;
  if (!isPositive((start - centre).Module())) return false;
  arc.start = start;
  arc.center = centre;
  arc.clockwise = clockwise;
  arc.fullCircle = !isProperSweep(sweep);
  arc.centralAngle.setRad(arc.fullCircle ? 0.0 : sweep);
  return true;
}

// The arc from start to finish sweeping sweep radians (clockwise positive, 0 < |sweep| < 2pi). The centre
// lies on the perpendicular bisector of the chord, (c/2) cot(sweep/2) to the right of the chord direction:
// right of it for clockwise arcs up to a half circle, left of it for longer ones.
bool arcFromChordAndSweep(const C2dPos& start, const C2dPos& finish, double sweep, CArc& arc) {
  if (!isFinite(start) || !isFinite(finish) || !isProperSweep(sweep)) return false;
  const double chord = (finish - start).Module();
  if (!isPositive(chord)) return false;
  const double half = sweep / 2.0;
  const double toCentre = 0.5 * chord * std::cos(half) / std::sin(half);
  const C2dPos middle = (start + finish) * 0.5;
  arc.start = start;
  arc.center = middle + rightNormal(azimuth(start, finish)) * toCentre;
  arc.centralAngle.setRad(sweep);
  arc.clockwise = sweep > 0.0;
  arc.fullCircle = false;
  return true;
}

// The sweep from azimuth `from` to azimuth `to` (seen from the centre) in the given direction, in
// [0, 2pi) clockwise or (-2pi, 0] counter-clockwise.
double sweepBetween(double from, double to, bool clockwise) {
  return clockwise ? Normalize0ToLt2Pi(to - from) : -Normalize0ToLt2Pi(from - to);
}

// Applies a setter to a scratch copy and keeps it only when it succeeds.
template <class Build>
bool assignIf(CArc& arc, Build build) {
  CArc candidate = arc;
  if (!build(candidate)) return false;
  arc = candidate;
  return true;
}

}  // namespace

bool CArc::set_center_R(const C2dPos& centre, double radius) {
  if (!isPositive(radius)) return false;
  return assignIf(*this, [&](CArc& a) {
    return arcAboutCentre(centre + C2dPos(radius, 0.0), centre, 0.0, true, a);
  });
}

bool CArc::set_center_R_startAz_direction(const C2dPos& centre, double radius, const CMathAngle& startAz,
                                          bool isClockwise) {
  if (!isPositive(radius) || !startAz.isok()) return false;
  const double s = startAz.getSin();
  const double c = startAz.getCos();
  const C2dPos offset = isClockwise ? C2dPos(s, -c) : C2dPos(-s, c);
  return assignIf(*this, [&](CArc& a) { return arcAboutCentre(centre + offset * radius, centre, 0.0, isClockwise, a); });
}

bool CArc::set_r_start_center_finish(double radius, const CMathAngle& startAngle, const C2dPos& centre,
                                     const CMathAngle& finishAngle, bool isClockwise) {
  if (!isPositive(radius) || !startAngle.isok() || !finishAngle.isok()) return false;
  C2dPos startPos;
  startAngle.getPosAlong(radius, centre, startPos);
  const double sweep = sweepBetween(startAngle.getRad(), finishAngle.getRad(), isClockwise);
  return assignIf(*this, [&](CArc& a) { return arcAboutCentre(startPos, centre, sweep, isClockwise, a); });
}

bool CArc::set_r_start_finish(double radius, const C2dPos& startPos, const C2dPos& finish, bool isClockwise) {
  if (!isPositive(radius)) return false;
  const double halfChord = (finish - startPos).Module() / 2.0;
  if (!(halfChord <= radius + tol::kZero)) return false;
  const double ratio = halfChord < radius ? halfChord / radius : 1.0;
  const double magnitude = 2.0 * std::asin(ratio);
  return assignIf(*this, [&](CArc& a) {
    return arcFromChordAndSweep(startPos, finish, isClockwise ? magnitude : -magnitude, a);
  });
}

bool CArc::set_start_center_cAngle(const C2dPos& startPos, const C2dPos& centre, const CMathAngle& angle,
                                   bool isClockwise) {
  if (!angle.isok()) return false;
  const double magnitude = std::fabs(angle.getRad());
  if (!isProperSweep(magnitude)) return false;
  return assignIf(*this, [&](CArc& a) {
    return arcAboutCentre(startPos, centre, isClockwise ? magnitude : -magnitude, isClockwise, a);
  });
}

bool CArc::set_start_center_finish(const C2dPos& startPos, const C2dPos& centre, const C2dPos& finish,
                                   bool isClockwise) {
  if (!isFinite(finish) || !isPositive((finish - centre).Module())) return false;
  const double sweep = sweepBetween(azimuth(centre, startPos), azimuth(centre, finish), isClockwise);
  return assignIf(*this, [&](CArc& a) { return arcAboutCentre(startPos, centre, sweep, isClockwise, a); });
}

bool CArc::set_start_finish_bulge(const C2dPos& startPos, const C2dPos& finish, double bulge) {
  const double sweep = 4.0 * std::atan(bulge);
  return assignIf(*this, [&](CArc& a) { return arcFromChordAndSweep(startPos, finish, sweep, a); });
}

bool CArc::set_start_finish_finishTgDir(const C2dPos& startPos, const C2dPos& finish,
                                        const CMathAngle& finishTgAz) {
  if (!finishTgAz.isok()) return false;
  // The tangent turns by twice the angle between the chord and either end tangent.
  const double deflection = NormalizeNegPiToPi(finishTgAz.getRad() - azimuth(startPos, finish));
  return assignIf(*this, [&](CArc& a) { return arcFromChordAndSweep(startPos, finish, 2.0 * deflection, a); });
}

bool CArc::set_start_finish_plusPos(const C2dPos& startPos, const C2dPos& finish, const C2dPos& intermediate) {
  if (!isFinite(intermediate) || !isPositive((intermediate - startPos).Module()) ||
      !isPositive((finish - intermediate).Module())) {
    return false;
  }
  // Inscribed angle: the turn between the chords start->intermediate and intermediate->finish is half the
  // sweep of the arc through the three points.
  const double deflection =
      NormalizeNegPiToPi(azimuth(intermediate, finish) - azimuth(startPos, intermediate));
  return assignIf(*this, [&](CArc& a) { return arcFromChordAndSweep(startPos, finish, 2.0 * deflection, a); });
}

bool CArc::set_start_finish_startTgDir(const C2dPos& startPos, const C2dPos& finish,
                                       const CMathAngle& startTgAz) {
  if (!startTgAz.isok()) return false;
  const double deflection = NormalizeNegPiToPi(azimuth(startPos, finish) - startTgAz.getRad());
  return assignIf(*this, [&](CArc& a) { return arcFromChordAndSweep(startPos, finish, 2.0 * deflection, a); });
}

bool CArc::set_start_finish_turn(const C2dPos& startPos, const C2dPos& finish, const CMathAngle& turnAngle) {
  if (!turnAngle.isok()) return false;
  const double sweep = turnAngle.getRad();
  return assignIf(*this, [&](CArc& a) { return arcFromChordAndSweep(startPos, finish, sweep, a); });
}

bool CArc::set_start_r_length(const C2dPos& startPos, const CMathAngle& startAz, double radius, double length,
                              bool isClockwise) {
  if (!isPositive(radius) || !startAz.isok() || !(length / radius >= tol::kZero)) return false;
  const double circumference = units::kTwoPi * radius;
  const double slack = tol::kZero * circumference;
  if (length > circumference + slack) return false;
  const double magnitude = length >= circumference - slack ? 0.0 : length / radius;
  const C2dPos toCentre = rightNormal(startAz.getRad()) * (isClockwise ? radius : -radius);
  return assignIf(*this, [&](CArc& a) {
    return arcAboutCentre(startPos, startPos + toCentre, isClockwise ? magnitude : -magnitude, isClockwise, a);
  });
}

double CArc::getRadius() const { return (start - center).Module(); }

double CArc::getSweep() const {
  if (fullCircle) return clockwise ? units::kTwoPi : -units::kTwoPi;
  const double r = centralAngle.getRad();
  return clockwise ? Normalize0To2PI(r) : -Normalize0To2PI(-r);
}

double CArc::getLength() const { return getRadius() * std::fabs(getSweep()); }

bool CArc::isok() const { return isPositive(getRadius()) && centralAngle.isok(); }

bool CArc::get_start_tgdir(CMathAngle& az) const {
  if (!isok()) return false;
  az.setRad(azimuth(center, start) + (clockwise ? units::kHalfPi : -units::kHalfPi));
  return true;
}

bool CArc::get_end_tgdir(CMathAngle& az) const {
  if (!isok()) return false;
  az.setRad(azimuth(center, start) + getSweep() + (clockwise ? units::kHalfPi : -units::kHalfPi));
  return true;
}

bool CArc::get_middle_pos_on_the_arc(C2dPos& middle) const {
  if (!isok()) return false;
  CMathAngle rotation;
  rotation.setRad(fullCircle ? units::kPi : getSweep() / 2.0);
  rotation.getRotatedPoint(center, start, middle);
  return true;
}

bool CArc::get_end_pos(C2dPos& finish) const {
  if (!isok()) return false;
  CMathAngle rotation;
  rotation.setRad(getSweep());
  rotation.getRotatedPoint(center, start, finish);
  return true;
}
