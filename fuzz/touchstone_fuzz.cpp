// Feeds arbitrary bytes to the Touchstone reader. The first byte picks the port count a
// version 1 file is read with (1 to 4); the rest is the file's text.
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "lumen/data.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) return 0;
  CSnPFileBase reader(1 + data[0] % 4);
  const std::string_view text(reinterpret_cast<const char*>(data) + 1, size - 1);
  const int points = reader.ReadSNPText(text);
  if (points >= 0 && reader.GetParam(SNP_S11).GetNumPoints() != points) __builtin_trap();
  return 0;
}
