/** @file */
/// @class LumenUtility::TraceManifest
/// TraceManifest: the names of a provider's events, tasks, keywords and payload fields, which
/// let a trace file show "SweepStart" with "value: 3" instead of event 1 with 4 bytes.
/// Thread-safety: immutable after construction; share freely. Ownership: plain value.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "lumen/export.h"
#include "lumen/platform/event_trace.h"

namespace LumenUtility {

/// How a payload item is read.
enum class TraceFieldType : std::uint8_t {
  Int32,       ///< 4 bytes, little-endian two's complement
  Utf16String  ///< UTF-16LE code units ending with a zero unit
};

/// How a viewer draws an event: a point in time, or the start or end of a span on its thread.
enum class TracePhase : std::uint8_t { Instant, Begin, End };

/// One payload item of an event: its name in the viewer and how its bytes are read.
struct TraceField {
  std::string name;  ///< Field name shown by viewers.
  /// How the item's bytes are read.
  TraceFieldType type;
};

/// What a manifest says about one event id.
struct TraceEventInfo {
  /// The event's EVENT_DESCRIPTOR::Id.
  std::uint16_t id;
  std::string name;  ///< Event name shown by viewers.
  /// The span a Begin and End pair forms is named after the task.
  std::string task;
  /// Whether the event is an instant, or starts or ends a span.
  TracePhase phase;
  /// One per payload item, in order.
  std::vector<TraceField> fields;
};

/// A name for one keyword bit.
struct TraceKeywordName {
  /// The keyword bit (one bit set).
  std::uint64_t bit;
  std::string name;  ///< The keyword's name.
};

class LUMEN_API TraceManifest {
 public:
  /// Names the events and keywords of the provider `providerName` registered under
  /// `providerId`; of events with the same id, the last one given counts.
  TraceManifest(std::string providerName, const GUID& providerId,
                std::vector<TraceEventInfo> events, std::vector<TraceKeywordName> keywords);

  /// The provider's name.
  const std::string& ProviderName() const { return m_providerName; }
  /// The provider's GUID.
  const GUID& ProviderId() const { return m_providerId; }
  /// The event of `id`, or null when the manifest does not name it.
  const TraceEventInfo* Find(std::uint16_t id) const;
  /// The names of the keyword bits set in `keyword`, joined by ','; empty when none is named.
  std::string KeywordNames(std::uint64_t keyword) const;

 private:
  std::string m_providerName;
  GUID m_providerId;
  /// Indexed by event id; ids the manifest does not name hold an empty name.
  std::vector<TraceEventInfo> m_byId;
  std::vector<TraceKeywordName> m_keywords;
};

}  // namespace LumenUtility
