#include "platform/system_clock.h"

#include <gtest/gtest.h>

#include <chrono>

namespace {

using namespace LumenUtility;

TEST(SystemClock, SystemSleepLastsAtLeastItsTimeOnTheCounter) {
  EXPECT_EQ(QueryPerformanceFrequency(), 1000000000);
  for (const std::uint32_t ms : {0u, 1u, 3u}) {
    const std::int64_t before = QueryPerformanceCounter();
    const auto steadyBefore = std::chrono::steady_clock::now();
    SystemSleep(ms);
    const std::int64_t after = QueryPerformanceCounter();
    EXPECT_GE(after - before, std::int64_t{ms} * 1000000) << ms;
    EXPECT_GE(std::chrono::steady_clock::now() - steadyBefore, std::chrono::milliseconds(ms));
  }
}

}  // namespace
