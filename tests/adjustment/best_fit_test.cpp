#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "svymath/adjustment/best_fit.h"
#include "svymath/adjustment/fit_quality.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_err_log.h"

using svy_math::TBestFitCurveData;
using svy_math::TBestFitLineData;
using svy_math::TBestFitRadiusData;

namespace {

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

}  // namespace
