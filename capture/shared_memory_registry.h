// The POSIX shared-memory objects behind the file mappings: their names, how they are opened,
// and which of them this process created.
//
// A name created by this process is removed from the shared-memory namespace when the last
// FileMapping of this process that holds it goes away; processes that mapped it keep their
// memory. Names opened from another process are never removed here. A process forked from
// the creator never removes the creator's names.
//
// Thread-safety: every function may be called from any thread; the table of created names is
// guarded by a mutex.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/platform/error_codes.h"

namespace LumenUtility {

// The HRESULT form of an errno value e: (e & 0xFFFF) | 0x80070000 for e > 0, else e.
constexpr HRESULT HResultFromOsError(int e) {
  return e > 0 ? MakeHResult((static_cast<std::uint32_t>(e) & 0xFFFFu) | 0x80070000u) : e;
}

class SharedMemoryRegistry {
 public:
  // The object name of a block: "/" followed by the block name in UTF-8. Throws
  // HResultFromOsError(EINVAL) for a name that is empty or holds "/" or a NUL character.
  static std::string ObjectName(const std::wstring& blockName);

  // Opens the object read/write, creating it with `size` bytes (mode 0600) when there is
  // none, and returns its descriptor. `holder` is set when the object is one this process
  // created; the caller then owes a Release. Throws the HRESULT of the failing call, or
  // HResultFromOsError(EEXIST) when an existing object is smaller than `size`. size >= 1.
  static int Open(const std::string& objectName, std::int64_t size, bool& holder);

  // One more holder of a name this process created.
  static void AddHolder(const std::string& objectName);
  // One holder fewer; the name is removed when none is left.
  static void Release(const std::string& objectName);

  // Whether this process created the name and still holds it (for tests).
  static bool IsHeld(const std::string& objectName);
};

}  // namespace LumenUtility
