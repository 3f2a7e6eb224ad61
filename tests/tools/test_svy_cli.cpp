// The svy command as a whole: input sources, header lines, output forms, bad rows and usage errors.
#include "svy_runner.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <string>
#include <vector>

namespace {

using svy_test::runSvy;
using svy_test::SvyResult;

const std::string kInversePoints = "n1,e1,n2,e2\n0,0,3,4\n# a comment\n\n100,200,100,150\n";

TEST(SvyInput, FileAndStdinGiveTheSameRows) {
  const SvyResult fromStdin = runSvy({"cogo", "inverse"}, kInversePoints);
  const SvyResult fromDash = runSvy({"cogo", "inverse", "-"}, kInversePoints);
  const SvyResult fromFile = runSvy({"cogo", "inverse", svy_test::writeTempFile(kInversePoints)});
  EXPECT_EQ(fromStdin.exitStatus, 0) << fromStdin.err;
  EXPECT_EQ(fromStdin.lines().size(), 3u);
  EXPECT_EQ(fromFile.exitStatus, 0) << fromFile.err;
  EXPECT_EQ(fromFile.out, fromStdin.out);
  EXPECT_EQ(fromDash.out, fromStdin.out);
}

TEST(SvyInput, MissingFileIsAUsageError) {
  const SvyResult r = runSvy({"cogo", "inverse", "/nonexistent/points.csv"});
  EXPECT_EQ(r.exitStatus, 2);
  EXPECT_EQ(r.out, "");
  ASSERT_EQ(r.errLines().size(), 1u);
  EXPECT_EQ(r.errLines()[0].rfind("svy: cannot open '/nonexistent/points.csv'", 0), 0u) << r.err;
}

TEST(SvyInput, EmptyInputGivesHeaderOnly) {
  EXPECT_EQ(runSvy({"cogo", "radiate"}, "").out, "n,e\n");
  EXPECT_EQ(runSvy({"--json", "cogo", "radiate"}, "# nothing\n").out, "[]\n");
}

TEST(SvyBadRows, ReportedWithLineNumbersWhileGoodRowsComeOut) {
  const std::string input = "n1,e1,n2,e2\n0,0,3,4\n1,2,3\n\n0,0,x,4\n0,0,-3,-4\n";
  const SvyResult r = runSvy({"cogo", "inverse"}, input);
  EXPECT_EQ(r.exitStatus, 1);
  const std::vector<std::string> out = r.lines();
  ASSERT_EQ(out.size(), 3u) << r.out;
  EXPECT_EQ(out[0], "azimuth_deg,azimuth_dms,distance");
  EXPECT_EQ(svy_test::splitCsvLine(out[1]).back(), "5.0000");
  EXPECT_EQ(svy_test::splitCsvLine(out[2]).front(), "233.13010235");
  EXPECT_EQ(r.errLines(), (std::vector<std::string>{"svy: line 3: expected 4 numbers, got 3",
                                                    "svy: line 5: n2: 'x' is not a number"}));
}

TEST(SvyBadRows, JsonStaysWellFormedAroundBadRows) {
  const SvyResult r = runSvy({"--json", "cogo", "inverse"}, "0,0,3,4\nbad,row\n0,0,0,2\n");
  EXPECT_EQ(r.exitStatus, 1);
  const nlohmann::json rows = nlohmann::json::parse(r.out);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[1]["distance"].get<double>(), 2.0);
}

TEST(SvyOutput, JsonObjectsKeyedByColumn) {
  const SvyResult r = runSvy({"cogo", "inverse", "--json"}, kInversePoints);
  ASSERT_EQ(r.exitStatus, 0) << r.err;
  const nlohmann::json rows = nlohmann::json::parse(r.out);
  ASSERT_TRUE(rows.is_array());
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_DOUBLE_EQ(rows[0]["distance"].get<double>(), 5.0);
  EXPECT_DOUBLE_EQ(rows[0]["azimuth_deg"].get<double>(), 53.13010235);
  EXPECT_EQ(rows[1]["azimuth_dms"].get<std::string>(), "270\xC2\xB0" "0'0.00\"");
}

TEST(SvyOutput, FullPrecisionReadsBackToTheSameDoubles) {
  // Radiate a point, then feed the written coordinates to inverse: with 17 digits nothing is lost, so the
  // distance comes back to the last bits.
  const SvyResult out = runSvy({"--full-precision", "cogo", "radiate"}, "1000.123,2000.456,37.5,123.456789\n");
  ASSERT_EQ(out.exitStatus, 0) << out.err;
  const std::string point = out.lines().at(1);
  const SvyResult back = runSvy({"--full-precision", "--json", "cogo", "inverse"}, "1000.123,2000.456," + point + "\n");
  const nlohmann::json rows = nlohmann::json::parse(back.out);
  EXPECT_NEAR(rows[0]["distance"].get<double>(), 123.456789, 1e-12);
  EXPECT_NEAR(rows[0]["azimuth_deg"].get<double>(), 37.5, 1e-11);
  // Fixed decimals lose digits instead.
  EXPECT_EQ(runSvy({"cogo", "radiate"}, "0,0,45,1\n").lines().at(1), "0.7071,0.7071");
}

struct UsageCase {
  std::vector<std::string> args;
  std::string message;
};

class SvyUsage : public ::testing::TestWithParam<UsageCase> {};

TEST_P(SvyUsage, OneLineErrorAndNonZeroExit) {
  const SvyResult r = runSvy(GetParam().args, "1\n");
  EXPECT_EQ(r.exitStatus, 2);
  EXPECT_EQ(r.out, "");
  ASSERT_EQ(r.errLines().size(), 1u) << r.err;
  EXPECT_NE(r.err.find(GetParam().message), std::string::npos) << r.err;
  EXPECT_EQ(r.err.rfind("svy: ", 0), 0u) << r.err;
}

INSTANTIATE_TEST_SUITE_P(
    Cases, SvyUsage,
    ::testing::Values(UsageCase{{"angle", "convert", "--from", "deg", "--to", "degrees"}, "unknown unit 'degrees'"},
                      UsageCase{{"units", "convert", "--from", "furlong", "--to", "m"}, "unknown unit 'furlong'"},
                      UsageCase{{"units", "convert", "--from", "m", "--to", "m2"}, "cannot convert length (m)"},
                      UsageCase{{"units", "convert", "--from", "C", "--to", "hPa"}, "to pressure (hPa)"},
                      UsageCase{{"station", "format"}, "--interval"},
                      UsageCase{{"station", "format", "--interval", "0"}, "--interval"},
                      UsageCase{{"cogo", "inverse", "--bogus"}, "--bogus"}, UsageCase{{"nosuchfamily"}, "subcommand"},
                      UsageCase{{}, "subcommand"}, UsageCase{{"cogo"}, "subcommand"}));

TEST(SvyHelp, ListsTheFamiliesAndExitsZero) {
  const SvyResult r = runSvy({"--help"});
  EXPECT_EQ(r.exitStatus, 0);
  for (const char* family : {"cogo", "angle", "station", "units"}) {
    EXPECT_NE(r.out.find(family), std::string::npos) << family;
  }
}

}  // namespace
