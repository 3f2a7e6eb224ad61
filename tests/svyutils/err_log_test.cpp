#include <gtest/gtest.h>

#include <atomic>
#include <map>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

#include "svyutils/svy_err_log.h"

namespace {

using svy_logging::CScopedErrLogCapture;
using svy_logging::svy_err_log;

// Entries keep file, line and message (null texts become empty); a nested capture takes the entries
// logged while it lives and then restores the outer one.
TEST(ErrLogCapture, RecordsEntriesAndNestedCapturesRestoreTheOuterOne) {
  const CScopedErrLogCapture outer;
  svy_err_log("AreaMath", 7, "segment order");
  {
    const CScopedErrLogCapture inner;
    svy_err_log("inner", 2, "");
    EXPECT_EQ(inner.count(), 1U);
  }
  svy_err_log(nullptr, -1, nullptr);
  const auto entries = outer.entries();
  ASSERT_EQ(entries.size(), 2U);
  EXPECT_EQ(entries[0].file, "AreaMath");
  EXPECT_EQ(entries[0].line, 7);
  EXPECT_EQ(entries[0].message, "segment order");
  EXPECT_EQ(entries[1].file, "");
  EXPECT_EQ(entries[1].line, -1);
  EXPECT_EQ(entries[1].message, "");
}

// Installing a sink returns the previous one; an empty sink drops entries; a throwing sink does not reach
// the caller.
TEST(ErrLogSink, InstallReturnsThePreviousSinkAndThrowsNeverReachTheCaller) {
  int calls = 0;
  const auto original = svy_logging::setErrLogSink([&calls](const svy_logging::TErrLogEntry&) { ++calls; });
  svy_err_log("formats", 1, "");
  auto mine = svy_logging::setErrLogSink({});
  svy_err_log("formats", 2, "");  // no sink: dropped
  EXPECT_EQ(calls, 1);
  ASSERT_TRUE(static_cast<bool>(mine));
  mine(svy_logging::TErrLogEntry{});
  EXPECT_EQ(calls, 2);
  svy_logging::setErrLogSink([](const svy_logging::TErrLogEntry&) { throw std::runtime_error("sink"); });
  EXPECT_NO_THROW(svy_err_log("mathAlnts", 5, ""));
  svy_logging::setErrLogSink(original);
}

TEST(ErrLogSink, ASinkMayLogWithoutDeadlock) {
  const CScopedErrLogCapture capture;
  std::vector<int> lines;
  const auto previous = svy_logging::setErrLogSink([&lines](const svy_logging::TErrLogEntry& entry) {
    lines.push_back(entry.line);
    if (entry.line > 0) svy_err_log(entry.file.c_str(), entry.line - 1, "");
  });
  svy_err_log("chain", 3, "");  // the sink is called outside the log's lock, so it may log again
  svy_logging::setErrLogSink(previous);
  EXPECT_EQ(lines, (std::vector<int>{3, 2, 1, 0}));
  svy_err_log("after", 9, "");
  ASSERT_EQ(capture.count(), 1U);
  EXPECT_EQ(capture.entries()[0].file, "after");
}

// Entries from several threads all arrive, intact, while another thread swaps captures in and out.
TEST(ErrLogCapture, CollectsEveryEntryFromSeveralThreads) {
  constexpr int kThreads = 6;
  constexpr int kPerThread = 2000;
  const CScopedErrLogCapture capture;
  std::atomic<bool> go{false};
  std::vector<std::thread> loggers;
  for (int t = 0; t < kThreads; ++t) {
    loggers.emplace_back([t, &go] {
      const std::string file = "thread" + std::to_string(t);
      while (!go.load()) std::this_thread::yield();
      for (int i = 0; i < kPerThread; ++i) svy_err_log(file.c_str(), i, "x");
    });
  }
  go = true;
  for (auto& logger : loggers) logger.join();

  const auto entries = capture.entries();
  ASSERT_EQ(entries.size(), static_cast<std::size_t>(kThreads * kPerThread));
  // Per thread, the lines arrive complete and in the order that thread logged them.
  std::map<std::string, int> nextLine;
  for (const auto& entry : entries) {
    ASSERT_EQ(entry.message, "x");
    ASSERT_EQ(entry.line, nextLine[entry.file]++) << entry.file;
  }
  EXPECT_EQ(nextLine.size(), static_cast<std::size_t>(kThreads));
}

// Captures begin and end while another thread logs: a capture that has ended is never written to (the
// sanitizer build checks the memory), and a live one holds only the logger's entries.
TEST(ErrLogCapture, SurvivesCapturesEndingWhileOthersLog) {
  std::atomic<bool> stop{false};
  std::atomic<long> logged{0};
  std::thread logger([&] {
    while (!stop.load()) {
      svy_err_log("busy", 1, "");
      ++logged;
    }
  });
  int captures = 0;
  std::size_t foreign = 0;
  while (logged.load() < 2000 || captures < 50) {
    const CScopedErrLogCapture capture;
    std::this_thread::yield();
    for (const auto& entry : capture.entries()) foreign += entry.file == "busy" ? 0U : 1U;
    ++captures;
  }
  stop = true;
  logger.join();
  EXPECT_EQ(foreign, 0U);
}

}  // namespace
