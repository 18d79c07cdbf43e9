// Loads a segment or array (first byte's low bit) from a LumenUtility::Archive whose buffer
// holds the first N bytes of the rest (N = the second byte) and whose file holds the others,
// so that refills run too. What loads is stored and loaded again and must store the same.
#include <sys/mman.h>
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <vector>

#include "lumen/platform.h"
#include "lumen/stimulus.h"

namespace {

template <typename T>
std::vector<unsigned char> Stored(T value) {
  std::vector<unsigned char> bytes;
  LumenUtility::Archive ar(bytes, false);
  value.Serialize(ar);
  return bytes;
}

// A descriptor reading `count` bytes at `bytes`, or Archive::kInvalidHandle.
int FileOf(const std::uint8_t* bytes, std::size_t count) {
  if (count == 0) return LumenUtility::Archive::kInvalidHandle;
  const int fd = memfd_create("archive", MFD_CLOEXEC);
  if (fd < 0) return LumenUtility::Archive::kInvalidHandle;
  if (write(fd, bytes, count) != static_cast<ssize_t>(count)) __builtin_trap();
  lseek(fd, 0, SEEK_SET);
  return fd;
}

template <typename T>
void LoadAndRestore(const std::uint8_t* data, std::size_t size, std::size_t inBuffer) {
  std::vector<unsigned char> buffer(data, data + inBuffer);
  T value;
  try {
    LumenUtility::Archive ar(buffer, true, FileOf(data + inBuffer, size - inBuffer));
    value.Serialize(ar);
  } catch (const LumenException&) {
    return;  // a documented rejection
  }
  std::vector<unsigned char> first = Stored(value);
  T again;
  LumenUtility::Archive ar(first, true);
  again.Serialize(ar);
  if (Stored(again) != first) __builtin_trap();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size < 2) return 0;
  const bool array = data[0] & 1;
  const std::size_t rest = size - 2;
  const std::size_t inBuffer = data[1] < rest ? data[1] : rest;
  if (array) {
    LoadAndRestore<LumenUtility::InputArray>(data + 2, rest, inBuffer);
  } else {
    LoadAndRestore<LumenUtility::Segment>(data + 2, rest, inBuffer);
  }
  return 0;
}
