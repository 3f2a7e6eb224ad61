// LandXML plan geometry. Directions in the file are azimuths (clockwise from north) in its direction unit;
// rot="cw" turns right; radiusStart / radiusEnd of a spiral are "INF" (or missing, or 0) at a tangent end.
// An element's start direction is its dir / dirStart when written, else taken from its points (towards the
// PI, square to the centre, towards the end).
#include "svyio/landxml_horizontal.h"

#include <cmath>
#include <cstring>
#include <limits>
#include <memory>

#include "svyio/landxml_constants.h"
#include "svymath/alignments/horz_element_arc.h"
#include "svymath/alignments/horz_element_segment.h"
#include "svymath/alignments/horz_element_spiral.h"
#include "svymath/curves/curve_data_spiral.h"
#include "svymath/foundation/constants.h"

namespace svy_io {
namespace detail {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

double azimuthTo(const C2dPos& from, const C2dPos& to) {
  return std::atan2(to.east() - from.east(), to.north() - from.north());
}

// A spiral radius: infinity at a tangent end ("INF", missing or zero).
double spiralRadius(const CLandXmlContext& context, const pugi::xml_node& node, const char* attribute) {
  const pugi::xml_attribute a = node.attribute(attribute);
  if (!a || strcasecmp(a.value(), "INF") == 0 || strcasecmp(a.value(), "infinity") == 0) return kInfinity;
  const double radius = std::fabs(context.length(node, attribute));
  return radius == 0.0 ? kInfinity : radius;
}

bool turnsRight(const CLandXmlContext& context, const pugi::xml_node& node) {
  const std::string rot = node.attribute("rot").value();
  if (rot != "cw" && rot != "ccw") context.fail(node, "attribute rot must be cw or ccw, got \"" + rot + "\"");
  return rot == "cw";
}

// The element's start direction (radians), NaN when neither written nor derivable.
double startDirection(const CLandXmlContext& context, const pugi::xml_node& node, const C2dPos* start) {
  double direction = context.optionalDirection(node, std::strcmp(node.name(), "Line") == 0 ? "dir" : "dirStart");
  if (std::isfinite(direction) || start == nullptr) return direction;
  C2dPos other;
  if (context.point(node, "PI", other) || (std::strcmp(node.name(), "Line") == 0 && context.point(node, "End", other))) {
    return azimuthTo(*start, other);
  }
  if (context.point(node, "Center", other)) {
    return azimuthTo(other, *start) + (turnsRight(context, node) ? 0.5 : -0.5) * svy_math::units::kPi;
  }
  return direction;
}

double lineLength(CLandXmlContext& context, const pugi::xml_node& node, const C2dPos* start) {
  const double stated = context.optionalLength(node, "length");
  C2dPos end;
  if (std::isfinite(stated)) return stated;
  if (start == nullptr || !context.point(node, "End", end)) context.fail(node, "missing attribute length");
  return std::hypot(end.north() - start->north(), end.east() - start->east());
}

double curveLength(CLandXmlContext& context, const pugi::xml_node& node, double radius, bool right) {
  const double stated = context.optionalLength(node, "length");
  if (std::isfinite(stated)) return stated;
  C2dPos start, centre, end;
  if (!context.point(node, "Start", start) || !context.point(node, "Center", centre) ||
      !context.point(node, "End", end)) {
    context.fail(node, "missing attribute length (and no Start, Center and End to derive it)");
  }
  double turn = azimuthTo(centre, end) - azimuthTo(centre, start);
  if (!right) turn = -turn;
  while (turn <= 0.0) turn += 2.0 * svy_math::units::kPi;
  return turn * radius;
}

std::unique_ptr<CAlntHe> makeArc(double length, double radius, bool right, double direction) {
  CCurveDataArc data;
  data.SetElement(length, radius, right);
  auto arc = std::make_unique<CAlntHeArc>();
  arc->set_data(CCurveArc(0.0, 0.0, CMathAngle(direction * svy_math::units::kRadToDeg), data));
  return arc;
}

std::unique_ptr<CAlntHe> makeElement(CLandXmlContext& context, const pugi::xml_node& node, const C2dPos* start, double direction) {
  const std::string kind = node.name();
  if (kind == "Line") {
    const double length = lineLength(context, node, start);
    auto line = std::make_unique<CAlntHeSegment>();
    line->setStartAndFinal(C2dPos(0.0, 0.0), C2dPos(length * std::cos(direction), length * std::sin(direction)));
    return line;
  }
  const bool right = turnsRight(context, node);
  if (kind == "Curve") {
    const double radius = std::fabs(context.length(node, "radius"));
    return makeArc(curveLength(context, node, radius, right), radius, right, direction);
  }
  const double length = context.length(node, "length");
  const std::string law = node.attribute("spiType").value();
  if (!law.empty() && law != "clothoid" && law != "cubicParabola" && law != "cubic") {
    context.fail(node, "spiral type \"" + law + "\" is not supported (only clothoid and cubicParabola)");
  }
  const double r1 = spiralRadius(context, node, "radiusStart");
  const double r2 = spiralRadius(context, node, "radiusEnd");
  if (std::isinf(r1) && std::isinf(r2)) context.fail(node, "spiral with both radii infinite");
  // An arc written as a spiral (equal radii, constant="0" in some exports).
  if (r1 == r2) return makeArc(length, r1, right, direction);
  CCurveDataSpiral data(law == "clothoid" || law.empty() ? eMathSpiralEuler : eMathSpiralCubic);
  if (!data.setLenAndTwoR(length, r1, r2, right, r2 < r1)) context.fail(node, "no spiral has these radii and length");
  return std::make_unique<CAlntHeSpiral>(
      CCurveSpiral(0.0, 0.0, CMathAngle(direction * svy_math::units::kRadToDeg), data));
}

bool isGeometry(const char* name) {
  return std::strcmp(name, "Line") == 0 || std::strcmp(name, "Curve") == 0 || std::strcmp(name, "Spiral") == 0;
}

// Chained start against the written one: position and staStart.
void checkJoint(CLandXmlContext& context, const pugi::xml_node& node, const CAlntHe& element) {
  C2dPos written, chained;
  if (context.point(node, "Start", written) && element.getStartPosNe(chained.north(), chained.east())) {
    const double misfit = std::hypot(written.north() - chained.north(), written.east() - chained.east());
    if (misfit > tol::kJointMisfit) {
      context.note(node, "written start lies " + std::to_string(misfit * 1000.0) + " mm from the chained start");
    }
  }
  double chainage = 0.0;
  const double station = context.optionalLength(node, "staStart");
  if (std::isfinite(station) && element.getStartChainageInM(chainage) &&
      std::fabs(station - chainage) > tol::kJointMisfit) {
    context.note(node, "written staStart " + std::to_string(station) + " differs from the chained " +
                           std::to_string(chainage));
  }
}

}  // namespace

void readHorizontal(CLandXmlContext& context, const pugi::xml_node& alignmentNode, TLandXmlAlignment& alignment) {
  CAlntH& horizontal = alignment.horizontal;
  horizontal.setStartChainageInM(context.length(alignmentNode, "staStart"));
  const pugi::xml_node geometry = alignmentNode.child("CoordGeom");
  if (!geometry) context.fail(alignmentNode, "missing CoordGeom");
  for (const pugi::xml_node& node : geometry.children()) {
    if (node.type() != pugi::node_element) continue;
    if (!isGeometry(node.name())) {
      context.fail(node, std::string("element ") + node.name() + " cannot be represented in an alignment");
    }
    C2dPos start;
    const bool hasStart = context.point(node, "Start", start);
    const bool first = horizontal.getNumOfHes() == 0;
    if (first) {
      if (!hasStart) context.fail(node, "the first element has no Start");
      horizontal.setStartPos(start.north(), start.east(), 0.0);
    }
    double direction = startDirection(context, node, hasStart ? &start : nullptr);
    CMathAngle chainedAz;
    const bool chained = !first && horizontal.getLastHe()->getFinalAzimut(chainedAz);
    if (!std::isfinite(direction)) {
      if (!chained) context.fail(node, "no direction (dir/dirStart, PI, Center or End)");
      direction = chainedAz.getRad();
    }
    const std::unique_ptr<CAlntHe> element = makeElement(context, node, hasStart ? &start : nullptr, direction);
    const double kink = chained ? std::remainder(direction - chainedAz.getRad(), 2.0 * svy_math::units::kPi) : 0.0;
    if (std::fabs(kink) > tol::kKinkAngle) {
      if (auto* line = CAlntHeSegment::cast(element.get())) line->setStartAzFixed();
      if (auto* arc = CAlntHeArc::cast(element.get())) arc->setStartAzFixed();
      if (auto* spiral = CAlntHeSpiral::cast(element.get())) spiral->setStartAzFixed();
      context.note(node, "kink of " + std::to_string(kink * svy_math::units::kRadToDeg) + " degrees kept");
    }
    if (!horizontal.appendElement(*element)) context.fail(node, "the element is not valid (zero or negative length or radius)");
    checkJoint(context, node, *horizontal.getLastHe());
  }
  if (horizontal.getNumOfHes() == 0) context.fail(geometry, "no Line, Curve or Spiral");
  for (const pugi::xml_node& node : alignmentNode.children("StaEquation")) {
    const double back = context.length(node, "staBack");
    const double ahead = context.length(node, "staAhead");
    if (!alignment.equations.addEquation(back, ahead)) {
      context.fail(node, "station equation out of order (each must lie beyond the previous one)");
    }
  }
}

}  // namespace detail
}  // namespace svy_io
