#pragma once
// A symmetric 3x3 covariance packed as its lower triangle row by row (the packing of LOC1 storage mode 1):
// c[0] = (1,1), c[1] = (2,1), c[2] = (2,2), c[3] = (3,1), c[4] = (3,2), c[5] = (3,3).
#include "svymath/adjustment/matr3_3.h"
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"

namespace svy_math {

class SVYMATH_API covar {
 public:
  SVY_CLASS_NEW_DELETE

  // The zero matrix.
  covar();
  // The six packed elements: (1,1), (2,1), (2,2), (3,1), (3,2), (3,3).
  covar(double c11, double c21, double c22, double c31, double c32, double c33);
  // Element (i, j) of the triangle is m(i, j) + m(j, i), without halving: meant for a matrix that holds
  // each off-diagonal term once (in either triangle). A full symmetric matrix comes out doubled, its
  // diagonal included.
  explicit covar(const matr3_3& m);

  // Element (row, col), 0-based, either triangle.
  double& operator()(int row, int col) { return c[packedIndex(row, col)]; }
  double operator()(int row, int col) const { return c[packedIndex(row, col)]; }

  // Adds (subtracts) the symmetric part (m + m^T) / 2 of m, which is m itself for a symmetric m.
  covar& operator+=(const matr3_3& m);
  covar& operator-=(const matr3_3& m);
  // The product of the full matrix with a vector.
  TAbstractPoint3<double> operator*(const TAbstractPoint3<double>& p) const;

  // Cyclic threshold Jacobi eigen-decomposition. Returns the eigenvectors as the columns of the matrix and
  // leaves the eigenvalues on this covariance's diagonal, column j of the result belonging to diagonal
  // element j (in the order the rotations leave them, not sorted). A matrix whose off-diagonal elements
  // are zero (relative to its largest element) is left as it is with the identity returned. A matrix with a
  // non-finite element is left unchanged and the result is undefined (NaN).
  matr3_3 eigen();
  // The semi-axes of the error ellipsoid for a confidence factor k (1 for the standard ellipsoid, 2.7955
  // for 95 % in 3-D): k * sqrt(eigenvalue), largest first; a slightly negative eigenvalue (rounding of a
  // semi-definite covariance) gives 0, a non-finite element NaN axes. This covariance is not changed.
  TAbstractPoint3<double> GetEigen(double confidenceFactor) const;
  // The rotation from the eigen frame to this covariance's frame (the derivative of user coordinates by
  // eigen coordinates): its columns are the unit eigenvectors, largest eigenvalue first, with the third
  // column chosen so that the frame is right-handed (determinant +1). This covariance is not changed.
  matr3_3 DuserDeigen() const;

  double c[6];

 private:
  static int packedIndex(int row, int col) {
    return row >= col ? row * (row + 1) / 2 + col : col * (col + 1) / 2 + row;
  }
};

}  // namespace svy_math
