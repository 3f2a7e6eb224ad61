#pragma once
// Builders shared by the alignment tests: elements by kind, and mixed alignments of tangents, arcs, clothoid
// and cubic transitions laid out like a road (tangent, entry spiral, arc, exit spiral, ...).
#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "support/geometry.h"
#include "svymath/alignments/alignment_h.h"
#include "svymath/alignments/horz_element_arc.h"
#include "svymath/alignments/horz_element_ip.h"
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

// Each element starts exactly where its predecessor ends, at its final chainage, heading along its final
// azimuth (within tolerance: a kink-free alignment), and (where every curve has transitions) the curvature
// runs on through the joint.
inline void expectContinuousJoints(const CAlntH& alignment, double tolerance, bool withCurvature = true) {
  for (int i = 1; i < alignment.getNumOfHes(); ++i) {
    const CAlntHe& before = *alignment.getHe(i - 1);
    const CAlntHe& after = *alignment.getHe(i);
    double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0, ch1 = 0.0, ch2 = 0.0, k1 = 0.0, k2 = 0.0;
    CMathAngle a1, a2;
    ASSERT_TRUE(before.getFinalPosNe(n1, e1) && after.getStartPosNe(n2, e2));
    ASSERT_TRUE(before.getFinalChainageInM(ch1) && after.getStartChainageInM(ch2));
    ASSERT_TRUE(before.getFinalAzimut(a1) && after.getStartAzimut(a2));
    EXPECT_EQ(ch1, ch2) << i;
    EXPECT_LE(dist(C2dPos(n1, e1), C2dPos(n2, e2)), tolerance) << i;
    EXPECT_TRUE(a1.isEqual(a2, tolerance)) << i << ": " << a1.getDeg() << " " << a2.getDeg();
    ASSERT_TRUE(alignment.getCurvatureAtChainage(ch1 - 1e-7, k1) && alignment.getCurvatureAtChainage(ch1, k2));
    if (withCurvature) {
      EXPECT_NEAR(k1, k2, 1e-9) << i;
    }
  }
}

inline CAlntHeIp ipElement(const C2dPos& ip, double radius, double lenIn, double lenOut,
                           AlntMathSpiralType law = eMathSpiralEuler) {
  CAlntHeIp element;
  CCurveIp group;
  group.setSpiralType(law);
  EXPECT_TRUE(group.setIp(ip.north(), ip.east(), radius, lenIn, lenOut));
  element.set_data(group);
  return element;
}

// Appends `count` intersection points in a random walk from the alignment's end (legs of 600 to 900 m,
// turns of 20 to 60 degrees either way), each with a curve group; the last one ends the alignment.
inline void appendIpRun(CAlntH& alignment, unsigned seed, int count) {
  std::mt19937 rng(seed);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  C2dPos at;
  CMathAngle heading;
  EXPECT_TRUE(alignment.getFinalPosNe(at.north(), at.east()) && alignment.getLastHe()->getFinalAzimut(heading));
  double azDeg = heading.getDeg();
  for (int i = 0; i < count; ++i) {
    const double leg = 600.0 + 300.0 * unit(rng);
    at = C2dPos(at.north() + leg * CMathAngle(azDeg).getCos(), at.east() + leg * CMathAngle(azDeg).getSin());
    const AlntMathSpiralType law = unit(rng) < 0.7 ? eMathSpiralEuler : eMathSpiralCubic;
    EXPECT_TRUE(alignment.appendElement(
        ipElement(at, 300.0 + 500.0 * unit(rng), 30.0 + 50.0 * unit(rng), 30.0 + 50.0 * unit(rng), law)));
    azDeg += (unit(rng) < 0.5 ? -1.0 : 1.0) * (20.0 + 40.0 * unit(rng));
  }
}

}  // namespace alnt_test
