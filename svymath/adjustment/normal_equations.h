#pragma once
// The normal equations of weighted least squares, shared by the solver and the covariance of its unknowns.
// Internal to the adjustment subsystem.
#include <vector>

#include "svymath/adjustment/least_squares.h"

namespace svy_math {
namespace detail {

// For A with m rows: eLsqDimensionMismatch unless W is m x m, eLsqNotFinite when an element of A, Y (the
// observations or residuals) or W is not finite, else eLsqOk.
ELeastSquaresStatus checkWeightsAndValues(const TLsqMatrix& a, const TLsqMatrix& y, const TLsqMatrix& w);

// A^T W (n x m), skipping the zero weights (W is mostly diagonal).
TLsqMatrix weightedTranspose(const TLsqMatrix& a, const TLsqMatrix& w);

// The inverse of the normal matrix N = (A^T W) A, packed (LOC1 mode 1, n(n + 1)/2 elements), formed from
// the lower triangle of N, so W must be symmetric. False when N is singular (see leastSquares).
bool invertNormalMatrix(const TLsqMatrix& atw, const TLsqMatrix& a, std::vector<double>& packedInverse);

// 0-based index of element (i, j) of a packed symmetric matrix.
std::size_t packedIndex(std::size_t i, std::size_t j);

}  // namespace detail
}  // namespace svy_math
