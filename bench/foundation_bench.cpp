// Angle normalisation and rotation by a CMathAngle, whose sine and cosine are computed once per value.
#include <benchmark/benchmark.h>

#include <cmath>
#include <vector>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/math_angle.h"

namespace {

std::vector<double> sampleAngles(double spread) {
  std::vector<double> values(1024);
  for (std::size_t i = 0; i < values.size(); ++i) {
    values[i] = spread * std::sin(static_cast<double>(i) * 0.7368);
  }
  return values;
}

void BM_ToRangeOrdinary(benchmark::State& state) {
  const std::vector<double> values = sampleAngles(20.0);
  for (auto _ : state) {
    for (double v : values) benchmark::DoNotOptimize(toRange(v, -3.141592653589793, 3.141592653589793));
  }
  state.SetItemsProcessed(state.iterations() * static_cast<long>(values.size()));
}
BENCHMARK(BM_ToRangeOrdinary);

void BM_ToRangeHuge(benchmark::State& state) {
  const std::vector<double> values = sampleAngles(1e12);
  for (auto _ : state) {
    for (double v : values) benchmark::DoNotOptimize(toRange(v, -3.141592653589793, 3.141592653589793));
  }
  state.SetItemsProcessed(state.iterations() * static_cast<long>(values.size()));
}
BENCHMARK(BM_ToRangeHuge);

void BM_NormalizeNegPiToPi(benchmark::State& state) {
  const std::vector<double> values = sampleAngles(20.0);
  for (auto _ : state) {
    for (double v : values) benchmark::DoNotOptimize(NormalizeNegPiToPi(v));
  }
  state.SetItemsProcessed(state.iterations() * static_cast<long>(values.size()));
}
BENCHMARK(BM_NormalizeNegPiToPi);

void BM_CMathAngleSetDeg(benchmark::State& state) {
  const std::vector<double> values = sampleAngles(720.0);
  CMathAngle angle;
  for (auto _ : state) {
    for (double v : values) {
      angle.setDeg(v);
      benchmark::DoNotOptimize(angle);
    }
  }
  state.SetItemsProcessed(state.iterations() * static_cast<long>(values.size()));
}
BENCHMARK(BM_CMathAngleSetDeg);

// Many rotations by one angle: the sine and cosine come from the cache after the first.
void BM_CMathAngleRotateCached(benchmark::State& state) {
  const CMathAngle angle(33.3);
  double n = 1.0, e = 2.0;
  for (auto _ : state) {
    for (int i = 0; i < 1024; ++i) {
      angle.getRotated(n, e);
      benchmark::DoNotOptimize(n);
      benchmark::DoNotOptimize(e);
    }
  }
  state.SetItemsProcessed(state.iterations() * 1024);
}
BENCHMARK(BM_CMathAngleRotateCached);

// The same rotations with a fresh angle each time: sine and cosine recomputed, the cost the cache saves.
void BM_CMathAngleRotateFresh(benchmark::State& state) {
  double n = 1.0, e = 2.0;
  for (auto _ : state) {
    for (int i = 0; i < 1024; ++i) {
      CMathAngle angle;
      angle.setRad(0.5812 + 1e-9 * i);
      angle.getRotated(n, e);
      benchmark::DoNotOptimize(n);
      benchmark::DoNotOptimize(e);
    }
  }
  state.SetItemsProcessed(state.iterations() * 1024);
}
BENCHMARK(BM_CMathAngleRotateFresh);

}  // namespace
