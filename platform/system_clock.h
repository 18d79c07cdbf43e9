// The monotonic high-resolution counter and the system sleep that timing code builds on.
//
// The counter reads CLOCK_MONOTONIC, which no clock adjustment moves, in nanosecond ticks.
// Thread-safety: every function may be called from any thread.
#pragma once

#include <cstdint>

namespace LumenUtility {

// Ticks of the monotonic clock from an arbitrary origin; one tick is
// 1 / QueryPerformanceFrequency() seconds.
std::int64_t QueryPerformanceCounter();

// Ticks per second of QueryPerformanceCounter: 1e9.
constexpr std::int64_t QueryPerformanceFrequency() {
  return 1000000000;
}

// Suspends the calling thread for at least `milliseconds` ms (0 to 2^32 - 1); a signal does
// not cut the sleep short. 0 gives the processor to another ready thread and returns.
void SystemSleep(std::uint32_t milliseconds);

}  // namespace LumenUtility
