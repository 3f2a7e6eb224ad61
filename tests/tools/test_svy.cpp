// The svy command: input sources, output forms and errors, then the verbs one by one with known and
// published values, deliberate quirks, and round trips between verbs.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <ctime>
#include <string>
#include <vector>

#include "svy_runner.h"
#include "svymath/curves/curve_data_spiral1r.h"
#include "svymath/curves/curve_formulas.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_test::csvRow;
using svy_test::examplesPath;
using svy_test::runJson;
using svy_test::runSvy;
using svy_test::splitCsvLine;
using svy_test::SvyResult;

// The command as a whole: input sources, output forms, one bad row per verb family, usage errors.

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
      {"units convert --from m --to m2", "cannot convert length (m)"}, {"station format", "--interval"},
      {"station format --interval 0", "--interval"}, {"cogo inverse --bogus", "--bogus"},
      {"nosuchfamily", "subcommand"}, {"", "subcommand"}, {"cogo", "subcommand"}, {"geo enu", "--origin"},
      {"geo enu --origin 55,5", "--origin"}, {"geo enu --origin 95,5,0", "--origin"}, {"fit radius", "center"},
      {"fit radius --center 1;2", "--center"}, {"curve solve --radius 100", "give one more quantity"},
      {"curve solve --delta 20", "give the radius"}, {"curve solve --radius 100 --delta 20 --length 5", "excludes"},
      {"curve solve --radius 100 --chord 250", "no circular curve of radius 100 has chord 250"},
      {"curve solve --radius 100 --mid-ordinate 250", "no circular curve"},
      {"curve solve --radius -5 --delta 20", "radius"},
      {"spiral table --type cubic --length 100 --radius 100 --interval 10", "no cubic spiral"},
      {"spiral table --length 100 --radius 300 --interval 1e-9", "interval"},
      {"spiral table --type bloss --length 100 --radius 300 --interval 1", "bloss"},
      {"spiral table --length 100 --radius 0 --interval 1", "radius"},
      {"profile height", "--pvi"}, {"profile height --pvi 0,100", "at least two"},
      {"profile height --pvi 0,100 --pvi 50", "CH,H[,L]"},
      {"profile height --pvi 0,100 --pvi 100,101,150 --pvi 150,100", "must not overlap"},
      {"road catch", "--cut, --fill"}, {"road catch --cut -2", "--cut"},
      {"cogo intersect --mode xy", "--mode"}, {"traverse adjust", "--start"}, {"traverse adjust --start 1", "--start"},
      {"traverse adjust --start 0,0 --rule simple", "--rule"},
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
  for (const char* family : {"cogo", "angle", "station", "units", "curve", "spiral", "fit", "geo", "time",
                             "traverse", "view", "profile", "road"}) {
    EXPECT_NE(help.out.find(family), std::string::npos) << family;
  }
}

// svy profile height: on the grades the line through the points; at a point with a parabola of length L the
// grade change g2 - g1 lowers the height by the middle ordinate L (g1 - g2) / 800; outside a bad row.
TEST(ProfileHeight, GradesAndMiddleOrdinates) {
  const SvyResult r = runSvy({"profile", "height", "--pvi", "1000,50", "--pvi", "1200,56,120", "--pvi", "1500,47"},
                             "chainage\n1000\n1100\n1200\n1350\n1500\n1500.5\n");
  EXPECT_EQ(r.exitStatus, 1);
  EXPECT_EQ(r.out, "chainage,height,grade_pct\n1000.0000,50.0000,3.0000\n1100.0000,53.0000,3.0000\n"
                   "1200.0000,55.1000,0.0000\n1350.0000,51.5000,-3.0000\n1500.0000,47.0000,-3.0000\n");
  EXPECT_EQ(r.errLines(),
            std::vector<std::string>{"svy: line 7: chainage 1500.5000 lies outside the profile (1000.0000 to 1500.0000)"});
}

// svy road catch: cut 2:1 and fill 3:1 from hinges on both sides onto level and sloping ground (the catch
// point on both the slope and the ground line), a slope the ground outruns, and a short row.
TEST(RoadCatch, CutAndFillOnBothSides) {
  const std::string rows = "hinge_offset,hinge_elevation,ground_offset,ground_elevation\n10,100,15,103\n-10,100,-20,98\n1,2,3\n";
  const SvyResult level = runSvy({"road", "catch", "--cut", "2", "--fill", "3"}, rows);
  EXPECT_EQ(level.exitStatus, 1);
  EXPECT_EQ(level.out, "catch_offset,catch_elevation,slope,run_rise\n16.0000,103.0000,cut,2.0000\n"
                       "-16.0000,98.0000,fill,-3.0000\n");
  EXPECT_EQ(level.errLines(), std::vector<std::string>{"svy: line 4: expected 4 numbers, got 3"});
  // Ground rising 10 % to the right: 100 + l / 2 = 102 + l / 10 at l = 5; at 60 % it outruns the cut slope.
  const SvyResult sloping = runSvy({"road", "catch", "--cut", "2", "--ground-grade", "10"}, "10,100,0,101\n");
  EXPECT_EQ(sloping.out, "catch_offset,catch_elevation,slope,run_rise\n15.0000,102.5000,cut,2.0000\n");
  const SvyResult steep = runSvy({"road", "catch", "--cut", "2", "--ground-grade", "60"}, "10,100,10,101\n");
  EXPECT_EQ(steep.exitStatus, 1);
  EXPECT_EQ(steep.errLines(), std::vector<std::string>{"svy: line 1: the slope does not meet the ground"});
}

// svy angle convert: known equivalents, the packed DDD.MMSS quirks, and round trips through every unit.

TEST(AngleConvert, KnownValuesQuirksAndRoundTrips) {
  const struct {
    const char *from, *to, *text;
    double expected;
  } cases[] = {
      {"deg", "rad", "90", 1.5707963267948966}, {"deg", "grad", "90", 100.0}, {"deg", "mil", "90", 1600.0},
      {"deg", "dms", "90", 90.0},
      // No reduction to one turn, except for the packed form.
      {"deg", "grad", "450", 500.0},            {"rad", "deg", "-7", -7.0 * 57.29577951308232},
      {"dms", "deg", "400.3000", 40.5},
  };
  for (const auto& c : cases) {
    const nlohmann::json r = runJson({"angle", "convert", "--from", c.from, "--to", c.to}, c.text);
    EXPECT_NEAR(r.at(0).at("value").get<double>(), c.expected, 1e-11) << c.from << " -> " << c.to << ' ' << c.text;
  }
  // 12.9999999 degrees is 12 deg 59' 59.99964": rounded seconds stay below 60.
  EXPECT_EQ(runSvy({"angle", "convert", "--from", "deg", "--to", "dms"}, "12.9999999\n13.0\n").out,
            "value\n12.59599996\n13.00000000\n");
  const double degrees[] = {0.5, 123.456789, -45.25, 359.9999};
  for (const char* unit : {"rad", "grad", "mil", "dms", "dmm", "deg-text", "dms-text", "dmm-text"}) {
    const std::string there = runSvy({"--full-precision", "angle", "convert", "--from", "deg", "--to", unit},
                                     "0.5\n123.456789\n-45.25\n359.9999\n")
                                  .out;
    const nlohmann::json back = runJson({"angle", "convert", "--from", unit, "--to", "deg"}, there);
    ASSERT_EQ(back.size(), 4u) << unit << '\n' << there;
    // The packed form keeps seconds to 8 decimals (3e-12 degree).
    for (std::size_t i = 0; i < 4; ++i) EXPECT_NEAR(back[i]["value"].get<double>(), degrees[i], 1e-11) << unit;
  }
}

// The text forms and the packed DD.MMmm number: known texts and a bad row among good ones (their round
// trips are in KnownValuesQuirksAndRoundTrips).
TEST(AngleConvert, TextFormsAndPackedMinutes) {
  EXPECT_EQ(runSvy({"angle", "convert", "--from", "deg", "--to", "dms-text"}, "45.50423611111111\n-0.5\n").out,
            "value\n\"45\u00B030'15.2500\"\"\"\n\"-0\u00B030'00.0000\"\"\"\n");
  EXPECT_EQ(runSvy({"angle", "convert", "--from", "deg", "--to", "deg-text"}, "12.5\n").out, "value\n12.5\u00B0\n");
  EXPECT_EQ(runSvy({"angle", "convert", "--from", "deg", "--to", "dmm"}, "-12.0833333333333333\n").out,
            "value\n-12.05000000\n");
  const SvyResult mixed = runSvy({"angle", "convert", "--from", "dmm", "--to", "deg"}, "45.30254\n45.60\n7.3\n");
  EXPECT_EQ(mixed.exitStatus, 1);
  EXPECT_EQ(mixed.out, "value\n45.504233333\n7.500000000\n");
  EXPECT_EQ(mixed.err, "svy: line 2: value: '45.60' is not a dmm angle\n");
}

// svy view project: a 90 degree view on 800 x 600 pixels puts a target 45 degrees right on the right edge
// and one 0.76 up at 1 ahead above the top; behind the observer there is no position; a bad view is a usage
// error.
TEST(ViewProject, KnownPixelsBehindAndBadViews) {
  const std::vector<std::string> view = {"view", "project", "--observer", "5000000,500000,100", "--azimuth", "90",
                                         "--fov", "90", "--screen", "800,600"};
  const SvyResult r = runSvy(view, "n,e,h\n5000000,500100,100\n4999900,500100,100\n5000000,500100,176\n5000000,499900,100\n");
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  EXPECT_EQ(r.out, "x,y,inside\n400.00,300.00,1\n800.00,300.00,1\n400.00,-4.00,0\nnan,nan,0\n");
  std::vector<std::string> bad = view;
  bad[7] = "180";
  EXPECT_EQ(runSvy(bad, "").exitStatus, 2);
}

// svy units convert: published unit definitions, the deliberate asymmetries of the factors, and round trips.

double convert(const std::string& from, const std::string& to, const std::string& value) {
  const nlohmann::json rows = runJson({"units", "convert", "--from", from, "--to", to}, value + "\n");
  return rows.at(0).at("value").get<double>();
}

TEST(UnitConvert, PublishedDefinitionsAndQuirks) {
  constexpr double kFt = 0.3048;
  constexpr double kUsFt = 1200.0 / 3937.0;
  const struct {
    const char *from, *to, *text;
    double expected, relTol;
  } cases[] = {
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
  for (const auto& c : cases) {
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
      const nlohmann::json back = runJson({"units", "convert", "--from", unit, "--to", base}, there);
      ASSERT_EQ(back.size(), 3u) << unit;
      for (std::size_t i = 0; i < 3; ++i) {
        EXPECT_NEAR(back[i]["value"].get<double>(), values[i], packed ? 0.0016 : std::fabs(values[i]) * 1e-12)
            << base << " -> " << unit;
      }
    }
  }
}

// svy station format and parse: the station text with its sign and rounding quirks, and the round trip.

TEST(StationText, FormatAndParseQuirks) {
  const char* const cases[][4] = {  // verb, interval, input, the written row
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
  for (const auto& [verb, interval, input, output] : cases) {
    const SvyResult r = runSvy({"station", verb, "--interval", interval}, std::string(input) + "\n");
    EXPECT_EQ(r.exitStatus, 0) << r.err;
    EXPECT_EQ(r.lines().at(1), output) << verb << ' ' << input;
  }
}

TEST(StationRoundTrip, FormattedTextsParseBackToTheChainage) {
  const std::vector<double> chainages = {0.0, 12.345, 999.994, 1005.3, 25000.125, -1234.5, -0.25, 7777.777};
  std::string input;
  for (double c : chainages) input += std::to_string(c) + "\n";
  for (const char* interval : {"1000", "100", "20"}) {
    const std::vector<std::string> formatted = runSvy({"station", "format", "--interval", interval}, input).lines();
    std::string texts;
    for (std::size_t i = 1; i < formatted.size(); ++i) texts += splitCsvLine(formatted[i]).at(1) + "\n";
    const nlohmann::json back = runJson({"station", "parse", "--interval", interval}, texts);
    ASSERT_EQ(back.size(), chainages.size());
    for (std::size_t i = 0; i < chainages.size(); ++i) {
      // The text keeps the remainder to 0.01 m.
      EXPECT_NEAR(back[i]["chainage"].get<double>(), chainages[i], 0.005 + 1e-9) << interval << ' ' << chainages[i];
    }
  }
}

// svy time to-gps and from-gps: published week anchors, millisecond rounding that carries into the next day,
// and the round trip between the two verbs over the whole range.

TEST(TimeVerbs, PublishedAnchorsBothWays) {
  // The GPS epoch, both week-number rollovers, published anchors of GNSS software test suites, day 366 of
  // 2000 (a Sunday: 2000-01-01 was a Saturday, 52 weeks and a day before), and times that round up to the
  // next day or week when written to the millisecond.
  const struct {
    const char* time;
    double week, secondsOfWeek, dayOfYear;
    bool exactText;
  } anchors[] = {
      {"1980-01-06T00:00:00.000", 0, 0.0, 6, true},           {"1999-01-01T00:00:00.000", 990, 432000.0, 1, true},
      {"1999-08-22T00:00:00.000", 1024, 0.0, 234, true},      {"2000-01-01T00:00:00.000", 1042, 518400.0, 1, true},
      {"2000-12-31T12:00:00.250", 1095, 43200.25, 366, true}, {"2019-04-07T00:00:00.000", 2048, 0.0, 97, true},
      {"1980-01-07T00:00:00.000", 0, 86399.9996, 7, false},   {"1980-01-13T00:00:00.000", 0, 604799.9999, 13, false},
      {"2018-05-06T00:01:00.000", 2000, 59.9996, 126, false}};
  for (const auto& a : anchors) {
    SCOPED_TRACE(a.time);
    const nlohmann::json from = runJson({"time", "from-gps"}, svy_test::csvRow({a.week, a.secondsOfWeek})).at(0);
    EXPECT_EQ(from["time"].get<std::string>(), a.time);
    EXPECT_EQ(from["day_of_year"].get<double>(), a.dayOfYear);
    if (!a.exactText) continue;
    const nlohmann::json to = runJson({"time", "to-gps"}, std::string(a.time) + "\n").at(0);
    EXPECT_EQ(to["week"].get<double>(), a.week);
    EXPECT_NEAR(to["seconds_of_week"].get<double>(), a.secondsOfWeek, 1e-6);
  }
}

// Calendar text -> GPS -> the same text, every 97th day from the epoch to the end of 2099 (the library's
// own tests cover every day), with a millisecond time of day that changes from row to row.
TEST(TimeVerbs, RoundTripOverTheWholeRange) {
  std::string times;
  for (long long millis = 0; millis < 3786480000000LL; millis += 97 * 86400000LL + 7919) {
    const std::time_t seconds = static_cast<std::time_t>(315964800 + millis / 1000);  // the GPS epoch in Unix time
    std::tm utc{};
    gmtime_r(&seconds, &utc);
    char text[80];
    std::snprintf(text, sizeof text, "%04d-%02d-%02dT%02d:%02d:%02d.%03lld\n", utc.tm_year + 1900, utc.tm_mon + 1,
                  utc.tm_mday, utc.tm_hour, utc.tm_min, utc.tm_sec, millis % 1000);
    times += text;
  }
  std::string gpsRows;
  for (const auto& g : runJson({"time", "to-gps"}, times)) {
    gpsRows += svy_test::csvRow({g["week"].get<double>(), g["seconds_of_week"].get<double>()});
  }
  std::string back;
  for (const auto& row : runJson({"time", "from-gps"}, gpsRows)) back += row["time"].get<std::string>() + "\n";
  EXPECT_EQ(back, times);
}

// svy cogo inverse and radiate: quadrant azimuths with their DMS text, and radiate-then-inverse round trips.

// From (1000, 2000): azimuth clockwise from north in [0, 360), never negative; coincident points give zero.
TEST(CogoInverse, AzimuthClockwiseFromNorthWithDmsText) {
  const struct {
    double dn, de, azimuthDeg;
    const char* dms;
  } cases[] = {{10, 0, 0.0, "0\xC2\xB0" "0'0.00"},
                        {0, 10, 90.0, "90\xC2\xB0" "0'0.00"},
                        {-10, 0, 180.0, "180\xC2\xB0" "0'0.00"},
                        {0, -10, 270.0, "270\xC2\xB0" "0'0.00"},
                        {6, 8, 53.130102354155978, "53\xC2\xB0" "7'48.37"},  // atan2(4, 3)
                        {-6, -8, 233.13010235415598, "233\xC2\xB0" "7'48.37"},
                        {6, -8, 306.86989764584402, "306\xC2\xB0" "52'11.63"},
                        {10, -1e-6, 359.99999427042211, "359\xC2\xB0" "59'59.98"},
                        {0, 0, 0.0, "0\xC2\xB0" "0'0.00"}};
  for (const auto& c : cases) {
    const std::string row = csvRow({1000, 2000, 1000 + c.dn, 2000 + c.de});
    const nlohmann::json r = runJson({"cogo", "inverse"}, row);
    EXPECT_NEAR(r.at(0)["azimuth_deg"].get<double>(), c.azimuthDeg, 1e-9) << row;
    EXPECT_NEAR(r.at(0)["distance"].get<double>(), std::hypot(c.dn, c.de), 1e-9) << row;
    EXPECT_EQ(splitCsvLine(runSvy({"cogo", "inverse"}, row).lines().at(1)).at(1),
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

// svy geo to-ecef, to-geodetic and enu: published worked examples and the round trip between the first two.

// Published worked examples: 53 deg 48' 33.820" N, 2 deg 07' 46.380" E, 73 m to geocentric, and that point
// about the origin 55 N, 5 E, 200 m to topocentric. The values are given to the millimetre on an ellipsoid
// within 0.4 mm of the library's; azimuth and elevation follow from east, north, up and the distance.
TEST(GeoVerbs, PublishedWorkedExamples) {
  const nlohmann::json ecef = runJson(
      {"geo", "to-ecef"}, csvRow({53.0 + 48.0 / 60.0 + 33.820 / 3600.0, 2.0 + 7.0 / 60.0 + 46.380 / 3600.0, 73}));
  const double xyz[] = {3771793.968, 140253.342, 5124304.349};
  const char* axes[] = {"x", "y", "z"};
  for (int i = 0; i < 3; ++i) EXPECT_NEAR(ecef.at(0)[axes[i]].get<double>(), xyz[i], 1.5e-3) << axes[i];

  const nlohmann::json r = runJson({"geo", "enu", "--origin", "55,5,200"}, csvRow({xyz[0], xyz[1], xyz[2]})).at(0);
  const double east = r["east"].get<double>(), north = r["north"].get<double>(), up = r["up"].get<double>();
  EXPECT_NEAR(east, -189013.869, 1.5e-3);
  EXPECT_NEAR(north, -128642.040, 1.5e-3);
  EXPECT_NEAR(up, -4220.171, 1.5e-3);
  const double distance = std::sqrt(std::pow(xyz[0] - 3652755.3058, 2) + std::pow(xyz[1] - 319574.6799, 2) +
                                    std::pow(xyz[2] - 5201547.3536, 2));
  EXPECT_NEAR(r["distance"].get<double>(), distance, 1.5e-3);
  EXPECT_NEAR(r["azimuth_deg"].get<double>(), 180.0 + std::atan2(-east, -north) * 180.0 / M_PI, 1e-9);
  EXPECT_NEAR(r["elevation_deg"].get<double>(), std::asin(up / distance) * 180.0 / M_PI, 1e-9);

  // A point at the origin has no direction.
  const nlohmann::json o = runJson({"geo", "to-ecef"}, "-33.5,151.25,20\n").at(0);
  const nlohmann::json atOrigin = runJson({"geo", "enu", "--origin", "-33.5,151.25,20"},
                                          csvRow({o["x"].get<double>(), o["y"].get<double>(), o["z"].get<double>()}));
  EXPECT_TRUE(atOrigin.at(0)["azimuth_deg"].is_null());
  EXPECT_TRUE(atOrigin.at(0)["elevation_deg"].is_null());
  EXPECT_NEAR(atOrigin.at(0)["distance"].get<double>(), 0.0, 1e-8);
}

// Geodetic -> Cartesian -> geodetic through both verbs; longitudes come back in (-180, 180].
TEST(GeoVerbs, RoundTripThroughBothVerbs) {
  const std::vector<std::vector<double>> points = {{0, 0, 0},          {53.8, 2.13, 73},    {-33.86, 151.21, 58},
                                                   {40.7, -74.0, 10},  {-45, -179.9999, 5}, {12, 180, 100},
                                                   {89.9999, 45, 2e3}, {-89.5, -120, -400}, {27.98, 86.92, 8848.86},
                                                   {0, -90, 2.02e7},   {10, -180, 0}};
  std::string input;
  for (const auto& p : points) input += csvRow({p[0], p[1], p[2]});
  std::string xyz;
  for (const auto& row : runJson({"geo", "to-ecef"}, input)) {
    xyz += csvRow({row["x"].get<double>(), row["y"].get<double>(), row["z"].get<double>()});
  }
  const nlohmann::json back = runJson({"geo", "to-geodetic"}, xyz);
  ASSERT_EQ(back.size(), points.size());
  for (std::size_t i = 0; i < points.size(); ++i) {
    // 1e-10 degree is 0.01 mm; the latitude iteration leaves a few micrometres.
    EXPECT_NEAR(back[i]["lat_deg"].get<double>(), points[i][0], 1e-10) << i;
    EXPECT_NEAR(back[i]["lon_deg"].get<double>(), points[i][1] == -180.0 ? 180.0 : points[i][1], 1e-9) << i;
    EXPECT_NEAR(back[i]["h"].get<double>(), points[i][2], 1e-5) << i;
  }
}

// svy fit line / circle / radius: fits of generated points at survey coordinates against the generating
// figures (the line's closed form is checked in the library's own tests), and fits that give no result.

constexpr double kNorth = 5000123.456;
constexpr double kEast = 500789.012;

// Points on a circle of radius r about (kNorth, kEast), alternately r + d and r - d from the centre.
std::string circleRows(double r, double d, int count, double spanRad) {
  std::string rows = "n,e\n";
  for (int k = 0; k < count; ++k) {
    const double rk = r + (k % 2 == 0 ? d : -d);
    rows += csvRow({kNorth + rk * std::cos(spanRad * k / count), kEast + rk * std::sin(spanRad * k / count)});
  }
  return rows;
}

TEST(FitVerbs, RecoverTheGeneratingFigures) {
  const nlohmann::json circle = runJson({"fit", "circle"}, circleRows(250.0, 0.002, 40, 4.0)).at(0);
  EXPECT_NEAR(circle.at("center_n").get<double>(), kNorth, 1e-3);
  EXPECT_NEAR(circle.at("center_e").get<double>(), kEast, 1e-3);
  EXPECT_NEAR(circle.at("radius").get<double>(), 250.0, 1e-3);
  EXPECT_NEAR(circle.at("rms").get<double>(), 0.002, 2e-4);

  std::string centre = csvRow({kNorth, kEast});
  centre.pop_back();
  const nlohmann::json radius = runJson({"fit", "radius", "--center", centre}, circleRows(80.0, 0.005, 10, 1.0)).at(0);
  EXPECT_NEAR(radius.at("radius").get<double>(), 80.0, 1e-9);
  EXPECT_NEAR(radius.at("rms").get<double>(), 0.005, 1e-9);

  // Bad rows are left out of the fit, which is written from the others.
  const SvyResult r = runSvy({"fit", "line"}, "# levels\nn,e\n3,1\n4\n5,2\nx,9\n7,3\n");
  EXPECT_EQ(r.exitStatus, 1);
  EXPECT_EQ(r.out, "slope,intercept,rms\n2.0000000000,1.0000,0.0000\n");
  EXPECT_EQ(r.errLines(), (std::vector<std::string>{"svy: line 4: expected 2 numbers, got 1",
                                                    "svy: line 6: n: 'x' is not a number"}));
}

TEST(FitVerbs, DegeneratePointSetsWriteNoResultRow) {
  const struct {
    const char *verb, *input, *message;
  } failures[] = {{"circle", "0,0\n1,1\n2,2\n", "collinear"},
                  {"circle", "0,0\n1,1\n", "too few points"},
                  {"line", "1,5\n2,5\n3,5\n", "one easting"},
                  {"line", "", "too few points"}};
  for (const auto& c : failures) {
    const SvyResult r = runSvy({"fit", c.verb}, c.input);
    EXPECT_EQ(r.exitStatus, 1) << c.message;
    EXPECT_LE(r.lines().size(), 1U) << c.message;
    EXPECT_NE(r.err.find(c.message), std::string::npos) << r.err;
  }
}

// svy curve solve and svy spiral table: each second curve quantity solves back to the same curve, circle
// geometry, the degree-of-curve options, and spiral tables that agree with the library's spiral data.

nlohmann::json solve(std::vector<std::string> options) {
  options.insert(options.begin(), {"curve", "solve"});
  return runJson(options).at(0);
}

TEST(CurveSolve, EachQuantitySolvesBackToTheCurve) {
  for (const char* delta : {"12.5", "90", "151"}) {
    const nlohmann::json ref = solve({"--radius", "350", "--delta", delta});
    const std::pair<const char*, const char*> quantities[] = {
        {"--length", "length"}, {"--chord", "chord"}, {"--tangent", "tangent"}, {"--external", "external"},
        {"--mid-ordinate", "mid_ordinate"}};
    for (const auto& [option, quantity] : quantities) {
      const nlohmann::json back = solve({"--radius", "350", option, std::to_string(ref[quantity].get<double>())});
      // to_string keeps six decimals: the solved curve matches to that input precision.
      for (const auto& [column, value] : ref.items()) {
        EXPECT_NEAR(back[column].get<double>(), value.get<double>(), 1e-3) << option << ' ' << delta << ' ' << column;
      }
    }
  }
}

TEST(CurveSolve, CircleGeometryAndDegreeOfCurve) {
  const SvyResult csv = runSvy({"curve", "solve", "--full-precision", "--radius", "100", "--delta", "90"});
  ASSERT_EQ(csv.lines().size(), 2u) << csv.err;
  EXPECT_EQ(csv.lines()[0],
            "radius,deg_curve_arc,deg_curve_chord,delta_deg,length,chord,tangent,external,mid_ordinate");
  const std::vector<std::string> v = splitCsvLine(csv.lines()[1]);
  EXPECT_DOUBLE_EQ(std::stod(v.at(6)), GetTangentFromDelta(90.0, 100.0));
  EXPECT_NEAR(std::stod(v.at(4)), 50.0 * 3.141592653589793, 1e-12);
  EXPECT_NEAR(std::stod(v.at(5)), 100.0 * std::sqrt(2.0), 1e-12);
  EXPECT_NEAR(std::stod(v.at(7)), 100.0 * (std::sqrt(2.0) - 1.0), 1e-12);

  const nlohmann::json arc = solve({"--deg-arc", "1", "--length", "100"});
  EXPECT_DOUBLE_EQ(arc["radius"].get<double>(), 5729.5779513082325);
  EXPECT_NEAR(arc["delta_deg"].get<double>(), 1.0, 1e-12);  // a 100-unit arc subtends one degree
  const nlohmann::json chord = solve({"--deg-chord", "2", "--chord", "100"});
  EXPECT_DOUBLE_EQ(chord["radius"].get<double>(), GetRadiusFromDegOfChord(2.0));
  EXPECT_NEAR(chord["delta_deg"].get<double>(), 2.0, 1e-9);  // a 100-unit chord subtends two degrees
  EXPECT_NEAR(chord["deg_curve_chord"].get<double>(), 2.0, 1e-9);
}

TEST(SpiralTable, RowsAgreeWithLibrary) {
  const struct {
    const char* type;
    double length, radius, interval;
    bool exit;
  } cases[] = {{"clothoid", 100.0, 300.0, 10.0, false},
                        {"clothoid", 75.0, -250.0, 20.0, false},
                        {"cubic", 100.0, 400.0, 30.0, true},
                        {"cubic", 60.0, -1000.0, 7.5, false}};
  for (const auto& c : cases) {
    SCOPED_TRACE(std::string(c.type) + " " + std::to_string(c.radius));
    std::vector<std::string> args = {"spiral", "table", "--full-precision", "--type", c.type,
                                     "--length", std::to_string(c.length), "--radius", std::to_string(c.radius),
                                     "--interval", std::to_string(c.interval)};
    if (c.exit) args.push_back("--exit");
    const std::vector<std::string> lines = runSvy(args).lines();
    ASSERT_GE(lines.size(), 3u);
    EXPECT_EQ(lines[0], "length,north,east,azimuth_deg,radius");
    // One row per whole interval, plus the start, plus the end when it is off the grid.
    const double whole = std::floor(c.length / c.interval + 1e-9);
    const bool endOnGrid = std::fabs(whole * c.interval - c.length) < 1e-9;
    EXPECT_EQ(lines.size(), static_cast<std::size_t>(whole) + (endOnGrid ? 2 : 3));
    CCurveDataSpiral1R spiral(std::string(c.type) == "cubic" ? eMathSpiralCubic : eMathSpiralEuler);
    ASSERT_TRUE(spiral.setLenAndR(c.length, c.radius, c.radius > 0.0, !c.exit));
    double previous = -1.0;
    for (std::size_t i = 1; i < lines.size(); ++i) {
      const std::vector<std::string> f = splitCsvLine(lines[i]);
      ASSERT_EQ(f.size(), 5u);
      const double s = std::stod(f[0]);
      EXPECT_GT(s, previous);
      previous = s;
      double n = 0.0, e = 0.0;
      ASSERT_TRUE(spiral.getPosAtLength(s, n, e));
      EXPECT_NEAR(std::stod(f[1]), n, 1e-12);
      EXPECT_NEAR(std::stod(f[2]), e, 1e-12);
      EXPECT_NEAR(std::stod(f[3]), spiral.GetAzimuth(s), 1e-12);
      const double k = spiral.getCurvatureAtLength(s);
      if (k == 0.0) {
        EXPECT_EQ(f[4], "inf");
      } else {
        EXPECT_NEAR(std::stod(f[4]), 1.0 / k, 1e-9 / std::fabs(k));
      }
    }
    EXPECT_NEAR(previous, c.length, 1e-9);
    // The curve end carries the given radius.
    EXPECT_NEAR(std::stod(splitCsvLine(c.exit ? lines[1] : lines.back())[4]), c.radius, 1e-5 * std::fabs(c.radius));
  }
}

// The sample data shipped in examples/ runs through its verbs without a bad row.

TEST(SvyExamples, EverySampleFileReadsWithoutBadRowsAndTheTraverseCloses) {
  const std::vector<std::vector<std::string>> runs = {
      {"cogo", "radiate", examplesPath("traverse_radiate.csv")},
      {"station", "format", "--interval", "1000", examplesPath("chainages.csv")},
      {"station", "parse", "--interval", "1000", examplesPath("stations.csv")},
      {"angle", "convert", "--from", "dms", "--to", "deg", examplesPath("angles_dms.csv")}};
  for (const auto& args : runs) {
    const SvyResult r = runSvy(args);
    EXPECT_EQ(r.exitStatus, 0) << args[0] << ' ' << args[1] << ": " << r.err;
    EXPECT_EQ(r.err, "");
    EXPECT_GT(r.lines().size(), 3u) << args[0] << ' ' << args[1];
  }
  // Summing the legs as vectors from their azimuths and distances returns to the start.
  const nlohmann::json legs = runJson({"cogo", "inverse", examplesPath("traverse_legs.csv")});
  ASSERT_EQ(legs.size(), 5u);
  double north = 0.0, east = 0.0;
  for (const auto& leg : legs) {
    const double azimuth = leg["azimuth_deg"].get<double>() * svy_math::units::kDegToRad;
    north += leg["distance"].get<double>() * std::cos(azimuth);
    east += leg["distance"].get<double>() * std::sin(azimuth);
  }
  EXPECT_NEAR(std::hypot(north, east), 0.0, 1e-9);
}

}  // namespace
