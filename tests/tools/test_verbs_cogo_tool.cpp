// svy cogo inverse and radiate: quadrant azimuths with their DMS text, and radiate-then-inverse round trips.
#include "svy_runner.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>

namespace {

using svy_test::csvRow;
using svy_test::runJson;

// From (1000, 2000): azimuth clockwise from north in [0, 360), never negative; coincident points give zero.
TEST(CogoInverse, AzimuthClockwiseFromNorthWithDmsText) {
  struct Case {
    double dn, de, azimuthDeg;
    const char* dms;
  };
  const Case cases[] = {{10, 0, 0.0, "0\xC2\xB0" "0'0.00"},
                        {0, 10, 90.0, "90\xC2\xB0" "0'0.00"},
                        {-10, 0, 180.0, "180\xC2\xB0" "0'0.00"},
                        {0, -10, 270.0, "270\xC2\xB0" "0'0.00"},
                        {6, 8, 53.130102354155978, "53\xC2\xB0" "7'48.37"},  // atan2(4, 3)
                        {-6, -8, 233.13010235415598, "233\xC2\xB0" "7'48.37"},
                        {6, -8, 306.86989764584402, "306\xC2\xB0" "52'11.63"},
                        {10, -1e-6, 359.99999427042211, "359\xC2\xB0" "59'59.98"},
                        {0, 0, 0.0, "0\xC2\xB0" "0'0.00"}};
  for (const Case& c : cases) {
    const std::string row = csvRow({1000, 2000, 1000 + c.dn, 2000 + c.de});
    const nlohmann::json r = runJson({"cogo", "inverse"}, row);
    EXPECT_NEAR(r.at(0)["azimuth_deg"].get<double>(), c.azimuthDeg, 1e-9) << row;
    EXPECT_NEAR(r.at(0)["distance"].get<double>(), std::hypot(c.dn, c.de), 1e-9) << row;
    EXPECT_EQ(svy_test::splitCsvLine(svy_test::runSvy({"cogo", "inverse"}, row).lines().at(1)).at(1),
              std::string("\"") + c.dms + "\"\"\"");
  }
}

// A traverse at grid coordinates radiated leg by leg, then inverted back: every leg is recovered. An azimuth
// of 450 degrees is reduced to 90.
TEST(CogoRoundTrip, InverseOfRadiatedTraverseRecoversLegs) {
  const double legs[][2] = {{12.5, 150.0}, {97.25, 80.125}, {181.0, 133.3}, {265.75, 42.0}, {450.0, 61.0}};
  double n = 5000000.0, e = 500000.0;
  std::string inverseRows;
  for (const auto& leg : legs) {
    const nlohmann::json p = runJson({"cogo", "radiate"}, csvRow({n, e, leg[0], leg[1]}));
    inverseRows += csvRow({n, e, p.at(0)["n"].get<double>(), p.at(0)["e"].get<double>()});
    n = p.at(0)["n"].get<double>();
    e = p.at(0)["e"].get<double>();
  }
  const nlohmann::json back = runJson({"cogo", "inverse"}, inverseRows);
  ASSERT_EQ(back.size(), std::size(legs));
  for (std::size_t i = 0; i < std::size(legs); ++i) {
    // 1e-8 m on 5e6 m coordinates is a few units in the last place.
    EXPECT_NEAR(back[i]["distance"].get<double>(), legs[i][1], 1e-8) << i;
    EXPECT_NEAR(back[i]["azimuth_deg"].get<double>(), std::fmod(legs[i][0], 360.0), 1e-8) << i;
  }
}

}  // namespace
