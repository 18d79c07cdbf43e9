// The table behind FromHRESULT, for benchmarks and checks that need its keys.
#pragma once

#include <cstdint>
#include <span>

namespace LumenUtility {

struct HResultErrorNumber {
  std::uint32_t code;  // the HRESULT's 32 bits
  std::int16_t number;
};

// Every mapped code, ascending by its unsigned 32-bit value: 481 entries.
std::span<const HResultErrorNumber> HResultErrorNumbers();

}  // namespace LumenUtility
