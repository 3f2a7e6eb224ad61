// Vertical elements: grade lines and parabolas against their closed forms, circular vertical curves against
// the circle, extrema against sampling, intersection-point records against the tangents, chord steps
// against the sagitta, the range snaps, and the optional published vertical curve tables.
#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "support/csv.h"
#include "support/refdata.h"
#include "svymath/alignments/vertical_arc.h"
#include "svymath/alignments/vertical_element.h"
#include "svymath/alignments/vertical_ls_element.h"
#include "svymath/alignments/vertical_ls_with_arc.h"
#include "svymath/alignments/vertical_visitor.h"
#include "svyutils/svy_err_log.h"

namespace {

CVerticalElement parabola(double chainage, double height, double length, double g1, double g2) {
  return CVerticalElement(chainage, height, length, g1, g2);
}

CAlntVeArc arc(double chainage, double height, double g1, double g2, double radius) {
  CAlntVeArc element;
  element.setGradesAndR(g1, g2, radius);
  element.setStartHtAndChain(height, chainage);
  return element;
}

// Samples an element every centimetre: the highest and lowest heights and where they are.
struct Sampled {
  double maxCh, maxH, minCh, minH;
};
Sampled sample(const CAlntVe& element) {
  Sampled s{0, -HUGE_VAL, 0, HUGE_VAL};
  double start = 0.0;
  EXPECT_TRUE(element.getStartChainageInM(start));
  for (double d = 0.0; d <= element.getLen(); d += 0.01) {
    double h = 0.0;
    EXPECT_EQ(element.getHtAtLen(d, h), eVeHtOk);
    if (h > s.maxH) s = {start + d, h, s.minCh, s.minH};
    if (h < s.minH) s = {s.maxCh, s.maxH, start + d, h};
  }
  return s;
}

// Parabola: height z0 + g1 s/100 + (g2 - g1) s^2 / (200 L), grade its derivative, at every metre.
TEST(VerticalParabola, HeightsAndGradesMatchClosedForm) {
  const struct {
    double length, g1, g2;
  } cases[] = {{200.0, 2.5, -1.5}, {120.0, -3.0, 4.0}, {80.0, 1.0, 1.0}, {300.0, 50.0, -100.0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.g1);
    const CVerticalElement e = parabola(1234.5, 310.0, c.length, c.g1, c.g2);
    EXPECT_EQ(e.getType(), c.g1 == c.g2 ? eAlntVeStraight : eAlntVeParabola);
    for (double s = 0.0; s <= c.length; s += 1.0) {
      const double z = 310.0 + c.g1 * s / 100.0 + (c.g2 - c.g1) * s * s / (200.0 * c.length);
      double h = 0.0, g = 0.0;
      ASSERT_TRUE(e.getHtAtChain(1234.5 + s, h) && e.getGradeAtChainage(1234.5 + s, g));
      EXPECT_NEAR(h, z, 1e-9);
      EXPECT_NEAR(g, c.g1 + (c.g2 - c.g1) * s / c.length, 1e-9);
    }
    EXPECT_NEAR(e.getParabolaCoefficientA() * 2.0 * c.length * 100.0, c.g2 - c.g1, 1e-12);
    EXPECT_NEAR(e.getFinalHt(), 310.0 + (c.g1 + c.g2) / 200.0 * c.length, 1e-9);  // mean grade
  }
}

TEST(VerticalParabola, DefinitionsByRiseAndOrdinateOrRadius) {
  CVerticalElement e;
  e.setParabolaByCR(100.0, 1.0, 5000.0);
  EXPECT_NEAR(e.getStartGrade(), 2.0, 1e-12);
  EXPECT_NEAR(e.getEndGrade(), 0.0, 1e-12);
  EXPECT_NEAR(e.getParabolaCoefficientKv(), -5000.0, 1e-6);  // crest: negative vertex radius
  e.setParabolaByCF(200.0, 3.0, 0.5);
  e.setStartHtAndChain(0.0, 0.0);
  // The curve passes F below the intersection of its tangents, which lies C above the start at L/2.
  double mid = 0.0;
  ASSERT_TRUE(e.getHtAtChain(100.0, mid));
  EXPECT_NEAR(mid, 3.0 - 0.5, 1e-12);
  EXPECT_NEAR(e.getParabolaCoefficientDs() * 100.0, e.getStartGrade() - e.getEndGrade(), 1e-12);
}

// The vertex of crest and sag parabolas and circles against the sampled maximum or minimum; grades of one
// sign have none on the element.
TEST(VerticalCurves, ExtremaMatchSampling) {
  const struct {
    double g1, g2;
    bool crest;
  } cases[] = {{3.0, -2.0, true}, {-4.0, 1.5, false}, {12.0, -30.0, true}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.g1);
    const CVerticalElement p = parabola(500.0, 100.0, 150.0, c.g1, c.g2);
    const CAlntVeArc a = arc(500.0, 100.0, c.g1, c.g2, 3000.0);
    double ch = 0.0, h = 0.0;
    bool isMax = false;
    for (const CAlntVe* e : {static_cast<const CAlntVe*>(&p), static_cast<const CAlntVe*>(&a)}) {
      const bool found = e == &p ? p.getParabolaExtremum(ch, h, isMax) : a.getExtremum(ch, h, isMax);
      ASSERT_TRUE(found);
      const Sampled s = sample(*e);
      EXPECT_EQ(isMax, c.crest);
      EXPECT_NEAR(ch, c.crest ? s.maxCh : s.minCh, 0.011);
      EXPECT_NEAR(h, c.crest ? s.maxH : s.minH, 1e-6);
    }
  }
  double ch = 0.0, h = 0.0;
  bool isMax = false;
  EXPECT_FALSE(parabola(0.0, 0.0, 100.0, 1.0, 3.0).getParabolaExtremum(ch, h, isMax));
  EXPECT_FALSE(arc(0.0, 0.0, -1.0, -3.0, 1000.0).getExtremum(ch, h, isMax));
}

TEST(VerticalArc, RadiusSignLengthAndCircle) {
  CAlntVeArc a = arc(1000.0, 50.0, 3.0, -2.0, 5000.0);
  EXPECT_EQ(a.getRadius(), -5000.0);
  EXPECT_TRUE(a.isConvexUpwards() && !a.isConvexDownwards());
  EXPECT_NEAR(a.getLen(), 5000.0 * (std::atan(0.03) + std::atan(0.02)), 1e-9);
  a.setGradesAndR(-2.0, 3.0, -5000.0);
  EXPECT_EQ(a.getRadius(), 5000.0);
  a.setGradesAndR(1.5, 1.5, 800.0);
  EXPECT_TRUE(a.isSimplePoint() && a.getLen() == 0.0);
  // Every point lies R from the centre and the grade is the slope of the circle's tangent there.
  for (const double r : {-2500.0, 4000.0}) {
    const CAlntVeArc c = arc(1000.0, 50.0, r < 0 ? 4.0 : -4.0, r < 0 ? -6.0 : 6.0, r);
    double cch = 0.0, ch = 0.0;
    ASSERT_TRUE(c.getCenterStaAndHt(cch, ch));
    for (double s = 0.0; s <= c.getLen(); s += 7.0) {
      double h = 0.0, g = 0.0;
      ASSERT_TRUE(c.getHtAtLen(s, h) == eVeHtOk && c.getGradeAtLength(s, g));
      EXPECT_NEAR(std::hypot(1000.0 + s - cch, h - ch), std::fabs(r), 1e-8);
      EXPECT_NEAR(g / 100.0, -(1000.0 + s - cch) / (h - ch), 1e-10);
    }
    // The centre defines the same circle; the length defines the same radius.
    CAlntVeArc same;
    same.setCenterGradesAndR(C2dPos(cch, ch), c.getStartGrade(), c.getEndGrade(), r);
    EXPECT_TRUE(same.isEqual(&c));
    same.setGradesAndLen(c.getStartGrade(), c.getEndGrade(), c.getLen());
    EXPECT_NEAR(same.getRadius(), r, 1e-6);
  }
}

// For gentle grades a circular curve and the parabola of the same length differ by far less than a
// millimetre; for steep ones by much more: the two kinds are told apart.
TEST(VerticalArc, GentleCircleIsNearItsParabola) {
  for (const auto& g : {std::make_pair(2.0, -1.0), std::make_pair(40.0, -60.0)}) {
    const CAlntVeArc a = arc(0.0, 0.0, g.first, g.second, 4000.0);
    const CVerticalElement p = parabola(0.0, 0.0, a.getLen(), g.first, g.second);
    double worst = 0.0;
    for (double s = 0.0; s <= a.getLen(); s += 1.0) {
      double ha = 0.0, hp = 0.0;
      a.getHtAtLen(s, ha);
      p.getHtAtLen(s, hp);
      worst = std::fmax(worst, std::fabs(ha - hp));
    }
    if (g.first < 10.0) EXPECT_LT(worst, 1e-3);
    else EXPECT_GT(worst, 0.1);
  }
}

// The intersection point of each kind lies on both tangents: the start tangent and the end tangent
// through the final point.
TEST(VerticalCurves, IntersectionRecordsLieOnBothTangents) {
  const CVerticalElement p = parabola(200.0, 40.0, 160.0, 2.0, -3.0);
  const CAlntVeArc a = arc(200.0, 40.0, 2.0, -3.0, 3200.0);
  for (const CAlntVe* e : {static_cast<const CAlntVe*>(&p), static_cast<const CAlntVe*>(&a)}) {
    CLsInfo info;
    double end = 0.0;
    ASSERT_TRUE(e->getAsLs(info) && e->getFinalChainageInM(end));
    EXPECT_NEAR(info.ipHeight, 40.0 + 0.02 * (info.ipChainage - 200.0), 1e-9);
    EXPECT_NEAR(info.ipHeight, e->getFinalHt() - e->getEndGrade() / 100.0 * (end - info.ipChainage), 2e-3);
    EXPECT_EQ(info.curveStartChainage, 200.0);
    EXPECT_EQ(info.radius, e == &a ? -3200.0 : 0.0);
  }
  CLsInfo straight;
  ASSERT_TRUE(CVerticalElement(10.0, 5.0, 90.0, 4.0).getAsLs(straight));
  EXPECT_TRUE(straight.ipChainage == 100.0 && std::fabs(straight.ipHeight - 8.6) < 1e-12 &&
              straight.curveLength == 0.0 && straight.curveStartChainage == 100.0);
}

// 1 mm snap at both ends of the height query; the grade snaps only at the end. A zero-length grade is a
// height step.
TEST(VerticalElement, RangeSnapsAndHeightStep) {
  const CVerticalElement p = parabola(100.0, 20.0, 50.0, 1.0, -1.0);
  double h = 0.0, g = 0.0;
  EXPECT_EQ(p.getHtAtLen(-0.0009, h), eVeHtOk);
  EXPECT_EQ(h, 20.0);
  EXPECT_EQ(p.getHtAtLen(-0.002, h), eVeHtBeforeStart);
  EXPECT_EQ(p.getHtAtLen(50.0009, h), eVeHtOk);
  EXPECT_EQ(p.getHtAtLen(50.002, h), eVeHtAfterEnd);
  EXPECT_FALSE(p.getGradeAtLength(-0.0009, g));
  EXPECT_TRUE(p.getGradeAtLength(50.0009, g) && std::fabs(g + 1.0) < 1e-12);
  CVerticalElement step;
  step.setVerticalGap(-0.35);
  step.setStartHtAndChain(12.0, 300.0);
  EXPECT_TRUE(step.isVerticalGAP() && step.getHtAtChain(300.0, h) && h == 12.0 - 0.35);
  // The circular curve logs a rejected length.
  svy_logging::CScopedErrLogCapture capture;
  EXPECT_EQ(arc(0.0, 0.0, 1.0, -1.0, 1000.0).getHtAtLen(-5.0, h), eVeHtBeforeStart);
  EXPECT_TRUE(capture.count() == 1u && capture.entries()[0].file == "mathAlntElements");
}

// Chord steps: the chord of each step stays within the deviation of the curve (checked at its middle,
// where the sagitta of a parabola or circle is largest), and steps never pass the end.
TEST(VerticalCurves, ChordStepsKeepTheDeviation) {
  const CVerticalElement p = parabola(0.0, 0.0, 240.0, 4.0, -3.0);
  const CAlntVeArc a = arc(0.0, 0.0, -3.0, 5.0, 1500.0);
  for (const CAlntVe* e : {static_cast<const CAlntVe*>(&p), static_cast<const CAlntVe*>(&a)}) {
    int steps = 0;
    for (double s = 0.0; s < e->getLen() && steps < 1000; ++steps) {
      const double step = e->getStepForDeviation(s, 0.005);
      ASSERT_GT(step, 0.0);
      double h0 = 0.0, h1 = 0.0, hm = 0.0;
      e->getHtAtLen(s, h0);
      e->getHtAtLen(s + step, h1);
      e->getHtAtLen(s + 0.5 * step, hm);
      EXPECT_LE(std::fabs(0.5 * (h0 + h1) - hm), 0.005 + 1e-9);
      s += step;
    }
    EXPECT_GT(steps, 3);
  }
  EXPECT_EQ(CVerticalElement(0.0, 0.0, 80.0, 2.0).getStepForDeviation(30.0, 0.005), 50.0);
}

struct KindVisitor : CAlntVeVisitor_const {
  std::string seen;
  void Visit(const CVerticalElement&) override { seen += "element "; }
  void Visit(const CVerticalLSElement&) override { seen += "ls "; }
  void Visit(const CAlntVeArc&) override { seen += "arc "; }
  void Visit(const CAlntVeLsWithArc&) override { seen += "lsarc "; }
};

TEST(VerticalElement, VisitorsDispatchAndClonesAreEqual) {
  CAlntVeLsWithArc withArc;
  withArc.setIpAndR(100.0, 5.0, 2000.0);
  const CVerticalLSElement ls(CLsInfo(0, 0, 0, 0, 0), CLsInfo(100, 2, 0, 100, 0));
  const CVerticalElement p = parabola(0.0, 0.0, 100.0, 1.0, 2.0);
  const CAlntVeArc a = arc(0.0, 0.0, 1.0, 2.0, 900.0);
  KindVisitor visitor;
  for (const CAlntVe* e : std::vector<const CAlntVe*>{&p, &ls, &a, &withArc}) {
    e->Accept(visitor);
    const std::unique_ptr<CAlntVe> copy(e->clone());
    EXPECT_TRUE(copy->isEqual(e) && !copy->isEqual(&p == e ? static_cast<const CAlntVe*>(&a) : &p));
  }
  EXPECT_EQ(visitor.seen, "element ls arc lsarc ");
}

// ---- published vertical curve tables (optional) ----

// A parabola or a circle of 100 m horizontal extent from height 10 m at chainage 0, grades in percent,
// reproduces the rows (horizontal distance, height) of a table.
void expectReproduces(const std::string& kind, double g1, double g2,
                      const std::vector<std::pair<double, double>>& rows, double tolerance) {
  ASSERT_GT(rows.size(), 100u);
  std::unique_ptr<CAlntVe> e;
  if (kind == "ParabolicArc") {
    e.reset(new CVerticalElement(0.0, 10.0, 100.0, g1, g2));
  } else {
    const double r = 100.0 / (std::sin(std::atan(g2 / 100.0)) - std::sin(std::atan(g1 / 100.0)));
    e.reset(new CAlntVeArc(arc(0.0, 10.0, g1, g2, r)));
  }
  for (const auto& row : rows) {
    double h = 0.0;
    ASSERT_EQ(e->getHtAtLen(row.first, h), eVeHtOk);
    EXPECT_NEAR(h, row.second, tolerance);
  }
}

const char* const kTableGrades[] = {"-0.5_-1.0", "0.0_0.5", "0.5_0.0", "1.0_0.5"};
const char* const kTableKinds[] = {"ParabolicArc", "CircularArc"};

double secondGrade(const std::string& grades) { return std::stod(grades.substr(grades.find('_') + 1)); }

// The alignment guide's tables: grades in PERCENT, CSV rows "dist_along,Y,...", six decimals.
TEST(VerticalReference, GuideTablesInPercent) {
  SVY_SKIP_WITHOUT_REFDATA();
  for (const std::string grades : kTableGrades) {
    for (const std::string kind : kTableKinds) {
      const std::string name = "alignment/ifc-alignment-geometry-implementation-guide/VerticalAlignment/" + kind +
                               "/Vertical_" + kind + "_100.0_10.0_" + grades + "_Meter.csv";
      SCOPED_TRACE(name);
      std::vector<std::pair<double, double>> rows;
      for (const auto& row : svy_test::readCsvTable(svy_test::refdataPath(name)).rows) rows.emplace_back(row[0], row[1]);
      expectReproduces(kind, std::stod(grades), secondGrade(grades), rows, 1.5e-6);
    }
  }
}

// The toolbox tables: grades as RAW RATIOS (0.5 is 50 %), two header lines, rows "i x 0 z"; circles at
// equal arc-length steps. Computed to 16 digits.
TEST(VerticalReference, ToolboxTablesInRatios) {
  SVY_SKIP_WITHOUT_REFDATA();
  for (const std::string grades : kTableGrades) {
    for (const std::string kind : kTableKinds) {
      const std::string name = "alignment/ifc-rail-unit-test-reference-code/ToolboxProcessed/VerticalAlignment/" +
                               kind + "/" + kind + "_100.0_10.0_" + grades + "_1_Meter.txt";
      SCOPED_TRACE(name);
      std::ifstream in(svy_test::refdataPath(name));
      std::string header;
      std::getline(in, header);
      std::getline(in, header);
      std::vector<std::pair<double, double>> rows;
      for (double i, x, zero, z; in >> i >> x >> zero >> z;) rows.emplace_back(x, z);
      expectReproduces(kind, 100.0 * std::stod(grades), 100.0 * secondGrade(grades), rows, 1e-9);
    }
  }
}

}  // namespace
