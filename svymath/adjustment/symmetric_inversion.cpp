#include "svymath/adjustment/symmetric_inversion.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <vector>

#include "svymath/adjustment/jacobi_eigen.h"
#include "svymath/adjustment/spd_inverse.h"
#include "svymath/foundation/constants.h"

namespace svy_math {

int CanInvert(TSMatrix& s, double maxFactor) {
  const int n = s.order();
  for (int k = 1; k <= n; ++k) {
    for (int j = 1; j < k; ++j) {
      const double ujk = s(j, k);
      if (-tol::kCholeskySparseZero < ujk && ujk < tol::kCholeskySparseZero) continue;
      s(k, k) -= ujk * ujk;
      for (int i = k + 1; i <= n; ++i) s(k, i) -= ujk * s(j, i);
    }
    const double pivot = s(k, k);
    if (pivot <= 0.0) return 0;
    const double factor = 1.0 / std::sqrt(pivot);
    s(k, k) = factor;
    for (int i = k + 1; i <= n; ++i) s(k, i) *= factor;
  }
  for (int k = 1; k <= n; ++k)
    if (!(s(k, k) <= maxFactor)) return 0;
  return 1;
}

int InvertSMatr3(covar& c) {
  const double* a = c.c;
  const double adj[6] = {a[2] * a[5] - a[4] * a[4], a[3] * a[4] - a[1] * a[5], a[0] * a[5] - a[3] * a[3],
                         a[1] * a[4] - a[2] * a[3], a[1] * a[3] - a[0] * a[4], a[0] * a[2] - a[1] * a[1]};
  const double det = a[0] * adj[0] + a[1] * adj[1] + a[3] * adj[3];
  if (std::fabs(det) < tol::kPackedDeterminantZero) return -1;
  for (int k = 0; k < 6; ++k) c.c[k] = adj[k] / det;
  return det > 0.0 && c.c[0] > 0.0 && c.c[2] > 0.0 && c.c[5] > 0.0 ? 0 : -2;
}

int RareInversion(TSMatrix& s, int* index, int indexSize) {
  const int n = s.order();
  if (index != nullptr)
    for (int i = 1; i <= n && i <= indexSize; ++i) index[i - 1] = detail::packedRowProfile(s.data(), i);
  return detail::invertPositiveDefinitePacked(s.data(), n, tol::kPivotRelativeZero) ? 0 : -1;
}

int PseudoInversion(TSMatrix& s, int rankDefect) {
  const int n = s.order();
  if (rankDefect > n) return -1;
  std::vector<double> diagonal(s.data(), s.data() + s.packedSize());
  std::vector<double> vectors(static_cast<std::size_t>(n) * static_cast<std::size_t>(n));
  for (int k = 0; k < s.packedSize(); ++k)
    if (!std::isfinite(diagonal[static_cast<std::size_t>(k)])) return -1;
  if (n > 0) detail::jacobiEigenPacked(diagonal.data(), vectors.data(), n);

  std::vector<double> values(static_cast<std::size_t>(n));
  for (int k = 1; k <= n; ++k) values[k - 1] = diagonal[LOC1(k, k, n, n, kStorageSymmetric) - 1];
  // Eigenvalue indices by increasing magnitude: the first `dropped` of them are zeroed.
  std::vector<int> bySize(static_cast<std::size_t>(n));
  std::iota(bySize.begin(), bySize.end(), 0);
  std::sort(bySize.begin(), bySize.end(), [&values](int a, int b) { return std::fabs(values[a]) < std::fabs(values[b]); });
  int dropped = rankDefect;
  if (rankDefect < 0) {
    const double largest = n > 0 ? std::fabs(values[bySize.back()]) : 0.0;
    dropped = 0;
    while (dropped < n && std::fabs(values[bySize[dropped]]) <= tol::kPseudoInverseRelativeZero * largest) ++dropped;
  }

  s = 0.0;
  for (int k = dropped; k < n; ++k) {
    const int e = bySize[k];
    const double inverse = 1.0 / values[e];
    const double* v = vectors.data() + static_cast<std::size_t>(e) * static_cast<std::size_t>(n);
    for (int i = 1; i <= n; ++i)
      for (int j = 1; j <= i; ++j) s(i, j) += v[i - 1] * v[j - 1] * inverse;
  }
  return n - dropped;
}

}  // namespace svy_math
