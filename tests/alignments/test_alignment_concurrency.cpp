// Several threads querying one alignment at once (run under ThreadSanitizer in CI): every query of the
// alignment takes its recursive lock (the elements fill caches inside const queries), and the batch query
// builds its index under it.
#include <gtest/gtest.h>

#include <thread>
#include <vector>

#include "alignment_test_support.h"

using namespace alnt_test;

TEST(AlignmentConcurrency, ThreadsQueryOneAlignment) {
  // Two identical alignments: the expected answers come from one, the threads share the other, untouched
  // since it was built (its search index not yet built).
  const CAlntH reference = mixedAlignment(31, 8);
  const CAlntH shared = mixedAlignment(31, 8);
  double length = 0.0;
  ASSERT_TRUE(reference.getHLengthInM(length));
  std::vector<double> north, east, chainages;
  for (double d = -20.0; d < length + 20.0; d += 11.0) {
    double n = 0.0, e = 0.0;
    ASSERT_TRUE(reference.getPosNeAtChainAndOffsetExtr(reference.distance2Chainage(d), 7.5, n, e));
    north.push_back(n);
    east.push_back(e);
    chainages.push_back(reference.distance2Chainage(d));
  }
  std::vector<TAlntStationResult> expected(north.size());
  reference.FindChainagesAndOffsets(north.data(), east.data(), north.size(), expected.data(), true);

  constexpr int kThreads = 4;
  std::vector<int> mismatches(kThreads, 0);
  std::vector<std::thread> threads;
  for (int t = 0; t < kThreads; ++t) {
    threads.emplace_back([&, t] {
      std::vector<TAlntStationResult> batch(north.size());
      for (int round = 0; round < 3; ++round) {
        shared.FindChainagesAndOffsets(north.data(), east.data(), north.size(), batch.data(), true);
        for (std::size_t k = 0; k < north.size(); ++k) {
          double c = 0.0, o = 0.0, n = 0.0, e = 0.0;
          bool extrapolated = false;
          const bool found = shared.FindChainageAndOffset(north[k], east[k], c, o, extrapolated);
          const bool positioned = shared.getPosNeAtChainAndOffsetExtr(chainages[k], 7.5, n, e);
          if (!found || c != expected[k].chainage || o != expected[k].offset || !positioned || n != north[k] ||
              e != east[k] || batch[k].chainage != expected[k].chainage) {
            ++mismatches[static_cast<std::size_t>(t)];
          }
        }
      }
    });
  }
  for (std::thread& thread : threads) thread.join();
  for (int t = 0; t < kThreads; ++t) EXPECT_EQ(mismatches[static_cast<std::size_t>(t)], 0) << t;
}

TEST(AlignmentConcurrency, LockIsRecursiveAndPerAlignment) {
  const CAlntH alignment = mixedAlignment(32, 1);
  CAlntAccessGuard outer(alignment);
  double c = 0.0, o = 0.0;
  // The search takes the lock again on this thread without blocking.
  EXPECT_TRUE(alignment.FindChainageAndOffset(kNorth0 + 1.0, kEast0 + 1.0, c, o));
  // A copy has its own lock: another thread can search it while this one holds the original's.
  const CAlntH copy = alignment;
  bool found = false;
  std::thread other([&] { found = copy.FindChainageAndOffset(kNorth0 + 1.0, kEast0 + 1.0, c, o); });
  other.join();
  EXPECT_TRUE(found);
}
