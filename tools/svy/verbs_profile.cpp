// svy profile: a vertical alignment given by its intersection points (--pvi CH,H[,L], repeated, in order of
// chainage: a symmetric parabola of horizontal length L about each point; none at the first and the last),
// read at the rows' chainages.
#include "row_io.h"
#include "verbs.h"

#include "svymath/alignments/alnt_v.h"
#include "svymath/alignments/vertical_ls_element.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <memory>
#include <string>
#include <vector>

namespace {

// Written decimals: chainages and heights to 0.1 mm, grades to 0.0001 %.
constexpr int kLengthDecimals = 4;
constexpr int kGradeDecimals = 4;

// The profile through the points; a one-line reason when they define none.
CAlntV buildProfile(const std::vector<std::string>& texts) {
  if (texts.size() < 2) throw CLI::ValidationError("--pvi: give at least two points CH,H[,L]");
  std::vector<CLsInfo> points;
  for (const std::string& text : texts) {
    std::vector<double> v;
    if (!svy_tool::parseNumberList(text, 3, v)) {
      if (!svy_tool::parseNumberList(text, 2, v)) throw CLI::ValidationError("--pvi: expected CH,H[,L], got '" + text + "'");
      v.push_back(0.0);
    }
    if (v[2] < 0.0) throw CLI::ValidationError("--pvi: negative curve length in '" + text + "'");
    points.emplace_back(v[0], v[1], v[2], v[0] - 0.5 * v[2], 0.0);
  }
  // The ends of the profile carry no curve.
  points.front().curveLength = 0.0;
  points.back().curveLength = 0.0;
  CAlntV profile;
  profile.setStartChainageInM(points.front().ipChainage);
  profile.setStartHeight(points.front().ipHeight);
  for (std::size_t i = 0; i + 1 < points.size(); ++i) {
    if (!profile.appendElement(CVerticalLSElement(points[i], points[i + 1]))) {
      throw CLI::ValidationError("--pvi: the points must increase in chainage and their curves must not overlap ('" +
                                 texts[i] + "', '" + texts[i + 1] + "')");
    }
  }
  return profile;
}

void addHeight(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("height", "Height and grade at rows of chainage on a profile of --pvi points");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<std::vector<std::string>> pvis = std::make_shared<std::vector<std::string>>();
  verb->add_option("--pvi", *pvis, "Vertical intersection point CH,H[,L] (L: parabola length), repeated")
      ->required()
      ->allow_extra_args(false);
  verb->callback([verb, input, pvis] {
    const CAlntV profile = buildProfile(*pvis);
    const svy_tool::RowFormat format{
        {"chainage"}, true, {{"chainage", kLengthDecimals}, {"height", kLengthDecimals}, {"grade_pct", kGradeDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [&profile](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const double chainage = row.numbers[0];
          double height = 0.0;
          double grade = 0.0;
          if (!profile.getHeightAtChain(chainage, height) || !profile.getGradeAtChainage(chainage, grade)) {
            double end = 0.0;
            profile.getFinalChainageInM(end);
            error = "chainage " + svy_tool::formatNumber(chainage, kLengthDecimals) + " lies outside the profile (" +
                    svy_tool::formatNumber(profile.getStartChainageInM(), kLengthDecimals) + " to " +
                    svy_tool::formatNumber(end, kLengthDecimals) + ")";
            return false;
          }
          out = {chainage, height, grade};
          return true;
        }));
  });
}

}  // namespace

void registerProfileVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("profile", "Vertical alignments (profiles)");
  family->require_subcommand(1);
  addHeight(*family);
}
