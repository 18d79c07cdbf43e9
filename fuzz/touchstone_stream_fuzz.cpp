// Differential target: Touchstone text read in chunks must parse exactly as the same text in
// memory. The first byte picks the port count (1 to 4), the second the chunk size (1 to 256
// bytes); the rest is the file's text. Any difference in outcome, message or content traps.
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "data/testing/chunk_source.h"
#include "data/touchstone_parser.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size < 2) return 0;
  const int ports = 1 + data[0] % 4;
  const std::size_t chunk = 1 + data[1];
  const std::string_view text(reinterpret_cast<const char*>(data) + 2, size - 2);

  LumenUtility::TouchstoneContent inMemory, streamed;
  LumenUtility::TouchstoneParser memoryParser(text, ports);
  const bool memoryRead = memoryParser.Parse(inMemory);
  LumenUtility::fixtures::ChunkSource source(text, chunk);
  LumenUtility::TouchstoneParser streamParser(source, ports);
  const bool streamRead = streamParser.Parse(streamed);

  if (memoryRead != streamRead || memoryParser.Error() != streamParser.Error() ||
      inMemory.stimulus != streamed.stimulus || inMemory.pointLines != streamed.pointLines ||
      inMemory.noise != streamed.noise || inMemory.values != streamed.values) {
    __builtin_trap();
  }
  return 0;
}
