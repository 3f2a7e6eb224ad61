// svy traverse: adjustment of a traverse run between known points, rows azimuth_deg,distance (the legs in
// order). All legs are read before anything is written: a traverse with a bad leg is not adjusted.
#include "row_io.h"
#include "verbs.h"

#include "svymath/adjustment/proportioning.h"
#include "svymath/foundation/angle_functions.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <iostream>
#include <memory>
#include <string>
#include <vector>

namespace {

// Coordinates and corrections to 0.1 mm; the relative precision 1:N as a whole number.
constexpr int kLengthDecimals = 4;
constexpr int kPrecisionDecimals = 0;

// Reads the legs; returns kExitOk, kExitBadRows when a row was bad (reported), or kExitUsage.
int readLegs(const std::string& path, svy_vector<svy_math::TTraverseLeg>& legs) {
  return svy_tool::readAllRows(path, svy_tool::RowFormat{{"azimuth_deg", "distance"}, true, {}},
                               [&legs](const svy_tool::InputRow& row, std::string& error) {
                                 if (row.numbers[1] < 0.0) {
                                   error = "distance: a leg cannot be negative";
                                   return false;
                                 }
                                 legs.push_back({Deg2Rad(row.numbers[0], false), row.numbers[1]});
                                 return true;
                               });
}

void addAdjust(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "adjust", "Distribute the misclosure of a traverse between known points: rows azimuth_deg,distance");
  auto rule = std::make_shared<std::string>("compass");
  auto start = std::make_shared<std::string>();
  auto end = std::make_shared<std::string>();
  verb->add_option("--rule", *rule, "compass (Bowditch, by distance) or transit (by |dN| and |dE|)")
      ->check(CLI::IsMember({"compass", "transit"}))
      ->capture_default_str();
  verb->add_option("--start", *start, "Known start point N,E")->required();
  verb->add_option("--end", *end, "Known end point N,E (default: the start, a closed loop)");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input, rule, start, end] {
    std::vector<double> startNE, endNE;
    if (!svy_tool::parseNumberList(*start, 2, startNE))
      throw CLI::ValidationError("--start", "expected N,E, got '" + *start + "'");
    if (end->empty()) {
      endNE = startNE;
    } else if (!svy_tool::parseNumberList(*end, 2, endNE)) {
      throw CLI::ValidationError("--end", "expected N,E, got '" + *end + "'");
    }
    svy_vector<svy_math::TTraverseLeg> legs;
    const int readStatus = readLegs(*input, legs);
    if (readStatus == svy_tool::kExitUsage) svy_tool::finishVerb(readStatus);

    const std::vector<svy_tool::Column> columns{{"point", 0},
                                                {"n", kLengthDecimals},
                                                {"e", kLengthDecimals},
                                                {"correction_n", kLengthDecimals},
                                                {"correction_e", kLengthDecimals}};
    const svy_tool::OutputOptions options = svy_tool::outputOptionsFor(*verb);
    svy_tool::RowWriter writer(std::cout, columns, options);
    svy_math::TTraverseAdjustment result;
    const bool adjusted = readStatus == svy_tool::kExitOk &&
                          svy_math::TProportioning::adjustTraverse(
                              C2dPos(startNE[0], startNE[1]), C2dPos(endNE[0], endNE[1]), legs,
                              *rule == "transit" ? svy_math::eTransitRule : svy_math::eCompassRule, result);
    // JSON is one object either way; without an adjustment its misclosure values are null.
    const double unknown = std::nan("");
    const std::vector<svy_tool::Column> misclosureColumns{
        {"n", kLengthDecimals}, {"e", kLengthDecimals}, {"linear", kLengthDecimals}, {"precision", kPrecisionDecimals}};
    writer.setJsonEnvelope({{"misclosure", misclosureColumns,
                             {adjusted ? result.misclosureNorth : unknown, adjusted ? result.misclosureEast : unknown,
                              adjusted ? result.linearMisclosure : unknown, adjusted ? result.precision : unknown}}},
                           "points");
    if (adjusted) {
      for (std::size_t i = 0; i < result.points.size(); ++i)
        writer.write({static_cast<double>(i + 1), result.points[i].north(), result.points[i].east(),
                      result.corrections[i].north(), result.corrections[i].east()});
    }
    writer.finish();
    if (!adjusted) {
      std::cerr << (readStatus != svy_tool::kExitOk ? "svy: the traverse is not adjusted: a leg is missing\n"
                                                    : "svy: the traverse cannot be adjusted: no legs, or no length\n");
    } else if (!options.json) {
      // CSV has no place for the misclosure beside the points: it goes to the terminal.
      std::cerr << "misclosure n " << svy_tool::formatNumber(result.misclosureNorth, kLengthDecimals) << " e "
                << svy_tool::formatNumber(result.misclosureEast, kLengthDecimals) << " linear "
                << svy_tool::formatNumber(result.linearMisclosure, kLengthDecimals) << ", precision 1:"
                << svy_tool::formatNumber(result.precision, kPrecisionDecimals) << '\n';
    }
    svy_tool::finishVerb(adjusted ? svy_tool::kExitOk : svy_tool::kExitBadRows);
  });
}

}  // namespace

void registerTraverseVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("traverse", "Traverse computations between known points");
  family->require_subcommand(1);
  addAdjust(*family);
}
