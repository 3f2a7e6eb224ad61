#pragma once
// A point of a road cross-section: an offset across the centre line (metres, negative left, positive right)
// and an elevation (metres), chained to its left and right neighbours in the section that owns it.
//
// Slope ratios are rise over run (elevation change per metre of offset, positive rising to the right).
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svymath/foundation/rtti.h"
#include "svyutils/svy_string.h"

class CRoadCrossSection;

class SVYMATH_API CRoadCrossSectPoint : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CRoadCrossSectPoint)

 public:
  SVY_CLASS_NEW_DELETE

  // A point still in a section is detached from it first, so the section's ends stay valid.
  ~CRoadCrossSectPoint() override;
  CRoadCrossSectPoint(const CRoadCrossSectPoint&) = delete;
  CRoadCrossSectPoint& operator=(const CRoadCrossSectPoint&) = delete;

  virtual double getOffset() const = 0;
  virtual double getElevation() const = 0;
  virtual const svy_text::CSvyString& getName() const = 0;
  // The plane position (northing, easting) of the point, from its section's centre-line position and
  // across vector; the offset alone along the across vector when the point is in no section.
  virtual C2dPos getPosition() const;
  // (elevation, offset) in one record.
  virtual C2dPos getElevAndOffs() const;
  virtual unsigned getFeatureIndex() const = 0;
  // The plane position at an offset from the centre line, or from this point when fromThisPoint is set.
  virtual C2dPos getPosAtOffset(double offset, bool fromThisPoint) const;
  // The elevation at an offset on the straight segment to the right (left) neighbour, extended beyond the
  // two points; NaN without that neighbour or when the two share one offset.
  virtual double getElevationFromSurfaceRight(double offset) const;
  virtual double getElevationFromSurfaceLeft(double offset) const;
  virtual const CRoadCrossSection* getSection() const { return m_section; }
  virtual const CRoadCrossSectPoint* getLeft() const { return m_left; }
  virtual const CRoadCrossSectPoint* getRight() const { return m_right; }
  virtual CRoadCrossSectPoint* getRightEditable() { return m_right; }

  // Rise over run from this point to other: 0 when the elevations agree within the zero tolerance,
  // +-tol::kVerticalSlopeRatio (signed by the rise) when the offsets do, else rise / run.
  double getSlopeRatio(const CRoadCrossSectPoint& other) const;
  // The ratio of the segment from the left neighbour to this point (from this point to the right
  // neighbour); 0 without that neighbour.
  double getSlopeRatioLeft() const;
  double getSlopeRatioRight() const;
  // The elevation at an offset on the line through this point and other (NaN when they share one offset).
  double getElevationFromSurface(double offset, const CRoadCrossSectPoint& other) const;
  // The offset where the line through this point and other reaches an elevation (NaN when it is level).
  double calcOffsetFromSurface(double elevation, const CRoadCrossSectPoint& other) const;

 protected:
  CRoadCrossSectPoint();

 private:
  friend class CRoadCrossSection;

  CRoadCrossSection* m_section;
  CRoadCrossSectPoint* m_left;
  CRoadCrossSectPoint* m_right;
};

// The plain point kind: offset, elevation, name and feature index held as values.
class SVYMATH_API CRoadCrossSectOffsPoint : public CRoadCrossSectPoint {
  SVY_RTTI_DECLARE(CRoadCrossSectOffsPoint)

 public:
  SVY_CLASS_NEW_DELETE

  CRoadCrossSectOffsPoint(double offset, double elevation, const svy_text::CSvyString& name = {},
                          unsigned featureIndex = 0);
  ~CRoadCrossSectOffsPoint() override;

  double getOffset() const override { return m_offset; }
  double getElevation() const override { return m_elevation; }
  const svy_text::CSvyString& getName() const override { return m_name; }
  unsigned getFeatureIndex() const override { return m_featureIndex; }

 private:
  double m_offset;
  double m_elevation;
  svy_text::CSvyString m_name;
  unsigned m_featureIndex;
};
