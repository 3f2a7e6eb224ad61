#include <cmath>
#include <cstddef>

#include "svymath/adjustment/best_fit.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace svy_math {

namespace {

// Lines logged when the design or weight matrix is asked for with neither a current solution nor a centre.
constexpr int kLogAMatrixUnready = 556;
constexpr int kLogWeightMatrixUnready = 606;

}  // namespace

TBestFitRadiusData::TBestFitRadiusData(const svy_list<C2dPos>& points, const C2dPos& centre) {
  for (const C2dPos& p : points) m_points.add(p);
  setCircleCenter(centre);
}

void TBestFitRadiusData::reset() {
  m_points.clear();
  clearSolution();
}

void TBestFitRadiusData::setCircleCenter(const C2dPos& centre) {
  m_centre = centre;
  m_centreSet = true;
}

ELeastSquaresStatus TBestFitRadiusData::computeInitialGuess() {
  if (!m_centreSet || m_points.count() == 0) return eLsqTooFewObservations;
  double sum = 0.0;
  for (const C2dPos& p : m_points.points()) sum += std::hypot(p.north() - m_centre.north(), p.east() - m_centre.east());
  const double meanDistance = sum / m_points.count();
  if (!std::isfinite(meanDistance)) return eLsqNotFinite;
  setCurrentSolution(svy_vector<double>{meanDistance});
  return eLsqOk;
}

TLsqMatrix TBestFitRadiusData::getAMatrix() const {
  if (!hasCurrentSolution() && !m_centreSet) svy_logging::svy_err_log(kLeastSquaresLogSource, kLogAMatrixUnready, "");
  return TLsqMatrix(static_cast<std::size_t>(m_points.count()), 1, -1.0);
}

TLsqMatrix TBestFitRadiusData::getYMatrix() const {
  if (!hasCurrentSolution() || !m_centreSet) return TLsqMatrix(0, 1);
  const double radius = currentSolution()[0];
  TLsqMatrix y(static_cast<std::size_t>(m_points.count()), 1);
  std::size_t row = 0;
  for (const C2dPos& p : m_points.points())
    y(row++, 0) = std::hypot(p.north() - m_centre.north(), p.east() - m_centre.east()) - radius;
  return y;
}

TLsqMatrix TBestFitRadiusData::getWeightMatrix() const {
  if (!hasCurrentSolution() && !m_centreSet)
    svy_logging::svy_err_log(kLeastSquaresLogSource, kLogWeightMatrixUnready, "");
  return detail::unitWeightMatrix(m_points.count());
}

}  // namespace svy_math
