// svy angle: conversion of angle values between degrees, radians, grads, mils, the packed DDD.MMSS and
// DD.MMmm numbers, and the display texts of degrees, DMS and DMM.
#include "row_io.h"
#include "unit_option.h"
#include "verbs.h"

#include "svymath/formats/angle_text.h"
#include "svymath/formats/degree_display_text.h"
#include "svymath/foundation/angle_functions.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <memory>
#include <string>
#include <vector>

namespace {

using svy_text::CSvyString;

// An angle unit: how a field of it reads into decimal degrees, how decimal degrees are written in it (a
// number, or a text; NaN or an empty text when there is none), and the decimals of its numbers (about
// 1 mm at 100 km in each unit; the packed forms show seconds to 0.0001" and minutes to 0.000001').
// Numeric units read fields that the row reader has already checked as numbers.
struct AngleUnit {
  const char* name;
  bool numeric;
  bool (*read)(const std::string& field, double number, double& degrees);
  svy_tool::Cell (*write)(double degrees, bool fullPrecision);
  int decimals;
};

// Decimals of the packed numbers, four of them for minutes and whole seconds (DDD.MMSS) or two for whole
// minutes (DD.MMmm); and of the last field of the texts.
constexpr int kPackedDecimals = 8;
constexpr int kPackedDecimalsFull = 12;
constexpr int kMinuteDecimals = 6;
constexpr int kMinuteDecimalsFull = 10;
constexpr int kDegreeTextDecimals = 9;
constexpr int kSecondTextDecimals = 4;
constexpr int kSecondTextDecimalsFull = 9;

bool readNumber(double number, double (*toDegrees)(double), double& degrees) {
  degrees = toDegrees(number);
  return true;
}

// A text cell, or NaN when the angle has no text (not finite, degrees beyond int).
svy_tool::Cell textCell(const CSvyString& text) {
  if (text.IsEmpty()) return std::nan("");
  return text.ToNarrow();
}

bool readText(bool (*parse)(const CSvyString&, double&), const std::string& field, double& degrees) {
  return parse(CSvyString(field.c_str()), degrees);
}

// Values are converted as given, without reduction to one turn (420 degrees stays 420), except the packed
// numbers, which the library defines within one turn (their sign kept).
const AngleUnit kAngleUnits[] = {
    {"deg", true, [](const std::string&, double v, double& d) { return readNumber(v, [](double x) { return x; }, d); },
     [](double d, bool) -> svy_tool::Cell { return d; }, 9},
    {"rad", true,
     [](const std::string&, double v, double& d) { return readNumber(v, [](double x) { return Rad2Deg(x, true); }, d); },
     [](double d, bool) -> svy_tool::Cell { return Deg2Rad(d, true); }, 10},
    {"grad", true,
     [](const std::string&, double v, double& d) { return readNumber(v, [](double x) { return Grad2Deg(x, true); }, d); },
     [](double d, bool) -> svy_tool::Cell { return Deg2Grad(d, true); }, 9},
    {"mil", true,
     [](const std::string&, double v, double& d) { return readNumber(v, [](double x) { return Mil2Deg(x, true); }, d); },
     [](double d, bool) -> svy_tool::Cell { return Deg2Mil(d, true); }, 7},
    {"dms", true, [](const std::string&, double v, double& d) { return readNumber(v, DDDMMSS2Deg, d); },
     [](double d, bool full) -> svy_tool::Cell {
       return Deg2DDDMMSS(d, full ? kPackedDecimalsFull : kPackedDecimals, false);
     },
     kPackedDecimals},
    {"dmm", true, [](const std::string& f, double, double& d) { return readText(svy_formats::FromStringDMM, f, d); },
     [](double d, bool full) -> svy_tool::Cell {
       return Deg2DDMMDEC(d, full ? kMinuteDecimalsFull : kMinuteDecimals, false);
     },
     kMinuteDecimals + 2},
    {"deg-text", false, [](const std::string& f, double, double& d) { return readText(svy_formats::ParseDegree, f, d); },
     [](double d, bool) {
       return textCell(svy_formats::DegreeToStringEx(d, kDegreeTextDecimals, svy_formats::eFloatTextTrimZeros));
     },
     0},
    {"dms-text", false, [](const std::string& f, double, double& d) { return readText(svy_formats::ParseDMS, f, d); },
     [](double d, bool full) {
       return textCell(svy_formats::DMSToString(d, full ? kSecondTextDecimalsFull : kSecondTextDecimals));
     },
     0},
    {"dmm-text", false, [](const std::string& f, double, double& d) { return readText(svy_formats::ParseDMM, f, d); },
     [](double d, bool full) {
       return textCell(svy_formats::DMMToString(d, full ? kMinuteDecimalsFull : kMinuteDecimals));
     },
     0},
};

bool isMissing(const svy_tool::Cell& cell) {
  const auto* number = std::get_if<double>(&cell);
  return number != nullptr && !std::isfinite(*number);
}

void addConvert(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("convert", "Convert angles, one value per row");
  auto from = std::make_shared<std::string>();
  auto to = std::make_shared<std::string>();
  const std::vector<std::string> names = svy_tool::unitNames(kAngleUnits);
  svy_tool::addUnitOption(*verb, "--from", *from, names, "Unit or text form of the input values");
  svy_tool::addUnitOption(*verb, "--to", *to, names, "Unit or text form of the output values");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input, from, to] {
    const AngleUnit& source = svy_tool::unitNamed(kAngleUnits, *from);
    const AngleUnit& target = svy_tool::unitNamed(kAngleUnits, *to);
    const svy_tool::OutputOptions options = svy_tool::outputOptionsFor(*verb);
    const svy_tool::RowFormat format{{"value"}, source.numeric, {{"value", target.decimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, options,
        [&](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::string& field = row.fields[0];
          double degrees = 0.0;
          if (!source.read(field, source.numeric ? row.numbers[0] : 0.0, degrees)) {
            error = "value: " + svy_tool::quoteForMessage(field) + " is not a " + source.name + " angle";
            return false;
          }
          // The same unit is copied, so that a number keeps all its digits.
          const svy_tool::Cell result =
              &source == &target && source.numeric ? row.numbers[0] : target.write(degrees, options.fullPrecision);
          if (isMissing(result)) {
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
  CLI::App* family = app.add_subcommand("angle", "Angle units and texts");
  family->require_subcommand(1);
  addConvert(*family);
}
