// Fixed-width values in a message block: little-endian, at their own width, unaligned.
#pragma once

#include <bit>
#include <cstring>
#include <type_traits>

#include "lumen/interprocess/vna_message_marshaling.h"

static_assert(std::endian::native == std::endian::little,
              "message blocks are little-endian; a big-endian host needs byte swapping here");

namespace vna_interprocess {

template <typename T>
requires std::is_integral_v<T>
void WriteWireValue(VNAMessageMarshaling& m, T value) {
  unsigned char bytes[sizeof(T)];
  std::memcpy(bytes, &value, sizeof(T));
  m.WriteToBuffer(bytes, sizeof(T));
}

// Leaves `value` as it was when fewer than sizeof(T) bytes remain.
template <typename T>
requires std::is_integral_v<T>
void ReadWireValue(VNAMessageMarshaling& m, T& value) {
  m.ReadFromBuffer(reinterpret_cast<unsigned char*>(&value), sizeof(T));
}

}  // namespace vna_interprocess
