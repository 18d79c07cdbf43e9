// A Touchstone source for tests and fuzz targets: gives a text in pieces of at most a chosen
// size, as a pipe may. Does not own the text, which must outlive it.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <string_view>

#include "data/touchstone_parser.h"

namespace LumenUtility::fixtures {

class ChunkSource : public TouchstoneSource {
 public:
  // `chunk` >= 1 bytes per Read.
  ChunkSource(std::string_view text, std::size_t chunk) : m_text(text), m_chunk(chunk) {}
  // The next at most min(capacity, chunk) bytes; 0 at the end of the text.
  std::size_t Read(char* buffer, std::size_t capacity) override {
    const std::size_t count = std::min({capacity, m_chunk, m_text.size()});
    if (count > 0) std::memcpy(buffer, m_text.data(), count);
    m_text.remove_prefix(count);
    return count;
  }

 private:
  std::string_view m_text;
  std::size_t m_chunk;
};

}  // namespace LumenUtility::fixtures
