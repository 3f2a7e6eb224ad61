// The length and offset of a surveyed point on a spiral-arc-spiral group about an intersection point (what
// the station-and-offset search asks of every IP element), at survey coordinates: points spread along the
// group and to both sides, on each of its three parts.
#include <benchmark/benchmark.h>

#include <cmath>

#include "svymath/curves/curve_ip.h"

namespace {

constexpr int kPoints = 64;

void lengthAndOffset(benchmark::State& state, AlntMathSpiralType type, double lenIn, double lenOut) {
  CCurveIp group;
  group.setSpiralType(type);
  group.setIp(5000500.0, 500000.0, 400.0, lenIn, lenOut);
  if (!group.setNeighbours(C2dPos(5000000.0, 500000.0), C2dPos(5000900.0, 500500.0))) {
    state.SkipWithError("the group does not fit");
    return;
  }
  C2dPos points[kPoints];
  for (int i = 0; i < kPoints; ++i) {
    const double s = group.getTotalLength() * (i + 0.5) / kPoints, offset = (i % 2 == 0 ? 1.0 : -1.0) * (i % 7);
    CMathAngle az;
    group.getAzimuthAtLength(s, az);
    group.getPosAtLength(s, points[i].north(), points[i].east());
    points[i] = C2dPos(points[i].north() - offset * az.getSin(), points[i].east() + offset * az.getCos());
  }
  int i = 0;
  for (auto _ : state) {
    const C2dPos& p = points[i++ % kPoints];
    double length = 0.0;
    double offset = 0.0;
    benchmark::DoNotOptimize(group.getLengthAndOffset(p.north(), p.east(), length, offset));
    benchmark::DoNotOptimize(length);
    benchmark::DoNotOptimize(offset);
  }
}

void BM_CurveIpLengthAndOffsetClothoid(benchmark::State& state) {
  lengthAndOffset(state, eMathSpiralEuler, 120.0, 80.0);
}
void BM_CurveIpLengthAndOffsetCubic(benchmark::State& state) { lengthAndOffset(state, eMathSpiralCubic, 120.0, 80.0); }
void BM_CurveIpLengthAndOffsetPlainArc(benchmark::State& state) { lengthAndOffset(state, eMathSpiralEuler, 0.0, 0.0); }

}  // namespace

BENCHMARK(BM_CurveIpLengthAndOffsetClothoid);
BENCHMARK(BM_CurveIpLengthAndOffsetCubic);
BENCHMARK(BM_CurveIpLengthAndOffsetPlainArc);
