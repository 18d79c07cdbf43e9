// The event catalogue of the tracing provider: for each of the 95 events its descriptor,
// payload kind and names.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "lumen/platform/event_trace.h"

namespace LumenUtility {

// The payload an event carries; each kind has its logger.
enum class ETWLoggerKind : std::uint8_t { None, Int, String, IntString };

struct ETWEventDefinition {
  EVENT_DESCRIPTOR descriptor;
  ETWLoggerKind kind;
  std::string name;
  std::string task;
};

inline constexpr std::uint8_t kETWChannel = 16;
inline constexpr std::uint8_t kETWLevel = 16;
inline constexpr std::uint8_t kETWOpcodeInfo = 0;
inline constexpr std::uint8_t kETWOpcodeStart = 10;
inline constexpr std::uint8_t kETWOpcodeStop = 11;
// Set in every event's keyword, beside its group bits.
inline constexpr std::uint64_t kETWChannelKeyword = 0x8000000000000000;

// The events in id order, built on first use and never changed.
const std::vector<ETWEventDefinition>& ETWCatalogue();

}  // namespace LumenUtility
