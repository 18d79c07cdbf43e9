// CSV reading speed: every field of a 64 MB file of measurement rows through CCSVFile, in
// MB/s, beside the speed of reading the same file in 64 KB pieces and finding its commas and
// line ends with memchr (what any reader pays for the bytes), timed in turn in the same run.
#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>
#include <fstream>
#include <string>

#include "bench_timing.h"
#include "lumen/data.h"

namespace {

using lumen_bench::Reported;
using lumen_bench::TimeInTurn;

constexpr std::size_t kFileBytes = 64u << 20;

std::string Path() {
  return "/tmp/lumen_csv_bench_" + std::to_string(getpid()) + ".csv";
}

// Writes the file once; returns its length in bytes.
std::size_t Generated() {
  static const std::size_t length = [] {
    std::ofstream out(Path(), std::ios::binary);
    std::size_t written = 0;
    char line[128];
    for (unsigned i = 0; written < kFileBytes; ++i) {
      // Now and then a quoted field, as exports with names carry them.
      const int n = std::snprintf(line, sizeof line, "%u,%.9e,%.6f,%.6f%s\r\n", i,
                                  1e7 + 12345.0 * i, -0.001 * (i % 5000), 0.01 * (i % 36000),
                                  i % 16 == 0 ? ",\"S21, trace 1\"" : "");
      out.write(line, n);
      written += static_cast<std::size_t>(n);
    }
    return written;
  }();
  return length;
}

std::size_t ReadFields(const std::wstring& path) {
  CCSVFile csv;
  if (!csv.Open(path.c_str(), CFile::modeRead)) return 0;
  std::string field;
  unsigned status;
  std::size_t fields = 0;
  for (;;) {
    if (csv.ReadField(field, &status)) {
      ++fields;
    } else if (status == CCSVFile::kEndOfLine) {
      csv.ReadEndOfLine(&status);
    } else {
      return fields;
    }
  }
}

// Separators found by memchr in the file read in 64 KB pieces.
std::size_t ScanSeparators(const std::string& path) {
  const int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
  static char buffer[64 * 1024];
  std::size_t separators = 0;
  for (ssize_t got; (got = read(fd, buffer, sizeof buffer)) > 0;) {
    for (const char* p = buffer;
         (p = static_cast<const char*>(std::memchr(p, ',', buffer + got - p))) != nullptr; ++p)
      ++separators;
    for (const char* p = buffer;
         (p = static_cast<const char*>(std::memchr(p, '\n', buffer + got - p))) != nullptr; ++p)
      ++separators;
  }
  close(fd);
  return separators;
}

void BM_ReadFields(benchmark::State& state) {
  const std::size_t length = Generated();
  const std::string path = Path();
  const std::wstring wide(path.begin(), path.end());
  std::size_t fields = 0;
  const auto total = TimeInTurn(
      state, Reported::kSecond, [] {}, [&] { benchmark::DoNotOptimize(ScanSeparators(path)); },
      [&] { fields = ReadFields(wide); });
  if (fields == 0) state.SkipWithError("no field read");
  const double megabytes = static_cast<double>(state.iterations()) * length / 1e6;
  state.counters["MB_per_s"] = megabytes / total.second;
  state.counters["memchr_MB_per_s"] = megabytes / total.first;
  state.counters["fields"] = static_cast<double>(fields);
}

BENCHMARK(BM_ReadFields)->UseManualTime()->Unit(benchmark::kMillisecond)->Iterations(3);

struct Cleanup {
  ~Cleanup() { std::remove(Path().c_str()); }
} cleanup;

}  // namespace
