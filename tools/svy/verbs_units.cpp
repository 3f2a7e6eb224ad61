// svy units: conversion of lengths, areas, volumes, pressures and temperatures between named units.
// Every conversion goes through the library's base unit of its quantity (m, m2, m3, hPa, degrees C) with
// the library's own conversion functions; where the library converts one way only, the way back divides
// by the library's factor (its conversion of 1).
#include "row_io.h"
#include "unit_option.h"
#include "verbs.h"

#include "svymath/foundation/unit_conversions.h"

#include <CLI/CLI.hpp>

#include <cmath>
#include <memory>
#include <string>
#include <vector>

namespace {

enum class Quantity { kLength, kArea, kVolume, kPressure, kTemperature };

const char* quantityName(Quantity quantity) {
  switch (quantity) {
    case Quantity::kLength: return "length";
    case Quantity::kArea: return "area";
    case Quantity::kVolume: return "volume";
    case Quantity::kPressure: return "pressure";
    case Quantity::kTemperature: return "temperature";
  }
  return "";
}

// A unit: its quantity, the conversions to and from the quantity's base unit, and the decimals written
// (about 0.1 mm, 0.1 mm^2-scale areas, 0.01 hPa, 0.01 degree).
struct Unit {
  const char* name;
  Quantity quantity;
  double (*toBase)(double value);
  double (*fromBase)(double base);
  int decimals;
};

constexpr bool kUsSurvey = true;
constexpr bool kInternational = false;

double identity(double value) { return value; }

// Acres through square chains, the library's route from square metres.
template <bool kUs>
double acresToSquareMetres(double acres) {
  return SqureChains2SqureMeters(acres / SqureChains2Acres(1.0, kUs), kUs);
}
template <bool kUs>
double squareMetresToAcres(double squareMetres) {
  return SqureChains2Acres(SqureMeter2SqureChain(squareMetres, kUs), kUs);
}

const Unit kUnits[] = {
    {"m", Quantity::kLength, identity, identity, 4},
    {"ft", Quantity::kLength, IFeet2Meter, Meter2IFeet, 4},
    {"ft-us", Quantity::kLength, USFeet2Meter, Meter2USFeet, 4},
    {"ch", Quantity::kLength, [](double c) { return Chain2Meter(c, kInternational); },
     [](double m) { return Meter2Chain(m, kInternational); }, 6},
    {"ch-us", Quantity::kLength, [](double c) { return Chain2Meter(c, kUsSurvey); },
     [](double m) { return Meter2Chain(m, kUsSurvey); }, 6},
    // Packed feet-inches-eighths FFF.IIE: three decimals hold the inches and the eighths.
    {"fin", Quantity::kLength, [](double x) { return FFFII2Meter(x, kInternational); },
     [](double m) { return Meter2FFFII(m, kInternational); }, 3},
    {"fin-us", Quantity::kLength, [](double x) { return FFFII2Meter(x, kUsSurvey); },
     [](double m) { return Meter2FFFII(m, kUsSurvey); }, 3},

    {"m2", Quantity::kArea, identity, identity, 4},
    {"ft2", Quantity::kArea, [](double a) { return a / SqrMeter2SqrFeet(1.0, kInternational); },
     [](double a) { return SqrMeter2SqrFeet(a, kInternational); }, 4},
    {"ft2-us", Quantity::kArea, [](double a) { return a / SqrMeter2SqrFeet(1.0, kUsSurvey); },
     [](double a) { return SqrMeter2SqrFeet(a, kUsSurvey); }, 4},
    {"ch2", Quantity::kArea, [](double a) { return SqureChains2SqureMeters(a, kInternational); },
     [](double a) { return SqureMeter2SqureChain(a, kInternational); }, 6},
    {"ch2-us", Quantity::kArea, [](double a) { return SqureChains2SqureMeters(a, kUsSurvey); },
     [](double a) { return SqureMeter2SqureChain(a, kUsSurvey); }, 6},
    {"acre", Quantity::kArea, acresToSquareMetres<kInternational>, squareMetresToAcres<kInternational>, 6},
    {"acre-us", Quantity::kArea, acresToSquareMetres<kUsSurvey>, squareMetresToAcres<kUsSurvey>, 6},

    {"m3", Quantity::kVolume, identity, identity, 4},
    {"yd3", Quantity::kVolume, [](double v) { return v / CubicMeter2CubicYards(1.0, kInternational); },
     [](double v) { return CubicMeter2CubicYards(v, kInternational); }, 4},
    {"yd3-us", Quantity::kVolume, [](double v) { return v / CubicMeter2CubicYards(1.0, kUsSurvey); },
     [](double v) { return CubicMeter2CubicYards(v, kUsSurvey); }, 4},
    {"ft3", Quantity::kVolume, [](double v) { return v / CubicMeter2CubicFeets(1.0, kInternational); },
     [](double v) { return CubicMeter2CubicFeets(v, kInternational); }, 4},
    {"ft3-us", Quantity::kVolume, [](double v) { return v / CubicMeter2CubicFeets(1.0, kUsSurvey); },
     [](double v) { return CubicMeter2CubicFeets(v, kUsSurvey); }, 4},
    {"ch3", Quantity::kVolume, [](double v) { return v / CubicMeter2CubicChain(1.0, kInternational); },
     [](double v) { return CubicMeter2CubicChain(v, kInternational); }, 8},
    {"ch3-us", Quantity::kVolume, [](double v) { return v / CubicMeter2CubicChain(1.0, kUsSurvey); },
     [](double v) { return CubicMeter2CubicChain(v, kUsSurvey); }, 8},

    {"hPa", Quantity::kPressure, identity, identity, 2},
    {"mmHg", Quantity::kPressure, mmHgTohPa, hPaTommHg, 2},
    {"inHg", Quantity::kPressure, inHgTohPa, hPaToinHg, 3},

    {"C", Quantity::kTemperature, identity, identity, 2},
    {"F", Quantity::kTemperature, FahrenheitToCelsius, CelsiusToFahrenheit, 2},
};

void addConvert(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("convert", "Convert values between units of one quantity, one per row");
  auto from = std::make_shared<std::string>();
  auto to = std::make_shared<std::string>();
  const std::vector<std::string> names = svy_tool::unitNames(kUnits);
  svy_tool::addUnitOption(*verb, "--from", *from, names, "Unit of the input values");
  svy_tool::addUnitOption(*verb, "--to", *to, names, "Unit of the output values");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input, from, to] {
    const Unit& source = svy_tool::unitNamed(kUnits, *from);
    const Unit& target = svy_tool::unitNamed(kUnits, *to);
    if (source.quantity != target.quantity) {
      throw CLI::ValidationError("cannot convert " + std::string(quantityName(source.quantity)) + " (" + *from +
                                 ") to " + quantityName(target.quantity) + " (" + *to + ")");
    }
    const svy_tool::RowFormat format{{"value"}, true, {{"value", target.decimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [&source, &target](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const double value = row.numbers[0];
          // The same unit is passed through: a round trip through the base would round the packed forms.
          const double result = &source == &target ? value : target.fromBase(source.toBase(value));
          if (!std::isfinite(result)) {
            error = "no finite value in " + std::string(target.name);
            return false;
          }
          out = {result};
          return true;
        }));
  });
}

}  // namespace

void registerUnitsVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("units", "Lengths, areas, volumes, pressures and temperatures");
  family->require_subcommand(1);
  addConvert(*family);
}
