#pragma once
// Tangents to circles: the common tangents of two circles, the tangents from a point to a circle, the line
// through the crossings of two circles, and the fillet: the circle of a given radius tangent to two lines.
//
// Plan positions are (northing, easting); azimuths are clockwise from north (CMathAngle holds radians);
// radii are metres. Circles that miss or overlap by at most svy_math::tol::kTangency (1e-8 m) touch. Work is
// done relative to the first circle's centre. Nothing here logs, throws or allocates.
#include "svymath/cogo/cogo_results.h"
#include "svymath/foundation/arc.h"
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"

namespace svy_math {

// The common tangents of two circles, or the tangents from a point (a circle of radius 0) to a circle.
// Each tangent is given by its touching points on the two circles.
class SVYMATH_API TTangentToCircles {
 public:
  SVY_CLASS_NEW_DELETE

  struct TTangent {
    C2dPos onFirst;   // touching point on the first circle (the point itself for a point)
    C2dPos onSecond;  // touching point on the second circle
    // True for an outer tangent (both circles on the same side of it), false for an inner one (it passes
    // between the centres).
    bool outer = true;
  };

  static constexpr int kMaxTangents = 4;

  // Every common tangent of the circles (center1, radius1) and (center2, radius2), radii not negative, at
  // most one of them 0. In order: the outer tangents, then the inner ones; of each pair first the one
  // touching the circles on the right of the direction center1 -> center2, then the one on the left.
  // Their number: 4 for separate circles, 3 for circles touching outside (the third is the tangent at the
  // touching point, both its points being that point), 2 for crossing circles, 1 for circles touching
  // inside, 0 for a circle inside the other (eCogoNoSolution). Concentric circles, and circles that coincide
  // within the tangency tolerance, give eCogoConcentric. With a radius 0 the inner tangents are the outer
  // ones and are not repeated: 2 from a point outside the circle, 1 from a point on it. Negative or
  // non-finite input gives eCogoInvalidInput. The previous tangents are cleared in every case.
  CogoFunctions::ECogoMathErrorCode solve(const C2dPos& center1, double radius1, const C2dPos& center2,
                                          double radius2);
  // The tangents from `point` to the circle: solve(point, 0, center, radius).
  CogoFunctions::ECogoMathErrorCode solveFromPoint(const C2dPos& point, const C2dPos& center, double radius);

  int count() const { return m_count; }
  // The tangent at index 0 .. count() - 1; an index outside reads the first slot, which means nothing when
  // count() is 0.
  const TTangent& tangent(int index) const { return m_tangents[index >= 0 && index < m_count ? index : 0]; }

 private:
  TTangent m_tangents[kMaxTangents];
  int m_count = 0;
};

}  // namespace svy_math

// The line on which two circles cross: with two crossings both outputs hold them (the one right of
// center1 -> center2 first), with the circles touching, the touching point and a second point of their
// common tangent, the smaller radius to the right of center1 -> center2 from it. Returns the number of
// crossings (0, 1 or 2); with 0 the outputs are left as they were.
SVYMATH_API int TwoCirclesIntersectionLine(const C2dPos& center1, double radius1, const C2dPos& center2,
                                           double radius2, C2dPos& linePos1, C2dPos& linePos2);

namespace CogoFunctions {

// The fillet of `radius` between the line through point1 along azimuth1 (travelled toward the lines'
// crossing) and the line through point2 along azimuth2 (travelled away from it): the arc that leaves the
// first line tangentially and joins the second, turning right (clockwise) when azimuth2 lies clockwise of
// azimuth1 within a half turn. The arc record holds its start (the tangent point on the first line), its
// centre, the signed turn as central angle and the direction; its end (CArc::get_end_pos) is the tangent
// point on the second line. eCogoParallel for lines without a crossing or a turn of (nearly) a half turn,
// where the tangent points would lie at infinity; eCogoInvalidInput for a radius that is not positive.
SVYMATH_API ECogoMathErrorCode eFilletTwoLines(const C2dPos& point1, const CMathAngle& azimuth1, const C2dPos& point2,
                                               const CMathAngle& azimuth2, double radius, CArc& fillet);

}  // namespace CogoFunctions
