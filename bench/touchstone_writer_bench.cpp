// Touchstone writing speed against the floor of printing the same floats with std::to_chars
// into memory, on a two-port network of 100,001 points read from an MA file. Writing RI costs
// about the floor; MA and DB find, for every value, the pair that reads back to its floats
// (angles and powers of ten, tried around the direct inverse), which is what they pay for.
// Counters: ns per complex value, and x_to_chars = how many times the floor the write takes.
#include <benchmark/benchmark.h>

#include <charconv>
#include <cmath>
#include <cstdio>
#include <sstream>
#include <string>

#include "bench_timing.h"
#include "lumen/data.h"

namespace {

using lumen_bench::Reported;
using lumen_bench::TimeInTurn;

constexpr int kPoints = 100001;

const CSnPFileBase& TwoPortSet() {
  static const CSnPFileBase set = [] {
    std::string text = "# GHZ S MA R 50\n";
    char buffer[48];
    for (int i = 0; i < kPoints; ++i) {
      const double f = 0.01 + 19.99 * i / (kPoints - 1);
      text.append(buffer, std::snprintf(buffer, sizeof buffer, "%.9g", f));
      for (int p = 0; p < 4; ++p) {
        const double magnitude = 0.2 + 0.7 * std::fabs(std::sin(f * (p + 1)));
        const double angle = std::remainder(-36.0 * f * (p + 1), 360.0);
        text.append(buffer, std::snprintf(buffer, sizeof buffer, " %.6f %.3f", magnitude, angle));
      }
      text += '\n';
    }
    CSnPFileBase file(2);
    file.ReadSNPText(text);
    return file;
  }();
  return set;
}

// The floor: the shortest text of every stimulus and value float, appended to one string.
std::size_t ToCharsPass(const CSnPFileBase& set) {
  std::string text;
  text.reserve(std::size_t{64} * kPoints * 4);
  char buffer[32];
  const LumenUtility::InputArray& x = set.GetParam(SNP_S11).GetStimulus();
  for (unsigned int i = 0; i < x.size(); ++i) {
    text.append(buffer, std::to_chars(buffer, buffer + sizeof buffer, x[i]).ptr);
    for (int k = 0; k < 4; ++k) {
      const LumenUtility::TsComplex& v = set.GetParam(static_cast<ESNParam>(k)).GetData()[i];
      text += ' ';
      text.append(buffer, std::to_chars(buffer, buffer + sizeof buffer, v.re).ptr);
      text += ' ';
      text.append(buffer, std::to_chars(buffer, buffer + sizeof buffer, v.im).ptr);
    }
    text += '\n';
  }
  return text.size();
}

void Write(benchmark::State& state, ESNPForm form) {
  const CSnPFileBase& set = TwoPortSet();
  LumenUtility::TouchstoneWriteOptions options;
  options.form = form;
  options.unit = LumenUtility::SNP_UNIT_GHZ;
  const LumenUtility::TouchstoneWriter writer(set, options);
  std::size_t inexact = 0;
  const lumen_bench::SecondsInTurn seconds = TimeInTurn(
      state, Reported::kFirst, [] {},
      [&] {
        std::ostringstream out;
        inexact = writer.Write(out).inexactValues;
        benchmark::DoNotOptimize(out.tellp());
      },
      [&] { benchmark::DoNotOptimize(ToCharsPass(set)); });
  const double values = 4.0 * kPoints * static_cast<double>(state.iterations());
  state.counters["ns_per_value"] = 1e9 * seconds.first / values;
  state.counters["to_chars_ns_per_value"] = 1e9 * seconds.second / values;
  state.counters["x_to_chars"] = seconds.first / seconds.second;
  state.counters["inexact_values"] = static_cast<double>(inexact);
}

void BM_WriteTouchstone_TwoPortRI(benchmark::State& state) {
  Write(state, SNP_RI);
}
void BM_WriteTouchstone_TwoPortMA(benchmark::State& state) {
  Write(state, SNP_MA);
}
void BM_WriteTouchstone_TwoPortDB(benchmark::State& state) {
  Write(state, SNP_DB);
}

BENCHMARK(BM_WriteTouchstone_TwoPortRI)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(BM_WriteTouchstone_TwoPortMA)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(BM_WriteTouchstone_TwoPortDB)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
