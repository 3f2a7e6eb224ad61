#include "svymath/adjustment/least_squares.h"

#include <cmath>
#include <cstddef>
#include <vector>

#include "svymath/adjustment/normal_equations.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

namespace svy_math {

namespace {

// Line logged when convergence is tested without criteria.
constexpr int kLogNoConvergenceCriteria = 76;
// Refinement steps of a linear solution: one recovers the digits lost to the normal equations of a badly
// scaled problem; the second only confirms it.
constexpr int kRefinementSteps = 2;

// x = ninv * (atw * y) for the packed inverse ninv of the normal matrix.
std::vector<double> normalSolve(const std::vector<double>& ninv, const TLsqMatrix& atw, const std::vector<double>& y) {
  const std::size_t n = atw.size1();
  std::vector<double> rhs(n, 0.0);
  for (std::size_t i = 0; i < n; ++i)
    for (std::size_t k = 0; k < atw.size2(); ++k) rhs[i] += atw(i, k) * y[k];
  std::vector<double> x(n, 0.0);
  for (std::size_t i = 0; i < n; ++i)
    for (std::size_t j = 0; j < n; ++j) x[i] += ninv[detail::packedIndex(i, j)] * rhs[j];
  return x;
}

}  // namespace

TLeastSquaresData::~TLeastSquaresData() = default;

// ---- TNonLinearLeastSquaresData ----

void TNonLinearLeastSquaresData::setConvergenceCriteria(const svy_vector<double>& criteria) {
  m_convergenceCriteria = criteria;
  m_hasConvergenceCriteria = true;
}

ELeastSquaresStatus TNonLinearLeastSquaresData::correctCurrentSolution(const svy_vector<double>& correction) {
  if (!m_hasCurrentSolution) return eLsqNoCurrentSolution;
  if (correction.size() != m_currentSolution.size() || correction.size() != m_convergenceCriteria.size())
    return eLsqDimensionMismatch;
  m_previousSolution = m_currentSolution;
  for (std::size_t i = 0; i < correction.size(); ++i) m_currentSolution[i] += correction[i];
  m_hasCorrection = true;
  return eLsqOk;
}

ELeastSquaresStatus TNonLinearLeastSquaresData::getCurrentSolution(svy_vector<double>& solution) const {
  solution.clear();
  if (!m_hasCurrentSolution) return eLsqNoCurrentSolution;
  solution = m_currentSolution;
  return eLsqOk;
}

bool TNonLinearLeastSquaresData::hasConverged() const {
  if (!m_hasConvergenceCriteria) svy_logging::svy_err_log(kLeastSquaresLogSource, kLogNoConvergenceCriteria, "");
  if (!m_hasCurrentSolution || !m_hasCorrection) return false;
  if (m_previousSolution.size() != m_currentSolution.size() || m_convergenceCriteria.size() < m_currentSolution.size())
    return false;
  for (std::size_t i = 0; i < m_currentSolution.size(); ++i)
    if (!(std::fabs(m_currentSolution[i] - m_previousSolution[i]) <= std::fabs(m_convergenceCriteria[i]))) return false;
  return true;
}

double TNonLinearLeastSquaresData::getMisclosureRms() const {
  if (!m_hasCurrentSolution) return undefinedValue();
  const TLsqMatrix y = getYMatrix();
  if (y.size1() == 0) return undefinedValue();
  double sum = 0.0;
  for (std::size_t i = 0; i < y.size1(); ++i)
    for (std::size_t j = 0; j < y.size2(); ++j) sum += y(i, j) * y(i, j);
  return std::sqrt(sum / static_cast<double>(y.size1()));
}

void TNonLinearLeastSquaresData::setCurrentSolution(const svy_vector<double>& solution) {
  m_currentSolution = solution;
  m_previousSolution.clear();
  m_hasCurrentSolution = true;
  m_hasCorrection = false;
}

void TNonLinearLeastSquaresData::clearSolution() {
  m_currentSolution.clear();
  m_previousSolution.clear();
  m_hasCurrentSolution = false;
  m_hasCorrection = false;
}

// ---- solvers ----

ELeastSquaresStatus leastSquares(svy_vector<double>& solution, const TLeastSquaresData& data) {
  solution.clear();
  const TLsqMatrix a = data.getAMatrix();
  const TLsqMatrix y = data.getYMatrix();
  if (a.size1() != y.size1() || y.size2() != 1) return eLsqDimensionMismatch;
  if (a.size1() < a.size2()) return eLsqTooFewObservations;
  const TLsqMatrix w = data.getWeightMatrix();
  const ELeastSquaresStatus weights = detail::checkWeightsAndValues(a, y, w);
  if (weights != eLsqOk) return weights;

  const std::size_t m = a.size1();
  const std::size_t n = a.size2();
  const TLsqMatrix atw = detail::weightedTranspose(a, w);
  std::vector<double> normalInverse;
  if (!detail::invertNormalMatrix(atw, a, normalInverse)) return eLsqSingular;

  std::vector<double> observations(m);
  for (std::size_t k = 0; k < m; ++k) observations[k] = y(k, 0);
  std::vector<double> x = normalSolve(normalInverse, atw, observations);
  for (int step = 0; step < kRefinementSteps; ++step) {
    std::vector<double> residual(observations);
    for (std::size_t k = 0; k < m; ++k)
      for (std::size_t i = 0; i < n; ++i) residual[k] -= a(k, i) * x[i];
    const std::vector<double> dx = normalSolve(normalInverse, atw, residual);
    for (std::size_t i = 0; i < n; ++i) x[i] += dx[i];
  }
  for (double value : x)
    if (!std::isfinite(value)) return eLsqNotFinite;
  solution.assign(x.begin(), x.end());
  return eLsqOk;
}

ELeastSquaresStatus gaussNewtonLeastSquares(svy_vector<double>& solution, TNonLinearLeastSquaresData& data) {
  solution.clear();
  if (!data.isConvergenceSet()) return eLsqDimensionMismatch;
  ELeastSquaresStatus status = data.computeInitialGuess();
  if (status != eLsqOk) return status;
  svy_vector<double> correction;
  for (int iteration = 0; !data.hasConverged(); ++iteration) {
    if (iteration >= limits::kGaussNewtonIterationCap) return eLsqNoConvergence;
    status = leastSquares(correction, data);
    if (status != eLsqOk) return status;
    status = data.correctCurrentSolution(correction);
    if (status != eLsqOk) return status;
  }
  return data.getCurrentSolution(solution);
}

}  // namespace svy_math
