// Timing for benchmarks that compare an operation with a baseline measured in the same run:
// both are timed in turn inside every iteration, so they share the run's cache state, clock
// speed and neighbours, and their ratio means something even on a busy machine.
#pragma once

#include <benchmark/benchmark.h>
#include <time.h>

#include <chrono>

namespace lumen_bench {

// CPU time of the calling thread, in seconds from an arbitrary origin. On a shared machine,
// time spent preempted would otherwise land on whichever of two compared loops was running.
inline double ThreadSeconds() {
  timespec now;
  clock_gettime(CLOCK_THREAD_CPUTIME_ID, &now);
  return now.tv_sec + 1e-9 * now.tv_nsec;
}

// ThreadSeconds() as a clock for TimeInTurn.
struct ThreadCpuClock {
  using time_point = std::chrono::duration<double>;
  static time_point now() { return time_point(ThreadSeconds()); }
};

// Seconds from `a` to `b` of either clock.
template <typename TimePoint>
double Seconds(TimePoint a, TimePoint b) {
  return std::chrono::duration<double>(b - a).count();
}

// Total seconds the two timed steps of TimeInTurn took over all iterations.
struct SecondsInTurn {
  double first = 0.0;
  double second = 0.0;
};

// Which step's time Google Benchmark reports as the iteration time (the benchmark is
// registered with UseManualTime()).
enum class Reported { kFirst, kSecond };

// Runs the benchmark loop of `state`. Each iteration runs `untimed` (for example to restore an
// input the operation overwrites), then times `first` and then `second` on `Clock`, with the
// compiler's view of memory flushed after each step so no work moves across a clock reading.
template <typename Clock = ThreadCpuClock, typename Untimed, typename First, typename Second>
SecondsInTurn TimeInTurn(benchmark::State& state, Reported reported, Untimed untimed, First first,
                         Second second) {
  SecondsInTurn total;
  for (auto _ : state) {
    untimed();
    benchmark::ClobberMemory();
    const auto t0 = Clock::now();
    first();
    benchmark::ClobberMemory();
    const auto t1 = Clock::now();
    second();
    benchmark::ClobberMemory();
    const auto t2 = Clock::now();
    const double firstSeconds = Seconds(t0, t1), secondSeconds = Seconds(t1, t2);
    total.first += firstSeconds;
    total.second += secondSeconds;
    state.SetIterationTime(reported == Reported::kFirst ? firstSeconds : secondSeconds);
  }
  return total;
}

// The counters of an operation timed against a memcpy of as many values, state.range(0) values
// per iteration: values_per_s, memcpy_values_per_s, and x_memcpy = how many times the
// operation is slower than copying.
inline void ReportAgainstMemcpy(benchmark::State& state, double operationSeconds,
                                double copySeconds) {
  const double values = static_cast<double>(state.range(0)) * state.iterations();
  const double operationRate = values / operationSeconds;
  const double copyRate = values / copySeconds;
  state.counters["values_per_s"] = operationRate;
  state.counters["memcpy_values_per_s"] = copyRate;
  state.counters["x_memcpy"] = copyRate / operationRate;
}

}  // namespace lumen_bench
