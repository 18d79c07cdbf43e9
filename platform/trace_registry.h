// TraceRegistry: the process's provider registrations and running trace sessions, which
// EventRegister, EventWrite, EventUnregister and TraceSession work through.
//
// Two locks: one serialises the changes (registrations, sessions) together with the enable
// callbacks they cause, so a provider sees its enable states in order; the other guards the
// tables, shared by writers and taken alone only for the moment a table changes. Writers thus
// never wait for an enable callback, and a callback may write events.
// Thread-safety: every operation may be called from any thread. Ownership: sinks and callback
// contexts are not owned.
#pragma once

#include <atomic>
#include <cstdint>
#include <map>
#include <mutex>
#include <shared_mutex>
#include <vector>

#include "lumen/platform/event_trace.h"
#include "lumen/platform/trace_session.h"

namespace LumenUtility {

class TraceRegistry {
 public:
  static TraceRegistry& Instance();

  std::uint32_t Register(const GUID& providerId, PENABLECALLBACK callback, void* context,
                         REGHANDLE& handle);
  std::uint32_t Unregister(REGHANDLE handle);
  std::uint32_t Write(REGHANDLE handle, const EVENT_DESCRIPTOR& descriptor, std::uint32_t count,
                      const EVENT_DATA_DESCRIPTOR* data);

  // Adds a session and tells the provider's registrations; returns the session's id.
  std::uint64_t StartSession(const GUID& providerId, std::uint8_t level, std::uint64_t matchAny,
                             std::uint64_t matchAll, ITraceSink& sink);
  // Removes the session (an unknown id does nothing) and tells the provider's registrations.
  void StopSession(std::uint64_t id);

 private:
  struct Registration {
    GUID providerId;
    PENABLECALLBACK callback;
    void* context;
  };
  struct Session {
    std::uint64_t id;
    GUID providerId;
    std::uint8_t level;
    std::uint64_t matchAny;
    std::uint64_t matchAll;
    ITraceSink* sink;
  };
  // The combined wishes of a provider's sessions.
  struct EnableState {
    bool enabled = false;
    std::uint8_t level = 0;
    std::uint64_t matchAny = 0;
    std::uint64_t matchAll = 0;
  };

  TraceRegistry() = default;
  // Both called with m_changes held.
  EnableState CombinedState(const GUID& providerId) const;
  void NotifyProvider(const GUID& providerId);
  static void Call(const Registration& registration, const EnableState& state);

  std::mutex m_changes;
  mutable std::shared_mutex m_tables;
  std::map<REGHANDLE, Registration> m_registrations;
  std::vector<Session> m_sessions;
  // Sessions running: lets EventWrite skip the lock while nothing records.
  std::atomic<std::size_t> m_sessionCount{0};
  REGHANDLE m_nextHandle = 1;
  std::uint64_t m_nextSessionId = 1;
};

}  // namespace LumenUtility
