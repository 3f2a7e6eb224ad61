// svy cogo: inverse and radiation between plane points, rows in (northing, easting) order.
#include "row_io.h"
#include "verbs.h"

#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"
#include "svyutils/svy_string.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <memory>
#include <string>
#include <vector>

namespace {

// Written decimals: 1e-8 degree is about 1 mm at 6 km; coordinates and distances to 0.1 mm.
constexpr int kAzimuthDecimals = 8;
constexpr int kLengthDecimals = 4;
// Seconds of arc shown in the DMS text (0.01" is 0.05 mm at 1 km), and with --full-precision.
constexpr int kDmsSecondDecimals = 2;
constexpr int kDmsSecondDecimalsFull = 6;
// Decimals of the packed DDD.MMSS number before the seconds' own decimals: MM and SS.
constexpr int kPackedMinuteSecondDigits = 4;

// The azimuth as degrees-minutes-seconds text, e.g. 36°52'11.63".
std::string azimuthText(double azimuthDeg, bool fullPrecision) {
  const int secondDecimals = fullPrecision ? kDmsSecondDecimalsFull : kDmsSecondDecimals;
  const double packed = Deg2DDDMMSS(azimuthDeg, kPackedMinuteSecondDigits + secondDecimals, false);
  return DDDMMSS2String(packed, secondDecimals).ToNarrow();
}

void addInverse(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("inverse", "Azimuth and distance between points: rows n1,e1,n2,e2");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::OutputOptions options = svy_tool::outputOptionsFor(*verb);
    const svy_tool::RowFormat format{{"n1", "e1", "n2", "e2"},
                                     true,
                                     {{"azimuth_deg", kAzimuthDecimals}, {"azimuth_dms", 0},
                                      {"distance", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, options,
        [&options](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          double azimuth = 0.0;
          double distance = 0.0;
          if (!Inverse2D(v[1], v[0], v[3], v[2], azimuth, distance)) {
            error = "the distance or azimuth is not finite";
            return false;
          }
          const double azimuthDeg = azimuth * svy_math::units::kRadToDeg;
          out = {azimuthDeg, azimuthText(azimuthDeg, options.fullPrecision), distance};
          return true;
        }));
  });
}

void addRadiate(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "radiate", "Point at an azimuth (degrees clockwise from north) and distance: rows n,e,azimuth_deg,distance");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{
        {"n", "e", "azimuth_deg", "distance"}, true, {{"n", kLengthDecimals}, {"e", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          double east = 0.0;
          double north = 0.0;
          // Reduced modulo 360 degrees first, so that a large azimuth loses no digits in radians.
          Radiate2D(v[1], v[0], Deg2Rad(v[2], false), v[3], east, north);
          if (!std::isfinite(north) || !std::isfinite(east)) {
            error = "the point is not finite";
            return false;
          }
          out = {north, east};
          return true;
        }));
  });
}

}  // namespace

void registerCogoVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("cogo", "Coordinate geometry in the plane");
  family->require_subcommand(1);
  addInverse(*family);
  addRadiate(*family);
}
