// svy align on the shipped sample road: the stations and offsets of the surveyed points lead back to the
// points (a round trip through the library's position at station and offset), their cut and fill is the
// surveyed height minus the library's profile height, the setting-out table reads back to its stations and
// offsets, and bad input gives its one-line errors.
#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "svy_runner.h"
#include "svyio/landxml_document.h"

namespace {

using svy_test::runSvy;

const std::string kRoad = svy_test::examplesPath("road/sample_road.xml");
const std::string kPoints = svy_test::examplesPath("road/surveyed_points.csv");

const svy_io::TLandXmlAlignment& sampleRoad() {
  static const svy_io::TLandXmlDocument document = [] {
    svy_io::TLandXmlDocument d;
    std::string error;
    EXPECT_TRUE(svy_io::readLandXmlFile(kRoad, d, error)) << error;
    return d;
  }();
  return document.alignments.at(0);
}

TEST(AlignVerb, StationsOfTheSurveyedPointsLeadBackToThem) {
  const nlohmann::json rows = svy_test::runJson({"--full-precision", "align", "station", "--landxml", kRoad, kPoints});
  std::ifstream in(kPoints);
  std::string line;
  std::getline(in, line);
  const svy_io::TLandXmlAlignment& road = sampleRoad();
  std::size_t i = 0, extrapolated = 0;
  for (; std::getline(in, line); ++i) {
    const std::vector<std::string> f = svy_test::splitCsvLine(line);
    ASSERT_LT(i, rows.size());
    const nlohmann::json& row = rows[i];
    ASSERT_EQ(row["id"], f[0]);
    const double station = row["station"], offset = row["offset"];
    double n = 0.0, e = 0.0, design = 0.0;
    ASSERT_TRUE(road.horizontal.getPosNeAtChainAndOffsetExtr(station, offset, n, e));
    EXPECT_LE(std::hypot(n - std::stod(f[1]), e - std::stod(f[2])), 1e-6) << line;
    ASSERT_TRUE(road.profiles[0].profile.getHeightAtChainExtr(station, design));
    EXPECT_NEAR(row["design_h"].get<double>(), design, 1e-9);
    EXPECT_NEAR(row["cut_fill"].get<double>(), std::stod(f[3]) - design, 1e-9);
    extrapolated += row["extrapolated"] == "yes";
  }
  EXPECT_EQ(i, rows.size());
  EXPECT_GE(extrapolated, 2u);
}

// Stations behind the gap of the station equation (back 1200, ahead 1200.5) are displayed half a metre on.
TEST(AlignVerb, StationTextAppliesTheEquation) {
  const svy_test::SvyResult r =
      runSvy({"align", "stakeout", "--landxml", kRoad, "--from", "1190", "--to", "1210", "--interval", "10"});
  ASSERT_EQ(r.exitStatus, 0) << r.err;
  std::string points = "id,n,e\n";
  const std::vector<std::string> lines = r.lines();
  for (std::size_t k = 1; k < lines.size(); ++k) {
    const std::vector<std::string> f = svy_test::splitCsvLine(lines[k]);
    points += "S" + f[0] + "," + f[2] + "," + f[3] + "\n";
  }
  const nlohmann::json rows = svy_test::runJson({"align", "station", "--landxml", kRoad}, points);
  ASSERT_EQ(rows.size(), 3u);
  // At the break itself both texts name the point; either side of it only one does.
  const char* texts[] = {"1+190.00", nullptr, "1+210.50"};
  for (std::size_t k = 0; k < 3; ++k) {
    if (texts[k] != nullptr) {
      EXPECT_EQ(rows[k]["station_text"], texts[k]);
    }
    EXPECT_NEAR(rows[k]["station"].get<double>(), 1190.0 + 10.0 * static_cast<double>(k), 0.001);
    EXPECT_NEAR(rows[k]["offset"].get<double>(), 0.0, 0.001);
  }
}

// The setting-out table: stations at the multiples of the interval and at the element and vertical curve
// ends; each point read back gives its station and offset.
TEST(AlignVerb, StakeoutReadsBackToItsStations) {
  const nlohmann::json table = svy_test::runJson({"--full-precision", "align", "stakeout", "--landxml", kRoad,
                                                  "--from", "300", "--to", "700", "--interval", "50", "--offsets",
                                                  "-3.5,0,4"});
  std::vector<double> stations;
  std::string points;
  for (const nlohmann::json& row : table) {
    if (stations.empty() || stations.back() != row["station"].get<double>()) stations.push_back(row["station"]);
    points += "x," + std::to_string(row["n"].get<double>()) + "," + std::to_string(row["e"].get<double>()) + "\n";
  }
  for (const double expected : {300.0, 320.0, 340.0, 400.0, 450.0, 500.0, 610.0, 690.0, 700.0}) {
    EXPECT_NE(std::find(stations.begin(), stations.end(), expected), stations.end()) << expected;
  }
  const nlohmann::json back =
      svy_test::runJson({"--full-precision", "align", "station", "--landxml", kRoad}, points);
  ASSERT_EQ(back.size(), table.size());
  for (std::size_t k = 0; k < table.size(); ++k) {
    EXPECT_NEAR(back[k]["station"].get<double>(), table[k]["station"].get<double>(), 1e-5);
    EXPECT_NEAR(back[k]["offset"].get<double>(), table[k]["offset"].get<double>(), 1e-5);
  }
}

struct TErrorCase {
  std::vector<std::string> args;
  std::string input;
  int status;
  const char* message;
};

class AlignErrors : public ::testing::TestWithParam<TErrorCase> {};

TEST_P(AlignErrors, OneLineAndAStatus) {
  const svy_test::SvyResult r = runSvy(GetParam().args, GetParam().input);
  EXPECT_EQ(r.exitStatus, GetParam().status);
  EXPECT_NE(r.err.find(GetParam().message), std::string::npos) << r.err;
}

INSTANTIATE_TEST_SUITE_P(
    Align, AlignErrors,
    ::testing::Values(
        TErrorCase{{"align", "station", "--landxml", "/nonexistent.xml"}, "", 2, "cannot open /nonexistent.xml"},
        TErrorCase{{"align", "station", "--landxml", kRoad, "--alignment", "Other"}, "", 2, "no alignment named"},
        TErrorCase{{"align", "info", "--landxml", kRoad, "--profile", "Ground"}, "", 2, "no profile named 'Ground'"},
        TErrorCase{{"align", "station", "--landxml", kRoad}, "a,5200100,480100\nb,x,480100\n", 1,
                   "line 2: n and e must be numbers"},
        TErrorCase{{"align", "stakeout", "--landxml", kRoad, "--from", "0", "--to", "10", "--interval", "0"}, "", 2,
                   "--interval must be positive"}));

}  // namespace
