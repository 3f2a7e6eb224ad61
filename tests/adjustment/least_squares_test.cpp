#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "svymath/adjustment/least_squares.h"
#include "svyutils/svy_err_log.h"

using svy_math::ELeastSquaresStatus;
using svy_math::TLsqMatrix;

namespace {

// A linear problem given by its matrices.
class TMatrixData : public svy_math::TLeastSquaresData {
 public:
  TMatrixData(TLsqMatrix a, TLsqMatrix y, TLsqMatrix w) : a_(std::move(a)), y_(std::move(y)), w_(std::move(w)) {}
  TLsqMatrix getAMatrix() const override { return a_; }
  TLsqMatrix getYMatrix() const override { return y_; }
  TLsqMatrix getWeightMatrix() const override { return w_; }

 private:
  TLsqMatrix a_, y_, w_;
};

TLsqMatrix matrix(std::size_t rows, std::size_t cols, std::initializer_list<double> values) {
  TLsqMatrix m(rows, cols);
  auto it = values.begin();
  for (std::size_t i = 0; i < rows; ++i)
    for (std::size_t j = 0; j < cols; ++j) m(i, j) = *it++;
  return m;
}

TLsqMatrix identity(std::size_t n) { return boost::numeric::ublas::identity_matrix<double>(n); }

TEST(LeastSquares, ReportsShapeRankAndFiniteProblemsWithAnEmptySolution) {
  const struct {
    const char* name;
    TLsqMatrix a, y, w;
    ELeastSquaresStatus expected;
  } cases[] = {
      {"one point two unknowns", matrix(1, 2, {1, 1}), matrix(1, 1, {3}), identity(1),
       svy_math::eLsqTooFewObservations},
      {"rows differ", matrix(2, 2, {1, 1, 2, 1}), matrix(3, 1, {1, 2, 3}), identity(2),
       svy_math::eLsqDimensionMismatch},
      {"two observation columns", matrix(2, 1, {1, 1}), matrix(2, 2, {1, 2, 3, 4}), identity(2),
       svy_math::eLsqDimensionMismatch},
      {"weights of another size", matrix(2, 1, {1, 1}), matrix(2, 1, {1, 2}), identity(3),
       svy_math::eLsqDimensionMismatch},
      {"equal columns", matrix(3, 2, {1, 1, 2, 2, 3, 3}), matrix(3, 1, {1, 2, 4}), identity(3), svy_math::eLsqSingular},
      {"zero weights", matrix(2, 1, {1, 1}), matrix(2, 1, {1, 2}), TLsqMatrix(2, 2, 0.0), svy_math::eLsqSingular},
      {"NaN in design", matrix(2, 1, {1, std::nan("")}), matrix(2, 1, {1, 2}), identity(2), svy_math::eLsqNotFinite},
      {"infinite observation", matrix(2, 1, {1, 1}), matrix(2, 1, {1, INFINITY}), identity(2), svy_math::eLsqNotFinite},
  };
  for (const auto& c : cases) {
    svy_vector<double> solution{99.0};
    EXPECT_EQ(svy_math::leastSquares(solution, TMatrixData(c.a, c.y, c.w)), c.expected) << c.name;
    EXPECT_TRUE(solution.empty()) << c.name;
  }
}

// Two observations of two unknowns solve exactly; consistent observations under correlated positive-definite
// weights give the generating unknowns; repeated measurements with weights 1/sigma^2 give the weighted mean.
TEST(LeastSquares, SolvesExactConsistentAndWeightedProblems) {
  svy_vector<double> solution;
  ASSERT_EQ(
      svy_math::leastSquares(solution, TMatrixData(matrix(2, 2, {1, 1, 2, 1}), matrix(2, 1, {3, 5}), identity(2))),
      svy_math::eLsqOk);
  ASSERT_EQ(solution.size(), 2U);
  EXPECT_NEAR(solution[0], 2.0, 1e-15);
  EXPECT_NEAR(solution[1], 1.0, 1e-15);

  std::mt19937 rng(7);
  std::uniform_real_distribution<double> value(-1.0, 1.0);
  const std::size_t m = 12;
  TLsqMatrix a(m, 3), b(m, m), x = matrix(3, 1, {1.5, -2.25, 1e3});
  for (double& element : a.data()) element = value(rng);
  for (double& element : b.data()) element = value(rng);
  const TLsqMatrix w = boost::numeric::ublas::prod(boost::numeric::ublas::trans(b), b) + identity(m);
  ASSERT_EQ(svy_math::leastSquares(solution, TMatrixData(a, boost::numeric::ublas::prod(a, x), w)), svy_math::eLsqOk);
  for (int j = 0; j < 3; ++j) EXPECT_NEAR(solution[j], x(j, 0), 1e-10 * (1.0 + std::fabs(x(j, 0))));

  const double values[4] = {10.02, 10.05, 9.98, 10.00}, weights[4] = {1.0, 4.0, 0.25, 2.0};
  TLsqMatrix y(4, 1), wd(4, 4, 0.0);
  for (std::size_t i = 0; i < 4; ++i) y(i, 0) = values[i], wd(i, i) = weights[i];
  ASSERT_EQ(svy_math::leastSquares(solution, TMatrixData(TLsqMatrix(4, 1, 1.0), y, wd)), svy_math::eLsqOk);
  EXPECT_NEAR(solution[0], (10.02 + 4 * 10.05 + 0.25 * 9.98 + 2 * 10.00) / 7.25, 1e-14);
}

// A one-unknown non-linear problem whose misclosure is a given function of the current solution: the root
// of x^2 = 2, a correction of 1 at every step, or a misclosure that overflows after two steps.
class TScalarProblem : public svy_math::TNonLinearLeastSquaresData {
 public:
  enum class Kind { kSqrtTwo, kNeverSettles, kDiverges };
  explicit TScalarProblem(Kind kind) : kind_(kind) {}
  ELeastSquaresStatus computeInitialGuess() override {
    setCurrentSolution(svy_vector<double>{1.0});
    return svy_math::eLsqOk;
  }
  TLsqMatrix getAMatrix() const override { return TLsqMatrix(1, 1, kind_ == Kind::kSqrtTwo ? 2.0 * x() : 1.0); }
  TLsqMatrix getYMatrix() const override {
    return TLsqMatrix(1, 1,
                      kind_ == Kind::kSqrtTwo        ? 2.0 - x() * x()
                      : kind_ == Kind::kNeverSettles ? 1.0
                                                     : x() * 1e200);
  }
  TLsqMatrix getWeightMatrix() const override { return TLsqMatrix(1, 1, 1.0); }

 private:
  double x() const { return currentSolution()[0]; }
  Kind kind_;
};

// Criteria of the wrong size are refused; criteria that can never be met (or NaN) end at the safety cap
// instead of looping; a diverging run ends as not finite with an empty solution.
TEST(GaussNewton, ConvergesToTheRootOrReportsWhyNot) {
  using Kind = TScalarProblem::Kind;
  const struct {
    Kind kind;
    std::vector<double> criteria;
    ELeastSquaresStatus expected;
  } cases[] = {{Kind::kSqrtTwo, {1e-14}, svy_math::eLsqOk},
               {Kind::kSqrtTwo, {}, svy_math::eLsqDimensionMismatch},
               {Kind::kSqrtTwo, {1e-9, 1e-9}, svy_math::eLsqDimensionMismatch},
               {Kind::kNeverSettles, {0.5}, svy_math::eLsqNoConvergence},
               {Kind::kSqrtTwo, {std::nan("")}, svy_math::eLsqNoConvergence},
               {Kind::kDiverges, {1e-9}, svy_math::eLsqNotFinite}};
  for (const auto& c : cases) {
    TScalarProblem problem(c.kind);
    if (!c.criteria.empty()) problem.setConvergenceCriteria(svy_vector<double>(c.criteria.begin(), c.criteria.end()));
    svy_vector<double> solution;
    ASSERT_EQ(svy_math::gaussNewtonLeastSquares(solution, problem), c.expected) << static_cast<int>(c.kind);
    if (c.expected == svy_math::eLsqOk) {
      EXPECT_NEAR(solution[0], std::sqrt(2.0), 1e-15);
      EXPECT_TRUE(problem.hasConverged());
    }
    if (c.expected == svy_math::eLsqNotFinite) {
      EXPECT_TRUE(solution.empty());
    }
  }
}

// Without a current solution corrections are refused and the convergence test logs; the bound of the test
// is the absolute value of the criterion and is inclusive.
TEST(NonLinearData, CorrectionStateAndConvergenceTest) {
  TScalarProblem problem(TScalarProblem::Kind::kSqrtTwo);
  EXPECT_EQ(problem.correctCurrentSolution(svy_vector<double>{0.1}), svy_math::eLsqNoCurrentSolution);
  svy_vector<double> current{5.0};
  EXPECT_EQ(problem.getCurrentSolution(current), svy_math::eLsqNoCurrentSolution);
  EXPECT_TRUE(current.empty());
  {
    svy_logging::CScopedErrLogCapture log;
    EXPECT_FALSE(problem.hasConverged());
    ASSERT_EQ(log.count(), 1U);
    EXPECT_TRUE(log.entries()[0].file == "TLeastSquares" && log.entries()[0].line == 76);
  }
  problem.setConvergenceCriteria(svy_vector<double>{-0.25});
  ASSERT_EQ(problem.computeInitialGuess(), svy_math::eLsqOk);
  EXPECT_FALSE(problem.hasConverged());  // no correction yet
  EXPECT_EQ(problem.correctCurrentSolution(svy_vector<double>{0.1, 0.0}), svy_math::eLsqDimensionMismatch);
  ASSERT_EQ(problem.correctCurrentSolution(svy_vector<double>{0.5}), svy_math::eLsqOk);
  EXPECT_FALSE(problem.hasConverged());
  ASSERT_EQ(problem.correctCurrentSolution(svy_vector<double>{-0.25}), svy_math::eLsqOk);
  EXPECT_TRUE(problem.hasConverged());
  ASSERT_EQ(problem.getCurrentSolution(current), svy_math::eLsqOk);
  EXPECT_EQ(current[0], 1.25);
}

}  // namespace
