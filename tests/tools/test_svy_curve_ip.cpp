// svy curve ip: rows of previous point, IP and next point give the group the library lays out, to the last
// bit under --full-precision; a row that defines no group is reported by line while the others come out.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "svy_runner.h"
#include "svymath/curves/curve_ip.h"
#include "svymath/foundation/constants.h"

namespace {

using svy_test::csvRow;
using svy_test::runSvy;

TEST(CurveIpVerb, RowsAreTheLibraryGroup) {
  const struct {
    const char* type;
    double radius, lenIn, lenOut, row[6];  // n_prev, e_prev, n_ip, e_ip, n_next, e_next
  } cases[] = {{"clothoid", 300.0, 80.0, 40.0, {5000000.0, 500000.0, 5000500.0, 500000.0, 5000800.0, 500400.0}},
               {"cubic", 600.0, 100.0, 0.0, {10.0, 20.0, 410.0, 320.0, 800.0, 300.0}}};
  for (const auto& c : cases) {
    const double* v = c.row;
    const svy_test::SvyResult r =
        runSvy({"--full-precision", "curve", "ip", "--radius", std::to_string(c.radius), "--spiral-in",
                std::to_string(c.lenIn), "--spiral-out", std::to_string(c.lenOut), "--type", c.type},
               csvRow({v[0], v[1], v[2], v[3], v[4], v[5]}));
    ASSERT_EQ(r.lines().size(), 2u) << r.err;
    CCurveIp g;
    g.setSpiralType(std::string(c.type) == "cubic" ? eMathSpiralCubic : eMathSpiralEuler);
    ASSERT_TRUE(g.setIp(v[2], v[3], c.radius, c.lenIn, c.lenOut) &&
                g.setNeighbours(C2dPos(v[0], v[1]), C2dPos(v[4], v[5])));
    std::vector<double> expected = {g.getDeflection() * svy_math::units::kRadToDeg,
                                    g.getTangentIn(),
                                    g.getTangentOut(),
                                    g.getShiftIn(),
                                    g.getShiftOut(),
                                    g.getTotalLength()};
    for (const C2dPos& p : {g.getTS(), g.getSC(), g.getCS(), g.getST()}) {
      expected.insert(expected.end(), {p.north(), p.east()});
    }
    const std::vector<std::string> fields = svy_test::splitCsvLine(r.lines()[1]);
    ASSERT_EQ(fields.size(), expected.size());
    for (std::size_t i = 0; i < fields.size(); ++i) EXPECT_EQ(std::stod(fields[i]), expected[i]) << i;
  }
}

TEST(CurveIpVerb, BadRowsAreReportedByLine) {
  const std::string input =
      "n_prev,e_prev,n_ip,e_ip,n_next,e_next\n"
      "0,0,100,0,160,80\n"
      "0,0,100,0,200,0\n"  // straight on
      "0,0,100,0,110,2\n"  // 11.3 degrees, 0.4 rad of spiral
      "0,0,100,0\n"
      "0,0,0,0,100,100\n"  // previous point on the IP
      "0,0,100,0,50,0\n"   // back on itself
      "0,0,100,0,160,-80\n";
  const svy_test::SvyResult r =
      runSvy({"curve", "ip", "--radius", "100", "--spiral-in", "40", "--spiral-out", "40"}, input);
  EXPECT_EQ(r.exitStatus, 1);
  const std::vector<std::string> out = r.lines(), err = r.errLines();
  ASSERT_EQ(out.size(), 3u) << r.err;
  EXPECT_EQ(out[0],
            "deflection_deg,tangent_in,tangent_out,shift_in,shift_out,length,ts_n,ts_e,sc_n,sc_e,cs_n,cs_e,"
            "st_n,st_e");
  EXPECT_EQ(out[1].rfind("53.130102,", 0), 0u);
  EXPECT_EQ(out[2].rfind("-53.130102,", 0), 0u);
  const std::vector<std::string> messages = {
      "svy: line 3: the tangents run straight on through the IP: no curve to fit",
      "svy: line 4: the spirals turn further than the deflection of 11.30993247 degrees",
      "svy: line 5: expected 6 numbers, got 4", "svy: line 6: the previous or the next point coincides with the IP",
      "svy: line 7: the tangents turn back on themselves at the IP"};
  EXPECT_EQ(err, messages);
  const svy_test::SvyResult cubic =
      runSvy({"curve", "ip", "--radius", "50", "--spiral-in", "80", "--type", "cubic"}, "0,0,100,0,100,100\n");
  EXPECT_EQ(cubic.err, "svy: line 1: no cubic spiral of the given length reaches radius 50\n");
  EXPECT_EQ(runSvy({"curve", "ip", "--spiral-in", "10"}, "").exitStatus, 2);  // the radius is required
  EXPECT_EQ(runSvy({"curve", "ip", "--radius", "100", "--spiral-out", "-1"}, "").exitStatus, 2);
}

}  // namespace
