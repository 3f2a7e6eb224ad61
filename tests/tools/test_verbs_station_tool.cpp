// svy station format and parse: the station text with its sign and rounding quirks, and the round trip.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "svy_runner.h"

namespace {

using svy_test::runSvy;

TEST(StationText, FormatAndParseQuirks) {
  struct Case {
    const char* verb;
    const char* interval;
    const char* input;
    const char* output;  // the written row
  };
  const Case cases[] = {
      {"format", "1000", "1234.567", "1234.5670,1+234.57"},
      {"format", "1000", "1005.3", "1005.3000,1+5.30"},        // remainder not zero-padded
      {"format", "1000", "-1234.5", "-1234.5000,-1+-234.50"},  // both parts carry the sign
      {"format", "1000", "999.999", "999.9990,0+1000.00"},     // rounding without carry
      {"format", "100", "1234.567", "1234.5670,12+34.57"},
      {"parse", "1000", "1234.5", "1234.5,1234.5000"},  // plain numbers are chainages
      {"parse", "1000", "\"1,5\"", "\"1,5\",1.5000"},   // and so are comma decimals
      {"parse", "1000", "  2+3 m", "2+3 m,2003.0000"},
      {"parse", "1000", "-1+-234.50", "-1+-234.50,-1234.5000"},
  };
  for (const Case& c : cases) {
    const svy_test::SvyResult r = runSvy({"station", c.verb, "--interval", c.interval}, std::string(c.input) + "\n");
    EXPECT_EQ(r.exitStatus, 0) << r.err;
    EXPECT_EQ(r.lines().at(1), c.output) << c.verb << ' ' << c.input;
  }
}

TEST(StationRoundTrip, FormattedTextsParseBackToTheChainage) {
  const std::vector<double> chainages = {0.0, 12.345, 999.994, 1005.3, 25000.125, -1234.5, -0.25, 7777.777};
  std::string input;
  for (double c : chainages) input += std::to_string(c) + "\n";
  for (const char* interval : {"1000", "100", "20"}) {
    const std::vector<std::string> formatted = runSvy({"station", "format", "--interval", interval}, input).lines();
    std::string texts;
    for (std::size_t i = 1; i < formatted.size(); ++i) texts += svy_test::splitCsvLine(formatted[i]).at(1) + "\n";
    const nlohmann::json back = svy_test::runJson({"station", "parse", "--interval", interval}, texts);
    ASSERT_EQ(back.size(), chainages.size());
    for (std::size_t i = 0; i < chainages.size(); ++i) {
      // The text keeps the remainder to 0.01 m.
      EXPECT_NEAR(back[i]["chainage"].get<double>(), chainages[i], 0.005 + 1e-9) << interval << ' ' << chainages[i];
    }
  }
}

}  // namespace
