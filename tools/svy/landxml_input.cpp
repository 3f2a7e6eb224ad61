#include "landxml_input.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <iostream>

#include "svyio/landxml_document.h"
#include "svymath/formats/station_text.h"

namespace svy_tool {

namespace {
// Metres per displayed station unit: "1+234.57" is 1234.57 m.
constexpr double kStationUnit = 1000.0;
}  // namespace

std::shared_ptr<LandXmlOptions> addLandXmlOptions(CLI::App& verb) {
  auto options = std::make_shared<LandXmlOptions>();
  verb.add_option("--landxml", options->path, "LandXML file of the road")->required();
  verb.add_option("--alignment", options->alignment, "Alignment name (default: the first)");
  verb.add_option("--profile", options->profile, "Design profile name (default: the alignment's first)");
  return options;
}

std::unique_ptr<LandXmlRoad> loadLandXmlRoad(const LandXmlOptions& options) {
  svy_io::TLandXmlDocument document;
  std::string error;
  if (!svy_io::readLandXmlFile(options.path, document, error)) throw CLI::ValidationError(error);
  for (const svy_io::TLandXmlNote& note : document.notes) {
    std::cerr << "svy: note: " << options.path << ": line " << note.line << ": " << note.path << ": " << note.message
              << '\n';
  }
  const svy_io::TLandXmlAlignment* found = document.findAlignment(options.alignment);
  if (found == nullptr) {
    throw CLI::ValidationError(options.path + ": no alignment" +
                               (options.alignment.empty() ? std::string() : " named '" + options.alignment + "'"));
  }
  auto road = std::make_unique<LandXmlRoad>();
  road->name = found->name;
  static_cast<CAlntH&>(road->pair) = found->horizontal;
  road->equations = found->equations;
  for (const svy_io::TLandXmlProfile& profile : found->profiles) {
    if (options.profile.empty() || profile.name == options.profile) {
      road->pair.getAlntVes() = profile.profile;
      road->hasProfile = true;
      break;
    }
  }
  if (!road->hasProfile && !options.profile.empty()) {
    throw CLI::ValidationError(options.path + ": alignment '" + found->name + "' has no profile named '" +
                               options.profile + "'");
  }
  return road;
}

std::string stationText(const StationEquations& equations, double chainage) {
  double station = chainage;
  int region = 0;
  if (!std::isfinite(chainage) || !equations.chainageToStation(chainage, station, &region)) return "";
  std::string text = StnToString(station, kStationUnit).ToNarrow();
  double other = 0.0;
  if (equations.stationToChainage(station, other) == eStationAmbiguous) {
    text += " (" + std::to_string(region + 1) + ")";
  }
  return text;
}

}  // namespace svy_tool
