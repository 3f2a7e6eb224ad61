// Offset curves and offset alignments: the length of a spiral's offset curve against the summed chords of its
// points, round trips of (length, offset) through a point, directions against differences of positions, the
// exact parallel of an arc, the refusal inside a centre of curvature, and stake-out lists along an alignment.
#include <gtest/gtest.h>

#include <cmath>

#include "alignments/alignment_test_support.h"
#include "svymath/road/offset_plane.h"
#include "svymath/road/offset_points.h"
#include "svymath/road/offset_stations.h"
#include "svymath/road/offset_ts.h"

namespace {

using alnt_test::dist;

// The element placed alone in an alignment at survey coordinates, heading 30 degrees, from chainage 500.
CAlntH placed(const CAlntHe& element) {
  CAlntH alignment;
  alignment.setStartPos(alnt_test::kNorth0, alnt_test::kEast0, 0.0);
  alignment.setStartChainageInM(500.0);
  EXPECT_TRUE(alignment.appendElement(alnt_test::tangent(10.0, 30.0)));
  EXPECT_TRUE(alignment.appendElement(element));
  return alignment;
}

C2dPos sideways(const C2dPos& p, double azimuthDeg, double offset) {
  const CMathAngle right(azimuthDeg + 90.0);
  return C2dPos(p.north() + offset * right.getCos(), p.east() + offset * right.getSin());
}

struct TElementCase {
  const char* name;
  CAlntHe* (*make)();
};

CAlntHe* makeTangent() { return new CAlntHeSegment(alnt_test::tangent(120.0)); }
CAlntHe* makeArcRight() { return new CAlntHeArc(alnt_test::arc(150.0, 250.0, true)); }
CAlntHe* makeClothoidIn() { return new CAlntHeSpiral(alnt_test::spiral(90.0, 200.0, true, true)); }
CAlntHe* makeClothoidOutLeft() { return new CAlntHeSpiral(alnt_test::spiral(90.0, 150.0, false, false)); }
CAlntHe* makeCubic() { return new CAlntHeSpiral(alnt_test::spiral(70.0, 300.0, true, true, eMathSpiralCubic)); }

class PlaneOffsetElement : public ::testing::TestWithParam<std::tuple<TElementCase, double>> {};

TEST_P(PlaneOffsetElement, LengthPositionAzimuthAndPointRoundTrip) {
  const auto& [kind, offset] = GetParam();
  const std::unique_ptr<CAlntHe> element(kind.make());
  const CAlntH alignment = placed(*element);
  const CAlntHe& he = *alignment.getHe(1);
  const PlaneOffset curve(he, offset);
  ASSERT_TRUE(curve.isok());
  double length = 0.0, base = 0.0;
  ASSERT_TRUE(curve.getLength(length) && he.getHLengthInM(base));
  // Oracle: the chords of 20000 points of the offset curve taken straight from the element.
  constexpr int kSteps = 20000;
  double chords = 0.0;
  C2dPos before;
  for (int i = 0; i <= kSteps; ++i) {
    C2dPos p;
    ASSERT_TRUE(he.getPosAtLengthAndOffset(base * i / kSteps, offset, p.north(), p.east()));
    if (i > 0) chords += dist(p, before);
    before = p;
  }
  EXPECT_NEAR(length, chords, 1e-7) << kind.name;
  for (double fraction : {0.0, 0.13, 0.5, 0.77, 1.0}) {
    const double at = fraction * length;
    C2dPos p, ahead, behind;
    double azimuth = 0.0, back = 0.0, foot = 0.0;
    ASSERT_TRUE(curve.getPosNeAtLength(at, p.north(), p.east()) && curve.getAzimuthAtLength(at, azimuth));
    // The direction against a central difference of positions (one-sided at the ends).
    const double h = 1e-3;
    ASSERT_TRUE(curve.getPosNeAtLength(std::min(at + h, length), ahead.north(), ahead.east()) &&
                curve.getPosNeAtLength(std::max(at - h, 0.0), behind.north(), behind.east()));
    const double chordAz = std::atan2(ahead.east() - behind.east(), ahead.north() - behind.north());
    EXPECT_NEAR(std::remainder(azimuth * svy_math::units::kDegToRad - chordAz, svy_math::units::kTwoPi), 0.0, 1e-5);
    // (length, offset) -> point -> (length, offset).
    const C2dPos q = sideways(p, azimuth, 1.75);
    ASSERT_TRUE(curve.getLengthAndOffset(q.north(), q.east(), back, foot));
    // Two resolutions of a coordinate near 5 000 000 m (9.3e-10 m).
    EXPECT_NEAR(back, at, 2e-9) << kind.name << " " << fraction;
    EXPECT_NEAR(foot, 1.75, 2e-9);
  }
}

INSTANTIATE_TEST_SUITE_P(
    Elements, PlaneOffsetElement,
    ::testing::Combine(::testing::Values(TElementCase{"tangent", makeTangent}, TElementCase{"arc", makeArcRight},
                                         TElementCase{"clothoid", makeClothoidIn},
                                         TElementCase{"clothoid left", makeClothoidOutLeft},
                                         TElementCase{"cubic", makeCubic}),
                       ::testing::Values(-7.5, 3.5, 40.0)));

TEST(PlaneOffset, ArcParallelIsExactAndRefusedAtTheCentre) {
  const CAlntH alignment = placed(alnt_test::arc(100.0, 50.0, true));
  const CAlntHe& arc = *alignment.getHe(1);
  const struct {
    double offset;
    bool ok;
  } cases[] = {{-60.0, true}, {0.0, true}, {49.0, true}, {50.0, false}, {80.0, false}, {NAN, false}};
  for (const auto& c : cases) {
    const PlaneOffset curve(arc, c.offset);
    double length = -1.0, north = -1.0, east = -1.0;
    EXPECT_EQ(curve.isok(), c.ok) << c.offset;
    EXPECT_EQ(curve.getLength(length), c.ok);
    if (c.ok) {
      EXPECT_NEAR(length, 100.0 * (50.0 - c.offset) / 50.0, 1e-10);
    }
    EXPECT_EQ(curve.getPosNeAtLength(0.0, north, east), c.ok);
  }
  // A spiral reaching R 50 refuses the same offset on its inside.
  const CAlntH spiral = placed(alnt_test::spiral(60.0, 50.0, true, true));
  EXPECT_FALSE(PlaneOffset(*spiral.getHe(1), 50.0).isok());
  EXPECT_TRUE(PlaneOffset(*spiral.getHe(1), 49.0).isok());
}

TEST(Offsets4TS, PointAtChainageAndOffsetLiesOnTheOffsetAlignment) {
  const CAlntH alignment = alnt_test::mixedAlignment(21, 3);
  double end = 0.0;
  ASSERT_TRUE(alignment.getFinalChainageInM(end));
  for (double offset : {-3.5, 0.0, 6.0}) {
    const Offsets4TS lane(alignment, offset);
    ASSERT_TRUE(lane.isok());
    for (double c = alignment.getStartChainageInM(); c <= end; c += 13.7) {
      C2dPos p, onLane;
      double chainage = 0.0, across = 0.0;
      ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(c, offset + 1.2, p.north(), p.east()));
      ASSERT_TRUE(lane.getChainageAndOffset(p.north(), p.east(), chainage, across));
      EXPECT_NEAR(chainage, c, 1e-8);
      EXPECT_NEAR(across, 1.2, 1e-8);
      ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(c, offset, p.north(), p.east()) &&
                  lane.getPosNeAtChain(c, onLane.north(), onLane.east()));
      EXPECT_LT(dist(p, onLane), 1e-9);
    }
  }
}

TEST(Offsets4TS, WideningRunsLinearlyAndTurnsTheEdge) {
  const CAlntH alignment = alnt_test::mixedAlignment(4, 2);
  const double c0 = alignment.getStartChainageInM() + 40.0, c1 = c0 + 200.0;
  const Offsets4TS edge(alignment, c0, 3.5, c1, 7.0);
  ASSERT_TRUE(edge.isok());
  const struct {
    double chainage, offset;
  } cases[] = {{c0 - 30.0, 3.5}, {c0, 3.5}, {c0 + 50.0, 4.375}, {c1, 7.0}, {c1 + 90.0, 7.0}};
  for (const auto& c : cases) EXPECT_DOUBLE_EQ(edge.getOffsetAtChain(c.chainage), c.offset);
  // The edge's direction against the chord of its neighbouring points, on and off the widening.
  for (double c : {c0 - 20.0, c0 + 10.0, c0 + 120.0, c1 + 25.0}) {
    C2dPos ahead, behind;
    double azimuth = 0.0;
    ASSERT_TRUE(edge.getAzimuthAtChain(c, azimuth) && edge.getPosNeAtChain(c + 1e-3, ahead.north(), ahead.east()) &&
                edge.getPosNeAtChain(c - 1e-3, behind.north(), behind.east()));
    const double chordAz = std::atan2(ahead.east() - behind.east(), ahead.north() - behind.north());
    EXPECT_NEAR(std::remainder(azimuth * svy_math::units::kDegToRad - chordAz, svy_math::units::kTwoPi), 0.0, 1e-6)
        << c;
  }
  std::vector<TOffsetAlntPoint> points;
  ASSERT_TRUE(edge.getPoints(25.0, points));
  for (double c : {c0, c1}) {
    EXPECT_TRUE(std::any_of(points.begin(), points.end(), [&](const TOffsetAlntPoint& p) { return p.chainage == c; }));
  }
  EXPECT_FALSE(edge.getPoints(0.0, points));
  // Inside a curve of R 300 to 1500 an edge 2 km to the side crosses the centres.
  const Offsets4TS far(alignment, c0, 3.5, c1, 2000.0), farLeft(alignment, -2000.0);
  EXPECT_FALSE(far.isok() && farLeft.isok());
  double north = 0.0, east = 0.0;
  EXPECT_FALSE(Offsets4TS(alignment, 5000.0).getPosNeAtChain(c0, north, east));
}

TEST(OffsetPoints, StationsJointsAndOffsetsOfAStakeOutList) {
  // Chainage 0: a tangent of 99.9995 m (its end is kept, not station 100), an arc of 50 m.
  CAlntH alignment;
  alignment.setStartPos(alnt_test::kNorth0, alnt_test::kEast0, 0.0);
  ASSERT_TRUE(alignment.appendElement(alnt_test::tangent(99.9995, 60.0)));
  ASSERT_TRUE(alignment.appendElement(alnt_test::arc(50.0, 200.0, false)));
  std::vector<double> chainages;
  ASSERT_TRUE(svy_math::StakeOutChainages(alignment, 0.0, 149.9995, 20.0, {55.0}, chainages));
  const std::vector<double> expected{0.0, 20.0, 40.0, 55.0, 60.0, 80.0, 99.9995, 120.0, 140.0, 149.9995};
  ASSERT_EQ(chainages.size(), expected.size());
  for (std::size_t i = 0; i < expected.size(); ++i) EXPECT_NEAR(chainages[i], expected[i], 1e-9);
  EXPECT_FALSE(svy_math::StakeOutChainages(alignment, 0.0, 100.0, -1.0, {}, chainages));
  EXPECT_FALSE(svy_math::StakeOutChainages(alignment, 0.0, 1e300, 1e-3, {}, chainages));

  OffsetPoints list(alignment);
  ASSERT_TRUE(list.addStations(0.0, 149.9995, 20.0, {-5.0, 5.0}));
  list.addPoint(200.0, 0.0);  // beyond the end
  EXPECT_EQ(list.compute(), 2 * 9);
  ASSERT_EQ(list.getNumOfPoints(), 19);
  for (int i = 0; i < list.getNumOfPoints(); ++i) {
    const TStakeOutPoint& p = *list.getPoint(i);
    double chainage = 0.0, offset = 0.0;
    bool extrapolated = false;
    if (!p.found) continue;
    ASSERT_TRUE(alignment.FindChainageAndOffset(p.north, p.east, chainage, offset, extrapolated));
    EXPECT_NEAR(chainage, p.chainage, 1e-8);
    EXPECT_NEAR(offset, p.offset, 1e-8);
  }
  EXPECT_FALSE(list.getPoint(18)->found);
  EXPECT_EQ(list.getPoint(19), nullptr);
}

}  // namespace
