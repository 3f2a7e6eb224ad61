// svy fit line / circle / radius: fits of generated points read back at full precision, and the handling of
// bad rows, degenerate point sets and a bad centre option.
#include "svy_runner.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <sstream>
#include <string>
#include <vector>

namespace {

using svy_test::runSvy;

constexpr double kNorth = 5000123.456;
constexpr double kEast = 500789.012;

std::string csvPoint(double n, double e) {
  std::ostringstream text;
  text.precision(17);
  text << n << ',' << e << '\n';
  return text.str();
}

// Points on a circle of radius r about (kNorth, kEast), alternately r + d and r - d from the centre.
std::string circleRows(double r, double d, int count, double spanRad) {
  std::string rows = "n,e\n";
  for (int k = 0; k < count; ++k) {
    const double azimuth = spanRad * k / count;
    const double rk = r + (k % 2 == 0 ? d : -d);
    rows += csvPoint(kNorth + rk * std::cos(azimuth), kEast + rk * std::sin(azimuth));
  }
  return rows;
}

nlohmann::json runJson(const std::vector<std::string>& verb, const std::string& input) {
  std::vector<std::string> args{"--json", "--full-precision", "fit"};
  args.insert(args.end(), verb.begin(), verb.end());
  const svy_test::SvyResult r = runSvy(args, input);
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  const nlohmann::json rows = nlohmann::json::parse(r.out);
  EXPECT_EQ(rows.size(), 1U);
  return rows.at(0);
}

TEST(FitLineVerb, SlopeInterceptAndRmsAtSurveyCoordinates) {
  // n = 0.5 e + b with +-1 cm alternating offsets, against the centred closed form slope = Sne / See.
  std::string rows;
  std::vector<double> de, dn;
  for (int k = 0; k < 20; ++k) {
    de.push_back(3.0 * k);
    dn.push_back(0.5 * de.back() + (k % 2 == 0 ? 0.01 : -0.01));
    rows += csvPoint(kNorth + dn.back(), kEast + de.back());
  }
  double meanE = 0.0, meanN = 0.0;
  for (std::size_t k = 0; k < de.size(); ++k) {
    meanE += de[k] / 20.0;
    meanN += dn[k] / 20.0;
  }
  double sne = 0.0, see = 0.0;
  for (std::size_t k = 0; k < de.size(); ++k) {
    sne += (de[k] - meanE) * (dn[k] - meanN);
    see += (de[k] - meanE) * (de[k] - meanE);
  }
  const nlohmann::json fit = runJson({"line"}, rows);
  const double slope = fit.at("slope").get<double>();
  EXPECT_NEAR(slope, sne / see, 1e-12);
  const double atCentroid = slope * (kEast + meanE) + fit.at("intercept").get<double>();
  EXPECT_NEAR(atCentroid - kNorth, meanN, 1e-6);
  EXPECT_NEAR(fit.at("rms").get<double>(), 0.01, 1e-4);
}

TEST(FitLineVerb, ExactPointsAndCsvOutput) {
  const svy_test::SvyResult r = runSvy({"fit", "line"}, "# levels\nn,e\n3,1\n\n5,2\n7,3\n");
  ASSERT_EQ(r.exitStatus, 0) << r.err;
  ASSERT_EQ(r.lines().size(), 2U);
  EXPECT_EQ(r.lines()[0], "slope,intercept,rms");
  EXPECT_EQ(r.lines()[1], "2.0000000000,1.0000,0.0000");
}

TEST(FitCircleVerb, RecoversCentreAndRadius) {
  const nlohmann::json fit = runJson({"circle"}, circleRows(250.0, 0.002, 40, 4.0));
  EXPECT_NEAR(fit.at("center_n").get<double>(), kNorth, 1e-3);
  EXPECT_NEAR(fit.at("center_e").get<double>(), kEast, 1e-3);
  EXPECT_NEAR(fit.at("radius").get<double>(), 250.0, 1e-3);
  EXPECT_NEAR(fit.at("rms").get<double>(), 0.002, 2e-4);
}

TEST(FitRadiusVerb, MeanDistanceAboutTheGivenCentre) {
  const std::string centre = csvPoint(kNorth, kEast);
  const nlohmann::json fit =
      runJson({"radius", "--center", centre.substr(0, centre.size() - 1)}, circleRows(80.0, 0.005, 10, 1.0));
  EXPECT_NEAR(fit.at("radius").get<double>(), 80.0, 1e-9);
  EXPECT_NEAR(fit.at("rms").get<double>(), 0.005, 1e-9);
}

TEST(FitVerbs, BadRowsAreReportedAndLeftOut) {
  const svy_test::SvyResult r = runSvy({"fit", "line"}, "3,1\n4\n5,2\nx,9\n7,3\n");
  EXPECT_EQ(r.exitStatus, 1);
  ASSERT_EQ(r.lines().size(), 2U);
  EXPECT_EQ(r.lines()[1], "2.0000000000,1.0000,0.0000");
  ASSERT_EQ(r.errLines().size(), 2U);
  EXPECT_NE(r.errLines()[0].find("line 2"), std::string::npos);
  EXPECT_NE(r.errLines()[1].find("line 4"), std::string::npos);
}

struct FailureCase {
  std::vector<std::string> args;
  std::string input;
  int exitStatus;
  std::string message;
};

class FitVerbFailure : public ::testing::TestWithParam<FailureCase> {};

TEST_P(FitVerbFailure, WritesNoResultRow) {
  const FailureCase& c = GetParam();
  const svy_test::SvyResult r = runSvy(c.args, c.input);
  EXPECT_EQ(r.exitStatus, c.exitStatus);
  EXPECT_LE(r.lines().size(), 1U);
  EXPECT_NE(r.err.find(c.message), std::string::npos) << r.err;
}

INSTANTIATE_TEST_SUITE_P(
    Table, FitVerbFailure,
    ::testing::Values(FailureCase{{"fit", "circle"}, "0,0\n1,1\n2,2\n", 1, "collinear"},
                      FailureCase{{"fit", "circle"}, "0,0\n1,1\n", 1, "too few points"},
                      FailureCase{{"fit", "line"}, "1,5\n2,5\n3,5\n", 1, "one easting"},
                      FailureCase{{"fit", "line"}, "", 1, "too few points"},
                      FailureCase{{"fit", "radius", "--center", "1;2"}, "0,1\n", 2, "--center"},
                      FailureCase{{"fit", "radius"}, "0,1\n", 2, "center"}));

}  // namespace
