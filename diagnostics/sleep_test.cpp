#include <gtest/gtest.h>

#include <chrono>

#include "lumen/diagnostics/process_utilities.h"

namespace {

using Clock = std::chrono::steady_clock;

// Lower bounds only: a loaded machine may make any wait longer.
TEST(Sleep, NeverReturnsEarly) {
  for (const std::uint32_t ms : {0u, 1u, 2u, 7u, 25u}) {
    const auto start = Clock::now();
    LumenUtility::Sleep(ms);
    EXPECT_GE(Clock::now() - start, std::chrono::milliseconds(ms)) << ms;
  }
}

TEST(SleepUsec, NeverReturnsEarlyWhetherItSpinsOrSleeps) {
  // 20000 is the longest spin; above it whole milliseconds are slept, rounded up.
  for (const int us : {-5, 0, 1, 500, 19999, 20000, 20001, 25000, 25500}) {
    const auto start = Clock::now();
    LumenUtility::SleepUsec(us);
    EXPECT_GE(Clock::now() - start, std::chrono::microseconds(us)) << us;
  }
}

}  // namespace
