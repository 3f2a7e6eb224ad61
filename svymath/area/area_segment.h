#pragma once
// A boundary segment of an area: a straight line or a circular arc, from its start to its end coordinate.
// A closed boundary is an ordered svy_list<AreaSegment>, the end of each segment being the start of the next
// and the last closing onto the first.
//
// Direction of an arc: counterClockwise false turns clockwise on the map (north up, east right) about the
// centre going from start to end. The swept angle is Normalize0To2PI(az(centre->end) - az(centre->start))
// for a clockwise arc and 2 pi minus that for a counter-clockwise one (0 when start equals end); the arc
// length is the swept angle times the radius. A clockwise arc bulges to the left of its chord, a
// counter-clockwise arc to the right.
#include <cstdint>

#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svyutils/svy_containers.h"

// Bare source names of the area code in the error log.
constexpr const char* kAreaMathLogSource = "AreaMath";
constexpr const char* kAreaSubdivisionLogSource = "AreaSubdivisionMath";

// Status of the area functions; only the numbers cross the library boundary.
enum EAreaCalcStatus : std::int32_t {
  eAreaCalcOk = 0,
  eAreaCalcSegmentsCross = 4,      // two boundary segments cross or overlap
  eAreaCalcChordCrosses = 5,       // the chord of an arc crosses another boundary segment
  eAreaCalcTooFewSegments = 6,     // a vertex area of fewer than three segments
  eAreaCalcNotACircle = 15,        // a one-segment boundary that is not a whole circle
  eAreaCalcGeometryFailed = 18,    // an azimuth, distance, intersection or segment area failed
  eAreaCalcZeroArea = 19,          // the vertex area of three or more segments is zero
  eAreaCalcSubdivided = 20,        // subdivision succeeded: pieces and cut filled
  eAreaCalcTotalAreaFailed = 27,   // the area of the whole boundary could not be computed
  eAreaCalcAreaTooLarge = 28,      // the requested area exceeds the whole boundary's
  eAreaCalcSearchFailed = 29,      // the search for the cut found no bracket, failed, stalled or ran out
};

struct SVYMATH_API AreaSegment {
  enum : std::int32_t { kLine = 0, kArc = 1 };

  TCoords start;
  TCoords end;
  double length = 0.0;           // chord length of a line, arc length of an arc (metres)
  std::int32_t type = kLine;
  double radiusOrAzimuth = 0.0;  // arc: radius (positive, metres); line: azimuth start->end (radians)
  bool counterClockwise = false; // arcs only
  TCoords center;                // arcs only; the default record for a line

  AreaSegment() = default;
  // A line; its azimuth and length from the two coordinates.
  AreaSegment(const TCoords& startCoords, const TCoords& endCoords);
  // An arc about a known centre; radius = distance centre->start.
  AreaSegment(const TCoords& startCoords, const TCoords& endCoords, const TCoords& centerCoords, bool ccw);
  // The arc of at most a half turn with the given radius, turning in the given direction.
  AreaSegment(const TCoords& startCoords, const TCoords& endCoords, double radius, bool ccw);
  // The arc of the given central angle (radians; above pi a major arc, whose centre lies on the other
  // side of the chord).
  AreaSegment(double centralAngle, const TCoords& startCoords, const TCoords& endCoords, bool ccw);

  bool boIsLine() const { return type == kLine; }
  bool boIsArc() const { return type == kArc; }
  // The arc's radius (the segment must be an arc).
  double radius() const { return radiusOrAzimuth; }
};

// Appends a line for each consecutive pair of points, then a closing line from the last point to the first
// unless they are the same vertex (within 2e-9 m). Fewer than two points add nothing. Always true.
SVYMATH_API bool getAreaSegmentListFromPointVector(svy_vector<C2dPos> points, svy_list<AreaSegment>& list);

// Whether any segment of the list is an arc.
SVYMATH_API bool boDoesPolygonContainAnArc(const svy_list<AreaSegment>& list);

// Whether two coordinates are the same vertex: the north and east components whose validity bits the two
// records share agree within 2e-9 m.
SVYMATH_API bool boAreSameAreaVertex(const TCoords& a, const TCoords& b);
