#pragma once
// The mathematics common to every transition spiral: its side, its boundary and its crossings with other
// segments, found through an approximation of the spiral by kCacheArcs circular arcs. The spiral law itself
// (positions, azimuths, curvature) comes from the concrete spiral element.
#include "svymath/curves/generic_segment.h"

class CCurveArc;

class SVYMATH_API CGenericSpiral : public CGenericSegment {
  SVY_RTTI_DECLARE(CGenericSpiral)

 public:
  ~CGenericSpiral() override;

  // Number of three-point arcs that stand in for the spiral in intersections.
  static constexpr int kCacheArcs = 20;

  // The box of the positions sampled along the spiral, widened by the exact points where the tangent is
  // parallel to an axis (the extremes between samples).
  C2dMinMax getBoundary() const override;

  void Accept(CGenericSegmentVisitor_const& visitor) const override;
  void Accept(CGenericSegmentVisitor& visitor) override;

  // Signed radii at the ends (positive turning right; 0 at a tangent end) and the spiral parameter A.
  virtual double getStartRadius() const = 0;
  virtual double getEndRadius() const = 0;
  virtual double getSpiralParam() const = 0;
  // By the start radius when it is defined and not zero, else by the end radius.
  virtual bool isToTheRight() const;
  // The length at which the spiral's tangent has the given azimuth.
  virtual double getLengthAtAzimuth(const CMathAngle& azimuth) const = 0;

  // Replaces `arcs` by the approximation: with h = length / (2 kCacheArcs), arc k passes through the
  // positions at 2k h, (2k + 1) h and (2k + 2) h. The chain stops at the first position that cannot be
  // computed; false when no arc was built. Each arc takes this spiral's intersection type (an unbounded
  // spiral gives arcs bounded with the end tolerance).
  bool createCache(svy_vector<CCurveArc>& arcs) const;

 protected:
  explicit CGenericSpiral(EIntersectionType type);
  CGenericSpiral(const CGenericSpiral& other);
  CGenericSpiral& operator=(const CGenericSpiral& other);

  using CGenericSegment::doCalcIntersections;
  bool doCalcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const override;
  bool doCalcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const override;
  bool doCalcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const override;
};
