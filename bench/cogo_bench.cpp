// Inverse, radiation and the circle solvers: called per point by curves, alignments and areas.
#include <benchmark/benchmark.h>

#include <cmath>
#include <vector>

#include "svymath/cogo/circle_solvers.h"
#include "svymath/cogo/circle_tangents.h"
#include "svymath/cogo/cogo_intersections.h"
#include "svymath/cogo/cogo_inverse.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/cogo/view_cone.h"

namespace {

// Targets around a grid station in every direction, so that every quadrant's branch is taken.
std::vector<C2dPos> targetsAround(const C2dPos& station, int count) {
  std::vector<C2dPos> targets;
  targets.reserve(static_cast<std::size_t>(count));
  for (int i = 0; i < count; ++i) {
    const double a = 0.37 + 6.283185307179586 * i / count;
    const double d = 10.0 + 7.0 * i;
    targets.emplace_back(station.north() + d * std::cos(a), station.east() + d * std::sin(a));
  }
  return targets;
}

const C2dPos kStation(5000000.0, 500000.0);

void BM_Inverse2D(benchmark::State& state) {
  const std::vector<C2dPos> targets = targetsAround(kStation, 64);
  std::size_t i = 0;
  for (auto _ : state) {
    const C2dPos& t = targets[i++ & 63u];
    double azimuth = 0.0;
    double distance = 0.0;
    benchmark::DoNotOptimize(Inverse2D(kStation.east(), kStation.north(), t.east(), t.north(), azimuth, distance));
    benchmark::DoNotOptimize(azimuth);
    benchmark::DoNotOptimize(distance);
  }
}
BENCHMARK(BM_Inverse2D);

void BM_Radiate2D(benchmark::State& state) {
  double azimuth = 0.1;
  for (auto _ : state) {
    double e = 0.0;
    double n = 0.0;
    Radiate2D(kStation.east(), kStation.north(), azimuth, 123.456, e, n);
    benchmark::DoNotOptimize(e);
    benchmark::DoNotOptimize(n);
    azimuth += 0.01;
  }
}
BENCHMARK(BM_Radiate2D);

void BM_LineAndCircle(benchmark::State& state) {
  const std::vector<C2dPos> targets = targetsAround(kStation, 64);
  std::size_t i = 0;
  for (auto _ : state) {
    C2dPos s1, s2;
    const C2dPos& t = targets[i++ & 63u];
    benchmark::DoNotOptimize(IntersectionCoordsOfLineAndCircle(kStation, t, targets[0], 150.0, s1, s2));
    benchmark::DoNotOptimize(s1);
  }
}
BENCHMARK(BM_LineAndCircle);

void BM_TwoCircles(benchmark::State& state) {
  const std::vector<C2dPos> targets = targetsAround(kStation, 64);
  std::size_t i = 0;
  for (auto _ : state) {
    C2dPos s1, s2;
    const C2dPos& t = targets[i++ & 63u];
    benchmark::DoNotOptimize(IntersectionCoordsOfTwoCircles(kStation, 300.0, t, 250.0, s1, s2));
    benchmark::DoNotOptimize(s1);
  }
}
BENCHMARK(BM_TwoCircles);

void BM_IntersectBearings(benchmark::State& state) {
  const std::vector<C2dPos> targets = targetsAround(kStation, 64);
  const CMathAngle az1(30.0), az2(100.0);
  std::size_t i = 0;
  for (auto _ : state) {
    C2dPos crossing;
    benchmark::DoNotOptimize(CogoFunctions::eIntersectBearings(kStation, az1, targets[i++ & 63u], az2, crossing));
    benchmark::DoNotOptimize(crossing);
  }
}
BENCHMARK(BM_IntersectBearings);

void BM_TangentsOfTwoCircles(benchmark::State& state) {
  const std::vector<C2dPos> targets = targetsAround(kStation, 64);
  svy_math::TTangentToCircles tangents;
  std::size_t i = 0;
  for (auto _ : state) {
    benchmark::DoNotOptimize(tangents.solve(kStation, 5.0, targets[i++ & 63u], 3.0));
    benchmark::DoNotOptimize(tangents.tangent(0));
  }
}
BENCHMARK(BM_TangentsOfTwoCircles);

// The nearest point of a polyline of as many vertices as the argument: one pass over its segments.
void BM_InverseToPolyline(benchmark::State& state) {
  const std::vector<C2dPos> around = targetsAround(kStation, static_cast<int>(state.range(0)));
  const svy_vector<C2dPos> polyline(around.begin(), around.end());
  const std::vector<C2dPos> probes = targetsAround(kStation, 64);
  std::size_t i = 0;
  for (auto _ : state) {
    CogoFunctions::TElementInverse inverse;
    benchmark::DoNotOptimize(CogoFunctions::eInverseToPolyline(polyline, false, probes[i++ & 63u], inverse));
    benchmark::DoNotOptimize(inverse);
  }
}
BENCHMARK(BM_InverseToPolyline)->Arg(16)->Arg(1024);

// A field screen redraws every target each frame: turn it into the observer's frame and project it.
void BM_ViewProjection(benchmark::State& state) {
  const std::vector<C2dPos> targets = targetsAround(kStation, 64);
  svy_math::TViewParams view;
  view.observer = svy_math::TAbstractPoint3<double>(kStation.north(), kStation.east(), 100.0);
  view.azimuth = 0.7;
  view.elevation = 0.05;
  view.fieldOfView = 1.2;
  view.screenWidth = 1920;
  view.screenHeight = 1080;
  const svy_math::TRectCone cone(view);
  std::size_t i = 0;
  for (auto _ : state) {
    const C2dPos& t = targets[i++ & 63u];
    const svy_math::T3dPosAndDirRotated target(view, svy_math::TAbstractPoint3<double>(t.north(), t.east(), 102.0));
    double x = 0.0;
    double y = 0.0;
    benchmark::DoNotOptimize(cone.toScreen(target, x, y));
    benchmark::DoNotOptimize(x);
    benchmark::DoNotOptimize(y);
  }
}
BENCHMARK(BM_ViewProjection);

}  // namespace
