// svy geo: geodetic (latitude, longitude in degrees, ellipsoidal height in metres) and earth-centred
// Cartesian coordinates (X, Y, Z in metres) on the library's reference ellipsoid, local east/north/up
// differences with azimuth, elevation and slope distance from an origin, and the geodesic inverse and
// direct problems (azimuths in degrees clockwise from north, written in [0, 360)), grid/ground scaling about
// a base point, and seven-parameter frame transformations.
#include "row_io.h"
#include "verbs.h"

#include "svymath/foundation/constants.h"
#include "svymath/geodesy/geo_coord.h"
#include "svymath/geodesy/geodesic.h"
#include "svymath/geodesy/grid_ground.h"
#include "svymath/geodesy/helmert.h"
#include "svymath/geodesy/local_frame.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <limits>
#include <memory>
#include <string>
#include <vector>

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kRadToDeg;

// Written decimals: 1e-9 degree of latitude is 0.1 mm on the ground; lengths to 0.1 mm; directions to
// 1e-7 degree (0.02 mm at 100 m).
constexpr int kLatLonDecimals = 9;
constexpr int kLengthDecimals = 4;
constexpr int kDirectionDecimals = 7;
constexpr double kMaxLatitudeDeg = 90.0;
constexpr double kHalfTurnDeg = 180.0;
constexpr double kFullTurnDeg = 360.0;

bool isLatitude(double latDeg) { return std::fabs(latDeg) <= kMaxLatitudeDeg; }

// The library's longitude lies in [0, 360); written in (-180, 180] as users read longitudes.
double signedLongitudeDeg(double lonRad) {
  const double deg = lonRad * kRadToDeg;
  return deg > kHalfTurnDeg ? deg - kFullTurnDeg : deg;
}

// Azimuths are written in [0, 360) as surveyors read them.
double azimuthDeg(double azimuthRad) {
  const double deg = azimuthRad * kRadToDeg;
  return deg < 0.0 ? deg + kFullTurnDeg : deg;
}

// Parses "LAT,LON,H" (degrees, degrees, metres).
bool parseOrigin(const std::string& text, GeoCoord& origin) {
  std::vector<double> v;
  if (!svy_tool::parseNumberList(text, 3, v) || !isLatitude(v[0])) return false;
  origin = GeoCoord(v[0] * kDegToRad, v[1] * kDegToRad, v[2]);
  return true;
}

void addToEcef(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("to-ecef", "Geodetic to earth-centred Cartesian: rows lat_deg,lon_deg,h");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{
        {"lat_deg", "lon_deg", "h"}, true, {{"x", kLengthDecimals}, {"y", kLengthDecimals}, {"z", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          if (!isLatitude(v[0])) {
            error = "latitude must lie within -90 to 90 degrees";
            return false;
          }
          Coord c;
          c.blh2xyz(GeoCoord(v[0] * kDegToRad, v[1] * kDegToRad, v[2]));
          out = {c.x(), c.y(), c.z()};
          return true;
        }));
  });
}

void addToGeodetic(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("to-geodetic", "Earth-centred Cartesian to geodetic: rows x,y,z");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{
        {"x", "y", "z"}, true, {{"lat_deg", kLatLonDecimals}, {"lon_deg", kLatLonDecimals}, {"h", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          GeoCoord g;
          g.xyz2blh(Coord(row.numbers[0], row.numbers[1], row.numbers[2]));
          if (!std::isfinite(g.lat()) || !std::isfinite(g.lon()) || !std::isfinite(g.height())) {
            error = "no geodetic position for this point";
            return false;
          }
          out = {g.lat() * kRadToDeg, signedLongitudeDeg(g.lon()), g.height()};
          return true;
        }));
  });
}

void addEnu(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "enu", "East, north, up, azimuth, elevation and distance from an origin to earth-centred points: rows x,y,z");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<std::string> originText = std::make_shared<std::string>();
  verb->add_option("--origin", *originText, "Origin LAT,LON,H (degrees, degrees, metres)")->required();
  verb->callback([verb, input, originText] {
    GeoCoord origin;
    if (!parseOrigin(*originText, origin))
      throw CLI::ValidationError("--origin: expected LAT,LON,H with latitude within -90 to 90, got '" +
                                 *originText + "'");
    Coord originXyz;
    originXyz.blh2xyz(origin);
    const svy_tool::RowFormat format{{"x", "y", "z"},
                                     true,
                                     {{"east", kLengthDecimals},
                                      {"north", kLengthDecimals},
                                      {"up", kLengthDecimals},
                                      {"azimuth_deg", kDirectionDecimals},
                                      {"elevation_deg", kDirectionDecimals},
                                      {"distance", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [origin, originXyz](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string&) {
          const Coord target(row.numbers[0], row.numbers[1], row.numbers[2]);
          const svy_math::TAbstractPoint3<double> enu = blh_to_neu(origin, target - originXyz);
          const svy_math::TAbstractPoint3<double> polar = neu_to_polar(enu);
          // A point at the origin has no direction: the library marks it with the largest double.
          const bool hasDirection = polar[1] != std::numeric_limits<double>::max();
          const double nan = std::numeric_limits<double>::quiet_NaN();
          out = {enu[0],
                 enu[1],
                 enu[2],
                 hasDirection ? polar[1] * kRadToDeg : nan,
                 hasDirection ? polar[0] * kRadToDeg : nan,
                 polar[2]};
          return true;
        }));
  });
}

void addInverse(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "inverse", "Geodesic distance and forward azimuths at both ends: rows lat1_deg,lon1_deg,lat2_deg,lon2_deg");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{{"lat1_deg", "lon1_deg", "lat2_deg", "lon2_deg"},
                                     true,
                                     {{"distance", kLengthDecimals},
                                      {"azimuth1_deg", kDirectionDecimals},
                                      {"azimuth2_deg", kDirectionDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          double distance = 0.0, az1 = 0.0, az2 = 0.0;
          if (!isLatitude(v[0]) || !isLatitude(v[2]) ||
              !svy_math::invers(v[0] * kDegToRad, v[1] * kDegToRad, v[2] * kDegToRad, v[3] * kDegToRad, distance,
                                az1, az2)) {
            error = "latitude must lie within -90 to 90 degrees";
            return false;
          }
          out = {distance, azimuthDeg(az1), azimuthDeg(az2)};
          return true;
        }));
  });
}

void addDirect(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "direct", "End point and forward azimuth of a geodesic: rows lat_deg,lon_deg,azimuth_deg,distance");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    const svy_tool::RowFormat format{{"lat_deg", "lon_deg", "azimuth_deg", "distance"},
                                     true,
                                     {{"lat_deg", kLatLonDecimals},
                                      {"lon_deg", kLatLonDecimals},
                                      {"azimuth2_deg", kDirectionDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          double lat = 0.0, lon = 0.0, az2 = 0.0;
          if (!isLatitude(v[0]) || !svy_math::frgeod(v[0] * kDegToRad, v[1] * kDegToRad, v[2] * kDegToRad, v[3], lat,
                                                     lon, az2)) {
            error = "latitude must lie within -90 to 90 degrees";
            return false;
          }
          out = {lat * kRadToDeg, lon * kRadToDeg, azimuthDeg(az2)};
          return true;
        }));
  });
}

// Ground to grid (or back): rows n,e scaled about a base point by the combined factor, given or formed from
// the site's latitude, mean ellipsoidal height and the projection's scale factor.
void addGridGround(CLI::App& family, const char* name, bool toGrid) {
  CLI::App* verb = family.add_subcommand(
      name, toGrid ? "Ground to grid coordinates about a base point: rows n,e"
                   : "Grid to ground coordinates about a base point: rows n,e");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<std::string> baseText = std::make_shared<std::string>();
  const std::shared_ptr<std::string> siteText = std::make_shared<std::string>();
  const std::shared_ptr<double> factor = std::make_shared<double>(svy_math::undefinedValue());
  verb->add_option("--base", *baseText, "Base point N,E common to both systems")->required();
  CLI::Option* factorOption =
      svy_tool::requireNumberText(verb->add_option("--factor", *factor, "Combined scale factor (grid / ground)"));
  verb->add_option("--site", *siteText, "LAT_DEG,MEAN_HEIGHT,GRID_SCALE: the factor from the site")
      ->excludes(factorOption);
  verb->callback([verb, input, baseText, siteText, factor, toGrid] {
    std::vector<double> base, site;
    if (!svy_tool::parseNumberList(*baseText, 2, base))
      throw CLI::ValidationError("--base: expected N,E, got '" + *baseText + "'");
    double k = *factor;
    if (!siteText->empty()) {
      if (!svy_tool::parseNumberList(*siteText, 3, site) || !isLatitude(site[0]))
        throw CLI::ValidationError("--site: expected LAT_DEG,MEAN_HEIGHT,GRID_SCALE, got '" + *siteText + "'");
      k = svy_math::CombinedScaleFactor(site[0] * kDegToRad, site[1], site[2]);
    }
    if (!(k > 0.0) || !std::isfinite(k)) throw CLI::ValidationError("a positive --factor or a --site is needed");
    const svy_tool::RowFormat format{{"n", "e"}, true, {{"n", kLengthDecimals}, {"e", kLengthDecimals}}};
    const C2dPos origin(base[0], base[1]);
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [origin, k, toGrid](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string&) {
          C2dPos p;
          const C2dPos in(row.numbers[0], row.numbers[1]);
          if (toGrid) svy_math::GroundToGrid(origin, k, in, p);
          else svy_math::GridToGround(origin, k, in, p);
          out = {p.north(), p.east()};
          return true;
        }));
  });
}

// Seven-parameter frame transformation of earth-centred rows x,y,z.
void addHelmert(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("helmert", "Seven-parameter frame transformation: rows x,y,z");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<std::string> paramText = std::make_shared<std::string>();
  const std::shared_ptr<bool> rigorous = std::make_shared<bool>(false);
  const std::shared_ptr<bool> inverse = std::make_shared<bool>(false);
  verb->add_option("--params", *paramText,
                   "TX,TY,TZ,RX,RY,RZ,PPM: metres, arc seconds (position-vector convention), parts per million")
      ->required();
  verb->add_flag("--rigorous", *rigorous, "Rigorous rotation matrix instead of the small-angle form");
  verb->add_flag("--inverse", *inverse, "From the target frame back to the source frame");
  verb->callback([verb, input, paramText, rigorous, inverse] {
    std::vector<double> v;
    if (!svy_tool::parseNumberList(*paramText, 7, v))
      throw CLI::ValidationError("--params: expected TX,TY,TZ,RX,RY,RZ,PPM, got '" + *paramText + "'");
    const double arcSecond = kDegToRad / svy_math::units::kArcSecondsPerDegree;
    svy_math::THelmertParams p;
    p.tx = v[0], p.ty = v[1], p.tz = v[2], p.rx = v[3] * arcSecond, p.ry = v[4] * arcSecond, p.rz = v[5] * arcSecond;
    p.scalePpm = v[6];
    const svy_math::EHelmertRotation form = *rigorous ? svy_math::eHelmertRigorous : svy_math::eHelmertSmallAngle;
    const svy_tool::RowFormat format{
        {"x", "y", "z"}, true, {{"x", kLengthDecimals}, {"y", kLengthDecimals}, {"z", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [p, form, inverse](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          Coord c;
          if (!svy_math::ECRFCorrections(Coord(row.numbers[0], row.numbers[1], row.numbers[2]), p, form, *inverse, c)) {
            error = "no transformation for these parameters";
            return false;
          }
          out = {c.x(), c.y(), c.z()};
          return true;
        }));
  });
}

}  // namespace

void registerGeoVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("geo", "Geodetic, earth-centred and local east/north/up coordinates; geodesics");
  family->require_subcommand(1);
  addToEcef(*family);
  addToGeodetic(*family);
  addEnu(*family);
  addInverse(*family);
  addDirect(*family);
  addGridGround(*family, "ground-to-grid", true);
  addGridGround(*family, "grid-to-ground", false);
  addHelmert(*family);
}
