#pragma once
// A fixed 2x2 matrix, four doubles row by row, addressed 0-based: m(row, col).
#include "svymath/adjustment/matrix_storage.h"
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"

namespace svy_math {

class SVYMATH_API matr2_2 {
 public:
  SVY_CLASS_NEW_DELETE

  // Operations of the constructor from another matrix.
  static constexpr char kTranspose = 't';
  static constexpr char kInverse = static_cast<char>(-1);

  // The zero matrix.
  matr2_2();
  matr2_2(double a00, double a01, double a10, double a11);
  // kTranspose gives the transpose, kInverse the inverse (all zeros when the determinant lies strictly
  // within +-1e-12); any other op leaves every element undefined (NaN).
  matr2_2(const matr2_2& m, char op);
  // The 2x2 block of r (or s) whose first element is (firstRow, firstCol), 1-based; elements outside the
  // source are undefined (NaN).
  matr2_2(const TMatrix& r, int firstRow, int firstCol);
  matr2_2(const TSMatrix& s, int firstRow, int firstCol);

  double& operator()(int row, int col) { return m[row * 2 + col]; }
  double operator()(int row, int col) const { return m[row * 2 + col]; }

  double det() const;
  matr2_2 operator*(const matr2_2& other) const;
  TAbstractPoint2<double> operator*(const TAbstractPoint2<double>& p) const;

  double m[4];
};

}  // namespace svy_math
