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

// A problem with an intercept column (all its entries one non-zero value c) is solved relative to the
// centroid: every other column and the observations are taken relative to their means. That is the same
// model exactly (the shift moves into the intercept), but at survey coordinates the normal equations of
// the raw columns (E 500 000 beside 1) are conditioned around 1e14 and lose the solution, while the centred
// ones keep it to the rounding of the data.
struct TCentring {
  std::size_t interceptColumn = 0;
  bool active = false;
  std::vector<double> columnMeans;  // per column; 0 for the intercept column
  double observationMean = 0.0;
};

// Mean of a sequence, summed relative to its first value so that large values keep their digits.
template <class Value>
double meanRelativeToFirst(std::size_t count, Value value) {
  double sum = 0.0;
  for (std::size_t k = 0; k < count; ++k) sum += value(k) - value(0);
  return value(0) + sum / static_cast<double>(count);
}

// Finds the intercept column and centres a and y on it. False when a centred column is no wider than the
// rounding of its values (tol::kCentredSpreadRelativeZero): its unknown is not defined by the data.
bool centreOnIntercept(TLsqMatrix& a, TLsqMatrix& y, TCentring& centring) {
  const std::size_t m = a.size1();
  const std::size_t n = a.size2();
  if (m == 0) return true;
  for (std::size_t j = 0; j < n && !centring.active; ++j) {
    bool constant = a(0, j) != 0.0;
    for (std::size_t k = 1; k < m && constant; ++k) constant = a(k, j) == a(0, j);
    centring.interceptColumn = j;
    centring.active = constant;
  }
  if (!centring.active || n < 2) {
    centring.active = false;
    return true;
  }
  centring.columnMeans.assign(n, 0.0);
  for (std::size_t j = 0; j < n; ++j) {
    if (j == centring.interceptColumn) continue;
    const double mean = meanRelativeToFirst(m, [&a, j](std::size_t k) { return a(k, j); });
    double largest = 0.0;
    double widest = 0.0;
    for (std::size_t k = 0; k < m; ++k) {
      largest = std::fmax(largest, std::fabs(a(k, j)));
      a(k, j) -= mean;
      widest = std::fmax(widest, std::fabs(a(k, j)));
    }
    if (!(widest > tol::kCentredSpreadRelativeZero * largest)) return false;
    centring.columnMeans[j] = mean;
  }
  centring.observationMean = meanRelativeToFirst(m, [&y](std::size_t k) { return y(k, 0); });
  for (std::size_t k = 0; k < m; ++k) y(k, 0) -= centring.observationMean;
  return true;
}

// Moves the centroid back into the intercept of the solution x of the centred problem, and likewise the
// intercept's row of the gain g (observations to solution, n x m row-major) when one is given.
void uncentre(const TLsqMatrix& a, const TCentring& centring, std::vector<double>& x, std::vector<double>* gain) {
  if (!centring.active) return;
  const std::size_t j0 = centring.interceptColumn;
  const double c = a(0, j0);
  double shift = centring.observationMean;
  for (std::size_t j = 0; j < x.size(); ++j) shift -= centring.columnMeans[j] * x[j];
  x[j0] += shift / c;
  if (gain == nullptr) return;
  const std::size_t m = a.size1();
  for (std::size_t j = 0; j < x.size(); ++j)
    for (std::size_t k = 0; k < m; ++k) (*gain)[j0 * m + k] -= centring.columnMeans[j] * (*gain)[j * m + k] / c;
}

// The linear solution of data into x. With noise given, noise[i] receives the root sum of squares of the
// i-th row of the map from observations to solution: the change of x[i] caused by independent errors of
// unit size in every observation.
ELeastSquaresStatus solveLinear(const TLeastSquaresData& data, std::vector<double>& x, std::vector<double>* noise) {
  TLsqMatrix a = data.getAMatrix();
  TLsqMatrix y = data.getYMatrix();
  if (a.size1() != y.size1() || y.size2() != 1) return eLsqDimensionMismatch;
  if (a.size1() < a.size2()) return eLsqTooFewObservations;
  const TLsqMatrix w = data.getWeightMatrix();
  const ELeastSquaresStatus weights = detail::checkWeightsAndValues(a, y, w);
  if (weights != eLsqOk) return weights;
  TCentring centring;
  if (!centreOnIntercept(a, y, centring)) return eLsqSingular;

  const std::size_t m = a.size1();
  const std::size_t n = a.size2();
  const TLsqMatrix atw = detail::weightedTranspose(a, w);
  std::vector<double> normalInverse;
  if (!detail::invertNormalMatrix(atw, a, normalInverse)) return eLsqSingular;

  std::vector<double> observations(m);
  for (std::size_t k = 0; k < m; ++k) observations[k] = y(k, 0);
  x = normalSolve(normalInverse, atw, observations);
  for (int step = 0; step < kRefinementSteps; ++step) {
    std::vector<double> residual(observations);
    for (std::size_t k = 0; k < m; ++k)
      for (std::size_t i = 0; i < n; ++i) residual[k] -= a(k, i) * x[i];
    const std::vector<double> dx = normalSolve(normalInverse, atw, residual);
    for (std::size_t i = 0; i < n; ++i) x[i] += dx[i];
  }
  std::vector<double> gain;
  if (noise != nullptr) {
    gain.assign(n * m, 0.0);
    for (std::size_t i = 0; i < n; ++i)
      for (std::size_t j = 0; j < n; ++j) {
        const double inverse = normalInverse[detail::packedIndex(i, j)];
        for (std::size_t k = 0; k < m; ++k) gain[i * m + k] += inverse * atw(j, k);
      }
  }
  uncentre(a, centring, x, noise != nullptr ? &gain : nullptr);
  for (double value : x)
    if (!std::isfinite(value)) return eLsqNotFinite;
  if (noise != nullptr) {
    noise->assign(n, 0.0);
    for (std::size_t i = 0; i < n; ++i) {
      double sum = 0.0;
      for (std::size_t k = 0; k < m; ++k) sum += gain[i * m + k] * gain[i * m + k];
      (*noise)[i] = std::sqrt(sum);
    }
  }
  return eLsqOk;
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

double TNonLinearLeastSquaresData::getMisclosureRounding() const { return 0.0; }

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
  std::vector<double> x;
  const ELeastSquaresStatus status = solveLinear(data, x, nullptr);
  if (status == eLsqOk) solution.assign(x.begin(), x.end());
  return status;
}

ELeastSquaresStatus gaussNewtonLeastSquares(svy_vector<double>& solution, TNonLinearLeastSquaresData& data) {
  solution.clear();
  if (!data.isConvergenceSet()) return eLsqDimensionMismatch;
  ELeastSquaresStatus status = data.computeInitialGuess();
  if (status != eLsqOk) return status;
  std::vector<double> step;
  std::vector<double> noise;
  bool atRounding = false;
  for (int iteration = 0; !atRounding && !data.hasConverged(); ++iteration) {
    if (iteration >= limits::kGaussNewtonIterationCap) return eLsqNoConvergence;
    const double rounding = data.getMisclosureRounding();
    status = solveLinear(data, step, &noise);
    if (status != eLsqOk) return status;
    // A correction no larger than the rounding of the misclosures carried into the unknowns is noise: the
    // iteration has reached the data's own precision, and further steps would only wander around it.
    atRounding = rounding > 0.0;
    for (std::size_t i = 0; i < step.size(); ++i)
      atRounding = atRounding && std::fabs(step[i]) <= limits::kRoundingNoiseFactor * rounding * noise[i];
    status = data.correctCurrentSolution(svy_vector<double>(step.begin(), step.end()));
    if (status != eLsqOk) return status;
  }
  return data.getCurrentSolution(solution);
}

}  // namespace svy_math
