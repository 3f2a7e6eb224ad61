#include "svymath/adjustment/covar.h"

#include <algorithm>
#include <cmath>

#include "svymath/adjustment/jacobi_eigen.h"
#include "svymath/foundation/constants.h"

namespace svy_math {

namespace {

// Column indices of the eigen-decomposition ordered by decreasing eigenvalue (the diagonal of d).
void orderByEigenvalue(const covar& d, int order[3]) {
  order[0] = 0;
  order[1] = 1;
  order[2] = 2;
  std::sort(order, order + 3, [&d](int a, int b) { return d(a, a) > d(b, b); });
}

}  // namespace

covar::covar() : c{0.0, 0.0, 0.0, 0.0, 0.0, 0.0} {}

covar::covar(double c11, double c21, double c22, double c31, double c32, double c33)
    : c{c11, c21, c22, c31, c32, c33} {}

covar::covar(const matr3_3& m) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j <= i; ++j) (*this)(i, j) = m(i, j) + m(j, i);
}

covar& covar::operator+=(const matr3_3& m) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j <= i; ++j) (*this)(i, j) += 0.5 * (m(i, j) + m(j, i));
  return *this;
}

covar& covar::operator-=(const matr3_3& m) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j <= i; ++j) (*this)(i, j) -= 0.5 * (m(i, j) + m(j, i));
  return *this;
}

TAbstractPoint3<double> covar::operator*(const TAbstractPoint3<double>& p) const { return matr3_3(*this) * p; }

matr3_3 covar::eigen() {
  double vectors[9];
  double work[6];
  std::copy(c, c + 6, work);
  const bool finite = std::all_of(c, c + 6, [](double x) { return std::isfinite(x); });
  if (!finite) {
    matr3_3 undefined;
    for (double& element : undefined.m) element = undefinedValue();
    return undefined;
  }
  detail::jacobiEigenPacked(work, vectors, 3);
  std::copy(work, work + 6, c);
  matr3_3 result;
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) result(i, j) = vectors[j * 3 + i];
  return result;
}

TAbstractPoint3<double> covar::GetEigen(double confidenceFactor) const {
  covar diagonal(*this);
  const matr3_3 vectors = diagonal.eigen();
  TAbstractPoint3<double> axes(undefinedValue());
  if (isUndefined(vectors(0, 0))) return axes;
  int order[3];
  orderByEigenvalue(diagonal, order);
  for (int k = 0; k < 3; ++k) {
    const double value = diagonal(order[k], order[k]);
    axes[k] = confidenceFactor * std::sqrt(value < 0.0 ? 0.0 : value);
  }
  return axes;
}

matr3_3 covar::DuserDeigen() const {
  covar diagonal(*this);
  const matr3_3 vectors = diagonal.eigen();
  int order[3];
  orderByEigenvalue(diagonal, order);
  matr3_3 rotation;
  for (int i = 0; i < 3; ++i) {
    rotation(i, 0) = vectors(i, order[0]);
    rotation(i, 1) = vectors(i, order[1]);
  }
  rotation(0, 2) = rotation(1, 0) * rotation(2, 1) - rotation(2, 0) * rotation(1, 1);
  rotation(1, 2) = rotation(2, 0) * rotation(0, 1) - rotation(0, 0) * rotation(2, 1);
  rotation(2, 2) = rotation(0, 0) * rotation(1, 1) - rotation(1, 0) * rotation(0, 1);
  return rotation;
}

}  // namespace svy_math
