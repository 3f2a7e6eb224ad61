#include "svymath/area/subdivision.h"

#include <cmath>
#include <iterator>
#include <limits>
#include <vector>

#include "svymath/area/area_geometry.h"
#include "svymath/area/area_support.h"
#include "svymath/area/boundary_cut.h"
#include "svymath/area/polygon_area.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace tol = svy_math::tol;
namespace units = svy_math::units;
namespace limits = svy_math::limits;

namespace {

// Line of the log entry for a hinge that is not on the boundary.
constexpr int kLogLineHingeOff = 839;

// Area of a copy of the list (the area computation may change the list it is given).
EAreaCalcStatus areaOf(const svy_list<AreaSegment>& list, double& area) {
  svy_list<AreaSegment> copy = list;
  return eComputePolygonArea(copy, &area);
}

// Total area of the boundary into `total`: 27 when it cannot be had, 28 below the request, 29 for a request
// that is negative or not a number (no search can reach it), else 0.
EAreaCalcStatus checkTotal(svy_list<AreaSegment>& boundary, double requested, double& total) {
  if (eComputePolygonArea(boundary, &total) != eAreaCalcOk || !std::isfinite(total)) return eAreaCalcTotalAreaFailed;
  if (!(requested >= 0.0)) return eAreaCalcSearchFailed;
  return total < requested ? eAreaCalcAreaTooLarge : eAreaCalcOk;
}

// The bracket of the cut's distance to the right of the base line: the distances of the boundary's
// vertices and of its arcs' extreme points in the cut's frame.
bool cutDistanceBracket(const svy_list<AreaSegment>& boundary, const TCoords& base, double azimuth, double& smallest,
                        double& largest) {
  smallest = tol::kCutDistanceStart;
  largest = 0.0;
  const double alongN = std::cos(azimuth);
  const double alongE = std::sin(azimuth);
  for (const AreaSegment& s : boundary) {
    std::vector<TCoords> points{s.start};
    if (s.boIsArc()) {
      const double r = s.radius();
      for (const C2dPos& offset : {C2dPos(r * alongN, r * alongE), C2dPos(-r * alongE, r * alongN),
                                   C2dPos(-r * alongN, -r * alongE), C2dPos(r * alongE, -r * alongN)}) {
        TCoords p = s.center;
        p.north += offset.north();
        p.east += offset.east();
        if (boIsPointOnArc(p, s)) points.push_back(p);
      }
    }
    for (const TCoords& p : points) {
      double d = 0.0;
      if (!boComputeDistanceFromCoordToLine(p, base, azimuth, d)) return false;
      smallest = std::min(smallest, d);
      largest = std::max(largest, d);
    }
  }
  return true;
}

// The signed area of a piece from the hinge: the area terms of its segments about the hinge, with the sign
// of the whole boundary's orientation so that the pieces grow positive.
bool pieceTerm(const AreaSegment& s, const C2dPos& hinge, double orientation, double& term) {
  if (!svy_math::detail::signedAreaTerm(s, hinge, term)) return false;
  term *= orientation;
  return true;
}

// The answer of one trial of a search: its area, or that the value cannot be evaluated, or a failure.
enum class ETrial { kArea, kInvalid, kFailed };

// The bracketing search until a trial's area is within 1e-3 m^2 of the target (20), bisecting toward it.
// Gives 29 when the bracket fails, two trials stall (areas within 1e-4 m^2), a trial fails, or the
// probing levels run out. trial(value, area) evaluates a value of the bracket.
template <class Trial>
EAreaCalcStatus searchForArea(TSearch& search, double target, Trial trial) {
  double previous = std::numeric_limits<double>::quiet_NaN();
  while (search.nGetInvalidCount() < limits::kSearchProbeLevels) {
    if (search.boHasFailed()) return eAreaCalcSearchFailed;
    double area = 0.0;
    const ETrial answer = trial(search.dGetCurrent(), area);
    if (answer == ETrial::kFailed) return eAreaCalcSearchFailed;
    if (answer == ETrial::kInvalid) {
      search.vCurrentIsInvalid();
      continue;
    }
    if (std::fabs(area - target) <= tol::kSubdivisionArea) return eAreaCalcSubdivided;
    if (std::fabs(area - previous) < tol::kSubdivisionStall) return eAreaCalcSearchFailed;
    previous = area;
    if (area <= target)
      search.vCurrentIsToLow();
    else
      search.vCurrentIsToHigh();
  }
  return eAreaCalcSearchFailed;
}

// Bisection of the arc's turning angle until the piece reaches the target: the arc part from its start to
// the point after the angle tried.
EAreaCalcStatus cutArc(const AreaSegment& arc, const C2dPos& hinge, double orientation, double before,
                       double target, TCoords& cut) {
  double sweep = 0.0;
  if (!boGetArcSweep(arc, sweep)) return eAreaCalcSearchFailed;
  TSearch search(sweep, 0.0, false);
  return searchForArea(search, target, [&](double angle, double& area) {
    cut = getPointOnArc(arc, angle);
    AreaSegment part;
    AreaSegment unused;
    splitAreaSegment(arc, cut, part, unused);
    double term = 0.0;
    if (!pieceTerm(part, hinge, orientation, term)) return ETrial::kInvalid;
    area = before + term;
    return ETrial::kArea;
  });
}

double planDistance(const TCoords& a, const TCoords& b) { return std::hypot(a.north - b.north, a.east - b.east); }

// Whether `towards` lies nearer the last segment of the ordered boundary (entering the hinge) than the first.
bool towardsEntering(const svy_list<AreaSegment>& ordered, const TCoords& towards) {
  const unsigned plan = TCoords::kNorthValid | TCoords::kEastValid;
  if ((towards.mask & plan) != plan || ordered.size() < 2 || !towards.hasFinitePlanPosition()) return false;
  const auto nearest = [&](const AreaSegment& s) {
    double sweep = 0.0;
    TCoords middle = s.end;
    if (s.boIsArc() && boGetArcSweep(s, sweep)) middle = getPointOnArc(s, 0.5 * sweep);
    return std::min({planDistance(towards, s.end), planDistance(towards, middle), planDistance(towards, s.start)});
  };
  return nearest(ordered.back()) < nearest(ordered.front());
}

}  // namespace

EAreaCalcStatus eSubdivideSegmentList(const double& azimuth, const double& area, bool pieceOnLeft,
                                      svy_list<AreaSegment>& boundary, svy_list<AreaSegment>* piece,
                                      svy_list<AreaSegment>* rest, TCoords* cutStart, TCoords* cutEnd) {
  const svy_list<AreaSegment> given = boundary;
  double total = 0.0;
  const EAreaCalcStatus totalStatus = checkTotal(boundary, area, total);
  if (totalStatus != eAreaCalcOk) return totalStatus;
  const double target = pieceOnLeft ? area : total - area;

  TCoords max;
  TCoords base;
  double smallest = 0.0;
  double largest = 0.0;
  if (!boGetPolygonMaxMin(&max, &base, given, azimuth) ||
      !cutDistanceBracket(given, base, azimuth, smallest, largest))
    return eAreaCalcSearchFailed;

  TSearch search(largest, smallest, false);
  bool left = false;
  svy_list<AreaSegment> first;
  svy_list<AreaSegment> second;
  TCoords start;
  TCoords end;
  const EAreaCalcStatus status = searchForArea(search, target, [&](double distance, double& leftArea) {
    TCoords trial = base;
    if (!Radiate2D(base.east, base.north, azimuth + units::kHalfPi, distance, trial.east, trial.north))
      return ETrial::kFailed;
    if (!boGetSubdividedSegmentList(given, trial, azimuth, &first, &second, &start, &end)) return ETrial::kInvalid;
    left = boIsPolygonLeftOfLine(first, trial, azimuth);
    return areaOf(left ? first : second, leftArea) == eAreaCalcOk ? ETrial::kArea : ETrial::kFailed;
  });
  if (status != eAreaCalcSubdivided) return status;
  if (left != pieceOnLeft) std::swap(first, second);
  *piece = std::move(first);
  *rest = std::move(second);
  *cutStart = start;
  *cutEnd = end;
  return eAreaCalcSubdivided;
}

EAreaCalcStatus eSubdivideSegmentList(const TCoords& hinge, const TCoords& towards, const double& area,
                                      svy_list<AreaSegment>& boundary, svy_list<AreaSegment>* piece,
                                      svy_list<AreaSegment>* rest, TCoords* cutEnd) {
  svy_list<AreaSegment> ordered;
  if (!boReorderSegmentList(boundary, hinge, false, &ordered)) {
    svy_logging::svy_err_log(kAreaSubdivisionLogSource, kLogLineHingeOff, "");
    return eAreaCalcGeometryFailed;
  }
  if (towardsEntering(ordered, towards)) {
    svy_list<AreaSegment> reversed;
    if (!boReorderSegmentList(ordered, ordered.front().start, true, &reversed)) return eAreaCalcGeometryFailed;
    ordered = std::move(reversed);
  }
  double total = 0.0;
  const EAreaCalcStatus totalStatus = checkTotal(boundary, area, total);
  if (totalStatus != eAreaCalcOk) return totalStatus;
  double signedTotal = 0.0;
  if (!svy_math::detail::signedBoundaryArea(ordered, signedTotal) || signedTotal == 0.0)
    return eAreaCalcTotalAreaFailed;
  const double orientation = signedTotal > 0.0 ? 1.0 : -1.0;

  const TCoords h = ordered.front().start;
  const C2dPos origin = h.pos();
  double grown = 0.0;
  for (auto it = ordered.begin(); it != ordered.end(); ++it) {
    double term = 0.0;
    if (!pieceTerm(*it, origin, orientation, term)) return eAreaCalcSearchFailed;
    if (grown + term < area - tol::kSubdivisionArea && std::next(it) != ordered.end()) {
      grown += term;
      continue;
    }
    TCoords cut = it->end;
    if (std::fabs(grown + term - area) > tol::kSubdivisionArea) {
      if (it->boIsArc()) {
        const EAreaCalcStatus status = cutArc(*it, origin, orientation, grown, area, cut);
        if (status != eAreaCalcSubdivided) return status;
      } else if (!boComputePointCoordsFromArea(&cut, it->start, h, it->radiusOrAzimuth, area - grown)) {
        return eAreaCalcSearchFailed;
      }
    }
    AreaSegment before = *it;
    AreaSegment after;
    const bool atVertex = planDistance(cut, it->end) <= tol::kAreaPoint;
    if (!atVertex) splitAreaSegment(*it, cut, before, after);
    svy_list<AreaSegment> pieceList(ordered.begin(), it);
    pieceList.push_back(before);
    svy_list<AreaSegment> restList;
    if (!atVertex) restList.push_back(after);
    restList.insert(restList.end(), std::next(it), ordered.end());
    const bool whole = restList.empty();
    if (!whole) {
      pieceList.emplace_back(cut, h);
      restList.emplace_back(h, cut);
    }
    *piece = std::move(pieceList);
    *rest = std::move(restList);
    *cutEnd = whole ? h : cut;
    return eAreaCalcSubdivided;
  }
  return eAreaCalcSearchFailed;
}
