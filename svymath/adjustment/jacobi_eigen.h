#pragma once
// The cyclic threshold Jacobi method for a symmetric matrix in packed storage (LOC1 mode 1), after the
// EIGEN routine of the classic scientific subroutines. Internal to the adjustment subsystem.
namespace svy_math {
namespace detail {

// Diagonalises the packed n x n matrix a (n(n + 1)/2 doubles) in place and writes the eigenvectors as the
// columns of vectors (n * n doubles, column by column): column j belongs to the eigenvalue left at a(j, j).
// The eigenvalues are not sorted. Returns false, with a unchanged and vectors set to the identity, when an
// element is not finite; returns false as well when a sweep cap was reached (a still holds the rotated
// matrix, which is then only partly diagonal).
bool jacobiEigenPacked(double* a, double* vectors, int n);

}  // namespace detail
}  // namespace svy_math
