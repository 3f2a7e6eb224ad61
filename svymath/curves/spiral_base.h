#pragma once
// A transition-spiral law: the full spiral from zero curvature (length 0, the tangent-to-spiral point TS) to
// the radius R (length L, the spiral-to-curve point SC), in its own local frame. The origin is the TS, the
// local north axis is the initial tangent and the local east axis its right-hand normal, so a spiral to the
// right (R > 0) has positive eastings and one to the left (R < 0) negative ones. Lengths in metres (or the
// caller's unit), angles in radians inside, decimal degrees where a plain double is returned and the name
// says Azimuth.
//
// Partial spirals, reversed (curve-to-tangent) spirals and placement in the world belong to the curve data
// records (CCurveDataSpiral1R, CCurveDataSpiral) that own one law each.
//
// Threads: a law fills caches inside const queries (its end point; the cubic law its length <-> x pair), so
// one law object must not be read from two threads at once. Distinct objects are independent.
#include "svymath/curves/spiral_type.h"
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"

class SVYMATH_API CCurveSpiralTStoSCBase {
 public:
  SVY_CLASS_NEW_DELETE

  virtual ~CCurveSpiralTStoSCBase();

  // Makes the law undefined: every double NaN.
  virtual void reset();
  virtual AlntMathSpiralType getMathSpiralType() const = 0;
  // Change of direction from the TS to length s, in decimal degrees (negative for a spiral to the left).
  virtual double GetAzimuth(double s) const = 0;
  // Length at which the direction has changed by the given angle; 0 where there is none.
  virtual double getLengthAtAzimuth(const CMathAngle& angle) const = 0;
  // Signed curvature (1/m, positive turning right) at length s.
  virtual double getCurvatureAtLength(double s) const = 0;
  // Local position of the SC (length L).
  virtual double getFinalNorthing() const = 0;
  virtual double getFinalEasting() const = 0;
  // Local position at length s in [0, L] (snapped within 0.001). False, logged, and outputs untouched for an
  // undefined law or a length outside the spiral.
  virtual bool getPosAtLength(double s, double& north, double& east) const = 0;
  // Whether the chord of a step of the given length from startLength stays within maxDeviation of the
  // spiral: half the change of direction over the step, t, must be below pi/16 and |tan(t)*step| below
  // maxDeviation. Always true for an undefined or straight law.
  virtual bool checkStepForDeviation(double step, double startLength, double maxDeviation) const;
  // Defines the spiral by its length and end radius; the side is taken from toTheRight, not from R's sign.
  virtual bool setLenAndR(double L, double R, bool toTheRight) = 0;
  // Defines the spiral by its length and spiral constant K = R*L.
  virtual bool setLenAndSpPrm(double L, double K) = 0;
  // Defines the full spiral from the length L of its part between the radii R1 and R2 (|R1| > |R2|: the
  // part runs towards the sharper radius, which becomes the law's end radius).
  virtual bool setLenAndTwoR(double L, double R1, double R2, bool toTheRight) = 0;
  // Takes over other's definition when other is of the same law; false (and nothing changed) otherwise.
  virtual bool copy(const CCurveSpiralTStoSCBase* other);
  // A heap copy, owned by the caller.
  virtual CCurveSpiralTStoSCBase* clone() const = 0;

  double getLength() const { return m_length; }
  double getRadius() const { return m_radius; }
  const CMathAngle& getSpiralAngle() const { return m_spiralAngle; }
  // The defining values (length and spiral angle) are known.
  bool isok() const;
  // L or |R| below the zero tolerance: every position is the origin.
  bool isDegenerate() const;

 protected:
  CCurveSpiralTStoSCBase();
  CCurveSpiralTStoSCBase(const CCurveSpiralTStoSCBase&) = default;
  CCurveSpiralTStoSCBase& operator=(const CCurveSpiralTStoSCBase&) = default;

  double m_length;              // L, metres; NaN when undefined
  double m_radius;              // R at length L, signed: positive to the right
  CMathAngle m_spiralAngle;     // total change of direction over L
  mutable double m_finalNorth;  // local end point (cached, NaN until known)
  mutable double m_finalEast;
};
