// The curve group about an intersection point: plain arcs and symmetric clothoid groups against the classic
// tangent, length and external formulas (shift and k from the clothoid series); every group closing on its
// exit tangent (against an integrated heading for the clothoid), continuous at SC and CS, mirrored between
// left and right, unchanged at survey coordinates; round trips through length and offset; failures and the
// simple point.
#include <gtest/gtest.h>

#include <cmath>
#include <string>

#include "curve_test_support.h"
#include "svymath/curves/curve_ip.h"
#include "svymath/curves/generic_segment_visitor.h"

namespace {

using curve_test::dist;
using curve_test::expectPosNear;
using svy_math::units::kDegToRad;

constexpr double kN = 5000000.0, kE = 500000.0;
// Doubles at N 5 000 000 are 9.3e-10 m apart: a chain of three placed parts ends within a few of them.
constexpr double kSurveyClosure = 3e-9;

C2dPos at(const C2dPos& from, double azDeg, double distance) {
  return C2dPos(from.north() + distance * std::cos(azDeg * kDegToRad),
                from.east() + distance * std::sin(azDeg * kDegToRad));
}

// The group about the IP (north, east), entered at azIn degrees and turning by defl degrees (positive right),
// with neighbours 2 km away; fits tells whether it could be laid out.
CCurveIp makeGroup(double north, double east, double azIn, double defl, double radius, double lenIn, double lenOut,
                   AlntMathSpiralType type = eMathSpiralEuler, bool* fits = nullptr) {
  const C2dPos ip(north, east);
  CCurveIp group;
  group.setSpiralType(type);
  EXPECT_TRUE(group.setIp(north, east, radius, lenIn, lenOut));
  const bool ok = group.setNeighbours(at(ip, azIn, -2000.0), at(ip, azIn + defl, 2000.0));
  EXPECT_TRUE(fits != nullptr || ok);
  if (fits != nullptr) *fits = ok;
  return group;
}

C2dPos posAt(const CCurveIp& group, double s) {
  C2dPos p(curve_test::kNaN, curve_test::kNaN);
  EXPECT_TRUE(group.getPosAtLength(s, p.north(), p.east())) << s;
  return p;
}

double azDegAt(const CCurveIp& group, double s) {
  CMathAngle az;
  EXPECT_TRUE(group.getAzimuthAtLength(s, az)) << s;
  return az.getDeg();
}

double angleDiffDeg(double a, double b) { return std::remainder(a - b, 360.0); }

// Symmetric groups (a plain arc has no spirals: p = k = 0): Ts = (R + p) tan(D/2) + k, length
// 2 Ls + R (D - 2 Ls/2R), external (R + p) / cos(D/2) - R. The clothoid's end point comes from its series in
// t = L/2R, independent of the Fresnel integrals: x = L (1 - t^2/10 + t^4/216 - ...), y = L (t/3 - ...).
TEST(CurveIpSymmetric, MatchesClassicTangentLengthAndExternal) {
  const struct {
    double azIn, defl, radius, spiral;
  } cases[] = {{10.0, 30.0, 300.0, 0.0},   {200.0, -75.0, 120.0, 0.0},
               {-40.0, 150.0, 50.0, 0.0},  {95.0, -2e-4, 5000.0, 0.0},
               {30.0, 40.0, 400.0, 100.0}, {300.0, -25.0, 800.0, 120.0},
               {180.0, 90.0, 150.0, 60.0}, {0.0, -120.0, 60.0, 62.83185307179586}};  // spirals of 30 deg
  for (const auto& c : cases) {
    const CCurveIp g = makeGroup(kN, kE, c.azIn, c.defl, c.radius, c.spiral, c.spiral);
    const double t = c.spiral / (2.0 * c.radius), t2 = t * t, d = std::fabs(c.defl) * kDegToRad;
    const double x =
        c.spiral * (1.0 - t2 / 10.0 + t2 * t2 / 216.0 - t2 * t2 * t2 / 9360.0 + t2 * t2 * t2 * t2 / 685440.0);
    const double y =
        c.spiral * t *
        (1.0 / 3.0 - t2 / 42.0 + t2 * t2 / 1320.0 - t2 * t2 * t2 / 75600.0 + t2 * t2 * t2 * t2 / 6894720.0);
    const double p = y - c.radius * (1.0 - std::cos(t)), k = x - c.radius * std::sin(t);
    const double ts = (c.radius + p) * std::tan(d / 2.0) + k, total = 2.0 * c.spiral + c.radius * (d - 2.0 * t);
    EXPECT_NEAR(g.getDeflection(), c.defl * kDegToRad, 1e-12);  // neighbours rounded 2 km away
    EXPECT_TRUE(std::fabs(g.getShiftIn() - p) < 1e-9 && std::fabs(g.getShiftOut() - p) < 1e-9) << g.getShiftIn();
    EXPECT_NEAR(g.getTangentIn(), ts, 1e-8);
    EXPECT_NEAR(g.getTangentOut(), ts, 1e-8);
    EXPECT_NEAR(g.getTotalLength(), total, 1e-9);
    EXPECT_NEAR(dist(g.getIp(), posAt(g, total / 2.0)), (c.radius + p) / std::cos(d / 2.0) - c.radius, 1e-8);
    EXPECT_EQ(g.getRadius(), c.defl > 0.0 ? c.radius : -c.radius);
  }
}

struct GroupCase {
  const char* name;
  AlntMathSpiralType type;
  double defl, radius, lenIn, lenOut;
};

class CurveIpGroup : public ::testing::TestWithParam<GroupCase> {
 protected:
  CCurveIp make(double north, double east, double azIn, double deflSign = 1.0) const {
    const GroupCase& c = GetParam();
    return makeGroup(north, east, azIn, deflSign * c.defl, c.radius, c.lenIn, c.lenOut, c.type);
  }
};

// The chain of parts closes: position and direction agree on both sides of TS, SC, CS and ST; the exit
// spiral ends at ST, T2 along the exit tangent, in its direction; the curvature runs 0, 1/R, 1/R, 0. For
// the clothoid, an independent integration of the heading from TS reaches ST.
TEST_P(CurveIpGroup, ClosesOnTheExitTangent) {
  const GroupCase& c = GetParam();
  const double azIn = 37.0, azOut = azIn + c.defl, side = c.defl > 0.0 ? 1.0 : -1.0;
  const CCurveIp g = make(kN, kE, azIn);
  const double total = g.getTotalLength(), arc = total - c.lenIn - c.lenOut;
  ASSERT_TRUE(g.isok() && arc >= 0.0);
  const C2dPos joints[] = {g.getTS(), g.getSC(), g.getCS(), g.getST()};
  const double lengths[] = {0.0, c.lenIn, c.lenIn + arc, total};
  const double turnOver2nm = 2e-9 / c.radius / kDegToRad + 1e-10;  // degrees
  for (int i = 0; i < 4; ++i) {
    expectPosNear(posAt(g, lengths[i]), joints[i].north(), joints[i].east(), kSurveyClosure);
    for (const double ds : {-1e-7, 1e-7}) {
      if ((i > 0 || ds > 0) && (i < 3 || ds < 0))
        expectPosNear(posAt(g, lengths[i] + ds), joints[i].north(), joints[i].east(), 2e-7);
    }
    EXPECT_NEAR(angleDiffDeg(azDegAt(g, lengths[i] - 1e-9), azDegAt(g, lengths[i] + 1e-9)), 0.0, turnOver2nm);
    const bool tangentEnd = (i == 0 && c.lenIn > 0.0) || (i == 3 && c.lenOut > 0.0);
    EXPECT_NEAR(g.getCurvatureAtLength(lengths[i]), tangentEnd ? 0.0 : side / c.radius, 1e-6 / c.radius) << i;
  }
  if (const CCurveSpiral* exit = g.getSpiralOut()) {
    expectPosNear(exit->getEndPos(), g.getST().north(), g.getST().east(), kSurveyClosure);
  }
  EXPECT_NEAR(angleDiffDeg(azDegAt(g, total), azOut), 0.0, 1e-10);
  EXPECT_NEAR(angleDiffDeg(azDegAt(g, 0.0), azIn), 0.0, 1e-10);
  EXPECT_TRUE(g.getCurvatureAtLength(-0.01) == 0.0 && g.getCurvatureAtLength(total + 0.01) == 0.0);
  const C2dPos ts = at(g.getIp(), azIn, -g.getTangentIn()), st = at(g.getIp(), azOut, g.getTangentOut());
  expectPosNear(g.getTS(), ts.north(), ts.east(), kSurveyClosure);
  expectPosNear(g.getST(), st.north(), st.east(), kSurveyClosure);
  if (c.type != eMathSpiralEuler) return;
  const double a0 = azIn * kDegToRad, R = c.radius, L1 = c.lenIn, L2 = c.lenOut;
  const auto heading = [&](double u) {
    if (L1 > 0.0 && u <= L1) return a0 + side * u * u / (2.0 * R * L1);
    if (L2 <= 0.0 || u <= L1 + arc) return a0 + side * (L1 / 2.0 + (u - L1)) / R;
    return azOut * kDegToRad - side * (total - u) * (total - u) / (2.0 * R * L2);
  };
  double dN = 0.0, dE = 0.0;
  curve_test::integrateHeading(heading, total, 1e-12, dN, dE);
  expectPosNear(g.getST(), g.getTS().north() + dN, g.getTS().east() + dE, 1e-7);
}

// A point at a length and an offset finds both back (joints included); the group at survey coordinates is
// the local group moved there; a left turn mirrors a right one. Over a grid, the search (which skips parts
// whose box lies too far) answers as asking every part in order, a later one winning within 1 mm.
TEST_P(CurveIpGroup, RoundTripsSurveyCoordinatesMirrorAndSearch) {
  const GroupCase& c = GetParam();
  const CCurveIp g = make(kN, kE, 0.0), local = make(0.0, 0.0, 0.0), mirror = make(0.0, 0.0, 0.0, -1.0);
  const double total = g.getTotalLength();
  for (const double s : {0.0, 0.3 * c.lenIn, c.lenIn, total / 2.0, total - c.lenOut, total - 0.2 * c.lenOut, total}) {
    const C2dPos on = posAt(g, s), onLocal = posAt(local, s);
    expectPosNear(C2dPos(on.north() - kN, on.east() - kE), onLocal.north(), onLocal.east(), kSurveyClosure);
    expectPosNear(posAt(mirror, s), onLocal.north(), -onLocal.east(), 1e-9);
    EXPECT_NEAR(mirror.getCurvatureAtLength(s), -local.getCurvatureAtLength(s), 1e-15);
    for (const double offset : {-7.5, -1e-3, 0.0, 4.0}) {
      const C2dPos p = at(on, azDegAt(g, s) + 90.0, offset);
      double length = 0.0, off = 0.0, distance = -1.0;
      ASSERT_TRUE(g.getLengthAndOffset(p.north(), p.east(), length, off)) << s << " " << offset;
      EXPECT_TRUE(std::fabs(length - s) < 2e-8 && std::fabs(off - offset) < 2e-8) << s << " " << offset;
      EXPECT_TRUE(g.getShortestDistanceToPoint(p.north(), p.east(), distance));
      EXPECT_NEAR(distance, std::fabs(offset), 2e-8);
    }
  }
  double length = 0.0, offset = 0.0;
  EXPECT_FALSE(g.getLengthAndOffset(g.getTS().north() - 10.0, g.getTS().east(), length, offset));  // before TS
  const CGenericSegment* parts[] = {g.getSpiralIn(), g.getArc(), g.getSpiralOut()};
  const C2dMinMax box = g.getBoundary();
  for (int i = 0; i <= 1600; ++i) {
    const double n = box.minNorth - 50.0 + (box.maxNorth - box.minNorth + 100.0) * (i / 40) / 40.0;
    const double e = box.minEast - 50.0 + (box.maxEast - box.minEast + 100.0) * (i % 40) / 40.0;
    bool expected = false;
    double expLength = 0.0, expOffset = 0.0, start = 0.0, s = 0.0, off = 0.0;
    for (const CGenericSegment* part : parts) {
      if (part == nullptr) continue;
      if (part->getLengthAndOffset(n, e, s, off) && (!expected || std::fabs(off) <= std::fabs(expOffset) + 1e-3)) {
        expected = true;
        expLength = start + s;
        expOffset = off;
      }
      start += part->getTotalLength();
    }
    const bool found = g.getLengthAndOffset(n, e, length, offset);
    EXPECT_TRUE(found == expected && (!found || (length == expLength && offset == expOffset))) << n << " " << e;
  }
}

// Stepping by chord deviation walks through the joints to ST inside the box; the parts come in travel order.
TEST_P(CurveIpGroup, StepsBoxAndParts) {
  const GroupCase& c = GetParam();
  const CCurveIp g = make(kN, kE, 250.0);
  const double total = g.getTotalLength();
  const C2dMinMax box = g.getBoundary();
  int steps = 0;
  for (double s = 0.0; s < total && steps < 100000; ++steps) {
    const double step = g.getStepForDeviation(s, 0.005);
    ASSERT_GT(step, 0.0) << s;
    s = std::fmin(s + step, total);
    EXPECT_TRUE(box.contains(posAt(g, s), 1e-9)) << s;
  }
  struct Kinds : CGenericSegmentVisitor_const {
    std::string seen;
    void Visit(const CGenericLine&) override { seen += 'L'; }
    void Visit(const CGenericArc&) override { seen += 'A'; }
    void Visit(const CGenericSpiral&) override { seen += 'S'; }
  } kinds;
  g.ForEachSegment(kinds);
  EXPECT_EQ(kinds.seen, std::string(c.lenIn > 0.0 ? "S" : "") + (total > c.lenIn + c.lenOut ? "A" : "") +
                            (c.lenOut > 0.0 ? "S" : ""));
}

INSTANTIATE_TEST_SUITE_P(
    Groups, CurveIpGroup,
    ::testing::Values(GroupCase{"SymmetricRight", eMathSpiralEuler, 48.0, 350.0, 90.0, 90.0},
                      GroupCase{"AsymmetricRight", eMathSpiralEuler, 63.0, 250.0, 120.0, 40.0},
                      GroupCase{"AsymmetricLeft", eMathSpiralEuler, -35.0, 500.0, 30.0, 150.0},
                      GroupCase{"EntryOnlyLeft", eMathSpiralEuler, -20.0, 400.0, 80.0, 0.0},
                      GroupCase{"ExitOnlyRight", eMathSpiralEuler, 110.0, 90.0, 0.0, 70.0},
                      GroupCase{"NoArc", eMathSpiralEuler, 200.0 / 600.0 / kDegToRad, 300.0, 100.0, 100.0},
                      GroupCase{"CubicAsymmetricLeft", eMathSpiralCubic, -55.0, 300.0, 100.0, 60.0},
                      GroupCase{"CubicRight", eMathSpiralCubic, 24.0, 1000.0, 150.0, 150.0}),
    [](const ::testing::TestParamInfo<GroupCase>& param) { return std::string(param.param.name); });

TEST(CurveIpFailures, SpiralsBeyondTheDeflectionDegenerateTangentsAndBadValues) {
  const struct {
    double defl, radius, lenIn, lenOut;
    AlntMathSpiralType type;
    ECurveIpStatus status;
  } cases[] = {
      {20.0, 300.0, 120.0, 90.0, eMathSpiralEuler, eCurveIpSpiralsTooLong},  // 0.2 + 0.15 rad in 0.349 rad
      {-10.0, 100.0, 40.0, 0.0, eMathSpiralEuler, eCurveIpSpiralsTooLong},   // 0.2 rad in 0.1745
      {0.0, 300.0, 0.0, 0.0, eMathSpiralEuler, eCurveIpCollinear},
      {180.0, 300.0, 0.0, 0.0, eMathSpiralEuler, eCurveIpReversal},
      {-179.999999, 300.0, 0.0, 0.0, eMathSpiralEuler, eCurveIpReversal},
      {60.0, 100.0, 80.0, 0.0, eMathSpiralCubic, eCurveIpSpiralUnreachable},  // no cubic parabola that sharp
      {120.0, 1e308, 0.0, 0.0, eMathSpiralEuler, eCurveIpUndefined},          // tangents beyond the doubles
  };
  for (const auto& c : cases) {
    bool fits = true;
    const CCurveIp g = makeGroup(kN, kE, 15.0, c.defl, c.radius, c.lenIn, c.lenOut, c.type, &fits);
    double n = 0.0, e = 0.0;
    EXPECT_TRUE(!fits && !g.isok() && g.getStatus() == c.status) << c.defl << " " << g.getStatus();
    EXPECT_TRUE(!g.getPosAtLength(0.0, n, e) && std::isnan(g.getTotalLength()) && std::isnan(g.getTS().north()));
  }
  // Bad definitions are refused and leave the group as it was; a neighbour on the IP defines no tangent.
  CCurveIp g = makeGroup(100.0, 200.0, 0.0, 30.0, 300.0, 50.0, 50.0);
  const double length = g.getTotalLength();
  for (const double bad : {-1.0, curve_test::kNaN, curve_test::kInf})
    EXPECT_FALSE(g.setIp(100.0, 200.0, 300.0, bad, 0.0));
  EXPECT_FALSE(g.setIp(100.0, 200.0, 0.0, 10.0, 0.0));  // spirals need a radius
  EXPECT_TRUE(g.isok() && g.getTotalLength() == length && g.getLenIn() == 50.0);
  EXPECT_FALSE(g.setNeighbours(C2dPos(100.0, 200.0), C2dPos(300.0, 200.0)));
  EXPECT_TRUE(!g.isok() && g.getStatus() == eCurveIpNoTangent);
}

// A bare angle point: no length, TS = ST = IP; only the wedge outside the angle has its foot there, on the
// outer side (left of a right turn). Copies are equal and independent.
TEST(CurveIpSimplePoint, HasNoLengthAndAnswersTheOuterWedge) {
  CCurveIp g = makeGroup(kN, kE, 0.0, 60.0, 200.0, 30.0, 30.0);
  g.setSimplePoint();
  ASSERT_TRUE(g.isok() && g.isSimplePoint() && g.getTotalLength() == 0.0 && g.getRadius() == 0.0);
  EXPECT_TRUE(g.getTangentIn() == 0.0 && g.getTangentOut() == 0.0 && g.getTS() == g.getIp() && g.getST() == g.getIp());
  EXPECT_TRUE(g.getSpiralIn() == nullptr && g.getArc() == nullptr && g.getSpiralOut() == nullptr);
  expectPosNear(posAt(g, 0.0005), kN, kE, 0.0);
  EXPECT_NEAR(azDegAt(g, 0.0), 60.0, 1e-12);
  double n = 0.0, e = 0.0, length = 1.0, offset = 0.0;
  EXPECT_FALSE(g.getPosAtLength(0.002, n, e));
  ASSERT_TRUE(g.getLengthAndOffset(kN + 3.0, kE - 4.0, length, offset));
  EXPECT_TRUE(length == 0.0 && std::fabs(offset + 5.0) < 1e-9);
  EXPECT_FALSE(g.getLengthAndOffset(kN - 3.0, kE + 1.0, length, offset));      // beside the entry tangent
  EXPECT_TRUE(g.setNeighbours(C2dPos(kN - 10.0, kE), C2dPos(kN - 20.0, kE)));  // a reversal is an angle point
  CCurveIp copy(g);
  EXPECT_TRUE(copy.isEqual(g));
  copy.setIp(kN, kE, 100.0, 0.0, 0.0);
  EXPECT_TRUE(!copy.isEqual(g) && g.isSimplePoint());
}

}  // namespace
