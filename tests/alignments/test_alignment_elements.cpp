// Horizontal elements in an alignment: placement after the predecessor, start azimuth control, chainage
// queries and their extrapolation, copies and comparison.
#include <gtest/gtest.h>

#include <cmath>
#include <memory>

#include "alignment_test_support.h"
#include "svymath/alignments/horz_element_visitor.h"

using namespace alnt_test;

namespace {

CAlntH tangentThenArc(bool fixArcAzimuth) {
  CAlntH alignment;
  alignment.setStartPos(kNorth0, kEast0, 0.0);
  alignment.setStartChainageInM(500.0);
  EXPECT_TRUE(alignment.appendElement(tangent(100.0, 45.0)));
  CAlntHeArc curve = arc(80.0, 200.0, true);
  if (fixArcAzimuth) curve.setFixedStartAzInDeg(60.0);
  EXPECT_TRUE(alignment.appendElement(curve));
  return alignment;
}

}  // namespace

TEST(AlignmentElements, SecondStartsWhereFirstEnds) {
  for (const bool fixed : {false, true}) {
    const CAlntH alignment = tangentThenArc(fixed);
    const CAlntHe& first = *alignment.getHe(0);
    const CAlntHe& second = *alignment.getHe(1);
    double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0, ch1 = 0.0, ch2 = 0.0, len = 0.0;
    ASSERT_TRUE(first.getFinalPosNe(n1, e1) && second.getStartPosNe(n2, e2));
    EXPECT_EQ(n1, n2);
    EXPECT_EQ(e1, e2);
    EXPECT_NEAR(n1, kNorth0 + 100.0 * std::cos(M_PI / 4), 1e-9);
    ASSERT_TRUE(first.getFinalChainageInM(ch1) && second.getStartChainageInM(ch2) && second.getHLengthInM(len));
    EXPECT_EQ(ch1, 600.0);
    EXPECT_EQ(ch2, 600.0);
    ASSERT_TRUE(second.getFinalChainageInM(ch2));
    EXPECT_EQ(ch2, 600.0 + len);
    CMathAngle endAz, startAz;
    ASSERT_TRUE(first.getFinalAzimut(endAz) && second.getStartAzimut(startAz));
    // A fixed start azimuth makes a kink that re-anchoring keeps.
    EXPECT_NEAR(startAz.getDeg(), fixed ? 60.0 : 45.0, 1e-12);
    EXPECT_NEAR(endAz.getDeg(), 45.0, 1e-12);
  }
}

TEST(AlignmentElements, ChainageQueriesAndExtrapolation) {
  const CAlntH alignment = tangentThenArc(false);
  const CAlntHe& first = *alignment.getHe(0);
  const CAlntHe& second = *alignment.getHe(1);
  double n = 0.0, e = 0.0, n2 = 0.0, e2 = 0.0, az = 0.0;
  // 10 m before the start of the tangent: on the prolonged tangent, behind the start.
  ASSERT_TRUE(first.getPosNeAtChainExtr(490.0, n, e));
  EXPECT_NEAR(dist(C2dPos(n, e), C2dPos(kNorth0, kEast0)), 10.0, 1e-9);
  EXPECT_LT(n, kNorth0);
  EXPECT_FALSE(first.getPosNeAtChain(490.0, n, e));
  // Inside the element the extrapolating query is the plain one.
  for (const double ch : {600.0, 623.4, 679.99}) {
    ASSERT_TRUE(second.getPosNeAtChain(ch, n, e) && second.getPosNeAtChainExtr(ch, n2, e2));
    EXPECT_NEAR(n, n2, 1e-9);
    EXPECT_NEAR(e, e2, 1e-9);
  }
  // 20 m past the arc's end: along its final tangent; offsets square to it, positive right.
  ASSERT_TRUE(second.getFinalPosNe(n, e) && second.getAzimuthAtChainExtr(700.0, az));
  const CMathAngle finalAz(az);
  ASSERT_TRUE(second.getPosNeAtChainAndOffsetExtr(700.0, 3.0, n2, e2));
  EXPECT_NEAR(n2, n + 20.0 * finalAz.getCos() - 3.0 * finalAz.getSin(), 1e-9);
  EXPECT_NEAR(e2, e + 20.0 * finalAz.getSin() + 3.0 * finalAz.getCos(), 1e-9);
  EXPECT_NEAR(az, 45.0 + 80.0 / 200.0 * 180.0 / M_PI, 1e-9);
  double k = 0.0, chainage = 0.0, offset = 0.0;
  ASSERT_TRUE(second.getCurvatureAtChainage(640.0, k));
  EXPECT_NEAR(k, 1.0 / 200.0, 1e-15);
  ASSERT_TRUE(second.getPosNeAtChainAndOffsetExtr(640.0, -7.0, n, e));
  ASSERT_TRUE(second.getChainageAndOffsetForPos(n, e, chainage, offset));
  EXPECT_NEAR(chainage, 640.0, 1e-9);
  EXPECT_NEAR(offset, -7.0, 1e-9);
  EXPECT_NEAR(second.getNextPosForDeviation(640.0, 0.01, n, e) - 640.0, 2.0 * 200.0 * std::acos(1.0 - 0.01 / 200.0),
              1e-9);
}

TEST(AlignmentElements, UnplacedElementsFailChainageQueries) {
  const CAlntHeSegment loose = tangent(10.0);
  double ch = 0.0, n = 0.0, e = 0.0;
  EXPECT_FALSE(loose.isok());
  EXPECT_FALSE(loose.getStartChainageInM(ch));
  EXPECT_FALSE(loose.getFinalChainageInM(ch));
  EXPECT_FALSE(loose.getPosNeAtChain(0.0, n, e));
  EXPECT_FALSE(loose.getPosNeAtChainExtr(0.0, n, e));
  EXPECT_FALSE(CAlntHeArc().getHLengthInM(ch));
  CAlntH alignment;
  EXPECT_FALSE(alignment.appendElement(CAlntHeArc()));
  EXPECT_EQ(alignment.getNumOfHes(), 0);
}

TEST(AlignmentElements, CloneEqualityKindsAndVisitors) {
  const CAlntH alignment = mixedAlignment(3, 1);
  struct Counter : CAlntHeVisitor_const {
    int kinds[4] = {0, 0, 0, 0};
    void Visit(const CAlntHeSegment&) override { ++kinds[eAlntHeSegment]; }
    void Visit(const CAlntHeArc&) override { ++kinds[eAlntHeArc]; }
    void Visit(const CAlntHeSpiral&) override { ++kinds[eAlntHeSpiral]; }
    void Visit(const CAlntHeIp&) override { ++kinds[eAlntHeIp]; }
  } counter;
  for (int i = 0; i < alignment.getNumOfHes(); ++i) {
    const CAlntHe& element = *alignment.getHe(i);
    element.Accept(counter);
    const std::unique_ptr<CAlntHe> copy(element.clone());
    EXPECT_EQ(copy->getType(), element.getType());
    EXPECT_TRUE(copy->isEqual(&element));
    EXPECT_EQ(copy->get_rtti_id(), element.get_rtti_id());
    EXPECT_FALSE(alignment.getHe((i + 1) % alignment.getNumOfHes())->isEqual(&element));
  }
  EXPECT_EQ(counter.kinds[eAlntHeSegment], 2);
  EXPECT_EQ(counter.kinds[eAlntHeArc], 1);
  EXPECT_EQ(counter.kinds[eAlntHeSpiral], 2);
  EXPECT_NE(CAlntHeArc::cast(const_cast<CAlntHe*>(alignment.getHe(2))), nullptr);
  EXPECT_EQ(CAlntHeArc::cast(const_cast<CAlntHe*>(alignment.getHe(1))), nullptr);
  EXPECT_FALSE(arc(10.0, 100.0, true).isEqual(&static_cast<const CAlntHe&>(arc(10.0, 100.0, false))));
}

TEST(AlignmentElements, ArcRecordRoundTrip) {
  CArc record;
  ASSERT_TRUE(record.set_start_r_length(C2dPos(kNorth0, kEast0), CMathAngle(100.0), 250.0, 120.0, false));
  const CAlntHeArc element(record);
  CArc back;
  ASSERT_TRUE(element.getArc(back));
  EXPECT_NEAR(back.getRadius(), 250.0, 1e-9);
  EXPECT_NEAR(back.getLength(), 120.0, 1e-9);
  EXPECT_FALSE(back.clockwise);
  EXPECT_NEAR(dist(back.center, record.center), 0.0, 1e-8);
  CArc circle;
  ASSERT_TRUE(circle.set_center_R(C2dPos(0.0, 0.0), 10.0));
  EXPECT_FALSE(CAlntHeArc().setArc(circle));
}
