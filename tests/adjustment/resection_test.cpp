// Free-station resection: observations computed from a known station give it back, in every mix of
// observations the geometry allows; with noise the stated standard deviations cover the errors at the
// normal rates; degenerate setups fail with their codes; the height alone from zenith angles.
#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "svymath/adjustment/three_d_resection.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_math::TResectionObservation;
using svy_math::units::kDegToRad;

struct Station {
  double north, east, height, orientation, instrumentHeight;
};

const Station kStation{5213400.0, 498700.0, 412.35, 37.0 * kDegToRad, 1.55};
// Known points around the station (north, east, height, target height): 80 m to 420 m away.
const double kTargets[][4] = {{5213650.2, 498750.9, 430.1, 1.8},
                              {5213480.7, 499110.3, 398.2, 0.0},
                              {5213250.0, 498620.5, 415.0, 2.1},
                              {5213390.4, 498480.2, 405.5, 1.3}};

// The observation a perfect instrument at the station makes of target i (the forward model: curvature and
// refraction k = 0.13 on the line of sight), keeping what `what` names: 'h' direction, 'z' zenith,
// 's' slope distance.
TResectionObservation observe(const Station& st, int i, const char* what) {
  TResectionObservation o;
  o.north = kTargets[i][0], o.east = kTargets[i][1], o.height = kTargets[i][2], o.targetHeight = kTargets[i][3];
  const double dn = o.north - st.north, de = o.east - st.east, d = std::hypot(dn, de);
  const double dh = o.height + o.targetHeight - st.height - st.instrumentHeight - (1 - 0.13) * d * d / (2 * 6.371e6);
  for (const char* c = what; *c; ++c) {
    if (*c == 'h') o.direction = std::atan2(de, dn) - st.orientation;
    if (*c == 'z') o.zenith = std::atan2(d, dh);
    if (*c == 's') o.slopeDistance = std::hypot(d, dh);
    if (*c == 'd') o.slopeDistance = d;  // a horizontal distance (2-D setups)
  }
  return o;
}

TEST(ThreeDResection, RecoversKnownStationFromEveryObservationMix) {
  const struct {
    const char* mix[4];  // per target; nullptr: not sighted
    bool withHeight;
  } cases[] = {{{"hzs", "hzs", "hzs", "hzs"}, true}, {{"hzs", "hzs", nullptr, nullptr}, true},
               {{"hz", "hz", "hz", "hz"}, true},      {{"h", "h", "h", nullptr}, false},
               {{"hd", "hd", nullptr, nullptr}, false}, {{"d", "d", "h", "h"}, false},
               {{"hzs", "z", "hs", "h"}, true},      {{"zs", "zs", "h", "h"}, true}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c.mix[0] << " " << c.mix[1] << " " << (c.mix[2] ? c.mix[2] : "-"));
    std::vector<TResectionObservation> obs;
    for (int i = 0; i < 4; ++i)
      if (c.mix[i]) obs.push_back(observe(kStation, i, c.mix[i]));
    svy_math::TResectionResult r;
    ASSERT_EQ(ThreeDResection(obs.data(), static_cast<int>(obs.size()), kStation.instrumentHeight,
                              svy_math::TResectionAccuracy(), r),
              svy_math::eResOk);
    EXPECT_NEAR(r.north, kStation.north, 1e-6);
    EXPECT_NEAR(r.east, kStation.east, 1e-6);
    EXPECT_NEAR(std::remainder(r.orientation - kStation.orientation, svy_math::units::kTwoPi), 0.0, 1e-9);
    EXPECT_EQ(std::isnan(r.height), !c.withHeight);
    if (c.withHeight) {
      EXPECT_NEAR(r.height, kStation.height, 1e-6);
    }
    ASSERT_EQ(r.residuals.size(), obs.size());
    for (const auto& v : r.residuals) EXPECT_FALSE(std::fabs(v.direction) > 1e-9 || std::fabs(v.distance) > 1e-6);
  }
}

// Noise at the a-priori accuracies: the error of each result lies within one stated standard deviation
// about 68.3% of the time and within two about 95.4% (binomial spread over 400 trials: +-2.3% and +-1%);
// sigma0 averages near 1.
TEST(ThreeDResection, StandardDeviationsCoverTheErrorsAtTheExpectedRate) {
  const svy_math::TResectionAccuracy acc;
  std::mt19937_64 engine(315);
  std::normal_distribution<double> unit(0.0, 1.0);
  constexpr int kTrials = 400;
  int within1[3] = {0, 0, 0}, within2[3] = {0, 0, 0};
  double sumSigma0Sq = 0.0;
  for (int trial = 0; trial < kTrials; ++trial) {
    std::vector<TResectionObservation> obs;
    for (int i = 0; i < 4; ++i) {
      TResectionObservation o = observe(kStation, i, "hzs");
      o.direction += acc.direction * unit(engine);
      o.zenith += acc.zenith * unit(engine);
      o.slopeDistance += (acc.distanceConstant + acc.distancePpm * 1e-6 * o.slopeDistance) * unit(engine);
      obs.push_back(o);
    }
    svy_math::TResectionResult r;
    ASSERT_EQ(ThreeDResection(obs.data(), 4, kStation.instrumentHeight, acc, r), svy_math::eResOk);
    const double err[3][2] = {{r.north - kStation.north, r.sdNorth},
                              {r.east - kStation.east, r.sdEast},
                              {r.height - kStation.height, r.sdHeight}};
    for (int k = 0; k < 3; ++k) {
      within1[k] += std::fabs(err[k][0]) < err[k][1] ? 1 : 0;
      within2[k] += std::fabs(err[k][0]) < 2 * err[k][1] ? 1 : 0;
    }
    sumSigma0Sq += r.sigma0 * r.sigma0;
  }
  for (int k = 0; k < 3; ++k) {
    EXPECT_NEAR(within1[k] / double(kTrials), 0.683, 0.07) << k;
    EXPECT_NEAR(within2[k] / double(kTrials), 0.954, 0.035) << k;
  }
  EXPECT_NEAR(sumSigma0Sq / kTrials, 1.0, 0.15);
}

TEST(ThreeDResection, DegenerateSetupsFailWithTheirCodes) {
  const svy_math::TResectionAccuracy acc;
  svy_math::TResectionResult r;
  r.north = 1.0;
  std::vector<TResectionObservation> obs = {observe(kStation, 0, "hzs")};
  EXPECT_EQ(ThreeDResection(obs.data(), 1, 1.5, acc, r), svy_math::eResTooFewObservations);
  obs.push_back(observe(kStation, 1, "zs"));
  obs[0] = observe(kStation, 0, "zs");
  EXPECT_EQ(ThreeDResection(obs.data(), 2, 1.5, acc, r), svy_math::eResTooFewObservations);  // no direction
  obs = {observe(kStation, 0, "h"), observe(kStation, 1, "h")};
  EXPECT_EQ(ThreeDResection(obs.data(), 2, 1.5, acc, r), svy_math::eResTooFewObservations);  // 2 rows, 3 unknowns
  obs = {observe(kStation, 0, "h"), observe(kStation, 0, "h"), observe(kStation, 0, "h")};
  EXPECT_EQ(ThreeDResection(obs.data(), 3, 1.5, acc, r), svy_math::eResDegenerate);  // one point thrice
  // Two distances and one direction: the mirror image across the base fits as well.
  obs = {observe(kStation, 0, "d"), observe(kStation, 1, "d"), observe(kStation, 2, "h")};
  EXPECT_EQ(ThreeDResection(obs.data(), 3, 1.5, acc, r), svy_math::eResDegenerate);
  obs = {observe(kStation, 0, "hzs"), observe(kStation, 1, "hzs")};
  obs[1].north = std::numeric_limits<double>::infinity();
  EXPECT_EQ(ThreeDResection(obs.data(), 2, 1.5, acc, r), svy_math::eResNotFinite);
  EXPECT_EQ(r.north, 1.0);
}

// The height alone: from slope distances and zenith angles, or from zenith angles and the station's known
// plan position; a sighting without a zenith angle does not count.
TEST(HeightInResection, FromZenithAnglesAndDistancesOrCoordinates) {
  const svy_math::TResectionAccuracy acc;
  const C2dPos station(kStation.north, kStation.east);
  const struct {
    const char* what;
    const C2dPos* station;
  } cases[] = {{"zs", nullptr}, {"z", &station}, {"hzs", &station}};
  for (const auto& c : cases) {
    std::vector<TResectionObservation> obs;
    for (int i = 0; i < 4; ++i) obs.push_back(observe(kStation, i, c.what));
    obs.push_back(observe(kStation, 0, "hs"));
    double h = 0, sd = 0;
    ASSERT_EQ(HeightInResection(obs.data(), 5, kStation.instrumentHeight, c.station, acc, h, sd), svy_math::eResOk);
    EXPECT_NEAR(h, kStation.height, 1e-9) << c.what;
    EXPECT_GT(sd, 0.0);
    EXPECT_LT(sd, 0.005);
  }
  const TResectionObservation noZenith = observe(kStation, 0, "hs");
  double h = 7, sd = 7;
  EXPECT_EQ(HeightInResection(&noZenith, 1, 1.5, &station, acc, h, sd), svy_math::eResTooFewObservations);
  EXPECT_EQ(h, 7.0);
}

}  // namespace
