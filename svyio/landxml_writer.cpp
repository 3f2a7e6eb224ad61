// LandXML out: each element with its start station, length, start direction and points (and its radii and
// rotation for arcs and spirals), so that any reader can place it; profiles as vertical intersection points
// with the parabola (every parabola is symmetric about the intersection of its end tangents) or circle about
// each. Numbers are written shortest-exact, so that they read back to the same doubles.
#include <charconv>
#include <cmath>
#include <fstream>
#include <limits>
#include <string>

#include "svyio/landxml_document.h"
#include "svymath/alignments/horz_element_spiral.h"
#include "svymath/alignments/vertical_element_base.h"
#include "svymath/foundation/constants.h"

namespace svy_io {
namespace {

std::string num(double value) {
  if (std::isinf(value)) return "INF";
  char buffer[32];
  const auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
  return std::string(buffer, result.ptr);
}

std::string attr(const char* name, double value) { return std::string(" ") + name + "=\"" + num(value) + "\""; }

std::string point(const char* name, double north, double east) {
  return std::string("<") + name + ">" + num(north) + " " + num(east) + "</" + name + ">";
}

std::string escaped(const std::string& text) {
  std::string out;
  for (const char c : text) {
    if (c == '&') out += "&amp;";
    else if (c == '<') out += "&lt;";
    else if (c == '"') out += "&quot;";
    else out += c;
  }
  return out;
}

void writeElement(const CAlntHe& element, std::string& out) {
  double station = 0.0, length = 0.0, n0 = 0.0, e0 = 0.0, n1 = 0.0, e1 = 0.0, k0 = 0.0, k1 = 0.0;
  CMathAngle azimuth;
  element.getStartChainageInM(station);
  element.getHLengthInM(length);
  element.getStartPosNe(n0, e0);
  element.getFinalPosNe(n1, e1);
  element.getStartAzimut(azimuth);
  element.getCurvatureAtLength(0.0, k0);
  element.getCurvatureAtLength(length, k1);
  const std::string common = attr("staStart", station) + attr("length", length);
  const std::string ends = point("Start", n0, e0) + point("End", n1, e1);
  const double dir = azimuth.getDeg();
  if (element.getType() == eAlntHeSegment) {
    out += "<Line" + common + attr("dir", dir) + ">" + ends + "</Line>\n";
    return;
  }
  const double k = k0 != 0.0 ? k0 : k1;
  const std::string rot = std::string(" rot=\"") + (k > 0.0 ? "cw" : "ccw") + "\"";
  if (element.getType() == eAlntHeArc) {
    // The centre lies a radius square to the start direction, on the side the arc turns to.
    const double radius = 1.0 / std::fabs(k0);
    const double side = (k0 > 0.0 ? 0.5 : -0.5) * svy_math::units::kPi;
    const double toCentre = azimuth.getRad() + side;
    out += "<Curve" + common + attr("radius", radius) + rot + attr("dirStart", dir) + " crvType=\"arc\">" +
           point("Start", n0, e0) + point("Center", n0 + radius * std::cos(toCentre), e0 + radius * std::sin(toCentre)) +
           point("End", n1, e1) + "</Curve>\n";
    return;
  }
  const CAlntHeSpiral* spiral = CAlntHeSpiral::cast(const_cast<CAlntHe*>(&element));
  const bool cubic = spiral != nullptr && spiral->get_data().getCurve().getSpiralMathType() == eMathSpiralCubic;
  const double inf = std::numeric_limits<double>::infinity();
  out += "<Spiral" + common + attr("radiusStart", k0 == 0.0 ? inf : 1.0 / std::fabs(k0)) +
         attr("radiusEnd", k1 == 0.0 ? inf : 1.0 / std::fabs(k1)) + rot + attr("dirStart", dir) + " spiType=\"" +
         (cubic ? "cubicParabola" : "clothoid") + "\">" + ends + "</Spiral>\n";
}

void writeProfile(const TLandXmlProfile& profile, std::string& out) {
  const CAlntV& v = profile.profile;
  out += "<ProfAlign name=\"" + escaped(profile.name) + "\">\n";
  out += "<PVI>" + num(v.getStartChainageInM()) + " " + num(v.getStartPosH()) + "</PVI>\n";
  for (int i = 0; i < v.getNumOfVes(); ++i) {
    const CAlntVe& element = *v.getVe(i);
    CLsInfo ip;
    if (element.getStartGrade() == element.getEndGrade() || !element.getAsLs(ip)) continue;
    const std::string at = ">" + num(ip.ipChainage) + " " + num(ip.ipHeight);
    if (ip.radius != 0.0) {
      out += "<CircCurve" + attr("radius", std::fabs(ip.radius)) + attr("length", element.getLen()) + at +
             "</CircCurve>\n";
    } else {
      out += "<ParaCurve" + attr("length", ip.curveLength) + at + "</ParaCurve>\n";
    }
  }
  double end = 0.0, height = 0.0;
  v.getFinalChainageInM(end);
  v.getFinalHeight(height);
  out += "<PVI>" + num(end) + " " + num(height) + "</PVI>\n</ProfAlign>\n";
}

}  // namespace

std::string writeLandXmlText(const TLandXmlDocument& document) {
  std::string out =
      "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
      "<LandXML xmlns=\"http://www.landxml.org/schema/LandXML-1.2\" version=\"1.2\">\n"
      "<Units><Metric linearUnit=\"meter\" areaUnit=\"squareMeter\" volumeUnit=\"cubicMeter\" "
      "angularUnit=\"decimal degrees\" directionUnit=\"decimal degrees\"/></Units>\n<Alignments>\n";
  for (const TLandXmlAlignment& alignment : document.alignments) {
    const CAlntH& h = alignment.horizontal;
    double length = 0.0;
    h.getHLengthInM(length);
    out += "<Alignment name=\"" + escaped(alignment.name) + "\"" + attr("staStart", h.getStartChainageInM()) +
           attr("length", length) + ">\n<CoordGeom>\n";
    for (int i = 0; i < h.getNumOfHes(); ++i) writeElement(*h.getHe(i), out);
    out += "</CoordGeom>\n";
    for (int i = 0; i < alignment.equations.getCount(); ++i) {
      double back = 0.0, ahead = 0.0, chainage = 0.0;
      alignment.equations.getEquation(i, back, ahead, chainage);
      out += "<StaEquation" + attr("staBack", back) + attr("staAhead", ahead) + attr("staInternal", chainage) + "/>\n";
    }
    if (!alignment.profiles.empty()) {
      out += "<Profile>\n";
      for (const TLandXmlProfile& profile : alignment.profiles) writeProfile(profile, out);
      out += "</Profile>\n";
    }
    out += "</Alignment>\n";
  }
  out += "</Alignments>\n</LandXML>\n";
  return out;
}

bool writeLandXmlFile(const std::string& path, const TLandXmlDocument& document, std::string& error) {
  std::ofstream file(path, std::ios::binary);
  file << writeLandXmlText(document);
  if (!file) {
    error = "cannot write " + path;
    return false;
  }
  return true;
}

}  // namespace svy_io
