// svy view: where targets lie on a field screen that looks from an observer along an azimuth and elevation.
#include "row_io.h"
#include "verbs.h"

#include "svymath/cogo/view_cone.h"
#include "svymath/foundation/constants.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <limits>
#include <memory>
#include <string>
#include <vector>

namespace {

// Screen positions to a hundredth of a pixel.
constexpr int kPixelDecimals = 2;

struct ViewOptions {
  std::string observer;
  std::string screen;
  double azimuthDeg = 0.0;
  double elevationDeg = 0.0;
  double fieldOfViewDeg = 0.0;
};

// The view from the options; false when a value is missing, malformed or out of range.
bool viewFrom(const ViewOptions& options, svy_math::TViewParams& view) {
  std::vector<double> observer;
  std::vector<double> screen;
  if (!svy_tool::parseNumberList(options.observer, 3, observer) || !svy_tool::parseNumberList(options.screen, 2, screen))
    return false;
  // Whole pixels within the range of int.
  for (double size : screen)
    if (!(size >= 1.0 && size <= std::numeric_limits<int>::max() && size == std::floor(size))) return false;
  view.observer = svy_math::TAbstractPoint3<double>(observer[0], observer[1], observer[2]);
  view.azimuth = options.azimuthDeg * svy_math::units::kDegToRad;
  view.elevation = options.elevationDeg * svy_math::units::kDegToRad;
  view.fieldOfView = options.fieldOfViewDeg * svy_math::units::kDegToRad;
  view.screenWidth = static_cast<int>(screen[0]);
  view.screenHeight = static_cast<int>(screen[1]);
  return view.isValid();
}

void addProject(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "project", "Screen position (pixels from the top-left corner) of targets: rows n,e,h; x,y are nan behind the observer");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const auto options = std::make_shared<ViewOptions>();
  verb->add_option("--observer", options->observer, "Observer N,E,H (metres)")->required();
  verb->add_option("--azimuth", options->azimuthDeg, "Azimuth of the view axis (degrees from north, clockwise)");
  verb->add_option("--elevation", options->elevationDeg, "Elevation of the view axis (degrees up, -90 to 90)");
  verb->add_option("--fov", options->fieldOfViewDeg, "Horizontal field of view (degrees, between 0 and 180)")
      ->required();
  verb->add_option("--screen", options->screen, "Screen WIDTH,HEIGHT (pixels)")->required();
  verb->callback([verb, input, options] {
    svy_math::TViewParams view;
    if (!viewFrom(*options, view))
      throw CLI::ValidationError(
          "view: expected --observer N,E,H, --fov within 0 to 180, --elevation within -90 to 90 and --screen W,H "
          "of whole pixels");
    const svy_math::TRectCone cone(view);
    const svy_tool::RowFormat format{
        {"n", "e", "h"}, true, {{"x", kPixelDecimals}, {"y", kPixelDecimals}, {"inside", 0}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [view, cone](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string&) {
          const svy_math::T3dPosAndDirRotated target(
              view, svy_math::TAbstractPoint3<double>(row.numbers[0], row.numbers[1], row.numbers[2]));
          double x = std::numeric_limits<double>::quiet_NaN();
          double y = x;
          cone.toScreen(target, x, y);
          out = {x, y, cone.contains(target) ? 1.0 : 0.0};
          return true;
        }));
  });
}

}  // namespace

void registerViewVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("view", "Targets on a field screen");
  family->require_subcommand(1);
  addProject(*family);
}
