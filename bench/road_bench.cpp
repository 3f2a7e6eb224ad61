// The road's per-point queries at survey coordinates: the design height at a chainage and offset (through
// the cross-section built there) and a cross-section at a chainage, on a 40-element alignment pair with a
// template set that alternates two seven-point templates (with cut and fill slopes) every 100 m, so that
// most sections are interpolated.
#include <benchmark/benchmark.h>

#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/horz_element_arc.h"
#include "svymath/alignments/horz_element_segment.h"
#include "svymath/alignments/horz_element_spiral.h"
#include "svymath/alignments/vertical_element.h"
#include "svymath/road/road_base_impl.h"

namespace {

constexpr int kElements = 40;

// Tangents, clothoid transitions and arcs (R 600, turning each way in turn), and a rolling profile.
void buildPair(CHorzAndVertAlnt& pair) {
  pair.setStartChainageInM(12000.0);
  pair.setStartPos(5000000.0, 500000.0, 350.0);
  pair.onBulkUpdateStarted();
  CAlntHeSegment tangent;
  tangent.setStartAndFinal(C2dPos(0.0, 0.0), C2dPos(80.0, 0.0));
  for (int curve = 0; curve < kElements / 4; ++curve) {
    const bool right = curve % 2 == 0;
    CCurveDataSpiral entry(eMathSpiralEuler), exit(eMathSpiralEuler);
    entry.setLenAndR(60.0, 600.0, right, true);
    exit.setLenAndR(60.0, 600.0, right, false);
    CCurveDataArc arcData;
    arcData.SetElement(60.0, 600.0, right);
    CAlntHeArc arc;
    arc.set_data(CCurveArc(0.0, 0.0, CMathAngle(0.0), arcData));
    pair.appendElement(tangent);
    pair.appendElement(CAlntHeSpiral(CCurveSpiral(0.0, 0.0, CMathAngle(0.0), entry)));
    pair.appendElement(arc);
    pair.appendElement(CAlntHeSpiral(CCurveSpiral(0.0, 0.0, CMathAngle(0.0), exit)));
  }
  pair.onBulkUpdateFinished();
  for (int i = 0; i < 10; ++i)
    pair.appendElement(CVerticalElement(12000.0 + 300.0 * i, 0.0, 300.0, i % 2 == 0 ? 1.5 : -1.0));
}

CCrossSectTemplate benchTemplate(double lane) {
  CCrossSectTemplate t(L"bench");
  t.addPoint(L"CL", 0.0, 0.0);
  for (double side : {-1.0, 1.0}) {
    t.addPoint(L"EP", lane * side, -0.025 * lane);
    t.addPoint(L"SH", (lane + 1.5) * side, -0.025 * lane - 0.06);
    t.addPoint(L"DT", (lane + 3.0) * side, -0.025 * lane - 0.6);
    t.setSideSlopes(side > 0.0, 2.0, -3.0);
  }
  return t;
}

struct TBenchRoad {
  CHorzAndVertAlnt pair;
  CXsSf templates;
  CRoadBaseImpl road;
  double chainages[64];

  TBenchRoad() {
    buildPair(pair);
    double end = 0.0;
    pair.getFinalChainageInM(end);
    for (double c = 12000.0; c <= end; c += 100.0) {
      templates.assignTemplate(c, benchTemplate(static_cast<int>(c / 100.0) % 2 == 0 ? 3.5 : 5.0));
    }
    road.setAlignments(pair);
    road.setXsSf(&templates);
    for (int i = 0; i < 64; ++i) chainages[i] = 12000.0 + (end - 12000.0) * ((i * 37) % 64) / 63.0;
  }
};

void BM_RoadHeightAtChainageAndOffset(benchmark::State& state) {
  const TBenchRoad r;
  int i = 0;
  for (auto _ : state) {
    double height = 0.0;
    double slope = 0.0;
    const int k = i++ & 63;
    benchmark::DoNotOptimize(r.road.getHtAtChainAndOffset(r.chainages[k], (k % 13) - 6.0, height, true, &slope));
    benchmark::DoNotOptimize(height);
  }
}
BENCHMARK(BM_RoadHeightAtChainageAndOffset);

void BM_RoadCrossSectionAtChainage(benchmark::State& state) {
  const TBenchRoad r;
  int i = 0;
  for (auto _ : state) {
    CRoadCrossSection* section = nullptr;
    benchmark::DoNotOptimize(r.road.getCrossSectionAtChainage(r.chainages[i++ & 63], section, true));
    delete section;
  }
}
BENCHMARK(BM_RoadCrossSectionAtChainage);

}  // namespace
