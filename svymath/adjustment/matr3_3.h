#pragma once
// A fixed 3x3 matrix, nine doubles row by row, addressed 0-based: m(row, col). Used for frame rotations
// and covariance propagation (see covar.h).
#include "svymath/adjustment/matrix_storage.h"
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"

namespace svy_math {

class covar;

class SVYMATH_API matr3_3 {
 public:
  SVY_CLASS_NEW_DELETE

  // Operations of the constructor from another matrix.
  static constexpr char kTranspose = 't';
  static constexpr char kInverse = static_cast<char>(-1);

  // The zero matrix.
  matr3_3();
  matr3_3(double a00, double a01, double a02, double a10, double a11, double a12, double a20, double a21,
          double a22);
  static matr3_3 identity();
  // kTranspose gives the transpose. kInverse gives the inverse: the adjugate of cofactors divided by the
  // determinant, which is expanded along the first column; a determinant strictly within +-1e-12 gives
  // the zero matrix (no error is reported). Any other op leaves every element undefined (NaN).
  matr3_3(const matr3_3& m, char op);
  // The full symmetric matrix of a packed covariance.
  explicit matr3_3(const covar& c);
  // The 3x3 block of r (or s) whose first element is (firstRow, firstCol), 1-based; elements outside the
  // source are undefined (NaN).
  matr3_3(const TMatrix& r, int firstRow, int firstCol);
  matr3_3(const TSMatrix& s, int firstRow, int firstCol);

  double& operator()(int row, int col) { return m[row * 3 + col]; }
  double operator()(int row, int col) const { return m[row * 3 + col]; }

  double det() const;
  matr3_3 operator*(const matr3_3& other) const;
  TAbstractPoint3<double> operator*(const TAbstractPoint3<double>& p) const;
  // The propagated covariance this * c * this^T.
  covar operator&(const covar& c) const;

  double m[9];
};

}  // namespace svy_math
