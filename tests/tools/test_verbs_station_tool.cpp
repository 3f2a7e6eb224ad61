// svy station format and parse: the station text form with its sign and rounding quirks, and the round trip.
#include "svy_runner.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace {

using svy_test::runSvy;

struct StationText {
  const char* chainage;
  double interval;
  const char* text;
};

class StationFormat : public ::testing::TestWithParam<StationText> {};

TEST_P(StationFormat, WritesCountPlusRemainder) {
  const StationText& c = GetParam();
  const svy_test::SvyResult r =
      runSvy({"station", "format", "--interval", std::to_string(c.interval)}, std::string(c.chainage) + "\n");
  ASSERT_EQ(r.exitStatus, 0) << r.err;
  EXPECT_EQ(svy_test::splitCsvLine(r.lines().at(1)).at(1), c.text);
}

INSTANTIATE_TEST_SUITE_P(
    Texts, StationFormat,
    ::testing::Values(StationText{"1234.567", 1000, "1+234.57"},
                      StationText{"1005.3", 1000, "1+5.30"},          // remainder not zero-padded
                      StationText{"-1234.5", 1000, "-1+-234.50"},     // both parts carry the sign
                      StationText{"999.999", 1000, "0+1000.00"},      // rounding without carry
                      StationText{"1234.567", 100, "12+34.57"}, StationText{"0", 100, "0+0.00"}));

TEST(StationRoundTrip, FormattedTextsParseBackToTheChainage) {
  const std::vector<double> chainages = {0.0, 12.345, 999.994, 1005.3, 25000.125, -1234.5, -0.25, 7777.777};
  std::string input;
  for (double c : chainages) input += std::to_string(c) + "\n";
  for (const char* interval : {"1000", "100", "20"}) {
    const svy_test::SvyResult formatted = runSvy({"station", "format", "--interval", interval}, input);
    ASSERT_EQ(formatted.exitStatus, 0) << formatted.err;
    std::string texts = "text\n";
    const std::vector<std::string> lines = formatted.lines();
    for (std::size_t i = 1; i < lines.size(); ++i) texts += svy_test::splitCsvLine(lines[i]).at(1) + "\n";
    const svy_test::SvyResult parsed = runSvy({"station", "parse", "--interval", interval}, texts);
    ASSERT_EQ(parsed.exitStatus, 0) << parsed.err;
    const std::vector<std::string> back = parsed.lines();
    ASSERT_EQ(back.size(), chainages.size() + 1);
    for (std::size_t i = 0; i < chainages.size(); ++i) {
      // The text keeps the remainder to 0.01 m.
      EXPECT_NEAR(std::stod(svy_test::splitCsvLine(back[i + 1]).at(1)), chainages[i], 0.005 + 1e-9)
          << interval << ' ' << chainages[i];
    }
  }
}

TEST(StationParse, PlainNumbersAndCommaDecimalsAreChainages) {
  const svy_test::SvyResult r = runSvy({"station", "parse", "--interval", "1000"}, "1234.5\n\"1,5\"\n  2+3 m\n");
  ASSERT_EQ(r.exitStatus, 0) << r.err;
  EXPECT_EQ(r.lines(), (std::vector<std::string>{"text,chainage", "1234.5,1234.5000", "\"1,5\",1.5000",
                                                 "2+3 m,2003.0000"}));
}

TEST(StationParse, UnreadableTextsAreBadRowsOthersComeOut) {
  const svy_test::SvyResult r = runSvy({"station", "parse", "--interval", "1000"},
                                       "1+200\n1+\n# skipped\n+5\nstation 4\n-1+-234.50\n");
  EXPECT_EQ(r.exitStatus, 1);
  EXPECT_EQ(r.lines(), (std::vector<std::string>{"text,chainage", "1+200,1200.0000", "-1+-234.50,-1234.5000"}));
  EXPECT_EQ(r.errLines(), (std::vector<std::string>{"svy: line 2: '1+' is not a station",
                                                    "svy: line 4: '+5' is not a station",
                                                    "svy: line 5: 'station 4' is not a station"}));
}

TEST(StationFormat, ChainageBeyondTheIntervalCountIsABadRow) {
  const svy_test::SvyResult r = runSvy({"station", "format", "--interval", "1"}, "1e12\n5\n");
  EXPECT_EQ(r.exitStatus, 1);
  EXPECT_EQ(r.lines().size(), 2u);
  EXPECT_EQ(r.errLines().size(), 1u);
}

}  // namespace
