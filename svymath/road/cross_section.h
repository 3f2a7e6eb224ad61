#pragma once
// A road cross-section: the profile of the road across its centre line at one chainage, an ordered chain of
// points from the leftmost to the rightmost offset (metres, negative left of the centre line, positive
// right), each with an elevation (metres). The section owns its points.
//
// The centre line's plane position and azimuth place the section in the plan: the along vector is the unit
// direction of the azimuth (N = cos, E = sin), the across vector points to the right of it (N = -sin, E = cos).
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"
#include "svymath/foundation/rtti.h"
#include "svymath/road/cross_section_point.h"

class SVYMATH_API CRoadCrossSection : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CRoadCrossSection)

 public:
  SVY_CLASS_NEW_DELETE

  explicit CRoadCrossSection(double chainage);
  CRoadCrossSection(double chainage, double clElevation, bool clElevationExtrapolated);
  ~CRoadCrossSection() override;
  CRoadCrossSection(const CRoadCrossSection&) = delete;
  CRoadCrossSection& operator=(const CRoadCrossSection&) = delete;

  // The plane position at an offset across the centre line.
  virtual C2dPos getPosAtOffset(double offset) const;
  // The elevation on the segment holding the offset (from getLeftOfOffset to its right neighbour) and, if
  // asked, that segment's rise over run. False without such a segment: no points, an offset outside the
  // chain, or exactly the rightmost point's offset (it has no right neighbour).
  virtual bool getElevationAtOffs(double offset, double& elevation, double* slopeRatio = nullptr) const;
  // As getElevationAtOffs inside the chain; beyond its ends the outermost segment's slope is continued.
  // False with fewer than two points or an outermost segment without run.
  virtual bool getElevationAtOffsSlope(double offset, double& elevation, double& slopeRatio) const;
  // The rise over run of the segment holding the offset (as getElevationAtOffs).
  virtual bool getSlopeRatioAtOffset(double offset, double& slopeRatio) const;
  // The first point (from the left) with a feature index; null when none has it.
  virtual const CRoadCrossSectPoint* findPointWithId(unsigned featureIndex) const;
  // Of the points with a name, the one nearest to an offset; null when none has the name.
  virtual const CRoadCrossSectPoint* findPointFromNameAndOffs(const svy_text::CSvyString& name, double offset) const;
  // The point at a 0-based index from the left; null outside the chain.
  virtual const CRoadCrossSectPoint* getPointAtIndex(int index) const;
  // The point on the centre line (offset within tol::kOffsetZero of 0); null when there is none.
  virtual const CRoadCrossSectPoint* findCenterPoint() const;
  // A number that changes whenever the points, the chainage, the centre-line elevation, position or azimuth
  // change: a caller that keeps results derived from the section compares it to know they are stale.
  virtual unsigned getCacheVersion() const { return m_cacheVersion; }

  double getChainage() const { return m_chainage; }
  double getClElevation() const { return m_clElevation; }
  bool hasClElevation() const { return m_hasClElevation; }
  bool isClElevationExtrapolated() const { return m_clElevationExtrapolated; }
  bool isClPosExtrapolated() const { return m_clPosExtrapolated; }
  void setClElevation(double elevation, bool extrapolated);
  bool hasPoints() const { return m_leftMost != nullptr; }
  int getNumOfPoints() const;
  const CRoadCrossSectPoint* getLeftMostPoint() const { return m_leftMost; }
  CRoadCrossSectPoint* getLeftMostPointEditable() { return m_leftMost; }
  const CRoadCrossSectPoint* getRightMostPoint() const { return m_rightMost; }
  const CRoadCrossSectPoint* getLeftOf(const CRoadCrossSectPoint& point) const { return point.getLeft(); }
  const CRoadCrossSectPoint* getRightOf(const CRoadCrossSectPoint& point) const { return point.getRight(); }
  const CRoadCrossSectPoint* getNext(const CRoadCrossSectPoint& point, bool toRight) const {
    return toRight ? point.getRight() : point.getLeft();
  }
  // The point at or left of an offset: null without points or left of the chain, the rightmost point right
  // of it. Inside the chain the walk starts at the nearer end; walking leftwards it stops at the first point
  // at or left of the offset, walking rightwards at the last point strictly left of it. A point exactly at
  // the offset is therefore found from the right end but passed over from the left end (null when it is
  // the leftmost point). Callers of earlier releases rely on this; it is kept.
  const CRoadCrossSectPoint* getLeftOfOffset(double offset) const;
  // The mirror image: the point at or right of an offset.
  const CRoadCrossSectPoint* getRightOfOffset(double offset) const;
  const C2dPos& getCenterLinePos() const { return m_clPos; }
  const CMathAngle& getAzimuth() const { return m_azimuth; }
  const C2dPos& getAlongVector() const { return m_along; }
  const C2dPos& getAcrossVector() const { return m_across; }

 protected:
  // Extend the chain at its left (right) end with a point created by new; the section takes it over.
  // Refused (false, the caller keeps the point) when the point is already in a section, its offset is not
  // a number, or it would lie right of the leftmost (left of the rightmost) point.
  bool addToLeft(CRoadCrossSectPoint& point);
  bool addToRight(CRoadCrossSectPoint& point);
  // Insert a point created by new at its place by offset (after points at the same offset); the same
  // refusals as addToRight apart from the order.
  bool insertByOffset(CRoadCrossSectPoint& point);
  void deleteAllPoints();
  void setChainage(double chainage);
  void setCenterLinePos(const C2dPos& position, bool extrapolated);
  void setCenterLineAzimuth(const CMathAngle& azimuth);

 private:
  friend class CRoadCrossSectPoint;

  void init();
  bool canAdopt(const CRoadCrossSectPoint& point) const;
  void adopt(CRoadCrossSectPoint& point, CRoadCrossSectPoint* left, CRoadCrossSectPoint* right);
  void onPointDetaching(CRoadCrossSectPoint& point);

  bool m_hasClElevation;
  double m_clElevation;
  bool m_clElevationExtrapolated;
  CRoadCrossSectPoint* m_leftMost;
  CRoadCrossSectPoint* m_rightMost;
  double m_chainage;
  C2dPos m_clPos;
  CMathAngle m_azimuth;
  C2dPos m_along;
  C2dPos m_across;
  bool m_clPosExtrapolated;
  unsigned m_cacheVersion;
};

// A section its owner fills: the road, a template, or a caller with its own data.
class SVYMATH_API CEditableRoadCrossSection : public CRoadCrossSection {
  SVY_RTTI_DECLARE(CEditableRoadCrossSection)

 public:
  SVY_CLASS_NEW_DELETE

  using CRoadCrossSection::CRoadCrossSection;
  ~CEditableRoadCrossSection() override;

  // A plain point at its place by offset; false (nothing added) when the offset is not a number.
  bool addPoint(double offset, double elevation, const svy_text::CSvyString& name = {}, unsigned featureIndex = 0);
  using CRoadCrossSection::addToLeft;
  using CRoadCrossSection::addToRight;
  using CRoadCrossSection::deleteAllPoints;
  using CRoadCrossSection::insertByOffset;
  using CRoadCrossSection::setCenterLineAzimuth;
  using CRoadCrossSection::setCenterLinePos;
  using CRoadCrossSection::setChainage;
};
