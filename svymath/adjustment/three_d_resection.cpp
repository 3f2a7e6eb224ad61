// Free-station resection by Gauss-Newton (see three_d_resection.h).
//
// Unknowns, in order: the station's north and east relative to the targets' centroid (survey coordinates
// keep their digits), the orientation, and (with zenith angles) the ground-mark height relative to the
// targets' mean height. Rows, per sighting: direction, zenith angle, distance, as observed. A row holds the
// partial derivatives of the computed observation; Y is observed minus computed (directions reduced to
// (-pi, pi]), so the engine's solution is the correction of the unknowns.
#include <cmath>
#include <limits>
#include <vector>

#include "svymath/adjustment/least_squares.h"
#include "svymath/adjustment/matrix_storage.h"
#include "svymath/adjustment/resection_model.h"
#include "svymath/adjustment/spd_inverse.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace svy_math {
namespace {

using detail::observed;

struct Target {
  double north, east, height;  // relative to the local origin; height includes the target height
  const TResectionObservation* obs;
};

struct Setup {
  std::vector<Target> targets;
  double instrumentHeight;
  TResectionAccuracy accuracy;
  bool withHeight;
  int unknowns;
  int rows;
};

class ResectionData : public TNonLinearLeastSquaresData {
 public:
  ResectionData(const Setup& setup, const svy_vector<double>& start) : m_setup(setup), m_start(start) {}

  ELeastSquaresStatus computeInitialGuess() override {
    setCurrentSolution(m_start);
    return eLsqOk;
  }
  TLsqMatrix getAMatrix() const override {
    TLsqMatrix a, y;
    evaluate(currentSolution(), &a, &y, nullptr);
    return a;
  }
  TLsqMatrix getYMatrix() const override {
    TLsqMatrix a, y;
    evaluate(currentSolution(), &a, &y, nullptr);
    return y;
  }
  TLsqMatrix getWeightMatrix() const override {
    TLsqMatrix a, y, w;
    evaluate(currentSolution(), &a, &y, &w);
    return w;
  }
  // Design matrix, misclosures and weights at x.
  void evaluate(const svy_vector<double>& x, TLsqMatrix* a, TLsqMatrix* y, TLsqMatrix* w) const;

 private:
  const Setup& m_setup;
  svy_vector<double> m_start;
};

void ResectionData::evaluate(const svy_vector<double>& x, TLsqMatrix* a, TLsqMatrix* y, TLsqMatrix* w) const {
  const Setup& s = m_setup;
  *y = boost::numeric::ublas::zero_matrix<double>(s.rows, 1);
  *a = boost::numeric::ublas::zero_matrix<double>(s.rows, s.unknowns);
  if (w) *w = boost::numeric::ublas::zero_matrix<double>(s.rows, s.rows);
  const double c = (1.0 - s.accuracy.refraction) / (2.0 * units::kSphereEarthRadius);
  int row = 0;
  for (const Target& t : s.targets) {
    const double dn = t.north - x[0], de = t.east - x[1];
    const double d2 = dn * dn + de * de, d = std::sqrt(d2);
    // Apparent height of the sighted point above the instrument's horizontal plane.
    const double dh = s.withHeight ? t.height - (x[3] + s.instrumentHeight) - c * d2 : 0.0;
    const double slope2 = d2 + dh * dh, slope = std::sqrt(slope2);
    if (observed(t.obs->direction)) {
      (*a)(row, 0) = de / d2;
      (*a)(row, 1) = -dn / d2;
      (*a)(row, 2) = -1.0;
      (*y)(row, 0) = std::remainder(t.obs->direction - (std::atan2(de, dn) - x[2]), units::kTwoPi);
      if (w) (*w)(row, row) = 1.0 / (s.accuracy.direction * s.accuracy.direction);
      ++row;
    }
    if (s.withHeight && observed(t.obs->zenith)) {
      // z = atan2(d, dh): dz/dd = dh / S^2, dz/d(dh) = -d / S^2; dd/dn = -dn / d, d(dh)/dn = 2 c dn.
      (*a)(row, 0) = -dh * dn / (slope2 * d) - d * 2.0 * c * dn / slope2;
      (*a)(row, 1) = -dh * de / (slope2 * d) - d * 2.0 * c * de / slope2;
      (*a)(row, 3) = d / slope2;
      (*y)(row, 0) = t.obs->zenith - std::atan2(d, dh);
      if (w) (*w)(row, row) = 1.0 / (s.accuracy.zenith * s.accuracy.zenith);
      ++row;
    }
    if (observed(t.obs->slopeDistance)) {
      if (s.withHeight) {
        (*a)(row, 0) = (-dn + dh * 2.0 * c * dn) / slope;
        (*a)(row, 1) = (-de + dh * 2.0 * c * de) / slope;
        (*a)(row, 3) = -dh / slope;
      } else {
        (*a)(row, 0) = -dn / d;
        (*a)(row, 1) = -de / d;
      }
      (*y)(row, 0) = t.obs->slopeDistance - (s.withHeight ? slope : d);
      const double sd = detail::distanceSd(s.accuracy, t.obs->slopeDistance);
      if (w) (*w)(row, row) = 1.0 / (sd * sd);
      ++row;
    }
  }
}

// Horizontal distance of a sighting: S sin z with a zenith angle, else the distance as given; NaN without.
double horizontalOf(const TResectionObservation& o) {
  double dh = 0.0, horizontal = o.slopeDistance;
  detail::sightedHeightDifference(o, undefinedValue(), dh, horizontal);
  return horizontal;
}

// How badly a trial station and orientation meet the sightings (squared metres across the line of sight
// and along it); infinite when a direction looks away from its target.
double startCost(const Setup& s, double pn, double pe, double omega) {
  double cost = 0.0;
  for (const Target& t : s.targets) {
    const double dn = t.north - pn, de = t.east - pe, d = std::hypot(dn, de);
    if (observed(t.obs->direction)) {
      const double miss = std::remainder(std::atan2(de, dn) - (t.obs->direction + omega), units::kTwoPi);
      if (std::fabs(miss) >= units::kHalfPi) return std::numeric_limits<double>::infinity();
      cost += d * d * miss * miss;
    }
    const double horizontal = horizontalOf(*t.obs);
    if (observed(horizontal)) cost += (d - horizontal) * (d - horizontal);
  }
  return cost;
}

struct Start {
  double north = 0.0, east = 0.0, orientation = 0.0;
  double cost = std::numeric_limits<double>::infinity();
  void consider(const Setup& s, double pn, double pe, double omega) {
    const double c = startCost(s, pn, pe, omega);
    if (c < cost) cost = c, north = pn, east = pe, orientation = omega;
  }
};

// For each orientation on a grid, the point that best meets the direction sightings, as lines through their
// targets (direction only) or as points (direction and horizontal distance).
void scanOrientations(const Setup& s, Start& best) {
  for (int step = 0; step < limits::kResectionOrientationSteps; ++step) {
    const double omega = units::kTwoPi * step / limits::kResectionOrientationSteps;
    double m00 = 0, m01 = 0, m11 = 0, r0 = 0, r1 = 0;
    for (const Target& t : s.targets) {
      if (!observed(t.obs->direction)) continue;
      const double az = t.obs->direction + omega, cn = std::cos(az), se = std::sin(az);
      const double horizontal = horizontalOf(*t.obs);
      if (observed(horizontal)) {  // the point at that distance behind the target
        m00 += 1.0, m11 += 1.0;
        r0 += t.north - horizontal * cn, r1 += t.east - horizontal * se;
      } else {  // the line through the target, normal (-sin, cos)
        m00 += se * se, m01 -= se * cn, m11 += cn * cn;
        const double k = -se * t.north + cn * t.east;
        r0 += -se * k, r1 += cn * k;
      }
    }
    const double det = m00 * m11 - m01 * m01;
    if (det > tol::kZero * (m00 + m11) * (m00 + m11))
      best.consider(s, (m11 * r0 - m01 * r1) / det, (m00 * r1 - m01 * r0) / det, omega);
  }
}

// With too few directions for the scan: the two points at the measured horizontal distances from two
// targets (where their distance circles cross), each oriented by the mean of its direction misclosures.
// With fewer than two directions the mirror images fit alike, so the start is left undecided.
void crossDistanceCircles(const Setup& s, int directions, Start& best) {
  const Target* pair[2] = {nullptr, nullptr};
  int found = 0;
  for (const Target& t : s.targets)
    if (found < 2 && observed(horizontalOf(*t.obs))) pair[found++] = &t;
  if (found < 2 || directions < 2) return;
  const double r0 = horizontalOf(*pair[0]->obs), r1 = horizontalOf(*pair[1]->obs);
  const double bn = pair[1]->north - pair[0]->north, be = pair[1]->east - pair[0]->east, b = std::hypot(bn, be);
  if (!(b > tol::kControlSpread)) return;
  // Foot of the common chord along the base, and the half chord across it (zero when the circles miss).
  const double along = (r0 * r0 - r1 * r1 + b * b) / (2.0 * b);
  const double across = std::sqrt(std::fmax(0.0, r0 * r0 - along * along));
  for (const double side : {-1.0, 1.0}) {
    const double pn = pair[0]->north + (along * bn - side * across * be) / b;
    const double pe = pair[0]->east + (along * be + side * across * bn) / b;
    double sumSin = 0.0, sumCos = 0.0;
    for (const Target& t : s.targets) {
      if (!observed(t.obs->direction)) continue;
      const double omega = std::atan2(t.east - pe, t.north - pn) - t.obs->direction;
      sumSin += std::sin(omega), sumCos += std::cos(omega);
    }
    best.consider(s, pn, pe, std::atan2(sumSin, sumCos));
  }
}

// Mean ground-mark height from the zenith angles at the starting position.
double startingHeight(const Setup& s, double north, double east) {
  double sum = 0.0;
  int n = 0;
  for (const Target& t : s.targets) {
    double dh = 0.0, horizontal = 0.0;
    if (!detail::sightedHeightDifference(*t.obs, std::hypot(t.north - north, t.east - east), dh, horizontal)) continue;
    sum += t.height - s.instrumentHeight - dh - detail::curvatureAndRefraction(horizontal, s.accuracy.refraction);
    ++n;
  }
  return n > 0 ? sum / n : 0.0;
}

bool isValidAccuracy(const TResectionAccuracy& a) {
  return a.direction > 0.0 && a.zenith > 0.0 && a.distanceConstant >= 0.0 && a.distancePpm >= 0.0 &&
         a.distanceConstant + a.distancePpm > 0.0 && std::isfinite(a.direction + a.zenith + a.distanceConstant +
                                                                   a.distancePpm + a.refraction);
}

EResectionStatus fromLsq(ELeastSquaresStatus status) {
  switch (status) {
    case eLsqOk: return eResOk;
    case eLsqTooFewObservations: return eResTooFewObservations;
    case eLsqSingular: return eResDegenerate;
    case eLsqNotFinite: return eResNotFinite;
    default: return eResNoConvergence;
  }
}

}  // namespace

EResectionStatus ThreeDResection(const TResectionObservation* observations, int count, double instrumentHeight,
                                 const TResectionAccuracy& accuracy, TResectionResult& result) {
  if (observations == nullptr || count < 2) return eResTooFewObservations;
  if (!std::isfinite(instrumentHeight) || !isValidAccuracy(accuracy)) return eResNotFinite;
  Setup s{{}, instrumentHeight, accuracy, false, 3, 0};
  double originN = 0.0, originE = 0.0, originH = 0.0;
  int directions = 0;
  for (int i = 0; i < count; ++i) {
    const TResectionObservation& o = observations[i];
    // Known values must be finite; observations finite or NaN (not observed).
    if (!std::isfinite(o.north) || !std::isfinite(o.east) || !std::isfinite(o.targetHeight) ||
        std::isinf(o.direction) || std::isinf(o.zenith) || std::isinf(o.slopeDistance))
      return eResNotFinite;
    s.withHeight = s.withHeight || observed(o.zenith);
    directions += observed(o.direction) ? 1 : 0;
    s.rows += (observed(o.direction) ? 1 : 0) + (observed(o.zenith) ? 1 : 0) + (observed(o.slopeDistance) ? 1 : 0);
    originN += o.north / count, originE += o.east / count;
  }
  s.unknowns = s.withHeight ? 4 : 3;
  if (directions == 0 || s.rows < s.unknowns) return eResTooFewObservations;
  int heights = 0;
  for (int i = 0; i < count; ++i)
    if (std::isfinite(observations[i].height)) originH += observations[i].height, ++heights;
  originH = heights > 0 ? originH / heights : 0.0;
  for (int i = 0; i < count; ++i) {
    const TResectionObservation& o = observations[i];
    // A height enters every zenith and (in 3-D) distance row.
    if (s.withHeight && (observed(o.zenith) || observed(o.slopeDistance)) && !std::isfinite(o.height))
      return eResNotFinite;
    s.targets.push_back({o.north - originN, o.east - originE, o.height + o.targetHeight - originH, &o});
  }

  Start begin;
  scanOrientations(s, begin);
  if (!std::isfinite(begin.cost)) crossDistanceCircles(s, directions, begin);
  const double n0 = begin.north, e0 = begin.east, omega0 = begin.orientation;
  if (!std::isfinite(begin.cost)) {
    svy_logging::svy_err_log(kResectionLogSource, __LINE__, "no starting position");
    return eResDegenerate;
  }
  svy_vector<double> start{n0, e0, omega0};
  if (s.withHeight) start.push_back(startingHeight(s, n0, e0));
  ResectionData data(s, start);
  svy_vector<double> criteria{tol::kResectionPosition, tol::kResectionPosition, tol::kResectionOrientation};
  if (s.withHeight) criteria.push_back(tol::kResectionPosition);
  data.setConvergenceCriteria(criteria);
  svy_vector<double> x;
  const EResectionStatus status = fromLsq(gaussNewtonLeastSquares(x, data));
  if (status != eResOk) {
    svy_logging::svy_err_log(kResectionLogSource, __LINE__, "adjustment failed");
    return status;
  }

  // Covariance of the unknowns: the inverse of the normal matrix at the solution (a-priori weights).
  TLsqMatrix a, y, w;
  data.evaluate(x, &a, &y, &w);
  const int u = s.unknowns;
  std::vector<double> normal(static_cast<std::size_t>(u * (u + 1) / 2), 0.0);
  double vtpv = 0.0;
  for (int r = 0; r < s.rows; ++r) {
    vtpv += w(r, r) * y(r, 0) * y(r, 0);
    for (int i = 0; i < u; ++i)
      for (int j = 0; j <= i; ++j)
        normal[static_cast<std::size_t>(LOC1(i + 1, j + 1, u, u, kStorageSymmetric) - 1)] += a(r, i) * w(r, r) * a(r, j);
  }
  if (!detail::invertPositiveDefinitePacked(normal.data(), u, tol::kPivotRelativeZero)) return eResDegenerate;
  const auto sd = [&](int i) { return std::sqrt(normal[static_cast<std::size_t>(LOC1(i + 1, i + 1, u, u, kStorageSymmetric) - 1)]); };

  result.north = originN + x[0];
  result.east = originE + x[1];
  result.orientation = std::fmod(std::fmod(x[2], units::kTwoPi) + units::kTwoPi, units::kTwoPi);
  result.height = s.withHeight ? originH + x[3] : undefinedValue();
  result.sdNorth = sd(0);
  result.sdEast = sd(1);
  result.sdOrientation = sd(2);
  result.sdHeight = s.withHeight ? sd(3) : undefinedValue();
  result.sigma0 = s.rows > u ? std::sqrt(vtpv / (s.rows - u)) : undefinedValue();
  result.residuals.clear();
  int row = 0;
  for (const Target& t : s.targets) {
    TResectionResidual r{undefinedValue(), undefinedValue(), undefinedValue()};
    if (observed(t.obs->direction)) r.direction = y(row++, 0);
    if (observed(t.obs->zenith)) r.zenith = y(row++, 0);
    if (observed(t.obs->slopeDistance)) r.distance = y(row++, 0);
    result.residuals.push_back(r);
  }
  return eResOk;
}

}  // namespace svy_math
