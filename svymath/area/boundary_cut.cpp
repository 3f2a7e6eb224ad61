#include "svymath/area/boundary_cut.h"

#include <algorithm>
#include <cmath>
#include <vector>

#include "svymath/area/area_geometry.h"
#include "svymath/area/area_support.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/constants.h"

namespace tol = svy_math::tol;
namespace units = svy_math::units;
using svy_math::detail::toCoords;

namespace {

// A direction frame: unit vectors along an azimuth and to its right, in (north, east).
struct TFrame {
  explicit TFrame(double azimuth)
      : alongN(std::cos(azimuth)), alongE(std::sin(azimuth)), acrossN(-std::sin(azimuth)), acrossE(std::cos(azimuth)) {}
  double along(const TCoords& p, const TCoords& o) const {
    return (p.north - o.north) * alongN + (p.east - o.east) * alongE;
  }
  double across(const TCoords& p, const TCoords& o) const {
    return (p.north - o.north) * acrossN + (p.east - o.east) * acrossE;
  }
  TCoords at(const TCoords& o, double a, double c) const {
    TCoords p = o;
    p.north = o.north + a * alongN + c * acrossN;
    p.east = o.east + a * alongE + c * acrossE;
    return p;
  }
  double alongN, alongE, acrossN, acrossE;
};

// Calls f for each point of the segment that can be extreme in the frame: its start and, for an arc, the
// points of its circle at the centre plus and minus the radius along each axis of the frame that lie on it.
template <class F>
void forEachExtremePoint(const AreaSegment& s, const TFrame& frame, F f) {
  f(s.start);
  if (!s.boIsArc()) return;
  const double r = s.radius();
  for (const double a : {r, -r}) {
    for (const TCoords& p : {frame.at(s.center, a, 0.0), frame.at(s.center, 0.0, a)})
      if (boIsPointOnArc(p, s)) f(p);
  }
}

double distance(const TCoords& a, const TCoords& b) { return std::hypot(a.north - b.north, a.east - b.east); }

// Distance from a point to a segment (the nearer end when its foot is off the segment).
double distanceToSegment(const TCoords& p, const AreaSegment& s) {
  if (s.boIsLine()) {
    const C2dSegment local(C2dPos(0.0, 0.0), C2dPos(s.end.north - s.start.north, s.end.east - s.start.east));
    return local.getDistance(C2dPos(p.north - s.start.north, p.east - s.start.east));
  }
  const double fromCentre = distance(p, s.center);
  double angle = 0.0;
  double sweep = 0.0;
  if (fromCentre > 0.0 && boGetAngleOnArc(s, p, angle) && boGetArcSweep(s, sweep) && angle <= sweep)
    return std::fabs(fromCentre - s.radius());
  return std::min(distance(p, s.start), distance(p, s.end));
}

// The point of the segment nearest p (assumed near it).
TCoords footOnSegment(const TCoords& p, const AreaSegment& s) {
  if (s.boIsArc()) {
    const double fromCentre = distance(p, s.center);
    if (!(fromCentre > 0.0)) return s.start;
    const double k = s.radius() / fromCentre;
    TCoords foot = p;
    foot.north = s.center.north + (p.north - s.center.north) * k;
    foot.east = s.center.east + (p.east - s.center.east) * k;
    return foot;
  }
  const double dn = s.end.north - s.start.north;
  const double de = s.end.east - s.start.east;
  const double lengthSq = dn * dn + de * de;
  if (!(lengthSq > 0.0)) return s.start;
  const double t = std::clamp(((p.north - s.start.north) * dn + (p.east - s.start.east) * de) / lengthSq, 0.0, 1.0);
  TCoords foot = p;
  foot.north = s.start.north + t * dn;
  foot.east = s.start.east + t * de;
  return foot;
}

// Appends the segment unless it is shorter than the point tolerance (a cut through a vertex).
void appendPart(svy_list<AreaSegment>& list, const AreaSegment& s) {
  if (distance(s.start, s.end) > tol::kAreaPoint || (s.boIsArc() && s.length > tol::kAreaPoint)) list.push_back(s);
}

// The crossings of a segment's interior with the line (distance function d), in the segment's order.
void interiorCrossings(const AreaSegment& s, const TFrame& frame, const TCoords& linePoint,
                       std::vector<TCoords>& crossings) {
  crossings.clear();
  const double d0 = frame.across(s.start, linePoint);
  const double d1 = frame.across(s.end, linePoint);
  if (s.boIsLine()) {
    if (std::fabs(d0) > tol::kAreaPoint && std::fabs(d1) > tol::kAreaPoint && (d0 > 0.0) != (d1 > 0.0)) {
      const double t = d0 / (d0 - d1);
      TCoords x = s.start;
      x.north += t * (s.end.north - s.start.north);
      x.east += t * (s.end.east - s.start.east);
      crossings.push_back(x);
    }
    return;
  }
  // The circle meets the line where the centre's distance from it is taken up by the radius.
  const double dc = frame.across(s.center, linePoint);
  const double r = s.radius();
  if (std::fabs(dc) >= r) return;
  const double half = std::sqrt((r - dc) * (r + dc));
  const double a = frame.along(s.center, linePoint);
  double sweep = 0.0;
  if (!boGetArcSweep(s, sweep)) return;
  const double slack = tol::kAreaPoint / r;
  std::vector<std::pair<double, TCoords>> found;
  for (const double offset : {-half, half}) {
    const TCoords x = frame.at(linePoint, a + offset, 0.0);
    double angle = 0.0;
    if (boGetAngleOnArc(s, x, angle) && angle > slack && angle < sweep - slack) found.emplace_back(angle, x);
  }
  std::sort(found.begin(), found.end(), [](const auto& l, const auto& rr) { return l.first < rr.first; });
  for (const auto& f : found) crossings.push_back(f.second);
}

}  // namespace

bool boComputePointCoordsFromArea(TCoords* result, const TCoords& p1, const TCoords& p2, const double& azimuth,
                                  const double& area) {
  double a12 = 0.0;
  double d12 = 0.0;
  if (!boComputeAzimuthBetweenCoords(p1, p2, a12) || !boCompute2DDistanceBetweenCoords(p1, p2, d12)) return false;
  const double base = std::fabs(std::sin(a12 - azimuth)) * d12;
  const double along = 2.0 * area / base;
  if (!(base > tol::kZero) || !std::isfinite(along)) return false;
  double east = 0.0;
  double north = 0.0;
  if (!Radiate2D(p1.east, p1.north, azimuth, along, east, north)) return false;
  *result = p1;
  result->north = north;
  result->east = east;
  return true;
}

bool boGetPolygonMaxMin(TCoords* max, TCoords* min, const svy_list<AreaSegment>& boundary, const double& azimuth) {
  if (boundary.empty() || !std::isfinite(azimuth)) return false;
  const TFrame frame(azimuth);
  const TCoords& origin = boundary.front().start;
  double minAlong = tol::kExtentStartMin;
  double minAcross = tol::kExtentStartMin;
  double maxAlong = tol::kExtentStartMax;
  double maxAcross = tol::kExtentStartMax;
  bool finite = true;
  for (const AreaSegment& s : boundary) {
    forEachExtremePoint(s, frame, [&](const TCoords& p) {
      const double a = frame.along(p, origin);
      const double c = frame.across(p, origin);
      finite = finite && std::isfinite(a) && std::isfinite(c);
      minAlong = std::min(minAlong, a);
      maxAlong = std::max(maxAlong, a);
      minAcross = std::min(minAcross, c);
      maxAcross = std::max(maxAcross, c);
    });
  }
  if (!finite) return false;
  *min = frame.at(origin, minAlong, minAcross);
  *max = frame.at(origin, maxAlong, maxAcross);
  return true;
}

bool boComputeDistanceFromCoordToLine(const TCoords& point, const TCoords& linePoint, const double& azimuth,
                                      double& distanceOut) {
  const double d = TFrame(azimuth).across(point, linePoint);
  if (!std::isfinite(d)) return false;
  distanceOut = d;
  return true;
}

bool boIsPolygonLeftOfLine(const svy_list<AreaSegment>& boundary, const TCoords& point, const double& azimuth) {
  const TFrame frame(azimuth);
  double farthest = 0.0;
  const auto consider = [&](const TCoords& p) {
    const double d = frame.across(p, point);
    if (std::fabs(d) > std::fabs(farthest)) farthest = d;
  };
  for (const AreaSegment& s : boundary) {
    consider(s.start);
    double sweep = 0.0;
    if (s.boIsArc() && boGetArcSweep(s, sweep)) consider(getPointOnArc(s, 0.5 * sweep));
  }
  return farthest < 0.0;
}

AreaSegment getReversedAreaSegment(const AreaSegment& s) {
  return s.boIsArc() ? AreaSegment(s.end, s.start, s.center, !s.counterClockwise) : AreaSegment(s.end, s.start);
}

void splitAreaSegment(const AreaSegment& s, const TCoords& at, AreaSegment& before, AreaSegment& after) {
  if (s.boIsArc()) {
    before = AreaSegment(s.start, at, s.center, s.counterClockwise);
    after = AreaSegment(at, s.end, s.center, s.counterClockwise);
  } else {
    before = AreaSegment(s.start, at);
    after = AreaSegment(at, s.end);
  }
}

bool boReorderSegmentList(const svy_list<AreaSegment>& boundary, const TCoords& start, bool reverse,
                          svy_list<AreaSegment>* ordered) {
  std::vector<AreaSegment> segments;
  segments.reserve(boundary.size());
  if (reverse) {
    for (auto it = boundary.rbegin(); it != boundary.rend(); ++it) segments.push_back(getReversedAreaSegment(*it));
  } else {
    for (const AreaSegment& s : boundary) segments.push_back(s);
  }
  const std::size_t n = segments.size();
  for (std::size_t k = 0; k < n; ++k) {
    const AreaSegment& s = segments[k];
    if (!(distanceToSegment(start, s) <= tol::kHingeOnBoundary)) continue;
    svy_list<AreaSegment> result;
    std::size_t first = k;
    AreaSegment tail;
    bool split = false;
    if (distance(start, s.end) <= tol::kHingeOnBoundary) {
      first = (k + 1) % n;
    } else if (distance(start, s.start) > tol::kHingeOnBoundary) {
      AreaSegment head;
      splitAreaSegment(s, footOnSegment(start, s), head, tail);
      result.push_back(tail);
      tail = head;
      first = (k + 1) % n;
      split = true;
    }
    for (std::size_t m = 0; m < n; ++m) {
      const std::size_t i = (first + m) % n;
      if (split && i == k) break;
      result.push_back(segments[i]);
    }
    if (split) result.push_back(tail);
    *ordered = std::move(result);
    return true;
  }
  return false;
}

bool boGetSubdividedSegmentList(const svy_list<AreaSegment>& boundary, const TCoords& point, const double& azimuth,
                                svy_list<AreaSegment>* first, svy_list<AreaSegment>* second, TCoords* cutStart,
                                TCoords* cutEnd) {
  if (boundary.empty() || !point.hasFinitePlanPosition() || !std::isfinite(azimuth)) return false;
  const TFrame frame(azimuth);
  // The boundary split at every crossing of a segment's interior, each part with the side of the line its
  // middle lies on (+1 right, -1 left, 0 along the line).
  std::vector<AreaSegment> parts;
  std::vector<int> sides;
  std::vector<TCoords> crossings;
  for (const AreaSegment& s : boundary) {
    interiorCrossings(s, frame, point, crossings);
    AreaSegment rest = s;
    for (const TCoords& x : crossings) {
      AreaSegment before;
      splitAreaSegment(rest, x, before, rest);
      parts.push_back(before);
    }
    parts.push_back(rest);
  }
  for (const AreaSegment& p : parts) {
    double sweep = 0.0;
    TCoords middle = toCoords(C2dPos(0.5 * (p.start.north + p.end.north), 0.5 * (p.start.east + p.end.east)), p.start);
    if (p.boIsArc() && boGetArcSweep(p, sweep)) middle = getPointOnArc(p, 0.5 * sweep);
    const double d = frame.across(middle, point);
    sides.push_back(d > tol::kAreaPoint ? 1 : (d < -tol::kAreaPoint ? -1 : 0));
  }
  // Parts along the line take the side of the part before them.
  const std::size_t n = parts.size();
  const auto firstSided = std::find_if(sides.begin(), sides.end(), [](int s) { return s != 0; });
  if (firstSided == sides.end()) return false;
  int current = *firstSided;
  for (std::size_t m = 0; m < n; ++m) {
    const std::size_t i = (static_cast<std::size_t>(firstSided - sides.begin()) + m) % n;
    if (sides[i] == 0) sides[i] = current;
    current = sides[i];
  }
  std::vector<std::size_t> changes;
  for (std::size_t i = 0; i < n; ++i)
    if (sides[i] != sides[(i + n - 1) % n]) changes.push_back(i);
  if (changes.size() != 2) return false;
  svy_list<AreaSegment> a;
  svy_list<AreaSegment> b;
  for (std::size_t i = changes[0]; i < changes[1]; ++i) appendPart(a, parts[i]);
  for (std::size_t m = 0; m < n - (changes[1] - changes[0]); ++m) appendPart(b, parts[(changes[1] + m) % n]);
  const TCoords x0 = parts[changes[0]].start;
  const TCoords x1 = parts[changes[1]].start;
  a.emplace_back(x1, x0);
  b.emplace_back(x0, x1);
  const bool inOrder = frame.along(x0, point) <= frame.along(x1, point);
  *cutStart = inOrder ? x0 : x1;
  *cutEnd = inOrder ? x1 : x0;
  *first = std::move(a);
  *second = std::move(b);
  return true;
}
