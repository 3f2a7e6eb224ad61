#pragma once
// The curve group about an intersection point (IP), as road designers lay it out: an entry transition
// spiral (TS to SC), a circular arc (SC to CS) and an exit spiral (CS to ST) between the tangent that
// arrives at the IP and the tangent that leaves it. Either spiral may have length zero, so a plain circular
// curve is a case of it; radius zero with no spirals is a bare angle point (the tangents meet at the IP).
//
// The group is defined by the IP, the radius and the two spiral lengths; its tangents come from the
// previous and next intersection points (setNeighbours), so it is recomputed whenever a neighbour moves.
// The direction of turn follows from the tangents: the signed values read back (radius, deflection) are
// positive turning right (clockwise), as everywhere in the library.
//
// Lengths are measured along the group from TS (0) to ST (getTotalLength()), with the element end snap
// (tol::kSnap); azimuths returned as doubles are decimal degrees.
//
// Geometry. With the deflection D (signed, from the azimuth previous->IP to the azimuth IP->next) and the
// spiral angles t1, t2 of the two spirals (L/2R for the clothoid, atan(3 a x^2) at the end of a cubic
// parabola), the arc turns through |D| - t1 - t2, which must not be negative. Each spiral, seen from its
// tangent point, ends at (x, y) with direction t; the arc's circle is then shifted off that tangent by
// p = y - R (1 - cos t) and its centre lies k = x - R sin t along the tangent from the tangent point. The
// centre is R + p1 off the entry tangent and R + p2 off the exit tangent, which gives the tangent lengths
//   T1 = (R + p1) tan(|D|/2) + k1 - (p1 - p2) / sin|D|,   T2 = (R + p2) tan(|D|/2) + k2 + (p1 - p2) / sin|D|
// (unequal spirals make an asymmetric group: T1 != T2). TS lies T1 before the IP on the entry tangent, ST
// T2 after it on the exit tangent. All of it is computed relative to the IP, so that it keeps its digits at
// survey coordinates; the parts (CCurveSpiral TS-SC, CCurveArc, CCurveSpiral CS-ST) are then placed by
// origin and azimuth and answer every query over their own length range.
//
// Threads: the parts fill caches inside const queries (angles, spiral laws), so one group must not be read
// from two threads at once; distinct groups are independent.
//
// Degenerate tangents: a curve needs a real turn. Collinear tangents (|D| below tol::kZero) and a reversal
// (|D| within tol::kHalfTurnDeg of a half turn, where the tangents would be infinite) define no curve and
// fail; a simple point takes any deflection.
#include "svymath/curves/curve_arc.h"
#include "svymath/curves/curve_spiral.h"
#include "svymath/curves/spiral_type.h"
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/positions.h"
#include "svymath/foundation/rtti.h"

class CGenericSegmentVisitor_const;

// Why a group is or is not defined (getStatus).
enum ECurveIpStatus : int {
  eCurveIpOk = 0,
  eCurveIpUndefined = 1,          // setIp or setNeighbours not yet given, or a group beyond finite numbers
  eCurveIpNoTangent = 2,          // a neighbour coincides with the IP
  eCurveIpCollinear = 3,          // the tangents run straight on: no curve to fit
  eCurveIpReversal = 4,           // the tangents turn back on themselves: infinite tangent lengths
  eCurveIpSpiralUnreachable = 5,  // the spiral law cannot reach the radius within the spiral length
  eCurveIpSpiralsTooLong = 6,     // the spirals turn further than the tangents
};

class SVYMATH_API CCurveIp : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CCurveIp)

 public:
  SVY_CLASS_NEW_DELETE

  // Undefined (isok() false) until setIp and setNeighbours have both succeeded.
  CCurveIp();
  CCurveIp(const CCurveIp& other);
  CCurveIp& operator=(const CCurveIp& other);
  ~CCurveIp() override;

  // ---- definition ----
  // The group about the intersection point (ipNorth, ipEast) with an arc of the given radius (metres, its
  // sign is ignored: the turn comes from the tangents), an entry spiral of length lenIn and an exit spiral
  // of length lenOut (metres, >= 0): the five values in that order. A radius below tol::kCurveRadiusZero
  // with no spirals makes a simple point. False, leaving the group unchanged, for non-finite or negative
  // values, or spirals with a zero radius. Otherwise true, and the group is recomputed when its neighbours
  // are known: isok() tells whether the curve fits between the tangents.
  bool setIp(double ipNorth, double ipEast, double radius, double lenIn, double lenOut);
  // A bare angle point at the current IP: radius 0, no spirals.
  void setSimplePoint();
  bool isSimplePoint() const;
  // The law of both spirals (clothoid by default).
  void setSpiralType(AlntMathSpiralType type);
  AlntMathSpiralType getSpiralType() const;
  // The tangents: from the previous intersection point (or the alignment's start) to the IP, and from the
  // IP to the next intersection point (or the alignment's end). Recomputes the parts. False, and the group
  // undefined, when a neighbour coincides with the IP, when the spirals do not fit the deflection (their
  // turning angles lenIn/2R + lenOut/2R exceed it), or when the tangents are parallel while a curve is
  // asked for. A simple point needs only distinct neighbours.
  bool setNeighbours(const C2dPos& previous, const C2dPos& next);
  bool isok() const;
  // eCurveIpOk when isok(); otherwise the reason.
  ECurveIpStatus getStatus() const;
  bool isEqual(const CCurveIp& other) const;

  // ---- read back ----
  C2dPos getIp() const;
  double getRadius() const;         // signed: positive turning right; 0 for a simple point
  double getLenIn() const;          // entry spiral length (metres)
  double getLenOut() const;         // exit spiral length (metres)
  double getDeflection() const;     // signed turn of the tangents at the IP (radians, positive right)
  double getTangentIn() const;      // distance TS to IP (metres)
  double getTangentOut() const;     // distance IP to ST (metres)
  double getShiftIn() const;        // shift of the arc from the entry tangent (metres)
  double getShiftOut() const;       // shift of the arc from the exit tangent (metres)
  C2dPos getTS() const;
  C2dPos getSC() const;
  C2dPos getCS() const;
  C2dPos getST() const;
  double getTotalLength() const;    // lenIn + arc length + lenOut (0 for a simple point)
  // The parts, null where a part has no length.
  const CCurveSpiral* getSpiralIn() const;
  const CCurveArc* getArc() const;
  const CCurveSpiral* getSpiralOut() const;

  // ---- queries over the group, from TS ----
  // Each is answered by the part that holds the length (at a joint the later part; the snap of the first
  // and last parts applies beyond the group's ends). A simple point has only length 0 (within the snap):
  // its position is the IP and its azimuth there the exit tangent's.
  bool getStartAzimut(CMathAngle& azimuth) const;
  bool getEndAzimut(CMathAngle& azimuth) const;
  bool getPosAtLength(double length, double& north, double& east) const;
  bool getAzimuthAtLength(double length, CMathAngle& azimuth) const;
  double getCurvatureAtLength(double length) const;
  // The length and offset (positive right) of the point's foot on the group: the part with the smallest
  // |offset| that has a foot, a later part within tol::kSnap of it taking over. False when no part has a
  // foot. At a simple point only the wedge outside the angle (past the entry tangent's end and before the
  // exit tangent's start) has its foot there: length 0, offset the distance to the IP, negative on the left.
  bool getLengthAndOffset(double north, double east, double& length, double& offset) const;
  // The nearest point of the group: its distance (never negative), or its signed distance (positive right)
  // and length.
  bool getShortestDistanceToPoint(double north, double east, double& distance) const;
  bool getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const;
  double getStepForDeviation(double length, double deviation) const;
  C2dMinMax getBoundary() const;
  // Hands the parts that have length to the visitor, in order of travel.
  void ForEachSegment(CGenericSegmentVisitor_const& visitor) const;

 private:
  // Rebuilds the parts from the definition and the stored neighbours.
  bool rebuild();
  // Makes the computed values undefined.
  void clearComputed();
  // The parts that have length, in order of travel, with the group length where each begins and its box.
  struct TPart {
    const CGenericSegment* segment;
    double start;
    const C2dMinMax* box;
  };
  int parts(TPart (&out)[3]) const;
  // The part holding group length s (at a joint the later one; before the start the first, after the end
  // the last) and s as a length along it. Null when the group has no parts.
  const CGenericSegment* partAt(double s, double& partLength) const;
  // The signed distance of a point from a simple point (positive right of both tangents).
  double simplePointOffset(double north, double east) const;

  C2dPos m_ip;
  C2dPos m_previous;
  C2dPos m_next;
  double m_radius;  // magnitude; 0 for a simple point
  double m_lenIn;
  double m_lenOut;
  AlntMathSpiralType m_spiralType;
  bool m_neighboursSet;
  bool m_ok;
  // Computed by rebuild().
  ECurveIpStatus m_status;
  double m_deflection;
  CMathAngle m_azIn;   // previous -> IP
  CMathAngle m_azOut;  // IP -> next
  double m_tangentIn;
  double m_tangentOut;
  double m_shiftIn;
  double m_shiftOut;
  double m_arcLength;
  C2dPos m_ts;
  C2dPos m_sc;
  C2dPos m_cs;
  C2dPos m_st;
  CCurveSpiral m_spiralIn;
  CCurveArc m_arc;
  CCurveSpiral m_spiralOut;
  C2dMinMax m_boxIn;
  C2dMinMax m_boxArc;
  C2dMinMax m_boxOut;
};
