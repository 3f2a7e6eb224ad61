#include "svymath/adjustment/lsq_matrix_helpers.h"

#include <cmath>
#include <vector>

#include <boost/numeric/ublas/matrix_expression.hpp>

#include "svymath/adjustment/normal_equations.h"

namespace svy_math {

bool GenerateATMatrix(const TObservationEquation& equations, std::size_t observations,
                      const svy_vector<double>& unknowns, const svy_vector<double>& steps, TLsqMatrix& a) {
  const std::size_t n = unknowns.size();
  if (observations == 0 || n == 0 || steps.size() != n || !equations) return false;
  TLsqMatrix design(observations, n);
  svy_vector<double> shifted(unknowns);
  for (std::size_t j = 0; j < n; ++j) {
    if (!(steps[j] > 0.0 && std::isfinite(steps[j]))) return false;
    const double plus = unknowns[j] + steps[j];
    const double minus = unknowns[j] - steps[j];
    // The step as the doubles hold it: at E 500 000 a step of 1e-4 m is off by up to 1e-10 m.
    const double span = plus - minus;
    for (std::size_t i = 0; i < observations; ++i) {
      shifted[j] = plus;
      const double ahead = equations(i, shifted);
      shifted[j] = minus;
      const double behind = equations(i, shifted);
      design(i, j) = (ahead - behind) / span;
      if (!std::isfinite(design(i, j))) return false;
    }
    shifted[j] = unknowns[j];
  }
  a.swap(design);
  return true;
}

TLsqMatrix GenerateTransposeMatrix(const TLsqMatrix& m) { return boost::numeric::ublas::trans(m); }

bool ProdMat(const TLsqMatrix& left, const TLsqMatrix& right, TLsqMatrix& product) {
  if (left.size2() != right.size1()) return false;
  // Assigned through a temporary, so that product may alias an operand.
  product = boost::numeric::ublas::prod(left, right);
  return true;
}

ELeastSquaresStatus ComputeCovMatrix(const TLsqMatrix& a, const TLsqMatrix& w, const TLsqMatrix& residuals,
                                     TLsqMatrix& covariance, double& sigma0Squared) {
  const std::size_t m = a.size1();
  const std::size_t n = a.size2();
  if (residuals.size1() != m || residuals.size2() != 1) return eLsqDimensionMismatch;
  if (m <= n) return eLsqTooFewObservations;
  const ELeastSquaresStatus values = detail::checkWeightsAndValues(a, residuals, w);
  if (values != eLsqOk) return values;
  std::vector<double> normalInverse;
  if (!detail::invertNormalMatrix(detail::weightedTranspose(a, w), a, normalInverse)) return eLsqSingular;

  double vtwv = 0.0;
  for (std::size_t k = 0; k < m; ++k)
    for (std::size_t l = 0; l < m; ++l) vtwv += residuals(k, 0) * w(k, l) * residuals(l, 0);
  const double s0 = vtwv / static_cast<double>(m - n);
  TLsqMatrix result(n, n);
  for (std::size_t i = 0; i < n; ++i)
    for (std::size_t j = 0; j < n; ++j) result(i, j) = s0 * normalInverse[detail::packedIndex(i, j)];
  covariance.swap(result);
  sigma0Squared = s0;
  return eLsqOk;
}

ELeastSquaresStatus ComputeCovMatrix(const TLeastSquaresData& data, const svy_vector<double>& solution,
                                     TLsqMatrix& covariance, double& sigma0Squared) {
  const TLsqMatrix a = data.getAMatrix();
  const TLsqMatrix y = data.getYMatrix();
  if (y.size1() != a.size1() || y.size2() != 1 || solution.size() != a.size2()) return eLsqDimensionMismatch;
  TLsqMatrix residuals(a.size1(), 1);
  for (std::size_t k = 0; k < a.size1(); ++k) {
    double computed = 0.0;
    for (std::size_t i = 0; i < a.size2(); ++i) computed += a(k, i) * solution[i];
    residuals(k, 0) = computed - y(k, 0);
  }
  return ComputeCovMatrix(a, data.getWeightMatrix(), residuals, covariance, sigma0Squared);
}

}  // namespace svy_math
