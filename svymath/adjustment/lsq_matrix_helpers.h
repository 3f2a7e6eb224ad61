#pragma once
// Matrix helpers around the least-squares engine (least_squares.h): the design matrix of observation
// equations by numerical differentiation, transposes and products of the engine's dense matrices, and the
// covariance of the adjusted unknowns.
#include <cstddef>
#include <functional>

#include "svymath/adjustment/least_squares.h"
#include "svymath/foundation/export.h"
#include "svyutils/svy_containers.h"

namespace svy_math {

// One observation equation: the value that observation `observation` (0-based) would have at the given
// unknowns (a distance, a direction, a height difference, in the observation's own unit).
using TObservationEquation = std::function<double(std::size_t observation, const svy_vector<double>& unknowns)>;

// The design matrix A (observations x unknowns) of the equations at the unknowns: element (i, j) is the
// derivative of observation i by unknown j, by the central difference over unknowns[j] +- steps[j]. Each
// step is in its unknown's unit and must suit its scale (1e-4 m for coordinates, 1e-7 rad for angles:
// small against the curvature of the equations, large against the rounding of the unknown; the central
// difference is then good to about step^2 times the third derivative). Returns false, a untouched, when
// there are no observations or no unknowns, the steps do not match the unknowns in number, a step is not
// positive and finite, or an equation gives a non-finite value.
SVYMATH_API bool GenerateATMatrix(const TObservationEquation& equations, std::size_t observations,
                                  const svy_vector<double>& unknowns, const svy_vector<double>& steps,
                                  TLsqMatrix& a);

// The transpose of m.
SVYMATH_API TLsqMatrix GenerateTransposeMatrix(const TLsqMatrix& m);

// product = left * right; false, product untouched, when left's columns differ from right's rows. product
// may be one of the operands.
SVYMATH_API bool ProdMat(const TLsqMatrix& left, const TLsqMatrix& right, TLsqMatrix& product);

// The covariance of the adjusted unknowns, sigma0^2 (A^T W A)^-1, with the variance factor a posteriori
// sigma0^2 = v^T W v / (m - n) from the residuals v (m x 1) of the m observations and the n unknowns of A
// (m x n). W (m x m, symmetric) is the weight matrix of the adjustment. On eLsqOk, covariance (n x n) and
// sigma0Squared are set; otherwise both are untouched and the status says why: eLsqTooFewObservations when
// there is no redundancy (m <= n), eLsqDimensionMismatch for shapes that do not fit, eLsqNotFinite for a
// non-finite element, eLsqSingular when A^T W A cannot be inverted.
// Multiplying W by a constant leaves the covariance unchanged; weights 1 / sigma_i^2 make sigma0^2 a test
// of the a priori sigmas (near 1 when they were right).
SVYMATH_API ELeastSquaresStatus ComputeCovMatrix(const TLsqMatrix& a, const TLsqMatrix& w,
                                                 const TLsqMatrix& residuals, TLsqMatrix& covariance,
                                                 double& sigma0Squared);
// The same for a linear problem and its solution X from leastSquares: the residuals are A X - Y. For a
// converged non-linear problem use the form above with A at the solution and the residuals -Y (Y being
// the misclosure, observed minus computed).
SVYMATH_API ELeastSquaresStatus ComputeCovMatrix(const TLeastSquaresData& data, const svy_vector<double>& solution,
                                                 TLsqMatrix& covariance, double& sigma0Squared);

}  // namespace svy_math
