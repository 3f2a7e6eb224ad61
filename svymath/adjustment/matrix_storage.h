#pragma once
// Dense and packed-symmetric matrices of doubles addressed 1-based, in the storage modes of the classic
// scientific subroutines:
//   mode 0  general matrix, column by column: element (i, j) of an n-row matrix is at (j - 1) * n + i;
//   mode 1  symmetric matrix, one triangle packed: (1,1), (2,1), (2,2), (3,1), (3,2), (3,3), ...
//           (the lower triangle row by row, which is the upper triangle column by column);
//   mode 2  diagonal matrix: only (i, i) is stored, at position i.
// Positions are 1-based as well; subtract 1 to index the C array.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"

namespace svy_math {

// Storage modes of LOC1.
constexpr int kStorageGeneral = 0;
constexpr int kStorageSymmetric = 1;
constexpr int kStorageDiagonal = 2;

// 1-based position of element (i, j) of a matrix with n rows (m columns, not needed by any mode) stored in
// storageMode: mode < 1 general, 1 symmetric packed, >= 2 diagonal (0 for an element that is not stored).
SVYMATH_API int LOC1(int i, int j, int n, int m, int storageMode);

class TSMatrix;

// A general rows x cols matrix stored column by column in a block from the C allocator. Elements are
// addressed 1-based: m(i, j) with 1 <= i <= rows, 1 <= j <= cols (not range checked, like an array).
class SVYMATH_API TMatrix {
 public:
  SVY_CLASS_NEW_DELETE

  // An empty 0 x 0 matrix (one element is still allocated, as for every empty size).
  TMatrix();
  // A rows x cols matrix; the elements are zero unless noInit is non-zero. Negative sizes count as 0.
  TMatrix(int rows, int cols, int noInit = 0);
  TMatrix(const TMatrix& other);
  TMatrix& operator=(const TMatrix& other);
  ~TMatrix();

  // Every element takes the value.
  TMatrix& operator=(int value);
  TMatrix& operator=(double value);

  int rows() const { return m_rows; }
  int cols() const { return m_cols; }
  double& operator()(int i, int j) { return m_data[(j - 1) * m_rows + (i - 1)]; }
  double operator()(int i, int j) const { return m_data[(j - 1) * m_rows + (i - 1)]; }
  double* data() { return m_data; }
  const double* data() const { return m_data; }

  // The nRows x nCols block whose first element is (firstRow, firstCol) of this matrix; elements of the
  // block that fall outside this matrix are 0.
  TMatrix SubMatrix(int firstRow, int firstCol, int nRows, int nCols) const;

 private:
  void allocate(int rows, int cols);

  int m_ownsData = 0;
  int m_allocated = 0;
  int m_rows = 0;
  int m_cols = 0;
  double* m_data = nullptr;
};

// A symmetric n x n matrix with one triangle packed (storage mode 1), n(n + 1)/2 doubles from the C
// allocator. s(i, j) and s(j, i) are the same element.
class SVYMATH_API TSMatrix {
 public:
  SVY_CLASS_NEW_DELETE

  TSMatrix();
  // An n x n matrix; the elements are zero unless noInit is non-zero. A negative order counts as 0.
  explicit TSMatrix(int n, int noInit = 0);
  TSMatrix(const TSMatrix& other);
  TSMatrix& operator=(const TSMatrix& other);
  ~TSMatrix();

  TSMatrix& operator=(int value);
  TSMatrix& operator=(double value);

  int order() const { return m_n; }
  // Number of stored elements, n(n + 1)/2.
  int packedSize() const { return m_n * (m_n + 1) / 2; }
  double& operator()(int i, int j) { return m_data[LOC1(i, j, m_n, m_n, kStorageSymmetric) - 1]; }
  double operator()(int i, int j) const { return m_data[LOC1(i, j, m_n, m_n, kStorageSymmetric) - 1]; }
  double* data() { return m_data; }
  const double* data() const { return m_data; }

  // Applies a block to the elements starting at (firstRow, firstCol) with the accumulation operator op
  // ('=' set, '+' add, '-' subtract; see matrix_products.h). An element met twice through symmetry (both
  // (i, j) and (j, i) lie in the block) is taken once, from the block's lower triangle, so a symmetric
  // block on the diagonal is applied as itself. Returns false, changing nothing, when the block does not
  // fit or op is unknown.
  bool BlockOper(int firstRow, int firstCol, const TMatrix& block, char op);
  // This matrix times r (n x k), a general n x k matrix; a 0 x 0 matrix when r does not have n rows.
  TMatrix MatrProduct(const TMatrix& r) const;
  // The symmetric product a * this * a^T for a (k x n); a 0 x 0 matrix when the shapes do not match.
  TSMatrix A_This_At(const TMatrix& a) const;

 private:
  void allocate(int n);

  unsigned char m_ownsData = 0;
  int m_n = 0;
  int m_n2 = 0;
  double* m_data = nullptr;
};

}  // namespace svy_math
