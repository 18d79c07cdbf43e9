#include <cmath>

#include "lumen/diagnostics/process_utilities.h"
#include "platform/system_clock.h"

namespace LumenUtility {
namespace {

// Waits longer than this are slept rather than spun.
constexpr int kLongestSpinUs = 20000;

double MillisecondsSince(std::int64_t start) {
  return static_cast<double>(QueryPerformanceCounter() - start) * 1e3 /
         static_cast<double>(QueryPerformanceFrequency());
}

}  // namespace

void Sleep(std::uint32_t milliseconds) {
  if (milliseconds == 0) return;
  const std::int64_t start = QueryPerformanceCounter();
  SystemSleep(milliseconds);
  for (double elapsed = MillisecondsSince(start); elapsed < milliseconds;
       elapsed = MillisecondsSince(start)) {
    // Less than a millisecond left gives 0: the thread only yields and checks again.
    SystemSleep(static_cast<std::uint32_t>(std::floor(milliseconds - elapsed)));
  }
}

void SleepUsec(int microseconds) {
  const std::int64_t start = QueryPerformanceCounter();
  if (microseconds > kLongestSpinUs) {
    // Rounded up: 25500 µs sleeps 26 ms, never 25.
    Sleep(static_cast<std::uint32_t>((static_cast<std::int64_t>(microseconds) + 999) / 1000));
    return;
  }
  const std::int64_t ticks =
      static_cast<std::int64_t>(microseconds) * QueryPerformanceFrequency() / 1000000;
  while (QueryPerformanceCounter() - start < ticks) {
  }
}

}  // namespace LumenUtility
