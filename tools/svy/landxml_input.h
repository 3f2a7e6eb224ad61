#pragma once
// The road of a LandXML file for the verbs that work on one (--landxml F [--alignment NAME] [--profile NAME]):
// the alignment with its design profile as a pair, and its station equations for the displayed stations.
// The file's notes (what it holds that was not taken over) go to stderr, one line each.
#include <memory>
#include <string>

#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/station_equations.h"

namespace CLI {
class App;
}

namespace svy_tool {

struct LandXmlOptions {
  std::string path;
  std::string alignment;  // empty: the first
  std::string profile;    // empty: the first design profile
};

// Adds --landxml (required), --alignment and --profile to a verb.
std::shared_ptr<LandXmlOptions> addLandXmlOptions(CLI::App& verb);

struct LandXmlRoad {
  std::string name;
  CHorzAndVertAlnt pair;
  StationEquations equations;
  bool hasProfile = false;
};

// Reads the file; a CLI::ValidationError with the reader's message when it cannot.
std::unique_ptr<LandXmlRoad> loadLandXmlRoad(const LandXmlOptions& options);

// The displayed station of a chainage ("1+234.57", 1000 m per station), station equations applied; in an
// overlap, where the same station occurs in several regions, the region follows ("1+150.00 (2)", from 1).
std::string stationText(const StationEquations& equations, double chainage);

}  // namespace svy_tool
