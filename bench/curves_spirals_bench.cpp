// Hot paths of the transition spirals: the Fresnel integrals in each regime (series below 1.5, fitted
// auxiliary functions up to 7, their asymptotic series beyond), clothoid and cubic positions (what every chainage query on a spiral element costs), the
// cubic's radius search when an element is defined, and the chord step of a staking run.
#include <benchmark/benchmark.h>

#include "svymath/curves/curve_data_spiral.h"
#include "svymath/curves/spiral_cubic.h"
#include "svymath/curves/spiral_euler.h"
#include "svymath/curves/spiral_fresnel.h"

namespace {

// Arguments spread over [lo, hi), so that each call takes a slightly different path.
void fresnel(benchmark::State& state, double lo, double hi) {
  double t[16];
  for (int i = 0; i < 16; ++i) t[i] = lo + (hi - lo) * i / 16.0;
  int i = 0;
  for (auto _ : state) {
    double S = 0.0;
    double C = 0.0;
    svy_math::fresnelCS(t[i++ & 15], S, C);
    benchmark::DoNotOptimize(S);
    benchmark::DoNotOptimize(C);
  }
}

void BM_FresnelSeriesSmall(benchmark::State& state) { fresnel(state, 0.01, 0.5); }
void BM_FresnelSeriesNearSwitch(benchmark::State& state) { fresnel(state, 1.0, 1.5); }
void BM_FresnelAuxiliaryNearSwitch(benchmark::State& state) { fresnel(state, 1.5, 2.0); }
void BM_FresnelAuxiliaryFitted(benchmark::State& state) { fresnel(state, 2.0, 7.0); }
void BM_FresnelAuxiliaryAsymptotic(benchmark::State& state) { fresnel(state, 7.0, 1000.0); }

template <class Law>
void positions(benchmark::State& state, const Law& law) {
  int i = 0;
  for (auto _ : state) {
    double n = 0.0;
    double e = 0.0;
    law.getPosAtLength(law.getLength() * (i++ & 63) / 63.0, n, e);
    benchmark::DoNotOptimize(n);
    benchmark::DoNotOptimize(e);
  }
}

void BM_ClothoidPosition(benchmark::State& state) {
  CEulerSpiralTStoSC law;
  law.setLenAndR(120.0, 400.0, true);
  positions(state, law);
}

void BM_CubicPosition(benchmark::State& state) {
  CCubicSpiralTStoSC law;
  law.setLenAndR(120.0, 400.0, true);
  positions(state, law);
}

void BM_CubicSetLenAndR(benchmark::State& state) {
  CCubicSpiralTStoSC law;
  int i = 0;
  for (auto _ : state) benchmark::DoNotOptimize(law.setLenAndR(120.0, 200.0 + (i++ & 255), true));
}

void BM_PartialSpiralPosition(benchmark::State& state) {
  CCurveDataSpiral data(static_cast<AlntMathSpiralType>(state.range(0)));
  data.setLenAndTwoR(60.0, 1000.0, 350.0, true, true);
  int i = 0;
  for (auto _ : state) {
    double n = 0.0;
    double e = 0.0;
    data.getPosAtLength(60.0 * (i++ & 63) / 63.0, n, e);
    benchmark::DoNotOptimize(n);
  }
}

void BM_SpiralStepForDeviation(benchmark::State& state) {
  CCurveDataSpiral data;
  data.setLenAndR(120.0, 400.0, true, true);
  int i = 0;
  for (auto _ : state) benchmark::DoNotOptimize(data.getStepForDeviation(120.0 * (i++ & 63) / 64.0, 0.005));
}

}  // namespace

BENCHMARK(BM_FresnelSeriesSmall);
BENCHMARK(BM_FresnelSeriesNearSwitch);
BENCHMARK(BM_FresnelAuxiliaryNearSwitch);
BENCHMARK(BM_FresnelAuxiliaryFitted);
BENCHMARK(BM_FresnelAuxiliaryAsymptotic);
BENCHMARK(BM_ClothoidPosition);
BENCHMARK(BM_CubicPosition);
BENCHMARK(BM_CubicSetLenAndR);
BENCHMARK(BM_PartialSpiralPosition)->Arg(eMathSpiralEuler)->Arg(eMathSpiralCubic);
BENCHMARK(BM_SpiralStepForDeviation);
