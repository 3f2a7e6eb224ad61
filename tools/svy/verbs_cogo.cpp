// svy cogo: inverse and radiation between plane points, intersections, perpendiculars and tangents to
// circles; rows in (northing, easting) order, azimuths in decimal degrees clockwise from north.
#include "row_io.h"
#include "verbs.h"

#include "svymath/cogo/circle_tangents.h"
#include "svymath/cogo/cogo_intersections.h"
#include "svymath/cogo/cogo_inverse.h"
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

// The one-line message of a failed construction.
std::string failureText(CogoFunctions::ECogoMathErrorCode status, const char* noSolution) {
  switch (status) {
    case CogoFunctions::eCogoParallel: return "the bearings are parallel";
    case CogoFunctions::eCogoConcentric: return "the centres coincide";
    case CogoFunctions::eCogoCoincidentPoints: return "the points coincide";
    case CogoFunctions::eCogoNoSolution: return noSolution;
    default: return "a distance or radius is not positive, or a value is out of range";
  }
}

// An azimuth in decimal degrees, reduced modulo 360 first so that a large one keeps its digits.
CMathAngle azimuthFromDegrees(double degrees) {
  CMathAngle azimuth;
  azimuth.setRad(Deg2Rad(degrees, false));
  return azimuth;
}

void addIntersect(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "intersect",
      "Intersections: --mode bb rows n1,e1,az1_deg,n2,e2,az2_deg; bd rows n1,e1,az1_deg,n2,e2,dist2; dd rows "
      "n1,e1,dist1,n2,e2,dist2");
  auto mode = std::make_shared<std::string>();
  verb->add_option("--mode", *mode, "bb (bearing-bearing), bd (bearing-distance) or dd (distance-distance)")
      ->required()
      ->check(CLI::IsMember({"bb", "bd", "dd"}));
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input, mode] {
    const char* second = *mode == "bb" ? "az2_deg" : "dist2";
    const char* first = *mode == "dd" ? "dist1" : "az1_deg";
    const svy_tool::RowFormat format{{"n1", "e1", first, "n2", "e2", second},
                                     true,
                                     {{"solution", 0}, {"n", kLengthDecimals}, {"e", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runMultiRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [mode](const svy_tool::InputRow& row, std::vector<std::vector<svy_tool::Cell>>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          const C2dPos p1(v[0], v[1]), p2(v[3], v[4]);
          C2dPos s1, s2;
          int count = 1;
          CogoFunctions::ECogoMathErrorCode status;
          const char* noSolution = "no intersection";
          if (*mode == "bb") {
            status = CogoFunctions::eIntersectBearings(p1, azimuthFromDegrees(v[2]), p2, azimuthFromDegrees(v[5]), s1);
          } else if (*mode == "bd") {
            noSolution = "the bearing passes farther than the distance from point 2";
            status = CogoFunctions::eIntersectBearingDistance(p1, azimuthFromDegrees(v[2]), p2, v[5], s1, s2, count);
          } else {
            noSolution = "the circles do not meet";
            status = CogoFunctions::eIntersectDistances(p1, v[2], p2, v[5], s1, s2, count);
          }
          if (status != CogoFunctions::eCogoOk) {
            error = failureText(status, noSolution);
            return false;
          }
          out.push_back({1.0, s1.north(), s1.east()});
          if (count == 2) out.push_back({2.0, s2.north(), s2.east()});
          return true;
        }));
  });
}

void addPerpendicular(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "perpendicular", "Foot of the perpendicular from n,e to the line 1->2: rows n1,e1,n2,e2,n,e");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{{"n1", "e1", "n2", "e2", "n", "e"},
                                     true,
                                     {{"along", kLengthDecimals}, {"offset", kLengthDecimals},
                                      {"foot_n", kLengthDecimals}, {"foot_e", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          CogoFunctions::TElementInverse inverse;
          const CogoFunctions::ECogoMathErrorCode status =
              CogoFunctions::eInverseToSegment(C2dPos(v[0], v[1]), C2dPos(v[2], v[3]), C2dPos(v[4], v[5]), inverse);
          if (status != CogoFunctions::eCogoOk) {
            error = failureText(status, "");
            return false;
          }
          out = {inverse.along, inverse.offset, inverse.foot.north(), inverse.foot.east()};
          return true;
        }));
  });
}

void addTangents(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "tangents",
      "Common tangents of two circles (r1 = 0: from a point): rows n1,e1,r1,n2,e2,r2 -> touching points");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{{"n1", "e1", "r1", "n2", "e2", "r2"},
                                     true,
                                     {{"tangent", 0}, {"n_a", kLengthDecimals}, {"e_a", kLengthDecimals},
                                      {"n_b", kLengthDecimals}, {"e_b", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runMultiRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<std::vector<svy_tool::Cell>>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          svy_math::TTangentToCircles tangents;
          const CogoFunctions::ECogoMathErrorCode status =
              tangents.solve(C2dPos(v[0], v[1]), v[2], C2dPos(v[3], v[4]), v[5]);
          if (status != CogoFunctions::eCogoOk) {
            error = failureText(status, "no common tangent: one circle lies inside the other");
            return false;
          }
          for (int i = 0; i < tangents.count(); ++i) {
            const svy_math::TTangentToCircles::TTangent& t = tangents.tangent(i);
            out.push_back({i + 1.0, t.onFirst.north(), t.onFirst.east(), t.onSecond.north(), t.onSecond.east()});
          }
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
  addIntersect(*family);
  addPerpendicular(*family);
  addTangents(*family);
}
