#pragma once
// svy_math::TLine: a straight line segment from a start position to an end position (four doubles), with
// all the line mathematics of CGenericLine: positions along and across it (offsets positive to the right),
// length and offset of a point, intersections with other segments.
#include "svymath/curves/generic_line.h"
#include "svymath/foundation/tangle.h"

namespace svy_math {

class SVYMATH_API TLine : public CGenericLine {
  SVY_RTTI_DECLARE(TLine)

 public:
  SVY_CLASS_NEW_DELETE

  // Undefined ends (isok() is false until initialised).
  TLine();
  TLine(const C2dPos& start, const C2dPos& end);
  // From start along the azimuth for length: end = start + length (cos a, sin a).
  TLine(const C2dPos& start, const TAngle& azimuth, double length);
  TLine(const TLine& other);
  TLine& operator=(const TLine& other);
  ~TLine() override;

  void initialize(const C2dPos& start, const C2dPos& end);
  void initialize(const C2dPos& start, const TAngle& azimuth, double length);

  // The azimuth start -> end (0 for coincident ends).
  TAngle getAzimuth() const;

  // Whether all four coordinates are finite.
  bool isok() const override;
  double getStartNorthing() const override;
  double getStartEasting() const override;
  double getEndNorthing() const override;
  double getEndEasting() const override;

 private:
  double m_startNorth;
  double m_startEast;
  double m_endNorth;
  double m_endEast;
};

}  // namespace svy_math
