#pragma once
// The mathematics of every circular arc: centre, side, length and offset of a point, boundary and the
// crossings with lines and other arcs. The arc starts at getStartPos heading getStartAzimut and turns with
// the signed radius getRadius (positive to the right, clockwise on the map); its centre lies on the right
// for a positive radius and on the left for a negative one.
#include "svymath/curves/generic_segment.h"
#include "svymath/foundation/math_angle.h"

// Whether direction `test` lies in the sweep from `start` clockwise to `end`, each end widened by
// |tolerance| (radians). Undefined angles count as 0.
SVYMATH_API bool isAngleRadInRange(const CMathAngle& start, const CMathAngle& end, const CMathAngle& test,
                                   double tolerance);

class SVYMATH_API CGenericArc : public CGenericSegment {
  SVY_RTTI_DECLARE(CGenericArc)

 public:
  using CGenericSegment::getLengthAndOffset;
  using CGenericSegment::getShortestDistanceToPoint;

  ~CGenericArc() override;

  // The exact box: both ends and every extreme point of the circle that lies within the sweep.
  C2dMinMax getBoundary() const override;
  // The sweep from the centre->start direction to the centre->point direction times |radius|; the offset
  // is R - d turning right and R + d turning left (d: distance from the centre), so it is positive on the
  // right of the direction of travel either way. A point at the centre (within tol::kSnap in both
  // coordinates) gets length 0 and offset R. False when the direction from the centre lies outside the
  // sweep.
  bool getLengthAndOffset(double north, double east, double& length, double& offset) const override;
  // Distance from the centre minus |R|, without extent test: negative for a point inside the circle.
  bool getShortestDistanceToPoint(double north, double east, double& distance) const override;

  void Accept(CGenericSegmentVisitor_const& visitor) const override;
  void Accept(CGenericSegmentVisitor& visitor) override;

  // The signed radius: positive turning right.
  virtual double getRadius() const = 0;
  // True for a radius >= 0.
  virtual bool isToTheRight() const;
  // The centre from the start position and start azimuth; false when they are undefined.
  virtual bool getArcCenterPos(C2dPos& centre) const;
  // Directions from the centre (undefined when the centre is).
  virtual CMathAngle getAzimuthFromCenter(const C2dPos& pos) const;
  virtual CMathAngle getAzimuthCenterToStart() const;
  virtual CMathAngle getAzimuthCenterToEnd() const;

  // Crossings of the arc with the line of constant northing (easting): up to two points appended to out.
  bool calcHorizontalIntersection(double north, svy_vector<C2dPos>& out) const;
  bool calcVerticalIntersection(double east, svy_vector<C2dPos>& out) const;
  // Whether a point of the circle (a crossing) lies within the arc's sweep.
  bool checkValidIntersectionPoint(const C2dPos& pos) const;
  // The sweep test of a direction from the centre, by the intersection type: always true unbounded;
  // otherwise the direction must lie from start clockwise to end (right turn) or from end clockwise to
  // start (left turn), with no tolerance on the segment and 1e-12 rad with tolerance. A full circle
  // accepts every direction.
  bool checkValidAzimuthToIntersectionPoint(const CMathAngle& start, const CMathAngle& end,
                                            const CMathAngle& test) const;
  // Whether the arc closes on itself (its length reaches 2 pi |R|).
  bool isFullCircle() const;

 protected:
  explicit CGenericArc(EIntersectionType type);
  CGenericArc(const CGenericArc& other);
  CGenericArc& operator=(const CGenericArc& other);

  using CGenericSegment::doCalcIntersections;
  bool doCalcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const override;
  bool doCalcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const override;
  bool doCalcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const override;

 private:
  // The centre and the directions from it to the start and the end; false when undefined.
  bool getSweepFrame(C2dPos& centre, CMathAngle& toStart, CMathAngle& toEnd) const;
  // Appends the crossings of the circle with the line through the two positions that pass the sweep test.
  bool appendLineCrossings(const C2dPos& linePos1, const C2dPos& linePos2, svy_vector<C2dPos>& out) const;
};
