#include <gtest/gtest.h>

#include <cmath>
#include <random>

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
svy_list<C2dPos> arcPoints(const C2dPos& centre, double radius, double fromRad, double toRad, int count,
                           double sigma, unsigned seed) {
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

svy_vector<double> criteria(std::size_t unknowns) { return svy_vector<double>(unknowns, 1e-7); }

// The line fit at survey coordinates against the centred closed form (slope = Sne / See).
TEST(BestFitLine, SurveyCoordinatesMatchCentredClosedForm) {
  std::mt19937 rng(99);
  std::normal_distribution<double> noise(0.0, 0.005);
  TBestFitLineData data;
  svy_list<C2dPos> points;
  for (int k = 0; k < 40; ++k) {
    const double e = kEastOrigin + 2.5 * k;
    points.push_back(C2dPos(kNorthOrigin + 0.75 * (e - kEastOrigin) + 12.0 + noise(rng), e));
    data.addData(points.back());
  }
  double meanN = 0.0, meanE = 0.0;
  for (const C2dPos& p : points) {
    meanN += (p.north() - kNorthOrigin) / 40.0;
    meanE += (p.east() - kEastOrigin) / 40.0;
  }
  double sne = 0.0, see = 0.0;
  for (const C2dPos& p : points) {
    const double dn = p.north() - kNorthOrigin - meanN;
    const double de = p.east() - kEastOrigin - meanE;
    sne += dn * de;
    see += de * de;
  }
  const double slope = sne / see;
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::leastSquares(solution, data), svy_math::eLsqOk);
  EXPECT_NEAR(solution[0], slope, 1e-12);
  // The fitted line passes through the centroid to the tenth of a micrometre.
  const double atCentroid = solution[0] * (kEastOrigin + meanE) + solution[1];
  EXPECT_NEAR(atCentroid - kNorthOrigin, meanN, 1e-7);
  EXPECT_NEAR(data.getRms(solution), 0.005, 0.002);
  EXPECT_TRUE(std::isnan(data.getRms(svy_vector<double>{1.0})));
}

TEST(BestFitLine, ExactTwoPointsSingularVerticalAndTooFew) {
  TBestFitLineData two;
  two.addData(C2dPos(3.0, 1.0));
  two.addData(C2dPos(5.0, 2.0));
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::leastSquares(solution, two), svy_math::eLsqOk);
  EXPECT_NEAR(solution[0], 2.0, 1e-15);
  EXPECT_NEAR(solution[1], 1.0, 1e-14);
  EXPECT_EQ(two.getRms(solution), 0.0);

  TBestFitLineData vertical;  // one easting: north is no function of east
  for (double n : {1.0, 2.0, 3.0}) vertical.addData(C2dPos(n, kEastOrigin));
  EXPECT_EQ(svy_math::leastSquares(solution, vertical), svy_math::eLsqSingular);
  TBestFitLineData one;
  one.addData(C2dPos(1.0, 2.0));
  EXPECT_EQ(svy_math::leastSquares(solution, one), svy_math::eLsqTooFewObservations);
  one.reset();
  EXPECT_EQ(one.getDataCount(), 0);
}

struct CircleCase {
  const char* name;
  double fromDeg, toDeg;
  int count;
  double sigma;
  double tolerance;  // on centre and radius, metres
};

class BestFitCircle : public ::testing::TestWithParam<CircleCase> {};

TEST_P(BestFitCircle, RecoversCentreAndRadiusAtSurveyCoordinates) {
  const CircleCase& c = GetParam();
  const C2dPos centre(kNorthOrigin + 123.456, kEastOrigin + 789.012);
  const double radius = 250.0;
  TBestFitCurveData data(arcPoints(centre, radius, c.fromDeg * svy_math::units::kDegToRad,
                                   c.toDeg * svy_math::units::kDegToRad, c.count, c.sigma, 42));
  data.setConvergenceCriteria(criteria(3));
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::gaussNewtonLeastSquares(solution, data), svy_math::eLsqOk);
  ASSERT_EQ(solution.size(), 3U);
  EXPECT_NEAR(solution[0], centre.east(), c.tolerance);   // u pairs with east
  EXPECT_NEAR(solution[1], centre.north(), c.tolerance);  // v pairs with north
  EXPECT_NEAR(solution[2], radius, c.tolerance);
  if (c.sigma > 0.0) {
    EXPECT_NEAR(data.getMisclosureRms(), c.sigma, 0.5 * c.sigma);
  }
}

INSTANTIATE_TEST_SUITE_P(Arcs, BestFitCircle,
                         ::testing::Values(CircleCase{"exact_full", 0, 350, 36, 0.0, 1e-6},
                                           CircleCase{"exact_short_arc", 10, 25, 8, 0.0, 1e-6},
                                           CircleCase{"noisy_full", 0, 359, 200, 0.002, 0.001},
                                           CircleCase{"noisy_quarter", 30, 120, 100, 0.002, 0.01}),
                         [](const ::testing::TestParamInfo<CircleCase>& param) { return param.param.name; });

TEST(BestFitCircleGuess, StatusesOfDegenerateData) {
  TBestFitCurveData data;
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  data.addData(C2dPos(0, 0));
  data.addData(C2dPos(1, 1));
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  data.addData(C2dPos(2, 2));  // collinear
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqSingular);
  data.reset();
  for (int k = 0; k < 3; ++k) data.addData(C2dPos(kNorthOrigin, kEastOrigin));
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqSingular);
  data.reset();
  data.addData(C2dPos(0, 1));
  data.addData(C2dPos(1, 0));
  data.addData(C2dPos(std::nan(""), 0));
  data.setConvergenceCriteria(criteria(3));
  svy_vector<double> solution;
  EXPECT_EQ(svy_math::gaussNewtonLeastSquares(solution, data), svy_math::eLsqNotFinite);
  EXPECT_FALSE(data.hasCurrentSolution());
}

TEST(BestFitCircleLog, MatricesBeforeASolutionAreLogged) {
  TBestFitCurveData data(arcPoints(C2dPos(0, 0), 10.0, 0.0, 3.0, 5, 0.0, 1));
  svy_logging::CScopedErrLogCapture log;
  EXPECT_EQ(data.getAMatrix().size1(), 0U);
  EXPECT_EQ(data.getYMatrix().size1(), 0U);
  EXPECT_EQ(data.getWeightMatrix().size1(), 5U);
  const auto entries = log.entries();
  ASSERT_EQ(entries.size(), 3U);
  EXPECT_EQ(entries[0].line, 330);
  EXPECT_EQ(entries[1].line, 369);
  EXPECT_EQ(entries[2].line, 396);
  for (const auto& entry : entries) EXPECT_EQ(entry.file, "TLeastSquares");
  ASSERT_EQ(data.computeInitialGuess(), svy_math::eLsqOk);
  data.getAMatrix();
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

// The radius rows carry -1 (the curve's radius column +1): with the mean distance as the initial guess
// the first correction is zero and the fit stops after it.
TEST(BestFitRadius, ConvergesAfterOneZeroCorrection) {
  const C2dPos centre(kNorthOrigin, kEastOrigin);
  TCountingRadiusData data(arcPoints(centre, 80.0, 0.0, 2.0, 25, 0.003, 5), centre);
  const svy_math::TLsqMatrix a = data.getAMatrix();
  ASSERT_EQ(a.size2(), 1U);
  EXPECT_EQ(a(0, 0), -1.0);
  data.setConvergenceCriteria(svy_vector<double>{1e-9});
  svy_vector<double> solution;
  ASSERT_EQ(svy_math::gaussNewtonLeastSquares(solution, data), svy_math::eLsqOk);
  EXPECT_EQ(data.evaluations, 1);
  double meanDistance = 0.0;
  for (const C2dPos& p : arcPoints(centre, 80.0, 0.0, 2.0, 25, 0.003, 5))
    meanDistance += std::hypot(p.north() - centre.north(), p.east() - centre.east()) / 25.0;
  EXPECT_NEAR(solution[0], meanDistance, 1e-9);
  EXPECT_NEAR(solution[0], 80.0, 0.003);
}

TEST(BestFitRadius, MissingCentreOrPointsAndLogs) {
  TBestFitRadiusData data;
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  data.addData(C2dPos(1, 1));
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  {
    svy_logging::CScopedErrLogCapture log;
    data.getAMatrix();
    data.getWeightMatrix();
    const auto entries = log.entries();
    ASSERT_EQ(entries.size(), 2U);
    EXPECT_EQ(entries[0].line, 556);
    EXPECT_EQ(entries[1].line, 606);
  }
  data.setCircleCenter(C2dPos(0, 0));
  svy_logging::CScopedErrLogCapture log;
  data.getAMatrix();
  data.getWeightMatrix();
  EXPECT_EQ(log.count(), 0U);
  ASSERT_EQ(data.computeInitialGuess(), svy_math::eLsqOk);
  data.reset();
  EXPECT_EQ(data.computeInitialGuess(), svy_math::eLsqTooFewObservations);
  EXPECT_TRUE(data.isCircleCenterSet());
}

struct GradeCase {
  double rms;
  int grade;
};

class RmsGrades : public ::testing::TestWithParam<GradeCase> {};

TEST_P(RmsGrades, BoundsAreExclusive) { EXPECT_EQ(svy_math::RmsToKnown(GetParam().rms), GetParam().grade); }

INSTANTIATE_TEST_SUITE_P(Table, RmsGrades,
                         ::testing::Values(GradeCase{1e9, 9}, GradeCase{200.0001, 9}, GradeCase{200.0, 8},
                                           GradeCase{10.0, 7}, GradeCase{5.0, 6}, GradeCase{1.0, 5},
                                           GradeCase{0.5, 4}, GradeCase{0.1, 3}, GradeCase{0.05, 2},
                                           GradeCase{0.0100001, 2}, GradeCase{0.01, 1}, GradeCase{0.0, 1},
                                           GradeCase{-3.0, 1}, GradeCase{std::nan(""), 9}));

TEST(DefTriad, UndefinedMarkers) {
  const svy_math::DefTriad undefined;
  EXPECT_TRUE(undefined.IsUndef());
  EXPECT_FALSE(undefined.IsPartialUndef());
  const svy_math::DefTriad partial(1.0, svy_math::undefinedValue(), 3.0);
  EXPECT_FALSE(partial.IsUndef());
  EXPECT_TRUE(partial.IsPartialUndef());
  const svy_math::TAbstractPoint3<double> defined(1.0, 2.0, 3.0);
  EXPECT_FALSE(svy_math::DefTriad::IsUndef(defined));
  EXPECT_FALSE(svy_math::DefTriad::IsPartialUndef(defined));
}

}  // namespace
