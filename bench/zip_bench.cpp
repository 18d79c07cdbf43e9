// ZIP speed of ZlibUtil against zlib alone, each pair timed in turn in the same run: DoZip of
// a 64 MB text file against raw deflate (the same level and window) of the same bytes from
// memory, and DoUnzip of that archive against raw inflate of the same stream from memory.
// x_raw is DoZip's (DoUnzip's) speed as a share of zlib's; the file and container work of
// DoZip should cost no more than a tenth (x_raw >= 0.9).
#include <benchmark/benchmark.h>
#include <unistd.h>
#include <zlib.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>

#include "bench_timing.h"
#include "lumen/util.h"

namespace {

namespace fs = std::filesystem;
using lumen_bench::Reported;
using lumen_bench::TimeInTurn;

constexpr std::size_t kFileBytes = 64u << 20;
constexpr std::size_t kPiece = 64 * 1024;

fs::path Scratch() {
  return fs::temp_directory_path() / ("lumen_zip_bench_" + std::to_string(getpid()));
}

// Measurement rows as a CSV export writes them: about 4:1 under deflate.
const std::string& Text() {
  static const std::string text = [] {
    std::string t;
    t.reserve(kFileBytes + 100);
    char line[96];
    for (unsigned i = 0; t.size() < kFileBytes; ++i) {
      const int n = std::snprintf(line, sizeof line, "%u,%.6e,%.5f,%.4f\n", i, 1e7 + 12345.0 * i,
                                  -3.0 - (i * 7919 % 1000) / 97.0, ((i * 104729) % 36000) / 100.0);
      t.append(line, static_cast<std::size_t>(n));
    }
    t.resize(kFileBytes);
    fs::create_directories(Scratch());
    std::ofstream(Scratch() / "data.csv", std::ios::binary) << t;
    return t;
  }();
  return text;
}

// Raw deflate of `text` in 64 KB pieces, as DoZip feeds it; returns the compressed length and
// appends the compressed bytes to `out` when it is not null (the timed baseline passes null,
// so it pays for no growing string).
std::size_t RawDeflate(const std::string& text, std::string* out) {
  z_stream stream{};
  deflateInit2(&stream, Z_DEFAULT_COMPRESSION, Z_DEFLATED, -15, 8, Z_DEFAULT_STRATEGY);
  const auto buffer = std::make_unique<unsigned char[]>(kPiece);
  for (std::size_t at = 0;; at += kPiece) {
    const std::size_t n = at < text.size() ? std::min(kPiece, text.size() - at) : 0;
    stream.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(text.data()) + at);
    stream.avail_in = static_cast<uInt>(n);
    const int flush = n == 0 ? Z_FINISH : Z_NO_FLUSH;
    do {
      stream.next_out = buffer.get();
      stream.avail_out = kPiece;
      deflate(&stream, flush);
      if (out) out->append(reinterpret_cast<char*>(buffer.get()), kPiece - stream.avail_out);
    } while (stream.avail_out == 0);
    if (n == 0) break;
  }
  const std::size_t length = stream.total_out;
  deflateEnd(&stream);
  return length;
}

// Raw inflate of `compressed` into a 64 KB buffer; returns the number of bytes produced.
std::size_t RawInflate(const std::string& compressed) {
  z_stream stream{};
  inflateInit2(&stream, -15);
  const auto buffer = std::make_unique<unsigned char[]>(kPiece);
  stream.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(compressed.data()));
  stream.avail_in = static_cast<uInt>(compressed.size());
  std::size_t produced = 0;
  int status;
  do {
    stream.next_out = buffer.get();
    stream.avail_out = kPiece;
    status = inflate(&stream, Z_NO_FLUSH);
    produced += kPiece - stream.avail_out;
  } while (status == Z_OK);
  inflateEnd(&stream);
  return produced;
}

void Report(benchmark::State& state, double zlibSeconds, double utilSeconds) {
  const double megabytes = static_cast<double>(state.iterations()) * kFileBytes / 1e6;
  state.counters["MB_per_s"] = megabytes / utilSeconds;
  state.counters["zlib_MB_per_s"] = megabytes / zlibSeconds;
  state.counters["x_raw"] = zlibSeconds / utilSeconds;
}

void BM_DoZipAgainstRawDeflate(benchmark::State& state) {
  const std::string& text = Text();
  const std::wstring base = Scratch().wstring();
  const std::wstring archive = (Scratch() / "out.zip").wstring();
  bool ok = true;
  const auto total = TimeInTurn(
      state, Reported::kSecond, [] {}, [&] { benchmark::DoNotOptimize(RawDeflate(text, nullptr)); },
      [&] { ok = LumenUtility::ZlibUtil::DoZip(base, {L"data.csv"}, archive) && ok; });
  if (!ok) state.SkipWithError("DoZip failed");
  Report(state, total.first, total.second);
}

void BM_DoUnzipAgainstRawInflate(benchmark::State& state) {
  std::string compressed;
  RawDeflate(Text(), &compressed);
  const std::wstring archive = (Scratch() / "in.zip").wstring();
  const std::wstring out = (Scratch() / "extracted").wstring();
  if (!LumenUtility::ZlibUtil::DoZip(Scratch().wstring(), {L"data.csv"}, archive)) {
    state.SkipWithError("DoZip failed");
    return;
  }
  bool ok = true;
  const auto total = TimeInTurn(
      state, Reported::kSecond, [] {}, [&] { benchmark::DoNotOptimize(RawInflate(compressed)); },
      [&] { ok = LumenUtility::ZlibUtil::DoUnzip(archive, out, nullptr) && ok; });
  if (!ok) state.SkipWithError("DoUnzip failed");
  Report(state, total.first, total.second);
}

BENCHMARK(BM_DoZipAgainstRawDeflate)->UseManualTime()->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK(BM_DoUnzipAgainstRawInflate)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond)
    ->Iterations(5);

struct Cleanup {
  ~Cleanup() {
    std::error_code error;
    fs::remove_all(Scratch(), error);
  }
} cleanup;

}  // namespace
