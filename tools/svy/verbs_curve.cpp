// svy curve and svy spiral: the circular-curve quantities from a radius and one more value, the
// spiral-arc-spiral group about an intersection point, and tables of transition spirals in their local frame
// (origin at the tangent point, north along the initial tangent, east to the right).
#include "row_io.h"
#include "verbs.h"

#include "svymath/curves/curve_data_spiral1r.h"
#include "svymath/curves/curve_formulas.h"
#include "svymath/curves/curve_ip.h"
#include "svymath/foundation/constants.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <cstdio>
#include <iostream>
#include <functional>
#include <limits>
#include <memory>
#include <string>
#include <vector>

namespace {

// Lengths to 0.1 mm, angles to 1e-6 degree (0.004 arc seconds).
constexpr int kLengthDecimals = 4;
constexpr int kAngleDecimals = 6;
// A spiral table longer than this many rows is refused: the interval is almost surely a typing error.
constexpr double kMaxTableRows = 1e6;
// A value recomputed from the solved deflection must agree with the given one to this relative amount,
// otherwise no circular curve has the given pair (a chord longer than the diameter, for example).
constexpr double kSolveRelTol = 1e-9;

// One way to give the second quantity of a circular curve: its option, and the conversions between it and
// the deflection (degrees) for a radius.
struct CurveQuantity {
  const char* option;
  const char* description;
  double (*toDelta)(double value, double radius);
  double (*fromDelta)(double delta, double radius);
};

double identityDelta(double delta, double) { return delta; }

// A number in a message: ten significant digits, no padding.
std::string messageNumber(double value) {
  char buffer[32];
  std::snprintf(buffer, sizeof buffer, "%.10g", value);
  return buffer;
}

const CurveQuantity kQuantities[] = {
    {"--delta", "Deflection (central angle), decimal degrees", identityDelta, identityDelta},
    {"--length", "Arc length", GetDeltaFromLength, GetLengthFromDelta},
    {"--chord", "Long chord", GetDeltaFromChordLength, GetChordLenFromDelta},
    {"--tangent", "Tangent length, PI to PC", GetDeltaFromTangent, GetTangentFromDelta},
    {"--external", "External distance, PI to the arc's midpoint", GetDeltaFromExternal, GetExternalFromDelta},
    {"--mid-ordinate", "Middle ordinate, chord's midpoint to the arc's midpoint", GetDeltaFromMidOrd,
     GetMidOrdFromDelta},
};

void addSolve(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "solve", "All quantities of a circular curve from its radius (or degree of curve) and one more value");
  auto radius = std::make_shared<double>(0.0);
  auto degArc = std::make_shared<double>(0.0);
  auto degChord = std::make_shared<double>(0.0);
  CLI::Option* radiusOpt =
      svy_tool::requireNumberText(verb->add_option("--radius", *radius, "Radius"))->check(CLI::PositiveNumber);
  CLI::Option* arcOpt = svy_tool::requireNumberText(
                            verb->add_option("--deg-arc", *degArc, "Degree of curve, arc definition (100-unit arc)"))
                            ->check(CLI::PositiveNumber);
  CLI::Option* chordOpt =
      svy_tool::requireNumberText(
          verb->add_option("--deg-chord", *degChord, "Degree of curve, chord definition (100-unit chord)"))
          ->check(CLI::Range(0.0, 180.0));
  radiusOpt->excludes(arcOpt)->excludes(chordOpt);
  arcOpt->excludes(chordOpt);

  auto values = std::make_shared<std::vector<double>>(std::size(kQuantities), 0.0);
  std::vector<CLI::Option*> quantityOpts;
  for (std::size_t i = 0; i < std::size(kQuantities); ++i) {
    quantityOpts.push_back(svy_tool::requireNumberText(
                               verb->add_option(kQuantities[i].option, (*values)[i], kQuantities[i].description))
                               ->check(CLI::NonNegativeNumber));
  }
  for (std::size_t i = 0; i < quantityOpts.size(); ++i) {
    for (std::size_t j = i + 1; j < quantityOpts.size(); ++j) quantityOpts[i]->excludes(quantityOpts[j]);
  }

  verb->callback([=] {
    double r = *radius;
    if (arcOpt->count() > 0) r = GetRadiusFromDegOfCurve(*degArc);
    if (chordOpt->count() > 0) r = GetRadiusFromDegOfChord(*degChord);
    if (radiusOpt->count() + arcOpt->count() + chordOpt->count() == 0) {
      throw CLI::ValidationError("give the radius: --radius, --deg-arc or --deg-chord");
    }
    if (!(r > 0.0)) throw CLI::ValidationError("the degree of curve gives no radius");
    std::size_t which = quantityOpts.size();
    for (std::size_t i = 0; i < quantityOpts.size(); ++i) {
      if (quantityOpts[i]->count() > 0) which = i;
    }
    if (which == quantityOpts.size()) {
      throw CLI::ValidationError(
          "give one more quantity: --delta, --length, --chord, --tangent, --external or --mid-ordinate");
    }
    const CurveQuantity& q = kQuantities[which];
    const double given = (*values)[which];
    const double delta = q.toDelta(given, r);
    const double back = q.fromDelta(delta, r);
    if (!(delta >= 0.0 && std::fabs(back - given) <= kSolveRelTol * std::fmax(given, r))) {
      throw CLI::ValidationError("no circular curve of radius " + messageNumber(r) + " has " +
                                 std::string(q.option + 2) + " " + messageNumber(given));
    }
    svy_tool::RowWriter writer(std::cout,
                               {{"radius", kLengthDecimals},
                                {"deg_curve_arc", kAngleDecimals},
                                {"deg_curve_chord", kAngleDecimals},
                                {"delta_deg", kAngleDecimals},
                                {"length", kLengthDecimals},
                                {"chord", kLengthDecimals},
                                {"tangent", kLengthDecimals},
                                {"external", kLengthDecimals},
                                {"mid_ordinate", kLengthDecimals}},
                               svy_tool::outputOptionsFor(*verb));
    writer.write({r, GetDegOfCurveFromRadius(r), GetDegOfChordFromRadius(r), delta, GetLengthFromDelta(delta, r),
                  GetChordLenFromDelta(delta, r), GetTangentFromDelta(delta, r), GetExternalFromDelta(delta, r),
                  GetMidOrdFromDelta(delta, r)});
    writer.finish();
  });
}

// Why a group about an intersection point could not be laid out, for the row's message.
std::string ipFailure(const CCurveIp& group, const std::string& type) {
  switch (group.getStatus()) {
    case eCurveIpNoTangent:
      return "the previous or the next point coincides with the IP";
    case eCurveIpCollinear:
      return "the tangents run straight on through the IP: no curve to fit";
    case eCurveIpReversal:
      return "the tangents turn back on themselves at the IP";
    case eCurveIpSpiralUnreachable:
      return "no " + type + " spiral of the given length reaches radius " + messageNumber(std::fabs(group.getRadius()));
    case eCurveIpSpiralsTooLong:
      return "the spirals turn further than the deflection of " +
             messageNumber(std::fabs(group.getDeflection()) * svy_math::units::kRadToDeg) + " degrees";
    default:
      return "no finite curve fits the tangents";
  }
}

void addIp(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "ip", "Spiral-arc-spiral curve about an intersection point, from the previous, the IP and the next point");
  std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  auto radius = std::make_shared<double>(0.0);
  auto spiralIn = std::make_shared<double>(0.0);
  auto spiralOut = std::make_shared<double>(0.0);
  auto type = std::make_shared<std::string>("clothoid");
  svy_tool::requireNumberText(
      verb->add_option("--radius", *radius, "Radius of the arc (the turn comes from the points)"))
      ->required()
      ->check(CLI::PositiveNumber);
  svy_tool::requireNumberText(verb->add_option("--spiral-in", *spiralIn, "Length of the entry spiral (TS to SC)"))
      ->check(CLI::NonNegativeNumber);
  svy_tool::requireNumberText(verb->add_option("--spiral-out", *spiralOut, "Length of the exit spiral (CS to ST)"))
      ->check(CLI::NonNegativeNumber);
  verb->add_option("--type", *type, "Spiral law")->check(CLI::IsMember({"clothoid", "cubic"}));

  verb->callback([=] {
    if (!std::isfinite(*radius) || !std::isfinite(*spiralIn) || !std::isfinite(*spiralOut)) {
      throw CLI::ValidationError("--radius, --spiral-in and --spiral-out must be finite");
    }
    const svy_tool::RowFormat format{{"n_prev", "e_prev", "n_ip", "e_ip", "n_next", "e_next"},
                                     true,
                                     {{"deflection_deg", kAngleDecimals},
                                      {"tangent_in", kLengthDecimals},
                                      {"tangent_out", kLengthDecimals},
                                      {"shift_in", kLengthDecimals},
                                      {"shift_out", kLengthDecimals},
                                      {"length", kLengthDecimals},
                                      {"ts_n", kLengthDecimals},
                                      {"ts_e", kLengthDecimals},
                                      {"sc_n", kLengthDecimals},
                                      {"sc_e", kLengthDecimals},
                                      {"cs_n", kLengthDecimals},
                                      {"cs_e", kLengthDecimals},
                                      {"st_n", kLengthDecimals},
                                      {"st_e", kLengthDecimals}}};
    const AlntMathSpiralType law = *type == "cubic" ? eMathSpiralCubic : eMathSpiralEuler;
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [=](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::vector<double>& v = row.numbers;
          CCurveIp group;
          group.setSpiralType(law);
          if (!group.setIp(v[2], v[3], *radius, *spiralIn, *spiralOut) ||
              !group.setNeighbours(C2dPos(v[0], v[1]), C2dPos(v[4], v[5]))) {
            error = ipFailure(group, *type);
            return false;
          }
          const C2dPos ts = group.getTS(), sc = group.getSC(), cs = group.getCS(), st = group.getST();
          out = {group.getDeflection() * svy_math::units::kRadToDeg,
                 group.getTangentIn(),
                 group.getTangentOut(),
                 group.getShiftIn(),
                 group.getShiftOut(),
                 group.getTotalLength(),
                 ts.north(),
                 ts.east(),
                 sc.north(),
                 sc.east(),
                 cs.north(),
                 cs.east(),
                 st.north(),
                 st.east()};
          return true;
        }));
  });
}

void addTable(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "table", "Positions along a transition spiral in its local frame: north along the initial tangent");
  auto type = std::make_shared<std::string>("clothoid");
  auto length = std::make_shared<double>(0.0);
  auto radius = std::make_shared<double>(0.0);
  auto interval = std::make_shared<double>(0.0);
  auto exitSpiral = std::make_shared<bool>(false);
  verb->add_option("--type", *type, "Spiral law")->check(CLI::IsMember({"clothoid", "cubic"}));
  svy_tool::requireNumberText(verb->add_option("--length", *length, "Spiral length"))
      ->required()
      ->check(CLI::PositiveNumber);
  svy_tool::requireNumberText(
      verb->add_option("--radius", *radius, "Radius at the curve end; negative for a spiral turning left"))
      ->required();
  svy_tool::requireNumberText(
      verb->add_option("--interval", *interval, "Length between rows (the end is always written)"))
      ->required()
      ->check(CLI::PositiveNumber);
  verb->add_flag("--exit", *exitSpiral, "Run from the curve out to the tangent (CS to ST)");

  verb->callback([=] {
    if (!(std::fabs(*radius) > 0.0) || !std::isfinite(*radius)) {
      throw CLI::ValidationError("--radius must be a non-zero number");
    }
    if (!(*length / *interval <= kMaxTableRows)) throw CLI::ValidationError("--interval gives too many rows");
    CCurveDataSpiral1R spiral(*type == "cubic" ? eMathSpiralCubic : eMathSpiralEuler);
    if (!spiral.setLenAndR(*length, *radius, *radius > 0.0, !*exitSpiral)) {
      throw CLI::ValidationError("no " + *type + " spiral of length " + messageNumber(*length) +
                                 " reaches radius " + messageNumber(*radius));
    }
    svy_tool::RowWriter writer(std::cout,
                               {{"length", kLengthDecimals},
                                {"north", kLengthDecimals},
                                {"east", kLengthDecimals},
                                {"azimuth_deg", kAngleDecimals},
                                {"radius", kLengthDecimals}},
                               svy_tool::outputOptionsFor(*verb));
    const double total = spiral.getTotalLength();
    const auto rows = static_cast<long>(std::floor(total / *interval));
    for (long i = 0; i <= rows + 1; ++i) {
      // Rows at whole intervals, then the end unless the last interval already reached it.
      double s = std::fmin(static_cast<double>(i) * *interval, total);
      if (i == rows + 1 && static_cast<double>(rows) * *interval >= total) break;
      double north = 0.0;
      double east = 0.0;
      if (!spiral.getPosAtLength(s, north, east)) continue;
      const double k = spiral.getCurvatureAtLength(s);
      const double r = k == 0.0 ? std::numeric_limits<double>::infinity() : 1.0 / k;
      writer.write({s, north, east, spiral.GetAzimuth(s), r});
    }
    writer.finish();
  });
}

}  // namespace

void registerCurveVerbs(CLI::App& app) {
  CLI::App* curve = app.add_subcommand("curve", "Circular curves and curves about an intersection point");
  curve->require_subcommand(1);
  addSolve(*curve);
  addIp(*curve);
  CLI::App* spiral = app.add_subcommand("spiral", "Transition spirals (clothoid, cubic parabola)");
  spiral->require_subcommand(1);
  addTable(*spiral);
}
