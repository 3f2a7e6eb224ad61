#include "svymath/adjustment/proportioning.h"

#include <cmath>
#include <cstddef>
#include <limits>
#include <utility>

#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace svy_math {

namespace {

// Line numbers of the log entries, one per kind of refused input.
constexpr int kLogBadTraverse = 48;
constexpr int kLogTraverseWithoutLength = 61;
constexpr int kLogBadMeasuredLine = 112;
constexpr int kLogMeasuredLineWithoutLength = 125;

bool refuse(int line) {
  svy_logging::svy_err_log(kProportioningLogSource, line, "");
  return false;
}

// The share of a misclosure that a point carries: its running sum over the total, or the fallback share
// when the total is zero.
double share(double runningSum, double total, double fallback) {
  return total >= tol::kZero ? runningSum / total : fallback;
}

}  // namespace

bool TProportioning::adjustTraverse(const C2dPos& start, const C2dPos& end, const svy_vector<TTraverseLeg>& legs,
                                    ETraverseRule rule, TTraverseAdjustment& result) {
  if (legs.empty() || !start.isFinite() || !end.isFinite()) return refuse(kLogBadTraverse);
  double totalLength = 0.0, totalAbsN = 0.0, totalAbsE = 0.0, sumN = 0.0, sumE = 0.0;
  for (const TTraverseLeg& leg : legs) {
    if (!std::isfinite(leg.azimuth) || !std::isfinite(leg.distance) || leg.distance < 0.0)
      return refuse(kLogBadTraverse);
    const double dN = leg.distance * std::cos(leg.azimuth), dE = leg.distance * std::sin(leg.azimuth);
    totalLength += leg.distance;
    totalAbsN += std::fabs(dN);
    totalAbsE += std::fabs(dE);
    sumN += dN;
    sumE += dE;
  }
  if (!(totalLength >= tol::kZero) || !std::isfinite(totalLength)) return refuse(kLogTraverseWithoutLength);

  TTraverseAdjustment out;
  // Measured minus known end, both relative to the start.
  out.misclosureNorth = sumN - (end.north() - start.north());
  out.misclosureEast = sumE - (end.east() - start.east());
  out.linearMisclosure = std::hypot(out.misclosureNorth, out.misclosureEast);
  out.totalLength = totalLength;
  out.precision = out.linearMisclosure > 0.0 ? totalLength / out.linearMisclosure
                                             : std::numeric_limits<double>::infinity();
  out.points.reserve(legs.size());
  out.corrections.reserve(legs.size());
  double runN = 0.0, runE = 0.0, runLength = 0.0, runAbsN = 0.0, runAbsE = 0.0;
  for (const TTraverseLeg& leg : legs) {
    const double dN = leg.distance * std::cos(leg.azimuth), dE = leg.distance * std::sin(leg.azimuth);
    runN += dN;
    runE += dE;
    runLength += leg.distance;
    runAbsN += std::fabs(dN);
    runAbsE += std::fabs(dE);
    const double lengthShare = runLength / totalLength;
    const double shareN = rule == eTransitRule ? share(runAbsN, totalAbsN, lengthShare) : lengthShare;
    const double shareE = rule == eTransitRule ? share(runAbsE, totalAbsE, lengthShare) : lengthShare;
    const C2dPos correction(-out.misclosureNorth * shareN, -out.misclosureEast * shareE);
    out.corrections.push_back(correction);
    out.points.push_back(C2dPos(start.north() + (runN + correction.north()), start.east() + (runE + correction.east())));
  }
  // The running shares end at exactly 1 up to rounding: the last point is the known end itself.
  out.points.back() = end;
  if (!std::isfinite(out.linearMisclosure)) return refuse(kLogBadTraverse);
  result = std::move(out);
  return true;
}

bool TProportioning::proportionLine(const C2dPos& knownStart, const C2dPos& knownEnd,
                                    const svy_vector<C2dPos>& measured, svy_vector<C2dPos>& adjusted) {
  if (measured.size() < 2 || !knownStart.isFinite() || !knownEnd.isFinite()) return refuse(kLogBadMeasuredLine);
  double total = 0.0;
  for (std::size_t i = 0; i < measured.size(); ++i) {
    if (!measured[i].isFinite()) return refuse(kLogBadMeasuredLine);
    if (i > 0)
      total += std::hypot(measured[i].north() - measured[i - 1].north(), measured[i].east() - measured[i - 1].east());
  }
  if (!(total >= tol::kZero) || !std::isfinite(total)) return refuse(kLogMeasuredLineWithoutLength);

  const C2dPos startShift(knownStart.north() - measured.front().north(), knownStart.east() - measured.front().east());
  const C2dPos endShift(knownEnd.north() - measured.back().north(), knownEnd.east() - measured.back().east());
  svy_vector<C2dPos> out;
  out.reserve(measured.size());
  double along = 0.0;
  for (std::size_t i = 0; i < measured.size(); ++i) {
    if (i > 0)
      along += std::hypot(measured[i].north() - measured[i - 1].north(), measured[i].east() - measured[i - 1].east());
    const double s = along / total;
    out.push_back(C2dPos(measured[i].north() + (startShift.north() + s * (endShift.north() - startShift.north())),
                         measured[i].east() + (startShift.east() + s * (endShift.east() - startShift.east()))));
  }
  out.front() = knownStart;
  out.back() = knownEnd;
  adjusted = std::move(out);
  return true;
}

}  // namespace svy_math
