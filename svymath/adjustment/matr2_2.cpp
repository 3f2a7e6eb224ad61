#include "svymath/adjustment/matr2_2.h"

#include "svymath/foundation/constants.h"

namespace svy_math {

namespace {

// Element (row, col), 1-based, of a source matrix, or NaN when it lies outside.
template <class Source>
double elementOrUndefined(const Source& source, int rows, int cols, int row, int col) {
  if (row < 1 || col < 1 || row > rows || col > cols) return undefinedValue();
  return source(row, col);
}

}  // namespace

matr2_2::matr2_2() : m{0.0, 0.0, 0.0, 0.0} {}

matr2_2::matr2_2(double a00, double a01, double a10, double a11) : m{a00, a01, a10, a11} {}

matr2_2::matr2_2(const matr2_2& other, char op) {
  if (op == kTranspose) {
    *this = matr2_2(other.m[0], other.m[2], other.m[1], other.m[3]);
  } else if (op == kInverse) {
    const double det = other.det();
    if (-tol::kZero < det && det < tol::kZero) {
      *this = matr2_2();
    } else {
      const double inv = 1.0 / det;
      *this = matr2_2(other.m[3] * inv, -other.m[1] * inv, -other.m[2] * inv, other.m[0] * inv);
    }
  } else {
    const double u = undefinedValue();
    *this = matr2_2(u, u, u, u);
  }
}

matr2_2::matr2_2(const TMatrix& r, int firstRow, int firstCol) {
  for (int i = 0; i < 2; ++i)
    for (int j = 0; j < 2; ++j)
      (*this)(i, j) = elementOrUndefined(r, r.rows(), r.cols(), firstRow + i, firstCol + j);
}

matr2_2::matr2_2(const TSMatrix& s, int firstRow, int firstCol) {
  for (int i = 0; i < 2; ++i)
    for (int j = 0; j < 2; ++j)
      (*this)(i, j) = elementOrUndefined(s, s.order(), s.order(), firstRow + i, firstCol + j);
}

double matr2_2::det() const { return m[0] * m[3] - m[1] * m[2]; }

matr2_2 matr2_2::operator*(const matr2_2& o) const {
  return matr2_2(m[0] * o.m[0] + m[1] * o.m[2], m[0] * o.m[1] + m[1] * o.m[3], m[2] * o.m[0] + m[3] * o.m[2],
                 m[2] * o.m[1] + m[3] * o.m[3]);
}

TAbstractPoint2<double> matr2_2::operator*(const TAbstractPoint2<double>& p) const {
  return TAbstractPoint2<double>(m[0] * p[0] + m[1] * p[1], m[2] * p[0] + m[3] * p[1]);
}

}  // namespace svy_math
