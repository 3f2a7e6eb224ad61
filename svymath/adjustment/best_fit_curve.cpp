#include <cmath>
#include <cstddef>
#include <limits>

#include "svymath/adjustment/best_fit.h"
#include "svymath/adjustment/spd_inverse.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace svy_math {

namespace {

// Lines logged when the matrices are asked for before a current solution exists.
constexpr int kLogAMatrixUnready = 330;
constexpr int kLogYMatrixUnready = 369;
constexpr int kLogWeightMatrixUnready = 396;
// A circle needs three points.
constexpr int kMinCirclePoints = 3;

}  // namespace

TBestFitCurveData::TBestFitCurveData(const svy_list<C2dPos>& points) {
  for (const C2dPos& p : points) m_points.add(p);
}

void TBestFitCurveData::reset() {
  m_points.clear();
  clearSolution();
}

ELeastSquaresStatus TBestFitCurveData::computeInitialGuess() {
  if (m_points.count() < kMinCirclePoints) return eLsqTooFewObservations;
  const double count = m_points.count();
  // Centroid, summed relative to the first point so that large coordinates keep their digits.
  const C2dPos& first = m_points.points().front();
  double sumN = 0.0;
  double sumE = 0.0;
  for (const C2dPos& p : m_points.points()) {
    if (!std::isfinite(p.north()) || !std::isfinite(p.east())) return eLsqNotFinite;
    sumN += p.north() - first.north();
    sumE += p.east() - first.east();
  }
  const double centroidN = first.north() + sumN / count;
  const double centroidE = first.east() + sumE / count;
  double sumSquares = 0.0;
  for (const C2dPos& p : m_points.points())
    sumSquares += (p.north() - centroidN) * (p.north() - centroidN) + (p.east() - centroidE) * (p.east() - centroidE);
  const double scale = std::sqrt(sumSquares / count);
  if (!(scale > 0.0) || !std::isfinite(scale)) return eLsqSingular;

  // Normal equations of x^2 + y^2 + D x + E y + F = 0 with x = (p2 - centroid)/scale, y likewise for p1:
  // rows (x, y, 1), right-hand side -(x^2 + y^2). Packed (1,1), (2,1), (2,2), (3,1), (3,2), (3,3).
  double normal[6] = {0.0, 0.0, 0.0, 0.0, 0.0, 0.0};
  double rhs[3] = {0.0, 0.0, 0.0};
  for (const C2dPos& p : m_points.points()) {
    const double x = (p.east() - centroidE) / scale;
    const double y = (p.north() - centroidN) / scale;
    const double row[3] = {x, y, 1.0};
    const double target = -(x * x + y * y);
    int k = 0;
    for (int i = 0; i < 3; ++i) {
      for (int j = 0; j <= i; ++j) normal[k++] += row[i] * row[j];
      rhs[i] += row[i] * target;
    }
  }
  if (!detail::invertPositiveDefinitePacked(normal, 3, tol::kPivotRelativeZero)) return eLsqSingular;
  const auto inverse = [&normal](int i, int j) { return i >= j ? normal[i * (i + 1) / 2 + j] : normal[j * (j + 1) / 2 + i]; };
  double coefficients[3];
  for (int i = 0; i < 3; ++i) coefficients[i] = inverse(i, 0) * rhs[0] + inverse(i, 1) * rhs[1] + inverse(i, 2) * rhs[2];
  const double centreX = -0.5 * coefficients[0];
  const double centreY = -0.5 * coefficients[1];
  const double radiusSquared = centreX * centreX + centreY * centreY - coefficients[2];
  if (!(radiusSquared > 0.0) || !std::isfinite(radiusSquared)) return eLsqSingular;

  setCurrentSolution(svy_vector<double>{centroidE + scale * centreX, centroidN + scale * centreY,
                                        scale * std::sqrt(radiusSquared)});
  return eLsqOk;
}

TLsqMatrix TBestFitCurveData::getAMatrix() const {
  if (!hasCurrentSolution()) {
    svy_logging::svy_err_log(kLeastSquaresLogSource, kLogAMatrixUnready, "");
    return TLsqMatrix(0, 3);
  }
  const double u = currentSolution()[0];
  const double v = currentSolution()[1];
  TLsqMatrix a(static_cast<std::size_t>(m_points.count()), 3);
  std::size_t row = 0;
  for (const C2dPos& p : m_points.points()) {
    const double d = std::hypot(u - p.east(), v - p.north());
    a(row, 0) = -(u - p.east()) / d;
    a(row, 1) = -(v - p.north()) / d;
    a(row, 2) = 1.0;
    ++row;
  }
  return a;
}

TLsqMatrix TBestFitCurveData::getYMatrix() const {
  if (!hasCurrentSolution()) {
    svy_logging::svy_err_log(kLeastSquaresLogSource, kLogYMatrixUnready, "");
    return TLsqMatrix(0, 1);
  }
  const double u = currentSolution()[0];
  const double v = currentSolution()[1];
  const double r = currentSolution()[2];
  TLsqMatrix y(static_cast<std::size_t>(m_points.count()), 1);
  std::size_t row = 0;
  for (const C2dPos& p : m_points.points()) y(row++, 0) = std::hypot(u - p.east(), v - p.north()) - r;
  return y;
}

double TBestFitCurveData::getMisclosureRounding() const {
  if (!hasCurrentSolution()) return 0.0;
  // Each misclosure d - r rounds at a few units of the last place of the radius.
  return limits::kCircleMisclosureUlps * std::numeric_limits<double>::epsilon() * std::fabs(currentSolution()[2]);
}

TLsqMatrix TBestFitCurveData::getWeightMatrix() const {
  if (!hasCurrentSolution()) svy_logging::svy_err_log(kLeastSquaresLogSource, kLogWeightMatrixUnready, "");
  return detail::unitWeightMatrix(m_points.count());
}

}  // namespace svy_math
