#pragma once
// Builders shared by the alignment tests: elements by kind, and mixed alignments of tangents, arcs, clothoid
// and cubic transitions laid out like a road (tangent, entry spiral, arc, exit spiral, ...).
#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "support/geometry.h"
#include "svymath/alignments/alignment_h.h"
#include "svymath/alignments/horz_element_arc.h"
#include "svymath/alignments/horz_element_segment.h"
#include "svymath/alignments/horz_element_spiral.h"

namespace alnt_test {

using svy_test::dist;

// Survey-sized coordinates: a double resolves about 1e-9 m here.
constexpr double kNorth0 = 5000000.0;
constexpr double kEast0 = 500000.0;

inline CAlntHeSegment tangent(double length, double azDeg = 0.0) {
  CAlntHeSegment element;
  const CMathAngle az(azDeg);
  element.setStartAndFinal(C2dPos(0.0, 0.0), C2dPos(length * az.getCos(), length * az.getSin()));
  return element;
}

// Radius magnitude; right turns for right == true.
inline CAlntHeArc arc(double length, double radius, bool right) {
  CCurveDataArc data;
  data.SetElement(length, radius, right);
  CAlntHeArc element;
  element.set_data(CCurveArc(0.0, 0.0, CMathAngle(0.0), data));
  return element;
}

inline CAlntHeSpiral spiral(double length, double radius, bool right, bool entering,
                            AlntMathSpiralType law = eMathSpiralEuler) {
  CCurveDataSpiral data(law);
  data.setLenAndR(length, radius, right, entering);
  return CAlntHeSpiral(CCurveSpiral(0.0, 0.0, CMathAngle(0.0), data));
}

// A road-like alignment of `curves` curve groups (entry spiral, arc, exit spiral; clothoid or cubic) between
// tangents, with random lengths, radii and sides, starting at (kNorth0, kEast0) heading startAzDeg.
inline CAlntH mixedAlignment(unsigned seed, int curves, double startChainage = 1000.0, double startAzDeg = 30.0) {
  std::mt19937 rng(seed);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  CAlntH alignment;
  alignment.setStartPos(kNorth0, kEast0, 0.0);
  alignment.setStartChainageInM(startChainage);
  CAlntHeSegment first = tangent(50.0 + 100.0 * unit(rng), startAzDeg);
  EXPECT_TRUE(alignment.appendElement(first));
  for (int c = 0; c < curves; ++c) {
    const bool right = unit(rng) < 0.5;
    const double radius = 300.0 + 1200.0 * unit(rng);
    const AlntMathSpiralType law = unit(rng) < 0.7 ? eMathSpiralEuler : eMathSpiralCubic;
    const double lenIn = 40.0 + 40.0 * unit(rng);
    const double lenOut = 40.0 + 40.0 * unit(rng);
    EXPECT_TRUE(alignment.appendElement(spiral(lenIn, radius, right, true, law)));
    EXPECT_TRUE(alignment.appendElement(arc(30.0 + 150.0 * unit(rng), radius, right)));
    EXPECT_TRUE(alignment.appendElement(spiral(lenOut, radius, right, false, law)));
    EXPECT_TRUE(alignment.appendElement(tangent(20.0 + 100.0 * unit(rng))));
  }
  return alignment;
}

}  // namespace alnt_test
