// Known-area subdivision: the bracketing search, parallel-line and hinge-point cuts checked against the
// polyline area of the pieces, and the alignment entry points.
#include <gtest/gtest.h>

#include <cmath>
#include <thread>
#include <vector>

#include "area_test_support.h"
#include "svymath/alignments/horz_element_spiral.h"
#include "svymath/curves/curve_data_spiral.h"
#include "svymath/area/alignment_area.h"
#include "svymath/area/area_support.h"
#include "svymath/area/boundary_cut.h"
#include "svymath/area/polygon_area.h"
#include "svymath/area/subdivision.h"

using namespace svy_area_test;

namespace {

double totalArea(svy_list<AreaSegment> list) {
  double area = 0.0;
  EXPECT_EQ(eComputePolygonArea(list, &area), eAreaCalcOk);
  return area;
}

bool onBoundary(const TCoords& p, const svy_list<AreaSegment>& list) {
  for (const AreaSegment& s : list)
    if (boIsPointOnSegment(p, s)) return true;
  return false;
}

// Distance right of the line through p with the azimuth.
double across(const TCoords& q, const TCoords& p, double azimuth) {
  return -(q.north - p.north) * std::sin(azimuth) + (q.east - p.east) * std::cos(azimuth);
}

// Rectangle 100 (north) x 60 (east) at survey coordinates, a trapezoid, the rectangle with an arc out on its
// east side and one in on its north side, and a parcel whose south side is a half disc.
std::vector<svy_list<AreaSegment>> boundaries() {
  const double n = 5000000.0, e = 500000.0;
  const TCoords a = ne(n, e), b = ne(n, e + 60), c = ne(n + 100, e + 60), d = ne(n + 100, e);
  svy_list<AreaSegment> arcs{AreaSegment(a, b), AreaSegment(b, c, 80.0, true), AreaSegment(c, d, 40.0, false),
                             AreaSegment(d, a)};
  svy_list<AreaSegment> halfDisc{AreaSegment(kPi, b, a, false), AreaSegment(a, d), AreaSegment(d, c),
                                 AreaSegment(c, b)};
  return {polygon({a, b, c, d}), polygon({a, ne(n, e + 90), ne(n + 50, e + 60), ne(n + 50, e + 20)}), arcs, halfDisc};
}

}  // namespace

TEST(TSearch, ProbesEverFinerAndBisects) {
  TSearch s(1.0, 0.0, false);
  EXPECT_DOUBLE_EQ(s.dGetCurrent(), 0.5);
  const struct {
    double value;
    int level;
  } probes[] = {{0.25, 1}, {0.75, 1}, {0.125, 2}, {0.875, 2}, {0.375, 2}, {0.625, 2}, {0.0625, 3}, {0.9375, 3}};
  for (const auto& p : probes) {
    s.vCurrentIsInvalid();
    EXPECT_DOUBLE_EQ(s.dGetCurrent(), p.value);
    EXPECT_EQ(s.nGetInvalidCount(), p.level);
  }
  s.vCurrentIsToHigh();  // 0.9375 too high: the bracket is [0, 0.9375]
  EXPECT_EQ(s.nGetInvalidCount(), 0);
  EXPECT_DOUBLE_EQ(s.dGetCurrent(), 0.46875);
  s.vCurrentIsToLow();
  EXPECT_DOUBLE_EQ(s.dGetCurrent(), 0.703125);
  EXPECT_TRUE(s.boHasConvergedOrFailed(0.5));
  EXPECT_FALSE(s.boHasConvergedOrFailed(0.4));

  const TSearch acrossNorth(0.1, -0.1, true);  // low 2pi - 0.1 exceeds high 0.1: high is raised by 2pi
  EXPECT_NEAR(acrossNorth.high, 2 * kPi + 0.1, 1e-12);
  EXPECT_NEAR(acrossNorth.dGetCurrent(), 2 * kPi, 1e-12);
  EXPECT_TRUE(TSearch(3.0, 3.0, false).boHasFailed());
  EXPECT_FALSE(acrossNorth.boHasFailed());
}

TEST(ParallelCut, PiecesHaveTheRequestedAreaOnTheRequestedSide) {
  for (const svy_list<AreaSegment>& shape : boundaries()) {
    const double total = totalArea(shape);
    for (const double azimuthDeg : {0.0, 90.0, 33.0, 301.0}) {
      const double azimuth = azimuthDeg * kPi / 180.0;
      for (const double share : {0.1, 0.5, 0.93}) {
        for (const bool left : {true, false}) {
          SCOPED_TRACE(testing::Message() << shape.size() << " segments, az " << azimuthDeg << ", share " << share
                                          << (left ? ", left" : ", right"));
          svy_list<AreaSegment> boundary = shape;
          svy_list<AreaSegment> piece, rest;
          TCoords cutStart, cutEnd;
          ASSERT_EQ(eSubdivideSegmentList(azimuth, share * total, left, boundary, &piece, &rest, &cutStart, &cutEnd),
                    eAreaCalcSubdivided);
          EXPECT_NEAR(polylineArea(piece), share * total, 1.5e-3);
          EXPECT_NEAR(polylineArea(rest), (1 - share) * total, 1.5e-3);
          EXPECT_TRUE(onBoundary(cutStart, shape) && onBoundary(cutEnd, shape));
          EXPECT_NEAR(std::fabs(across(cutEnd, cutStart, azimuth)), 0.0, 1e-6);
          for (const AreaSegment& s : piece) EXPECT_LE(across(s.start, cutStart, azimuth) * (left ? 1 : -1), 1e-6);
        }
      }
    }
  }
}

TEST(ParallelCut, FailureCodes) {
  svy_list<AreaSegment> square = polygon({ne(0, 0), ne(0, 10), ne(10, 10), ne(10, 0)});
  svy_list<AreaSegment> piece, rest;
  TCoords s, e;
  EXPECT_EQ(eSubdivideSegmentList(0.0, 100.001 + 1e-3, true, square, &piece, &rest, &s, &e), eAreaCalcAreaTooLarge);
  EXPECT_EQ(eSubdivideSegmentList(0.0, 100.0, true, square, &piece, &rest, &s, &e), eAreaCalcSubdivided);
  svy_list<AreaSegment> twoLines = polygon({ne(0, 0), ne(0, 10)});
  EXPECT_EQ(eSubdivideSegmentList(0.0, 1.0, true, twoLines, &piece, &rest, &s, &e), eAreaCalcTotalAreaFailed);
  EXPECT_EQ(eSubdivideSegmentList(ne(50, 50), ne(0, 0), 1.0, square, &piece, &rest, &e), eAreaCalcGeometryFailed);
  EXPECT_EQ(eSubdivideSegmentList(ne(0, 0), ne(0, 0), 101.0, square, &piece, &rest, &e), eAreaCalcAreaTooLarge);
  for (const double bad : {-1.0, std::nan("")}) {
    EXPECT_EQ(eSubdivideSegmentList(0.0, bad, true, square, &piece, &rest, &s, &e), eAreaCalcSearchFailed);
    EXPECT_EQ(eSubdivideSegmentList(ne(0, 0), ne(0, 0), bad, square, &piece, &rest, &e), eAreaCalcSearchFailed);
  }
  EXPECT_EQ(eSubdivideSegmentList(NAN, 10.0, true, square, &piece, &rest, &s, &e), eAreaCalcSearchFailed);
}

TEST(HingeCut, PieceGrowsFromTheHingeToTheRequestedArea) {
  TCoords none;
  none.mask = 0;
  for (const svy_list<AreaSegment>& shape : boundaries()) {
    const double total = totalArea(shape);
    const TCoords& corner = std::next(shape.begin())->start;
    const TCoords& sideStart = shape.front().start;
    double sweep = 0.0;
    const TCoords midSide = boGetArcSweep(shape.front(), sweep) && shape.front().boIsArc()
                                ? getPointOnArc(shape.front(), 0.5 * sweep)
                                : ne(0.5 * (sideStart.north + corner.north), 0.5 * (sideStart.east + corner.east));
    for (const TCoords& hinge : {corner, midSide}) {
      for (const double share : {0.2, 0.6, 0.97, 1.0}) {
        for (const TCoords& towards : {none, sideStart}) {
          SCOPED_TRACE(testing::Message() << shape.size() << " segments, share " << share);
          svy_list<AreaSegment> boundary = shape;
          svy_list<AreaSegment> piece, rest;
          TCoords cutEnd;
          ASSERT_EQ(eSubdivideSegmentList(hinge, towards, share * total, boundary, &piece, &rest, &cutEnd),
                    eAreaCalcSubdivided);
          EXPECT_NEAR(polylineArea(piece), share * total, 1.5e-3);
          if (share < 1.0) {
            EXPECT_NEAR(polylineArea(rest), (1 - share) * total, 1.5e-3);
          }
          EXPECT_TRUE(onBoundary(cutEnd, shape));
          EXPECT_NEAR(std::hypot(piece.front().start.north - hinge.north, piece.front().start.east - hinge.east),
                      0.0, 1e-9);
          // Grown toward `towards`: the piece's first segment runs toward it (the segment entering the hinge,
          // reversed, when the hinge is a corner).
          if (towards.mask != 0 && hinge.north == corner.north && hinge.east == corner.east) {
            EXPECT_TRUE(onBoundary(piece.front().end, {shape.front()}));
          }
        }
      }
    }
  }
}

TEST(AlignmentArea, BoundaryRoundTripAreaPerimeterAndTasks) {
  const svy_list<AreaSegment> shape = boundaries()[2];
  CHorzAndVertAlnt alignment;
  ASSERT_TRUE(boSetAlignmentFromAreaSegmentList(shape, alignment));
  svy_list<AreaSegment> back;
  ASSERT_TRUE(boGetAreaSegmentListFromAlignment(alignment, back));
  ASSERT_EQ(back.size(), shape.size());
  double area = 0.0, perimeter = 0.0, expectedPerimeter = 0.0;
  ASSERT_TRUE(computePolygonArea(alignment, &area));
  ASSERT_TRUE(computePolygonPerimeter(alignment, perimeter));
  boComputePolygonPerimeter(shape, expectedPerimeter);
  EXPECT_NEAR(area, polylineArea(shape), 1e-3);
  EXPECT_NEAR(perimeter, expectedPerimeter, 1e-6);

  // Without its last side the alignment is closed by a line: the same area.
  CHorzAndVertAlnt open;
  svy_list<AreaSegment> allButLast(shape.begin(), std::prev(shape.end()));
  ASSERT_TRUE(boSetAlignmentFromAreaSegmentList(allButLast, open));
  double openArea = 0.0;
  ASSERT_TRUE(computePolygonArea(open, &openArea));
  EXPECT_NEAR(openArea, area, 1e-6);

  // The parallel task: the piece borders the given line (here the west side, north to south, or back), so
  // both orders of its points give the same strip along the west side.
  const C2dPos west1 = shape.back().start.pos(), west2 = shape.back().end.pos();
  std::vector<double> cutEasts;
  for (const bool swapped : {false, true}) {
    CHorzAndVertAlnt piece;
    C2dPos cut1, cut2;
    ASSERT_TRUE(solveKnownAreaParallelLineTask(1000.0, alignment, swapped ? west2 : west1, swapped ? west1 : west2,
                                               piece, cut1, cut2));
    double pieceArea = 0.0;
    ASSERT_TRUE(computePolygonArea(piece, &pieceArea));
    EXPECT_NEAR(pieceArea, 1000.0, 1.5e-3);
    EXPECT_NEAR(cut1.east(), cut2.east(), 1e-6);
    cutEasts.push_back(cut1.east());
  }
  EXPECT_NEAR(cutEasts[0], cutEasts[1], 1e-3);
  EXPECT_GT(cutEasts[0] - west1.east(), 10.0);  // the arc in on the north side makes the strip less deep
  EXPECT_LT(cutEasts[0] - west1.east(), 12.0);
  // The hinge task in both directions from the south-east corner.
  C2dPos cutAlong, cutAgainst;
  for (const bool against : {false, true}) {
    CHorzAndVertAlnt piece;
    ASSERT_TRUE(solveKnownAreaHingePointTask(std::next(shape.begin())->start.pos(), 1500.0, alignment, against, piece,
                                             against ? cutAgainst : cutAlong));
    double pieceArea = 0.0;
    ASSERT_TRUE(computePolygonArea(piece, &pieceArea));
    EXPECT_NEAR(pieceArea, 1500.0, 1.5e-3);
  }
  EXPECT_GT(std::hypot(cutAlong.north() - cutAgainst.north(), cutAlong.east() - cutAgainst.east()), 1.0);

  CHorzAndVertAlnt withSpiral = alignment;
  CCurveDataSpiral spiralData(eMathSpiralEuler);
  spiralData.setLenAndR(20.0, 200.0, true, true);
  ASSERT_TRUE(withSpiral.appendElement(CAlntHeSpiral(CCurveSpiral(0.0, 0.0, CMathAngle(0.0), spiralData))));
  svy_list<AreaSegment> none;
  EXPECT_FALSE(boGetAreaSegmentListFromAlignment(withSpiral, none));
  EXPECT_FALSE(computePolygonPerimeter(withSpiral, perimeter));
  CHorzAndVertAlnt bowTie;
  boSetAlignmentFromAreaSegmentList(polygon({ne(0, 0), ne(0, 10), ne(10, 0), ne(10, 10)}), bowTie);
  EXPECT_FALSE(computePolygonArea(bowTie, &area));
}

TEST(AreaConcurrency, ThreadsSubdivideOneBoundaryAlike) {
  // Every query works on the caller's copies: threads sharing one boundary get the single-thread answer.
  const svy_list<AreaSegment> shape = boundaries()[2];
  const auto cut = [&shape](double area) {
    svy_list<AreaSegment> boundary = shape, piece, rest;
    TCoords start, end;
    return eSubdivideSegmentList(0.4, area, true, boundary, &piece, &rest, &start, &end) == eAreaCalcSubdivided
               ? start.east
               : NAN;
  };
  const double expected = cut(2500.0);
  std::vector<double> results(4, 0.0);
  std::vector<std::thread> threads;
  for (double& r : results) threads.emplace_back([&r, &cut] { r = cut(2500.0); });
  for (std::thread& t : threads) t.join();
  for (double r : results) EXPECT_EQ(r, expected);
}
