// Cost of diagnostics that are switched off, and the rate of debug print to a file.
//
// Off: dprint to a slot that is off, dprint while locked out, and TPrint with tracing off at
// its three depths (no tracing object; TPrint disabled; enabled with no session), each timed
// in turn with a call of the same arguments to an empty function the compiler cannot
// inline. Reported: ns_per_call, empty_call_ns, x_empty_call. A few nanoseconds per call
// and a small multiple of the empty call are what "off" should cost.
// File: dprint of a 40-character line to a file, flushed per message as the file device
// does, timed in turn with the same text formatted by swprintf and written with fputs and
// fflush to a stdio file. Reported: msgs_per_s, stdio_msgs_per_s, x_stdio.
#include <benchmark/benchmark.h>

#include <cstdarg>
#include <cstdio>
#include <cwchar>
#include <string>

#include "bench_timing.h"
#include "lumen/diagnostics.h"
#include "lumen/platform.h"
#include "platform/temp_dir.h"

namespace {

constexpr int kCallsPerIteration = 1000;

__attribute__((noinline)) void EmptyCall(std::int32_t slot, const wchar_t* format, ...) {
  benchmark::DoNotOptimize(slot);
  benchmark::DoNotOptimize(format);
}

__attribute__((noinline)) void EmptyTrace(short id, std::int32_t value) {
  benchmark::DoNotOptimize(id);
  benchmark::DoNotOptimize(value);
}

void ReportPerCall(benchmark::State& state, const lumen_bench::SecondsInTurn& seconds) {
  const double calls = static_cast<double>(state.iterations()) * kCallsPerIteration;
  state.counters["ns_per_call"] = seconds.second / calls * 1e9;
  state.counters["empty_call_ns"] = seconds.first / calls * 1e9;
  state.counters["x_empty_call"] = seconds.second / seconds.first;
}

template <typename Operation>
void TimeOffAgainstEmptyCall(benchmark::State& state, Operation operation) {
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond, [] {},
      [] {
        for (int i = 0; i < kCallsPerIteration; ++i) EmptyCall(200, L"point %d", i);
      },
      [&] {
        for (int i = 0; i < kCallsPerIteration; ++i) operation(i);
      });
  ReportPerCall(state, seconds);
}

void BM_DPrintSlotOff(benchmark::State& state) {
  gDebugPrint.Lockout(false);
  gDebugPrint.SetOn(200, false);
  TimeOffAgainstEmptyCall(state, [](int i) { dprint(200, L"point %d", i); });
  gDebugPrint.Lockout(true);
}
BENCHMARK(BM_DPrintSlotOff)->UseManualTime();

void BM_DPrintLockedOut(benchmark::State& state) {
  gDebugPrint.Lockout(true);
  gDebugPrint.SetOn(200, true);
  TimeOffAgainstEmptyCall(state, [](int i) { dprint(200, L"point %d", i); });
  gDebugPrint.SetOn(200, false);
}
BENCHMARK(BM_DPrintLockedOut)->UseManualTime();

template <typename Operation>
void TimeTraceAgainstEmptyCall(benchmark::State& state, Operation operation) {
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond, [] {},
      [] {
        for (int i = 0; i < kCallsPerIteration; ++i) EmptyTrace(3, i);
      },
      [&] {
        for (int i = 0; i < kCallsPerIteration; ++i) operation(i);
      });
  ReportPerCall(state, seconds);
}

void BM_TPrintNoTracingObject(benchmark::State& state) {
  LumenUtility::ETWReset();
  TimeTraceAgainstEmptyCall(state, [](int i) { LumenUtility::TPrint(3, i); });
}
BENCHMARK(BM_TPrintNoTracingObject)->UseManualTime();

void BM_TPrintDisabled(benchmark::State& state) {
  LumenUtility::ETWInit();
  LumenUtility::EnableTPrint(false);
  TimeTraceAgainstEmptyCall(state, [](int i) { LumenUtility::TPrint(3, i); });
  LumenUtility::ETWReset();
}
BENCHMARK(BM_TPrintDisabled)->UseManualTime();

void BM_TPrintEnabledWithoutSession(benchmark::State& state) {
  LumenUtility::ETWInit();
  LumenUtility::EnableTPrint(true);
  TimeTraceAgainstEmptyCall(state, [](int i) { LumenUtility::TPrint(3, i); });
  LumenUtility::ETWReset();
}
BENCHMARK(BM_TPrintEnabledWithoutSession)->UseManualTime();

struct DiscardedOutput : LumenUtility::IDebugOutputSink {
  void Output(const wchar_t*) override {}
};

void BM_DPrintToFile(benchmark::State& state) {
  LumenUtility::testutil::TempDir dir;
  DiscardedOutput discarded;
  LumenUtility::SetDebugOutputSink(&discarded);
  gDebugPrint.SetDeviceOn(CDebugPrint::Debugger, false);
  gDebugPrint.SetFilePath((dir.Path("") + L"/").c_str());
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  gDebugPrint.SetOn(5, true);
  gDebugPrint.Lockout(false);
  FILE* stdio = std::fopen(dir.NarrowPath("stdio.txt").c_str(), "w");
  int n = 0;
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond, [&] { ++n; },
      [&] {
        wchar_t text[512];
        std::swprintf(text, 512, L"sweep %d point %5d value %10.4f\n", 3, n, n * 0.25);
        std::fputs(LumenUtility::WideToUtf8(text).c_str(), stdio);
        std::fflush(stdio);
      },
      [&] { dprint(5, L"sweep %d point %5d value %10.4f\n", 3, n, n * 0.25); });
  std::fclose(stdio);
  gDebugPrint.Lockout(true);
  gDebugPrint.SetOn(5, false);
  gDebugPrint.SetDeviceOn(CDebugPrint::File, false);
  gDebugPrint.SetDeviceOn(CDebugPrint::Debugger, true);
  LumenUtility::SetDebugOutputSink(nullptr);
  const double messages = static_cast<double>(state.iterations());
  state.counters["msgs_per_s"] = messages / seconds.second;
  state.counters["stdio_msgs_per_s"] = messages / seconds.first;
  state.counters["x_stdio"] = seconds.second / seconds.first;
}
BENCHMARK(BM_DPrintToFile)->UseManualTime();

}  // namespace
