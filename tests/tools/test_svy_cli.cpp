// The svy command as a whole: input sources, output forms, one bad row per verb family, usage errors.
#include "svy_runner.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

using svy_test::runSvy;
using svy_test::SvyResult;

const std::string kInversePoints = "n1,e1,n2,e2\n0,0,3,4\n# a comment\n\n100,200,100,150\n";

TEST(SvyInput, FileAndStdinGiveTheSameRows) {
  const SvyResult fromStdin = runSvy({"cogo", "inverse"}, kInversePoints);
  EXPECT_EQ(fromStdin.exitStatus, 0) << fromStdin.err;
  EXPECT_EQ(fromStdin.lines().size(), 3u);
  EXPECT_EQ(runSvy({"cogo", "inverse", "-"}, kInversePoints).out, fromStdin.out);
  EXPECT_EQ(runSvy({"cogo", "inverse", svy_test::writeTempFile(kInversePoints)}).out, fromStdin.out);
  const SvyResult missing = runSvy({"cogo", "inverse", "/nonexistent/points.csv"});
  EXPECT_EQ(missing.exitStatus, 2);
  EXPECT_EQ(missing.err.rfind("svy: cannot open '/nonexistent/points.csv'", 0), 0u) << missing.err;
  EXPECT_EQ(runSvy({"cogo", "radiate"}, "").out, "n,e\n");
  EXPECT_EQ(runSvy({"--json", "cogo", "radiate"}, "# nothing\n").out, "[]\n");
}

TEST(SvyOutput, JsonObjectsKeyedByColumnAndWellFormedAroundBadRows) {
  const nlohmann::json rows = nlohmann::json::parse(runSvy({"--json", "cogo", "inverse"}, kInversePoints).out);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_DOUBLE_EQ(rows[0]["distance"].get<double>(), 5.0);
  EXPECT_EQ(rows[1]["azimuth_dms"].get<std::string>(), "270\xC2\xB0" "0'0.00\"");
  const SvyResult bad = runSvy({"--json", "cogo", "inverse"}, "0,0,3,4\nbad,row\n0,0,0,2\n");
  EXPECT_EQ(bad.exitStatus, 1);
  EXPECT_EQ(nlohmann::json::parse(bad.out).at(1)["distance"].get<double>(), 2.0);
}

TEST(SvyOutput, FullPrecisionReadsBackToTheSameDoubles) {
  const SvyResult out = runSvy({"--full-precision", "cogo", "radiate"}, "1000.123,2000.456,37.5,123.456789\n");
  ASSERT_EQ(out.exitStatus, 0) << out.err;
  const nlohmann::json back = svy_test::runJson({"cogo", "inverse"}, "1000.123,2000.456," + out.lines().at(1) + "\n");
  EXPECT_NEAR(back[0]["distance"].get<double>(), 123.456789, 1e-12);
  EXPECT_NEAR(back[0]["azimuth_deg"].get<double>(), 37.5, 1e-11);
  EXPECT_EQ(runSvy({"cogo", "radiate"}, "0,0,45,1\n").lines().at(1), "0.7071,0.7071");
}

// Per verb family: the header line, the same good row before and after two bad rows, the message for line 2.
TEST(SvyBadRows, ReportedWithLineNumbersWhileGoodRowsComeOut) {
  const char* const toGps = "week,seconds_of_week";
  const char* const cases[][4] = {
      {"cogo inverse", "0,0,3,4\n1,2,3\n", "azimuth_deg,azimuth_dms,distance", "expected 4 numbers, got 3"},
      {"cogo inverse", "0,0,3,4\n0,0,x,4\n", "azimuth_deg,azimuth_dms,distance", "n2: 'x' is not a number"},
      {"cogo inverse", "0,0,1,0\n0,0,1e308,1e308\n", "azimuth_deg,azimuth_dms,distance", ""},
      {"angle convert --from deg --to rad", "1\nabc\n", "value", "value: 'abc' is not a number"},
      {"units convert --from m --to ft", "1\n1,2\n", "value", "expected 1 number, got 2"},
      {"station format --interval 1", "5\n1e12\n", "chainage,text", ""},
      {"station parse --interval 1000", "1+200\n+5\n", "text,chainage", "'+5' is not a station"},
      {"geo to-ecef", "10,20,30\n91,0,0\n", "x,y,z", "latitude must lie within -90 to 90 degrees"},
      {"time to-gps", "2020-01-01T00:00:00\n2021-02-29T00:00:00\n", toGps, "no such date or time"},
      {"time to-gps", "2020-01-01T00:00:00\n1980-01-05T23:59:59.999\n", toGps, "times run from the GPS epoch"},
      {"time to-gps", "2020-01-01T00:00:00\n2100-01-01T00:00:00\n", toGps, "times run from the GPS epoch"},
      {"time to-gps", "2020-01-01T00:00:00\n2020-01-01T00:00:00.\n", toGps, "expected a time"},
      {"time from-gps", "2000,0\n1.5,0\n", "time,day_of_year", "the week must be a whole number"},
      {"time from-gps", "2000,0\n0,604800\n", "time,day_of_year", "seconds of week must lie in"},
      {"time from-gps", "2000,0\n6260,432000\n", "time,day_of_year", "times run to 2099-12-31"},
  };
  for (const auto& [args, input, header, message] : cases) {
    SCOPED_TRACE(std::string(args) + ": " + input);
    const std::string text = input;
    const SvyResult r =
        runSvy(svy_test::split(args, ' '), text + "a,b,c,d,e,f,g\n" + text.substr(0, text.find('\n') + 1));
    EXPECT_EQ(r.exitStatus, 1);
    const std::vector<std::string> out = r.lines();
    ASSERT_EQ(out.size(), 3u) << r.out;
    EXPECT_EQ(out[0], header);
    EXPECT_EQ(out[1], out[2]);
    ASSERT_GE(r.errLines().size(), 2u) << r.err;
    EXPECT_EQ(r.errLines()[0].rfind("svy: line 2: " + std::string(message), 0), 0u) << r.err;
  }
}

TEST(SvyUsage, OneLineErrorAndExitStatusTwo) {
  const char* const cases[][2] = {
      {"angle convert --from deg --to degrees", "unknown unit 'degrees'"},
      {"units convert --from furlong --to m", "unknown unit 'furlong'"},
      {"units convert --from m --to m2", "cannot convert length (m)"},
      {"units convert --from C --to hPa", "to pressure (hPa)"},
      {"station format", "--interval"}, {"station format --interval 0", "--interval"},
      {"cogo inverse --bogus", "--bogus"}, {"nosuchfamily", "subcommand"}, {"", "subcommand"}, {"cogo", "subcommand"},
      {"geo enu", "--origin"}, {"geo enu --origin 55,5", "--origin"}, {"geo enu --origin 55,5,x", "--origin"},
      {"geo enu --origin 95,5,0", "--origin"}, {"fit radius", "center"}, {"fit radius --center 1;2", "--center"},
      {"curve solve --radius 100", "give one more quantity"}, {"curve solve --delta 20", "give the radius"},
      {"curve solve --radius 100 --delta 20 --length 5", "excludes"},
      {"curve solve --radius 100 --deg-arc 3 --delta 20", "excludes"},
      {"curve solve --radius 100 --chord 250", "no circular curve of radius 100 has chord 250"},
      {"curve solve --radius 100 --mid-ordinate 250", "no circular curve"},
      {"curve solve --radius -5 --delta 20", "radius"},
      {"spiral table --type cubic --length 100 --radius 100 --interval 10", "no cubic spiral"},
      {"spiral table --length 100 --radius 300 --interval 1e-9", "interval"},
      {"spiral table --type bloss --length 100 --radius 300 --interval 1", "bloss"},
      {"spiral table --length 100 --radius 0 --interval 1", "radius"},
  };
  for (const auto& [args, message] : cases) {
    SCOPED_TRACE(args);
    const SvyResult r = runSvy(svy_test::split(args, ' '), "1,2,3\n");
    EXPECT_EQ(r.exitStatus, 2);
    EXPECT_EQ(r.out, "");
    EXPECT_EQ(r.errLines().size(), 1u) << r.err;
    EXPECT_EQ(r.err.rfind("svy: ", 0), 0u) << r.err;
    EXPECT_NE(r.err.find(message), std::string::npos) << r.err;
  }
  const SvyResult help = runSvy({"--help"});
  EXPECT_EQ(help.exitStatus, 0);
  for (const char* family : {"cogo", "angle", "station", "units", "curve", "spiral", "fit", "geo", "time"}) {
    EXPECT_NE(help.out.find(family), std::string::npos) << family;
  }
}

}  // namespace
