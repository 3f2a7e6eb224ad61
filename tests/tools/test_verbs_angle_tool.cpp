// svy angle convert: known equivalents in every unit, round trips, and the packed DDD.MMSS quirks.
#include "svy_runner.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <string>

namespace {

using svy_test::runSvy;

double convert(const std::string& from, const std::string& to, const std::string& value) {
  const svy_test::SvyResult r =
      runSvy({"--json", "--full-precision", "angle", "convert", "--from", from, "--to", to}, value + "\n");
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  return nlohmann::json::parse(r.out).at(0).at("value").get<double>();
}

struct Equivalent {
  const char* unit;
  const char* quarterTurnText;  // 90 degrees in this unit, as typed
  double quarterTurn;
};

class AngleConvert : public ::testing::TestWithParam<Equivalent> {};

TEST_P(AngleConvert, QuarterTurnInEveryUnit) {
  const Equivalent& c = GetParam();
  EXPECT_NEAR(convert("deg", c.unit, "90"), c.quarterTurn, 1e-12);
  EXPECT_NEAR(convert(c.unit, "deg", c.quarterTurnText), 90.0, 1e-12);
}

INSTANTIATE_TEST_SUITE_P(Units, AngleConvert,
                         ::testing::Values(Equivalent{"rad", "1.5707963267948966", 1.5707963267948966},
                                           Equivalent{"grad", "100", 100.0}, Equivalent{"mil", "1600", 1600.0},
                                           Equivalent{"dms", "90", 90.0}, Equivalent{"deg", "90", 90.0}));

TEST(AngleConvert, RoundTripsThroughEveryUnit) {
  const char* units[] = {"rad", "grad", "mil", "dms"};
  for (const char* unit : units) {
    for (const char* degrees : {"0.5", "123.456789", "-45.25", "359.9999"}) {
      const svy_test::SvyResult there =
          runSvy({"--full-precision", "angle", "convert", "--from", "deg", "--to", unit}, std::string(degrees) + "\n");
      const svy_test::SvyResult back = runSvy({"--full-precision", "angle", "convert", "--from", unit, "--to", "deg"},
                                              there.out);
      ASSERT_EQ(back.exitStatus, 0) << back.err;
      // The packed form keeps seconds to 8 decimals (3e-12 degree); the others are plain products.
      EXPECT_NEAR(std::stod(back.lines().at(1)), std::stod(degrees), 1e-11) << unit << ' ' << degrees;
    }
  }
}

TEST(AngleConvert, PackedOutputRoundsWholeSecondsWithoutReachingSixty) {
  // 12.9999999 degrees is 12 deg 59' 59.99964": at 4 decimals of seconds it stays below 13.
  const svy_test::SvyResult r = runSvy({"angle", "convert", "--from", "deg", "--to", "dms"}, "12.9999999\n13.0\n");
  EXPECT_EQ(r.lines().at(1), "12.59599996");
  EXPECT_EQ(r.lines().at(2), "13.00000000");
}

TEST(AngleConvert, NoReductionToOneTurnExceptThePackedForm) {
  EXPECT_NEAR(convert("deg", "grad", "450"), 500.0, 1e-12);
  EXPECT_NEAR(convert("rad", "deg", "-7"), -7.0 * 57.29577951308232, 1e-11);
  EXPECT_NEAR(convert("dms", "deg", "400.3000"), 40.5, 1e-12);
}

}  // namespace
