// LandXML design profiles: a chain of vertical intersection points ("station elevation"), each with the
// vertical curve about it: <PVI> none, <ParaCurve length> a symmetric parabola, <UnsymParaCurve lengthIn
// lengthOut> two parabolas meeting on a common tangent below the point, <CircCurve radius> a circle.
// They become grade lines and curves of the library, each chained from its predecessor's end.
#include "svyio/landxml_profile.h"

#include <cmath>
#include <cstring>
#include <vector>

#include "svymath/alignments/vertical_arc.h"
#include "svymath/alignments/vertical_element.h"
#include "svymath/foundation/constants.h"

namespace svy_io {
namespace detail {
namespace {

struct TVip {
  pugi::xml_node node;
  double chainage = 0.0;
  double height = 0.0;
  double lengthIn = 0.0;   // horizontal length of the curve before the point (metres)
  double lengthOut = 0.0;  // and after it
  double radius = 0.0;     // circular curves (metres); 0 for parabolas
};

std::vector<TVip> readPoints(CLandXmlContext& context, const pugi::xml_node& profAlign) {
  std::vector<TVip> points;
  const double factor = context.document().metresPerUnit;
  for (const pugi::xml_node& node : profAlign.children()) {
    if (node.type() != pugi::node_element) continue;
    const std::string kind = node.name();
    TVip vip;
    vip.node = node;
    if (kind == "ParaCurve") {
      vip.lengthIn = vip.lengthOut = 0.5 * context.length(node, "length");
    } else if (kind == "UnsymParaCurve") {
      vip.lengthIn = context.length(node, "lengthIn");
      vip.lengthOut = context.length(node, "lengthOut");
    } else if (kind == "CircCurve") {
      vip.radius = std::fabs(context.length(node, "radius"));
    } else if (kind != "PVI") {
      context.note(node, "element " + kind + " of a profile is not represented");
      continue;
    }
    const std::vector<double> values = context.numbers(node, 2);
    vip.chainage = values[0] * factor;
    vip.height = values[1] * factor;
    if (vip.lengthIn < 0.0 || vip.lengthOut < 0.0) context.fail(node, "negative curve length");
    if (!points.empty() && vip.chainage <= points.back().chainage) {
      context.fail(node, "station does not increase along the profile");
    }
    points.push_back(vip);
  }
  return points;
}

double gradePercent(const TVip& a, const TVip& b) {
  return (b.height - a.height) / (b.chainage - a.chainage) * svy_math::units::kPercent;
}

// The chainage where the profile built so far ends.
double profileEnd(const CAlntV& profile, double start) {
  double end = start;
  return profile.getNumOfVes() > 0 && profile.getFinalChainageInM(end) ? end : start;
}

void append(CLandXmlContext& context, const TVip& vip, CAlntV& profile, const CAlntVe& element) {
  if (!profile.appendElement(element)) context.fail(vip.node, "the vertical curve is not valid");
}

// The grade line up to `chainage` (from where the profile ends), then nothing when it is already there.
void appendGradeLine(CLandXmlContext& context, const TVip& vip, CAlntV& profile, double chainage, double grade,
                     double startChainage, double startHeight) {
  const double from = profileEnd(profile, startChainage);
  const double length = chainage - from;
  if (length < -svy_math::tol::kSnap) context.fail(vip.node, "vertical curves overlap");
  if (length <= svy_math::tol::kSnap) return;
  double height = startHeight;
  if (profile.getNumOfVes() > 0) profile.getFinalHeight(height);
  append(context, vip, profile, CVerticalElement(from, height, length, grade));
}

CAlntV buildProfile(CLandXmlContext& context, const pugi::xml_node& profAlign) {
  const std::vector<TVip> points = readPoints(context, profAlign);
  if (points.size() < 2) context.fail(profAlign, "a profile needs at least two points");
  CAlntV profile;
  const TVip& first = points.front();
  profile.setStartChainageInM(first.chainage);
  profile.setStartHeight(first.height);
  for (std::size_t i = 1; i + 1 < points.size(); ++i) {
    const TVip& vip = points[i];
    const double gIn = gradePercent(points[i - 1], vip);
    const double gOut = gradePercent(vip, points[i + 1]);
    double lengthIn = vip.lengthIn;
    if (vip.radius > 0.0) {
      // Tangent length R tan(dtheta / 2) along the incoming grade, measured horizontally.
      const double thetaIn = std::atan(gIn / svy_math::units::kPercent);
      const double thetaOut = std::atan(gOut / svy_math::units::kPercent);
      lengthIn = vip.radius * std::tan(0.5 * std::fabs(thetaOut - thetaIn)) * std::cos(thetaIn);
    }
    appendGradeLine(context, vip, profile, vip.chainage - lengthIn, gIn, first.chainage, first.height);
    double height = first.height;
    if (profile.getNumOfVes() > 0) profile.getFinalHeight(height);
    const double from = profileEnd(profile, first.chainage);
    if (vip.radius > 0.0) {
      CAlntVeArc arc;
      arc.setGradesAndR(gIn, gOut, vip.radius);
      arc.setStartHtAndChain(height, from);
      append(context, vip, profile, arc);
    } else if (vip.lengthIn + vip.lengthOut > 0.0) {
      // Unsymmetric: the common tangent's grade weights each side's grade by its length; a symmetric
      // parabola is the case of equal lengths (one parabola).
      const double gMid = (gIn * vip.lengthIn + gOut * vip.lengthOut) / (vip.lengthIn + vip.lengthOut);
      if (vip.lengthIn == vip.lengthOut) {
        append(context, vip, profile, CVerticalElement(from, height, 2.0 * vip.lengthIn, gIn, gOut));
      } else {
        if (vip.lengthIn > 0.0) append(context, vip, profile, CVerticalElement(from, height, vip.lengthIn, gIn, gMid));
        profile.getFinalHeight(height);
        append(context, vip, profile,
               CVerticalElement(profileEnd(profile, first.chainage), height, vip.lengthOut, gMid, gOut));
      }
    }
  }
  const TVip& last = points.back();
  appendGradeLine(context, last, profile, last.chainage, gradePercent(points[points.size() - 2], last),
                  first.chainage, first.height);
  return profile;
}

}  // namespace

void readProfiles(CLandXmlContext& context, const pugi::xml_node& alignmentNode, TLandXmlAlignment& alignment) {
  for (const pugi::xml_node& profileNode : alignmentNode.children("Profile")) {
    for (const pugi::xml_node& node : profileNode.children()) {
      if (node.type() != pugi::node_element) continue;
      if (std::strcmp(node.name(), "ProfAlign") == 0) {
        alignment.profiles.push_back(TLandXmlProfile{node.attribute("name").value(), buildProfile(context, node)});
      } else {
        context.note(node, std::string("element ") + node.name() + " (not a design profile) is not used");
      }
    }
  }
}

}  // namespace detail
}  // namespace svy_io
