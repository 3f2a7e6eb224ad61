#include "svymath/area/area_segment.h"

#include <cmath>

#include "svymath/area/area_support.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace {

// Lines of the constructor failures in the log, as earlier releases wrote them.
constexpr int kLogLineAzimuth = 109;
constexpr int kLogLineLineLength = 111;
constexpr int kLogLineCentreRadius = 123;
constexpr int kLogLineCentreLength = 125;
constexpr int kLogLineRadiusCentre = 137;
constexpr int kLogLineRadiusLength = 139;
constexpr int kLogLineAngleChord = 152;
constexpr int kLogLineAngleCentre = 159;

void logIf(bool failed, int line) {
  if (failed) svy_logging::svy_err_log(kAreaMathLogSource, line, "");
}

}  // namespace

AreaSegment::AreaSegment(const TCoords& startCoords, const TCoords& endCoords)
    : start(startCoords), end(endCoords), type(kLine) {
  logIf(!boComputeAzimuthBetweenCoords(start, end, radiusOrAzimuth), kLogLineAzimuth);
  logIf(!boCompute2DDistanceBetweenCoords(start, end, length), kLogLineLineLength);
}

AreaSegment::AreaSegment(const TCoords& startCoords, const TCoords& endCoords, const TCoords& centerCoords,
                         bool ccw)
    : start(startCoords), end(endCoords), type(kArc), counterClockwise(ccw), center(centerCoords) {
  logIf(!boCompute2DDistanceBetweenCoords(start, center, radiusOrAzimuth), kLogLineCentreRadius);
  logIf(!boGetArcLength(start, end, center, counterClockwise, length), kLogLineCentreLength);
}

AreaSegment::AreaSegment(const TCoords& startCoords, const TCoords& endCoords, double radius, bool ccw)
    : start(startCoords), end(endCoords), type(kArc), radiusOrAzimuth(radius), counterClockwise(ccw) {
  logIf(!boComputeCenterPointCoords(start, end, radius, counterClockwise, center), kLogLineRadiusCentre);
  logIf(!boGetArcLength(start, end, center, counterClockwise, length), kLogLineRadiusLength);
}

AreaSegment::AreaSegment(double centralAngle, const TCoords& startCoords, const TCoords& endCoords, bool ccw)
    : start(startCoords), end(endCoords), type(kArc), counterClockwise(ccw) {
  double chord = 0.0;
  logIf(!boCompute2DDistanceBetweenCoords(start, end, chord), kLogLineAngleChord);
  radiusOrAzimuth = chord / (2.0 * std::sin(centralAngle / 2.0));
  length = radiusOrAzimuth * centralAngle;
  // A major arc has its centre on the other side of the chord than the minor arc of the same direction.
  const bool centreSide = centralAngle <= svy_math::units::kPi ? ccw : !ccw;
  logIf(!boComputeCenterPointCoords(start, end, radiusOrAzimuth, centreSide, center), kLogLineAngleCentre);
}

bool boAreSameAreaVertex(const TCoords& a, const TCoords& b) {
  const unsigned shared = ~(a.mask ^ b.mask);
  if ((shared & TCoords::kNorthValid) && !(std::fabs(a.north - b.north) <= svy_math::tol::kAreaSameVertex))
    return false;
  return !((shared & TCoords::kEastValid) && !(std::fabs(a.east - b.east) <= svy_math::tol::kAreaSameVertex));
}

bool getAreaSegmentListFromPointVector(svy_vector<C2dPos> points, svy_list<AreaSegment>& list) {
  if (points.size() < 2) return true;
  const auto coords = [](const C2dPos& p) {
    TCoords c;
    c.north = p.north();
    c.east = p.east();
    return c;
  };
  for (std::size_t i = 1; i < points.size(); ++i) list.emplace_back(coords(points[i - 1]), coords(points[i]));
  const TCoords first = coords(points.front());
  const TCoords last = coords(points.back());
  if (!boAreSameAreaVertex(last, first)) list.emplace_back(last, first);
  return true;
}

bool boDoesPolygonContainAnArc(const svy_list<AreaSegment>& list) {
  for (const AreaSegment& segment : list)
    if (segment.boIsArc()) return true;
  return false;
}
