#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "svymath/adjustment/least_squares.h"
#include "svyutils/svy_err_log.h"

using svy_math::ELeastSquaresStatus;
using svy_math::TLsqMatrix;

namespace {

// A linear problem given by its matrices.
class TMatrixData : public svy_math::TLeastSquaresData {
 public:
  TMatrixData(TLsqMatrix a, TLsqMatrix y) : a_(std::move(a)), y_(std::move(y)), w_(identity(a_.size1())) {}
  TMatrixData(TLsqMatrix a, TLsqMatrix y, TLsqMatrix w) : a_(std::move(a)), y_(std::move(y)), w_(std::move(w)) {}
  TLsqMatrix getAMatrix() const override { return a_; }
  TLsqMatrix getYMatrix() const override { return y_; }
  TLsqMatrix getWeightMatrix() const override { return w_; }
  static TLsqMatrix identity(std::size_t n) {
    TLsqMatrix w(n, n, 0.0);
    for (std::size_t i = 0; i < n; ++i) w(i, i) = 1.0;
    return w;
  }

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

struct StatusCase {
  const char* name;
  TLsqMatrix a, y, w;
  ELeastSquaresStatus expected;
};

class LeastSquaresStatus : public ::testing::TestWithParam<StatusCase> {};

TEST_P(LeastSquaresStatus, ReportsShapeAndRankProblems) {
  const StatusCase& c = GetParam();
  const TMatrixData data(c.a, c.y, c.w);
  svy_vector<double> solution{99.0};
  EXPECT_EQ(svy_math::leastSquares(solution, data), c.expected);
  EXPECT_TRUE(solution.empty());
}

const double kNaN = std::nan("");
const StatusCase kStatusCases[] = {
    {"one point two unknowns", matrix(1, 2, {1, 1}), matrix(1, 1, {3}), TMatrixData::identity(1),
     svy_math::eLsqTooFewObservations},
    {"rows differ", matrix(2, 2, {1, 1, 2, 1}), matrix(3, 1, {1, 2, 3}), TMatrixData::identity(2),
     svy_math::eLsqDimensionMismatch},
    {"two observation columns", matrix(2, 1, {1, 1}), matrix(2, 2, {1, 2, 3, 4}), TMatrixData::identity(2),
     svy_math::eLsqDimensionMismatch},
    {"weights of another size", matrix(2, 1, {1, 1}), matrix(2, 1, {1, 2}), TMatrixData::identity(3),
     svy_math::eLsqDimensionMismatch},
    {"equal columns", matrix(3, 2, {1, 1, 2, 2, 3, 3}), matrix(3, 1, {1, 2, 4}), TMatrixData::identity(3),
     svy_math::eLsqSingular},
    {"zero weights", matrix(2, 1, {1, 1}), matrix(2, 1, {1, 2}), TLsqMatrix(2, 2, 0.0), svy_math::eLsqSingular},
    {"NaN in design", matrix(2, 1, {1, kNaN}), matrix(2, 1, {1, 2}), TMatrixData::identity(2),
     svy_math::eLsqNotFinite},
    {"infinite observation", matrix(2, 1, {1, 1}), matrix(2, 1, {1, INFINITY}), TMatrixData::identity(2),
     svy_math::eLsqNotFinite},
};

INSTANTIATE_TEST_SUITE_P(Table, LeastSquaresStatus, ::testing::ValuesIn(kStatusCases),
                         [](const ::testing::TestParamInfo<StatusCase>& param) {
                           std::string name = param.param.name;
                           for (char& ch : name)
                             if (ch == ' ') ch = '_';
                           return name;
                         });

TEST(LeastSquares, TwoObservationsTwoUnknownsSolveExactly) {
  const TMatrixData data(matrix(2, 2, {1, 1, 2, 1}), matrix(2, 1, {3, 5}));
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::leastSquares(solution, data), svy_math::eLsqOk);
  ASSERT_EQ(solution.size(), 2U);
  EXPECT_NEAR(solution[0], 2.0, 1e-15);
  EXPECT_NEAR(solution[1], 1.0, 1e-15);
}

// Consistent observations under any positive-definite (correlated) weights give the generating unknowns.
TEST(LeastSquares, ConsistentObservationsRecoverUnknownsUnderCorrelatedWeights) {
  std::mt19937 rng(7);
  std::uniform_real_distribution<double> value(-1.0, 1.0);
  const std::size_t m = 12;
  TLsqMatrix a(m, 3);
  for (std::size_t i = 0; i < m; ++i)
    for (std::size_t j = 0; j < 3; ++j) a(i, j) = value(rng);
  const double x[3] = {1.5, -2.25, 1e3};
  TLsqMatrix y(m, 1);
  for (std::size_t i = 0; i < m; ++i) y(i, 0) = a(i, 0) * x[0] + a(i, 1) * x[1] + a(i, 2) * x[2];
  TLsqMatrix b(m, m);
  for (std::size_t i = 0; i < m; ++i)
    for (std::size_t j = 0; j < m; ++j) b(i, j) = value(rng);
  TLsqMatrix w = boost::numeric::ublas::prod(boost::numeric::ublas::trans(b), b);
  for (std::size_t i = 0; i < m; ++i) w(i, i) += 1.0;
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::leastSquares(solution, TMatrixData(a, y, w)), svy_math::eLsqOk);
  for (int j = 0; j < 3; ++j) EXPECT_NEAR(solution[j], x[j], 1e-10 * (1.0 + std::fabs(x[j])));
}

// Repeated measurements of one quantity with weights 1/sigma^2: the weighted mean.
TEST(LeastSquares, DiagonalWeightsGiveTheWeightedMean) {
  const double values[4] = {10.02, 10.05, 9.98, 10.00};
  const double weights[4] = {1.0, 4.0, 0.25, 2.0};
  TLsqMatrix a(4, 1, 1.0);
  TLsqMatrix y(4, 1);
  TLsqMatrix w(4, 4, 0.0);
  double sum = 0.0;
  double weightSum = 0.0;
  for (std::size_t i = 0; i < 4; ++i) {
    y(i, 0) = values[i];
    w(i, i) = weights[i];
    sum += weights[i] * values[i];
    weightSum += weights[i];
  }
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::leastSquares(solution, TMatrixData(a, y, w)), svy_math::eLsqOk);
  EXPECT_NEAR(solution[0], sum / weightSum, 1e-14);
}

// A one-unknown non-linear problem whose misclosure is a given function of the current solution.
class TScalarProblem : public svy_math::TNonLinearLeastSquaresData {
 public:
  enum class Kind { kSqrtTwo, kNeverSettles, kDiverges };
  explicit TScalarProblem(Kind kind) : kind_(kind) {}
  ELeastSquaresStatus computeInitialGuess() override {
    setCurrentSolution(svy_vector<double>{1.0});
    return svy_math::eLsqOk;
  }
  TLsqMatrix getAMatrix() const override {
    const double x = currentSolution()[0];
    return TLsqMatrix(1, 1, kind_ == Kind::kSqrtTwo ? 2.0 * x : 1.0);
  }
  TLsqMatrix getYMatrix() const override {
    const double x = currentSolution()[0];
    switch (kind_) {
      case Kind::kSqrtTwo: return TLsqMatrix(1, 1, 2.0 - x * x);  // root of x^2 = 2
      case Kind::kNeverSettles: return TLsqMatrix(1, 1, 1.0);     // every correction is 1
      case Kind::kDiverges: return TLsqMatrix(1, 1, x * 1e200);   // overflows after two steps
    }
    return TLsqMatrix(1, 1, 0.0);
  }
  TLsqMatrix getWeightMatrix() const override { return TLsqMatrix(1, 1, 1.0); }

 private:
  Kind kind_;
};

TEST(GaussNewton, ConvergesQuadraticallyToTheRoot) {
  TScalarProblem problem(TScalarProblem::Kind::kSqrtTwo);
  problem.setConvergenceCriteria(svy_vector<double>{1e-14});
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::gaussNewtonLeastSquares(solution, problem), svy_math::eLsqOk);
  EXPECT_NEAR(solution[0], std::sqrt(2.0), 1e-15);
  EXPECT_TRUE(problem.hasConverged());
}

TEST(GaussNewton, StatusesOfFailingRuns) {
  svy_vector<double> solution;
  TScalarProblem noCriteria(TScalarProblem::Kind::kSqrtTwo);
  EXPECT_EQ(svy_math::gaussNewtonLeastSquares(solution, noCriteria), svy_math::eLsqDimensionMismatch);

  TScalarProblem wrongCriteria(TScalarProblem::Kind::kSqrtTwo);
  wrongCriteria.setConvergenceCriteria(svy_vector<double>{1e-9, 1e-9});
  EXPECT_EQ(svy_math::gaussNewtonLeastSquares(solution, wrongCriteria), svy_math::eLsqDimensionMismatch);

  // Criteria that can never be met end at the safety cap instead of looping.
  TScalarProblem unsettled(TScalarProblem::Kind::kNeverSettles);
  unsettled.setConvergenceCriteria(svy_vector<double>{0.5});
  EXPECT_EQ(svy_math::gaussNewtonLeastSquares(solution, unsettled), svy_math::eLsqNoConvergence);
  TScalarProblem nanCriteria(TScalarProblem::Kind::kSqrtTwo);
  nanCriteria.setConvergenceCriteria(svy_vector<double>{kNaN});
  EXPECT_EQ(svy_math::gaussNewtonLeastSquares(solution, nanCriteria), svy_math::eLsqNoConvergence);

  TScalarProblem diverging(TScalarProblem::Kind::kDiverges);
  diverging.setConvergenceCriteria(svy_vector<double>{1e-9});
  EXPECT_EQ(svy_math::gaussNewtonLeastSquares(solution, diverging), svy_math::eLsqNotFinite);
  EXPECT_TRUE(solution.empty());
}

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
    EXPECT_EQ(log.entries()[0].file, "TLeastSquares");
    EXPECT_EQ(log.entries()[0].line, 76);
  }
  problem.setConvergenceCriteria(svy_vector<double>{-0.25});
  ASSERT_EQ(problem.computeInitialGuess(), svy_math::eLsqOk);
  EXPECT_FALSE(problem.hasConverged());  // no correction yet
  EXPECT_EQ(problem.correctCurrentSolution(svy_vector<double>{0.1, 0.0}), svy_math::eLsqDimensionMismatch);
  ASSERT_EQ(problem.correctCurrentSolution(svy_vector<double>{0.5}), svy_math::eLsqOk);
  EXPECT_FALSE(problem.hasConverged());  // 0.5 > |-0.25|
  ASSERT_EQ(problem.correctCurrentSolution(svy_vector<double>{-0.25}), svy_math::eLsqOk);
  EXPECT_TRUE(problem.hasConverged());  // the bound is inclusive
  ASSERT_EQ(problem.getCurrentSolution(current), svy_math::eLsqOk);
  EXPECT_EQ(current[0], 1.25);
}

}  // namespace
