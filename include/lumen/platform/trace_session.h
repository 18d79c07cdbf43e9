/** @file */
/// @class LumenUtility::TraceSession
/// TraceSession: a host's recording of one provider's events into a sink.
///
/// A session names the provider by GUID, the highest level it wants (0: all) and two keyword
/// masks: an event with keywords needs one bit of the "any" mask and every bit of the "all"
/// mask. An "any" mask of 0 takes every keyword, as trace controllers treat it. Starting and
/// stopping a session calls the enable callback of the provider's registrations with all its
/// sessions' wishes combined (the highest level, the union of the "any" masks, the
/// intersection of the "all" masks); each session still filters the events it records.
/// Thread-safety: sessions may be started and stopped on any thread while events are written
/// on others. Ownership: the session does not own its sink, which must outlive it.
#pragma once

#include <cstdint>
#include <vector>

#include "lumen/export.h"
#include "lumen/platform/event_trace.h"

namespace LumenUtility {

/// One event as a session records it.
struct TraceRecord {
  /// The provider that wrote it.
  GUID providerId;
  /// The event's descriptor, as written.
  EVENT_DESCRIPTOR descriptor;
  /// QueryPerformanceCounter ticks (nanoseconds of the monotonic clock) when it was written.
  std::int64_t timestampNs;
  /// The writing process.
  std::uint32_t processId;
  /// The writing thread (the kernel's thread id).
  std::uint32_t threadId;
  /// The payload items, copied.
  std::vector<std::vector<std::uint8_t>> items;
};

/// Receives a session's events; implemented by MemoryTraceSink, JsonTraceFileSink or the host.
class LUMEN_API ITraceSink {
 public:
  virtual ~ITraceSink() = default;
  /// Takes one event. Called on the writing threads, several at once; an exception it throws
  /// is dropped (tracing never fails the code it traces).
  virtual void Consume(const TraceRecord& record) = 0;
};

class LUMEN_API TraceSession {
 public:
  /// Starts recording events of `providerId` up to `level` that match the keyword masks into
  /// `sink`, calling the provider's enable callback.
  TraceSession(const GUID& providerId, std::uint8_t level, std::uint64_t matchAnyKeyword,
               std::uint64_t matchAllKeyword, ITraceSink& sink);
  TraceSession(const TraceSession&) = delete;
  TraceSession& operator=(const TraceSession&) = delete;
  ~TraceSession();

  /// Stops recording: once this returns the sink is given no more events, and the provider's
  /// enable callback has been told (disabled when this was its last session). Later calls do
  /// nothing.
  void Stop();

 private:
  std::uint64_t m_id;
};

}  // namespace LumenUtility
