// Reads a fuzzer's input bytes as the values a target builds its test case from. Reading past
// the end never fails: the missing bytes count as zero, so every input, the empty one included,
// makes a complete case and short inputs favour the small, zero-filled cases.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>

namespace lumen_fuzz {

class FuzzInput {
 public:
  FuzzInput(const std::uint8_t* data, std::size_t size) : m_data(data), m_size(size) {}

  // The next byte, or 0 once the input is used up.
  std::uint8_t Byte() { return m_pos < m_size ? m_data[m_pos++] : 0; }

  // The next four bytes as a float in the machine's byte order (any bit pattern: NaN,
  // infinities and subnormals included); bytes past the end read as 0.
  float Float() {
    std::uint8_t bytes[4] = {Byte(), Byte(), Byte(), Byte()};
    float v;
    std::memcpy(&v, bytes, sizeof v);
    return v;
  }

  // The next sizeof(T) bytes as a T when that many are left; otherwise T{} and nothing is
  // consumed, so the bytes left over still serve the smaller reads after it.
  template <typename T>
  T Take() {
    T value{};
    if (Left() >= sizeof(T)) {
      std::memcpy(&value, m_data + m_pos, sizeof(T));
      m_pos += sizeof(T);
    }
    return value;
  }

  // How many bytes are still unread.
  std::size_t Left() const { return m_size - m_pos; }

 private:
  const std::uint8_t* m_data;
  std::size_t m_size;
  std::size_t m_pos = 0;
};

}  // namespace lumen_fuzz
