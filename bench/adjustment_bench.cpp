// Best-fit circle and covariance eigen-decomposition timings.
#include <benchmark/benchmark.h>

#include <cmath>
#include <random>

#include "svymath/adjustment/best_fit.h"
#include "svymath/adjustment/covar.h"

namespace {

// 1,000 points on a 300-degree arc of radius 250 m at survey coordinates, with 2 mm noise.
svy_list<C2dPos> circlePoints() {
  std::mt19937 rng(1);
  std::normal_distribution<double> noise(0.0, 0.002);
  svy_list<C2dPos> points;
  const int count = 1000;
  for (int k = 0; k < count; ++k) {
    const double azimuth = 5.2 * k / (count - 1);
    const double r = 250.0 + noise(rng);
    points.push_back(C2dPos(5000123.456 + r * std::cos(azimuth), 500789.012 + r * std::sin(azimuth)));
  }
  return points;
}

void BM_BestFitCircle1000(benchmark::State& state) {
  const svy_list<C2dPos> points = circlePoints();
  const svy_vector<double> criteria(3, 1e-7);
  for (auto _ : state) {
    svy_math::TBestFitCurveData data(points);
    data.setConvergenceCriteria(criteria);
    svy_vector<double> solution;
    benchmark::DoNotOptimize(svy_math::gaussNewtonLeastSquares(solution, data));
    benchmark::DoNotOptimize(solution.data());
  }
}
BENCHMARK(BM_BestFitCircle1000)->Unit(benchmark::kMillisecond);

void BM_CovarEigen(benchmark::State& state) {
  const svy_math::covar c(9e-6, 2e-6, 4e-6, 1e-6, -1e-6, 1e-6);
  for (auto _ : state) {
    svy_math::covar work(c);
    benchmark::DoNotOptimize(work.eigen());
  }
}
BENCHMARK(BM_CovarEigen);

}  // namespace
