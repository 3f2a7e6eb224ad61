// Geodetic and Cartesian positions, local frames, geodesic azimuths and GPS time, against an independent
// geodesy library, closed formulas and an independent day count.
#include <gtest/gtest.h>

#include <GeographicLib/Geocentric.hpp>
#include <GeographicLib/Geodesic.hpp>
#include <GeographicLib/LocalCartesian.hpp>
#include <algorithm>
#include <climits>
#include <cmath>
#include <cstdint>
#include <limits>
#include <random>
#include <utility>
#include <vector>

#include "support/csv.h"
#include "support/refdata.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/geodesy/ellipsoid.h"
#include "svymath/geodesy/geo_coord.h"
#include "svymath/geodesy/gps_time.h"
#include "svymath/geodesy/local_frame.h"

namespace {

using Vec3 = svy_math::TAbstractPoint3<double>;
using svy_math::units::kDegToRad;
using svy_math::units::kHalfPi;
using svy_math::units::kPi;
using svy_math::units::kTwoPi;

// Forward: both sides evaluate closed formulas, a few ulps of 2.6e7 m. Reverse (as a distance): the latitude
// iteration stops on a change of 1e-10 in tan(B) and contracts by ~e^2 per step, which leaves up to
// ~7e-13 rad (4 micrometres) at low latitudes.
constexpr double kForwardTol = 1e-7;
constexpr double kReverseTol = 1e-5;

Coord toCartesian(double latDeg, double lonDeg, double h) {
  return Coord().blh2xyz(GeoCoord(latDeg * kDegToRad, lonDeg * kDegToRad, h));
}

GeoCoord toGeodetic(const Coord& c) { return GeoCoord().xyz2blh(c); }

double distance(const Coord& p, const Coord& q) { return (p - q).Module(); }

const GeographicLib::Geocentric& independentEarth() {
  static const GeographicLib::Geocentric earth(svy_math::ellipsoidParams().a,
                                               1.0 - std::sqrt(1.0 - svy_math::ellipsoidParams().e2));
  return earth;
}

// Over a global grid (poles, 1e-7 deg from them, both sides of the antimeridian, heights from below sea
// level to GNSS orbit): forward against the independent library, and reverse judged by where the result
// lies, which stays meaningful at the poles where the longitude is arbitrary.
TEST(GeodeticCartesian, MatchesIndependentLibraryOverGlobalGrid) {
  const GeographicLib::Geocentric& earth = independentEarth();
  for (int i = -13; i <= 13; ++i) {
    const double lat = i == 13 ? 89.9999999 : i == -13 ? -90.0 : 7.5 * i;
    for (int j = -13; j <= 12; ++j) {
      const double lon = j == -13 ? -179.9999999 : 15.0 * j;
      for (double h : {-1000.0, 0.0, 8848.86, 1.0e5, 2.02e7}) {
        double x = 0, y = 0, z = 0;
        earth.Forward(lat, lon, h, x, y, z);
        const Coord expected(x, y, z);
        ASSERT_LT(distance(toCartesian(lat, lon, h), expected), kForwardTol) << lat << " " << lon << " " << h;
        const GeoCoord g = toGeodetic(expected);
        earth.Forward(g.lat() / kDegToRad, g.lon() / kDegToRad, g.height(), x, y, z);
        ASSERT_LT(distance(Coord(x, y, z), expected), kReverseTol) << lat << " " << lon << " " << h;
      }
    }
  }
}

// The equator on the prime meridian (exactly on the X axis both ways); the centre of the earth (h = -a); the
// polar axis, within 1e-10 m of it, where the height is |Z| - b; a western longitude, which comes back
// increased by 2 pi.
// 516 points computed independently for the stored eccentricity (columns *_e0818191913305) and for the usual
// flattening (*_wgs84): the stored decimal e puts positions 0.1 to 0.5 mm from the usual ellipsoid, and this
// table pins which of the two the library uses. It stays in the shared reference folder (optional).
TEST(GeodeticCartesian, MatchesReferenceTableForTheStoredEccentricity) {
  SVY_SKIP_WITHOUT_REFDATA();
  const svy_test::CsvTable t = svy_test::readCsvTable(svy_test::refdataPath("geodetic/geodetic_ecef_cartconvert.csv"));
  ASSERT_EQ(t.rows.size(), 516u);
  double largestEllipsoidDifference = 0.0;
  for (const auto& row : t.rows) {
    const Coord expected(row[t.column("X_e0818191913305")], row[t.column("Y_e0818191913305")],
                         row[t.column("Z_e0818191913305")]);
    const Coord c = toCartesian(row[t.column("lat_deg")], row[t.column("lon_deg")], row[t.column("h_m")]);
    ASSERT_LT(distance(c, expected), kForwardTol) << row[0] << " " << row[1] << " " << row[2];
    ASSERT_LT(distance(Coord().blh2xyz(toGeodetic(expected)), expected), kReverseTol);
    const Coord usual(row[t.column("X_wgs84")], row[t.column("Y_wgs84")], row[t.column("Z_wgs84")]);
    largestEllipsoidDifference = std::max(largestEllipsoidDifference, distance(c, usual));
  }
  EXPECT_GT(largestEllipsoidDifference, 1e-4);
  EXPECT_LT(largestEllipsoidDifference, 1e-3);
}

TEST(GeodeticCartesian, SpecialPositions) {
  EXPECT_EQ(toCartesian(0.0, 0.0, 0.0), Coord(6378137.0, 0.0, 0.0));
  const double b = std::sqrt(1.0 - 0.0818191913305 * 0.0818191913305) * 6378137.0;
  const struct {
    Coord xyz;
    double lat, lon, h;
  } cases[] = {{Coord(6378137.0, 0, 0), 0, 0, 0},
               {Coord(0, 0, 0), 0, 0, -6378137.0},
               {Coord(0, 0, 7e6), kHalfPi, 0, 7e6 - b},
               {Coord(5e-11, 0, -10.0), -kHalfPi, 0, 10.0 - b},
               {toCartesian(10.0, -75.5, 10.0), 10.0 * kDegToRad, 284.5 * kDegToRad, 10.0}};
  for (const auto& c : cases) {
    const GeoCoord g = toGeodetic(c.xyz);
    EXPECT_NEAR(g.lat(), c.lat, 1e-12) << c.xyz.x() << " " << c.xyz.z();
    EXPECT_NEAR(g.lon(), c.lon, 1e-15);
    EXPECT_NEAR(g.height(), c.h, kReverseTol);
  }
}

// Non-finite input gives NaN at once. Absurd finite input terminates: squares that overflow, a huge Z just
// off the axis (tan B overflows), and the slowest region of the iteration, about 42.7 km from the axis a few
// micrometres off the equatorial plane, where the latitude map has a slope near 1 (millions of steps).
TEST(GeodeticCartesian, NonFiniteAndAbsurdInputEnds) {
  const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
  for (const Coord& c : {Coord(nan, 0, 0), Coord(1e6, 1e6, nan), Coord(0, -inf, 1), Coord(1e6, 0, inf)}) {
    const GeoCoord g = toGeodetic(c);
    EXPECT_TRUE(std::isnan(g.lat()) && std::isnan(g.lon()) && std::isnan(g.height()));
  }
  EXPECT_FALSE(std::isnan(toGeodetic(Coord(1e300, 1e300, 1e300)).lon()));
  const GeoCoord steep = toGeodetic(Coord(2e-10, 0.0, 1e300));
  EXPECT_TRUE(std::isnan(steep.lat()) || std::fabs(steep.lat()) <= kHalfPi);
  EXPECT_LT(std::fabs(toGeodetic(Coord(42697.673, 0.0, 6.9e-6)).lat()), 0.01);
}

// (east, north, up) of Cartesian differences against an independent local Cartesian frame, at origins that
// include both poles, the antimeridian and the equator, for targets near and far (a rotation of a vector of
// up to 2.6e7 m: a few ulps).
TEST(LocalFrame, MatchesIndependentLocalCartesian) {
  const double origins[][3] = {
      {0.0, 0.0, 0.0},      {53.8, 2.13, 73.0}, {-33.9, 151.2, 40.0},        {90.0, 0.0, 0.0},
      {-90.0, 30.0, 100.0}, {12.5, 180.0, 0.0}, {-45.0, -179.9999999, 10.0}, {89.9999999, -75.0, 3000.0}};
  for (const auto& o : origins) {
    const GeographicLib::LocalCartesian frame(o[0], o[1], o[2], independentEarth());
    const Coord origin = toCartesian(o[0], o[1], o[2]);
    for (double dLat : {-30.0, -0.001, 0.0, 2.0})
      for (double dLon : {-90.0, 0.0, 0.00002, 45.0})
        for (double h : {-50.0, 1500.0, 2.02e7}) {
          const double lat = std::max(-90.0, std::min(90.0, o[0] + dLat)), lon = o[1] + dLon;
          double enu[3] = {0, 0, 0};
          frame.Forward(lat, lon, h, enu[0], enu[1], enu[2]);
          const Vec3 local =
              blh_to_neu(Vec3(o[0] * kDegToRad, o[1] * kDegToRad, o[2]), toCartesian(lat, lon, h) - origin);
          for (int k = 0; k < 3; ++k)
            ASSERT_NEAR(local[k], enu[k], 1e-7) << o[0] << " " << o[1] << ": " << lat << " " << lon << " " << h;
        }
  }
}

// Polar form (elevation, azimuth clockwise from north in [0, 2 pi), slope distance) of the vector built from
// it. A vector without direction (horizontal length squared and up both inside +-1e-12, so anything up to
// 1e-6 m across with no height) gives the largest double for both angles and a zero distance.
TEST(LocalPolar, RecoversAzimuthElevationAndDistance) {
  const double cases[][3] = {{0.0, 0.0, 100.0},  {90.0, 10.0, 25.0}, {180.0, -5.0, 1000.0},
                             {270.0, 45.0, 3.5}, {-0.5, 1.0, 2.0e7}, {359.9999, -89.0, 0.01},
                             {0.0, 90.0, 12.0},  {0.0, -90.0, 12.0}, {123.456, 0.0, 1e-5}};
  for (const auto& c : cases) {
    SCOPED_TRACE(::testing::Message() << c[0] << " " << c[1] << " " << c[2]);
    const double az = c[0] * kDegToRad, el = c[1] * kDegToRad;
    const Vec3 polar =
        neu_to_polar(Vec3(c[2] * std::cos(el) * std::sin(az), c[2] * std::cos(el) * std::cos(az), c[2] * std::sin(el)));
    EXPECT_NEAR(polar[0], el, 1e-14);
    if (std::fabs(c[1]) < 90.0) {
      EXPECT_NEAR(polar[1], std::fmod(az + kTwoPi, kTwoPi), 1e-14);
    }
    EXPECT_TRUE(polar[1] >= 0.0 && polar[1] < kTwoPi) << polar[1];
    EXPECT_NEAR(polar[2], c[2], 1e-9 * c[2]);
  }
  const double kMax = std::numeric_limits<double>::max();
  for (const Vec3& v : {Vec3(0.0, 0.0, 0.0), Vec3(5e-7, -5e-7, 0.0), Vec3(0.0, 0.0, -9e-13)}) {
    const Vec3 polar = neu_to_polar(v);
    EXPECT_TRUE(polar[0] == kMax && polar[1] == kMax && polar[2] == 0.0) << v[0] << " " << v[2];
  }
  const Vec3 justAbove = neu_to_polar(Vec3(1.1e-6, 0.0, 0.0));
  EXPECT_EQ(justAbove[1], svy_math::units::kPi / 2);
  EXPECT_NEAR(justAbove[2], 1.1e-6, 1e-20);
}

bool setAzimuthDeg(CMathAngle& az, double lat1, double lon1, double lat2, double lon2) {
  return az.setAzFromLatLon(lat1 * kDegToRad, lon1 * kDegToRad, lat2 * kDegToRad, lon2 * kDegToRad);
}

// Random pairs against the independent geodesic solution: all over the ellipsoid, survey-scale lines (up to
// ~1 km), and pairs within a degree of the antipode, where a classic iteration on the longitude oscillates:
// every pair gets the geodesic's azimuth.
TEST(GeodesicAzimuth, MatchesIndependentInverse) {
  const GeographicLib::Geodesic geodesic(independentEarth().EquatorialRadius(), independentEarth().Flattening());
  std::mt19937_64 engine(20260101);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  for (int i = 0; i < 6000; ++i) {
    const double lat1 = unit(engine) * 180.0 - 90.0, lon1 = unit(engine) * 360.0 - 180.0;
    double lat2 = unit(engine) * 180.0 - 90.0, lon2 = unit(engine) * 360.0 - 180.0;
    if (i % 3 == 1) lat2 = lat1 + (lat2 / 90.0) * 0.01, lon2 = lon1 + (lon2 / 180.0) * 0.01;
    if (i % 3 == 2) lat2 = -lat1 + lat2 / 90.0, lon2 = lon1 + 180.0 + lon2 / 180.0;
    lat2 = std::max(-90.0, std::min(90.0, lat2));
    double distance = 0, azi1 = 0, azi2 = 0;
    geodesic.Inverse(lat1, lon1, lat2, lon2, distance, azi1, azi2);
    CMathAngle az;
    ASSERT_TRUE(setAzimuthDeg(az, lat1, lon1, lat2, lon2));
    ASSERT_LT(std::fabs(std::remainder(az.getRad() - azi1 * kDegToRad, kTwoPi)), 1e-9)
        << lat1 << " " << lon1 << " -> " << lat2 << " " << lon2;
  }
}

// Meridians (from a pole too) and the equator, across the antimeridian: due north, south (stored as +pi),
// east or west. Exact antipodes (NaN here) still give a direction within [-pi, pi]. Coincident or invalid
// positions (radians) give none and leave the angle as it was.
TEST(GeodesicAzimuth, CardinalDirectionsAndNoDirection) {
  const double any = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
  const double cardinal[][5] = {{10, 20, 50, 20, 0},  {50, -120, -10, -120, 180}, {0, 10, 0, 40, 90},
                                {0, 10, 0, -20, -90}, {0, 179, 0, -179, 90},      {-45, -179.5, -40, -179.5, 0},
                                {-90, 0, 10, 0, 0},   {0, 0, 0, 180, any},        {30, 0, -30, 180, any}};
  for (const auto& c : cardinal) {
    SCOPED_TRACE(::testing::Message() << c[0] << " " << c[1] << " -> " << c[2] << " " << c[3]);
    CMathAngle az;
    ASSERT_TRUE(setAzimuthDeg(az, c[0], c[1], c[2], c[3]));
    if (std::isnan(c[4]))
      EXPECT_LE(std::fabs(az.getRad()), kPi);
    else
      EXPECT_NEAR(az.getRad(), c[4] * kDegToRad, 1e-12);
  }
  const double none[][4] = {{0.5, 0.3, 0.5, 0.3}, {0.5, 0.3, 0.5, 0.3 + kTwoPi}, {any, 0.0, 0.1, 0.1},
                            {0.1, 0.1, 0.2, inf}, {1.6, 0.0, 0.0, 0.0},          {0.0, 0.0, -2.0, 0.0}};
  for (const auto& c : none) {
    CMathAngle az(30.0);
    EXPECT_FALSE(az.setAzFromLatLon(c[0], c[1], c[2], c[3])) << c[0] << " " << c[3];
    EXPECT_NEAR(az.getDeg(), 30.0, 1e-12);
  }
}

Coord onSphere(double latDeg, double lonDeg, double radius) {
  const double lat = latDeg * kDegToRad, lon = lonDeg * kDegToRad;
  return Coord(radius * std::cos(lat) * std::cos(lon), radius * std::cos(lat) * std::sin(lon), radius * std::sin(lat));
}

// The angle at the earth's centre against the haversine formula, for radii that differ (the angle depends on
// the directions only); tiny and opposite angles keep their precision; a zero or non-finite vector has none.
TEST(GeocentricAngle, MatchesHaversineAndEdgeCases) {
  std::mt19937_64 engine(7);
  std::uniform_real_distribution<double> lat(-90.0, 90.0), lon(-180.0, 180.0), radius(1.0, 2.0e7);
  for (int i = 0; i < 2000; ++i) {
    const double lat1 = lat(engine), lon1 = lon(engine), lat2 = lat(engine), lon2 = lon(engine);
    const double h =
        std::pow(std::sin((lat2 - lat1) * kDegToRad / 2), 2) +
        std::cos(lat1 * kDegToRad) * std::cos(lat2 * kDegToRad) * std::pow(std::sin((lon2 - lon1) * kDegToRad / 2), 2);
    const double expected = 2.0 * std::asin(std::min(1.0, std::sqrt(h)));
    const Coord a = onSphere(lat1, lon1, radius(engine)), b = onSphere(lat2, lon2, radius(engine));
    ASSERT_NEAR(rotRange(a, b), expected, 1e-12);
    ASSERT_NEAR(rotRange(b, a), expected, 1e-12);
  }
  const Coord p = onSphere(37.0, -122.0, 6378137.0), zero(0.0, 0.0, 0.0);
  EXPECT_EQ(rotRange(p, p), 0.0);
  EXPECT_NEAR(rotRange(p, Coord(-p.x(), -p.y(), -p.z())), kPi, 1e-15);
  EXPECT_NEAR(rotRange(onSphere(0.0, 0.0, 1.0), onSphere(0.0, 1e-9, 5.0)), 1e-9 * kDegToRad, 1e-22);
  for (const auto& pair :
       {std::make_pair(p, zero), std::make_pair(zero, p), std::make_pair(p, Coord(std::nan(""), 0, 1))})
    EXPECT_TRUE(std::isnan(rotRange(pair.first, pair.second)));
}

constexpr double kSecondsPerWeek = 604800.0;
// Seconds of week reach 6e5 s; the conversions lose a few ulps (1e-10 s) on the way.
constexpr double kSecondTol = 1e-6;

// Independent day count: days from 1970-01-01 to a proleptic Gregorian date (the well-known
// days-from-civil algorithm over 400-year eras, with March as the first month of the computing year).
std::int64_t daysFromCivil(int year, int month, int day) {
  const std::int64_t y = year - (month <= 2 ? 1 : 0);
  const std::int64_t era = (y >= 0 ? y : y - 399) / 400;
  const std::int64_t yearOfEra = y - era * 400;
  const std::int64_t dayOfYear = (153 * (month > 2 ? month - 3 : month + 9) + 2) / 5 + day - 1;
  return era * 146097 + yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear - 719468;
}

struct CalendarTime {
  int year, month, day, dayOfYear, hour, minute;
  double second;
};

CalendarTime fromGps(int week, double secondsOfWeek) {
  CalendarTime t{};
  gps_to_ymdhms(week, secondsOfWeek, &t.year, &t.month, &t.day, &t.hour, &t.minute, &t.second);
  int yearByDay = 0, hour = 0, minute = 0;
  double second = 0.0;
  gps_to_ydhms(week, secondsOfWeek, &yearByDay, &t.dayOfYear, &hour, &minute, &second);
  EXPECT_EQ(yearByDay, t.year);
  return t;
}

// Every day from 1901 to 2099 at two times of day (fixed ones at boundaries and a spread), both directions
// and both calendar forms, against the independent day count. Before the epoch the week is truncated toward
// zero, so the seconds of week can be negative; back from a week by floor division they are never negative.
TEST(GpsTimeCalendar, EveryDayOfTheValidRangeMatchesIndependentDayCount) {
  static const double kFixed[] = {0.0, 0.25, 59.5, 3599.5, 3600.0, 43200.0, 45296.789, 86399.5};
  const std::int64_t epochDays = daysFromCivil(1980, 1, 6);
  std::int64_t dayIndex = 0;
  for (int year = 1901; year <= 2099; ++year)
    for (int month = 1; month <= 12; ++month) {
      const std::int64_t monthStart = daysFromCivil(year, month, 1);
      const int monthDays = static_cast<int>(daysFromCivil(year + month / 12, month % 12 + 1, 1) - monthStart);
      for (int day = 1; day <= monthDays; ++day, ++dayIndex) {
        SCOPED_TRACE(::testing::Message() << year << "-" << month << "-" << day);
        const std::int64_t days = monthStart + day - 1 - epochDays;
        int dayOfYear = 0;
        mday_to_yday(year, month, day, &dayOfYear);
        ASSERT_EQ(dayOfYear, monthStart + day - daysFromCivil(year, 1, 1));
        for (const double timeOfDay :
             {kFixed[dayIndex % 8], std::fmod(static_cast<double>(dayIndex) * 7919.37, 86400.0)}) {
          const int hour = static_cast<int>(timeOfDay / 3600.0);
          const int minute = static_cast<int>((timeOfDay - hour * 3600.0) / 60.0);
          const double second = timeOfDay - hour * 3600.0 - minute * 60.0;
          int week = 0, weekByDay = 0;
          double secondsOfWeek = 0.0, secondsByDay = 0.0;
          ymdhms_to_gps(year, month, day, hour, minute, second, &week, &secondsOfWeek);
          ASSERT_NEAR(week * kSecondsPerWeek + secondsOfWeek, static_cast<double>(days) * 86400.0 + timeOfDay,
                      kSecondTol);
          ASSERT_TRUE(days >= 0 ? secondsOfWeek >= 0.0 && secondsOfWeek < kSecondsPerWeek
                                : week <= 0 && secondsOfWeek > -kSecondsPerWeek)
              << week << " " << secondsOfWeek;
          ydhms_to_gps(year, dayOfYear, hour, minute, second, &weekByDay, &secondsByDay);
          ASSERT_EQ(weekByDay, week);
          ASSERT_EQ(secondsByDay, secondsOfWeek);

          const std::int64_t floorWeek = (days >= 0 ? days : days - 6) / 7;
          const CalendarTime back =
              fromGps(static_cast<int>(floorWeek), static_cast<double>(days - 7 * floorWeek) * 86400.0 + timeOfDay);
          ASSERT_TRUE(back.year == year && back.month == month && back.day == day && back.dayOfYear == dayOfYear);
          ASSERT_NEAR(back.hour * 3600.0 + back.minute * 60.0 + back.second, timeOfDay, kSecondTol);
          ASSERT_TRUE(back.hour >= 0 && back.hour < 24 && back.minute >= 0 && back.minute < 60);
        }
      }
    }
  EXPECT_EQ(dayIndex, daysFromCivil(2100, 1, 1) - daysFromCivil(1901, 1, 1));
  // Six days before the epoch, the start of the range, and a published anchor.
  const int anchors[][5] = {{1979, 12, 31, 0, -518400}, {1901, 1, 1, -4122, -432000}, {1999, 1, 1, 990, 432000}};
  for (const auto& a : anchors) {
    int week = -1;
    double secondsOfWeek = 0.0;
    ymdhms_to_gps(a[0], a[1], a[2], 0, 0, 0.0, &week, &secondsOfWeek);
    EXPECT_TRUE(week == a[3] && secondsOfWeek == a[4]) << a[0] << " " << week << " " << secondsOfWeek;
  }
}

// Inputs that cannot name a day give undefined results (NaN seconds, zero fields), never a table read
// out of bounds, an integer overflow or a hang.
// Generated calendar/GPS pairs: the epoch, week ends, day 366, both week-number rollovers (1999-08-22,
// 2019-04-07), 2099-12-31 and fractional seconds, both directions. Rows before the epoch use floor-divided
// weeks, which this library truncates toward zero instead; they are left to the day-count sweep.
TEST(GpsTimeCalendar, MatchesGeneratedVectorsIncludingWeekRollovers) {
  const svy_test::CsvTable t = svy_test::readCsvTable(svy_test::testdataPath("geodesy/gps_week_sow_vectors.csv"));
  ASSERT_GT(t.rows.size(), 60u);
  for (const auto& r : t.rows) {
    if (r[t.column("seconds_since_gps_epoch")] < 0.0) continue;
    const int year = static_cast<int>(r[t.column("year")]), month = static_cast<int>(r[t.column("month")]);
    const int day = static_cast<int>(r[t.column("day")]), hour = static_cast<int>(r[t.column("hour")]);
    const int minute = static_cast<int>(r[t.column("minute")]);
    const double second = r[t.column("second")];
    SCOPED_TRACE(testing::Message() << year << "-" << month << "-" << day << " " << hour << ":" << minute);
    int week = -1;
    double sow = -1.0;
    ymdhms_to_gps(year, month, day, hour, minute, second, &week, &sow);
    EXPECT_EQ(week, static_cast<int>(r[t.column("gps_week")]));
    EXPECT_NEAR(sow, r[t.column("seconds_of_week")], 1e-6);
    int y = 0, mo = 0, d = 0, h = 0, mi = 0, doy = 0;
    double s = -1.0;
    gps_to_ymdhms(week, sow, &y, &mo, &d, &h, &mi, &s);
    EXPECT_EQ(std::vector<int>({y, mo, d, h, mi}), std::vector<int>({year, month, day, hour, minute}));
    EXPECT_NEAR(s, second, 1e-6);
    mday_to_yday(year, month, day, &doy);
    EXPECT_EQ(doy, static_cast<int>(r[t.column("day_of_year")]));
  }
}

TEST(GpsTimeCalendar, InputsThatNameNoDayGiveUndefinedResults) {
  const int calendarCases[][3] = {
      {2020, 0, 1}, {2020, 13, 1}, {2020, INT_MAX, 1}, {INT_MAX, 12, 31}, {INT_MIN, 12, 31}};
  for (const auto& c : calendarCases) {
    int week = 7, dayOfYear = -1;
    double secondsOfWeek = 0.0;
    ymdhms_to_gps(c[0], c[1], c[2], 23, 59, 59.0, &week, &secondsOfWeek);
    mday_to_yday(c[0], c[1], c[2], &dayOfYear);
    EXPECT_TRUE(std::isnan(secondsOfWeek) && (c[0] != 2020 || dayOfYear == 0)) << c[0] << " " << c[1];
  }
  int dayOfYear = -1;
  mday_to_yday(2020, 12, INT_MAX, &dayOfYear);
  EXPECT_EQ(dayOfYear, 0);
  const double inf = std::numeric_limits<double>::infinity();
  const std::pair<int, double> gpsCases[] = {
      {0, std::nan("")}, {0, -inf}, {INT_MIN, 0.0}, {INT_MAX, 1e300}, {-4123, 0.0}};
  for (const auto& [week, secondsOfWeek] : gpsCases) {
    const CalendarTime t = fromGps(week, secondsOfWeek);
    EXPECT_TRUE(t.year == 0 && t.month == 0 && t.dayOfYear == 0 && std::isnan(t.second)) << week;
  }
}

}  // namespace
