// Error codes typed by people: whatever the text, the parser either rejects it or returns a
// code that reads back the same from its hexadecimal and its decimal spellings, and whose
// error number lies in the mapped range.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <optional>
#include <string_view>

#include "lumen/util/from_hresult.h"
#include "lumenutil/hresult_code.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view text(reinterpret_cast<const char*>(data), size);
  const std::optional<std::int32_t> code = lumenutil::ParseHResultCode(text);
  if (!code) return 0;
  char hex[16];
  char dec[16];
  std::snprintf(hex, sizeof hex, "0x%X", static_cast<std::uint32_t>(*code));
  std::snprintf(dec, sizeof dec, "%d", *code);
  if (lumenutil::ParseHResultCode(hex) != code || lumenutil::ParseHResultCode(dec) != code) {
    std::abort();
  }
  const int number = FromHRESULT(*code);
  if (number < -400 || number > 3027) std::abort();
  return 0;
}
