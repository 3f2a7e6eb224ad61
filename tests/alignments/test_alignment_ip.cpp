// Intersection-point elements: the lead-in tangent and the curve group between the neighbouring IPs, the
// re-anchoring of both neighbours when an IP moves, and the failures (overlapping tangents, spirals that do
// not fit) with the cached length they leave behind.
#include <gtest/gtest.h>

#include <cmath>

#include "alignment_test_support.h"

using namespace alnt_test;

namespace {

// Start (kNorth0, kEast0); IPs 500 m north, then 500 m north-east of it, then an end point 400 m east.
const C2dPos kIp1(kNorth0 + 500.0, kEast0);
const C2dPos kIp2(kNorth0 + 500.0 + 500.0 * M_SQRT1_2, kEast0 + 500.0 * M_SQRT1_2);
const C2dPos kEnd(kIp2.north(), kIp2.east() + 400.0);

CAlntH ipRoad(double radius1 = 300.0, double spiral1 = 60.0, const C2dPos& ip2 = kIp2) {
  CAlntH alignment;
  alignment.setStartPos(kNorth0, kEast0, 0.0);
  alignment.setStartChainageInM(100.0);
  EXPECT_TRUE(alignment.appendElement(ipElement(kIp1, radius1, spiral1, spiral1)));
  EXPECT_TRUE(alignment.appendElement(ipElement(ip2, 250.0, 40.0, 0.0, eMathSpiralCubic)));
  EXPECT_TRUE(alignment.appendElement(ipElement(kEnd, 0.0, 0.0, 0.0)));
  return alignment;
}

const CAlntHeIp& ipAt(const CAlntH& alignment, int index) {
  return *CAlntHeIp::cast(const_cast<CAlntHe*>(alignment.getHe(index)));
}

}  // namespace

TEST(AlignmentIp, LaysOutLeadInsAndGroupsBetweenTheIps) {
  const CAlntH road = ipRoad();
  const CAlntHeIp& first = ipAt(road, 0);
  const CAlntHeIp& last = ipAt(road, 2);
  ASSERT_TRUE(first.isok() && first.hasCurveGroup());
  EXPECT_FALSE(last.hasCurveGroup());
  // The first group turns 45 degrees right; its lead-in runs from the start to TS.
  EXPECT_NEAR(first.get_data().getDeflection(), M_PI / 4.0, 1e-12);
  EXPECT_NEAR(first.getLeadInLength(), 500.0 - first.get_data().getTangentIn(), 1e-9);
  double length = 0.0, n = 0.0, e = 0.0;
  ASSERT_TRUE(first.getHLengthInM(length));
  EXPECT_NEAR(length, first.getLeadInLength() + first.get_data().getTotalLength(), 1e-12);
  ASSERT_TRUE(first.getFinalPosNe(n, e));
  EXPECT_NEAR(dist(C2dPos(n, e), first.get_data().getST()), 0.0, 1e-8);
  // The last element ends at its IP, 400 m on from the previous ST's IP.
  ASSERT_TRUE(road.getFinalPosNe(n, e));
  EXPECT_NEAR(dist(C2dPos(n, e), kEnd), 0.0, 1e-8);
  ASSERT_TRUE(road.getIpPosForElement(1, n, e));
  EXPECT_EQ(n, kIp2.north());
  // The second group has no exit spiral: its curvature jumps at ST.
  expectContinuousJoints(road, 1e-8, false);
  // Round trips through the whole road, lead-ins and groups alike.
  ASSERT_TRUE(road.getHLengthInM(length));
  for (double d = 0.0; d <= length; d += 4.1) {
    for (const double off : {-12.0, 0.0, 30.0}) {
      double c = 0.0, o = 0.0;
      ASSERT_TRUE(road.getPosNeAtChainAndOffsetExtr(road.distance2Chainage(d), off, n, e));
      ASSERT_TRUE(road.FindChainageAndOffset(n, e, c, o));
      EXPECT_NEAR(c, road.distance2Chainage(d), 1e-6) << d << " " << off;
      EXPECT_NEAR(o, off, 1e-6) << d << " " << off;
    }
  }
}

TEST(AlignmentIp, MovingAnIpRedoesBothNeighbours) {
  const C2dPos moved(kIp2.north() + 60.0, kIp2.east() - 40.0);
  CAlntH road = ipRoad();
  ASSERT_TRUE(road.replaceElement(1, ipElement(moved, 250.0, 40.0, 0.0, eMathSpiralCubic)));
  const CAlntH expected = ipRoad(300.0, 60.0, moved);
  for (int i = 0; i < 3; ++i) {
    double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0, l1 = 0.0, l2 = 0.0;
    ASSERT_TRUE(road.getHe(i)->getFinalPosNe(n1, e1) && expected.getHe(i)->getFinalPosNe(n2, e2));
    ASSERT_TRUE(road.getHe(i)->getHLengthInM(l1) && expected.getHe(i)->getHLengthInM(l2));
    EXPECT_EQ(n1, n2);
    EXPECT_EQ(e1, e2);
    EXPECT_EQ(l1, l2);
  }
  // The first group's exit tangent now points at the moved IP.
  CMathAngle exit, towards;
  ASSERT_TRUE(road.getHe(0)->getFinalAzimut(exit) && towards.setAz(kIp1, moved));
  EXPECT_TRUE(exit.isEqual(towards, 1e-12));
  // Removing the middle IP makes the first one the last: it ends at its IP.
  ASSERT_TRUE(road.removeHe(1));
  EXPECT_TRUE(ipAt(road, 0).hasCurveGroup());
  ASSERT_TRUE(road.removeHe(1));
  EXPECT_FALSE(ipAt(road, 0).hasCurveGroup());
}

TEST(AlignmentIp, SimplePointAndIpAfterATangent) {
  CAlntH road;
  road.setStartPos(kNorth0, kEast0, 0.0);
  ASSERT_TRUE(road.appendElement(tangent(200.0, 0.0)));
  CAlntHeIp corner = ipElement(kIp1, 300.0, 0.0, 0.0);
  corner.setSimplePoint();
  ASSERT_TRUE(road.appendElement(corner));
  ASSERT_TRUE(road.appendElement(ipElement(kIp2, 0.0, 0.0, 0.0)));
  // The corner's previous IP is its own start (the tangent's end), so its lead-in is the remaining 300 m.
  EXPECT_NEAR(ipAt(road, 1).getLeadInLength(), 300.0, 1e-9);
  // A point outside the bare angle, 5 m from the IP on the bisector, lies at the IP's chainage.
  const CMathAngle outward(45.0 / 2.0 - 90.0);
  double c = 0.0, o = 0.0;
  ASSERT_TRUE(road.FindChainageAndOffset(kIp1.north() + 5.0 * outward.getCos(), kIp1.east() + 5.0 * outward.getSin(),
                                         c, o));
  EXPECT_NEAR(c, 500.0, 1e-9);
  EXPECT_NEAR(o, -5.0, 1e-9);
}

// Radii too large for the legs make the tangent lengths overlap; spirals longer than the turn do not fit.
// The first length query fails; the partial sum then stays cached until an edit (kept on purpose).
TEST(AlignmentIp, UndefinedGroupsAndTheCachedLength) {
  for (const double radius : {2000.0, 100.0}) {
    const double spiral = radius > 1000.0 ? 60.0 : 250.0;
    CAlntH road = ipRoad(radius, spiral);
    EXPECT_FALSE(ipAt(road, 0).isok()) << radius;
    double length = -1.0;
    EXPECT_FALSE(road.getHLengthInM(length));
    ASSERT_TRUE(road.getHLengthInM(length));
    EXPECT_EQ(length, 0.0);
    road.setStartChainageInM(0.0);
    EXPECT_FALSE(road.getHLengthInM(length));
    ASSERT_TRUE(road.replaceElement(0, ipElement(kIp1, 300.0, 60.0, 60.0)));
    ASSERT_TRUE(road.getHLengthInM(length));
    EXPECT_GT(length, 1000.0);
  }
}
