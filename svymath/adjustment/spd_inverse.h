#pragma once
// Inversion of a symmetric positive-definite matrix by its Cholesky factor, in packed storage (LOC1 mode 1).
// Internal to the adjustment subsystem: the normal equations of least squares, the weights of averaged
// coordinates and RareInversion share it.
namespace svy_math {
namespace detail {

// Replaces the packed n x n matrix a by its inverse and returns true. The factorisation follows each row's
// profile (its first non-zero element): no fill-in occurs to the left of it, so banded and sparse matrices
// factor cheaply. Returns false, with a unchanged, when an element is not finite or a pivot is at or below
// relativePivotZero times its original diagonal element (singular or not positive definite).
bool invertPositiveDefinitePacked(double* a, int n, double relativePivotZero);

// 1-based column of the first non-zero element of row i (1-based) of the packed matrix (i for a row that is
// zero left of the diagonal).
int packedRowProfile(const double* a, int i);

}  // namespace detail
}  // namespace svy_math
