// Position caches: building the 1 mm cache of a 10 km alignment of tangents and clothoid-arc-clothoid curves
// (left and right in turn), and interpolating positions by chainage from the built cache.
#include <benchmark/benchmark.h>

#include "svymath/alignments/alignment_h.h"
#include "svymath/alignments/horz_element_arc.h"
#include "svymath/alignments/horz_element_segment.h"
#include "svymath/alignments/horz_element_spiral.h"
#include "svymath/alignments/pos_cache.h"

namespace {

constexpr double kLength = 10000.0;  // metres

// Tangent 300 m, clothoid 80 m into an arc of R 600 m over 200 m, clothoid 80 m out: 660 m a group.
CAlntH makeRoad() {
  CAlntH alignment;
  alignment.setStartPos(5000000.0, 500000.0, 0.0);
  double length = 0.0;
  for (int k = 0; length < kLength; ++k) {
    const bool right = k % 2 == 0;
    CAlntHeSegment tangent;
    tangent.setStartAndFinal(C2dPos(0.0, 0.0), C2dPos(300.0, 0.0));
    alignment.appendElement(tangent);
    for (bool entering : {true, false}) {
      CCurveDataSpiral data(eMathSpiralEuler);
      data.setLenAndR(80.0, 600.0, right, entering);
      if (!entering) {
        CCurveDataArc arcData;
        arcData.SetElement(200.0, 600.0, right);
        CAlntHeArc arc;
        arc.set_data(CCurveArc(0.0, 0.0, CMathAngle(0.0), arcData));
        alignment.appendElement(arc);
      }
      alignment.appendElement(CAlntHeSpiral(CCurveSpiral(0.0, 0.0, CMathAngle(0.0), data)));
    }
    alignment.getHLengthInM(length);
  }
  return alignment;
}

void BM_PosCacheBuild10km1mm(benchmark::State& state) {
  const CAlntH alignment = makeRoad();
  std::size_t positions = 0;
  for (auto _ : state) {
    CAlnt2dPosCache cache(alignment, 0.001);
    benchmark::DoNotOptimize(cache.update());
    positions = cache.getNumOfPositions();
  }
  state.counters["positions"] = static_cast<double>(positions);
}
BENCHMARK(BM_PosCacheBuild10km1mm)->Unit(benchmark::kMillisecond);

void BM_PosCacheQuery(benchmark::State& state) {
  const CAlntH alignment = makeRoad();
  CAlnt2dPosCache cache(alignment, 0.001);
  cache.update();
  double chainage = 0.0;
  for (auto _ : state) {
    double north = 0.0, east = 0.0;
    benchmark::DoNotOptimize(cache.getPosNeAtChain(chainage, north, east));
    chainage = chainage < kLength - 7.3 ? chainage + 7.3 : 0.0;
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_PosCacheQuery);

}  // namespace
