#include "svyio/landxml_context.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>
#include <sstream>
#include <system_error>

#include <charconv>

namespace svy_io {
namespace detail {

bool parseFileNumber(const char* text, double& value) {
  while (*text == ' ' || *text == '\t' || *text == '\n' || *text == '\r') ++text;
  const char* end = text + std::strlen(text);
  while (end > text && (end[-1] == ' ' || end[-1] == '\t' || end[-1] == '\n' || end[-1] == '\r')) --end;
  if (text != end && *text == '+') ++text;
  const auto result = std::from_chars(text, end, value);
  return result.ec == std::errc() && result.ptr == end && std::isfinite(value);
}

CLandXmlContext::CLandXmlContext(const std::string& text, TLandXmlDocument& document) : m_document(document) {
  m_lineStarts.push_back(0);
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == '\n') m_lineStarts.push_back(i + 1);
  }
}

int CLandXmlContext::lineOf(const pugi::xml_node& node) const {
  const std::ptrdiff_t offset = node.offset_debug();
  if (offset < 0) return 0;
  const auto it = std::upper_bound(m_lineStarts.begin(), m_lineStarts.end(), static_cast<std::size_t>(offset));
  return static_cast<int>(it - m_lineStarts.begin());
}

std::string CLandXmlContext::pathOf(const pugi::xml_node& node) {
  std::string path;
  for (pugi::xml_node n = node; n && n.type() == pugi::node_element; n = n.parent()) {
    std::string part = n.name();
    if (*n.attribute("name").value() != '\0') part += std::string("[") + n.attribute("name").value() + "]";
    path = path.empty() ? part : part + "/" + path;
  }
  return path;
}

void CLandXmlContext::fail(const pugi::xml_node& node, const std::string& message) const {
  throw CLandXmlError("line " + std::to_string(lineOf(node)) + ": " + pathOf(node) + ": " + message);
}

void CLandXmlContext::note(const pugi::xml_node& node, const std::string& message) {
  m_document.notes.push_back(TLandXmlNote{lineOf(node), pathOf(node), message});
}

double CLandXmlContext::number(const pugi::xml_node& node, const char* attribute) const {
  const pugi::xml_attribute a = node.attribute(attribute);
  if (!a) fail(node, std::string("missing attribute ") + attribute);
  double value = 0.0;
  if (!parseFileNumber(a.value(), value)) {
    fail(node, std::string("attribute ") + attribute + " is not a number: \"" + a.value() + "\"");
  }
  return value;
}

double CLandXmlContext::optionalNumber(const pugi::xml_node& node, const char* attribute) const {
  if (!node.attribute(attribute)) return std::numeric_limits<double>::quiet_NaN();
  return number(node, attribute);
}

double CLandXmlContext::length(const pugi::xml_node& node, const char* attribute) const {
  return number(node, attribute) * m_document.metresPerUnit;
}

double CLandXmlContext::optionalLength(const pugi::xml_node& node, const char* attribute) const {
  return optionalNumber(node, attribute) * m_document.metresPerUnit;
}

double CLandXmlContext::optionalDirection(const pugi::xml_node& node, const char* attribute) const {
  return optionalNumber(node, attribute) * m_document.radiansPerUnit;
}

std::vector<double> CLandXmlContext::numbers(const pugi::xml_node& node, std::size_t count) const {
  std::vector<double> values;
  std::istringstream words(node.child_value());
  std::string word;
  while (words >> word) {
    double value = 0.0;
    if (!parseFileNumber(word.c_str(), value)) fail(node, "not a number: \"" + word + "\"");
    values.push_back(value);
  }
  if (values.size() < count) {
    fail(node, "expected " + std::to_string(count) + " numbers, got " + std::to_string(values.size()));
  }
  return values;
}

bool CLandXmlContext::point(const pugi::xml_node& parent, const char* child, C2dPos& position) const {
  const pugi::xml_node node = parent.child(child);
  if (!node) return false;
  const std::vector<double> values = numbers(node, 2);
  position = C2dPos(values[0] * m_document.metresPerUnit, values[1] * m_document.metresPerUnit);
  return true;
}

}  // namespace detail
}  // namespace svy_io
