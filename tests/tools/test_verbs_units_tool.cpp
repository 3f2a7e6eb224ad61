// svy units convert: published unit definitions, the deliberate asymmetries of the factors, and round trips.
#include "svy_runner.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace {

using svy_test::runSvy;

double convert(const std::string& from, const std::string& to, const std::string& value) {
  const nlohmann::json rows = svy_test::runJson({"units", "convert", "--from", from, "--to", to}, value + "\n");
  return rows.at(0).at("value").get<double>();
}

TEST(UnitConvert, PublishedDefinitionsAndQuirks) {
  constexpr double kFt = 0.3048;
  constexpr double kUsFt = 1200.0 / 3937.0;
  struct Case {
    const char *from, *to, *text;
    double expected, relTol;
  };
  const Case cases[] = {
      {"ft", "m", "1", kFt, 1e-15}, {"ft-us", "m", "1", kUsFt, 1e-15}, {"ch", "m", "1", 66 * kFt, 1e-15},
      {"ch-us", "m", "1", 66 * kUsFt, 1e-15}, {"ft2", "m2", "1", kFt * kFt, 1e-6},
      {"ft2-us", "m2", "1", kUsFt * kUsFt, 1e-6}, {"ch2", "m2", "1", 66 * 66 * kFt * kFt, 1e-12},
      // The US survey acre factor maps to the international acre: both routes give one area.
      {"acre", "m2", "1", 4046.8564224, 1e-12}, {"acre-us", "m2", "1", 4046.8564224, 1e-12},
      {"yd3", "m3", "1", 27 * kFt * kFt * kFt, 1e-6}, {"ft3", "m3", "1", kFt * kFt * kFt, 1e-6},
      {"ft3-us", "m3", "1", kUsFt * kUsFt * kUsFt, 1e-6}, {"ch3", "m3", "1", 66 * 66 * 66 * kFt * kFt * kFt, 1e-6},
      {"mmHg", "hPa", "1", 1.33322387415, 1e-12}, {"inHg", "hPa", "1", 33.8639, 1e-12},
      {"hPa", "inHg", "1013.25", 1013.25 * 0.02953, 1e-15},  // not the inverse of 33.8639
      {"C", "F", "-40", -40.0, 1e-15}, {"F", "C", "212", 100.0, 1e-15},
      {"m", "fin", "1", 3.033, 1e-15},  // 3.28084 ft = 3 ft 3 3/8 in
      {"fin-us", "ft-us", "5.073", 5 + 7.375 / 12, 1e-15},
      // 10000 international feet are 9999.98 US survey feet: 9999 ft 11 in and 6.08 eighths, re-rounded.
      {"fin", "fin-us", "10000.000", 9999.116, 1e-13},
      {"fin", "fin", "5.089", 5.089, 0.0}, {"acre-us", "acre-us", "0.1", 0.1, 0.0},  // passed through unrounded
  };
  for (const Case& c : cases) {
    EXPECT_NEAR(convert(c.from, c.to, c.text), c.expected, std::fabs(c.expected) * c.relTol) << c.from << ' ' << c.to;
  }
  const double back = convert("inHg", "hPa", std::to_string(convert("hPa", "inHg", "1013.25")));
  EXPECT_NE(back, 1013.25);
  EXPECT_NEAR(back, 1013.25, 0.01);
}

// Every conversion passes through the base unit of its quantity: a trip from the base and back covers each
// unit's pair of factors. The packed feet-inches forms keep the nearest eighth of an inch (3.175 mm).
TEST(UnitConvert, EveryUnitThereAndBackFromItsBase) {
  const std::vector<std::pair<std::string, std::vector<std::string>>> quantities = {
      {"m", {"ft", "ft-us", "ch", "ch-us", "fin", "fin-us"}},
      {"m2", {"ft2", "ft2-us", "ch2", "ch2-us", "acre", "acre-us"}},
      {"m3", {"yd3", "yd3-us", "ft3", "ft3-us", "ch3", "ch3-us"}},
      {"hPa", {"mmHg"}},
      {"C", {"F"}}};
  const double values[] = {1234.5678, -0.001, 5e6};
  for (const auto& [base, units] : quantities) {
    for (const std::string& unit : units) {
      const bool packed = unit.rfind("fin", 0) == 0;
      const char* precision = packed ? "-" : "--full-precision";  // "-" reads stdin, written to 1/8 in
      const std::string there =
          runSvy({"units", "convert", "--from", base, "--to", unit, precision}, "1234.5678\n-0.001\n5e6\n").out;
      const nlohmann::json back = svy_test::runJson({"units", "convert", "--from", unit, "--to", base}, there);
      ASSERT_EQ(back.size(), 3u) << unit;
      for (std::size_t i = 0; i < 3; ++i) {
        EXPECT_NEAR(back[i]["value"].get<double>(), values[i], packed ? 0.0016 : std::fabs(values[i]) * 1e-12)
            << base << " -> " << unit;
      }
    }
  }
}

}  // namespace
