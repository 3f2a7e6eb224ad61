#include "svymath/adjustment/matr3_3.h"

#include "svymath/adjustment/covar.h"
#include "svymath/foundation/constants.h"

namespace svy_math {

namespace {

template <class Source>
double elementOrUndefined(const Source& source, int rows, int cols, int row, int col) {
  if (row < 1 || col < 1 || row > rows || col > cols) return undefinedValue();
  return source(row, col);
}

// The adjugate (transposed cofactors) of a.
matr3_3 adjugate(const matr3_3& a) {
  return matr3_3(a(1, 1) * a(2, 2) - a(1, 2) * a(2, 1), a(0, 2) * a(2, 1) - a(0, 1) * a(2, 2),
                 a(0, 1) * a(1, 2) - a(0, 2) * a(1, 1), a(1, 2) * a(2, 0) - a(1, 0) * a(2, 2),
                 a(0, 0) * a(2, 2) - a(0, 2) * a(2, 0), a(0, 2) * a(1, 0) - a(0, 0) * a(1, 2),
                 a(1, 0) * a(2, 1) - a(1, 1) * a(2, 0), a(0, 1) * a(2, 0) - a(0, 0) * a(2, 1),
                 a(0, 0) * a(1, 1) - a(0, 1) * a(1, 0));
}

// Determinant expanded along the first column, with the adjugate's first row as the cofactors.
double firstColumnDeterminant(const matr3_3& a, const matr3_3& adj) {
  return a(0, 0) * adj(0, 0) + a(1, 0) * adj(0, 1) + a(2, 0) * adj(0, 2);
}

}  // namespace

matr3_3::matr3_3() : m{0.0, 0.0, 0.0, 0.0, 0.0, 0.0, 0.0, 0.0, 0.0} {}

matr3_3::matr3_3(double a00, double a01, double a02, double a10, double a11, double a12, double a20, double a21,
                 double a22)
    : m{a00, a01, a02, a10, a11, a12, a20, a21, a22} {}

matr3_3 matr3_3::identity() { return matr3_3(1.0, 0.0, 0.0, 0.0, 1.0, 0.0, 0.0, 0.0, 1.0); }

matr3_3::matr3_3(const matr3_3& other, char op) {
  if (op == kTranspose) {
    for (int i = 0; i < 3; ++i)
      for (int j = 0; j < 3; ++j) (*this)(i, j) = other(j, i);
  } else if (op == kInverse) {
    const matr3_3 adj = adjugate(other);
    const double det = firstColumnDeterminant(other, adj);
    if (-tol::kZero < det && det < tol::kZero) {
      *this = matr3_3();
    } else {
      const double inv = 1.0 / det;
      for (int k = 0; k < 9; ++k) m[k] = adj.m[k] * inv;
    }
  } else {
    for (double& element : m) element = undefinedValue();
  }
}

matr3_3::matr3_3(const covar& c) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) (*this)(i, j) = c(i, j);
}

matr3_3::matr3_3(const TMatrix& r, int firstRow, int firstCol) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j)
      (*this)(i, j) = elementOrUndefined(r, r.rows(), r.cols(), firstRow + i, firstCol + j);
}

matr3_3::matr3_3(const TSMatrix& s, int firstRow, int firstCol) {
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j)
      (*this)(i, j) = elementOrUndefined(s, s.order(), s.order(), firstRow + i, firstCol + j);
}

double matr3_3::det() const { return firstColumnDeterminant(*this, adjugate(*this)); }

matr3_3 matr3_3::operator*(const matr3_3& o) const {
  matr3_3 p;
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) p(i, j) = (*this)(i, 0) * o(0, j) + (*this)(i, 1) * o(1, j) + (*this)(i, 2) * o(2, j);
  return p;
}

TAbstractPoint3<double> matr3_3::operator*(const TAbstractPoint3<double>& p) const {
  TAbstractPoint3<double> r;
  for (int i = 0; i < 3; ++i) r[i] = (*this)(i, 0) * p[0] + (*this)(i, 1) * p[1] + (*this)(i, 2) * p[2];
  return r;
}

covar matr3_3::operator&(const covar& c) const {
  const matr3_3 mc = *this * matr3_3(c);
  covar result;
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j <= i; ++j) result(i, j) = mc(i, 0) * (*this)(j, 0) + mc(i, 1) * (*this)(j, 1) + mc(i, 2) * (*this)(j, 2);
  return result;
}

}  // namespace svy_math
