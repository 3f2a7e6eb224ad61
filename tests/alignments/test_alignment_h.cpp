#include <gtest/gtest.h>

#include <cmath>

#include "alignment_test_support.h"

using namespace alnt_test;

TEST(AlignmentSmoke, BuildsAndRoundTrips) {
  const CAlntH alignment = mixedAlignment(1, 3);
  double length = 0.0;
  ASSERT_TRUE(alignment.getHLengthInM(length));
  EXPECT_GT(length, 300.0);
  for (double ch = 1000.0; ch <= 1000.0 + length; ch += 7.3) {
    for (double off : {-20.0, 0.0, 15.0}) {
      double n = 0.0, e = 0.0;
      ASSERT_TRUE(alignment.getPosNeAtChainAndOffsetExtr(ch, off, n, e));
      double c = 0.0, o = 0.0;
      ASSERT_TRUE(alignment.FindChainageAndOffset(n, e, c, o));
      EXPECT_NEAR(c, ch, 1e-6) << ch << " " << off;
      EXPECT_NEAR(o, off, 1e-6) << ch << " " << off;
    }
  }
}
