// svy fit line / circle / radius: fits of generated points at survey coordinates against closed forms and the
// generating figures, and fits that give no result.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svy_runner.h"

namespace {

using svy_test::csvRow;

constexpr double kNorth = 5000123.456;
constexpr double kEast = 500789.012;

nlohmann::json fit(const std::vector<std::string>& verb, const std::string& input) {
  std::vector<std::string> args{"fit"};
  args.insert(args.end(), verb.begin(), verb.end());
  const nlohmann::json rows = svy_test::runJson(args, input);
  EXPECT_EQ(rows.size(), 1U);
  return rows.at(0);
}

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
  // n = 0.5 e + b with +-1 cm alternating offsets, against the centred closed form slope = Sne / See.
  std::string rows;
  double de[20], dn[20], meanE = 0.0, meanN = 0.0;
  for (int k = 0; k < 20; ++k) {
    de[k] = 3.0 * k;
    dn[k] = 0.5 * de[k] + (k % 2 == 0 ? 0.01 : -0.01);
    rows += csvRow({kNorth + dn[k], kEast + de[k]});
    meanE += de[k] / 20.0;
    meanN += dn[k] / 20.0;
  }
  double sne = 0.0, see = 0.0;
  for (int k = 0; k < 20; ++k) {
    sne += (de[k] - meanE) * (dn[k] - meanN);
    see += (de[k] - meanE) * (de[k] - meanE);
  }
  const nlohmann::json line = fit({"line"}, rows);
  const double slope = line.at("slope").get<double>();
  EXPECT_NEAR(slope, sne / see, 1e-12);
  EXPECT_NEAR(slope * (kEast + meanE) + line.at("intercept").get<double>() - kNorth, meanN, 1e-6);
  EXPECT_NEAR(line.at("rms").get<double>(), 0.01, 1e-4);

  const nlohmann::json circle = fit({"circle"}, circleRows(250.0, 0.002, 40, 4.0));
  EXPECT_NEAR(circle.at("center_n").get<double>(), kNorth, 1e-3);
  EXPECT_NEAR(circle.at("center_e").get<double>(), kEast, 1e-3);
  EXPECT_NEAR(circle.at("radius").get<double>(), 250.0, 1e-3);
  EXPECT_NEAR(circle.at("rms").get<double>(), 0.002, 2e-4);

  std::string centre = csvRow({kNorth, kEast});
  centre.pop_back();
  const nlohmann::json radius = fit({"radius", "--center", centre}, circleRows(80.0, 0.005, 10, 1.0));
  EXPECT_NEAR(radius.at("radius").get<double>(), 80.0, 1e-9);
  EXPECT_NEAR(radius.at("rms").get<double>(), 0.005, 1e-9);

  // Bad rows are left out of the fit, which is written from the others.
  const svy_test::SvyResult r = svy_test::runSvy({"fit", "line"}, "# levels\nn,e\n3,1\n4\n5,2\nx,9\n7,3\n");
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
    const svy_test::SvyResult r = svy_test::runSvy({"fit", c.verb}, c.input);
    EXPECT_EQ(r.exitStatus, 1) << c.message;
    EXPECT_LE(r.lines().size(), 1U) << c.message;
    EXPECT_NE(r.err.find(c.message), std::string::npos) << r.err;
  }
}

}  // namespace
