// svy fit: least-squares best fits to rows of plane points n,e (a line, a circle, a radius about a known
// centre). Every good row takes part; bad rows are reported and left out, and the one result row is
// written from the others.
#include "row_io.h"
#include "verbs.h"

#include "svymath/adjustment/best_fit.h"
#include "svymath/adjustment/least_squares.h"

#include <CLI/CLI.hpp>

#include <iostream>
#include <memory>
#include <string>
#include <vector>

namespace {

// Written decimals: coordinates, radii and rms to 0.1 mm; a slope to 1e-10 (0.05 mm over 500 km, the
// distance from the intercept at E 0 to survey eastings).
constexpr int kLengthDecimals = 4;
constexpr int kSlopeDecimals = 10;
// Convergence of the iterative fits, metres per unknown: far below the written 0.1 mm and still 100 times
// the spacing of doubles at N 5 000 000.
constexpr double kFitConvergence = 1e-7;

// Reads the points of the input; returns kExitOk, or kExitBadRows when a row was left out, or kExitUsage
// when the input cannot be opened.
int readPoints(const std::string& path, svy_list<C2dPos>& points) {
  return svy_tool::readAllRows(path, svy_tool::RowFormat{{"n", "e"}, true, {}},
                               [&points](const svy_tool::InputRow& row, std::string&) {
                                 points.push_back(C2dPos(row.numbers[0], row.numbers[1]));
                                 return true;
                               });
}

std::string failureText(svy_math::ELeastSquaresStatus status, const std::string& degenerate) {
  switch (status) {
    case svy_math::eLsqTooFewObservations: return "too few points";
    case svy_math::eLsqSingular: return degenerate;
    case svy_math::eLsqNotFinite: return "the fit is not finite";
    case svy_math::eLsqNoConvergence: return "the fit did not converge";
    default: return "the fit failed";
  }
}

// Writes the result row (or, for a failed fit, the message and only the header) and ends the verb.
void finishFit(const CLI::App& verb, int readStatus, svy_math::ELeastSquaresStatus fitStatus,
               const std::vector<svy_tool::Column>& columns, const std::vector<svy_tool::Cell>& cells,
               const std::string& degenerate) {
  svy_tool::RowWriter writer(std::cout, columns, svy_tool::outputOptionsFor(verb));
  int status = readStatus;
  if (fitStatus == svy_math::eLsqOk) {
    writer.write(cells);
  } else {
    std::cerr << "svy: " << failureText(fitStatus, degenerate) << '\n';
    status = svy_tool::kExitBadRows;
  }
  writer.finish();
  svy_tool::finishVerb(status);
}

void addLine(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("line", "Line n = slope * e + intercept through rows n,e");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    svy_list<C2dPos> points;
    const int readStatus = readPoints(*input, points);
    if (readStatus == svy_tool::kExitUsage) svy_tool::finishVerb(readStatus);
    const svy_math::TBestFitLineData data(points);
    svy_vector<double> solution;
    const svy_math::ELeastSquaresStatus status = svy_math::leastSquares(solution, data);
    std::vector<svy_tool::Cell> cells;
    if (status == svy_math::eLsqOk) cells = {solution[0], solution[1], data.getRms(solution)};
    finishFit(*verb, readStatus, status,
              {{"slope", kSlopeDecimals}, {"intercept", kLengthDecimals}, {"rms", kLengthDecimals}}, cells,
              "all points have one easting: n is no function of e");
  });
}

void addCircle(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("circle", "Best-fit circle through rows n,e");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input] {
    svy_list<C2dPos> points;
    const int readStatus = readPoints(*input, points);
    if (readStatus == svy_tool::kExitUsage) svy_tool::finishVerb(readStatus);
    svy_math::TBestFitCurveData data(points);
    data.setConvergenceCriteria(svy_vector<double>(3, kFitConvergence));
    svy_vector<double> solution;
    const svy_math::ELeastSquaresStatus status = svy_math::gaussNewtonLeastSquares(solution, data);
    std::vector<svy_tool::Cell> cells;
    // The solution is (centre east, centre north, radius).
    if (status == svy_math::eLsqOk) cells = {solution[1], solution[0], solution[2], data.getMisclosureRms()};
    finishFit(*verb, readStatus, status,
              {{"center_n", kLengthDecimals}, {"center_e", kLengthDecimals}, {"radius", kLengthDecimals},
               {"rms", kLengthDecimals}},
              cells, "the points are collinear or coincide");
  });
}

void addRadius(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("radius", "Best-fit radius about a known centre of rows n,e");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<std::string> centreText = std::make_shared<std::string>();
  verb->add_option("--center", *centreText, "Circle centre N,E")->required();
  verb->callback([verb, input, centreText] {
    std::vector<double> centre;
    if (!svy_tool::parseNumberList(*centreText, 2, centre))
      throw CLI::ValidationError("--center: expected N,E, got '" + *centreText + "'");
    svy_list<C2dPos> points;
    const int readStatus = readPoints(*input, points);
    if (readStatus == svy_tool::kExitUsage) svy_tool::finishVerb(readStatus);
    svy_math::TBestFitRadiusData data(points, C2dPos(centre[0], centre[1]));
    data.setConvergenceCriteria(svy_vector<double>(1, kFitConvergence));
    svy_vector<double> solution;
    const svy_math::ELeastSquaresStatus status = svy_math::gaussNewtonLeastSquares(solution, data);
    std::vector<svy_tool::Cell> cells;
    if (status == svy_math::eLsqOk) cells = {solution[0], data.getMisclosureRms()};
    finishFit(*verb, readStatus, status, {{"radius", kLengthDecimals}, {"rms", kLengthDecimals}}, cells,
              "no radius");
  });
}

}  // namespace

void registerFitVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("fit", "Least-squares best fits to plane points n,e");
  family->require_subcommand(1);
  addLine(*family);
  addCircle(*family);
  addRadius(*family);
}
