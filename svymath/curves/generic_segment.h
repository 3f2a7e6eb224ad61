#pragma once
// The plan-view segment interface shared by every straight line, circular arc and transition spiral of the
// library, and by the alignment elements built on them.
//
// Positions are (northing, easting); azimuths are radians clockwise from north held in CMathAngle, and the
// queries that return an azimuth as a plain double return decimal degrees. A length is measured along the
// segment from its start; an offset is measured square to it, positive to the right of the direction of
// travel. Lengths are in the caller's linear unit (metres throughout the library).
//
// Failure is reported by a false result (outputs then unchanged) or a zero value; nothing throws or logs.
#include <cstdint>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svymath/foundation/rtti.h"
#include "svyutils/svy_containers.h"

class CMathAngle;
class CGenericLine;
class CGenericArc;
class CGenericSpiral;
class CGenericSegmentVisitor;
class CGenericSegmentVisitor_const;

// How the extent test (checkDistanceAlongIsOnLine) treats a segment's ends.
enum EIntersectionType : std::int32_t {
  eIntersectOnSegment = 0,     // only lengths from 0 to the total length inclusive lie on the segment
  eIntersectOnSegmentTol = 1,  // lengths strictly inside, or within tol::kSnap of either end, lie on it
  eIntersectUnbounded = 2,     // every length lies on it: the segment is treated as infinite
};

class SVYMATH_API CGenericSegment : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CGenericSegment)

 public:
  SVY_CLASS_NEW_DELETE

  ~CGenericSegment() override;

  // Whether the segment is fully defined.
  virtual bool isok() const = 0;

  virtual double getStartNorthing() const = 0;
  virtual double getStartEasting() const = 0;
  virtual C2dPos getStartPos() const;
  virtual double getEndNorthing() const = 0;
  virtual double getEndEasting() const = 0;
  virtual C2dPos getEndPos() const;

  // The smallest axis-aligned box holding the segment.
  virtual C2dMinMax getBoundary() const = 0;
  virtual double getTotalLength() const = 0;

  virtual bool getStartAzimut(CMathAngle& azimuth) const = 0;
  virtual bool getEndAzimut(CMathAngle& azimuth) const = 0;
  // Tangent azimuth at `length`; the double form returns decimal degrees (0 when undefined).
  virtual bool getAzimuthAtLength(double length, CMathAngle& azimuth) const = 0;
  virtual double getAzimuthAtLength(double length) const = 0;
  // Signed curvature (1/radius) at `length`: positive turning right.
  virtual double getCurvatureAtLength(double length) const = 0;

  // The longest step from `length` whose chord stays within `deviation` of the segment.
  virtual double getStepForDeviation(double length, double deviation) const = 0;
  // The position one deviation step after `length`; returns the length of that position.
  virtual double getNextPosForDeviation(double length, double deviation, C2dPos& pos) const;
  virtual double getNextPosForDeviation(double length, double deviation, double& north,
                                        double& east) const;

  virtual bool getPosAtLength(double length, C2dPos& pos) const;
  virtual bool getPosAtLength(double length, double& north, double& east) const = 0;
  // The position at `length`, moved `offset` square to the segment (positive to the right).
  virtual bool getPosAtLengthAndOffset(double length, double offset, C2dPos& pos) const;
  virtual bool getPosAtLengthAndOffset(double length, double offset, double& north,
                                       double& east) const = 0;
  // Length along and offset from the segment of a position; false when it does not lie beside the segment.
  virtual bool getLengthAndOffset(const C2dPos& pos, double& length, double& offset) const;
  virtual bool getLengthAndOffset(double north, double east, double& length, double& offset) const = 0;
  virtual bool getShortestDistanceToPoint(const C2dPos& pos, double& distance) const;
  virtual bool getShortestDistanceToPoint(double north, double east, double& distance) const = 0;

  virtual void Accept(CGenericSegmentVisitor_const& visitor) const = 0;
  virtual void Accept(CGenericSegmentVisitor& visitor) = 0;

  // Appends every crossing of this segment with `other` to `out`; true when at least one was found. The
  // call dispatches on the kind of `other`, then on the kind of this segment.
  bool calcIntersections(const CGenericSegment& other, svy_vector<C2dPos>& out) const;
  bool calcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const;
  bool calcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const;
  bool calcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const;

  // Whether a length along the segment lies on it, by the intersection type.
  bool checkDistanceAlongIsOnLine(double length) const;

  void setIntersectionType(EIntersectionType type) { m_intersectionType = type; }
  EIntersectionType getIntersectionType() const { return m_intersectionType; }

 protected:
  explicit CGenericSegment(EIntersectionType type);
  CGenericSegment(const CGenericSegment& other);
  CGenericSegment& operator=(const CGenericSegment& other);

  virtual bool doCalcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const = 0;
  virtual bool doCalcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const = 0;
  virtual bool doCalcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const = 0;
  // Dispatches on the dynamic kind of `other` to one of the three forms above.
  virtual bool doCalcIntersections(const CGenericSegment& other, svy_vector<C2dPos>& out) const;

 private:
  class CIntersectionDispatch;

  EIntersectionType m_intersectionType;
};
