// Names, ranges and output lengths handed to a DataMatrix whose buffers have uneven lengths:
// every lookup either fails leaving the output as it was, or succeeds reading only samples
// the buffers hold (AddressSanitizer reports any read past them).
//
// Input: buffer size, output length, start, stop and the lengths of four buffers (one byte
// each), then alias text and the looked-up name separated by a newline.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>
#include <vector>

#include "fuzz_input.h"
#include "lumen/data/data_matrix.h"
#include "lumen/platform/text_conversion.h"

using LumenUtility::DataMatrix;
using LumenUtility::TsComplex;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  lumen_fuzz::FuzzInput input(data, size);
  const int bufferSize = input.Byte() % 12;
  const std::size_t outLength = input.Byte() % 16;
  const int start = static_cast<std::int8_t>(input.Byte()) % 16;
  const int stop = static_cast<std::int8_t>(input.Byte()) % 16;

  DataMatrix m(2, {1, 2}, bufferSize);
  m.AddBuffer(L"A,1");
  m.AddBuffer(L"R,1");
  const wchar_t* names[] = {L"S11", L"S21", L"A,1", L"R,1"};
  for (int b = 0; b < 4; ++b) {
    const std::size_t length = input.Byte() % 16;
    std::vector<TsComplex> samples(length, TsComplex(b + 1.0, -1.0 * b));
    if (b < 2) {
      m.SetDataByPhysicalPort(1 + b / 2 + b % 2, 1, samples);
    } else if (TsComplex* p = m.GetDataByName(names[b])) {
      for (int k = 0; k < bufferSize; ++k) p[k] = samples.empty() ? TsComplex() : samples[0];
    }
  }

  const std::string_view rest(reinterpret_cast<const char*>(data) + (size - input.Left()),
                              input.Left());
  const std::size_t newline = rest.find('\n');
  const std::wstring alias = LumenUtility::Utf8ToWide(rest.substr(0, newline));
  const std::wstring name = newline == std::string_view::npos
                                ? alias
                                : LumenUtility::Utf8ToWide(rest.substr(newline + 1));
  m.AddAlias(alias.c_str(), L"S21");

  const std::vector<TsComplex> before(outLength, TsComplex(7, 7));
  std::vector<TsComplex> out = before;
  if (!m.GetDataByName(name.c_str(), out, start, stop) && out != before) std::abort();
  out = before;
  if (!m.GetDataByAuxName(name.c_str(), out, start, stop) && out != before) std::abort();
  out = before;
  const int a = name.empty() ? 1 : 1 + (name[0] & 1), b = name.size() < 2 ? 1 : 1 + (name[1] & 1);
  if (!m.GetDataByPhysicalPort(a, b, out, start, stop) && out != before) std::abort();
  const TsComplex* p = nullptr;
  if (m.GetDataByPhysicalPort(a, b, &p, start, stop)) {
    const int end = stop == -1 ? bufferSize : stop;
    for (int k = start; k < end; ++k) {
      if (p[k - start] != p[k - start]) std::abort();  // reads the whole range
    }
  } else if (p != nullptr) {
    std::abort();
  }
  out = before;
  if (!m.GetFirstBuffer(out, start, stop) && out != before) std::abort();
  std::vector<TsComplex> in(outLength, TsComplex(3, 3));
  m.SetDataByPhysicalPort(a, b, in, start, stop);
  return 0;
}
