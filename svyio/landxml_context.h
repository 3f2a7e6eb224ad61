#pragma once
// What the LandXML readers of the parts of a file share: the element path and line of a node for messages,
// required and optional numbers in the file's units, "northing easting" point texts, and the notes.
#include <pugixml.hpp>

#include <stdexcept>
#include <string>
#include <vector>

#include "svyio/landxml_document.h"
#include "svymath/foundation/positions.h"

namespace svy_io {
namespace detail {

// A fault of the file that stops the reading; caught at the reader's interface and turned into its message.
class CLandXmlError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

class CLandXmlContext {
 public:
  CLandXmlContext(const std::string& text, TLandXmlDocument& document);

  int lineOf(const pugi::xml_node& node) const;
  // "LandXML/Alignments/Alignment[name]/CoordGeom/Curve" (named elements carry their name).
  static std::string pathOf(const pugi::xml_node& node);
  [[noreturn]] void fail(const pugi::xml_node& node, const std::string& message) const;
  void note(const pugi::xml_node& node, const std::string& message);

  // A finite number; fails naming the attribute when it is missing or not a number.
  double number(const pugi::xml_node& node, const char* attribute) const;
  // NaN when the attribute is absent; fails when present but not a finite number.
  double optionalNumber(const pugi::xml_node& node, const char* attribute) const;
  // Lengths (and stations) in metres, directions in radians.
  double length(const pugi::xml_node& node, const char* attribute) const;
  double optionalLength(const pugi::xml_node& node, const char* attribute) const;
  double optionalDirection(const pugi::xml_node& node, const char* attribute) const;
  // The numbers of an element's text ("northing easting [height]", "station elevation"), at least `count`.
  std::vector<double> numbers(const pugi::xml_node& node, std::size_t count) const;
  // The plan position of a child point element (<Start>, <End>, <Center>, <PI>) in metres; false if absent.
  bool point(const pugi::xml_node& parent, const char* child, C2dPos& position) const;

  TLandXmlDocument& document() { return m_document; }

 private:
  std::vector<std::size_t> m_lineStarts;
  TLandXmlDocument& m_document;
};

// Parses a number the way the file writes it (C locale); false for empty, partial or non-finite text.
bool parseFileNumber(const char* text, double& value);

}  // namespace detail
}  // namespace svy_io
