// svy angle convert: known equivalents, the packed DDD.MMSS quirks, and round trips through every unit.
#include "svy_runner.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using svy_test::runSvy;

TEST(AngleConvert, KnownValuesQuirksAndRoundTrips) {
  struct Case {
    const char *from, *to, *text;
    double expected;
  };
  const Case cases[] = {
      {"deg", "rad", "90", 1.5707963267948966}, {"rad", "deg", "1.5707963267948966", 90.0},
      {"deg", "grad", "90", 100.0},             {"grad", "deg", "100", 90.0},
      {"deg", "mil", "90", 1600.0},             {"mil", "deg", "1600", 90.0},
      {"deg", "dms", "90", 90.0},               {"dms", "deg", "90", 90.0},
      // No reduction to one turn, except for the packed form.
      {"deg", "grad", "450", 500.0},            {"rad", "deg", "-7", -7.0 * 57.29577951308232},
      {"dms", "deg", "400.3000", 40.5},
  };
  for (const Case& c : cases) {
    const nlohmann::json r = svy_test::runJson({"angle", "convert", "--from", c.from, "--to", c.to}, c.text);
    EXPECT_NEAR(r.at(0).at("value").get<double>(), c.expected, 1e-11) << c.from << " -> " << c.to << ' ' << c.text;
  }
  // 12.9999999 degrees is 12 deg 59' 59.99964": rounded seconds stay below 60.
  EXPECT_EQ(runSvy({"angle", "convert", "--from", "deg", "--to", "dms"}, "12.9999999\n13.0\n").out,
            "value\n12.59599996\n13.00000000\n");
  const double degrees[] = {0.5, 123.456789, -45.25, 359.9999};
  for (const char* unit : {"rad", "grad", "mil", "dms"}) {
    const std::string there = runSvy({"--full-precision", "angle", "convert", "--from", "deg", "--to", unit},
                                     "0.5\n123.456789\n-45.25\n359.9999\n")
                                  .out;
    const nlohmann::json back = svy_test::runJson({"angle", "convert", "--from", unit, "--to", "deg"}, there);
    ASSERT_EQ(back.size(), 4u) << unit;
    // The packed form keeps seconds to 8 decimals (3e-12 degree).
    for (std::size_t i = 0; i < 4; ++i) EXPECT_NEAR(back[i]["value"].get<double>(), degrees[i], 1e-11) << unit;
  }
}

}  // namespace
