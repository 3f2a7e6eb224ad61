// Point to chainage through the spatial index (single points and batches) gives, bit for bit, the answers of
// the search that projects every element, on random points around mixed alignments with kinks.
#include <gtest/gtest.h>

#include <random>
#include <vector>

#include "alignment_test_support.h"

using namespace alnt_test;

namespace {

// Some tangents get a fixed start azimuth, making kinks (and wedges) at their starts.
void addKinks(CAlntH& alignment, std::mt19937& rng) {
  std::uniform_real_distribution<double> turn(-40.0, 40.0);
  for (int i = 4; i < alignment.getNumOfHes(); i += 8) {
    CAlntHeSegment kinked = *CAlntHeSegment::cast(const_cast<CAlntHe*>(alignment.getHe(i)));
    CMathAngle start;
    ASSERT_TRUE(kinked.getStartAzimut(start));
    kinked.setFixedStartAzInDeg(start.getDeg() + turn(rng));
    ASSERT_TRUE(alignment.replaceElement(i, kinked));
  }
}

// Points within 60 m of the centre line (also beyond the ends), points anywhere in the grown extent, and
// points at every joint with a few offsets (tie-breaks and wedges).
void samplePoints(const CAlntH& alignment, std::mt19937& rng, std::vector<double>& north, std::vector<double>& east) {
  double length = 0.0;
  ASSERT_TRUE(alignment.getHLengthInM(length));
  std::uniform_real_distribution<double> along(-100.0, length + 100.0), across(-60.0, 60.0), unit(0.0, 1.0);
  for (int k = 0; k < 250; ++k) {
    double n = 0.0, e = 0.0;
    ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(alignment.distance2Chainage(along(rng)), across(rng), n, e));
    north.push_back(n);
    east.push_back(e);
  }
  const C2dMinMax box = alignment.getBoundary();
  for (int k = 0; k < 60; ++k) {
    north.push_back(box.minNorth - 200.0 + (box.maxNorth - box.minNorth + 400.0) * unit(rng));
    east.push_back(box.minEast - 200.0 + (box.maxEast - box.minEast + 400.0) * unit(rng));
  }
  for (int i = 1; i < alignment.getNumOfHes(); ++i) {
    double ch = 0.0;
    ASSERT_TRUE(alignment.getHe(i)->getStartChainageInM(ch));
    for (const double off : {-30.0, -0.7, 0.0, 2.0, 45.0}) {
      double n = 0.0, e = 0.0;
      ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(ch, off, n, e));
      north.push_back(n);
      east.push_back(e);
    }
  }
}

void expectIndexedMatchesScan(const CAlntH& alignment, const std::vector<double>& north,
                              const std::vector<double>& east) {
  CAlntH scanning = alignment;
  scanning.setUseSearchIndex(false);
  std::vector<TAlntStationResult> batch(north.size());
  for (const bool withExtension : {false, true}) {
    const std::size_t found =
        alignment.FindChainagesAndOffsets(north.data(), east.data(), north.size(), batch.data(), withExtension);
    std::size_t scanFound = 0;
    for (std::size_t k = 0; k < north.size(); ++k) {
      TAlntStationResult scan, single;
      const auto find = [&](const CAlntH& a, TAlntStationResult& r) {
        r.found = withExtension ? a.FindChainageAndOffset(north[k], east[k], r.chainage, r.offset, r.extrapolated,
                                                          &r.index, &r.atJoint)
                                : a.FindChainageAndOffset(north[k], east[k], r.chainage, r.offset, &r.index,
                                                          &r.atJoint);
      };
      find(scanning, scan);
      find(alignment, single);
      scanFound += scan.found ? 1 : 0;
      for (const TAlntStationResult& indexed : {batch[k], single}) {
        ASSERT_EQ(indexed.found, scan.found) << k;
        if (!scan.found) continue;
        // Identical doubles, not merely close ones.
        ASSERT_EQ(indexed.chainage, scan.chainage) << k;
        ASSERT_EQ(indexed.offset, scan.offset) << k;
        ASSERT_EQ(indexed.index, scan.index) << k;
        ASSERT_EQ(indexed.atJoint, scan.atJoint) << k;
        ASSERT_EQ(indexed.extrapolated, scan.extrapolated) << k;
      }
    }
    EXPECT_EQ(found, scanFound);
  }
}

}  // namespace

TEST(AlignmentBatch, IndexedAnswersEqualTheScan) {
  struct Case {
    unsigned seed;
    int curves;
  };
  for (const Case c : {Case{21, 1}, Case{22, 6}, Case{23, 20}}) {
    std::mt19937 rng(c.seed);
    CAlntH alignment = mixedAlignment(c.seed, c.curves, 250.0 * c.seed, 37.0 * c.seed);
    addKinks(alignment, rng);
    appendIpRun(alignment, c.seed, c.curves / 2);
    std::vector<double> north, east;
    samplePoints(alignment, rng, north, east);
    expectIndexedMatchesScan(alignment, north, east);
    // After an edit the index is rebuilt: a sharper arc near the start changes everything after it.
    ASSERT_TRUE(alignment.replaceElement(2, arc(60.0, 90.0, c.seed % 2 == 0)));
    expectIndexedMatchesScan(alignment, north, east);
  }
}

TEST(AlignmentBatch, HairpinTieBreakAndEmptyAlignment) {
  CAlntH hairpin;
  hairpin.setStartPos(kNorth0, kEast0, 0.0);
  for (const CAlntHe* element : {static_cast<const CAlntHe*>(new CAlntHeSegment(tangent(100.0))),
                                 static_cast<const CAlntHe*>(new CAlntHeArc(arc(10.0 * M_PI, 10.0, true))),
                                 static_cast<const CAlntHe*>(new CAlntHeSegment(tangent(100.0)))}) {
    ASSERT_TRUE(hairpin.appendElement(*element));
    delete element;
  }
  std::vector<double> north, east;
  for (double shift = -0.0012; shift <= 0.0012; shift += 0.0001) {
    north.push_back(kNorth0 + 50.0);
    east.push_back(kEast0 + 10.0 + shift);
  }
  expectIndexedMatchesScan(hairpin, north, east);
  std::vector<TAlntStationResult> results(north.size());
  EXPECT_EQ(CAlntH().FindChainagesAndOffsets(north.data(), east.data(), north.size(), results.data(), true), 0u);
  EXPECT_FALSE(results.front().found);
}
