// The horizontal alignment: round trips of position and chainage over mixed alignments (also beyond both
// ends), continuity at the joints, re-anchoring after every kind of edit, the lookup and search rules.
#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "alignment_test_support.h"
#include "svymath/curves/generic_segment_visitor.h"

using namespace alnt_test;

namespace {

double totalLength(const CAlntH& alignment) {
  double length = svy_math::undefinedValue();
  EXPECT_TRUE(alignment.getHLengthInM(length));
  return length;
}

// Positions every 9.7 m (and at the ends) of two alignments agree within 1e-9 m.
void expectSameGeometry(const CAlntH& actual, const CAlntH& expected) {
  ASSERT_EQ(actual.getNumOfHes(), expected.getNumOfHes());
  EXPECT_EQ(actual.getStartChainageInM(), expected.getStartChainageInM());
  const double length = totalLength(expected);
  EXPECT_NEAR(totalLength(actual), length, 1e-9);
  for (double d = 0.0; d <= length + 1e-9; d = d + 9.7 > length && d < length ? length : d + 9.7) {
    const double ch = expected.distance2Chainage(d);
    double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0;
    ASSERT_TRUE(actual.getPosNeAtChain(ch, n1, e1) && expected.getPosNeAtChain(ch, n2, e2)) << ch;
    EXPECT_NEAR(n1, n2, 1e-9) << ch;
    EXPECT_NEAR(e1, e2, 1e-9) << ch;
  }
}

CAlntH fromElements(const std::vector<const CAlntHe*>& elements, double startChainage = 1000.0) {
  CAlntH alignment;
  alignment.setStartPos(kNorth0, kEast0, 0.0);
  alignment.setStartChainageInM(startChainage);
  for (const CAlntHe* element : elements) EXPECT_TRUE(alignment.appendElement(*element));
  return alignment;
}

}  // namespace

// Position at (chainage, offset), then the point back to (chainage, offset), on and beyond alignments of
// tangents, arcs, clothoid and cubic spirals and intersection-point groups.
TEST(AlignmentRoundTrip, MixedAlignmentsAndExtensions) {
  for (const unsigned seed : {1u, 2u, 3u}) {
    CAlntH alignment = mixedAlignment(seed, 4, 1000.0 * seed, 90.0 * seed);
    appendIpRun(alignment, seed, 3);
    ASSERT_TRUE(alignment.appendElement(tangent(70.0)));
    const double start = alignment.getStartChainageInM();
    const double length = totalLength(alignment);
    for (double ch = start - 80.0; ch <= start + length + 80.0; ch += 6.1) {
      for (const double off : {-40.0, -2.5, 0.0, 0.4, 25.0}) {
        double n = 0.0, e = 0.0, c = 0.0, o = 0.0;
        bool extrapolated = false, predicted = false;
        ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(ch, off, n, e, &predicted));
        ASSERT_TRUE(alignment.FindChainageAndOffset(n, e, c, o, extrapolated)) << seed << " " << ch;
        EXPECT_NEAR(c, ch, 1e-6) << seed << " " << ch << " " << off;
        EXPECT_NEAR(o, off, 1e-6) << seed << " " << ch << " " << off;
        EXPECT_EQ(extrapolated, predicted) << seed << " " << ch << " " << off;
        double c6 = 0.0, o6 = 0.0;
        if (!predicted) {
          EXPECT_TRUE(alignment.FindChainageAndOffset(n, e, c6, o6) && c6 == c && o6 == o) << ch << " " << off;
        }
      }
    }
  }
}

TEST(AlignmentRoundTrip, ContinuityAtEveryJoint) {
  CAlntH alignment = mixedAlignment(7, 5);
  expectContinuousJoints(alignment, 1e-12);
  appendIpRun(alignment, 7, 3);
  // Intersection-point groups are placed from their IPs: their joints agree to the last digits.
  expectContinuousJoints(alignment, 1e-8);
}

TEST(AlignmentEditing, ReanchorsAfterEveryEdit) {
  const CAlntHeSegment t1 = tangent(120.0, 10.0), t2 = tangent(60.0), t3 = tangent(35.0);
  const CAlntHeSpiral in = spiral(50.0, 400.0, true, true), out = spiral(50.0, 400.0, true, false);
  const CAlntHeArc a = arc(90.0, 400.0, true), b = arc(40.0, 150.0, false);
  const CAlntH reference = fromElements({&t1, &in, &a, &out, &t2});

  CAlntH edited = fromElements({&t1, &in, &out, &t2});
  ASSERT_TRUE(edited.insertElement(2, a));
  expectSameGeometry(edited, reference);
  ASSERT_TRUE(edited.replaceElement(2, b));
  expectSameGeometry(edited, fromElements({&t1, &in, &b, &out, &t2}));
  ASSERT_TRUE(edited.removeHe(2));
  expectSameGeometry(edited, fromElements({&t1, &in, &out, &t2}));
  ASSERT_TRUE(edited.insertElement(0, t3));
  expectSameGeometry(edited, fromElements({&t3, &t1, &in, &out, &t2}));
  ASSERT_TRUE(edited.removeHe(0));
  EXPECT_FALSE(edited.removeHe(4));
  EXPECT_FALSE(edited.insertElement(6, t3));
  EXPECT_FALSE(edited.replaceElement(-1, t3));

  // Start point and start chainage move everything.
  CAlntH moved = reference;
  moved.setStartPos(kNorth0 + 10.0, kEast0 - 5.0, 123.0);
  moved.setStartChainageInM(0.0);
  double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0;
  ASSERT_TRUE(moved.getFinalPosNe(n1, e1) && reference.getFinalPosNe(n2, e2));
  EXPECT_NEAR(n1 - n2, 10.0, 1e-9);
  EXPECT_NEAR(e1 - e2, -5.0, 1e-9);
  ASSERT_TRUE(moved.getPosNeAtChain(200.0, n1, e1) && reference.getPosNeAtChain(1200.0, n2, e2));
  EXPECT_NEAR(n1 - n2, 10.0, 1e-9);

  // A bulk update leaves the chain stale until it finishes, then matches a normal build.
  CAlntH bulk = fromElements({&t1});
  bulk.onBulkUpdateStarted();
  EXPECT_TRUE(bulk.isInBulkUpdate());
  for (const CAlntHe* element : {static_cast<const CAlntHe*>(&in), static_cast<const CAlntHe*>(&a),
                                 static_cast<const CAlntHe*>(&out), static_cast<const CAlntHe*>(&t2)}) {
    ASSERT_TRUE(bulk.appendElement(*element));
  }
  double ch = 0.0;
  EXPECT_FALSE(bulk.getHe(2)->getStartChainageInM(ch));
  bulk.setStartChainageInM(1000.0);
  bulk.onBulkUpdateFinished();
  EXPECT_FALSE(bulk.isInBulkUpdate());
  expectSameGeometry(bulk, reference);

  // Copies are independent.
  CAlntH copy = reference;
  copy.removeAllHes();
  EXPECT_EQ(copy.getNumOfHes(), 0);
  EXPECT_EQ(reference.getNumOfHes(), 5);
  copy = reference;
  expectSameGeometry(copy, reference);
}

TEST(AlignmentEditing, RemovingTheOnlyElementLeavesAnEmptyAlignment) {
  const CAlntHeSegment t = tangent(50.0);
  CAlntH alignment = fromElements({&t});
  ASSERT_TRUE(alignment.removeHe(0));
  double length = -1.0, n = 0.0, e = 0.0, c = 0.0, o = 0.0;
  bool extrapolated = false;
  ASSERT_TRUE(alignment.getHLengthInM(length));
  EXPECT_EQ(length, 0.0);
  EXPECT_FALSE(alignment.getPosNeAtChain(1000.0, n, e));
  EXPECT_FALSE(alignment.getPosNeAtChainExtr(1000.0, n, e));
  EXPECT_FALSE(alignment.FindChainageAndOffset(kNorth0, kEast0, c, o, extrapolated));
  EXPECT_FALSE(alignment.FindApproxChainageAndOffset(1000.0, kNorth0, kEast0, c, o));
  EXPECT_TRUE(alignment.getBoundary().empty);
}

// A chainage at a joint belongs to the later element; up to 1 mm past the end to the last one.
TEST(AlignmentLookup, ElementAtChainage) {
  const CAlntHeSegment t1 = tangent(100.0), t2 = tangent(50.0);
  const CAlntH alignment = fromElements({&t1, &t2}, 0.0);
  struct Case {
    double chainage;
    int index;
    double distance;
  };
  for (const Case& c : {Case{100.0, 1, 0.0}, Case{99.9999, 0, 99.9999}, Case{150.0005, 1, 50.0005},
                        Case{-0.0005, 0, -0.0005}, Case{150.002, -1, 0.0}, Case{-0.002, -1, 0.0}}) {
    int index = -1;
    double distance = 0.0;
    const CHorzAlntElemBase* element = alignment.getHorzElemAtChain(c.chainage, &distance, &index);
    EXPECT_EQ(element == nullptr ? -1 : index, c.index) << c.chainage;
    if (element != nullptr) {
      EXPECT_NEAR(distance, c.distance, 1e-12) << c.chainage;
    }
  }
  // Below the start, an offset under 1e-05 m leaves the extended centre-line point as it is.
  double n = 0.0, e = 0.0, n0 = 0.0, e0 = 0.0;
  bool extrapolated = false;
  ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(-10.0, 0.000005, n, e, &extrapolated));
  ASSERT_TRUE(alignment.getPosNeAtChainExtr(-10.0, n0, e0));
  EXPECT_TRUE(extrapolated);
  EXPECT_EQ(n, n0);
  EXPECT_EQ(e, e0);
  EXPECT_NEAR(n, kNorth0 - 10.0, 1e-9);
}

// A hairpin: tangent north, half circle of radius 10 to the right, tangent south 20 m east of the first.
// A point between the tangents is nearer the first or the second; when the later one is farther by less than
// 1 mm (twice the shift from the middle) it still wins.
TEST(AlignmentSearch, TieBreakFavoursTheLaterElement) {
  const CAlntHeSegment north = tangent(100.0), south = tangent(100.0);
  const CAlntHeArc turn = arc(10.0 * M_PI, 10.0, true);
  const CAlntH alignment = fromElements({&north, &turn, &south}, 0.0);
  struct Case {
    double eastFromMiddle;
    int index;
  };
  for (const Case& c : {Case{0.0, 2}, Case{-0.00045, 2}, Case{-0.00055, 0}, Case{0.0004, 2}}) {
    double ch = 0.0, off = 0.0;
    int index = -1;
    bool atJoint = true;
    ASSERT_TRUE(alignment.FindChainageAndOffset(kNorth0 + 50.0, kEast0 + 10.0 + c.eastFromMiddle, ch, off, &index,
                                                &atJoint));
    EXPECT_EQ(index, c.index) << c.eastFromMiddle;
    EXPECT_FALSE(atJoint);
    EXPECT_NEAR(std::fabs(off), 10.0 + (index == 0 ? 1.0 : -1.0) * c.eastFromMiddle, 1e-9);
  }
}

// Two tangents meeting at a 30 degree right turn: a point in the wedge outside the kink is at the joint.
TEST(AlignmentSearch, PointInTheKinkWedge) {
  CAlntHeSegment second = tangent(100.0);
  for (const double turnDeg : {30.0, -30.0}) {
    second.setFixedStartAzInDeg(turnDeg);
    const CAlntHeSegment first = tangent(100.0);
    const CAlntH alignment = fromElements({&first, &second}, 0.0);
    // Outside the turn: left of a right turn, right of a left turn; 5 m from the joint, on the bisector.
    const double outward = (turnDeg > 0.0 ? -1.0 : 1.0);
    const CMathAngle bisector(turnDeg / 2.0 + outward * 90.0);
    double ch = 0.0, off = 0.0;
    int index = -1;
    bool atJoint = false;
    for (const double r : {5.0, 0.5}) {
      ASSERT_TRUE(alignment.FindChainageAndOffset(kNorth0 + 100.0 + r * bisector.getCos(),
                                                  kEast0 + r * bisector.getSin(), ch, off, &index, &atJoint));
      EXPECT_TRUE(atJoint);
      EXPECT_EQ(index, 1);
      EXPECT_EQ(ch, 100.0);
      EXPECT_NEAR(off, outward * r, 1e-9);
    }
    // Inside the turn the point projects onto an element.
    ASSERT_TRUE(alignment.FindChainageAndOffset(kNorth0 + 100.0 - 5.0 * bisector.getCos(),
                                                kEast0 - 5.0 * bisector.getSin(), ch, off, &index, &atJoint));
    EXPECT_FALSE(atJoint);
  }
}

TEST(AlignmentSearch, ApproximateInverseNearAKnownChainage) {
  const CAlntH alignment = mixedAlignment(11, 2);
  const double length = totalLength(alignment);
  for (double d = 5.0; d < length; d += 23.0) {
    const double ch = alignment.distance2Chainage(d);
    double n = 0.0, e = 0.0, c = 0.0, o = 0.0;
    ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(ch, 6.0, n, e));
    // From 0.5 m away the tangent's first-order error is below R (1 - cos(0.5 / R)) plus the offset's share.
    ASSERT_TRUE(alignment.FindApproxChainageAndOffset(ch + 0.5, n, e, c, o));
    EXPECT_NEAR(c, ch, 0.02) << d;
    EXPECT_NEAR(o, 6.0, 0.002) << d;
  }
  double c = 0.0, o = 0.0, n = 0.0, e = 0.0;
  // Beyond the end the extended tangent serves.
  ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(alignment.distance2Chainage(length + 30.0), -4.0, n, e));
  ASSERT_TRUE(alignment.FindApproxChainageAndOffset(alignment.distance2Chainage(length + 10.0), n, e, c, o));
  EXPECT_NEAR(c, alignment.distance2Chainage(length + 30.0), 1e-9);
  EXPECT_NEAR(o, -4.0, 1e-9);
}

TEST(AlignmentGeometry, BoundaryIntersectionPointsAndSegments) {
  const CAlntH alignment = mixedAlignment(5, 3);
  const C2dMinMax box = alignment.getBoundary();
  const double length = totalLength(alignment);
  for (double d = 0.0; d <= length; d += 1.0) {
    double n = 0.0, e = 0.0;
    ASSERT_TRUE(alignment.getPosNeAtChain(alignment.distance2Chainage(d), n, e));
    EXPECT_TRUE(box.contains(C2dPos(n, e), 1e-9)) << d;
  }
  // The IP of an arc is equally far from both its ends, R tan(delta / 2).
  const CAlntHeArc& curve = *CAlntHeArc::cast(const_cast<CAlntHe*>(alignment.getHe(2)));
  double ipN = 0.0, ipE = 0.0, n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0, len = 0.0;
  ASSERT_TRUE(alignment.getIpPosForElement(2, ipN, ipE));
  ASSERT_TRUE(curve.getStartPosNe(n1, e1) && curve.getFinalPosNe(n2, e2) && curve.getHLengthInM(len));
  const double radius = std::fabs(curve.get_data().getRadius());
  EXPECT_NEAR(dist(C2dPos(ipN, ipE), C2dPos(n1, e1)), radius * std::tan(len / radius / 2.0), 1e-8);
  EXPECT_NEAR(dist(C2dPos(ipN, ipE), C2dPos(n2, e2)), radius * std::tan(len / radius / 2.0), 1e-8);
  EXPECT_FALSE(alignment.getIpPosForElement(0, ipN, ipE));
  EXPECT_FALSE(alignment.getIpPosForElement(99, ipN, ipE));
  struct Counter : CGenericSegmentVisitor_const {
    int count = 0;
    void Visit(const CGenericLine&) override { ++count; }
    void Visit(const CGenericArc&) override { ++count; }
    void Visit(const CGenericSpiral&) override { ++count; }
  } counter;
  alignment.ForEachSegment(counter);
  EXPECT_EQ(counter.count, alignment.getNumOfHes());
  EXPECT_NE(CAlntH::cast(static_cast<const CHorzAlntBase*>(&alignment)), nullptr);
}

// Points and chainages off the number line find nothing; huge ones end in a plain answer, never a hang.
TEST(AlignmentRobustness, AbsurdInput) {
  CAlntH alignment = mixedAlignment(13, 2);
  appendIpRun(alignment, 13, 2);
  for (const double v : {std::nan(""), HUGE_VAL, -HUGE_VAL, 1e300, -1e300}) {
    double c = 0.0, o = 0.0, n = 0.0, e = 0.0;
    bool extrapolated = false;
    TAlntStationResult result;
    EXPECT_FALSE(alignment.getPosNeAtChain(v, n, e)) << v;
    const bool found = alignment.FindChainageAndOffset(kNorth0, v, c, o, extrapolated);
    alignment.FindChainagesAndOffsets(&v, &v, 1, &result, true);
    if (std::isnan(v)) {
      EXPECT_FALSE(found || result.found || alignment.FindChainageAndOffset(v, kEast0, c, o) ||
                   alignment.getPosNeAtChainAndOffsetExtr(v, 0.0, n, e));
    }
  }
}
