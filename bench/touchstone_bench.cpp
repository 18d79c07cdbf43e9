// Touchstone reading speed against the ceiling of parsing the same numbers with
// std::from_chars from memory, on two generated files: a two-port version 1 file of 100,001
// points (MA, GHz) and a four-port version 2 file of 20,001 points (RI, upper triangle); and
// the cost of carrying the two-port file onto 100,001 new points.
#include <benchmark/benchmark.h>

#include <unistd.h>

#include <charconv>
#include <cmath>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <string>

#include "bench_timing.h"
#include "lumen/data.h"

namespace {

using lumen_bench::ThreadSeconds;

struct GeneratedFile {
  std::string path;
  std::string text;
};

void Append(std::string& text, const char* format, double value) {
  char buffer[32];
  const int n = std::snprintf(buffer, sizeof buffer, format, value);
  text.append(buffer, static_cast<std::size_t>(n));
}

GeneratedFile Write(const std::string& name, const std::string& text) {
  GeneratedFile file{"/tmp/lumen_touchstone_bench_" + std::to_string(::getpid()) + "_" + name,
                     text};
  std::ofstream(file.path, std::ios::binary) << text;
  return file;
}

const GeneratedFile& TwoPortFile() {
  static const GeneratedFile file = [] {
    std::string text = "! generated two-port network\n# GHZ S MA R 50\n";
    constexpr int kPoints = 100001;
    for (int i = 0; i < kPoints; ++i) {
      const double f = 0.01 + 19.99 * i / (kPoints - 1);
      Append(text, "%.9g", f);
      for (int p = 0; p < 4; ++p) {
        Append(text, " %.6f", 0.2 + 0.7 * std::fabs(std::sin(f * (p + 1))));
        Append(text, " %.3f", std::remainder(-36.0 * f * (p + 1), 360.0));
      }
      text += '\n';
    }
    return Write("two_port.s2p", text);
  }();
  return file;
}

const GeneratedFile& FourPortFile() {
  static const GeneratedFile file = [] {
    std::string text =
        "[Version] 2.0\n# Hz S RI R 50\n[Number of Ports] 4\n[Number of Frequencies] 20001\n"
        "[Matrix Format] Upper\n[Network Data]\n";
    constexpr int kPoints = 20001;
    for (int i = 0; i < kPoints; ++i) {
      const double f = 1e7 + 1e6 * i;
      Append(text, "%.10g", f);
      for (int p = 0; p < 10; ++p) {
        Append(text, " %.8e", 0.5 * std::cos(f * 1e-9 * (p + 1)));
        Append(text, " %.8e", -0.5 * std::sin(f * 1e-9 * (p + 1)));
        if (p % 4 == 3) text += "\n ";
      }
      text += '\n';
    }
    text += "[End]\n";
    return Write("four_port.s4p", text);
  }();
  return file;
}

// Parses every number of the text with std::from_chars, skipping comment and option lines
// and keywords: the speed a reader cannot beat without a faster number parser.
double FromCharsPass(const std::string& text) {
  double sum = 0.0;
  const char* p = text.data();
  const char* end = p + text.size();
  while (p != end) {
    if (*p == '!' || *p == '#' || *p == '[') {
      while (p != end && *p != '\n') ++p;
      continue;
    }
    if (*p == ' ' || *p == '\n' || *p == '\t' || *p == '\r') {
      ++p;
      continue;
    }
    double value = 0.0;
    const std::from_chars_result r = std::from_chars(p, end, value);
    if (r.ec != std::errc()) {
      ++p;
      continue;
    }
    sum += value;
    p = r.ptr;
  }
  return sum;
}

// MB/s of the from_chars pass, measured once per file and process.
double CeilingMegabytesPerSecond(const GeneratedFile& file) {
  constexpr int kRepeats = 5;
  const double start = ThreadSeconds();
  double sink = 0.0;
  for (int i = 0; i < kRepeats; ++i) sink += FromCharsPass(file.text);
  benchmark::DoNotOptimize(sink);
  return kRepeats * file.text.size() / 1e6 / (ThreadSeconds() - start);
}

void ReadFile(benchmark::State& state, const GeneratedFile& file, int ports) {
  const double ceiling = CeilingMegabytesPerSecond(file);
  const std::wstring path(file.path.begin(), file.path.end());
  double seconds = 0.0;
  for (auto _ : state) {
    CSnPFileBase reader(ports);
    const double start = ThreadSeconds();
    const int points = reader.ReadSNPFile(path);
    seconds += ThreadSeconds() - start;
    if (points <= 0) state.SkipWithError("the generated file did not read");
    benchmark::DoNotOptimize(points);
  }
  const double megabytesPerSecond = state.iterations() * file.text.size() / 1e6 / seconds;
  state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * file.text.size()));
  state.counters["MB/s"] = megabytesPerSecond;
  state.counters["from_chars_MB/s"] = ceiling;
  state.counters["share_of_ceiling"] = megabytesPerSecond / ceiling;
}

void BM_ReadSNPFile_TwoPortV1(benchmark::State& state) {
  ReadFile(state, TwoPortFile(), 2);
}
void BM_ReadSNPFile_FourPortV2(benchmark::State& state) {
  ReadFile(state, FourPortFile(), 4);
}

void Ceiling(benchmark::State& state, const GeneratedFile& file) {
  for (auto _ : state) benchmark::DoNotOptimize(FromCharsPass(file.text));
  state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * file.text.size()));
}
void BM_FromChars_TwoPortV1(benchmark::State& state) {
  Ceiling(state, TwoPortFile());
}
void BM_FromChars_FourPortV2(benchmark::State& state) {
  Ceiling(state, FourPortFile());
}

// The two-port file's four traces carried onto 100,001 new points that fall between the old
// ones, by circular interpolation.
void BM_InterpolateReadSNPFile_TwoPort(benchmark::State& state) {
  const GeneratedFile& file = TwoPortFile();
  CSnPFileBase original(2);
  if (original.ReadSNPFile(std::wstring(file.path.begin(), file.path.end())) <= 0) {
    state.SkipWithError("the generated file did not read");
    return;
  }
  constexpr int kPoints = 100001;
  const LumenUtility::InputArray target(0.0153e9, 19.9953e9, kPoints, LumenUtility::Linear);
  target.GetRawArray();  // the flattened points are built once, as a sweep's would be
  double seconds = 0.0;
  for (auto _ : state) {
    state.PauseTiming();
    CSnPFileBase reader = original;
    state.ResumeTiming();
    const double start = ThreadSeconds();
    reader.InterpolateReadSNPFile(target, true);
    seconds += ThreadSeconds() - start;
    benchmark::DoNotOptimize(reader.GetParam(SNP_S21).GetData().data());
  }
  // Per output point of one trace, and per sweep point with all four traces.
  const double perSweepPoint = seconds * 1e9 / (static_cast<double>(state.iterations()) * kPoints);
  state.counters["ns_per_output_point"] = perSweepPoint / 4;
  state.counters["ns_per_sweep_point"] = perSweepPoint;
}

BENCHMARK(BM_ReadSNPFile_TwoPortV1)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_FromChars_TwoPortV1)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ReadSNPFile_FourPortV2)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_FromChars_FourPortV2)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_InterpolateReadSNPFile_TwoPort)->Unit(benchmark::kMillisecond);

// The generated files are removed when the process ends.
struct Cleanup {
  ~Cleanup() {
    for (const char* name : {"two_port.s2p", "four_port.s4p"}) {
      std::remove(
          ("/tmp/lumen_touchstone_bench_" + std::to_string(::getpid()) + "_" + name).c_str());
    }
  }
} cleanup;

}  // namespace
