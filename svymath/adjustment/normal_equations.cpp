#include "svymath/adjustment/normal_equations.h"

#include <cmath>

#include "svymath/adjustment/matrix_storage.h"
#include "svymath/adjustment/spd_inverse.h"
#include "svymath/foundation/constants.h"

namespace svy_math {
namespace detail {
namespace {

bool allFinite(const TLsqMatrix& m) {
  for (std::size_t i = 0; i < m.size1(); ++i)
    for (std::size_t j = 0; j < m.size2(); ++j)
      if (!std::isfinite(m(i, j))) return false;
  return true;
}

}  // namespace

ELeastSquaresStatus checkWeightsAndValues(const TLsqMatrix& a, const TLsqMatrix& y, const TLsqMatrix& w) {
  if (w.size1() != a.size1() || w.size2() != a.size1()) return eLsqDimensionMismatch;
  if (!allFinite(a) || !allFinite(y) || !allFinite(w)) return eLsqNotFinite;
  return eLsqOk;
}

std::size_t packedIndex(std::size_t i, std::size_t j) {
  return static_cast<std::size_t>(LOC1(static_cast<int>(i) + 1, static_cast<int>(j) + 1, 0, 0, kStorageSymmetric) - 1);
}

TLsqMatrix weightedTranspose(const TLsqMatrix& a, const TLsqMatrix& w) {
  const std::size_t m = a.size1();
  const std::size_t n = a.size2();
  TLsqMatrix atw(n, m, 0.0);
  for (std::size_t k = 0; k < m; ++k)
    for (std::size_t l = 0; l < m; ++l) {
      const double weight = w(k, l);
      if (weight == 0.0) continue;
      for (std::size_t i = 0; i < n; ++i) atw(i, l) += a(k, i) * weight;
    }
  return atw;
}

bool invertNormalMatrix(const TLsqMatrix& atw, const TLsqMatrix& a, std::vector<double>& packedInverse) {
  const std::size_t n = a.size2();
  packedInverse.assign(n * (n + 1) / 2, 0.0);
  for (std::size_t i = 0; i < n; ++i)
    for (std::size_t j = 0; j <= i; ++j) {
      double sum = 0.0;
      for (std::size_t k = 0; k < a.size1(); ++k) sum += atw(i, k) * a(k, j);
      packedInverse[packedIndex(i, j)] = sum;
    }
  return invertPositiveDefinitePacked(packedInverse.data(), static_cast<int>(n), tol::kPivotRelativeZero);
}

}  // namespace detail
}  // namespace svy_math
