/// @file
/// Event tracing for providers: registration with an enable callback, and writing events.
///
/// The shapes are those of the original platform's event tracing (GUID, EVENT_DESCRIPTOR,
/// EVENT_DATA_DESCRIPTOR, the enable callback), so provider code reads as it would there.
/// Events reach the sessions a host starts with TraceSession ("lumen/platform/trace_session.h");
/// a session's start and stop call the enable callback of every provider registered under
/// its GUID, with the level and keyword masks of all the provider's sessions together.
/// Thread-safety: every function may be called from any thread. An enable callback runs on
/// the thread that starts or stops a session or registers the provider, and must not call
/// EventRegister, EventUnregister or start or stop sessions (EventWrite is fine).
/// Ownership: a registration lasts until EventUnregister; the callback context is not owned.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/export.h"

namespace LumenUtility {

/// A 128-bit identifier of a provider, in the original platform's layout.
struct GUID {
  /// First 8 hex digits.
  std::uint32_t Data1;
  /// Next 4 hex digits.
  std::uint16_t Data2;
  /// Next 4 hex digits.
  std::uint16_t Data3;
  /// Last 16 hex digits, two per byte.
  std::uint8_t Data4[8];
};

/// True when all 16 bytes are equal.
LUMEN_API bool operator==(const GUID& a, const GUID& b);
/// The registry form, upper case in braces: "{532E117B-E9BD-4FE9-B3BA-B009375F889B}".
LUMEN_API std::string GuidToString(const GUID& guid);

/// What an event is: its number within the provider and the fields consumers filter on.
struct EVENT_DESCRIPTOR {
  /// Event number within the provider.
  std::uint16_t Id;
  /// Version of the event's payload layout.
  std::uint8_t Version;
  /// Channel the event is meant for (0: none).
  std::uint8_t Channel;
  /// Severity: 1 critical to 5 verbose; sessions take events up to their level.
  std::uint8_t Level;
  /// Step of an activity (0 info, 1 start, 2 stop).
  std::uint8_t Opcode;
  /// Task the event belongs to.
  std::uint16_t Task;
  /// Keyword bits sessions filter on (0: matches every session).
  std::uint64_t Keyword;
};

/// One item of an event's payload: Size bytes at the address Ptr.
struct EVENT_DATA_DESCRIPTOR {
  /// Address of the bytes.
  std::uint64_t Ptr;
  /// Number of bytes.
  std::uint32_t Size;
  /// 0.
  std::uint32_t Reserved;
};

/// Fills `descriptor` for `size` bytes at `data` (not copied until EventWrite).
inline void EventDataDescCreate(EVENT_DATA_DESCRIPTOR* descriptor, const void* data,
                                std::uint32_t size) {
  descriptor->Ptr = reinterpret_cast<std::uintptr_t>(data);
  descriptor->Size = size;
  descriptor->Reserved = 0;
}

/// Payload filters of the original platform; sessions here never pass one (always null).
struct EVENT_FILTER_DESCRIPTOR;

/// A provider registration; 0 is never a valid one.
using REGHANDLE = std::uint64_t;

///@{
/// IsEnabled codes passed to an enable callback.
inline constexpr std::uint32_t EVENT_CONTROL_CODE_DISABLE_PROVIDER = 0;
inline constexpr std::uint32_t EVENT_CONTROL_CODE_ENABLE_PROVIDER = 1;
///@}

/// Told when sessions for the provider change: enabled or not, the highest level wanted
/// (0: every level), the keywords of which an event needs one ("any") and the keywords it
/// needs all of ("all").
using PENABLECALLBACK = void (*)(const GUID* sourceId, std::uint32_t isEnabled,
                                 std::uint8_t level, std::uint64_t matchAnyKeyword,
                                 std::uint64_t matchAllKeyword,
                                 EVENT_FILTER_DESCRIPTOR* filterData, void* callbackContext);

///@{
/// Results, with the original platform's numbers.
inline constexpr std::uint32_t ERROR_SUCCESS = 0;
inline constexpr std::uint32_t ERROR_INVALID_HANDLE = 6;
inline constexpr std::uint32_t ERROR_INVALID_PARAMETER = 87;
inline constexpr std::uint32_t ERROR_ARITHMETIC_OVERFLOW = 534;
///@}

///@{
/// Largest payload of one event in bytes, and most items, as on the original platform.
inline constexpr std::uint32_t kMaxEventPayloadBytes = 65535;
inline constexpr std::uint32_t kMaxEventDataDescriptors = 128;
///@}

/// Registers a provider; `enableCallback` (may be null) is called at once when sessions for
/// the GUID are running. ERROR_SUCCESS with a nonzero handle in `regHandle`, or
/// ERROR_INVALID_PARAMETER for a null `providerId` or `regHandle`.
LUMEN_API std::uint32_t EventRegister(const GUID* providerId, PENABLECALLBACK enableCallback,
                                      void* callbackContext, REGHANDLE* regHandle);

/// Ends a registration: no callback is called for it after this returns. ERROR_SUCCESS, or
/// ERROR_INVALID_HANDLE for a handle that is not registered.
LUMEN_API std::uint32_t EventUnregister(REGHANDLE regHandle);

/// Hands the event to every session of the provider whose level and keywords it matches; the
/// payload is copied. ERROR_SUCCESS (also when no session takes it); ERROR_INVALID_PARAMETER
/// for a null descriptor, more than kMaxEventDataDescriptors items, or items missing their
/// data; ERROR_ARITHMETIC_OVERFLOW for a payload above kMaxEventPayloadBytes (not written);
/// ERROR_INVALID_HANDLE for an unregistered handle while sessions are running.
LUMEN_API std::uint32_t EventWrite(REGHANDLE regHandle, const EVENT_DESCRIPTOR* eventDescriptor,
                                   std::uint32_t userDataCount, EVENT_DATA_DESCRIPTOR* userData);

/// The keyword rule both sessions and providers apply: an event without keywords always
/// matches; otherwise it needs one bit of `matchAny` and every bit of `matchAll`.
constexpr bool KeywordsMatch(std::uint64_t keyword, std::uint64_t matchAny,
                             std::uint64_t matchAll) {
  return keyword == 0 || ((keyword & matchAny) != 0 && (keyword & matchAll) == matchAll);
}

/// The level rule: `enabledLevel` 0 takes every level.
constexpr bool LevelMatches(std::uint8_t eventLevel, std::uint8_t enabledLevel) {
  return enabledLevel == 0 || eventLevel <= enabledLevel;
}

}  // namespace LumenUtility
