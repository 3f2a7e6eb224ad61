// Published alignment geometry as an oracle: the straight and circular elements of the LandXML files in
// the shared reference folder (optional: skipped when the folder is absent). Every line's direction and
// length must come out of Inverse2D and lead back to its end through Radiate2D; every arc's centre must be
// a crossing of the circles about its ends, on the side its turn says, and its start tangent must touch
// its circle at the start.
#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>
#include <string>
#include <vector>

#include "support/geometry.h"
#include "support/refdata.h"
#include "svymath/cogo/circle_solvers.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::units::kPi;

struct Element {
  std::string file, head, body;  // head: the opening tag with its attributes
  double radiansPerUnit;         // of the file's directions
};

std::string textAttribute(const std::string& head, const std::string& name) {
  const std::string key = " " + name + "=\"";
  const std::size_t at = head.find(key);
  if (at == std::string::npos) return std::string();
  return head.substr(at + key.size(), head.find('"', at + key.size()) - at - key.size());
}

// The value of attribute `name` in an opening tag, or NaN when it is absent or not a number.
double attribute(const std::string& head, const std::string& name) {
  std::istringstream text(textAttribute(head, name));
  double value = std::nan("");
  return text >> value ? value : std::nan("");
}

// "<Start>N E [Z]</Start>" inside an element.
bool childPos(const std::string& body, const std::string& child, C2dPos& pos) {
  const std::size_t at = body.find("<" + child + ">");
  std::istringstream numbers(at == std::string::npos ? std::string() : body.substr(at + child.size() + 2));
  return static_cast<bool>(numbers >> pos.north() >> pos.east());
}

std::vector<Element> collect(const std::string& tag) {
  std::vector<Element> out;
  for (const auto& entry :
       std::filesystem::recursive_directory_iterator(svy_test::refdataPath("alignment/ifc-infra-unit-test"))) {
    const std::string ext = entry.path().extension().string();
    if (ext != ".xml" && ext != ".XML") continue;
    std::ifstream in(entry.path(), std::ios::binary);
    const std::string text{std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
    const std::string unit = textAttribute(text, "directionUnit");
    const double perUnit = unit == "grads" ? kPi / 200.0 : unit == "decimal degrees" ? kPi / 180.0
                           : unit == "radians" ? 1.0 : std::nan("");
    std::size_t at = 0;
    while ((at = text.find("<" + tag + " ", at)) != std::string::npos) {
      const std::size_t headEnd = text.find('>', at), close = text.find("</" + tag + ">", headEnd);
      if (headEnd == std::string::npos || close == std::string::npos) break;
      out.push_back(Element{entry.path().filename().string(), text.substr(at, headEnd - at),
                            text.substr(headEnd + 1, close - headEnd - 1), perUnit});
      at = close;
    }
  }
  return out;
}

// Coordinates are published to 1e-6 of the length unit (some to more digits); allow a few units of that.
constexpr double kPublishedPos = 5e-6;

TEST(LandXmlLines, InverseGivesThePublishedDirectionAndLength) {
  SVY_SKIP_WITHOUT_REFDATA();
  const std::vector<Element> lines = collect("Line");
  ASSERT_GE(lines.size(), 5u);
  for (const Element& line : lines) {
    SCOPED_TRACE(line.file + ": " + line.head);
    C2dPos start, end;
    ASSERT_TRUE(childPos(line.body, "Start", start) && childPos(line.body, "End", end));
    double azimuth = 0, distance = 0;
    ASSERT_TRUE(Inverse2D(start.east(), start.north(), end.east(), end.north(), azimuth, distance));
    EXPECT_NEAR(distance, attribute(line.head, "length"), kPublishedPos);
    const double published = attribute(line.head, "dir") * line.radiansPerUnit;
    if (!std::isnan(published)) {
      EXPECT_NEAR(std::remainder(azimuth - published, 2 * kPi), 0.0, kPublishedPos / distance + 1e-9);
      double e = 0, n = 0;
      Radiate2D(start.east(), start.north(), published, attribute(line.head, "length"), e, n);
      EXPECT_NEAR(svy_test::dist(C2dPos(n, e), end), 0.0, kPublishedPos);
    }
  }
}

// Every arc's centre is the crossing of the circles about its ends on the side its turn says; the start
// tangent touches the circle at the start.
TEST(LandXmlArcs, CentreAndStartTangentAgreeWithTheCircle) {
  SVY_SKIP_WITHOUT_REFDATA();
  const std::vector<Element> arcs = collect("Curve");
  ASSERT_GE(arcs.size(), 5u);
  int tangentsChecked = 0;
  for (const Element& arc : arcs) {
    SCOPED_TRACE(arc.file + ": " + arc.head);
    C2dPos start, center, end, s1, s2;
    ASSERT_TRUE(childPos(arc.body, "Start", start) && childPos(arc.body, "Center", center) &&
                childPos(arc.body, "End", end));
    const double radius = std::hypot(start.north() - center.north(), start.east() - center.east());
    const double rEnd = std::hypot(end.north() - center.north(), end.east() - center.east());
    ASSERT_EQ(IntersectionCoordsOfTwoCircles(start, radius, end, rEnd, s1, s2), 2);
    // A clockwise (right-turning) arc has its centre right of the chord start -> end.
    const C2dPos& found = textAttribute(arc.head, "rot") == "cw" ? s1 : s2;
    EXPECT_NEAR(svy_test::dist(found, center), 0.0, 1e-8);
    const double dirStart = attribute(arc.head, "dirStart") * arc.radiansPerUnit;
    if (std::isnan(dirStart)) continue;
    double e = 0, n = 0;
    Radiate2D(start.east(), start.north(), dirStart, 40.0, e, n);
    ASSERT_EQ(IntersectionCoordsOfLineAndCircle(start, C2dPos(n, e), center, radius, s1, s2), 1);
    // The touching point moves along the line by the published rounding of the positions.
    EXPECT_NEAR(svy_test::dist(s1, start), 0.0, 1e-5);
    ++tangentsChecked;
  }
  EXPECT_GT(tangentsChecked, 0);
}

}  // namespace
