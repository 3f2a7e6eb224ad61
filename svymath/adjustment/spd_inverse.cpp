#include "svymath/adjustment/spd_inverse.h"

#include <algorithm>
#include <cmath>
#include <vector>

#include "svymath/adjustment/matrix_storage.h"

namespace svy_math {
namespace detail {

namespace {

// 0-based index of (i, j), 1-based, in the packed triangle.
int at(int i, int j) { return LOC1(i, j, 0, 0, kStorageSymmetric) - 1; }

}  // namespace

int packedRowProfile(const double* a, int i) {
  for (int j = 1; j < i; ++j)
    if (a[at(i, j)] != 0.0) return j;
  return i;
}

bool invertPositiveDefinitePacked(double* a, int n, double relativePivotZero) {
  if (n <= 0) return true;
  const int count = n * (n + 1) / 2;
  if (!std::all_of(a, a + count, [](double x) { return std::isfinite(x); })) return false;

  std::vector<int> first(static_cast<std::size_t>(n) + 1);
  for (int i = 1; i <= n; ++i) first[i] = packedRowProfile(a, i);

  // Lower Cholesky factor l, a = l l^T, row by row within each row's profile.
  std::vector<double> l(a, a + count);
  for (int i = 1; i <= n; ++i) {
    for (int j = first[i]; j <= i; ++j) {
      double sum = a[at(i, j)];
      for (int k = std::max(first[i], first[j]); k < j; ++k) sum -= l[at(i, k)] * l[at(j, k)];
      if (i == j) {
        if (!(sum > relativePivotZero * a[at(i, i)]) || !(a[at(i, i)] > 0.0)) return false;
        l[at(i, i)] = std::sqrt(sum);
      } else {
        l[at(i, j)] = sum / l[at(j, j)];
      }
    }
  }

  // linv = l^-1 (lower triangular, dense in general), column by column.
  std::vector<double> linv(static_cast<std::size_t>(count), 0.0);
  for (int j = 1; j <= n; ++j) {
    linv[at(j, j)] = 1.0 / l[at(j, j)];
    for (int i = j + 1; i <= n; ++i) {
      double sum = 0.0;
      for (int k = std::max(j, first[i]); k < i; ++k) sum += l[at(i, k)] * linv[at(k, j)];
      linv[at(i, j)] = -sum / l[at(i, i)];
    }
  }

  // a^-1 = linv^T linv.
  for (int i = 1; i <= n; ++i)
    for (int j = 1; j <= i; ++j) {
      double sum = 0.0;
      for (int k = i; k <= n; ++k) sum += linv[at(k, i)] * linv[at(k, j)];
      a[at(i, j)] = sum;
    }
  return true;
}

}  // namespace detail
}  // namespace svy_math
