#pragma once
// Tests and inversions of symmetric matrices in packed storage.
#include "svymath/adjustment/covar.h"
#include "svymath/adjustment/matrix_storage.h"
#include "svymath/foundation/export.h"

namespace svy_math {

// Cholesky test of s (upper factor u, s = u^T u, row by row): returns 1 when s is positive definite and
// every 1/sqrt(pivot) is at most maxFactor (no pivot smaller than 1/maxFactor^2), else 0. Elements of u
// within +-1e-15 are skipped as zeros. s is overwritten by the factor: each diagonal element by
// 1/sqrt(pivot), the rest of its row by the factor's elements (the work stops at the first pivot <= 0).
SVYMATH_API int CanInvert(TSMatrix& s, double maxFactor);

// Inverts a packed 3x3 symmetric matrix in place by its adjugate. Returns 0 for a positive-definite
// inverse, -1 when |determinant| < 1e-60 (c unchanged), -2 when the inverse is stored but is not positive
// definite (determinant or a diagonal element not positive).
SVYMATH_API int InvertSMatr3(covar& c);

// Inverts a positive-definite s in place through a Cholesky factorisation that follows each row's profile
// (its first non-zero element), so banded and sparse normal matrices factor cheaply. When index is not
// null it receives, for each of the first indexSize rows, the 1-based column of the row's first non-zero
// element. Returns 0, or -1 (s unchanged) when s is singular, not positive definite or not finite.
SVYMATH_API int RareInversion(TSMatrix& s, int* index, int indexSize);

// The Moore-Penrose pseudo-inverse of s, in place, from its Jacobi eigen-decomposition: the inverse on the
// space of the eigenvalues kept, zero on the others. rankDefect >= 0 drops that many eigenvalues of smallest
// magnitude; rankDefect < 0 drops those at or below 1e-12 of the largest magnitude. Returns the rank kept,
// or -1 (s unchanged) when rankDefect exceeds the order or s is not finite.
SVYMATH_API int PseudoInversion(TSMatrix& s, int rankDefect);

}  // namespace svy_math
