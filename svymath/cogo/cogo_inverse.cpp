#include "svymath/cogo/cogo_inverse.h"

#include <cmath>
#include <cstddef>

#include "svymath/cogo/line_frame.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

namespace CogoFunctions {

namespace {

using svy_math::tol::kZero;

// The inverse of p to the segment from the frame's origin over its length.
void inverseToFrame(const svy_math::detail::TLineFrame& segment, const C2dPos& p, TElementInverse& out) {
  out.along = segment.alongOf(p);
  out.offset = segment.offsetOf(p);
  out.foot = segment.at(out.along, 0.0);
  out.position = out.along < 0.0 ? eFootBeforeStart : (out.along > segment.length ? eFootAfterEnd : eFootOnElement);
  const double clamped = out.position == eFootBeforeStart ? 0.0 : segment.length;
  out.nearest = out.position == eFootOnElement ? out.foot : segment.at(clamped, 0.0);
  out.distance = std::hypot(p.north() - out.nearest.north(), p.east() - out.nearest.east());
  out.segment = 0;
}

}  // namespace

ECogoMathErrorCode eInverseToSegment(const C2dPos& start, const C2dPos& end, const C2dPos& point,
                                     TElementInverse& result) {
  if (!start.isFinite() || !end.isFinite() || !point.isFinite()) return eCogoInvalidInput;
  svy_math::detail::TLineFrame segment;
  if (!segment.set(start, end)) return eCogoCoincidentPoints;
  inverseToFrame(segment, point, result);
  return eCogoOk;
}

ECogoMathErrorCode eInverseToArc(const CArc& arc, const C2dPos& point, TElementInverse& result) {
  if (!arc.center.isFinite() || !arc.start.isFinite() || !point.isFinite() || !arc.isok()) return eCogoInvalidInput;
  const double radius = arc.getRadius();
  const double relN = point.north() - arc.center.north();
  const double relE = point.east() - arc.center.east();
  const double r = std::hypot(relN, relE);
  if (!(r >= kZero)) return eCogoCoincidentPoints;

  // The angle turned from the start to the foot in the arc's direction of travel, in [0, 2 pi).
  const double startAz = std::atan2(arc.start.east() - arc.center.east(), arc.start.north() - arc.center.north());
  const double footAz = std::atan2(relE, relN);
  const double turned = Normalize0ToLt2Pi(arc.clockwise ? footAz - startAz : startAz - footAz);
  const double sweep = std::fabs(arc.getSweep());

  TElementInverse out;
  out.foot = C2dPos(arc.center.north() + relN * (radius / r), arc.center.east() + relE * (radius / r));
  // The centre lies right of a clockwise arc: a point inside the circle is offset to the right.
  out.offset = arc.clockwise ? radius - r : r - radius;
  out.nearest = out.foot;
  out.along = radius * turned;
  if (!arc.fullCircle && turned > sweep) {
    // Beyond the ends: on a circle the nearer end by angle is the nearer by distance.
    const double pastEnd = turned - sweep;
    const double beforeStart = svy_math::units::kTwoPi - turned;
    if (pastEnd <= beforeStart) {
      out.position = eFootAfterEnd;
      arc.get_end_pos(out.nearest);
    } else {
      out.position = eFootBeforeStart;
      out.along = -radius * beforeStart;
      out.nearest = arc.start;
    }
  }
  out.distance = std::hypot(point.north() - out.nearest.north(), point.east() - out.nearest.east());
  result = out;
  return eCogoOk;
}

ECogoMathErrorCode eInverseToPolyline(const svy_vector<C2dPos>& vertices, bool closed, const C2dPos& point,
                                      TElementInverse& result) {
  const std::size_t count = vertices.size();
  if (count < 2 || !point.isFinite()) return eCogoInvalidInput;
  for (const C2dPos& v : vertices)
    if (!v.isFinite()) return eCogoInvalidInput;

  const std::size_t segments = closed ? count : count - 1;
  TElementInverse best;
  bool found = false;
  double lengthBefore = 0.0;
  // The last segment with a direction: only its foot may fall beyond the end of an open polyline.
  std::size_t last = segments - 1;
  for (svy_math::detail::TLineFrame probe; last > 0 && !probe.set(vertices[last], vertices[(last + 1) % count]);) --last;
  for (std::size_t i = 0; i < segments; ++i) {
    svy_math::detail::TLineFrame segment;
    if (!segment.set(vertices[i], vertices[(i + 1) % count])) continue;
    TElementInverse candidate;
    inverseToFrame(segment, point, candidate);
    if (!found || candidate.distance < best.distance) {
      const bool openStart = !closed && !found;
      const bool openEnd = !closed && i == last;
      if ((candidate.position == eFootBeforeStart && !openStart) || (candidate.position == eFootAfterEnd && !openEnd)) {
        // An interior vertex: the foot is the vertex itself, the offset its distance on the point's side.
        candidate.along = candidate.position == eFootBeforeStart ? 0.0 : segment.length;
        candidate.foot = candidate.nearest;
        candidate.offset = std::copysign(candidate.distance, candidate.offset);
        candidate.position = eFootOnElement;
      }
      candidate.along += lengthBefore;
      candidate.segment = static_cast<int>(i);
      best = candidate;
      found = true;
    }
    lengthBefore += segment.length;
  }
  if (!found) return eCogoCoincidentPoints;
  result = best;
  return eCogoOk;
}

ECogoMathErrorCode ePointAtAlongOffset(const C2dPos& start, const C2dPos& end, double along, double offset,
                                       C2dPos& point) {
  if (!start.isFinite() || !end.isFinite() || !std::isfinite(along) || !std::isfinite(offset)) return eCogoInvalidInput;
  svy_math::detail::TLineFrame segment;
  if (!segment.set(start, end)) return eCogoCoincidentPoints;
  const C2dPos result = segment.at(along, offset);
  if (!result.isFinite()) return eCogoInvalidInput;
  point = result;
  return eCogoOk;
}

}  // namespace CogoFunctions
