// svy road catch: slope staking. Each row gives a hinge point (offset from the centre line, negative left,
// and elevation) and a ground shot (offset and elevation); the ground is the line through the shot at the
// cross grade --ground-grade (percent, rising to the right; level by default). The cut slope --cut and the
// fill slope --fill are given as horizontal run per unit of rise (2 for 2:1); the slope the ground at the
// hinge calls for runs outward, away from the centre line, to the catch point.
#include <CLI/CLI.hpp>
#include <cmath>
#include <memory>
#include <string>
#include <vector>

#include "row_io.h"
#include "svymath/foundation/constants.h"
#include "svymath/road/catch_point.h"
#include "verbs.h"

namespace {

// Written decimals: offsets and elevations to 0.1 mm, slopes to 0.0001.
constexpr int kLengthDecimals = 4;
constexpr int kSlopeDecimals = 4;

struct TSlopeOptions {
  double cutRun = svy_math::undefinedValue();
  double fillRun = svy_math::undefinedValue();
  double groundGradePct = 0.0;
};

std::string reasonFor(ECatchPointStatus status) {
  switch (status) {
    case eCatchPointNoSlope:
      return "no slope suits the ground at the hinge (give --cut or --fill)";
    case eCatchPointNotMet:
      return "the slope does not meet the ground";
    default:
      return "no ground at the hinge";
  }
}

void addCatch(CLI::App& family) {
  CLI::App* verb =
      family.add_subcommand("catch", "Catch points of cut and fill slopes from rows of hinge and ground shot");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<TSlopeOptions> options = std::make_shared<TSlopeOptions>();
  verb->add_option("--cut", options->cutRun, "Cut slope as run per unit rise (2 for 2:1)")->check(CLI::PositiveNumber);
  verb->add_option("--fill", options->fillRun, "Fill slope as run per unit fall (3 for 3:1)")
      ->check(CLI::PositiveNumber);
  verb->add_option("--ground-grade", options->groundGradePct, "Cross grade of the ground, percent rising to the right");
  verb->callback([verb, input, options] {
    if (std::isnan(options->cutRun) && std::isnan(options->fillRun)) {
      throw CLI::ValidationError("give --cut, --fill or both");
    }
    const svy_tool::RowFormat format{{"hinge_offset", "hinge_elevation", "ground_offset", "ground_elevation"},
                                     true,
                                     {{"catch_offset", kLengthDecimals},
                                      {"catch_elevation", kLengthDecimals},
                                      {"slope", 0},
                                      {"run_rise", kSlopeDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [&options](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const double hingeOffset = row.numbers[0];
          const CEditableRoadCrossSection section(0.0);
          CRoadCrossSectionSlope slope(section, hingeOffset >= 0.0, options->cutRun, -options->fillRun);
          slope.setHingePoint(hingeOffset, row.numbers[1]);
          // The ground line through the shot, as two points a metre either side of it, continued.
          const double rise = options->groundGradePct / svy_math::units::kPercent;
          const TXsGroundPoint ground[] = {{row.numbers[2] - 1.0, row.numbers[3] - rise},
                                           {row.numbers[2] + 1.0, row.numbers[3] + rise}};
          double offset = 0.0;
          double elevation = 0.0;
          double runRise = 0.0;
          const ECatchPointStatus status = ComputeCatchPoint(slope, ground, 2, true, offset, elevation, &runRise);
          if (status != eCatchPointFound) {
            error = reasonFor(status);
            return false;
          }
          out = {offset, elevation, std::string(runRise > 0.0 ? "cut" : "fill"), runRise};
          return true;
        }));
  });
}

}  // namespace

void registerRoadVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("road", "Road cross-sections and side slopes");
  family->require_subcommand(1);
  addCatch(*family);
}
