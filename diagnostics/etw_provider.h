// ETWProvider: the library's registration as a tracing provider and what the enable
// callback last heard from the trace sessions (enabled or not, level, keyword masks).
//
// Process-wide and static, like the registration handle it holds. The enable state is
// written by the callback on a controlling thread and read by every writing thread, so each
// field is atomic; a writer that sees the new level with the old masks for a moment only
// decides one event by a mix of two valid states.
// Thread-safety: IsEnabled and Write may be called from any thread; Register and Unregister
// from one thread at a time (ETWInit and ETWReset).
#pragma once

#include <cstdint>

#include "lumen/platform/event_trace.h"

namespace LumenUtility {

class ETWProvider {
 public:
  // Registers the provider; true on success. Sessions already running enable it at once.
  static bool Register();
  // Ends the registration and forgets the enable state.
  static void Unregister();
  // Whether a session enabled the provider for an event of this level and keyword.
  static bool IsEnabled(const EVENT_DESCRIPTOR& descriptor);
  // Writes the event; the result is ignored, as tracing failures are.
  static void Write(const EVENT_DESCRIPTOR& descriptor, std::uint32_t count,
                    EVENT_DATA_DESCRIPTOR* data);

 private:
  static void EnableCallback(const GUID* sourceId, std::uint32_t isEnabled, std::uint8_t level,
                             std::uint64_t matchAnyKeyword, std::uint64_t matchAllKeyword,
                             EVENT_FILTER_DESCRIPTOR* filterData, void* context);
};

}  // namespace LumenUtility
