// Linear and Gauss-Newton least squares, and the line, circle and radius fits built on them.
#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "svymath/adjustment/best_fit.h"
#include "svymath/adjustment/fit_quality.h"
#include "svymath/adjustment/least_squares.h"
#include "svymath/adjustment/lsq_matrix_helpers.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

using svy_math::ELeastSquaresStatus;
using svy_math::TBestFitCurveData;
using svy_math::TBestFitLineData;
using svy_math::TBestFitRadiusData;
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
  };
  for (const auto& c : cases) {
    svy_vector<double> solution{99.0};
    EXPECT_EQ(svy_math::leastSquares(solution, TMatrixData(c.a, c.y, c.w)), c.expected) << c.name;
    EXPECT_TRUE(solution.empty()) << c.name;
  }
}

// Consistent observations under correlated positive-definite weights give the generating unknowns; repeated measurements with weights 1/sigma^2 give the weighted mean.
TEST(LeastSquares, SolvesConsistentAndWeightedProblems) {
  svy_vector<double> solution;
  std::mt19937 rng(7);
  std::uniform_real_distribution<double> value(-1.0, 1.0);
  const std::size_t m = 12;
  TLsqMatrix a(m, 3), b(m, m), x = matrix(3, 1, {1.5, -2.25, 1e3});
  for (double& element : a.data()) element = value(rng);
  for (double& element : b.data()) element = value(rng);
  const TLsqMatrix w = boost::numeric::ublas::prod(boost::numeric::ublas::trans(b), b) + identity(m);
  ASSERT_EQ(svy_math::leastSquares(solution, TMatrixData(a, boost::numeric::ublas::prod(a, x), w)), svy_math::eLsqOk);
  ASSERT_EQ(solution.size(), 3U);
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

constexpr double kNorthOrigin = 5000000.0;
constexpr double kEastOrigin = 500000.0;

// Points on a circle arc, with Gaussian noise of sigma (metres) on the radius.
svy_list<C2dPos> arcPoints(const C2dPos& centre, double radius, double fromRad, double toRad, int count, double sigma,
                           unsigned seed) {
  std::mt19937 rng(seed);
  std::normal_distribution<double> noise(0.0, sigma);
  svy_list<C2dPos> points;
  for (int k = 0; k < count; ++k) {
    const double azimuth = fromRad + (toRad - fromRad) * k / (count - 1);
    const double r = radius + (sigma > 0.0 ? noise(rng) : 0.0);
    points.push_back(C2dPos(centre.north() + r * std::cos(azimuth), centre.east() + r * std::sin(azimuth)));
  }
  return points;
}

std::vector<int> loggedLines(const svy_logging::CScopedErrLogCapture& log) {
  std::vector<int> lines;
  for (const auto& entry : log.entries()) lines.push_back(entry.file == "TLeastSquares" ? entry.line : -entry.line);
  return lines;
}

// At survey coordinates against the centred closed form (slope = Sne / See, through the centroid to the
// tenth of a micrometre); two points fit exactly; one easting is singular (north is no function of east).
TEST(BestFitLine, MatchesCentredClosedFormAndStatuses) {
  std::mt19937 rng(99);
  std::normal_distribution<double> noise(0.0, 0.005);
  TBestFitLineData data;
  double de[40], dn[40], meanN = 0.0, meanE = 0.0, sne = 0.0, see = 0.0;
  for (int k = 0; k < 40; ++k) {
    const double e = kEastOrigin + 2.5 * k;
    const double n = kNorthOrigin + 0.75 * (e - kEastOrigin) + 12.0 + noise(rng);
    data.addData(C2dPos(n, e));
    dn[k] = n - kNorthOrigin, de[k] = e - kEastOrigin;
    meanN += dn[k] / 40.0, meanE += de[k] / 40.0;
  }
  for (int k = 0; k < 40; ++k) sne += (dn[k] - meanN) * (de[k] - meanE), see += (de[k] - meanE) * (de[k] - meanE);
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::leastSquares(solution, data), svy_math::eLsqOk);
  EXPECT_NEAR(solution[0], sne / see, 1e-12);
  EXPECT_NEAR(solution[0] * (kEastOrigin + meanE) + solution[1] - kNorthOrigin, meanN, 1e-7);
  EXPECT_NEAR(data.getRms(solution), 0.005, 0.002);
  EXPECT_TRUE(std::isnan(data.getRms(svy_vector<double>{1.0})));

  TBestFitLineData two;
  two.addData(C2dPos(3.0, 1.0));
  two.addData(C2dPos(5.0, 2.0));
  ASSERT_EQ(svy_math::leastSquares(solution, two), svy_math::eLsqOk);
  EXPECT_NEAR(solution[0], 2.0, 1e-15);
  EXPECT_NEAR(solution[1], 1.0, 1e-14);
  EXPECT_EQ(two.getRms(solution), 0.0);
  TBestFitLineData vertical;
  for (double n : {1.0, 2.0, 3.0}) vertical.addData(C2dPos(n, kEastOrigin));
  EXPECT_EQ(svy_math::leastSquares(solution, vertical), svy_math::eLsqSingular);
  vertical.reset();
  vertical.addData(C2dPos(1.0, 2.0));
  EXPECT_EQ(svy_math::leastSquares(solution, vertical), svy_math::eLsqTooFewObservations);
}

// Ten exact points of a steep line at survey coordinates: 100 m of northing over a small easting spread.
// Solved on raw coordinates the normal equations lose the line (21.8 m off at 0.2 m of spread); relative to
// the centroid it is the same line, exact to the rounding of the data. Eastings that differ only in their
// last digits carry no line at all and are refused.
TEST(BestFitLine, SteepLineAtSurveyCoordinatesKeepsItsAccuracy) {
  for (const double spread : {0.2, 0.25, 0.3, 1.0}) {
    SCOPED_TRACE(spread);
    TBestFitLineData data;
    const double slope = 100.0 / spread;
    for (int k = 0; k < 10; ++k) data.addData(C2dPos(kNorthOrigin + 100.0 * k / 9.0, kEastOrigin + spread * k / 9.0));
    svy_vector<double> solution;
    ASSERT_EQ(svy_math::leastSquares(solution, data), svy_math::eLsqOk);
    EXPECT_NEAR(solution[0] / slope, 1.0, 1e-8);
    EXPECT_NEAR(solution[0] * (kEastOrigin + 0.5 * spread) + solution[1] - kNorthOrigin, 50.0, 1e-6);
    EXPECT_LT(data.getRms(solution), 1e-6);
  }
  TBestFitLineData rounding;
  for (int k = 0; k < 10; ++k)
    rounding.addData(C2dPos(kNorthOrigin + k, k % 2 ? std::nextafter(kEastOrigin, 1e6) : kEastOrigin));
  svy_vector<double> solution;
  EXPECT_EQ(svy_math::leastSquares(solution, rounding), svy_math::eLsqSingular);
}

// Nearly straight arcs at survey coordinates (radius 25 km over a 100 m chord, 4.5 to 11 km over 30 m):
// the centre is known only to the rounding of the data times (radius / chord)^2, and the iteration must
// still end at it rather than cycle at that level.
TEST(BestFitCircle, NearlyStraightArcsConvergeAtSurveyCoordinates) {
  const struct {
    double chord, rise;
  } cases[] = {{100.0, 0.05}, {30.0, 0.01}, {30.0, 0.02}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.chord);
    const double radius = (c.chord * c.chord / 4.0 + c.rise * c.rise) / (2.0 * c.rise);
    const double halfAngle = std::asin(0.5 * c.chord / radius);
    const C2dPos centre(kNorthOrigin + 3.0, kEastOrigin + 7.0 + radius);
    TBestFitCurveData data(arcPoints(centre, radius, 1.5 * svy_math::units::kPi - halfAngle,
                                     1.5 * svy_math::units::kPi + halfAngle, 5, 0.0, 1));
    data.setConvergenceCriteria(svy_vector<double>(3, 1e-7));
    svy_vector<double> solution;
    ASSERT_EQ(svy_math::gaussNewtonLeastSquares(solution, data), svy_math::eLsqOk);
    EXPECT_NEAR(solution[0], centre.east(), 2e-4);
    EXPECT_NEAR(solution[1], centre.north(), 2e-4);
    EXPECT_NEAR(solution[2], radius, 2e-4);
    EXPECT_LT(data.getMisclosureRms(), 1e-8);
  }
}

// Exact and noisy arcs (full circle and short arcs) at survey coordinates: the centre (u east, v north) and
// radius, and for noisy points a misclosure RMS near the noise.
TEST(BestFitCircle, RecoversCentreAndRadiusAtSurveyCoordinates) {
  const struct {
    double fromDeg, toDeg;
    int count;
    double sigma, tolerance;  // metres
  } cases[] = {
      {0, 350, 36, 0.0, 1e-6}, {10, 25, 8, 0.0, 1e-6}, {0, 359, 200, 0.002, 0.001}, {30, 120, 100, 0.002, 0.01}};
  const C2dPos centre(kNorthOrigin + 123.456, kEastOrigin + 789.012);
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.fromDeg << ".." << c.toDeg << " sigma " << c.sigma);
    TBestFitCurveData data(arcPoints(centre, 250.0, c.fromDeg * svy_math::units::kDegToRad,
                                     c.toDeg * svy_math::units::kDegToRad, c.count, c.sigma, 42));
    data.setConvergenceCriteria(svy_vector<double>(3, 1e-7));
    svy_vector<double> solution;
    ASSERT_EQ(svy_math::gaussNewtonLeastSquares(solution, data), svy_math::eLsqOk);
    ASSERT_EQ(solution.size(), 3U);
    EXPECT_NEAR(solution[0], centre.east(), c.tolerance);
    EXPECT_NEAR(solution[1], centre.north(), c.tolerance);
    EXPECT_NEAR(solution[2], 250.0, c.tolerance);
    if (c.sigma > 0.0) {
      EXPECT_NEAR(data.getMisclosureRms(), c.sigma, 0.5 * c.sigma);
    }
  }
}

// Too few, collinear or coincident points have no initial guess; a NaN point ends as not finite. Matrices
// asked for before a solution are logged (source and line), and not once there is one.
TEST(BestFitCircle, DegenerateDataAndLogs) {
  TBestFitCurveData data;
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  data.addData(C2dPos(0, 0));
  data.addData(C2dPos(1, 1));
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  data.addData(C2dPos(2, 2));
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqSingular);
  data.reset();
  for (int k = 0; k < 3; ++k) data.addData(C2dPos(kNorthOrigin, kEastOrigin));
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqSingular);
  data.reset();
  for (const C2dPos& p : {C2dPos(0, 1), C2dPos(1, 0), C2dPos(std::nan(""), 0)}) data.addData(p);
  data.setConvergenceCriteria(svy_vector<double>(3, 1e-7));
  svy_vector<double> solution;
  EXPECT_EQ(svy_math::gaussNewtonLeastSquares(solution, data), svy_math::eLsqNotFinite);
  EXPECT_FALSE(data.hasCurrentSolution());

  TBestFitCurveData arc(arcPoints(C2dPos(0, 0), 10.0, 0.0, 3.0, 5, 0.0, 1));
  svy_logging::CScopedErrLogCapture log;
  EXPECT_EQ(arc.getAMatrix().size1(), 0U);
  EXPECT_EQ(arc.getYMatrix().size1(), 0U);
  EXPECT_EQ(arc.getWeightMatrix().size1(), 5U);
  EXPECT_EQ(loggedLines(log), (std::vector<int>{330, 369, 396}));
  ASSERT_EQ(arc.computeInitialGuess(), svy_math::eLsqOk);
  arc.getAMatrix();
  EXPECT_EQ(log.count(), 3U);
}

// Counts the misclosure evaluations, one per Gauss-Newton correction.
class TCountingRadiusData : public TBestFitRadiusData {
 public:
  using TBestFitRadiusData::TBestFitRadiusData;
  svy_math::TLsqMatrix getYMatrix() const override {
    ++evaluations;
    return TBestFitRadiusData::getYMatrix();
  }
  mutable int evaluations = 0;
};

// The radius rows carry -1 (the curve's radius column +1): with the mean distance as the initial guess the
// first correction is zero and the fit stops after it. Without a centre or points there is no guess, and
// the matrices are logged until the centre is set; reset keeps the centre.
TEST(BestFitRadius, ConvergesAfterOneZeroCorrection) {
  const C2dPos centre(kNorthOrigin, kEastOrigin);
  const svy_list<C2dPos> points = arcPoints(centre, 80.0, 0.0, 2.0, 25, 0.003, 5);
  TCountingRadiusData data(points, centre);
  const svy_math::TLsqMatrix a = data.getAMatrix();
  ASSERT_EQ(a.size2(), 1U);
  EXPECT_EQ(a(0, 0), -1.0);
  data.setConvergenceCriteria(svy_vector<double>{1e-9});
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::gaussNewtonLeastSquares(solution, data), svy_math::eLsqOk);
  EXPECT_EQ(data.evaluations, 1);
  double meanDistance = 0.0;
  for (const C2dPos& p : points)
    meanDistance += std::hypot(p.north() - centre.north(), p.east() - centre.east()) / 25.0;
  EXPECT_NEAR(solution[0], meanDistance, 1e-9);
  EXPECT_NEAR(solution[0], 80.0, 0.003);

  // Distances 9, 10, 12 and 13 fit the radius 11 with misclosures -2, -1, 1, 2: the RMS is sqrt(10 / 4), taken
  // over the n observations (the residual count, not n - 1). The line's residuals +-1 give 1 likewise.
  TBestFitRadiusData spread;
  spread.setCircleCenter(centre);
  for (double d : {9.0, 10.0, 12.0, 13.0}) spread.addData(C2dPos(centre.north() + d, centre.east()));
  spread.setConvergenceCriteria(svy_vector<double>{1e-9});
  ASSERT_EQ(svy_math::gaussNewtonLeastSquares(solution, spread), svy_math::eLsqOk);
  EXPECT_NEAR(solution[0], 11.0, 1e-9);
  EXPECT_NEAR(spread.getMisclosureRms(), std::sqrt(2.5), 1e-9);
  TBestFitLineData line;
  for (const C2dPos& p : {C2dPos(1, 0), C2dPos(-1, 0), C2dPos(2, 1), C2dPos(0, 1)}) line.addData(p);
  ASSERT_EQ(svy_math::leastSquares(solution, line), svy_math::eLsqOk);
  EXPECT_NEAR(line.getRms(solution), 1.0, 1e-14);

  TBestFitRadiusData bare;
  EXPECT_EQ(bare.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  bare.addData(C2dPos(1, 1));
  EXPECT_EQ(bare.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  for (const std::vector<int>& expectedLines : {std::vector<int>{556, 606}, std::vector<int>{}}) {
    svy_logging::CScopedErrLogCapture log;
    bare.getAMatrix();
    bare.getWeightMatrix();
    EXPECT_EQ(loggedLines(log), expectedLines);
    bare.setCircleCenter(C2dPos(0, 0));
  }
  ASSERT_EQ(bare.computeInitialGuess(), svy_math::eLsqOk);
  bare.reset();
  EXPECT_EQ(bare.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  EXPECT_TRUE(bare.isCircleCenterSet());
}

// Grades of an RMS: the bounds are exclusive; NaN is the worst grade. Undefined markers of a triad.
TEST(FitQuality, RmsGradesAndUndefinedTriads) {
  const double cases[][2] = {{1e9, 9},  {200.0001, 9}, {200.0, 8}, {10.0, 7},        {5.0, 6},
                             {1.0, 5},  {0.5, 4},      {0.1, 3},   {0.05, 2},        {0.0100001, 2},
                             {0.01, 1}, {0.0, 1},      {-3.0, 1},  {std::nan(""), 9}};
  for (const auto& c : cases) EXPECT_EQ(svy_math::RmsToKnown(c[0]), static_cast<int>(c[1])) << c[0];
  const svy_math::DefTriad undefined, partial(1.0, svy_math::undefinedValue(), 3.0);
  EXPECT_TRUE(undefined.IsUndef() && !undefined.IsPartialUndef());
  EXPECT_TRUE(!partial.IsUndef() && partial.IsPartialUndef());
  const svy_math::TAbstractPoint3<double> defined(1.0, 2.0, 3.0);
  EXPECT_FALSE(svy_math::DefTriad::IsUndef(defined) || svy_math::DefTriad::IsPartialUndef(defined));
}

// The covariance of a straight-line fit against the textbook formulas of simple regression
// (var m = s^2/Sxx, var b = s^2 (1/n + mean^2/Sxx), cov = -mean s^2/Sxx, s^2 = sum v^2 / (n - 2)), and of a
// weighted mean (sigma0^2 / sum w); scaling the weights leaves the covariance as it was.
TEST(ComputeCovMatrix, MatchesClosedFormsOfSmallAdjustments) {
  const double xs[6] = {0, 1, 2, 3, 4, 6}, ys[6] = {1.02, 2.98, 5.05, 6.96, 9.01, 12.97};
  TLsqMatrix a(6, 2), y(6, 1);
  double mean = 0.0;
  for (std::size_t i = 0; i < 6; ++i) a(i, 0) = xs[i], a(i, 1) = 1.0, y(i, 0) = ys[i], mean += xs[i] / 6;
  const TMatrixData line(a, y, identity(6));
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::leastSquares(solution, line), svy_math::eLsqOk);
  double sxx = 0.0, vv = 0.0;
  for (std::size_t i = 0; i < 6; ++i) {
    sxx += (xs[i] - mean) * (xs[i] - mean);
    vv += std::pow(solution[0] * xs[i] + solution[1] - ys[i], 2);
  }
  const double s2 = vv / 4;
  TLsqMatrix cov;
  double sigma0Sq = 0.0;
  ASSERT_EQ(svy_math::ComputeCovMatrix(line, solution, cov, sigma0Sq), svy_math::eLsqOk);
  EXPECT_NEAR(sigma0Sq, s2, 1e-15);
  const double expected[2][2] = {{s2 / sxx, -mean * s2 / sxx}, {-mean * s2 / sxx, s2 * (1.0 / 6 + mean * mean / sxx)}};
  for (std::size_t i = 0; i < 2; ++i)
    for (std::size_t j = 0; j < 2; ++j) EXPECT_NEAR(cov(i, j), expected[i][j], 1e-15) << i << j;

  const double values[4] = {10.02, 10.05, 9.98, 10.00}, weights[4] = {1.0, 4.0, 0.25, 2.0};
  for (double scale : {1.0, 4.0}) {
    TLsqMatrix v(4, 1), w(4, 4, 0.0);
    const double mean4 = (10.02 + 4 * 10.05 + 0.25 * 9.98 + 2 * 10.00) / 7.25;
    double wvv = 0.0;
    for (std::size_t i = 0; i < 4; ++i) {
      w(i, i) = scale * weights[i], v(i, 0) = mean4 - values[i];
      wvv += weights[i] * v(i, 0) * v(i, 0);
    }
    ASSERT_EQ(svy_math::ComputeCovMatrix(TLsqMatrix(4, 1, 1.0), w, v, cov, sigma0Sq), svy_math::eLsqOk);
    EXPECT_NEAR(cov(0, 0), wvv / 3 / 7.25, 1e-18) << scale;
    EXPECT_NEAR(sigma0Sq, scale * wvv / 3, 1e-16) << scale;
  }
}

TEST(ComputeCovMatrix, ReportsWhyNoCovarianceLeavingOutputsAlone) {
  const struct {
    const char* name;
    TLsqMatrix a, w, v;
    ELeastSquaresStatus expected;
  } cases[] = {
      {"no redundancy", matrix(2, 2, {1, 0, 0, 1}), identity(2), TLsqMatrix(2, 1, 0.0), svy_math::eLsqTooFewObservations},
      {"residual rows", matrix(3, 1, {1, 1, 1}), identity(3), TLsqMatrix(2, 1, 0.0), svy_math::eLsqDimensionMismatch},
      {"weights size", matrix(3, 1, {1, 1, 1}), identity(2), TLsqMatrix(3, 1, 0.0), svy_math::eLsqDimensionMismatch},
      {"NaN residual", matrix(3, 1, {1, 1, 1}), identity(3), matrix(3, 1, {0, std::nan(""), 0}), svy_math::eLsqNotFinite},
      {"equal columns", matrix(3, 2, {1, 1, 2, 2, 3, 3}), identity(3), TLsqMatrix(3, 1, 0.0), svy_math::eLsqSingular}};
  for (const auto& c : cases) {
    TLsqMatrix cov(1, 1, 7.0);
    double sigma0Sq = 7.0;
    EXPECT_EQ(svy_math::ComputeCovMatrix(c.a, c.w, c.v, cov, sigma0Sq), c.expected) << c.name;
    EXPECT_TRUE(cov.size1() == 1 && cov(0, 0) == 7.0 && sigma0Sq == 7.0) << c.name;
  }
}

// Distances from an unknown point near N 5 000 000 to four stations: the numerical design matrix equals the
// analytic one (the direction cosines), and Gauss-Newton with it reaches the point the distances came from.
TEST(GenerateATMatrix, DistanceEquationsMatchDirectionCosinesAndAdjust) {
  const double stations[4][2] = {{5000000.0, 500000.0}, {5000300.0, 500050.0}, {4999900.0, 500400.0}, {5000250.0, 500380.0}};
  const double truth[2] = {5000120.25, 500210.75};
  const svy_math::TObservationEquation distance = [&](std::size_t i, const svy_vector<double>& x) {
    return std::hypot(x[0] - stations[i][0], x[1] - stations[i][1]);
  };
  svy_vector<double> point{truth[0] + 3.0, truth[1] - 2.0};
  const svy_vector<double> steps{1e-4, 1e-4};
  TLsqMatrix a;
  for (int iteration = 0; iteration < 6; ++iteration) {
    ASSERT_TRUE(svy_math::GenerateATMatrix(distance, 4, point, steps, a));
    TLsqMatrix misclosure(4, 1);
    for (std::size_t i = 0; i < 4; ++i) {
      const double d = distance(i, point);
      EXPECT_NEAR(a(i, 0), (point[0] - stations[i][0]) / d, 1e-8);
      EXPECT_NEAR(a(i, 1), (point[1] - stations[i][1]) / d, 1e-8);
      misclosure(i, 0) = std::hypot(truth[0] - stations[i][0], truth[1] - stations[i][1]) - d;
    }
    svy_vector<double> correction;
    ASSERT_EQ(svy_math::leastSquares(correction, TMatrixData(a, misclosure, identity(4))), svy_math::eLsqOk);
    point[0] += correction[0], point[1] += correction[1];
  }
  EXPECT_NEAR(point[0], truth[0], 1e-8);
  EXPECT_NEAR(point[1], truth[1], 1e-8);

  TLsqMatrix untouched(1, 1, 7.0);
  const svy_math::TObservationEquation infinite = [](std::size_t, const svy_vector<double>&) { return HUGE_VAL; };
  EXPECT_FALSE(svy_math::GenerateATMatrix(infinite, 4, point, steps, untouched));
  EXPECT_FALSE(svy_math::GenerateATMatrix(distance, 0, point, steps, untouched));
  EXPECT_FALSE(svy_math::GenerateATMatrix(distance, 4, point, svy_vector<double>{1e-4}, untouched));
  EXPECT_FALSE(svy_math::GenerateATMatrix(distance, 4, point, svy_vector<double>{1e-4, 0.0}, untouched));
  EXPECT_EQ(untouched(0, 0), 7.0);
}

// (A B)^T = B^T A^T; a product may overwrite its operand; shapes that do not chain are refused.
TEST(ProdMat, TransposeOfProductAndAliasing) {
  const TLsqMatrix a = matrix(2, 3, {1, 2, 3, 4, 5, 6}), b = matrix(3, 2, {7, -1, 0.5, 2, -3, 4});
  TLsqMatrix ab, btat, aliased = a;
  ASSERT_TRUE(svy_math::ProdMat(a, b, ab));
  ASSERT_TRUE(svy_math::ProdMat(svy_math::GenerateTransposeMatrix(b), svy_math::GenerateTransposeMatrix(a), btat));
  ASSERT_TRUE(svy_math::ProdMat(aliased, b, aliased));
  EXPECT_EQ(ab(0, 0), 7 + 1 - 9);
  EXPECT_EQ(ab(1, 1), -4 + 10 + 24);
  for (std::size_t i = 0; i < 2; ++i)
    for (std::size_t j = 0; j < 2; ++j) EXPECT_TRUE(btat(j, i) == ab(i, j) && aliased(i, j) == ab(i, j));
  EXPECT_FALSE(svy_math::ProdMat(a, a, ab));
  EXPECT_EQ(ab.size1(), 2u);
}

}  // namespace
