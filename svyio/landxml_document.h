#pragma once
// Road data read from a LandXML 1.2 file, in the library's units (metres, radians) and plan convention
// (northing, easting). Each alignment keeps its horizontal geometry, its station equations and its design
// profiles; every note records something of the file that was not taken over as written (an element the
// library cannot represent, a joint whose written start misses the chained one), with its element path
// and line so that a user can find it.
#include <string>
#include <vector>

#include "svymath/alignments/alignment_h.h"
#include "svymath/alignments/alnt_v.h"
#include "svymath/alignments/station_equations.h"

namespace svy_io {

struct TLandXmlNote {
  int line = 0;      // 1-based line of the element in the file
  std::string path;  // element path, e.g. "LandXML/Alignments/Alignment[Road 1]/CoordGeom/Spiral"
  std::string message;
};

struct TLandXmlProfile {
  std::string name;
  CAlntV profile;
};

struct TLandXmlAlignment {
  std::string name;
  CAlntH horizontal;
  StationEquations equations;
  std::vector<TLandXmlProfile> profiles;  // design profiles (ProfAlign) in file order
  double statedLength = 0.0;              // the Alignment's length attribute (metres; NaN when absent)
};

struct TLandXmlDocument {
  double metresPerUnit = 1.0;   // the file's linear unit
  double radiansPerUnit = 1.0;  // the file's direction unit
  std::vector<TLandXmlAlignment> alignments;
  std::vector<TLandXmlNote> notes;

  // The alignment of that name, or the first one for an empty name; null when there is none.
  const TLandXmlAlignment* findAlignment(const std::string& name) const;
};

// Reads a LandXML file. False with a one-line message (naming the element path and line where the file is
// at fault) for unreadable or malformed XML, a missing or non-numeric required value, or geometry the
// library cannot represent faithfully (a spiral law other than the clothoid and the cubic parabola).
bool readLandXmlFile(const std::string& path, TLandXmlDocument& document, std::string& error);
bool readLandXmlText(const std::string& text, TLandXmlDocument& document, std::string& error);

}  // namespace svy_io

namespace svy_io {

// The alignments and their design profiles as LandXML 1.2 text (metres, decimal degrees), every number
// with the digits that read back to the same double, so that reading the text gives the same geometry.
std::string writeLandXmlText(const TLandXmlDocument& document);
bool writeLandXmlFile(const std::string& path, const TLandXmlDocument& document, std::string& error);

}  // namespace svy_io
