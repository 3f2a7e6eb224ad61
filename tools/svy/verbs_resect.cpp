// svy resect: free-station resection from rows target,n,e,h,hz_deg,zenith_deg,slope_distance,target_height
// (an empty cell where a quantity was not observed), with the instrument height as an option. One result
// row: the station's north, east, ground-mark height, the orientation (azimuth of the circle's zero) and
// the standard deviations from the a-priori accuracies.
#include "row_io.h"
#include "verbs.h"

#include "svymath/adjustment/three_d_resection.h"
#include "svymath/foundation/constants.h"

#include <CLI/CLI.hpp>

#include <iostream>
#include <memory>
#include <string>
#include <vector>

namespace {

using svy_math::units::kDegToRad;

// Written decimals: coordinates and standard deviations to 0.1 mm, the orientation to 1e-7 degree.
constexpr int kLengthDecimals = 4;
constexpr int kOrientationDecimals = 7;
constexpr std::size_t kRequiredFields = 4;  // target, n, e, h (h may be empty)

const std::vector<std::string> kInputs = {"target",     "n",          "e",           "h",
                                          "hz_deg",     "zenith_deg", "slope_distance", "target_height"};

// Parses the numeric cells of a row; an empty cell is NaN (not observed), except the target height (0).
bool parseSighting(const svy_tool::InputRow& row, svy_math::TResectionObservation& o, std::string& error) {
  double v[7];
  for (std::size_t k = 1; k < kInputs.size(); ++k) {
    const std::string cell = k < row.fields.size() ? row.fields[k] : std::string();
    v[k - 1] = k == 7 ? 0.0 : svy_math::undefinedValue();
    if (!cell.empty() && !svy_tool::parseNumber(cell, v[k - 1])) {
      error = kInputs[k] + ": " + svy_tool::quoteForMessage(cell) + " is not a number";
      return false;
    }
  }
  if (v[0] != v[0] || v[1] != v[1]) {
    error = "the target's n and e are needed";
    return false;
  }
  o.north = v[0], o.east = v[1], o.height = v[2];
  o.direction = v[3] * kDegToRad, o.zenith = v[4] * kDegToRad, o.slopeDistance = v[5], o.targetHeight = v[6];
  return true;
}

std::string failureText(svy_math::EResectionStatus status) {
  switch (status) {
    case svy_math::eResTooFewObservations: return "too few observations (two targets and a direction at least)";
    case svy_math::eResDegenerate: return "the geometry fixes no unique station";
    case svy_math::eResNotFinite: return "a known point or an observation is not usable";
    default: return "the adjustment did not converge";
  }
}

}  // namespace

void registerResectVerbs(CLI::App& app) {
  CLI::App* verb = app.add_subcommand(
      "resect", "Free-station resection: rows target,n,e,h,hz_deg,zenith_deg,slope_distance,target_height");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<double> instrumentHeight = std::make_shared<double>(0.0);
  const std::shared_ptr<double> angleSdSeconds = std::make_shared<double>(3.0);
  const std::shared_ptr<double> distanceSd = std::make_shared<double>(svy_math::units::kDefaultDistanceSd);
  svy_tool::requireNumberText(
      verb->add_option("--instrument-height", *instrumentHeight, "Instrument height above the ground mark (metres)"))
      ->required();
  svy_tool::requireNumberText(verb->add_option(
      "--angle-sd", *angleSdSeconds, "Standard deviation of directions and zenith angles (arc seconds)"))
      ->default_val(3.0);
  svy_tool::requireNumberText(
      verb->add_option("--distance-sd", *distanceSd, "Standard deviation of distances (metres, plus 2 ppm)"))
      ->default_val(svy_math::units::kDefaultDistanceSd);
  verb->callback([verb, input, instrumentHeight, angleSdSeconds, distanceSd] {
    std::string error;
    const std::unique_ptr<std::istream> in = svy_tool::openInput(*input, error);
    if (!in) {
      std::cerr << "svy: " << error << '\n';
      svy_tool::finishVerb(svy_tool::kExitUsage);
    }
    svy_math::TResectionAccuracy accuracy;
    accuracy.direction = accuracy.zenith = *angleSdSeconds / svy_math::units::kArcSecondsPerDegree * kDegToRad;
    accuracy.distanceConstant = *distanceSd;
    const svy_tool::RowFormat format{kInputs, false, {}, kRequiredFields};
    svy_tool::RowReader reader(*in, format.inputs, format.numericInput);
    svy_tool::InputRow row;
    std::vector<svy_math::TResectionObservation> sightings;
    int status = svy_tool::kExitOk;
    while (reader.next(row)) {
      svy_math::TResectionObservation o;
      if (!svy_tool::checkRow(format, row, error) || !parseSighting(row, o, error)) {
        svy_tool::reportBadRow(row.lineNumber, error);
        status = svy_tool::kExitBadRows;
        continue;
      }
      sightings.push_back(o);
    }
    svy_math::TResectionResult result;
    const svy_math::EResectionStatus solved = svy_math::ThreeDResection(
        sightings.data(), static_cast<int>(sightings.size()), *instrumentHeight, accuracy, result);
    svy_tool::RowWriter writer(std::cout,
                               {{"n", kLengthDecimals}, {"e", kLengthDecimals}, {"h", kLengthDecimals},
                                {"orientation_deg", kOrientationDecimals}, {"sd_n", kLengthDecimals},
                                {"sd_e", kLengthDecimals}, {"sd_h", kLengthDecimals}},
                               svy_tool::outputOptionsFor(*verb));
    if (solved == svy_math::eResOk) {
      writer.write({result.north, result.east, result.height, result.orientation * svy_math::units::kRadToDeg,
                    result.sdNorth, result.sdEast, result.sdHeight});
    } else {
      std::cerr << "svy: " << failureText(solved) << '\n';
      status = svy_tool::kExitBadRows;
    }
    writer.finish();
    svy_tool::finishVerb(status);
  });
}
