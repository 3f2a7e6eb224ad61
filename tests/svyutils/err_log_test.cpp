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
using svy_logging::TErrLogEntry;

// Entries keep file, line and message (null texts become empty); a nested capture takes the entries logged
// while it lives, then restores the outer one. Installing a sink returns the previous one; an empty sink
// drops entries; a throwing sink does not reach the caller; a sink runs outside the log's lock, so it may
// log again; a restored sink reaches captures again.
TEST(ErrLog, CapturesNestAndSinksAreReplacedSwallowThrowsAndMayLog) {
  {
    const CScopedErrLogCapture outer;
    svy_err_log("AreaMath", 7, "segment order");
    {
      const CScopedErrLogCapture inner;
      svy_err_log("inner", 2, "");
      EXPECT_EQ(inner.count(), 1U);
    }
    svy_err_log(nullptr, -1, nullptr);
    const auto e = outer.entries();
    ASSERT_EQ(e.size(), 2U);
    EXPECT_TRUE(e[0].file == "AreaMath" && e[0].line == 7 && e[0].message == "segment order");
    EXPECT_TRUE(e[1].file.empty() && e[1].line == -1 && e[1].message.empty());
  }
  int calls = 0;
  const auto original = svy_logging::setErrLogSink([&calls](const TErrLogEntry&) { ++calls; });
  svy_err_log("formats", 1, "");
  auto mine = svy_logging::setErrLogSink({});
  svy_err_log("formats", 2, "");
  ASSERT_TRUE(static_cast<bool>(mine));
  mine(TErrLogEntry{});
  EXPECT_EQ(calls, 2);
  svy_logging::setErrLogSink([](const TErrLogEntry&) { throw std::runtime_error("sink"); });
  EXPECT_NO_THROW(svy_err_log("mathAlnts", 5, ""));
  std::vector<int> lines;
  svy_logging::setErrLogSink([&lines](const TErrLogEntry& entry) {
    lines.push_back(entry.line);
    if (entry.line > 0) svy_err_log(entry.file.c_str(), entry.line - 1, "");
  });
  svy_err_log("chain", 3, "");
  svy_logging::setErrLogSink(original);
  EXPECT_EQ(lines, (std::vector<int>{3, 2, 1, 0}));
  const CScopedErrLogCapture capture;
  svy_err_log("after", 9, "");
  EXPECT_EQ(capture.count(), 1U);
}

// Entries from several threads all arrive, intact and in each thread's order; captures that begin and end
// while another thread logs are never written to after they end (the sanitizer build checks the memory).
TEST(ErrLogCapture, CollectsEveryEntryFromSeveralThreadsAndSurvivesEndingCaptures) {
  constexpr int kThreads = 6, kPerThread = 2000;
  {
    const CScopedErrLogCapture capture;
    std::atomic<bool> go{false};
    std::vector<std::thread> loggers;
    for (int t = 0; t < kThreads; ++t)
      loggers.emplace_back([t, &go] {
        const std::string file = "thread" + std::to_string(t);
        while (!go.load()) std::this_thread::yield();
        for (int i = 0; i < kPerThread; ++i) svy_err_log(file.c_str(), i, "x");
      });
    go = true;
    for (auto& logger : loggers) logger.join();
    const auto entries = capture.entries();
    ASSERT_EQ(entries.size(), static_cast<std::size_t>(kThreads * kPerThread));
    std::map<std::string, int> nextLine;
    for (const auto& entry : entries) ASSERT_EQ(entry.line, nextLine[entry.file]++) << entry.file;
    EXPECT_EQ(nextLine.size(), static_cast<std::size_t>(kThreads));
  }
  std::atomic<bool> stop{false};
  std::atomic<long> logged{0};
  std::thread logger([&] {
    for (; !stop.load(); ++logged) svy_err_log("busy", 1, "");
  });
  for (int captures = 0; logged.load() < 2000 || captures < 50; ++captures) {
    const CScopedErrLogCapture capture;
    std::this_thread::yield();
    for (const auto& entry : capture.entries()) EXPECT_EQ(entry.file, "busy");
  }
  stop = true;
  logger.join();
}

}  // namespace
