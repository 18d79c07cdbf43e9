// Builds expected byte records field by field for the persisted-form tests.
#pragma once

#include <cstdint>
#include <cstring>
#include <vector>

namespace LumenUtility::testutil {

using Bytes = std::vector<unsigned char>;

// Golden().Put<std::uint16_t>(1).Put(3.5).bytes: each field's little-endian bytes in order.
struct Golden {
  template <typename T>
  Golden& Put(T value) {
    unsigned char raw[sizeof(T)];
    std::memcpy(raw, &value, sizeof(T));
    bytes.insert(bytes.end(), raw, raw + sizeof(T));
    return *this;
  }
  Golden& Append(const Bytes& more) {
    bytes.insert(bytes.end(), more.begin(), more.end());
    return *this;
  }
  Bytes bytes;
};

}  // namespace LumenUtility::testutil
