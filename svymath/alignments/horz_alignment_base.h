#pragma once
// The interface of every horizontal alignment: a chain of horizontal elements laid end to end in the plan,
// measured by chainage from the start chainage.
//
// Positions are (northing, easting) in metres; azimuths handed out as doubles are decimal degrees, clockwise
// from north; offsets are positive to the right of the direction of increasing chainage. Every query that
// can fail returns false and leaves its outputs unchanged.
#include "svymath/alignments/alignment_base.h"
#include "svymath/foundation/positions.h"

class CAlntHe;
class CHorzAlntElemBase;
class CGenericSegmentVisitor_const;

class SVYMATH_API CHorzAlntBase : public virtual CAlntBase {
  SVY_RTTI_DECLARE(CHorzAlntBase)

 public:
  ~CHorzAlntBase() override;

  virtual double getStartPosN() const = 0;
  virtual double getStartPosE() const = 0;
  // The last element's final point.
  virtual bool getFinalPosNe(double& north, double& east) const = 0;
  // The plan extent of all elements (empty for an empty alignment).
  virtual C2dMinMax getBoundary() const = 0;
  // Position, azimuth (degrees) and curvature (1/m, positive turning right) of the element holding the
  // chainage; false where no element holds it.
  virtual bool getPosNeAtChain(double chainage, double& north, double& east) const = 0;
  virtual bool getAzimuthAtChain(double chainage, double& azimuthDeg) const = 0;
  // Chainage and offset of a point, extended beyond both ends along the end tangents (extrapolated says
  // whether the answer lies on such an extension). index receives the element, atJoint whether the point
  // lies in the wedge outside a kink between two elements. The pointers may be null.
  virtual bool FindChainageAndOffset(double north, double east, double& chainage, double& offset,
                                     bool& extrapolated, int* index = nullptr, bool* atJoint = nullptr) const = 0;
  // The same on the alignment only (no extension beyond the ends).
  virtual bool FindChainageAndOffset(double north, double east, double& chainage, double& offset,
                                     int* index = nullptr, bool* atJoint = nullptr) const = 0;
  // A fast local inverse for a point known to lie near approxChainage: the point resolved along and
  // across the tangent at that chainage.
  virtual bool FindApproxChainageAndOffset(double approxChainage, double north, double east, double& chainage,
                                           double& offset) const = 0;
  // The centre-line position at any chainage, on the end tangents beyond the ends.
  virtual bool getPosNeAtChainExtr(double chainage, double& north, double& east, bool& extrapolated) const = 0;
  virtual bool getPosNeAtChainExtr(double chainage, double& north, double& east) const = 0;
  // The position at a chainage and offset (positive right), on the end tangents beyond the ends.
  virtual bool getPosNeAtChainAndOffsetExtr(double chainage, double offset, double& north, double& east,
                                            bool* extrapolated = nullptr) const = 0;
  virtual bool getAzimuthAtChainExtr(double chainage, double& azimuthDeg) const = 0;
  virtual bool getCurvatureAtChainage(double chainage, double& curvature) const = 0;
  // The element holding the chainage, the distance into it and its index (pointers may be null).
  virtual const CHorzAlntElemBase* getHorzElemAtChain(double chainage, double* distanceInElement,
                                                      int* index) const = 0;
  // Stores the start point; the third value is accepted and not stored.
  virtual void setStartPos(double north, double east, double third) = 0;
  // Editing: the alignment keeps a private clone of the element given.
  virtual bool appendElement(const CAlntHe& element) = 0;
  virtual bool insertElement(int index, const CAlntHe& element) = 0;
  virtual bool replaceElement(int index, const CAlntHe& element) = 0;
  virtual bool removeHe(int index) = 0;
  // The intersection point of the tangents at the element's two ends.
  virtual bool getIpPosForElement(int index, double& north, double& east) const = 0;

  int getNumOfHes() const { return getNumOfElements(); }
  // Element i as a horizontal element, or null.
  const CHorzAlntElemBase* getHe(int index) const;
  const CHorzAlntElemBase* getFirstHe() const;
  const CHorzAlntElemBase* getLastHe() const;
  // Hands every element's plan segments to the visitor, in order of chainage.
  void ForEachSegment(CGenericSegmentVisitor_const& visitor) const;

 protected:
  CHorzAlntBase() = default;
  CHorzAlntBase(const CHorzAlntBase& other) = default;
  CHorzAlntBase& operator=(const CHorzAlntBase& other) = default;
};
