// Feeds arbitrary bytes to the numeric helpers that take caller-controlled indices, ranges
// and text: the value search, piecewise phase unwrapping, natural-order comparison,
// significant-digit check and SI prefixes. Any crash, out-of-bounds read or sanitizer report
// is a fault.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "fuzz_input.h"
#include "lumen/core.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
  lumen_fuzz::FuzzInput in(bytes, size);
  const double start = in.Take<double>();
  const double low = in.Take<double>();
  const double high = in.Take<double>();
  const std::uint8_t flags = in.Take<std::uint8_t>();
  const float target = in.Take<float>();
  const std::int32_t maxExponent = in.Take<std::int32_t>();
  const std::int32_t minExponent = in.Take<std::int32_t>();
  const int count = in.Take<std::uint8_t>();
  std::vector<float> trace;
  for (int i = 0; i < count && in.Left() >= sizeof(float); ++i) trace.push_back(in.Take<float>());

  double position = 0.0;
  LumenUtility::ValueSearch(start, trace.empty() ? nullptr : trace.data(),
                            static_cast<int>(trace.size()), low, high, (flags & 1) != 0, target,
                            position);

  // Unwrap the trace read as complex pairs, in pieces whose lengths come from the flags.
  std::vector<LumenUtility::TsComplex> complexTrace(trace.size() / 2);
  if (!complexTrace.empty()) {
    std::memcpy(complexTrace.data(), trace.data(), complexTrace.size() * sizeof(float) * 2);
  }
  std::vector<float> phase(complexTrace.size());
  const int n = static_cast<int>(complexTrace.size());
  const int piece = 1 + (flags >> 4);
  for (int begin = 0; begin < n; begin += piece) {
    LumenUtility::FormatUnwrappedPhase(complexTrace.data(), phase.data(), begin,
                                       std::min(n, begin + piece));
  }

  MathUtil::ValidCheck(start, static_cast<int>(flags) - 64);
  double scale = 0.0;
  wchar_t prefix = 0;
  LumenUtility::GetSIPrefix(low, scale, prefix, maxExponent, minExponent);

  // The rest as two wide strings split at the middle.
  std::wstring a, b;
  std::size_t half = in.Left() / 2;
  while (in.Left() > half) a.push_back(static_cast<wchar_t>(in.Take<std::uint8_t>()));
  while (in.Left() > 0) b.push_back(static_cast<wchar_t>(in.Take<std::uint8_t>()));
  LumenUtility::strnatcmp(a.c_str(), b.c_str());
  LumenUtility::strnatcmpNoCase(a.c_str(), b.c_str());
  return 0;
}
