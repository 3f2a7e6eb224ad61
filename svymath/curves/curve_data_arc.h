#pragma once
// A circular arc as curve data, in the local frame of its element (origin at the element's start, local
// north along the start tangent, local east its right-hand normal). The radius is signed: positive for an
// arc turning right (clockwise, centre at local (0, R)), negative turning left. The centre angle carries
// the same sign. Lengths are never negative.
//
// The record keeps the length and the radius as defined and derives the other from the centre angle when
// only one is known. Undefined values are NaN. The derived values are cached inside const queries, so one
// record must not be read from two threads at once.
#include <cstdint>

#include "svymath/curves/curve_display.h"
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"

class SVYMATH_API CCurveDataArc {
 public:
  SVY_CLASS_NEW_DELETE

  CCurveDataArc();

  // The kind code of arc data (the alignment element code of an arc).
  static int static_type();

  // Every value undefined; the flags are kept.
  void reset();
  void copy(const CCurveDataArc& other) { *this = other; }
  // Length and radius are known (given or derivable).
  bool isok() const;

  // Length (>= 0) and radius; the side comes from toTheRight, not from the radius's sign. False (unchanged)
  // for a negative or non-finite length or a non-finite radius.
  bool SetElement(double length, double radius, bool toTheRight);
  // The same, recording how the user gave the two values.
  bool SetElement(double length, AlntElementLengthDisplay lengthDisplay, double radius,
                  AlntElementRadiusDisplay radiusDisplay, bool toTheRight);
  bool GetElement(double& length, double& radius, bool& toTheRight) const;
  bool GetElement(double& length, AlntElementLengthDisplay& lengthDisplay, double& radius,
                  AlntElementRadiusDisplay& radiusDisplay, bool& toTheRight) const;
  // From the centre angle and the radius: length |R angle| (an undefined angle counts as 0); the radius
  // takes the sign of the angle.
  void setCAngleR(const CMathAngle& angle, double radius);
  // The same with the side given: radius and angle both take the sign of toTheRight.
  void setCAngleR(const CMathAngle& angle, double radius, bool toTheRight);
  // A whole circle of the radius, turning to the given side.
  bool setCircle(double radius, bool toTheRight);
  // A new length along the same circle. False (unchanged) for a negative or non-finite length.
  bool setLen(double length);

  // The length, or |radius * centre angle| when only those are known.
  double getTotalLength() const;
  // Signed radius. Derived as length / centre angle when only those are known; when neither radius nor
  // length is known this logs and returns 1e-6 (a tiny non-zero value that keeps later divisions finite).
  double getRadius() const;
  const CMathAngle& getCenterAngle() const { return m_centerAngle; }
  // Local centre (0, R).
  bool getCenterNE(double& north, double& east) const;
  // Start-to-end chord.
  double getChordLength() const;
  // The arc closes on itself.
  bool isCircle() const;
  bool isToTheLeft() const { return getRadius() <= 0.0; }
  bool isToTheRight() const { return getRadius() >= 0.0; }

  // Direction at length s relative to the start tangent, decimal degrees (0 for a zero radius).
  double GetAzimuth(double s) const;
  // (R sin(s/R), R (1 - cos(s/R))); false for undefined data, false and logged for s outside [0, length]
  // beyond the snap.
  bool getPosAtLength(double s, double& north, double& east) const;
  // 1/R; 0 for a zero or undefined radius.
  double getCurvatureAtLength(double s) const;
  // The longest step from s whose chord stays within dev of the arc, 2 |R| acos(1 - d/|R|) with d = min(dev,
  // |R|), capped at |R| pi/16 and at the rest of the arc; the rest of the arc for dev <= 0. 0 (logged) for
  // s outside the arc.
  double getStepForDeviation(double s, double dev) const;
  // The point of the arc nearest to the local point: len its length, dist its distance, positive when the
  // point lies right of the direction of travel. False for undefined data or a non-finite point.
  bool getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const;

  double getFinalNorthing() const;
  double getFinalEasting() const;
  // The direction at the end relative to the start tangent.
  bool getFinalAzimut(CMathAngle& azimuth) const;
  double getFinalAzimutInRad() const;

  std::uint32_t getFlags() const { return m_flags; }
  void setFlags(std::uint32_t flags) { m_flags = flags; }
  std::uint32_t getAlntElementFlags() const { return m_flags; }

 private:
  // Clears the cached end point.
  void clearCache();
  // The signed radius when given or derivable (no fallback, no log).
  bool knownRadius(double& radius) const;
  // The change of direction over length s (radians, signed); 0 for a zero radius.
  double turnAt(double s) const;

  mutable double m_finalNorth;
  mutable double m_finalEast;
  mutable double m_length;
  mutable double m_radius;
  CMathAngle m_centerAngle;
  std::uint32_t m_flags = 0;
};
