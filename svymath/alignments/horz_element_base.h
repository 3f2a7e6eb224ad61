#pragma once
// The queries of a horizontal alignment element. The element answers by length (metres from its start)
// through its plan geometry; this interface adds the same queries by chainage, and the extrapolating ones
// that prolong the element along its end tangents.
//
// Positions are (northing, easting) in metres; azimuths as doubles are decimal degrees clockwise from north,
// as CMathAngle they are angles; offsets are positive to the right of the direction of travel; curvature is
// 1/radius, positive turning right. Queries return false, leaving their outputs unchanged, when the element
// is not placed or not defined, or when a length lies outside the element beyond the end snap (tol::kSnap);
// the ...Extr queries are defined at every chainage.
#include "svymath/alignments/alignment_element_base.h"

class CMathAngle;
class CGenericSegmentVisitor_const;

// The kind of a horizontal element (getType).
enum TAlntHeType : int {
  eAlntHeSegment = 0,  // tangent
  eAlntHeArc = 1,      // circular arc
  eAlntHeSpiral = 2,   // transition spiral
  eAlntHeIp = 3,       // intersection point with its curve group
};

class SVYMATH_API CHorzAlntElemBase : public CAlntElBase {
 public:
  ~CHorzAlntElemBase() override;

  // ---- answered by the element's geometry ----
  virtual bool getStartPosNe(double& north, double& east) const = 0;
  virtual bool getFinalPosNe(double& north, double& east) const = 0;
  virtual bool getStartAzimut(CMathAngle& azimuth) const = 0;
  virtual bool getFinalAzimut(CMathAngle& azimuth) const = 0;
  virtual bool getPosNeAtLength(double length, double& north, double& east) const = 0;
  virtual bool getAzimuthAtLength(double length, double& azimuthDeg) const = 0;
  virtual double getStepForDeviation(double length, double deviation) const = 0;
  // The nearest point of the element: its distance and its length along the element.
  virtual bool getShortestDistAndCurveLen(double north, double east, double& distance, double& length) const = 0;
  // Length of the point's foot on the element and its offset; false when it has no foot on the element.
  virtual bool getLengthAndOffset(double north, double east, double& length, double& offset) const = 0;
  // A cheap lower bound of the distance from the point to the element, used to prune the nearest-element
  // search (for a line: the distance to the prolonged line; for an arc: to the full circle, signed).
  virtual bool getShortestDistanceToPoint(double north, double east, double& distance) const = 0;
  virtual bool getPosAtLengthAndOffset(double length, double offset, double& north, double& east) const = 0;
  virtual bool getCurvatureAtLength(double length, double& curvature) const = 0;
  virtual void ForEachSegment(CGenericSegmentVisitor_const& visitor) const = 0;

  // ---- by chainage, built on the above ----
  virtual bool getPosNeAtChain(double chainage, double& north, double& east) const;
  // The position on the element, or on its prolonged end tangents outside it.
  virtual bool getPosNeAtChainExtr(double chainage, double& north, double& east) const;
  virtual bool getAzimuthAtChain(double chainage, double& azimuthDeg) const;
  // The azimuth on the element, the start azimuth before it and the final azimuth after it.
  virtual bool getAzimuthAtChainExtr(double chainage, double& azimuthDeg) const;
  // The chainage of the point's foot on the element and its offset.
  virtual bool getChainageAndOffsetForPos(double north, double east, double& chainage, double& offset) const;
  // The position at a chainage and offset, on the prolonged end tangents outside the element.
  virtual bool getPosNeAtChainAndOffsetExtr(double chainage, double offset, double& north, double& east) const;
  virtual bool getCurvatureAtChainage(double chainage, double& curvature) const;
  // The position one chord step (deviation in metres) after the chainage; returns the chainage reached
  // (the given chainage when the element cannot step).
  virtual double getNextPosForDeviation(double chainage, double deviation, double& north, double& east) const;

 protected:
  CHorzAlntElemBase() = default;
  CHorzAlntElemBase(const CHorzAlntElemBase&) = default;
  CHorzAlntElemBase& operator=(const CHorzAlntElemBase&) = default;
};
