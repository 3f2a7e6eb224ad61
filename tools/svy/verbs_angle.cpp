// svy angle: conversion of plain angle values between degrees, radians, grads, mils and packed DDD.MMSS.
#include "row_io.h"
#include "unit_option.h"
#include "verbs.h"

#include "svymath/foundation/angle_functions.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <memory>
#include <string>
#include <vector>

namespace {

// An angle unit: to and from decimal degrees with the library's conversions, and the decimals written
// (about 1 mm at 100 km in each unit; the packed form shows seconds to 0.0001").
struct AngleUnit {
  const char* name;
  double (*toDegrees)(double value);
  double (*fromDegrees)(double degrees, bool fullPrecision);
  int decimals;
};

// Packed DDD.MMSS: the decimals of the packed number, four of them for minutes and whole seconds.
constexpr int kPackedDecimals = 8;
constexpr int kPackedDecimalsFull = 12;

// Values are converted as given, without reduction to one turn (420 degrees stays 420), except the packed
// form, which the library defines within one turn (its sign kept).
const AngleUnit kAngleUnits[] = {
    {"deg", [](double v) { return v; }, [](double d, bool) { return d; }, 9},
    {"rad", [](double v) { return Rad2Deg(v, true); }, [](double d, bool) { return Deg2Rad(d, true); }, 10},
    {"grad", [](double v) { return Grad2Deg(v, true); }, [](double d, bool) { return Deg2Grad(d, true); },
     9},
    {"mil", [](double v) { return Mil2Deg(v, true); }, [](double d, bool) { return Deg2Mil(d, true); }, 7},
    {"dms", [](double v) { return DDDMMSS2Deg(v); },
     [](double d, bool full) { return Deg2DDDMMSS(d, full ? kPackedDecimalsFull : kPackedDecimals, false); },
     kPackedDecimals},
};

void addConvert(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("convert", "Convert angles, one value per row");
  auto from = std::make_shared<std::string>();
  auto to = std::make_shared<std::string>();
  const std::vector<std::string> names = svy_tool::unitNames(kAngleUnits);
  svy_tool::addUnitOption(*verb, "--from", *from, names, "Unit of the input values");
  svy_tool::addUnitOption(*verb, "--to", *to, names, "Unit of the output values");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input, from, to] {
    const AngleUnit& source = svy_tool::unitNamed(kAngleUnits, *from);
    const AngleUnit& target = svy_tool::unitNamed(kAngleUnits, *to);
    const svy_tool::OutputOptions options = svy_tool::outputOptionsFor(*verb);
    const svy_tool::RowFormat format{{"value"}, true, {{"value", target.decimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, options,
        [&](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const double value = row.numbers[0];
          const double result =
              &source == &target ? value
                                 : target.fromDegrees(source.toDegrees(value),
                                                      options.fullPrecision);
          if (!std::isfinite(result)) {
            error = "no finite " + std::string(target.name) + " value";
            return false;
          }
          out = {result};
          return true;
        }));
  });
}

}  // namespace

void registerAngleVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("angle", "Angle units");
  family->require_subcommand(1);
  addConvert(*family);
}
