// The curve group about an intersection point: plain arcs against the textbook tangent, length and external;
// symmetric clothoid groups against the classic series for shift and k; every group closing on its exit
// tangent (against an integrated heading for the clothoid), continuous at SC and CS, mirrored between left
// and right, unchanged at survey coordinates; round trips through length and offset; the failures and the
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
using svy_math::units::kPi;

constexpr double kSurveyN = 5000000.0;
constexpr double kSurveyE = 500000.0;
// Doubles at N 5 000 000 are 9.3e-10 m apart: a chain of three placed parts ends within a few of them.
constexpr double kSurveyClosure = 3e-9;

C2dPos at(const C2dPos& from, double azRad, double distance) {
  return C2dPos(from.north() + distance * std::cos(azRad), from.east() + distance * std::sin(azRad));
}

// The group about an IP at (north, east): the entry tangent comes in at azInDeg, the exit tangent turns by
// deflDeg (positive right); the neighbours are 2 km away.
CCurveIp makeGroup(double north, double east, double azInDeg, double deflDeg, double radius, double lenIn,
                   double lenOut, AlntMathSpiralType type = eMathSpiralEuler, bool* fits = nullptr) {
  const C2dPos ip(north, east);
  const double azIn = azInDeg * kDegToRad, azOut = (azInDeg + deflDeg) * kDegToRad;
  CCurveIp group;
  group.setSpiralType(type);
  EXPECT_TRUE(group.setIp(north, east, radius, lenIn, lenOut));
  const bool ok = group.setNeighbours(at(ip, azIn, -2000.0), at(ip, azOut, 2000.0));
  if (fits != nullptr) {
    *fits = ok;
  } else {
    EXPECT_TRUE(ok);
  }
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

TEST(CurveIpPlainArc, MatchesTextbookTangentLengthAndExternal) {
  const struct {
    double azIn, defl, radius;
  } cases[] = {{10.0, 30.0, 300.0}, {200.0, -75.0, 120.0}, {-40.0, 150.0, 50.0}, {95.0, -2e-4, 5000.0}};
  for (const auto& c : cases) {
    const CCurveIp g = makeGroup(kSurveyN, kSurveyE, c.azIn, c.defl, c.radius, 0.0, 0.0);
    const double d = std::fabs(c.defl) * kDegToRad, t = c.radius * std::tan(d / 2.0);
    const double length = c.radius * d, external = c.radius * (1.0 / std::cos(d / 2.0) - 1.0);
    EXPECT_NEAR(g.getDeflection(), c.defl * kDegToRad, 1e-12);  // neighbours rounded at 2 km
    EXPECT_NEAR(g.getTangentIn(), t, 1e-9);
    EXPECT_NEAR(g.getTangentOut(), t, 1e-9);
    EXPECT_NEAR(g.getTotalLength(), length, 1e-9);
    EXPECT_TRUE(g.getShiftIn() == 0.0 && g.getShiftOut() == 0.0);
    EXPECT_TRUE(g.getSpiralIn() == nullptr && g.getArc() != nullptr && g.getSpiralOut() == nullptr);
    EXPECT_NEAR(dist(g.getIp(), posAt(g, length / 2.0)), external, kSurveyClosure);
    expectPosNear(g.getTS(), at(g.getIp(), c.azIn * kDegToRad, -t).north(), at(g.getIp(), c.azIn * kDegToRad, -t).east(),
                  kSurveyClosure);
    expectPosNear(posAt(g, length), g.getST().north(), g.getST().east(), kSurveyClosure);
    EXPECT_EQ(g.getRadius(), c.defl > 0.0 ? c.radius : -c.radius);
    EXPECT_NEAR(g.getCurvatureAtLength(length / 3.0), 1.0 / g.getRadius(), 1e-15);
  }
}

// The clothoid's end point by its classic series in the spiral angle t = L / 2R, independent of the Fresnel
// integrals: x = L (1 - t^2/10 + t^4/216 - t^6/9360 + t^8/685440), y = L (t/3 - t^3/42 + t^5/1320 - ...).
void clothoidSeries(double length, double radius, double& p, double& k) {
  const double t = length / (2.0 * radius), t2 = t * t;
  const double x = length * (1.0 - t2 / 10.0 + t2 * t2 / 216.0 - t2 * t2 * t2 / 9360.0 + t2 * t2 * t2 * t2 / 685440.0);
  const double y = length * t * (1.0 / 3.0 - t2 / 42.0 + t2 * t2 / 1320.0 - t2 * t2 * t2 / 75600.0 +
                                 t2 * t2 * t2 * t2 / 6894720.0);
  p = y - radius * (1.0 - std::cos(t));
  k = x - radius * std::sin(t);
}

TEST(CurveIpSymmetricSpirals, MatchClassicShiftAndTangentFormulas) {
  const struct {
    double azIn, defl, radius, spiral;
  } cases[] = {{30.0, 40.0, 400.0, 100.0}, {300.0, -25.0, 800.0, 120.0}, {180.0, 90.0, 150.0, 60.0},
               {0.0, -120.0, 60.0, 62.83185307179586}};  // the last: spirals of 30 degrees each
  for (const auto& c : cases) {
    const CCurveIp g = makeGroup(kSurveyN, kSurveyE, c.azIn, c.defl, c.radius, c.spiral, c.spiral);
    double p = 0.0, k = 0.0;
    clothoidSeries(c.spiral, c.radius, p, k);
    const double d = std::fabs(c.defl) * kDegToRad, theta = c.spiral / (2.0 * c.radius);
    const double ts = (c.radius + p) * std::tan(d / 2.0) + k, total = 2.0 * c.spiral + c.radius * (d - 2.0 * theta);
    EXPECT_NEAR(g.getShiftIn(), p, 1e-9);
    EXPECT_NEAR(g.getShiftOut(), p, 1e-9);
    EXPECT_NEAR(g.getTangentIn(), ts, 1e-8);
    EXPECT_NEAR(g.getTangentOut(), ts, 1e-8);
    EXPECT_NEAR(g.getTotalLength(), total, 1e-9);
    // The external distance: IP to the middle of the arc, (R + p) / cos(D/2) - R.
    EXPECT_NEAR(dist(g.getIp(), posAt(g, total / 2.0)), (c.radius + p) / std::cos(d / 2.0) - c.radius, 1e-8);
  }
}

struct GroupCase {
  const char* name;
  AlntMathSpiralType type;
  double defl, radius, lenIn, lenOut;
};

class CurveIpGroup : public ::testing::TestWithParam<GroupCase> {
 protected:
  CCurveIp make(double north, double east, double azInDeg, double deflSign = 1.0) const {
    const GroupCase& c = GetParam();
    return makeGroup(north, east, azInDeg, deflSign * c.defl, c.radius, c.lenIn, c.lenOut, c.type);
  }
};

// The chain of parts closes: each part starts where and as the one before ends, the exit spiral ends at ST
// on the exit tangent in its direction, the curvature runs 0, 1/R, 1/R, 0, and T1, T2 put TS and ST on the
// tangents. For the clothoid, an independent integration of the heading from TS must reach ST.
TEST_P(CurveIpGroup, ClosesOnTheExitTangent) {
  const GroupCase& c = GetParam();
  const CCurveIp g = make(kSurveyN, kSurveyE, 37.0);
  const double side = c.defl > 0.0 ? 1.0 : -1.0, azIn = 37.0, azOut = 37.0 + c.defl;
  const double total = g.getTotalLength(), arc = total - c.lenIn - c.lenOut;
  ASSERT_TRUE(g.isok());
  EXPECT_GE(arc, 0.0);
  const C2dPos joints[] = {g.getTS(), g.getSC(), g.getCS(), g.getST()};
  const double lengths[] = {0.0, c.lenIn, c.lenIn + arc, total};
  const double turnOver2nm = 2e-9 / c.radius / kDegToRad + 1e-10;  // degrees
  for (int i = 0; i < 4; ++i) {
    // The position and direction approached from both sides of each joint agree.
    expectPosNear(posAt(g, lengths[i]), joints[i].north(), joints[i].east(), kSurveyClosure);
    if (i > 0) expectPosNear(posAt(g, lengths[i] - 1e-7), joints[i].north(), joints[i].east(), 2e-7);
    if (i < 3) expectPosNear(posAt(g, lengths[i] + 1e-7), joints[i].north(), joints[i].east(), 2e-7);
    EXPECT_NEAR(angleDiffDeg(azDegAt(g, lengths[i] - 1e-9), azDegAt(g, lengths[i] + 1e-9)), 0.0, turnOver2nm);
    const bool tangentEnd = (i == 0 && c.lenIn > 0.0) || (i == 3 && c.lenOut > 0.0);
    const double curvature = tangentEnd ? 0.0 : side / c.radius;
    EXPECT_NEAR(g.getCurvatureAtLength(lengths[i]), curvature, 1e-6 / c.radius) << i;
  }
  for (const CGenericSegment* part : {static_cast<const CGenericSegment*>(g.getSpiralIn()),
                                      static_cast<const CGenericSegment*>(g.getArc()),
                                      static_cast<const CGenericSegment*>(g.getSpiralOut())}) {
    EXPECT_TRUE(part == nullptr || part->isok());
  }
  if (const CCurveSpiral* exit = g.getSpiralOut()) {
    expectPosNear(exit->getEndPos(), g.getST().north(), g.getST().east(), kSurveyClosure);
  }
  EXPECT_NEAR(angleDiffDeg(azDegAt(g, total), azOut), 0.0, 1e-10);
  EXPECT_NEAR(angleDiffDeg(azDegAt(g, 0.0), azIn), 0.0, 1e-10);
  EXPECT_NEAR(g.getCurvatureAtLength(arc > 0.0 ? c.lenIn + arc / 2.0 : c.lenIn), side / c.radius, 1e-6 / c.radius);
  const C2dPos ts = at(g.getIp(), azIn * kDegToRad, -g.getTangentIn()), st = at(g.getIp(), azOut * kDegToRad, g.getTangentOut());
  expectPosNear(g.getTS(), ts.north(), ts.east(), kSurveyClosure);
  expectPosNear(g.getST(), st.north(), st.east(), kSurveyClosure);
  EXPECT_EQ(g.getRadius(), side * c.radius);
  if (c.type != eMathSpiralEuler) return;
  // The clothoid's curvature is linear on the spirals and 1/R on the arc; its heading integrates in closed
  // form, and the integrated path from TS ends at ST.
  const double a0 = azIn * kDegToRad, R = c.radius, L1 = c.lenIn, L2 = c.lenOut;
  const auto heading = [&](double u) {
    if (L1 > 0.0 && u <= L1) return a0 + side * u * u / (2.0 * R * L1);
    if (L2 <= 0.0 || u <= L1 + arc) return a0 + side * (L1 / 2.0 + (u - L1)) / R;
    const double v = total - u;  // from ST backwards
    return azOut * kDegToRad - side * v * v / (2.0 * R * L2);
  };
  double dN = 0.0, dE = 0.0;
  curve_test::integrateHeading(heading, total, 1e-12, dN, dE);
  EXPECT_NEAR(g.getTS().north() + dN, g.getST().north(), 1e-7);
  EXPECT_NEAR(g.getTS().east() + dE, g.getST().east(), 1e-7);
}

// Every point at a length and an offset finds the same length and offset back (joints included); the group
// at survey coordinates is the local group moved there; a left turn mirrors a right one.
TEST_P(CurveIpGroup, RoundTripsSurveyCoordinatesAndMirror) {
  const GroupCase& c = GetParam();
  const CCurveIp g = make(kSurveyN, kSurveyE, 0.0), local = make(0.0, 0.0, 0.0), mirror = make(0.0, 0.0, 0.0, -1.0);
  const double total = g.getTotalLength();
  const double lengths[] = {0.0, 0.3 * c.lenIn, c.lenIn, total / 2.0, total - c.lenOut, total - 0.2 * c.lenOut, total};
  for (const double s : lengths) {
    const C2dPos on = posAt(g, s), onLocal = posAt(local, s), onMirror = posAt(mirror, s);
    expectPosNear(C2dPos(on.north() - kSurveyN, on.east() - kSurveyE), onLocal.north(), onLocal.east(), kSurveyClosure);
    expectPosNear(onMirror, onLocal.north(), -onLocal.east(), 1e-9);
    EXPECT_NEAR(mirror.getCurvatureAtLength(s), -local.getCurvatureAtLength(s), 1e-15);
    const double az = azDegAt(g, s) * kDegToRad;
    for (const double offset : {-7.5, -1e-3, 0.0, 4.0}) {
      const C2dPos p = at(on, az + kPi / 2.0, offset);
      double length = 0.0, off = 0.0;
      ASSERT_TRUE(g.getLengthAndOffset(p.north(), p.east(), length, off)) << s << " " << offset;
      EXPECT_NEAR(length, s, 2e-8) << offset;
      EXPECT_NEAR(off, offset, 2e-8) << s;
      double distance = -1.0;
      EXPECT_TRUE(g.getShortestDistanceToPoint(p.north(), p.east(), distance));
      EXPECT_NEAR(distance, std::fabs(offset), 2e-8);
    }
  }
  // Before TS on the entry tangent no part has a foot.
  const C2dPos before = at(g.getTS(), 0.0, -10.0);
  double length = 0.0, offset = 0.0;
  EXPECT_FALSE(g.getLengthAndOffset(before.north(), before.east(), length, offset));
  // Over a grid around the group, the search (which skips parts whose box is too far) answers as asking
  // every part in order, the later one winning within 1 mm.
  const C2dMinMax box = g.getBoundary();
  const double gridN = box.maxNorth - box.minNorth + 100.0, gridE = box.maxEast - box.minEast + 100.0;
  for (int i = 0; i <= 40; ++i) {
    for (int j = 0; j <= 40; ++j) {
      const double n = box.minNorth - 50.0 + gridN * i / 40.0, e = box.minEast - 50.0 + gridE * j / 40.0;
      bool expected = false;
      double expLength = 0.0, expOffset = 0.0, start = 0.0;
      for (const CGenericSegment* part : {static_cast<const CGenericSegment*>(g.getSpiralIn()),
                                          static_cast<const CGenericSegment*>(g.getArc()),
                                          static_cast<const CGenericSegment*>(g.getSpiralOut())}) {
        double s = 0.0, off = 0.0;
        if (part != nullptr && part->getLengthAndOffset(n, e, s, off) &&
            (!expected || std::fabs(off) <= std::fabs(expOffset) + 1e-3)) {
          expected = true;
          expLength = start + s;
          expOffset = off;
        }
        if (part != nullptr) start += part->getTotalLength();
      }
      const bool found = g.getLengthAndOffset(n, e, length, offset);
      ASSERT_EQ(found, expected) << n << " " << e;
      EXPECT_TRUE(!found || (length == expLength && offset == expOffset)) << n << " " << e;
    }
  }
}

// Stepping by chord deviation walks through the joints to ST; the box holds the group; the parts are handed
// over in order of travel.
TEST_P(CurveIpGroup, StepsBoxAndParts) {
  const CCurveIp g = make(kSurveyN, kSurveyE, 250.0);
  const double total = g.getTotalLength();
  const C2dMinMax box = g.getBoundary();
  int steps = 0;
  for (double s = 0.0; s < total && steps < 100000; ++steps) {
    const double step = g.getStepForDeviation(s, 0.005);
    ASSERT_GT(step, 0.0) << s;
    s = std::fmin(s + step, total);
    EXPECT_TRUE(box.contains(posAt(g, s), 1e-9)) << s;
  }
  EXPECT_LT(steps, 100000);
  struct Kinds : CGenericSegmentVisitor_const {
    std::string seen;
    void Visit(const CGenericLine&) override { seen += 'L'; }
    void Visit(const CGenericArc&) override { seen += 'A'; }
    void Visit(const CGenericSpiral&) override { seen += 'S'; }
  } kinds;
  g.ForEachSegment(kinds);
  const std::string expected = std::string(GetParam().lenIn > 0.0 ? "S" : "") +
                               (total - GetParam().lenIn - GetParam().lenOut > 0.0 ? "A" : "") +
                               (GetParam().lenOut > 0.0 ? "S" : "");
  EXPECT_EQ(kinds.seen, expected);
}

INSTANTIATE_TEST_SUITE_P(Groups, CurveIpGroup,
                         ::testing::Values(GroupCase{"SymmetricRight", eMathSpiralEuler, 48.0, 350.0, 90.0, 90.0},
                                           GroupCase{"AsymmetricRight", eMathSpiralEuler, 63.0, 250.0, 120.0, 40.0},
                                           GroupCase{"AsymmetricLeft", eMathSpiralEuler, -35.0, 500.0, 30.0, 150.0},
                                           GroupCase{"EntryOnlyLeft", eMathSpiralEuler, -20.0, 400.0, 80.0, 0.0},
                                           GroupCase{"ExitOnlyRight", eMathSpiralEuler, 110.0, 90.0, 0.0, 70.0},
                                           // spirals fill the deflection: no arc between them
                                           GroupCase{"NoArc", eMathSpiralEuler, 2.0 * 100.0 / 600.0 / kDegToRad, 300.0,
                                                     100.0, 100.0},
                                           GroupCase{"CubicAsymmetricLeft", eMathSpiralCubic, -55.0, 300.0, 100.0, 60.0},
                                           GroupCase{"CubicRight", eMathSpiralCubic, 24.0, 1000.0, 150.0, 150.0}),
                         [](const ::testing::TestParamInfo<GroupCase>& param) { return std::string(param.param.name); });

TEST(CurveIpFailures, SpiralsBeyondTheDeflectionAndDegenerateTangents) {
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
    const CCurveIp g = makeGroup(kSurveyN, kSurveyE, 15.0, c.defl, c.radius, c.lenIn, c.lenOut, c.type, &fits);
    EXPECT_FALSE(fits) << c.defl;
    EXPECT_TRUE(!g.isok() && g.getStatus() == c.status) << g.getStatus();
    double n = 0.0, e = 0.0;
    EXPECT_FALSE(g.getPosAtLength(0.0, n, e));
    EXPECT_TRUE(std::isnan(g.getTotalLength()) && std::isnan(g.getTS().north()) && g.getArc() == nullptr);
  }
  // Bad definitions are refused and leave the group as it was; a neighbour on the IP defines no tangent.
  CCurveIp g = makeGroup(100.0, 200.0, 0.0, 30.0, 300.0, 50.0, 50.0);
  const double length = g.getTotalLength();
  for (const auto& bad : {std::make_pair(-1.0, 0.0), std::make_pair(curve_test::kNaN, 0.0),
                          std::make_pair(0.0, curve_test::kInf)}) {
    EXPECT_FALSE(g.setIp(100.0, 200.0, 300.0, bad.first, bad.second));
  }
  EXPECT_FALSE(g.setIp(100.0, 200.0, 0.0, 10.0, 0.0));  // spirals need a radius
  EXPECT_TRUE(g.isok() && g.getTotalLength() == length && g.getLenIn() == 50.0);
  EXPECT_FALSE(g.setNeighbours(C2dPos(100.0, 200.0), C2dPos(300.0, 200.0)));
  EXPECT_TRUE(!g.isok() && g.getStatus() == eCurveIpNoTangent);
}

// A bare angle point: no length, TS = ST = IP; only the wedge outside the angle has its foot there, on the
// outer side (left of a right turn).
TEST(CurveIpSimplePoint, HasNoLengthAndAnswersTheOuterWedge) {
  CCurveIp g = makeGroup(kSurveyN, kSurveyE, 0.0, 60.0, 200.0, 30.0, 30.0);
  g.setSimplePoint();
  ASSERT_TRUE(g.isok() && g.isSimplePoint());
  EXPECT_TRUE(g.getTotalLength() == 0.0 && g.getTangentIn() == 0.0 && g.getTangentOut() == 0.0 && g.getRadius() == 0.0);
  EXPECT_TRUE(g.getTS() == g.getIp() && g.getST() == g.getIp());
  EXPECT_NEAR(g.getDeflection(), 60.0 * kDegToRad, 1e-13);
  EXPECT_TRUE(g.getSpiralIn() == nullptr && g.getArc() == nullptr && g.getSpiralOut() == nullptr);
  expectPosNear(posAt(g, 0.0005), kSurveyN, kSurveyE, 0.0);
  double n = 0.0, e = 0.0, length = 1.0, offset = 0.0;
  EXPECT_FALSE(g.getPosAtLength(0.002, n, e));
  EXPECT_NEAR(azDegAt(g, 0.0), 60.0, 1e-12);
  ASSERT_TRUE(g.getLengthAndOffset(kSurveyN + 3.0, kSurveyE - 4.0, length, offset));
  EXPECT_TRUE(length == 0.0 && std::fabs(offset + 5.0) < 1e-9);
  EXPECT_FALSE(g.getLengthAndOffset(kSurveyN - 3.0, kSurveyE + 1.0, length, offset));  // beside the entry tangent
  // A simple point needs only distinct neighbours: a reversal is an angle point too.
  EXPECT_TRUE(g.setNeighbours(C2dPos(kSurveyN - 10.0, kSurveyE), C2dPos(kSurveyN - 20.0, kSurveyE)));
  // Copies are equal and independent.
  CCurveIp copy(g);
  EXPECT_TRUE(copy.isEqual(g));
  copy.setIp(kSurveyN, kSurveyE, 100.0, 0.0, 0.0);
  EXPECT_FALSE(copy.isEqual(g));
  EXPECT_TRUE(g.isSimplePoint());
}

}  // namespace
