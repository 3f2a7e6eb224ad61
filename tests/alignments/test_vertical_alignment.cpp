// The vertical alignment: a profile defined by intersection points equals the same profile defined by
// elements, circular intersection-point curves have the curvature of their circles, extrapolation, the
// lookup rules (the index against the element walk), re-chaining after edits and start changes with the
// deliberate asymmetry of its two anchoring paths, the acceptance rule, and concurrent readers.
#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <thread>
#include <vector>

#include "svymath/alignments/alnt_v.h"
#include "svymath/alignments/vertical_arc.h"
#include "svymath/alignments/vertical_element.h"
#include "svymath/alignments/vertical_ls_element.h"
#include "svymath/alignments/vertical_ls_with_arc.h"

namespace {

// Grades +2, -3, +1 % meeting at VIPs (1250, 105) and (1510, 97.2), from (1000, 100) to (1650, 98.6).
const CLsInfo kVips[] = {{1000.0, 100.0, 0.0, 1000.0, 0.0},
                         {1250.0, 105.0, 200.0, 1150.0, 0.0},
                         {1510.0, 97.2, 120.0, 1450.0, 0.0},
                         {1650.0, 98.6, 0.0, 1650.0, 0.0}};

CAlntV byElements() {
  CAlntV profile;
  profile.setStartChainageInM(1000.0);
  profile.setStartHeight(100.0);
  CVerticalElement e;
  const double pieces[][3] = {{150, 2, 2}, {200, 2, -3}, {100, -3, -3}, {120, -3, 1}, {80, 1, 1}};
  for (const auto& p : pieces) {
    e.setParabola(p[0], p[1], p[2]);
    EXPECT_TRUE(profile.appendElement(e));
  }
  return profile;
}

CAlntV byVips() {
  CAlntV profile;
  profile.setStartChainageInM(1000.0);
  profile.setStartHeight(100.0);
  for (int i = 0; i < 3; ++i) EXPECT_TRUE(profile.appendElement(CVerticalLSElement(kVips[i], kVips[i + 1])));
  return profile;
}

CAlntV byIpsWithArcs(double r1, double r2) {
  CAlntV profile;
  profile.setStartChainageInM(1000.0);
  profile.setStartHeight(100.0);
  const double radii[] = {0.0, r1, r2, 0.0};
  for (int i = 0; i < 4; ++i) {
    CAlntVeLsWithArc e;
    e.setIpAndR(kVips[i].ipChainage, kVips[i].ipHeight, radii[i]);
    EXPECT_TRUE(profile.appendElement(e));
  }
  return profile;
}

double heightAt(const CAlntV& profile, double chainage) {
  double h = NAN;
  EXPECT_TRUE(profile.getHeightAtChain(chainage, h)) << chainage;
  return h;
}

// The polyline through the VIPs: the profile's height on its grade lines.
double lineHeight(double chainage) {
  int i = 0;
  while (i < 2 && chainage > kVips[i + 1].ipChainage) ++i;
  const CLsInfo& a = kVips[i];
  const CLsInfo& b = kVips[i + 1];
  return a.ipHeight + (b.ipHeight - a.ipHeight) * (chainage - a.ipChainage) / (b.ipChainage - a.ipChainage);
}

TEST(VerticalAlignment, ProfileByVipsEqualsProfileByElements) {
  const CAlntV elements = byElements();
  const CAlntV vips = byVips();
  double f1 = 0.0, f2 = 0.0;
  ASSERT_TRUE(elements.getFinalChainageInM(f1) && vips.getFinalChainageInM(f2));
  EXPECT_NEAR(f1, 1650.0, 1e-9);
  EXPECT_NEAR(f2, 1650.0, 1e-9);
  for (double c = 1000.0; c <= 1650.0; c += 0.5) {
    double g1 = 0.0, g2 = 0.0;
    EXPECT_NEAR(heightAt(vips, c), heightAt(elements, c), 1e-9) << c;
    ASSERT_TRUE(elements.getGradeAtChainage(c, g1) && vips.getGradeAtChainage(c, g2));
    EXPECT_NEAR(g1, g2, 1e-9) << c;
    const bool onGrade = std::fabs(c - 1250.0) > 100.0 && std::fabs(c - 1510.0) > 60.0;
    if (onGrade) {
      EXPECT_NEAR(heightAt(vips, c), lineHeight(c), 1e-9) << c;
    }
  }
  EXPECT_EQ(vips.getStartChainageInM(), 1000.0);
  EXPECT_EQ(vips.getStartPosH(), 100.0);
}

// Circular curves about the IPs: on the grade lines away from the IPs, grades continuous, and inside the
// curves the height's second difference is the circle's 1 / (R cos^3 theta).
TEST(VerticalAlignment, IpsWithCircularCurves) {
  const CAlntV profile = byIpsWithArcs(4000.0, 3000.0);
  EXPECT_EQ(profile.getVe(1)->getType(), eAlntVeLsWithArc);
  EXPECT_EQ(CAlntVeLsWithArc::cast(profile.getVe(1))->getRadius(), 4000.0);
  EXPECT_EQ(CAlntVeLsWithArc::cast(profile.getVe(1))->getArc().getRadius(), -4000.0);  // a crest
  double previousGrade = 2.0;
  for (double c = 1000.0; c <= 1650.0; c += 0.25) {
    double g = 0.0;
    ASSERT_TRUE(profile.getGradeAtChainage(c, g));
    EXPECT_NEAR(g, previousGrade, 0.01) << c;  // no kink: 0.25 m changes the grade by R = 3000 at most
    previousGrade = g;
    if (std::fabs(c - 1250.0) > 110.0 && std::fabs(c - 1510.0) > 70.0) {
      EXPECT_NEAR(heightAt(profile, c), lineHeight(c), 1e-7) << c;
    }
  }
  const double step = 0.5;
  for (const auto& probe : {std::make_pair(1250.0, -4000.0), std::make_pair(1510.0, 3000.0)}) {
    double g = 0.0;
    profile.getGradeAtChainage(probe.first, g);
    const double cosTheta = std::cos(std::atan(g / 100.0));
    const double second = (heightAt(profile, probe.first + step) - 2.0 * heightAt(profile, probe.first) +
                           heightAt(profile, probe.first - step)) / (step * step);
    EXPECT_NEAR(second * probe.second * cosTheta * cosTheta * cosTheta, 1.0, 1e-5);
  }
}

TEST(VerticalAlignment, ExtrapolatesAlongTheEndGrades) {
  const CAlntV profile = byVips();
  double h = 0.0;
  bool extrapolated = false;
  ASSERT_TRUE(profile.getHeightAtChainExtr(990.0, h, extrapolated));
  EXPECT_TRUE(extrapolated);
  EXPECT_NEAR(h, 100.0 - 0.2, 1e-12);
  ASSERT_TRUE(profile.getHeightAtChainExtr(1700.0, h, extrapolated));
  EXPECT_TRUE(extrapolated);
  EXPECT_NEAR(h, 98.6 + 0.5, 1e-9);
  ASSERT_TRUE(profile.getHeightAtChainExtr(1300.0, h, extrapolated));
  EXPECT_FALSE(extrapolated);
  EXPECT_FALSE(CAlntV().getHeightAtChainExtr(0.0, h));
  for (const double absurd : {HUGE_VAL, -HUGE_VAL, std::nan("")}) EXPECT_FALSE(profile.getHeightAtChainExtr(absurd, h));
}

// The element at a chainage: a joint belongs to the later element, 1 mm of tolerance at both ends.
TEST(VerticalAlignment, LookupAtJointsAndEnds) {
  const CAlntV profile = byElements();
  const struct {
    double chainage;
    int index;
  } cases[] = {{1150.0, 1}, {1149.9999, 0}, {1650.0005, 4}, {1650.002, -1}, {999.9991, 0}, {999.998, -1}};
  for (const auto& c : cases) {
    int index = -1;
    const CAlntVe* e = profile.getVertElemAtChain(c.chainage, nullptr, &index);
    EXPECT_EQ(e == nullptr ? -1 : index, c.index) << c.chainage;
  }
}

// The binary search gives the element the backward walk of the lookup rule gives, on a profile with height
// steps (zero-length elements), also while a bulk update leaves the chain unsorted.
TEST(VerticalAlignment, IndexAgreesWithTheWalk) {
  CAlntV profile = byElements();
  CVerticalElement step;
  step.setVerticalGap(0.4);
  ASSERT_TRUE(profile.insertElement(2, step) && profile.insertElement(2, step));
  const auto walk = [&profile](double c) {
    for (int i = profile.getNumOfVes() - 1; i >= 0; --i) {
      double s = 0.0, len = 0.0;
      if (!profile.getVe(i)->getStartChainageInM(s)) return -1;
      if ((s <= c || (i == 0 && s - 0.001 <= c)) && profile.getVe(i)->getHLengthInM(len) && c - s >= -0.001 &&
          c - s < len + 0.001) {
        return i;
      }
    }
    return -1;
  };
  std::mt19937 random(7);
  std::uniform_real_distribution<double> chainage(990.0, 1660.0);
  for (int round = 0; round < 2; ++round) {
    for (int k = 0; k < 3000; ++k) {
      const double c = k < 40 ? 1350.0 + (k - 20) * 0.0002 : chainage(random);
      int index = -1;
      const bool found = profile.getVertElemAtChain(c, nullptr, &index) != nullptr;
      EXPECT_EQ(found ? index : -1, walk(c)) << c;
    }
    if (round > 0) break;
    profile.onBulkUpdateStarted();  // the second round: stale, unsorted starts
    ASSERT_TRUE(profile.insertElement(0, CVerticalElement(0.0, 0.0, 30.0, 1.0)));
  }
  double stale = 0.0;
  ASSERT_TRUE(profile.getVe(1)->getStartChainageInM(stale));
  EXPECT_EQ(stale, 1000.0);
  profile.onBulkUpdateFinished();
  ASSERT_TRUE(profile.getVe(1)->getStartChainageInM(stale));
  EXPECT_EQ(stale, 1030.0);
}

// Edits re-chain: every element starts at its predecessor's end, and moving the start moves the profile.
TEST(VerticalAlignment, EditsAndStartChangesRechain) {
  CAlntV profile = byElements();
  const double before = heightAt(profile, 1600.0);
  ASSERT_TRUE(profile.insertElement(2, CVerticalElement(0.0, 0.0, 40.0, -3.0)));  // 40 m more of -3 %
  ASSERT_TRUE(profile.replaceElement(0, CVerticalElement(0.0, 0.0, 150.0, 1.0)));  // 1.5 m lower
  EXPECT_NEAR(heightAt(profile, 1640.0), before - 1.2 - 1.5, 1e-9);
  ASSERT_TRUE(profile.removeVe(2) && profile.removeVe(0));
  for (int i = 1; i < profile.getNumOfVes(); ++i) {
    double end = 0.0, start = 0.0;
    ASSERT_TRUE(profile.getVe(i - 1)->getFinalChainageInM(end) && profile.getVe(i)->getStartChainageInM(start));
    EXPECT_EQ(start, end);
    EXPECT_NEAR(profile.getVe(i)->getStartHt(), profile.getVe(i - 1)->getFinalHt(), 1e-12);
  }
  EXPECT_EQ(profile.getStartChainageInM(), 1000.0);  // the first element now starts at the start
  profile.setStartPos(123.0, 456.0, 110.0);           // only the height is taken
  EXPECT_EQ(profile.getStartChainageInM(), 1000.0);
  EXPECT_NEAR(heightAt(profile, 1000.0), 110.0, 1e-12);
  profile.setStartChainageInM(2000.0);
  double final = 0.0;
  ASSERT_TRUE(profile.getFinalChainageInM(final));
  EXPECT_NEAR(final, 2500.0, 1e-9);
  while (profile.getNumOfVes() > 0) ASSERT_TRUE(profile.removeVe(0));
  double length = -1.0;
  EXPECT_TRUE(profile.getHLengthInM(length) && length == 0.0);
  EXPECT_FALSE(profile.getHeightAtChain(2000.0, final));
}

// Deliberate: after an edit at the start an intersection-point first element keeps its own chainage (and
// takes the start height); setting the start chainage imposes it.
TEST(VerticalAlignment, FirstIntersectionPointKeepsItsChainageUntilTheStartIsSet) {
  CAlntV profile;
  profile.setStartChainageInM(1000.0);
  profile.setStartHeight(100.0);
  ASSERT_TRUE(profile.appendElement(CVerticalLSElement(CLsInfo(0, 50, 0, 0, 0), CLsInfo(100, 52, 0, 100, 0))));
  EXPECT_EQ(profile.getStartChainageInM(), 0.0);
  EXPECT_EQ(profile.getStartPosH(), 100.0);
  EXPECT_NEAR(heightAt(profile, 100.0), 52.0, 1e-12);
  profile.setStartChainageInM(40.0);
  EXPECT_EQ(profile.getStartChainageInM(), 40.0);
  EXPECT_NEAR(heightAt(profile, 70.0), 76.0, 1e-12);  // from (40, 100) to (100, 52)
  // An element of another kind first takes the stored start chainage whatever its own.
  CAlntV grades;
  grades.setStartChainageInM(1000.0);
  grades.setStartHeight(100.0);
  ASSERT_TRUE(grades.appendElement(CVerticalElement(0.0, 50.0, 100.0, 1.0)));
  EXPECT_NEAR(heightAt(grades, 1100.0), 101.0, 1e-12);
}

TEST(VerticalAlignment, CheckIfOkRefusesMisfits) {
  CAlntV profile = byVips();
  const int count = profile.getNumOfVes();
  CVerticalElement undefined;
  EXPECT_FALSE(profile.appendElement(undefined));
  // A VIP element must keep the order of the points around it.
  EXPECT_FALSE(profile.insertElement(1, CVerticalLSElement(CLsInfo(900, 1, 0, 0, 0), CLsInfo(1100, 2, 0, 0, 0))));
  EXPECT_FALSE(profile.insertElement(1, CVerticalLSElement(CLsInfo(1300, 1, 0, 0, 0), CLsInfo(1400, 2, 0, 0, 0))));
  EXPECT_FALSE(profile.insertElement(9, CVerticalElement(0.0, 0.0, 1.0, 1.0)));
  EXPECT_EQ(profile.getNumOfVes(), count);
  // A point between its neighbours fits: the profile gains a VIP at 1100.
  EXPECT_TRUE(profile.insertElement(1, CVerticalLSElement(CLsInfo(1100, 103, 0, 0, 0), CLsInfo(1250, 105, 200, 0, 0))));
  EXPECT_NEAR(heightAt(profile, 1100.0), 103.0, 1e-9);
}

// Readers on several threads see what one reader sees (run under ThreadSanitizer in CI).
TEST(VerticalAlignmentConcurrency, ParallelReadersAgree) {
  const CAlntV profile = byIpsWithArcs(4000.0, 3000.0);
  std::vector<double> expected;
  for (double c = 990.0; c <= 1660.0; c += 0.37) {
    double h = 0.0;
    profile.getHeightAtChainExtr(c, h);
    expected.push_back(h);
  }
  std::vector<int> mismatches(4, 0);
  std::vector<std::thread> readers;
  for (int t = 0; t < 4; ++t) {
    readers.emplace_back([&, t] {
      std::size_t i = 0;
      for (double c = 990.0; c <= 1660.0; c += 0.37, ++i) {
        double h = 0.0;
        if (!profile.getHeightAtChainExtr(c, h) || h != expected[i]) ++mismatches[t];
      }
    });
  }
  for (std::thread& reader : readers) reader.join();
  EXPECT_EQ(mismatches, std::vector<int>(4, 0));
}

}  // namespace
