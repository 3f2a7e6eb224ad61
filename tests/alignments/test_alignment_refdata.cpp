// Published alignments built element by element (optional: the reference folder beside the project):
// a Swiss railway exit turnout (lines, clothoids, arcs; metres) and the FHWA bridge manual alignment (lines
// and arcs; feet, start station 100+00). Their segment tables come from the IFC files, their sampled
// positions from the CSV files beside them.
//
// IFC conventions: X east, Y north, directions counter-clockwise from +X, positive radius turning left.
// Here: N = Y, E = X, azimuth = pi/2 - direction, radius = -radius.
#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <map>
#include <regex>
#include <sstream>
#include <string>

#include "alignment_test_support.h"
#include "support/csv.h"
#include "support/refdata.h"

using namespace alnt_test;

namespace {

const std::string kFolder = "alignment/ifc-alignment-geometry-implementation-guide/real-world-alignments/";

// The horizontal alignment of an IFC file: its segments in file order, zero-length ones left out, the
// first placed at its start point and direction and the others chained by tangency.
CAlntH readIfcAlignment(const std::string& path, double startChainage) {
  std::ifstream in(path);
  std::stringstream text;
  text << in.rdbuf();
  const std::string content = text.str();
  std::map<std::string, C2dPos> points;
  const std::regex point(R"((#\d+)=IFCCARTESIANPOINT\(\(([-\d.E]+),([-\d.E]+)\)\);)");
  for (std::sregex_iterator it(content.begin(), content.end(), point), end; it != end; ++it) {
    points[(*it)[1]] = C2dPos(std::stod((*it)[3]), std::stod((*it)[2]));
  }
  const std::regex segment(
      R"(IFCALIGNMENTHORIZONTALSEGMENT\(\$,\$,(#\d+),([-\d.E]+),([-\d.E]+),([-\d.E]+),([-\d.E]+),\$,\.(\w+)\.\);)");
  CAlntH alignment;
  alignment.setStartChainageInM(startChainage);
  for (std::sregex_iterator it(content.begin(), content.end(), segment), end; it != end; ++it) {
    const double length = std::stod((*it)[5]);
    if (length == 0.0) continue;
    const double azDeg = 90.0 - std::stod((*it)[2]) * svy_math::units::kRadToDeg;
    const double r1 = -std::stod((*it)[3]);
    const double r2 = -std::stod((*it)[4]);
    const std::string kind = (*it)[6];
    if (alignment.getNumOfHes() == 0) {
      const C2dPos start = points[(*it)[1]];
      alignment.setStartPos(start.north(), start.east(), 0.0);
    }
    if (kind == "LINE") {
      EXPECT_TRUE(alignment.appendElement(tangent(length, azDeg)));
    } else if (kind == "CIRCULARARC") {
      CCurveDataArc data;
      data.SetElement(length, std::fabs(r1), r1 > 0.0);
      CAlntHeArc arc;
      arc.set_data(CCurveArc(0.0, 0.0, CMathAngle(azDeg), data));
      EXPECT_TRUE(alignment.appendElement(arc));
    } else {
      EXPECT_EQ(kind, "CLOTHOID");
      const bool entering = r1 == 0.0;
      const double radius = entering ? r2 : r1;
      CCurveDataSpiral data;
      EXPECT_TRUE(data.setLenAndR(length, std::fabs(radius), radius > 0.0, entering));
      EXPECT_TRUE(alignment.appendElement(CAlntHeSpiral(CCurveSpiral(0.0, 0.0, CMathAngle(azDeg), data))));
    }
  }
  return alignment;
}

// Every sampled row: the position (and, where the table's frame is not rolled by cant, the direction) at its
// chainage, and the row's point back to its chainage.
void expectReproducesTable(const CAlntH& alignment, const std::string& csv, double startChainage, double tolerance,
                           bool withDirection) {
  const svy_test::CsvTable table = svy_test::readCsvTable(svy_test::refdataPath(kFolder + csv));
  ASSERT_GT(table.rows.size(), 100u);
  const std::size_t dist = table.column("DistAlong"), x = table.column("X"), y = table.column("Y"),
                    dx = table.column("RefDir_dx"), dy = table.column("RefDir_dy");
  for (const std::vector<double>& row : table.rows) {
    const double chainage = startChainage + row[dist];
    double n = 0.0, e = 0.0, azDeg = 0.0, c = 0.0, o = 0.0;
    ASSERT_TRUE(alignment.getPosNeAtChain(chainage, n, e)) << chainage;
    EXPECT_NEAR(n, row[y], tolerance) << chainage;
    EXPECT_NEAR(e, row[x], tolerance) << chainage;
    ASSERT_TRUE(alignment.getAzimuthAtChain(chainage, azDeg));
    if (withDirection) {
      const double expectedAz = std::atan2(row[dx], row[dy]);
      EXPECT_NEAR(std::remainder(azDeg * svy_math::units::kDegToRad - expectedAz, 2.0 * M_PI), 0.0, 1e-6) << chainage;
    }
    ASSERT_TRUE(alignment.FindChainageAndOffset(row[y], row[x], c, o));
    EXPECT_NEAR(c, chainage, tolerance) << chainage;
    EXPECT_NEAR(o, 0.0, tolerance) << chainage;
  }
}

}  // namespace

TEST(AlignmentReference, RailwayExitTurnoutWithClothoids) {
  SVY_SKIP_WITHOUT_REFDATA();
  const CAlntH alignment = readIfcAlignment(svy_test::refdataPath(kFolder + "Exit_Turnout_Huni_Valley_Station.ifc"), 0.0);
  ASSERT_EQ(alignment.getNumOfHes(), 19);
  // The CSV has 6 decimals and agrees with the elements chained over 4.2 km to 2e-6 m. Its reference directions are those of a frame
  // rolled by the track's cant (up to 4 mrad off the plan tangent), so only positions are compared.
  expectReproducesTable(alignment, "Exit_Turnout_Huni_Valley_Station.csv", 0.0, 2.5e-6, false);
}

TEST(AlignmentReference, FhwaBridgeAlignmentByStation) {
  SVY_SKIP_WITHOUT_REFDATA();
  // Feet throughout; station 100+00 is chainage 10000.
  const CAlntH alignment = readIfcAlignment(svy_test::refdataPath(kFolder + "FHWA_Alignment.ifc"), 10000.0);
  ASSERT_EQ(alignment.getNumOfHes(), 7);
  expectReproducesTable(alignment, "FHWA_Alignment.csv", 10000.0, 1.5e-6, true);
  expectReproducesTable(alignment, "FHWA_Alignment_with_Linear_Placement.csv", 10000.0, 1.5e-6, true);
}
