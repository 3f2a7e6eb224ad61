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
  bool found = false;
  for (const CCurveArc& arc : arcs) found = arc.calcIntersections(other, out) || found;
  return found;
}

bool intersectSpirals(const CGenericSpiral& a, const CGenericSpiral& b, svy_vector<C2dPos>& out) {
  svy_vector<CCurveArc> arcsA;
  svy_vector<CCurveArc> arcsB;
  if (!a.createCache(arcsA) || !b.createCache(arcsB)) return false;
  bool found = false;
  for (const CCurveArc& arcA : arcsA) {
    for (const CCurveArc& arcB : arcsB) found = intersectArcs(arcA, arcB, out) || found;
  }
  return found;
}

}  // namespace detail
}  // namespace svy_math
