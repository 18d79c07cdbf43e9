// Helpers shared by the shared-memory tests: names no other test run uses, and a look at
// the shared-memory namespace.
#pragma once

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include <cstdint>
#include <string>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility::testutil {

// "lumen-test-<pid>-<tag>": runs of the suite in parallel, or two engineers' runs, never meet.
inline std::wstring UniqueBlockName(const std::string& tag) {
  return Utf8ToWide("lumen-test-" + std::to_string(getpid()) + "-" + tag);
}

// Whether the shared-memory namespace holds the block name.
inline bool BlockNameExists(const std::wstring& name) {
  const int fd = shm_open(("/" + WideToUtf8(name)).c_str(), O_RDONLY, 0);
  if (fd < 0) return false;
  close(fd);
  return true;
}

// Runs `f` and returns the HRESULT it throws, or 0 when it throws none.
template <typename F>
std::int32_t ThrownCode(F f) {
  try {
    f();
  } catch (std::int32_t code) {
    return code;
  }
  return 0;
}

}  // namespace LumenUtility::testutil
