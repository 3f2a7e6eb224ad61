#pragma once
// A circular arc record: start position, centre, signed central angle, turning direction and a full-circle
// flag.
//
// Sign convention: the central angle is positive for a clockwise arc (turning right on the map) and negative
// for a counter-clockwise arc, as rotations by CMathAngle are clockwise-positive. The stored angle is reduced
// to [-pi, pi]; an arc of more than a half circle is recovered from it together with the clockwise flag
// (getSweep). A full circle stores a central angle of 0 with fullCircle set.
//
// Every setter fills the whole record. A setter returns false and leaves the record unchanged when its input
// cannot define an arc: a non-positive radius, coincident points (within 1e-12), a straight configuration.
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"

class SVYMATH_API CArc {
 public:
  C2dPos start;
  C2dPos center;
  CMathAngle centralAngle;
  bool clockwise = false;
  bool fullCircle = false;

  // A whole circle of radius R about centre, starting due north of it, clockwise.
  bool set_center_R(const C2dPos& centre, double radius);
  // A whole circle whose tangent at the start has azimuth a = startAz, the centre lying to the right of that
  // tangent for a clockwise circle: start = centre + R (sin a, -cos a); counter-clockwise: centre + R (-sin a,
  // cos a). Central angle 0, fullCircle set.
  bool set_center_R_startAz_direction(const C2dPos& centre, double radius, const CMathAngle& startAz,
                                      bool isClockwise);
  // Start and finish given by their azimuths seen from the centre; the arc runs from the start to the
  // finish in the given direction (equal azimuths: a whole circle).
  bool set_r_start_center_finish(double radius, const CMathAngle& startAngle, const C2dPos& centre,
                                 const CMathAngle& finishAngle, bool isClockwise);
  // The shorter arc of radius R (at most a half circle) from start to finish in the given direction; false
  // when the chord exceeds the diameter.
  bool set_r_start_finish(double radius, const C2dPos& startPos, const C2dPos& finish, bool isClockwise);
  // The arc about centre from start through the magnitude of centralAngle in the given direction.
  bool set_start_center_cAngle(const C2dPos& startPos, const C2dPos& centre, const CMathAngle& angle,
                               bool isClockwise);
  // The arc about centre from start to the ray centre->finish in the given direction (finish on that ray,
  // at any distance; on the start ray: a whole circle).
  bool set_start_center_finish(const C2dPos& startPos, const C2dPos& centre, const C2dPos& finish,
                               bool isClockwise);
  // The arc of a polyline bulge b = tan(sweep / 4): positive turns clockwise, |b| = 1 is a half circle.
  bool set_start_finish_bulge(const C2dPos& startPos, const C2dPos& finish, double bulge);
  // The arc from start to finish whose tangent at the finish has the given azimuth.
  bool set_start_finish_finishTgDir(const C2dPos& startPos, const C2dPos& finish, const CMathAngle& finishTgAz);
  // The arc from start through an intermediate point to finish.
  bool set_start_finish_plusPos(const C2dPos& startPos, const C2dPos& finish, const C2dPos& intermediate);
  // The arc from start to finish whose tangent at the start has the given azimuth.
  bool set_start_finish_startTgDir(const C2dPos& startPos, const C2dPos& finish, const CMathAngle& startTgAz);
  // The arc from start to finish turning its tangent by turnAngle (positive clockwise).
  bool set_start_finish_turn(const C2dPos& startPos, const C2dPos& finish, const CMathAngle& turnAngle);
  // The arc of length L and radius R leaving start with tangent azimuth startAz (a length of a whole
  // circumference, within 1e-12 relative, gives a whole circle; more fails).
  bool set_start_r_length(const C2dPos& startPos, const CMathAngle& startAz, double radius, double length,
                          bool isClockwise);

  // Tangent azimuth at the start; false when the record has no radius.
  bool get_start_tgdir(CMathAngle& az) const;
  // Tangent azimuth at the finish; false when the record has no radius.
  bool get_end_tgdir(CMathAngle& az) const;
  // The start rotated about the centre by half the sweep (pi for a whole circle: the opposite point).
  bool get_middle_pos_on_the_arc(C2dPos& middle) const;
  // The start rotated about the centre by the whole sweep.
  bool get_end_pos(C2dPos& finish) const;
  // Distance from centre to start.
  double getRadius() const;
  // The signed sweep in radians (-2pi, 2pi), clockwise positive, taken from the central angle and the
  // direction flag; +-2pi for a whole circle.
  double getSweep() const;
  // Arc length, radius times |sweep|.
  double getLength() const;
  // Whether the record has a radius above the zero tolerance.
  bool isok() const;
};

// Holds one arc for callers that build it step by step.
class SVYMATH_API CArcCalculator {
 public:
  void setArc(const CArc& arc) { m_arc = arc; }
  const CArc& getArc() const { return m_arc; }
  CArc& getArc() { return m_arc; }

 private:
  CArc m_arc;
};
