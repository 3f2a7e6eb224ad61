#include "svymath/adjustment/jacobi_eigen.h"

#include <cmath>

#include "svymath/adjustment/matrix_storage.h"
#include "svymath/foundation/constants.h"

namespace svy_math {
namespace detail {

namespace {

// 0-based index of element (i, j), 1-based, of the packed triangle.
int packed(int i, int j) { return LOC1(i, j, 0, 0, kStorageSymmetric) - 1; }

// One plane rotation in rows and columns l < m that annihilates a(l, m), with the eigenvector columns
// rotated alike.
void rotate(double* a, double* vectors, int n, int l, int m) {
  const int ll = packed(l, l);
  const int mm = packed(m, m);
  const int lm = packed(l, m);
  const double half = 0.5 * (a[ll] - a[mm]);
  double x = -a[lm] / std::sqrt(a[lm] * a[lm] + half * half);
  if (half < 0.0) x = -x;
  // |x| <= 1 exactly; the clamp only absorbs a last-bit excess of the rounded quotient.
  const double oneMinusX2 = 1.0 - x * x > 0.0 ? 1.0 - x * x : 0.0;
  const double sinX = x / std::sqrt(2.0 * (1.0 + std::sqrt(oneMinusX2)));
  const double sin2 = sinX * sinX;
  const double cosX = std::sqrt(1.0 - sin2);
  const double cos2 = cosX * cosX;
  const double sinCos = sinX * cosX;

  for (int i = 1; i <= n; ++i) {
    if (i != l && i != m) {
      const int il = packed(i, l);
      const int im = packed(i, m);
      const double t = a[il] * cosX - a[im] * sinX;
      a[im] = a[il] * sinX + a[im] * cosX;
      a[il] = t;
    }
    double& vl = vectors[(l - 1) * n + (i - 1)];
    double& vm = vectors[(m - 1) * n + (i - 1)];
    const double t = vl * cosX - vm * sinX;
    vm = vl * sinX + vm * cosX;
    vl = t;
  }
  const double twice = 2.0 * a[lm] * sinCos;
  const double newL = a[ll] * cos2 + a[mm] * sin2 - twice;
  const double newM = a[ll] * sin2 + a[mm] * cos2 + twice;
  a[lm] = (a[ll] - a[mm]) * sinCos + a[lm] * (cos2 - sin2);
  a[ll] = newL;
  a[mm] = newM;
}

void scale(double* a, int count, double factor) {
  for (int k = 0; k < count; ++k) a[k] *= factor;
}

}  // namespace

bool jacobiEigenPacked(double* a, double* vectors, int n) {
  for (int j = 0; j < n; ++j)
    for (int i = 0; i < n; ++i) vectors[j * n + i] = i == j ? 1.0 : 0.0;
  const int count = n * (n + 1) / 2;
  double largest = 0.0;
  for (int k = 0; k < count; ++k) {
    if (!std::isfinite(a[k])) return false;
    largest = std::fabs(a[k]) > largest ? std::fabs(a[k]) : largest;
  }
  if (largest == 0.0) return true;

  // Work on the matrix scaled by a power of two that brings its largest element into [0.5, 1): exact, so
  // the rotations are those of the matrix itself, but neither the squares of huge elements overflow nor
  // those of tiny ones underflow, and the zero test of the off-diagonal norm is relative.
  int exponent = 0;
  std::frexp(largest, &exponent);
  scale(a, count, std::ldexp(1.0, -exponent));

  double offDiagonal = 0.0;
  for (int m = 2; m <= n; ++m)
    for (int l = 1; l < m; ++l) offDiagonal += a[packed(l, m)] * a[packed(l, m)];
  bool finished = true;
  if (offDiagonal >= tol::kZero) {
    const double norm = std::sqrt(2.0 * offDiagonal);
    const double finalThreshold = norm * tol::kJacobiRange / n;
    double threshold = norm;
    do {
      threshold /= n;
      int sweeps = 0;
      bool rotated = true;
      while (rotated && sweeps < limits::kJacobiSweepCap) {
        rotated = false;
        for (int l = 1; l < n; ++l)
          for (int m = l + 1; m <= n; ++m)
            if (std::fabs(a[packed(l, m)]) >= threshold) {
              rotate(a, vectors, n, l, m);
              rotated = true;
            }
        ++sweeps;
      }
      if (rotated) finished = false;
    } while (threshold > finalThreshold);
  }
  scale(a, count, std::ldexp(1.0, exponent));
  return finished;
}

}  // namespace detail
}  // namespace svy_math
