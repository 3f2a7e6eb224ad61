#include "svymath/adjustment/matrix_storage.h"

#include <cstdlib>
#include <cstring>
#include <limits>

#include "svymath/adjustment/matrix_accumulate.h"
#include "svymath/adjustment/matrix_products.h"

namespace svy_math {

int LOC1(int i, int j, int n, int /*m*/, int storageMode) {
  if (storageMode < kStorageSymmetric) return (j - 1) * n + i;
  if (storageMode == kStorageSymmetric) return i < j ? (j - 1) * j / 2 + i : (i - 1) * i / 2 + j;
  return i == j ? i : 0;
}

namespace {

// Number of doubles to allocate for count elements: at least one, so that data() is never null. A count
// beyond the int range gives 0 (nothing can be allocated).
int allocationCount(long long count) {
  if (count <= 0) return 1;
  if (count > std::numeric_limits<int>::max() / static_cast<int>(sizeof(double))) return 0;
  return static_cast<int>(count);
}

double* allocateDoubles(int count) {
  if (count <= 0) return nullptr;
  return static_cast<double*>(std::malloc(static_cast<std::size_t>(count) * sizeof(double)));
}

void fill(double* data, int count, double value) {
  for (int k = 0; k < count; ++k) data[k] = value;
}

}  // namespace

// ---- TMatrix ----

TMatrix::TMatrix() { allocate(0, 0); }

TMatrix::TMatrix(int rows, int cols, int noInit) {
  allocate(rows, cols);
  if (noInit == 0) fill(m_data, m_allocated, 0.0);
}

TMatrix::TMatrix(const TMatrix& other) {
  allocate(other.m_rows, other.m_cols);
  if (m_data != nullptr) std::memcpy(m_data, other.m_data, static_cast<std::size_t>(m_allocated) * sizeof(double));
}

TMatrix& TMatrix::operator=(const TMatrix& other) {
  if (this == &other) return *this;
  if (m_rows != other.m_rows || m_cols != other.m_cols) {
    if (m_ownsData != 0) std::free(m_data);
    allocate(other.m_rows, other.m_cols);
  }
  if (m_data != nullptr) std::memcpy(m_data, other.m_data, static_cast<std::size_t>(m_allocated) * sizeof(double));
  return *this;
}

TMatrix::~TMatrix() {
  if (m_ownsData != 0) std::free(m_data);
}

TMatrix& TMatrix::operator=(int value) { return *this = static_cast<double>(value); }

TMatrix& TMatrix::operator=(double value) {
  fill(m_data, m_rows * m_cols, value);
  return *this;
}

void TMatrix::allocate(int rows, int cols) {
  rows = rows < 0 ? 0 : rows;
  cols = cols < 0 ? 0 : cols;
  m_allocated = allocationCount(static_cast<long long>(rows) * cols);
  m_data = allocateDoubles(m_allocated);
  if (m_data == nullptr) {
    rows = cols = 0;
    m_allocated = 0;
  }
  m_ownsData = 1;
  m_rows = rows;
  m_cols = cols;
}

TMatrix TMatrix::SubMatrix(int firstRow, int firstCol, int nRows, int nCols) const {
  TMatrix block(nRows, nCols);
  for (int j = 1; j <= block.m_cols; ++j) {
    const int col = firstCol + j - 1;
    if (col < 1 || col > m_cols) continue;
    for (int i = 1; i <= block.m_rows; ++i) {
      const int row = firstRow + i - 1;
      if (row >= 1 && row <= m_rows) block(i, j) = (*this)(row, col);
    }
  }
  return block;
}

// ---- TSMatrix ----

TSMatrix::TSMatrix() { allocate(0); }

TSMatrix::TSMatrix(int n, int noInit) {
  allocate(n);
  if (noInit == 0) fill(m_data, packedSize(), 0.0);
}

TSMatrix::TSMatrix(const TSMatrix& other) {
  allocate(other.m_n);
  if (m_data != nullptr && packedSize() > 0)
    std::memcpy(m_data, other.m_data, static_cast<std::size_t>(packedSize()) * sizeof(double));
}

TSMatrix& TSMatrix::operator=(const TSMatrix& other) {
  if (this == &other) return *this;
  if (m_n != other.m_n) {
    if (m_ownsData != 0) std::free(m_data);
    allocate(other.m_n);
  }
  if (m_data != nullptr && packedSize() > 0)
    std::memcpy(m_data, other.m_data, static_cast<std::size_t>(packedSize()) * sizeof(double));
  return *this;
}

TSMatrix::~TSMatrix() {
  if (m_ownsData != 0) std::free(m_data);
}

TSMatrix& TSMatrix::operator=(int value) { return *this = static_cast<double>(value); }

TSMatrix& TSMatrix::operator=(double value) {
  fill(m_data, packedSize(), value);
  return *this;
}

void TSMatrix::allocate(int n) {
  n = n < 0 ? 0 : n;
  const int count = allocationCount(static_cast<long long>(n) * (n + 1) / 2);
  m_data = allocateDoubles(count);
  if (m_data == nullptr) n = 0;
  m_ownsData = 1;
  m_n = n;
  m_n2 = n;
}

bool TSMatrix::BlockOper(int firstRow, int firstCol, const TMatrix& block, char op) {
  if (!detail::isAccumulationOperator(op) || firstRow < 1 || firstCol < 1) return false;
  if (firstRow + block.rows() - 1 > m_n || firstCol + block.cols() - 1 > m_n) return false;
  for (int j = 1; j <= block.cols(); ++j) {
    const int col = firstCol + j - 1;
    for (int i = 1; i <= block.rows(); ++i) {
      const int row = firstRow + i - 1;
      // (row, col) and (col, row) share one element: when the mirror lies in the block too, only the
      // lower-triangle member (row >= col) is applied.
      const int mirrorI = col - firstRow + 1;
      const int mirrorJ = row - firstCol + 1;
      const bool mirrorInBlock = mirrorI >= 1 && mirrorI <= block.rows() && mirrorJ >= 1 && mirrorJ <= block.cols();
      if (mirrorInBlock && row < col) continue;
      detail::accumulate((*this)(row, col), block(i, j), op);
    }
  }
  return true;
}

TMatrix TSMatrix::MatrProduct(const TMatrix& r) const {
  TMatrix product(m_n, r.cols());
  if (MATRopS_R(product, *this, r, kOpAssign) != 0) return TMatrix();
  return product;
}

TSMatrix TSMatrix::A_This_At(const TMatrix& a) const {
  TSMatrix product(a.rows());
  if (SMATRopR_S_Rt(product, a, *this, kOpAssign) != 0) return TSMatrix();
  return product;
}

}  // namespace svy_math
