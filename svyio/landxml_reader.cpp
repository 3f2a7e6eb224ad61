#include <algorithm>
#include <cmath>
#include <cstring>
#include <fstream>
#include <limits>
#include <sstream>

#include "svyio/landxml_context.h"
#include "svyio/landxml_horizontal.h"
#include "svyio/landxml_profile.h"
#include "svymath/foundation/constants.h"

namespace svy_io {

const TLandXmlAlignment* TLandXmlDocument::findAlignment(const std::string& name) const {
  for (const TLandXmlAlignment& alignment : alignments) {
    if (name.empty() || alignment.name == name) return &alignment;
  }
  return nullptr;
}

namespace detail {
namespace {

// Metres per unit of the <Metric> or <Imperial> linearUnit.
double linearFactor(const CLandXmlContext& context, const pugi::xml_node& units) {
  const std::string unit = units.attribute("linearUnit").value();
  if (unit == "meter" || unit.empty()) return 1.0;
  if (unit == "millimeter") return 0.001;
  if (unit == "centimeter") return 0.01;
  if (unit == "kilometer") return 1000.0;
  if (unit == "USSurveyFoot") return svy_math::units::kUsFootToMetre;
  if (unit == "foot" || unit == "internationalFoot") return svy_math::units::kIntFootToMetre;
  context.fail(units, "unknown linear unit \"" + unit + "\"");
}

// Radians per unit of the directionUnit (else the angularUnit).
double angularFactor(const CLandXmlContext& context, const pugi::xml_node& units) {
  std::string unit = units.attribute("directionUnit").value();
  if (unit.empty()) unit = units.attribute("angularUnit").value();
  if (unit == "radians") return 1.0;
  if (unit == "grads") return svy_math::units::kPi / 200.0;
  if (unit == "decimal degrees" || unit.empty()) return svy_math::units::kDegToRad;
  context.fail(units, "unsupported direction unit \"" + unit + "\"");
}

void readUnits(CLandXmlContext& context, const pugi::xml_node& root) {
  const pugi::xml_node units = root.child("Units");
  const pugi::xml_node system = units.child("Metric") ? units.child("Metric") : units.child("Imperial");
  if (!system) return;
  context.document().metresPerUnit = linearFactor(context, system);
  context.document().radiansPerUnit = angularFactor(context, system);
}

void readAlignment(CLandXmlContext& context, const pugi::xml_node& node) {
  TLandXmlAlignment alignment;
  alignment.name = node.attribute("name").value();
  alignment.statedLength = context.optionalLength(node, "length");
  readHorizontal(context, node, alignment);
  readProfiles(context, node, alignment);
  for (const pugi::xml_node& child : node.children()) {
    const char* name = child.name();
    if (child.type() == pugi::node_element && std::strcmp(name, "CoordGeom") != 0 &&
        std::strcmp(name, "StaEquation") != 0 && std::strcmp(name, "Profile") != 0) {
      context.note(child, std::string("element ") + name + " is not read");
    }
  }
  context.document().alignments.push_back(std::move(alignment));
}

void readDocument(CLandXmlContext& context, const pugi::xml_node& root) {
  readUnits(context, root);
  for (const pugi::xml_node& child : root.children()) {
    if (child.type() != pugi::node_element) continue;
    const std::string name = child.name();
    if (name == "Alignments") {
      for (const pugi::xml_node& node : child.children("Alignment")) readAlignment(context, node);
    } else if (name != "Units" && name != "Project" && name != "Application") {
      context.note(child, "element " + name + " is not read");
    }
  }
}

}  // namespace
}  // namespace detail

bool readLandXmlText(const std::string& text, TLandXmlDocument& document, std::string& error) {
  document = TLandXmlDocument();
  pugi::xml_document xml;
  const pugi::xml_parse_result parsed = xml.load_buffer(text.data(), text.size());
  detail::CLandXmlContext context(text, document);
  if (!parsed) {
    const std::size_t offset = parsed.offset < 0 ? 0 : static_cast<std::size_t>(parsed.offset);
    const int line = 1 + static_cast<int>(std::count(text.begin(), text.begin() + std::min(offset, text.size()), '\n'));
    error = "line " + std::to_string(line) + ": not well-formed XML: " + parsed.description();
    return false;
  }
  const pugi::xml_node root = xml.child("LandXML");
  if (!root) {
    error = "not a LandXML file (no LandXML root element)";
    return false;
  }
  try {
    detail::readDocument(context, root);
  } catch (const detail::CLandXmlError& failure) {
    error = failure.what();
    document.alignments.clear();
    return false;
  }
  return true;
}

bool readLandXmlFile(const std::string& path, TLandXmlDocument& document, std::string& error) {
  std::ifstream in(path, std::ios::binary);
  if (!in) {
    error = "cannot open " + path;
    return false;
  }
  std::ostringstream text;
  text << in.rdbuf();
  if (!readLandXmlText(text.str(), document, error)) {
    error = path + ": " + error;
    return false;
  }
  return true;
}

}  // namespace svy_io
