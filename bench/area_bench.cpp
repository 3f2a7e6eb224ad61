// Areas: the area of a long boundary with arcs (linear in its segments) and known-area subdivisions.
#include <benchmark/benchmark.h>

#include <cmath>

#include "svymath/area/polygon_area.h"
#include "svymath/area/subdivision.h"

namespace {

TCoords at(double north, double east) {
  TCoords c;
  c.north = north;
  c.east = east;
  return c;
}

// A boundary of `count` segments round a circle of radius 500 m at survey coordinates, every other side
// an arc bulging out by a tenth of a radian of turn.
svy_list<AreaSegment> roundBoundary(int count) {
  svy_list<AreaSegment> list;
  const double step = 6.283185307179586 / count;
  const auto vertex = [&](int i) {
    return at(5000000.0 + 500.0 * std::cos(i * step), 500000.0 - 500.0 * std::sin(i * step));
  };
  for (int i = 0; i < count; ++i) {
    if (i % 2 == 0)
      list.emplace_back(vertex(i), vertex(i + 1));
    else
      list.emplace_back(0.1, vertex(i), vertex(i + 1), true);
  }
  return list;
}

void BM_BoundaryArea(benchmark::State& state) {
  svy_list<AreaSegment> list = roundBoundary(static_cast<int>(state.range(0)));
  for (auto _ : state) {
    double area = 0.0;
    benchmark::DoNotOptimize(eComputePolygonArea(list, &area));
    benchmark::DoNotOptimize(area);
  }
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_BoundaryArea)->Arg(1000)->Arg(10000)->Complexity(benchmark::oN)->Unit(benchmark::kMicrosecond);

void BM_SubdivideParallel(benchmark::State& state) {
  const svy_list<AreaSegment> boundary = roundBoundary(1000);
  for (auto _ : state) {
    svy_list<AreaSegment> list = boundary;
    svy_list<AreaSegment> piece, rest;
    TCoords cutStart, cutEnd;
    benchmark::DoNotOptimize(eSubdivideSegmentList(0.6, 250000.0, true, list, &piece, &rest, &cutStart, &cutEnd));
  }
}
BENCHMARK(BM_SubdivideParallel)->Unit(benchmark::kMillisecond);

void BM_SubdivideHinge(benchmark::State& state) {
  const svy_list<AreaSegment> boundary = roundBoundary(1000);
  TCoords towards;
  towards.mask = 0;
  for (auto _ : state) {
    svy_list<AreaSegment> list = boundary;
    svy_list<AreaSegment> piece, rest;
    TCoords cutEnd;
    benchmark::DoNotOptimize(
        eSubdivideSegmentList(boundary.front().start, towards, 250000.0, list, &piece, &rest, &cutEnd));
  }
}
BENCHMARK(BM_SubdivideHinge)->Unit(benchmark::kMillisecond);

}  // namespace
