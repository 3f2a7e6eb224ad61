#pragma once
// Weighted linear least squares and the Gauss-Newton iteration built on it.
//
// A problem is a data object that supplies the design matrix A (observations x unknowns), the observation
// vector Y (observations x 1) and the weight matrix W (observations x observations). The solution is
// X = (A^T W A)^-1 A^T W Y. For a non-linear problem, A and Y are evaluated at the current solution (Y is the
// misclosure) and X is the correction that Gauss-Newton adds to it until every unknown changes by no more
// than its convergence criterion.
#include <cstdint>

#include <boost/numeric/ublas/matrix.hpp>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svyutils/svy_containers.h"

namespace svy_math {

// Source name of the least-squares error-log entries.
constexpr const char* kLeastSquaresLogSource = "TLeastSquares";

enum ELeastSquaresStatus : std::int32_t {
  eLsqOk = 0,
  // Fewer observations than unknowns, or a best-fit initial guess without data or without a centre.
  eLsqTooFewObservations = 1,
  // Shapes of A, Y, W, the solution, a correction or the convergence criteria disagree.
  eLsqDimensionMismatch = 3,
  // The normal matrix A^T W A cannot be inverted (or a best-fit initial guess is degenerate).
  eLsqSingular = 4,
  // A correction was applied before any current solution existed.
  eLsqNoCurrentSolution = 6,
  // An element of A, Y or W, or of the solution, is not finite.
  eLsqNotFinite = 7,
  // Gauss-Newton reached its safety cap of iterations without meeting the convergence criteria.
  eLsqNoConvergence = 8,
};

// Dense row-major matrices of the engine.
using TLsqMatrix = boost::numeric::ublas::matrix<double>;

class SVYMATH_API TLeastSquaresData {
 public:
  SVY_CLASS_NEW_DELETE

  virtual ~TLeastSquaresData();
  // Design matrix, observations x unknowns.
  virtual TLsqMatrix getAMatrix() const = 0;
  // Observations (misclosures for a non-linear problem), observations x 1.
  virtual TLsqMatrix getYMatrix() const = 0;
  // Weights, observations x observations.
  virtual TLsqMatrix getWeightMatrix() const = 0;
};

class SVYMATH_API TNonLinearLeastSquaresData : public TLeastSquaresData {
 public:
  // Sets the first current solution; returns eLsqOk or why it cannot.
  virtual ELeastSquaresStatus computeInitialGuess() = 0;

  // One tolerance per unknown: converged when every unknown changed by at most |criterion|.
  void setConvergenceCriteria(const svy_vector<double>& criteria);
  bool isConvergenceSet() const { return m_hasConvergenceCriteria; }
  // Adds the correction to the current solution, keeping the old one as the previous solution.
  // eLsqNoCurrentSolution without a current solution; eLsqDimensionMismatch unless the correction, the
  // solution and the criteria have one length.
  ELeastSquaresStatus correctCurrentSolution(const svy_vector<double>& correction);
  // Copies the current solution; eLsqNoCurrentSolution (solution emptied) when there is none.
  ELeastSquaresStatus getCurrentSolution(svy_vector<double>& solution) const;
  bool hasCurrentSolution() const { return m_hasCurrentSolution; }
  // Whether the last correction changed every unknown by at most its criterion. False before any
  // correction; logged (and false unless criteria follow) when no criteria were set.
  bool hasConverged() const;
  // The rounding error of one misclosure at the current solution (its unit), for example the rounding of the
  // distances it is the difference of; 0 (the default) for misclosures taken as exact. Gauss-Newton ends
  // once a correction is no larger than this error carried into the unknowns.
  virtual double getMisclosureRounding() const;
  // Root mean square of the misclosures Y at the current solution; NaN without one.
  double getMisclosureRms() const;

 protected:
  // A new current solution: no correction applied to it yet.
  void setCurrentSolution(const svy_vector<double>& solution);
  void clearSolution();
  const svy_vector<double>& currentSolution() const { return m_currentSolution; }

 private:
  bool m_hasCurrentSolution = false;
  bool m_hasCorrection = false;
  bool m_hasConvergenceCriteria = false;
  svy_vector<double> m_convergenceCriteria;
  svy_vector<double> m_currentSolution;
  svy_vector<double> m_previousSolution;
};

// One weighted linear solution; solution is cleared and then receives X in order.
//
// W must be symmetric (a weight matrix is): the normal matrix is built from its lower triangle. Any
// non-finite element of A, Y or W gives eLsqNotFinite.
// A problem with an intercept column (one non-zero value in every row) is solved relative to the means of
// its other columns and of Y: the same solution exactly, without the digits that large coordinates cost
// the normal equations; a column that after this varies only by the rounding of its values (1e-10 of them)
// makes the problem singular (eLsqSingular).
// The normal matrix is inverted through its Cholesky factor; a pivot at or below 1e-14 of its diagonal
// element makes it singular (eLsqSingular). The solution is then refined by solving again for the residuals
// Y - A X (computed from the original A and Y): this recovers the digits that forming A^T W A loses when
// the unknowns are badly scaled, as for a line n = m e + b at E 500 000, and leaves a well-conditioned
// solution as it was.
SVYMATH_API ELeastSquaresStatus leastSquares(svy_vector<double>& solution, const TLeastSquaresData& data);

// Gauss-Newton from the data's initial guess until hasConverged(), or until a correction is within the
// rounding of the misclosures (getMisclosureRounding) carried into each unknown: criteria finer than the
// data's own precision end there instead of cycling. Each correction is a leastSquares() solution at the
// current solution; a failing step ends the loop with its status (eLsqNotFinite when a correction is not
// finite). The loop has no iteration limit of its own beyond a safety cap of 1000
// iterations (eLsqNoConvergence), a hundred times what a well-posed fit needs. solution receives the final
// current solution.
SVYMATH_API ELeastSquaresStatus gaussNewtonLeastSquares(svy_vector<double>& solution,
                                                        TNonLinearLeastSquaresData& data);

}  // namespace svy_math
