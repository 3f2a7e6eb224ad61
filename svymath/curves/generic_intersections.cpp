#include "svymath/curves/generic_intersections.h"

#include <algorithm>
#include <cmath>

#include "svymath/cogo/circle_solvers.h"
#include "svymath/curves/curve_arc.h"
#include "svymath/curves/generic_arc.h"
#include "svymath/curves/generic_line.h"
#include "svymath/curves/generic_spiral.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

namespace svy_math {
namespace detail {

namespace {

bool appendIf(bool accepted, const C2dPos& pos, svy_vector<C2dPos>& out) {
  if (accepted) out.push_back(pos);
  return accepted;
}

// Neighbouring approximating arcs share their end points, so a crossing at a shared point is found by both.
// Removes, from the points appended from index `first` on, each one closer than tol::kOffsetZero to an
// earlier one of them.
void removeRepeatedCrossings(svy_vector<C2dPos>& out, std::size_t first) {
  std::size_t kept = first;
  for (std::size_t i = first; i < out.size(); ++i) {
    bool repeated = false;
    for (std::size_t j = first; j < kept && !repeated; ++j) {
      repeated = std::hypot(out[i].north() - out[j].north(), out[i].east() - out[j].east()) < tol::kOffsetZero;
    }
    if (!repeated) out[kept++] = out[i];
  }
  out.resize(kept);
}

}  // namespace

bool intersectRays(const C2dPos& p0, const CMathAngle& a0, const C2dPos& p1, const CMathAngle& a1, C2dPos& out) {
  if (a0.isNan() || a1.isNan()) return false;
  const double cross = a0.getCos() * a1.getSin() - a0.getSin() * a1.getCos();
  if (std::fabs(cross) < tol::kZero) return false;
  const double dN = p1.north() - p0.north();
  const double dE = p1.east() - p0.east();
  const double along = (dN * a1.getSin() - dE * a1.getCos()) / cross;
  if (!std::isfinite(along)) return false;
  out = C2dPos(p0.north() + along * a0.getCos(), p0.east() + along * a0.getSin());
  return true;
}

bool intersectLines(const CGenericLine& a, const CGenericLine& b, svy_vector<C2dPos>& out) {
  C2dPos pos;
  if (a.isLineWithSameEasting()) {
    return appendIf(b.calcVerticalIntersection(a.getStartEasting(), pos) && a.checkNorthIsOnLine(pos.north()),
                    pos, out);
  }
  if (a.isLineWithSameNorthing()) {
    return appendIf(b.calcHorizontalIntersection(a.getStartNorthing(), pos) && a.checkEastIsOnLine(pos.east()),
                    pos, out);
  }
  if (b.isLineWithSameEasting()) {
    return appendIf(a.calcVerticalIntersection(b.getStartEasting(), pos) && b.checkNorthIsOnLine(pos.north()),
                    pos, out);
  }
  if (b.isLineWithSameNorthing()) {
    return appendIf(a.calcHorizontalIntersection(b.getStartNorthing(), pos) && b.checkEastIsOnLine(pos.east()),
                    pos, out);
  }
  CMathAngle azimuthA;
  CMathAngle azimuthB;
  if (!a.getStartAzimut(azimuthA) || !b.getStartAzimut(azimuthB)) return false;
  return appendIf(intersectRays(a.getStartPos(), azimuthA, b.getStartPos(), azimuthB, pos) &&
                      a.checkValidIntersectionPoint(pos) && b.checkValidIntersectionPoint(pos),
                  pos, out);
}

bool intersectLineArc(const CGenericLine& line, const CGenericArc& arc, svy_vector<C2dPos>& out) {
  C2dPos centre;
  CMathAngle azimuth;
  if (!arc.getArcCenterPos(centre) || !line.getStartAzimut(azimuth) || azimuth.isNan()) return false;
  const double radius = std::fabs(arc.getRadius());
  // The second point of the line is taken about as far away as the circle, so that the line's direction
  // keeps its digits at survey coordinates.
  const C2dPos start = line.getStartPos();
  const double baseline =
      std::max(1.0, std::hypot(centre.north() - start.north(), centre.east() - start.east()) + radius);
  C2dPos through;
  azimuth.getPosAlong(baseline, start, through);
  C2dPos solutions[2];
  const int count = IntersectionCoordsOfLineAndCircle(start, through, centre, radius, solutions[0], solutions[1]);
  bool found = false;
  for (int i = 0; i < count; ++i) {
    const C2dPos& pos = solutions[i];
    found = appendIf(line.checkValidIntersectionPoint(pos) && arc.checkValidIntersectionPoint(pos), pos, out) ||
            found;
  }
  return found;
}

bool intersectArcs(const CGenericArc& a, const CGenericArc& b, svy_vector<C2dPos>& out) {
  C2dPos centreA;
  C2dPos centreB;
  if (!a.getArcCenterPos(centreA) || !b.getArcCenterPos(centreB)) return false;
  C2dPos solutions[2];
  const int count = IntersectionCoordsOfTwoCircles(centreA, std::fabs(a.getRadius()), centreB,
                                                   std::fabs(b.getRadius()), solutions[0], solutions[1]);
  bool found = false;
  for (int i = 0; i < count; ++i) {
    const C2dPos& pos = solutions[i];
    found = appendIf(a.checkValidIntersectionPoint(pos) && b.checkValidIntersectionPoint(pos), pos, out) || found;
  }
  return found;
}

bool intersectSpiralWith(const CGenericSpiral& spiral, const CGenericSegment& other, svy_vector<C2dPos>& out) {
  svy_vector<CCurveArc> arcs;
  if (!spiral.createCache(arcs)) return false;
  const std::size_t first = out.size();
  for (const CCurveArc& arc : arcs) arc.calcIntersections(other, out);
  removeRepeatedCrossings(out, first);
  return out.size() > first;
}

bool intersectSpirals(const CGenericSpiral& a, const CGenericSpiral& b, svy_vector<C2dPos>& out) {
  svy_vector<CCurveArc> arcsA;
  svy_vector<CCurveArc> arcsB;
  if (!a.createCache(arcsA) || !b.createCache(arcsB)) return false;
  const std::size_t first = out.size();
  for (const CCurveArc& arcA : arcsA) {
    for (const CCurveArc& arcB : arcsB) intersectArcs(arcA, arcB, out);
  }
  removeRepeatedCrossings(out, first);
  return out.size() > first;
}

}  // namespace detail
}  // namespace svy_math
