#pragma once
// Utilities on plan point lists (polygons and polylines given by their vertices): area, perimeter and
// orientation, removal of repeated and collinear vertices, the nearest vertex and the nearest point.
//
// Plan positions are (northing, easting); lengths are metres, areas square metres. A list is a closed
// polygon when `closed` is true (its last vertex joins the first; a repeated first vertex at the end is
// allowed and adds nothing) and an open polyline otherwise. Sums are taken relative to the first vertex, so
// that survey coordinates (N 5 000 000, E 500 000) keep their digits. Nothing here logs or throws.
#include <cstdint>

#include "svymath/cogo/cogo_results.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svyutils/svy_containers.h"

class SVYMATH_API C2dPtListUt {
 public:
  enum EOrientation : std::int32_t {
    eOrientationDegenerate = 0,  // fewer than three vertices, or no area (strictly within +-1e-12 m2)
    eOrientationClockwise = 1,   // north up, east right
    eOrientationCounterClockwise = 2,
  };

  // The area of the polygon, positive when its vertices run counter-clockwise (north up, east right) and
  // negative when clockwise, as the vertex area of the area code signs it. 0 for fewer than three vertices;
  // NaN when a vertex is not finite.
  static double getSignedArea(const svy_vector<C2dPos>& points);
  // The unsigned area of the polygon.
  static double getArea(const svy_vector<C2dPos>& points);
  // The length of the polyline, with the closing side when closed. NaN when a vertex is not finite.
  static double getPerimeter(const svy_vector<C2dPos>& points, bool closed);
  static EOrientation getOrientation(const svy_vector<C2dPos>& points);
  // Reverses the order of the vertices when the polygon does not already run as asked (a degenerate one is
  // left as it is). Returns whether it reversed them.
  static bool setOrientation(svy_vector<C2dPos>& points, EOrientation wanted);

  // Removes every vertex within `tolerance` metres of the vertex kept before it (for a closed list also a
  // last vertex within it of the first), keeping the first of each run. Returns how many were removed.
  static int removeRepeatedPoints(svy_vector<C2dPos>& points, bool closed, double tolerance);
  // Removes every vertex that lies within `tolerance` metres of the straight line between its kept
  // neighbours and between them (a vertex where the line turns back is kept). Repeated vertices go too. The
  // ends of an open list are always kept; a closed list keeps at least three vertices. Returns how many
  // were removed.
  static int removeCollinearPoints(svy_vector<C2dPos>& points, bool closed, double tolerance);

  // The index of the vertex nearest to `point` (the first of equally near ones) and its distance; -1 (and
  // distance untouched) for an empty list or when nothing finite is near.
  static int getNearestVertex(const svy_vector<C2dPos>& points, const C2dPos& point, double& distance);
  // The nearest point of the polyline (closed: of the polygon's sides) to `point`, with its position along
  // the list and offset: CogoFunctions::eInverseToPolyline.
  static CogoFunctions::ECogoMathErrorCode getNearestPoint(const svy_vector<C2dPos>& points, bool closed,
                                                           const C2dPos& point,
                                                           CogoFunctions::TElementInverse& result);
};
