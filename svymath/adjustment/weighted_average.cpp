#include "svymath/adjustment/weighted_average.h"

#include <cmath>

#include "svymath/adjustment/matrix_storage.h"
#include "svymath/adjustment/spd_inverse.h"
#include "svymath/foundation/constants.h"

namespace {

constexpr unsigned kComponentBit[3] = {TCoords::kNorthValid, TCoords::kEastValid, TCoords::kHeightValid};

int packed(int i, int j) { return svy_math::LOC1(i + 1, j + 1, 3, 3, svy_math::kStorageSymmetric) - 1; }

// The 0-based components whose bits are in mask, in order; returns how many.
int componentsOf(unsigned mask, int components[3]) {
  int k = 0;
  for (int c = 0; c < 3; ++c)
    if ((mask & kComponentBit[c]) != 0) components[k++] = c;
  return k;
}

}  // namespace

CWaCoords::CWaCoords() { reset(); }

void CWaCoords::reset() {
  for (double& w : m_weight) w = 0.0;
  for (int c = 0; c < 3; ++c) m_weightedSum[c] = m_origin[c] = 0.0;
  m_originSet = 0;
  m_count = 0;
}

bool CWaCoords::add(const TCoords& coords, const TCoordCov& cov) {
  const double value[3] = {coords.north, coords.east, coords.height};
  int used[3];
  const int n = componentsOf(coords.mask, used);
  if (n == 0) return false;
  for (int a = 0; a < n; ++a)
    if (!std::isfinite(value[used[a]])) return false;

  double weight[6];
  for (int a = 0; a < n; ++a)
    for (int b = 0; b <= a; ++b) weight[packed(a, b)] = cov.element(used[a], used[b]);
  if (!svy_math::detail::invertPositiveDefinitePacked(weight, n, svy_math::tol::kPivotRelativeZero)) return false;

  for (int a = 0; a < n; ++a)
    if ((m_originSet & kComponentBit[used[a]]) == 0) {
      m_origin[used[a]] = value[used[a]];
      m_originSet |= kComponentBit[used[a]];
    }
  for (int a = 0; a < n; ++a) {
    for (int b = 0; b <= a; ++b) m_weight[packed(used[a], used[b])] += weight[packed(a, b)];
    for (int b = 0; b < n; ++b) m_weightedSum[used[a]] += weight[packed(a, b)] * (value[used[b]] - m_origin[used[b]]);
  }
  ++m_count;
  return true;
}

bool CWaCoords::getResult(TCoords& out) const {
  if (m_count == 0) return false;
  int used[3];
  const int n = componentsOf(m_originSet, used);
  double inverse[6];
  for (int a = 0; a < n; ++a)
    for (int b = 0; b <= a; ++b) inverse[packed(a, b)] = m_weight[packed(used[a], used[b])];
  // Every added covariance block was positive definite, so their sum is too.
  if (!svy_math::detail::invertPositiveDefinitePacked(inverse, n, 0.0)) return false;
  double* target[3] = {&out.north, &out.east, &out.height};
  for (int a = 0; a < n; ++a) {
    double reduced = 0.0;
    for (int b = 0; b < n; ++b) reduced += inverse[packed(a, b)] * m_weightedSum[used[b]];
    *target[used[a]] = m_origin[used[a]] + reduced;
  }
  out.mask = m_originSet;
  return true;
}
