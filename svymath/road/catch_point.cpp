#include "svymath/road/catch_point.h"

#include <cmath>

#include "svymath/foundation/constants.h"

namespace {

using svy_math::tol::kZero;

bool groundIsUsable(const TXsGroundPoint* ground, int count) {
  if (ground == nullptr || count < 2) return false;
  for (int i = 0; i < count; ++i) {
    if (!std::isfinite(ground[i].offset) || !std::isfinite(ground[i].elevation)) return false;
    if (i > 0 && ground[i].offset < ground[i - 1].offset) return false;
  }
  return true;
}

// The ground segment (i, i + 1) holding an offset: the first one whose end is at or beyond it; the
// outermost segment beyond the ground's ends when the ground is extended, else -1.
int segmentHolding(const TXsGroundPoint* ground, int count, double offset, bool extendGround) {
  if (offset < ground[0].offset || offset > ground[count - 1].offset) {
    if (!extendGround) return -1;
    return offset < ground[0].offset ? 0 : count - 2;
  }
  int i = 0;
  while (i < count - 2 && ground[i + 1].offset < offset) ++i;
  return i;
}

// The ground elevation on segment i at an offset (continued beyond its ends); the elevation of the higher
// end for a vertical segment.
double groundOn(const TXsGroundPoint* ground, int i, double offset) {
  const TXsGroundPoint& a = ground[i];
  const TXsGroundPoint& b = ground[i + 1];
  const double run = b.offset - a.offset;
  if (-kZero < run && run < kZero) return std::fmax(a.elevation, b.elevation);
  return a.elevation + (offset - a.offset) / run * (b.elevation - a.elevation);
}

}  // namespace

bool ComputeXYOffsetsForCutFillSlope(const CRoadCrossSectionSlope& slope, double runRise, double run, double& offset,
                                     double& elevation) {
  double hingeOffset = 0.0;
  double hingeElevation = 0.0;
  if (!slope.getHingePoint(hingeOffset, hingeElevation) || !std::isfinite(runRise) || !std::isfinite(run) ||
      run < 0.0) {
    return false;
  }
  const double riseRun = (-kZero < runRise && runRise < kZero) ? 0.0 : 1.0 / runRise;
  offset = slope.isRightSide() ? hingeOffset + run : hingeOffset - run;
  elevation = hingeElevation + run * riseRun;
  return true;
}

ECatchPointStatus ComputeCatchPoint(const CRoadCrossSectionSlope& slope, const TXsGroundPoint* ground, int count,
                                    bool extendGround, double& offset, double& elevation, double* runRise) {
  double hingeOffset = 0.0;
  double hingeElevation = 0.0;
  if (!slope.getHingePoint(hingeOffset, hingeElevation)) return eCatchPointNoHinge;
  if (!groundIsUsable(ground, count)) return eCatchPointNoGround;
  const int first = segmentHolding(ground, count, hingeOffset, extendGround);
  if (first < 0) return eCatchPointNoGround;

  // The slope the ground at the hinge calls for, as getHeightFromSlopeAuto chooses it.
  const double groundAtHinge = groundOn(ground, first, hingeOffset);
  double chosen = 0.0;
  if (slope.hasCut() && (!slope.hasFill() || hingeElevation <= groundAtHinge)) {
    chosen = slope.getCutSlopeRunRise();
  } else if (slope.hasFill() && (!slope.hasCut() || groundAtHinge < hingeElevation)) {
    chosen = slope.getFillSlopeRunRise();
  } else {
    return eCatchPointNoSlope;
  }
  const double riseRun = (-kZero < chosen && chosen < kZero) ? 0.0 : 1.0 / chosen;

  // Walk the ground points outward from the hinge in local offsets (distance outward from the hinge). The
  // gap (ground minus slope) is linear between them; the catch point is where it first reaches zero.
  const bool right = slope.isRightSide();
  const auto local = [&](const TXsGroundPoint& p) { return right ? p.offset - hingeOffset : hingeOffset - p.offset; };
  double localPrev = 0.0;
  double gapPrev = groundAtHinge - hingeElevation;
  double found = gapPrev == 0.0 ? 0.0 : svy_math::undefinedValue();
  for (int k = right ? first + 1 : first; std::isnan(found) && k >= 0 && k < count; k += right ? 1 : -1) {
    const double l = local(ground[k]);
    if (l < 0.0) continue;  // the hinge lies beyond an extended ground's end
    const double gap = ground[k].elevation - (hingeElevation + l * riseRun);
    if (gap == 0.0 || (gap > 0.0) != (gapPrev > 0.0)) found = localPrev + (l - localPrev) * gapPrev / (gapPrev - gap);
    localPrev = l;
    gapPrev = gap;
  }
  if (std::isnan(found) && extendGround) {
    // Beyond the outermost point the gap changes at the outermost segment's grade minus the slope's.
    const TXsGroundPoint& inner = right ? ground[count - 2] : ground[1];
    const TXsGroundPoint& outer = right ? ground[count - 1] : ground[0];
    const double run = local(outer) - local(inner);
    const double rate = run > kZero ? (outer.elevation - inner.elevation) / run - riseRun : 0.0;
    if (rate != 0.0 && (rate > 0.0) != (gapPrev > 0.0)) found = localPrev - gapPrev / rate;
  }
  if (std::isnan(found) || !ComputeXYOffsetsForCutFillSlope(slope, chosen, found, offset, elevation)) {
    return eCatchPointNotMet;
  }
  if (runRise != nullptr) *runRise = chosen;
  return eCatchPointFound;
}
