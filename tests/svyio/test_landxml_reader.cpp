// The LandXML reader on exports of road design software (copied into tests/data with their CC BY 4.0
// licence) and on small files written here for the units, the exports' quirks and malformed input. The
// oracles are the files' own written end points and lengths, read independently with pugixml.
#include <gtest/gtest.h>
#include <pugixml.hpp>

#include <cmath>
#include <sstream>
#include <string>

#include "support/refdata.h"
#include "svyio/landxml_document.h"
#include "svymath/alignments/vertical_element_base.h"

namespace {

using svy_io::TLandXmlDocument;

const std::string kFolder = "alignment/ifc-infra-unit-test/";

C2dPos textPoint(const pugi::xml_node& node, double factor) {
  std::istringstream in(node.child_value());
  double n = 0.0, e = 0.0;
  in >> n >> e;
  return C2dPos(n * factor, e * factor);
}

struct TFileCase {
  const char* file;
  int elements;
  double factor;          // metres per file unit
  double endTolerance;    // metres: the written points are rounded (to the mm in one file), chaining adds up
  int misfitNotes;        // joints whose written start misses the chained one by more than 1 mm
};

class ReferenceFile : public ::testing::TestWithParam<TFileCase> {};

// Every element ends where the file writes its end, the lengths add up to the alignment's stated length.
TEST_P(ReferenceFile, ElementsEndWhereTheFileSays) {
  const TFileCase& c = GetParam();
  const std::string path = svy_test::testdataPath(kFolder + c.file);
  TLandXmlDocument document;
  std::string error;
  ASSERT_TRUE(svy_io::readLandXmlFile(path, document, error)) << error;
  ASSERT_EQ(document.alignments.size(), 1u);
  const CAlntH& alignment = document.alignments[0].horizontal;
  ASSERT_EQ(alignment.getNumOfHes(), c.elements);
  pugi::xml_document xml;
  ASSERT_TRUE(xml.load_file(path.c_str()));
  const pugi::xml_node geometry = xml.child("LandXML").child("Alignments").child("Alignment").child("CoordGeom");
  int i = 0;
  for (const pugi::xml_node& node : geometry.children()) {
    double n = 0.0, e = 0.0, length = 0.0;
    ASSERT_TRUE(alignment.getHe(i)->getFinalPosNe(n, e));
    const C2dPos written = textPoint(node.child("End"), c.factor);
    EXPECT_LE(std::hypot(n - written.north(), e - written.east()), c.endTolerance) << c.file << " element " << i;
    ASSERT_TRUE(alignment.getHe(i)->getHLengthInM(length));
    EXPECT_NEAR(length, node.attribute("length").as_double() * c.factor, 1e-9);
    ++i;
  }
  double total = 0.0;
  ASSERT_TRUE(alignment.getHLengthInM(total));
  EXPECT_NEAR(total, document.alignments[0].statedLength, 0.001 * c.factor);
  int misfits = 0;
  for (const svy_io::TLandXmlNote& note : document.notes) {
    if (note.message.find("chained start") != std::string::npos) ++misfits;
    EXPECT_GT(note.line, 1);
  }
  EXPECT_EQ(misfits, c.misfitNotes);
}

INSTANTIATE_TEST_SUITE_P(Exports, ReferenceFile,
                         ::testing::Values(TFileCase{"UT-Alignment-Aplitop-1.xml", 15, 1.0, 5e-6, 0},
                                           TFileCase{"Alignment-Aplitop-2.XML", 9, 1.0, 0.001, 0},
                                           TFileCase{"PR_Twin_Branch_section_alignment.xml", 3,
                                                     0.3048006096012192, 1e-6, 0}));

// The parabolas about the points of the exported profile: the height at a point lies the middle ordinate
// (g2 - g1) L / 8 from the point's written height; at the ends the profile meets the points exactly.
TEST(LandXmlProfile, ParabolasPassTheMiddleOrdinate) {
  TLandXmlDocument document;
  std::string error;
  const std::string path = svy_test::testdataPath(kFolder + "PR_Twin_Branch_section_alignment.xml");
  ASSERT_TRUE(svy_io::readLandXmlFile(path, document, error)) << error;
  ASSERT_EQ(document.alignments[0].profiles.size(), 1u);
  const CAlntV& profile = document.alignments[0].profiles[0].profile;
  const double ft = 0.3048006096012192;
  const double pvi[][3] = {{2103.7224673486326, 796.56280347515894, 0.0},
                           {2276.8612336743163, 797.16981264013839, 346.27753265136721},
                           {3150.0000000000005, 783.52400000000023, 499.99999999999983},
                           {3990.0000000000009, 808.32700000000057, 399.99999999999864},
                           {4932.5000000000018, 714.47918750000042, 15.000000000000211},
                           {4940.0000000000018, 713.75733171875027, 0.0}};
  for (int i = 0; i < 6; ++i) {
    const double gIn = i > 0 ? (pvi[i][1] - pvi[i - 1][1]) / (pvi[i][0] - pvi[i - 1][0]) : 0.0;
    const double gOut = i < 5 ? (pvi[i + 1][1] - pvi[i][1]) / (pvi[i + 1][0] - pvi[i][0]) : 0.0;
    double height = 0.0;
    ASSERT_TRUE(profile.getHeightAtChain(pvi[i][0] * ft, height)) << i;
    EXPECT_NEAR(height, (pvi[i][1] + (gOut - gIn) * pvi[i][2] / 8.0) * ft, 1e-9) << i;
  }
}

// A small metric file whose numbers scale to any linear unit and whose directions are written in any unit.
std::string roadFile(const char* unitsElement, double perMetre, double perRadian, const std::string& extra = "") {
  auto num = [&](double metres) { return std::to_string(metres * perMetre); };
  const double pi = 3.14159265358979323846;
  std::ostringstream xml;
  xml.precision(17);
  xml << "<?xml version=\"1.0\"?>\n<LandXML>\n<Units>" << unitsElement << "</Units>\n<Alignments>\n"
      << "<Alignment name=\"A\" staStart=\"" << num(1000.0) << "\">\n<CoordGeom>\n"
      << "<Line length=\"" << num(100.0) << "\" dir=\"" << (pi / 4.0) * perRadian << "\"><Start>" << num(5000000.0)
      << " " << num(500000.0) << "</Start></Line>\n"
      << "<Spiral length=\"" << num(60.0) << "\" radiusStart=\"INF\" radiusEnd=\"" << num(400.0)
      << "\" rot=\"cw\" spiType=\"clothoid\"/>\n"
      << "<Curve length=\"" << num(80.0) << "\" radius=\"" << num(400.0) << "\" rot=\"cw\"/>\n"
      << "<Spiral length=\"" << num(50.0) << "\" radiusStart=\"" << num(400.0)
      << "\" rot=\"cw\" spiType=\"cubicParabola\"/>\n"
      << "<Spiral length=\"" << num(30.0) << "\" radiusStart=\"" << num(250.0) << "\" radiusEnd=\"" << num(250.0)
      << "\" constant=\"0\" rot=\"ccw\" spiType=\"clothoid\"/>\n"
      << extra << "</CoordGeom>\n</Alignment>\n</Alignments>\n</LandXML>\n";
  return xml.str();
}

struct TUnitCase {
  const char* units;
  double perMetre;
  double perRadian;
};

class UnitConversion : public ::testing::TestWithParam<TUnitCase> {};

// Every unit gives the metric file's geometry.
TEST_P(UnitConversion, GivesTheMetricGeometry) {
  TLandXmlDocument metric, other;
  std::string error;
  ASSERT_TRUE(svy_io::readLandXmlText(roadFile("<Metric linearUnit=\"meter\" directionUnit=\"radians\"/>", 1.0, 1.0),
                                      metric, error)) << error;
  ASSERT_TRUE(svy_io::readLandXmlText(roadFile(GetParam().units, GetParam().perMetre, GetParam().perRadian), other,
                                      error)) << error;
  const CAlntH& a = metric.alignments[0].horizontal;
  const CAlntH& b = other.alignments[0].horizontal;
  ASSERT_EQ(a.getNumOfHes(), 5);
  ASSERT_EQ(b.getNumOfHes(), 5);
  EXPECT_NEAR(b.getStartChainageInM(), 1000.0, 1e-6);
  for (double chainage = 1000.0; chainage <= 1320.0; chainage += 7.3) {
    double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0;
    ASSERT_TRUE(a.getPosNeAtChain(chainage, n1, e1) && b.getPosNeAtChain(chainage, n2, e2));
    EXPECT_LE(std::hypot(n1 - n2, e1 - e2), 1e-6) << chainage;
  }
}

INSTANTIATE_TEST_SUITE_P(
    Units, UnitConversion,
    ::testing::Values(TUnitCase{"<Imperial linearUnit=\"USSurveyFoot\" directionUnit=\"decimal degrees\"/>",
                                1.0 / 0.3048006096012192, 57.29577951308232},
                      TUnitCase{"<Imperial linearUnit=\"foot\" directionUnit=\"grads\"/>", 1.0 / 0.3048,
                                200.0 / 3.14159265358979323846},
                      TUnitCase{"<Metric linearUnit=\"millimeter\" angularUnit=\"radians\"/>", 1000.0, 1.0}));

// The arc written as a spiral of equal radii is an arc; the spiral without a tangent-end radius is a
// transition from the arc to the tangent; curvature runs on at every joint.
TEST(LandXmlQuirks, SpiralsOfExports) {
  TLandXmlDocument document;
  std::string error;
  ASSERT_TRUE(svy_io::readLandXmlText(roadFile("", 1.0, 57.29577951308232), document, error)) << error;
  const CAlntH& alignment = document.alignments[0].horizontal;
  const double joints[] = {1100.0, 1160.0, 1240.0, 1290.0};
  const double curvatures[] = {0.0, 1.0 / 400.0, 1.0 / 400.0, 0.0};
  for (int i = 0; i < 3; ++i) {
    double before = 0.0, after = 0.0;
    ASSERT_TRUE(alignment.getCurvatureAtChainage(joints[i] - 1e-7, before));
    ASSERT_TRUE(alignment.getCurvatureAtChainage(joints[i] + 1e-7, after));
    EXPECT_NEAR(before, curvatures[i], 1e-9) << i;
    EXPECT_NEAR(after, curvatures[i], 1e-9) << i;
  }
  double k = 0.0;
  ASSERT_TRUE(alignment.getCurvatureAtChainage(1305.0, k));
  EXPECT_NEAR(std::fabs(k), 1.0 / 250.0, 1e-12);
  EXPECT_EQ(alignment.getHe(4)->getType(), eAlntHeArc);
}

struct TBrokenCase {
  std::string text;
  const char* message;
};

class BrokenFile : public ::testing::TestWithParam<TBrokenCase> {};

TEST_P(BrokenFile, GivesItsClearError) {
  TLandXmlDocument document;
  std::string error;
  EXPECT_FALSE(svy_io::readLandXmlText(GetParam().text, document, error));
  EXPECT_NE(error.find(GetParam().message), std::string::npos) << error;
  EXPECT_TRUE(document.alignments.empty());
}

const std::string kGood = roadFile("", 1.0, 57.29577951308232);

std::string replaced(const std::string& from, const std::string& to) {
  std::string text = kGood;
  return text.replace(text.find(from), from.size(), to);
}

INSTANTIATE_TEST_SUITE_P(
    Malformed, BrokenFile,
    ::testing::Values(TBrokenCase{kGood.substr(0, kGood.size() / 2), "not well-formed XML"},
                      TBrokenCase{"<Other/>", "not a LandXML file"},
                      TBrokenCase{replaced("spiType=\"cubicParabola\"", "spiType=\"bloss\""),
                                  "line 10: LandXML/Alignments/Alignment[A]/CoordGeom/Spiral: spiral type \"bloss\""},
                      TBrokenCase{replaced("radius=\"400", "radius=\"NaN\" x=\"400"), "attribute radius is not a number"},
                      TBrokenCase{replaced("rot=\"cw\"", ""), "attribute rot must be cw or ccw"},
                      TBrokenCase{replaced(" staStart=", " x="), "missing attribute staStart"},
                      TBrokenCase{replaced("<Start>5", "<Start>nan 5"), "not a number: \"nan\""},
                      TBrokenCase{kGood + "<", "not well-formed XML"},
                      TBrokenCase{replaced("</CoordGeom>", "<IrregularLine/></CoordGeom>"),
                                  "IrregularLine cannot be represented"}));

// Station equations of a gap and an overlap; misfit written starts and stations noted with their line.
TEST(LandXmlQuirks, EquationsAndMisfitJointsAreKept) {
  const std::string text =
      replaced("</CoordGeom>",
               "<Line length=\"20\" staStart=\"1320.5\"><Start>0 0</Start></Line></CoordGeom>"
               "<StaEquation staBack=\"1050\" staAhead=\"1060\"/><StaEquation staBack=\"1200\" staAhead=\"1150\"/>");
  TLandXmlDocument document;
  std::string error;
  ASSERT_TRUE(svy_io::readLandXmlText(text, document, error)) << error;
  EXPECT_EQ(document.alignments[0].equations.getCount(), 2);
  int joints = 0, stations = 0;
  for (const svy_io::TLandXmlNote& note : document.notes) {
    joints += note.message.find("chained start") != std::string::npos && note.line == 12;
    stations += note.message.find("staStart 1320.5") != std::string::npos && note.line == 12;
  }
  EXPECT_EQ(joints, 1);
  EXPECT_EQ(stations, 1);
}

}  // namespace

namespace {

// Two design profiles of one alignment (the second one picked by name): an unsymmetric parabola, whose
// height at its point lies (g2 - g1) Lin Lout / (2 (Lin + Lout)) from the point, and a circular curve whose
// grades at its tangent points are those of the grade lines; the ground profile is noted, not dropped.
TEST(LandXmlProfile, UnsymmetricAndCircularCurves) {
  const std::string profiles =
      "<Profile><ProfSurf name=\"ground\"><PntList2D>1000 50 1300 60</PntList2D></ProfSurf>"
      "<ProfAlign name=\"first\"><PVI>1000 50</PVI><PVI>1300 56</PVI></ProfAlign>"
      "<ProfAlign name=\"second\"><PVI>1000 50</PVI><UnsymParaCurve lengthIn=\"40\" lengthOut=\"80\">1100 54"
      "</UnsymParaCurve><CircCurve radius=\"600\">1200 52</CircCurve><PVI>1320 55.6</PVI></ProfAlign></Profile>";
  std::string text = replaced("</CoordGeom>", std::string("</CoordGeom>") + profiles);
  TLandXmlDocument document;
  std::string error;
  ASSERT_TRUE(svy_io::readLandXmlText(text, document, error)) << error;
  const auto& found = document.alignments[0].profiles;
  ASSERT_EQ(found.size(), 2u);
  EXPECT_EQ(found[1].name, "second");
  const CAlntV& profile = found[1].profile;
  double height = 0.0, grade = 0.0;
  ASSERT_TRUE(profile.getHeightAtChain(1100.0, height));
  EXPECT_NEAR(height, 54.0 + (-2.0 - 4.0) / 100.0 * 40.0 * 80.0 / (2.0 * 120.0), 1e-9);
  ASSERT_TRUE(profile.getGradeAtChainage(1060.0 - 1e-6, grade));
  EXPECT_NEAR(grade, 4.0, 1e-6);
  ASSERT_TRUE(profile.getGradeAtChainage(1180.0 + 1e-6, grade));
  EXPECT_NEAR(grade, -2.0, 1e-6);
  // The circle's tangent length R tan(dtheta / 2) either side of the point at 1200.
  const double tIn = 600.0 * std::tan(0.5 * (std::atan(0.03) - std::atan(-0.02))) * std::cos(std::atan(-0.02));
  ASSERT_TRUE(profile.getGradeAtChainage(1200.0 - tIn - 1e-3, grade));
  EXPECT_NEAR(grade, -2.0, 1e-4);
  ASSERT_TRUE(profile.getGradeAtChainage(1290.0, grade));
  EXPECT_NEAR(grade, 3.0, 1e-9);
  bool ground = false;
  for (const svy_io::TLandXmlNote& note : document.notes) ground |= note.path.find("ProfSurf[ground]") != std::string::npos;
  EXPECT_TRUE(ground);
}

}  // namespace

namespace {

// Reading what the writer wrote gives the same geometry: positions along the alignments (1e-9 m), heights
// along their profiles (1e-8 m: a circular vertical curve is written by its intersection point, which the
// reader turns back into the circle's tangent points through a tangent and a cosine), the station equations.
void expectSameRoad(const TLandXmlDocument& a, const TLandXmlDocument& b) {
  ASSERT_EQ(a.alignments.size(), b.alignments.size());
  for (std::size_t k = 0; k < a.alignments.size(); ++k) {
    const CAlntH& h1 = a.alignments[k].horizontal;
    const CAlntH& h2 = b.alignments[k].horizontal;
    ASSERT_EQ(h1.getNumOfHes(), h2.getNumOfHes());
    double length = 0.0;
    ASSERT_TRUE(h1.getHLengthInM(length));
    for (double s = 0.0; s <= length; s += length / 997.0) {
      const double chainage = h1.getStartChainageInM() + s;
      double n1 = 0.0, e1 = 0.0, n2 = 0.0, e2 = 0.0;
      ASSERT_TRUE(h1.getPosNeAtChain(chainage, n1, e1) && h2.getPosNeAtChain(chainage, n2, e2));
      EXPECT_LE(std::hypot(n1 - n2, e1 - e2), 1e-9) << chainage;
      for (std::size_t p = 0; p < a.alignments[k].profiles.size(); ++p) {
        double z1 = 0.0, z2 = 0.0;
        if (a.alignments[k].profiles[p].profile.getHeightAtChain(chainage, z1)) {
          ASSERT_TRUE(b.alignments[k].profiles.at(p).profile.getHeightAtChain(chainage, z2)) << chainage;
          EXPECT_NEAR(z1, z2, 1e-8) << chainage;
        }
      }
    }
    EXPECT_EQ(a.alignments[k].equations.getCount(), b.alignments[k].equations.getCount());
  }
}

class RoundTrip : public ::testing::TestWithParam<std::string> {};

TEST_P(RoundTrip, WrittenFileReadsBackToTheSameGeometry) {
  TLandXmlDocument first, second;
  std::string error;
  ASSERT_TRUE(svy_io::readLandXmlFile(GetParam(), first, error)) << error;
  ASSERT_TRUE(svy_io::readLandXmlText(svy_io::writeLandXmlText(first), second, error)) << error;
  expectSameRoad(first, second);
}

INSTANTIATE_TEST_SUITE_P(
    Files, RoundTrip,
    ::testing::Values(std::string(SVY_EXAMPLES_DIR) + "/road/sample_road.xml",
                      svy_test::testdataPath(kFolder + "UT-Alignment-Aplitop-1.xml"),
                      svy_test::testdataPath(kFolder + "Alignment-Aplitop-2.XML"),
                      svy_test::testdataPath(kFolder + "PR_Twin_Branch_section_alignment.xml")));

}  // namespace
