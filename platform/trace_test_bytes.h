// Payload items as the tracing functions lay them out, for tests of trace records.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility::testutil {

// A 32-bit integer item: 4 bytes, little-endian.
inline std::vector<std::uint8_t> Int32Bytes(std::int32_t v) {
  const auto u = static_cast<std::uint32_t>(v);
  return {static_cast<std::uint8_t>(u), static_cast<std::uint8_t>(u >> 8),
          static_cast<std::uint8_t>(u >> 16), static_cast<std::uint8_t>(u >> 24)};
}

// A text item: UTF-16LE with its terminating zero unit.
inline std::vector<std::uint8_t> TextBytes(const std::wstring& text) {
  const std::string bytes = WideToUtf16LeBytes(text) + std::string(2, '\0');
  return {bytes.begin(), bytes.end()};
}

}  // namespace LumenUtility::testutil
