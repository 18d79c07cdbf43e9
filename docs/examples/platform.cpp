// Platform base: result codes, the library exception, text conversion, and an archive written
// to a memory file and read back past its end.
// guide:begin
#include <cstdint>
#include <cstdio>
#include <string>

#include "lumen/platform.h"

using namespace LumenUtility;

int main() {
  LumenException error(LUMEN_E_BOUNDS, L"segment count");
  error.AddMessage(L"while reading the sweep");
  std::printf("%s (failed: %d)\n", error.what(), Failed(error.GetCode()));

  const std::wstring text = Utf8ToWide("10 \xC2\xB5s");  // UTF-8 in, wide text out
  std::printf("%zu characters, %zu UTF-8 bytes\n", text.size(), WideToUtf8(text).size());

  CMemFile file;
  {
    CArchive out(&file, CArchive::store);
    out << std::int32_t{201} << 2.4e9 << std::wstring(L"S21");
  }
  file.SeekToBegin();
  CArchive in(&file, CArchive::load);
  std::int32_t points = 0;
  double frequency = 0;
  std::wstring name;
  in >> points >> frequency >> name;
  std::printf("%d points at %g Hz, %ls\n", points, frequency, name.c_str());
  try {
    in >> points;  // nothing left
  } catch (const CArchiveException& e) {
    std::printf("cause %d: %ls\n", e.m_cause, e.GetErrorMessage().c_str());
  }
}
// guide:end
