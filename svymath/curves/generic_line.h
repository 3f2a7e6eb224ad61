#pragma once
// The mathematics of every straight plan-view piece: a tangent element, svy_math::TLine and
// CGenericLineImpl all answer through this class. The line starts at (getStartNorthing, getStartEasting)
// and runs along getStartAzimut (radians clockwise from north); offsets are positive to the right.
#include "svymath/curves/generic_segment.h"

class SVYMATH_API CGenericLine : public CGenericSegment {
  SVY_RTTI_DECLARE(CGenericLine)

 public:
  using CGenericSegment::getAzimuthAtLength;
  using CGenericSegment::getLengthAndOffset;
  using CGenericSegment::getPosAtLength;
  using CGenericSegment::getPosAtLengthAndOffset;
  using CGenericSegment::getShortestDistanceToPoint;

  ~CGenericLine() override;

  // Min and max of the two ends.
  C2dMinMax getBoundary() const override;
  // Start-to-end distance.
  double getTotalLength() const override;

  // The start-to-end direction, the same at every length; false when it is undefined (NaN ends).
  bool getStartAzimut(CMathAngle& azimuth) const override;
  bool getEndAzimut(CMathAngle& azimuth) const override;
  bool getAzimuthAtLength(double length, CMathAngle& azimuth) const override;
  double getAzimuthAtLength(double length) const override;
  double getCurvatureAtLength(double length) const override;
  // A line never leaves its chord: the step is the rest of the line.
  double getStepForDeviation(double length, double deviation) const override;

  // Positions along the prolonged line: no extent test.
  bool getPosAtLength(double length, double& north, double& east) const override;
  bool getPosAtLengthAndOffset(double length, double offset, double& north, double& east) const override;
  // Along and offset values within the zero tolerance are returned as exactly 0; false when the along
  // value fails the extent test.
  bool getLengthAndOffset(double north, double east, double& length, double& offset) const override;
  // The perpendicular distance to the prolonged line (no extent test): always non-negative.
  bool getShortestDistanceToPoint(double north, double east, double& distance) const override;

  void Accept(CGenericSegmentVisitor_const& visitor) const override;
  void Accept(CGenericSegmentVisitor& visitor) override;

  // The crossing with the line of constant northing `north` (or constant easting `east`); false when the
  // lines are parallel or the crossing fails this line's extent test.
  bool calcHorizontalIntersection(double north, C2dPos& pos) const;
  bool calcVerticalIntersection(double east, C2dPos& pos) const;
  // Whether the point of the line at that northing (easting) passes the extent test; for a line of
  // constant northing (easting), whether the value is that of the line.
  bool checkNorthIsOnLine(double north) const;
  bool checkEastIsOnLine(double east) const;
  // The northing of the line at an easting, and the easting at a northing; false for a line parallel to
  // the given axis.
  bool interpolateNorthing(double east, double& north) const;
  bool interpolateEasting(double north, double& east) const;
  // Whether the ends share their northing (easting) to the last bit of a double.
  bool isLineWithSameNorthing() const;
  bool isLineWithSameEasting() const;
  // Whether a point of the line (a crossing) passes the extent test.
  bool checkValidIntersectionPoint(const C2dPos& pos) const;

 protected:
  explicit CGenericLine(EIntersectionType type);
  CGenericLine(const CGenericLine& other);
  CGenericLine& operator=(const CGenericLine& other);

 private:
  using CGenericSegment::doCalcIntersections;

  // Start position and unit direction of the line; false when undefined.
  bool getFrame(C2dPos& start, double& cosAz, double& sinAz) const;

  bool doCalcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const override;
  bool doCalcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const override;
  bool doCalcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const override;
};
