#include "svymath/area/polygon_area.h"

#include <cmath>

#include "svymath/area/area_geometry.h"
#include "svymath/area/area_pieces.h"
#include "svymath/area/polygon_predicates.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace tol = svy_math::tol;
namespace units = svy_math::units;

namespace {

// Lines of the log entries of the area computation, as earlier releases wrote them.
constexpr int kLogLineTwoLines = 1952;
constexpr int kLogLineRimSegmentZero = 1990;
constexpr int kLogLineSegmentZero = 2026;
constexpr int kLogLineAreaZero = 2050;
constexpr int kLogLineAreaNotPositive = 2051;

void log(int line) { svy_logging::svy_err_log(kAreaMathLogSource, line, ""); }

bool nearZero(double x) { return -tol::kAreaNearZero < x && x < tol::kAreaNearZero; }

// The circular segment between an arc and its chord, by the arc's stored length.
bool chordSegmentArea(const AreaSegment& arc, double& area) {
  return AreaCircChord(arc.radius(), arc.length / arc.radius(), &area) && std::isfinite(area);
}

EAreaCalcStatus twoSegmentArea(const AreaSegment& s1, const AreaSegment& s2, double& area) {
  if (s1.boIsArc() != s2.boIsArc()) {
    return chordSegmentArea(s1.boIsArc() ? s1 : s2, area) ? eAreaCalcOk : eAreaCalcGeometryFailed;
  }
  if (!s1.boIsArc()) {
    log(kLogLineTwoLines);
    return eAreaCalcGeometryFailed;
  }
  double a1 = 0.0;
  double a2 = 0.0;
  if (!chordSegmentArea(s1, a1) || !chordSegmentArea(s2, a2)) return eAreaCalcGeometryFailed;
  const double l1 = s1.length;
  const double l2 = s2.length;
  const double h1 = units::kPi * s1.radius();
  const double h2 = units::kPi * s2.radius();
  // The side of the common chord each arc bulges to: the direction flag, turned over for a major arc.
  const bool d1 = (l1 / s1.radius() > units::kPi) ? !s1.counterClockwise : s1.counterClockwise;
  const bool d2 = (l2 / s2.radius() > units::kPi) ? !s2.counterClockwise : s2.counterClockwise;
  bool sum = false;
  if (d1 == d2)
    sum = (l1 >= h1 && l2 >= h2) || (l1 <= h1 && l2 <= h2);
  else
    sum = (l1 <= h1 || l2 <= h2) && (l1 > h1 || l2 > h2);
  area = sum ? a1 + a2 : std::fabs(a1 - a2);
  return eAreaCalcOk;
}

// Whether the vertices' extent fits in the arc's circle: a quick necessary test before boIsPolygonInArc.
bool extentFitsCircle(const C2dMinMax& extent, const AreaSegment& arc) {
  const double r = arc.radius() + tol::kAreaPoint;
  return extent.minNorth >= arc.center.north - r && extent.maxNorth <= arc.center.north + r &&
         extent.minEast >= arc.center.east - r && extent.maxEast <= arc.center.east + r;
}

}  // namespace

EAreaCalcStatus eComputePolygonVertexArea(const svy_list<AreaSegment>& list, double& area, bool signedArea) {
  area = 0.0;
  if (list.size() < 3) return eAreaCalcTooFewSegments;
  // (Ep - E)(N + Np) summed over the vertices, relative to the first start so that survey coordinates keep
  // their digits; positive for a counter-clockwise boundary.
  const C2dPos origin = list.front().start.pos();
  const TCoords& last = list.back().start;
  double prevNorth = last.north - origin.north();
  double prevEast = last.east - origin.east();
  double sum = 0.0;
  for (const AreaSegment& s : list) {
    const double north = s.start.north - origin.north();
    const double east = s.start.east - origin.east();
    sum += (prevEast - east) * (north + prevNorth);
    prevNorth = north;
    prevEast = east;
  }
  area = 0.5 * sum;
  if (!signedArea) area = std::fabs(area);
  return eAreaCalcOk;
}

EAreaCalcStatus eComputePolygonArea(svy_list<AreaSegment>& list, double* area) {
  if (list.size() == 1) {
    const AreaSegment& s = list.front();
    if (!(std::fabs(s.length - units::kTwoPi * s.radius()) < tol::kAreaFullCircle)) return eAreaCalcNotACircle;
    *area = units::kPi * s.radius() * s.radius();
    return eAreaCalcOk;
  }
  if (list.size() == 2) {
    double twoArea = 0.0;
    const EAreaCalcStatus status = twoSegmentArea(list.front(), list.back(), twoArea);
    if (status == eAreaCalcOk) *area = twoArea;
    return status;
  }
  double signedVertexArea = 0.0;
  const EAreaCalcStatus vertexStatus = eComputePolygonVertexArea(list, signedVertexArea, true);
  if (vertexStatus != eAreaCalcOk) return vertexStatus;
  const double vertexArea = std::fabs(signedVertexArea);
  *area = vertexArea;
  if (!(std::fabs(vertexArea) >= tol::kZero)) return eAreaCalcZeroArea;

  C2dMinMax extent;
  for (const AreaSegment& s : list) extent.include(s.start.pos());
  bool rimFound = false;
  double rimSegment = 0.0;
  for (AreaSegment& s : list) {
    if (!s.boIsArc() || !extentFitsCircle(extent, s) || !boIsPolygonInArc(list, s)) continue;
    if (!chordSegmentArea(s, rimSegment)) return eAreaCalcGeometryFailed;
    if (nearZero(rimSegment)) log(kLogLineRimSegmentZero);
    // The rim is taken as its chord from here on: the change stays in the caller's list.
    s.type = AreaSegment::kLine;
    if (!boComputeAzimuthBetweenCoords(s.start, s.end, s.radiusOrAzimuth)) return eAreaCalcGeometryFailed;
    rimFound = true;
    break;
  }
  double segments = 0.0;
  for (const AreaSegment& s : list) {
    if (!s.boIsArc()) continue;
    double c = 0.0;
    if (!chordSegmentArea(s, c)) return eAreaCalcGeometryFailed;
    if (nearZero(c)) log(kLogLineSegmentZero);
    segments += svy_math::detail::arcBulgesInto(s, signedVertexArea) ? -c : c;
  }
  double result = vertexArea + segments;
  if (rimFound) result = rimSegment - result;
  if (nearZero(result)) log(kLogLineAreaZero);
  if (result <= 0.0) log(kLogLineAreaNotPositive);
  *area = result;
  return eAreaCalcOk;
}

bool boComputePolygonPerimeter(const svy_list<AreaSegment>& list, double& perimeter) {
  double sum = 0.0;
  for (const AreaSegment& s : list) sum += s.length;
  if (!std::isfinite(sum)) return false;
  perimeter = sum;
  return true;
}
