#pragma once
// A complete straight line held as its two end points and their azimuth.
#include "svymath/curves/generic_line.h"
#include "svymath/foundation/math_angle.h"

class SVYMATH_API CGenericLineImpl : public CGenericLine {
  SVY_RTTI_DECLARE(CGenericLineImpl)

 public:
  SVY_CLASS_NEW_DELETE

  // All coordinates 0, azimuth 0, bounded to the segment.
  CGenericLineImpl();
  // From start to end; the azimuth is that of start -> end.
  CGenericLineImpl(const C2dPos& start, const C2dPos& end, EIntersectionType type = eIntersectOnSegment);
  // An unbounded line through start along azimuth; its end is placed kDefaultLength along it.
  CGenericLineImpl(const C2dPos& start, const CMathAngle& azimuth);
  // A line of `length` from start along azimuth.
  CGenericLineImpl(const C2dPos& start, const CMathAngle& azimuth, double length, EIntersectionType type);
  CGenericLineImpl(const CGenericLineImpl& other);
  CGenericLineImpl& operator=(const CGenericLineImpl& other);
  ~CGenericLineImpl() override;

  // Length given to a line built from a point and an azimuth alone (linear units).
  static constexpr double kDefaultLength = 1000.0;

  // Always true: the fields are the definition.
  bool isok() const override;
  double getStartNorthing() const override;
  double getStartEasting() const override;
  double getEndNorthing() const override;
  double getEndEasting() const override;
  // The stored azimuth.
  bool getStartAzimut(CMathAngle& azimuth) const override;

 private:
  double m_startNorth = 0.0;
  double m_startEast = 0.0;
  double m_endNorth = 0.0;
  double m_endEast = 0.0;
  CMathAngle m_azimuth;
};
