// Damaged input to every svy verb that reads rows: each verb's clean rows with one bad row inserted after the
// first must give the clean output, one message for that line and exit status 1; accepted variations of the
// file (byte-order mark, CRLF, a header, comments) must give the clean output exactly.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "svy_runner.h"

namespace {

using svy_test::runSvy;
using svy_test::SvyResult;

// One line per verb invocation: its arguments, its input column names, clean rows (the first row's last
// field is the one the damaged rows replace) and whether its rows form one figure. Rows of a figure (the
// legs of a traverse) stand or fall together: one bad row leaves the output header alone, with one more
// line saying why. A new verb joins the tables with one line here.
struct RowVerb {
  const char* args;
  const char* header;
  const char* rows;
  bool oneFigure = false;
};
const RowVerb kRowVerbs[] = {
    {"cogo inverse", "n1,e1,n2,e2", "0,0,3,4\n5000000.5,500000.25,5000100,500050\n"},
    {"cogo radiate", "n,e,azimuth_deg,distance", "100,200,45,10\n0,0,270,5\n"},
    {"cogo intersect --mode bb", "n1,e1,az1_deg,n2,e2,az2_deg",
     "5000,2000,36.565,5087.412,2064.835,103.7955\n5000,2000,45,5000,2100,315\n"},
    {"cogo intersect --mode bd", "n1,e1,az1_deg,n2,e2,dist2",
     "5000,2000,90,5010,2050,20\n5000,2000,36.565,5061.2,2171.6,120\n"},
    {"cogo intersect --mode dd", "n1,e1,dist1,n2,e2,dist2",
     "5000,2000,50,5000,2080,40\n5087.4,2064.8,60,5061.2,2171.6,70\n"},
    {"cogo perpendicular", "n1,e1,n2,e2,n,e", "5000,2000,5087.412,2064.835,5040,2035\n0,0,10,0,5,-2\n"},
    {"cogo tangents", "n1,e1,r1,n2,e2,r2", "5000,2000,12,5000,2060,8\n5000,2000,0,5030,2040,15\n"},
    {"traverse adjust --rule compass --start 5000,2000 --end 5000,2000", "azimuth_deg,distance",
     "36.564972,108.838\n103.795556,109.889\n188.289722,93.241\n254.065833,99.486\n313.067222,85.483\n", true},
    {"angle convert --from dms --to deg", "value", "45.3015\n-12.05\n"},
    {"angle convert --from dms-text --to dmm", "value", "\"45°30'15.25\"\"\"\n-12°05'\n"},
    {"station format --interval 1000", "chainage", "1234.567\n-5\n"},
    {"station parse --interval 1000", "text", "1+234.57\n\"0+5,5\"\n"},
    {"units convert --from ft-us --to m", "value", "1000\n0.5\n"},
    {"fit line", "n,e", "0,0\n1,1.1\n2,1.9\n3,3\n"},
    {"fit circle", "n,e", "10,0\n0,10\n-10,0\n0,-10.1\n"},
    {"fit radius --center 0,0", "n,e", "10,0\n0,10.1\n-10,0\n"},
    {"geo to-ecef", "lat_deg,lon_deg,h", "45,7,300\n-33.5,151.25,20\n"},
    {"geo to-geodetic", "x,y,z", "4400000,600000,4500000\n6378137,0,0\n"},
    {"curve ip --radius 300 --spiral-in 60 --spiral-out 60", "n_prev,e_prev,n_ip,e_ip,n_next,e_next",
     "0,0,1000,0,1700,700\n0,0,0,1000,-500,1500\n"},
    {"geo enu --origin 45,7,300", "x,y,z", "4500000,550000,4490000\n4510000,552000,4480000\n"},
    {"geo inverse", "lat1_deg,lon1_deg,lat2_deg,lon2_deg", "47.3769,8.5417,47.377,8.543\n0.5,10,-0.4,-170.4\n"},
    {"geo direct", "lat_deg,lon_deg,azimuth_deg,distance", "47.3769,8.5417,85,100\n-33.8568,151.2153,320,17000000\n"},
    {"geo ground-to-grid --base 5213400,498700 --site 47.1,450,0.9996", "n,e", "5213400,498700\n5213650.2,498750.9\n"},
    {"geo grid-to-ground --base 5213400,498700 --factor 0.99963", "n,e", "5213400,498700\n5213650.2,498750.9\n"},
    {"geo helmert --params 0,0,4.5,0,0,0.554,0.219", "x,y,z", "3657660.66,255768.55,5201382.11\n6378137,0,0\n"},
    {"localize fit", "id,n_from,e_from,n_to,e_to",
     "C1,1000,2000,5214060.636,498560.601\nC2,1250.5,2010,5214304.777,498503.282\n"
     "C3,1120,2310.25,5214259.25,498827.596\nC5,990,1801,5213997.789,498371.445\n"},
    {"localize apply --scale 1.0002 --rotation -15.5 --shift 5212562,496900", "n,e", "1000,2000\n1100,2100\n"},
    {"resect --instrument-height 1.55", "target,n,e,h,hz_deg,zenith_deg,slope_distance,target_height",
     "P1,5213650.2,498750.9,430.1,334.499745,85.967833,255.9604,1.8\n"
     "P2,5213480.7,499110.3,398.2,41.872221,92.1521,418.455,0\n"
     "P3,5213250,498620.5,415,170.923876,88.920505,,2.1\nP4,5213390.4,498480.2,405.5,230.498849,,220.1262,1.3\n"},
    {"view project --observer 5000,2000,12 --fov 60 --screen 640,480", "n,e,h", "5100,2100,10\n5100,1950,14\n"},
    {"profile height --pvi 0,100 --pvi 100,102,40 --pvi 200,101", "chainage", "50\n125.5\n"},
    {"road catch --cut 2 --fill 3", "hinge_offset,hinge_elevation,ground_offset,ground_elevation", "5,100,12,103\n-5,100,-15,96\n"},
    {"time to-gps", "time", "2024-01-01T00:00:00\n2000-02-29T12:30:00.25\n"},
    {"time from-gps", "week,seconds_of_week", "2295,86400\n1000,0.5\n"},
};

std::string replaceAll(std::string text, const std::string& from, const std::string& to) {
  for (std::size_t at = 0; (at = text.find(from, at)) != std::string::npos; at += to.size()) {
    text.replace(at, from.size(), to);
  }
  return text;
}

// Verbs whose input is text as a user types it (a station, an angle with its marks), not a plain number.
bool readsTypedText(const RowVerb& verb) {
  const std::string args = verb.args;
  return args.rfind("station parse", 0) == 0 || args.find("-text --to") != std::string::npos;
}

std::vector<std::string> argsOf(const RowVerb& verb) { return svy_test::split(verb.args, ' '); }

// A text that holds no number, date or station, whatever a verb reads ("abc" as a time once read past the
// end of the text: the sanitizer build catches such a fault here). The last field of a row is replaced by
// it; a row that gains a field is too long for every verb.
const char* const kDecimalComma = "\"1234,5\"";
struct Damage {
  const char* what;
  std::string field;
};
std::vector<Damage> damagedFields() {
  return {{"letters", "abc"},
          {"not a number", "nan"},
          {"infinity", "inf"},
          {"negative infinity", "-inf"},
          {"beyond double", "1e400"},
          {"hexadecimal", "0x10"},
          {"thousands separator", "\"1,234.5\""},
          {"blank thousands separator", "1 234.5"},
          {"decimal comma", kDecimalComma},
          {"NUL byte", std::string("12\0" "3", 4)},
          {"lone carriage return", "12\r3"},
          {"control byte", "\x1b[2J"},
          {"invalid UTF-8", "\xff\xfe"},
          {"very long line", std::string(200000, '7') + "x"},
          {"unclosed quote", "\"12"}};
}

// All the damaged rows of a verb in one input, on lines 2, 3, ... between its first clean row and the others:
// each gives one message with its own line number (a damaged line never swallows the next), the clean rows
// still come out in order, and each message is one short printable line.
TEST(SvyBadInput, EveryBadRowReportedOnceWhileTheCleanRowsComeOut) {
  for (const RowVerb& verb : kRowVerbs) {
    const std::string rows = verb.rows;
    const std::string firstRow = rows.substr(0, rows.find('\n'));
    const std::size_t lastComma = firstRow.rfind(',');
    const std::string head = lastComma == std::string::npos ? std::string() : firstRow.substr(0, lastComma + 1);
    std::vector<std::pair<std::string, std::string>> badRows = {{"an extra field", firstRow + ",1"}};
    for (const Damage& damage : damagedFields()) {
      // Station and angle texts take a decimal comma, as the library's readers of typed text do.
      if (damage.field == kDecimalComma && readsTypedText(verb)) continue;
      badRows.emplace_back(damage.what, head + damage.field);
    }
    std::string input = firstRow + "\n";
    for (const auto& badRow : badRows) input += badRow.second + "\n";
    input += rows.substr(firstRow.size() + 1);

    for (const bool json : {false, true}) {
      SCOPED_TRACE(std::string(verb.args) + (json ? " --json" : ""));
      std::vector<std::string> args = argsOf(verb);
      if (json) args.insert(args.begin(), "--json");
      // What bad rows leave: the clean output, or for a figure the output of no rows at all.
      const SvyResult clean = runSvy(args, verb.oneFigure ? "" : verb.rows);
      const SvyResult r = runSvy(args, input);
      EXPECT_EQ(r.exitStatus, 1);
      EXPECT_EQ(r.out, clean.out);
      const std::vector<std::string> messages = r.errLines();
      ASSERT_EQ(messages.size(), badRows.size() + (verb.oneFigure ? 1 : 0)) << r.err;
      for (std::size_t k = 0; k < badRows.size(); ++k) {
        SCOPED_TRACE(badRows[k].first);
        EXPECT_EQ(messages[k].rfind("svy: line " + std::to_string(k + 2) + ": ", 0), 0u) << messages[k];
        EXPECT_LT(messages[k].size(), 200u);
        EXPECT_EQ(messages[k].find_first_of(std::string("\0\r\x1b", 3)), std::string::npos) << messages[k];
      }
    }
  }
}

// Accepted: a UTF-8 byte-order mark, CRLF line ends, a header of the input column names, comments and
// blank lines, no newline at the end. Each gives the clean output.
TEST(SvyBadInput, AcceptedFileFormsGiveTheCleanOutput) {
  const std::string bom = "\xEF\xBB\xBF";
  for (const RowVerb& verb : kRowVerbs) {
    const SvyResult clean = runSvy(argsOf(verb), verb.rows);
    const std::string rows = verb.rows;
    const std::string header = std::string(verb.header) + "\n";
    const std::string forms[] = {
        bom + rows, bom + replaceAll(header + rows, "\n", "\r\n"),
        "# surveyed 2024-05-02\n\n" + header + "\n" + replaceAll(rows.substr(0, rows.size() - 1), "\n", "\n# checked\n")};
    for (const std::string& input : forms) {
      SCOPED_TRACE(std::string(verb.args) + ": " + input);
      const SvyResult r = runSvy(argsOf(verb), input);
      EXPECT_EQ(r.exitStatus, 0) << r.err;
      EXPECT_EQ(r.out, clean.out);
    }
  }
}

// Nothing to read: the output header alone; a verb that needs points (a fit, a traverse) says so on one line.
TEST(SvyBadInput, EmptyInputGivesTheHeaderAlone) {
  for (const RowVerb& verb : kRowVerbs) {
    const SvyResult clean = runSvy(argsOf(verb), verb.rows);
    const std::string outputHeader = clean.lines().at(0) + "\n";
    for (const std::string& input : {std::string(), "\xEF\xBB\xBF" + std::string(verb.header) + "\r\n"}) {
      SCOPED_TRACE(std::string(verb.args) + ": " + input);
      const SvyResult r = runSvy(argsOf(verb), input);
      EXPECT_EQ(r.out, outputHeader);
      // Status 0, or for a verb that needs points 1 with one line saying so.
      EXPECT_EQ(r.errLines().size(), static_cast<std::size_t>(r.exitStatus)) << r.err;
      EXPECT_LE(r.exitStatus, 1);
    }
  }
}

// Verbs without rows take their numbers from options: what the rows refuse is refused there too, on one line.
TEST(SvyBadInput, BadOptionNumbersGiveOneLineAndStatusTwo) {
  const char* const verbs[] = {"curve solve --radius {} --delta 20", "curve solve --radius 300 --tangent {}",
                               "spiral table --length 100 --radius {} --interval 10",
                               "station format --interval {}",
                               "curve ip --radius 300 --spiral-in {}",
                               "resect --instrument-height {}",
                               "localize apply --scale {} --rotation 0 --shift 0,0",
                               "geo ground-to-grid --base 0,0 --factor {}"};
  for (const char* verb : verbs) {
    for (const char* value : {"abc", "nan", "inf", "1e400", "1,000", "1000,5", ""}) {
      std::vector<std::string> args = svy_test::split(verb, ' ');
      for (std::string& arg : args) arg = replaceAll(arg, "{}", value);
      SCOPED_TRACE(std::string(verb) + " with " + value);
      const SvyResult r = runSvy(args, "1\n");
      EXPECT_EQ(r.exitStatus, 2);
      EXPECT_EQ(r.out, "");
      EXPECT_EQ(r.errLines().size(), 1u) << r.err;
    }
  }
}

}  // namespace
