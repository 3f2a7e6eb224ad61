#pragma once
// A full transition spiral as curve data: the shape in the local frame of the element (origin at the
// element's start, local north along its start tangent, local east the right-hand normal), between zero
// curvature and one radius, by one owned spiral law (clothoid or cubic parabola).
//
// Direction of travel: a TS-to-SC element runs from the tangent into the curve (curvature grows along it),
// a CS-to-ST element from the curve out to the tangent. Every signed value of the record (radius,
// curvature, azimuth, the side) describes the element as travelled: toTheRight means the element turns
// clockwise from its start to its end, whichever way it runs. A CS-to-ST element runs the law backwards, so
// its law is held with the opposite side.
//
// Azimuths returned as plain doubles are decimal degrees relative to the start tangent; lengths are along
// the element from its start.
#include <cstdint>

#include "svymath/curves/curve_display.h"
#include "svymath/curves/spiral_base.h"
#include "svymath/curves/spiral_type.h"
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"

class SVYMATH_API CCurveDataSpiral1R {
 public:
  SVY_CLASS_NEW_DELETE

  // An undefined spiral of the given law, running TS to SC.
  explicit CCurveDataSpiral1R(AlntMathSpiralType type = eMathSpiralEuler);
  CCurveDataSpiral1R(const CCurveDataSpiral1R& other);
  CCurveDataSpiral1R& operator=(const CCurveDataSpiral1R& other);
  virtual ~CCurveDataSpiral1R();

  // The kind code of spiral data (the alignment element code of a spiral).
  static int static_type();

  // ---- definition ----
  // Undefined law (same type), TS to SC; the flags are kept.
  virtual void reset();
  void copy(const CCurveDataSpiral1R& other) { *this = other; }
  // Replaces the law by an undefined one of the given type.
  void resetType(AlntMathSpiralType type);
  // Replaces the law by one of the given type defined with the same length, radius and side. False (law
  // undefined) when the new law cannot reach that radius within that length.
  bool recreateSimpleSpiral(AlntMathSpiralType type);
  // Length L and end radius R (its sign is ignored: the side comes from toTheRight).
  bool setLenAndR(double L, double R, bool toTheRight, bool isTSSC);
  // The same, recording in the flags the form in which the user entered the length and the radius.
  bool setLenAndR(double L, AlntElementLengthDisplay lengthDisplay, double R, AlntElementRadiusDisplay radiusDisplay,
                  bool toTheRight, bool isTSSC);
  // Length and spiral constant K = R*L (see the law for the clothoid's treatment of it).
  bool setLenAndSpPrm(double L, double K, bool isTSSC);
  // The full spiral whose part between the radii R1 and R2 (in either order) is L long. This record covers
  // the whole spiral, from the tangent to the sharper radius; CCurveDataSpiral keeps just the part.
  virtual bool setLenAndTwoR(double L, double R1, double R2, bool toTheRight, bool isTSSC);
  // Redefines the law with its own length and radius turning to the given side.
  virtual bool setTurnRight(bool toTheRight);

  // ---- queries ----
  // The law's length and spiral angle are known.
  bool isok() const { return m_law->isok(); }
  virtual double getTotalLength() const;
  // Change of direction from the start to length s, decimal degrees (positive turning right).
  virtual double GetAzimuth(double s) const;
  // Local position at length s; false (logged) for undefined data or s outside [0, length] beyond the snap.
  virtual bool getPosAtLength(double s, double& north, double& east) const;
  // Signed curvature at s (1/m, positive turning right); 0 for undefined data.
  virtual double getCurvatureAtLength(double s) const;
  // The largest step from s whose chord stays within dev of the spiral (to 1e-9 of the step), cut at the
  // end; the rest of the element when dev is not positive; 0 (logged) for s outside the element.
  virtual double getStepForDeviation(double s, double dev) const;
  // The point of the element nearest to the local point (north, east): len its length, dist its signed
  // distance (positive when the point lies right of the direction of travel at that length). An end point
  // is returned (len 0 or the total length) when the nearest point is an end. False for undefined data.
  bool getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const;
  // The nearest foot of a perpendicular from the local point, or the nearer end: the element is cut into
  // pieces of at most half a radian of turn, each foot bracketed by the along component changing sign between the
  // ends of a piece (32 samples instead where a piece could hide one) and found by a Newton search on the
  // foot-point condition (bisection fallback) converging to tol::kProjectionLength. False for undefined
  // data or a non-finite point.
  struct TFoot {
    double length = 0.0;    // length of the foot (or end) on the element
    double along = 0.0;     // component along the tangent there (0 at a true foot)
    double offset = 0.0;    // component square to the tangent, positive to the right
    bool interior = false;  // a foot of the perpendicular, not an end
    double distance() const;
  };
  bool findFoot(double north, double east, TFoot& foot) const;

  // Local end point and end direction (relative to the start tangent).
  double getFinalNorthing() const;
  double getFinalEasting() const;
  bool getFinalAzimut(CMathAngle& azimuth) const;
  double getFinalAzimutInRad() const;

  // Signed radius at the sharp end (positive turning right); A = sqrt(|R*L|) of the law; the length at
  // which the direction has turned by the given angle from the start (0 where it never does).
  double getRadius() const;
  double getSpiralParam() const;
  virtual double getLengthAtAzimuth(const CMathAngle& angle) const;

  bool isTSSC() const { return m_isTSSC; }
  bool isCSST() const { return !m_isTSSC; }
  bool isToTheRight() const;
  bool isToTheLeft() const;
  // The owned law (full spiral, law frame, law side).
  const CCurveSpiralTStoSCBase* getSimpleSpiral() const { return m_law; }
  AlntMathSpiralType getSpiralMathType() const { return m_law->getMathSpiralType(); }

  // Length, radius, side and direction as they were set (the law's own values for a full spiral).
  bool GetSpiralElement(double& length, double& radius, bool& toTheRight, bool& isTSSC) const;
  // The same with the recorded forms of entry.
  bool GetSpiralElement(double& length, AlntElementLengthDisplay& lengthDisplay, double& radius,
                        AlntElementRadiusDisplay& radiusDisplay, bool& toTheRight, bool& isTSSC) const;

  // The flags word (bits 4-6 radius display, bits 7-9 length display, the rest the host's).
  std::uint32_t getFlags() const { return m_flags; }
  void setFlags(std::uint32_t flags) { m_flags = flags; }
  std::uint32_t getAlntElementFlags() const { return m_flags; }

 protected:
  // Components along and across the tangent at length s of the vector from that point to the local point.
  bool componentsAt(double north, double east, double s, double& along, double& offset) const;
  // The foot between a and b, where along(a) > 0 >= along(b): bracketed Newton with bisection fallback.
  bool refineFoot(double north, double east, double a, double b, double aAlong, double bAlong, TFoot& candidate) const;
  // Curvature of the law's sharp end (1/m, unsigned): no part of the element is sharper.
  double sharpestCurvature() const;
  // Number of projection pieces of the element (see findFoot); 0 when it needs more than the dense samples.
  int projectionPieces(double total) const;
  // How a scan of the element for the nearest foot or end ended.
  enum class EFootScan { kFound, kDense, kFailed };
  // The nearest foot or end from the element cut into intervals of equal length, each sign change of the
  // along component refined; with boundPieces, kDense when an interval may hide a minimum (see findFoot).
  EFootScan scanFoot(double north, double east, double total, int intervals, bool boundPieces, TFoot& foot) const;
  // Law length s of element length s (the law runs backwards under a CS-to-ST element).
  double lawLength(double s) const { return m_isTSSC ? s : m_law->getLength() - s; }
  // Position of the full spiral at element length s without the range check.
  bool fullPosAtLength(double s, double& north, double& east) const;
  // The largest step from full-spiral element length s within dev, not past limit (element length).
  double fullStepForDeviation(double s, double dev, double limit) const;
  // Called after every change of the law or direction (the partial spiral re-derives its placement).
  virtual void onDefinitionChanged() {}
  // Called when the law is defined anew from a length and a radius or constant (a partial spiral becomes
  // the full one); onDefinitionChanged follows.
  virtual void onSpiralRedefined() {}

  CCurveSpiralTStoSCBase* m_law;
  bool m_isTSSC = true;
  std::uint32_t m_flags = 0;
};
