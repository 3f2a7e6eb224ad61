// svy cogo inverse and radiate: quadrant azimuths, DMS text, and the round trip between the two verbs.
#include "svy_runner.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <iterator>
#include <sstream>
#include <string>

namespace {

using svy_test::runSvy;

nlohmann::json runJson(const std::vector<std::string>& args, const std::string& input) {
  std::vector<std::string> all = {"--json", "--full-precision"};
  all.insert(all.end(), args.begin(), args.end());
  const svy_test::SvyResult r = runSvy(all, input);
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  return nlohmann::json::parse(r.out);
}

struct InverseCase {
  double n2, e2;
  double azimuthDeg;
  const char* dms;
};

class CogoInverse : public ::testing::TestWithParam<InverseCase> {};

// From (1000, 2000) to a point 10 m away: azimuth clockwise from north in [0, 360), never negative.
TEST_P(CogoInverse, AzimuthClockwiseFromNorth) {
  const InverseCase& c = GetParam();
  std::ostringstream row;
  row.precision(17);
  row << "1000,2000," << 1000.0 + c.n2 << ',' << 2000.0 + c.e2 << '\n';
  const nlohmann::json rows = runJson({"cogo", "inverse"}, row.str());
  ASSERT_EQ(rows.size(), 1u);
  EXPECT_NEAR(rows[0]["azimuth_deg"].get<double>(), c.azimuthDeg, 1e-9);
  EXPECT_NEAR(rows[0]["distance"].get<double>(), std::hypot(c.n2, c.e2), 1e-9);
  const svy_test::SvyResult csv = runSvy({"cogo", "inverse"}, row.str());
  EXPECT_EQ(svy_test::splitCsvLine(csv.lines().at(1)).at(1), std::string("\"") + c.dms + "\"\"\"");
}

INSTANTIATE_TEST_SUITE_P(
    Quadrants, CogoInverse,
    ::testing::Values(InverseCase{10, 0, 0.0, "0\xC2\xB0" "0'0.00"}, InverseCase{0, 10, 90.0, "90\xC2\xB0" "0'0.00"},
                      InverseCase{-10, 0, 180.0, "180\xC2\xB0" "0'0.00"},
                      InverseCase{0, -10, 270.0, "270\xC2\xB0" "0'0.00"},
                      // 3-4-5 triangle: atan2(4, 3) = 53.130102354155978 deg = 53 deg 07' 48.368"
                      InverseCase{6, 8, 53.130102354155978, "53\xC2\xB0" "7'48.37"},
                      InverseCase{-6, -8, 233.13010235415598, "233\xC2\xB0" "7'48.37"},
                      InverseCase{6, -8, 306.86989764584402, "306\xC2\xB0" "52'11.63"},
                      // Just west of north: close to 360 but below it.
                      InverseCase{10, -1e-6, 359.99999427042211, "359\xC2\xB0" "59'59.98"}));

TEST(CogoInverse, CoincidentPointsGiveZeroAzimuthAndDistance) {
  const nlohmann::json rows = runJson({"cogo", "inverse"}, "5,5,5,5\n");
  EXPECT_EQ(rows[0]["azimuth_deg"].get<double>(), 0.0);
  EXPECT_EQ(rows[0]["distance"].get<double>(), 0.0);
}

TEST(CogoInverse, OverflowingDistanceIsABadRow) {
  const svy_test::SvyResult r = runSvy({"cogo", "inverse"}, "0,0,1e308,1e308\n0,0,1,0\n");
  EXPECT_EQ(r.exitStatus, 1);
  EXPECT_EQ(r.lines().size(), 2u);
  EXPECT_EQ(r.errLines().at(0).rfind("svy: line 1: ", 0), 0u) << r.err;
}

TEST(CogoRadiate, MovesAlongTheAzimuth) {
  const nlohmann::json rows = runJson({"cogo", "radiate"}, "100,200,0,10\n100,200,90,10\n100,200,450,10\n");
  EXPECT_EQ(rows[0]["n"].get<double>(), 110.0);
  EXPECT_EQ(rows[0]["e"].get<double>(), 200.0);
  EXPECT_NEAR(rows[1]["n"].get<double>(), 100.0, 1e-12);
  EXPECT_EQ(rows[1]["e"].get<double>(), 210.0);
  // 450 degrees is reduced to 90 before conversion to radians.
  EXPECT_EQ(rows[2]["e"].get<double>(), rows[1]["e"].get<double>());
}

// A closed traverse: radiating each leg from the previous point and inverting back recovers every leg, and
// the traverse closes on its start.
TEST(CogoRoundTrip, InverseOfRadiatedTraverseRecoversLegs) {
  const double legs[][2] = {{12.5, 150.0}, {97.25, 80.125}, {181.0, 133.3}, {265.75, 42.0}, {300.5, 61.0}};
  std::ostringstream radiateInput;
  radiateInput.precision(17);
  double n = 5000000.0;  // grid-sized coordinates, where digits are easily lost
  double e = 500000.0;
  std::ostringstream inverseInput;
  inverseInput.precision(17);
  for (const auto& leg : legs) {
    const nlohmann::json p = runJson({"cogo", "radiate"}, [&] {
      std::ostringstream row;
      row.precision(17);
      row << n << ',' << e << ',' << leg[0] << ',' << leg[1] << '\n';
      return row.str();
    }());
    const double n2 = p[0]["n"].get<double>();
    const double e2 = p[0]["e"].get<double>();
    inverseInput << n << ',' << e << ',' << n2 << ',' << e2 << '\n';
    n = n2;
    e = e2;
  }
  const nlohmann::json back = runJson({"cogo", "inverse"}, inverseInput.str());
  ASSERT_EQ(back.size(), std::size(legs));
  for (std::size_t i = 0; i < std::size(legs); ++i) {
    // 1e-9 m on 5e6 m coordinates is a few units in the last place.
    EXPECT_NEAR(back[i]["distance"].get<double>(), legs[i][1], 1e-8) << i;
    EXPECT_NEAR(back[i]["azimuth_deg"].get<double>(), legs[i][0], 1e-8) << i;
  }
}

}  // namespace
