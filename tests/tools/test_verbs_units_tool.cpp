// svy units convert: published unit definitions, round trips within each quantity, and the deliberate
// asymmetries of the library's factors.
#include "svy_runner.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <string>
#include <utility>
#include <vector>

namespace {

using svy_test::runSvy;

double convert(const std::string& from, const std::string& to, const std::string& value) {
  const svy_test::SvyResult r =
      runSvy({"--json", "--full-precision", "units", "convert", "--from", from, "--to", to}, value + "\n");
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  return nlohmann::json::parse(r.out).at(0).at("value").get<double>();
}

struct Definition {
  const char* unit;
  const char* base;
  double baseValueOfOne;  // one unit in the base unit, from the unit's legal definition
  double relTol;
};

class UnitDefinition : public ::testing::TestWithParam<Definition> {};

TEST_P(UnitDefinition, OneUnitMatchesItsDefinition) {
  const Definition& c = GetParam();
  EXPECT_NEAR(convert(c.unit, c.base, "1"), c.baseValueOfOne, c.baseValueOfOne * c.relTol);
}

constexpr double kUsFoot = 1200.0 / 3937.0;
constexpr double kFoot = 0.3048;
INSTANTIATE_TEST_SUITE_P(
    Published, UnitDefinition,
    ::testing::Values(Definition{"ft", "m", kFoot, 1e-15}, Definition{"ft-us", "m", kUsFoot, 1e-15},
                      Definition{"ch", "m", 66 * kFoot, 1e-15}, Definition{"ch-us", "m", 66 * kUsFoot, 1e-15},
                      Definition{"ft2", "m2", kFoot * kFoot, 1e-6}, Definition{"ft2-us", "m2", kUsFoot * kUsFoot, 1e-6},
                      Definition{"ch2", "m2", 66 * 66 * kFoot * kFoot, 1e-12},
                      Definition{"acre", "m2", 4046.8564224, 1e-12},
                      // The library's acre factor for US survey square chains (0.1000004000012) maps them
                      // to the international acre, so both routes give the same area.
                      Definition{"acre-us", "m2", 4046.8564224, 1e-12},
                      Definition{"yd3", "m3", 27 * kFoot * kFoot * kFoot, 1e-6},
                      Definition{"ft3", "m3", kFoot * kFoot * kFoot, 1e-6},
                      Definition{"ft3-us", "m3", kUsFoot * kUsFoot * kUsFoot, 1e-6},
                      Definition{"ch3", "m3", 66 * 66 * 66 * kFoot * kFoot * kFoot, 1e-6},
                      Definition{"mmHg", "hPa", 1.33322387415, 1e-12},
                      Definition{"inHg", "hPa", 33.8639, 1e-12}));

// Every conversion passes through the base unit of its quantity, so each unit's pair of functions is
// covered by a trip from the base unit and back.
TEST(UnitRoundTrip, EveryUnitThereAndBackFromItsBase) {
  const std::vector<std::pair<std::string, std::vector<std::string>>> quantities = {
      {"m", {"ft", "ft-us", "ch", "ch-us"}},
      {"m2", {"ft2", "ft2-us", "ch2", "ch2-us", "acre", "acre-us"}},
      {"m3", {"yd3", "yd3-us", "ft3", "ft3-us", "ch3", "ch3-us"}},
      {"hPa", {"mmHg"}},
      {"C", {"F"}}};
  const std::string values = "1234.5678\n-0.001\n5e6\n";
  for (const auto& [base, units] : quantities) {
    for (const std::string& unit : units) {
      const svy_test::SvyResult there =
          runSvy({"--full-precision", "units", "convert", "--from", base, "--to", unit}, values);
      const svy_test::SvyResult back =
          runSvy({"--full-precision", "units", "convert", "--from", unit, "--to", base}, there.out);
      ASSERT_EQ(back.exitStatus, 0) << back.err;
      const std::vector<std::string> lines = back.lines();
      ASSERT_EQ(lines.size(), 4u) << unit;
      for (const auto& [line, value] : {std::pair{lines[1], 1234.5678}, {lines[2], -0.001}, {lines[3], 5e6}}) {
        EXPECT_NEAR(std::stod(line), value, std::fabs(value) * 1e-12) << base << " -> " << unit;
      }
    }
  }
}

TEST(UnitRoundTrip, PackedFeetInchesKeepTheNearestEighth) {
  // An eighth of an inch is 3.175 mm: a length read back from the packed form is within half of it.
  for (const char* unit : {"fin", "fin-us"}) {
    const svy_test::SvyResult there = runSvy({"units", "convert", "--from", "m", "--to", unit}, "0.5\n12.3456\n-250.01\n");
    const svy_test::SvyResult back =
        runSvy({"--full-precision", "units", "convert", "--from", unit, "--to", "m"}, there.out);
    ASSERT_EQ(back.exitStatus, 0) << back.err;
    const double expected[] = {0.5, 12.3456, -250.01};
    for (std::size_t i = 0; i < 3; ++i) {
      EXPECT_NEAR(std::stod(back.lines().at(i + 1)), expected[i], 0.0016) << unit << ' ' << expected[i];
    }
  }
}

TEST(UnitConvert, TemperaturesMeetAtMinusForty) {
  EXPECT_NEAR(convert("C", "F", "-40"), -40.0, 1e-12);
  EXPECT_NEAR(convert("F", "C", "212"), 100.0, 1e-12);
}

TEST(UnitConvert, InchesOfMercuryFactorsAreNotExactInverses) {
  // 0.02953 and 33.8639 are rounded independently: their product is 0.99999...
  const double there = convert("hPa", "inHg", "1013.25");
  EXPECT_NEAR(there, 1013.25 * 0.02953, 1e-12);
  const double back = convert("inHg", "hPa", std::to_string(there));
  EXPECT_NE(back, 1013.25);
  EXPECT_NEAR(back, 1013.25, 0.01);
}

TEST(UnitConvert, PackedFeetInchesFollowTheirFoot) {
  EXPECT_NEAR(convert("m", "fin", "1"), 3.033, 1e-12);  // 3.28084 ft = 3 ft 3 3/8 in
  EXPECT_NEAR(convert("fin-us", "ft-us", "5.073"), 5 + 7.375 / 12, 1e-12);
  // 10000 international feet are 9999.98 US survey feet: 9999 ft 11 in and 6.08 eighths, re-rounded.
  EXPECT_NEAR(convert("fin", "fin-us", "10000.000"), 9999.116, 1e-9);
}

TEST(UnitConvert, SameUnitPassesValuesThrough) {
  EXPECT_EQ(convert("fin", "fin", "5.089"), 5.089);
  EXPECT_EQ(convert("acre-us", "acre-us", "0.1"), 0.1);
}

}  // namespace
