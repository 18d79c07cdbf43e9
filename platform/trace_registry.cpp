#include "platform/trace_registry.h"

#include <sys/syscall.h>
#include <unistd.h>

#include <algorithm>

#include "platform/system_clock.h"

namespace LumenUtility {
namespace {

constexpr std::uint64_t kEveryKeyword = ~std::uint64_t{0};

std::uint64_t EffectiveAnyMask(std::uint64_t matchAny) {
  return matchAny == 0 ? kEveryKeyword : matchAny;
}

// Levels compare with 0 as "every level", the widest wish.
std::uint8_t WiderLevel(std::uint8_t a, std::uint8_t b) {
  return (a == 0 || b == 0) ? 0 : std::max(a, b);
}

}  // namespace

TraceRegistry& TraceRegistry::Instance() {
  // Never destroyed: providers and sessions held by other static objects end during exit,
  // in an order this object cannot know.
  static TraceRegistry* const registry = new TraceRegistry;
  return *registry;
}

std::uint32_t TraceRegistry::Register(const GUID& providerId, PENABLECALLBACK callback,
                                      void* context, REGHANDLE& handle) {
  const std::lock_guard<std::mutex> changes(m_changes);
  const Registration registration{providerId, callback, context};
  {
    const std::unique_lock<std::shared_mutex> tables(m_tables);
    handle = m_nextHandle++;
    m_registrations.emplace(handle, registration);
  }
  const EnableState state = CombinedState(providerId);
  if (state.enabled) Call(registration, state);
  return ERROR_SUCCESS;
}

std::uint32_t TraceRegistry::Unregister(REGHANDLE handle) {
  const std::lock_guard<std::mutex> changes(m_changes);
  const std::unique_lock<std::shared_mutex> tables(m_tables);
  return m_registrations.erase(handle) == 1 ? ERROR_SUCCESS : ERROR_INVALID_HANDLE;
}

std::uint32_t TraceRegistry::Write(REGHANDLE handle, const EVENT_DESCRIPTOR& descriptor,
                                   std::uint32_t count, const EVENT_DATA_DESCRIPTOR* data) {
  if (count > kMaxEventDataDescriptors || (count > 0 && data == nullptr)) {
    return ERROR_INVALID_PARAMETER;
  }
  std::uint64_t totalBytes = 0;
  for (std::uint32_t i = 0; i < count; ++i) {
    if (data[i].Ptr == 0 && data[i].Size != 0) return ERROR_INVALID_PARAMETER;
    totalBytes += data[i].Size;
  }
  if (totalBytes > kMaxEventPayloadBytes) return ERROR_ARITHMETIC_OVERFLOW;
  if (m_sessionCount.load(std::memory_order_acquire) == 0) return ERROR_SUCCESS;

  const std::shared_lock<std::shared_mutex> tables(m_tables);
  const auto registration = m_registrations.find(handle);
  if (registration == m_registrations.end()) return ERROR_INVALID_HANDLE;
  const GUID& providerId = registration->second.providerId;
  TraceRecord record;
  bool recordBuilt = false;
  for (const Session& session : m_sessions) {
    if (!(session.providerId == providerId) || !LevelMatches(descriptor.Level, session.level) ||
        !KeywordsMatch(descriptor.Keyword, EffectiveAnyMask(session.matchAny),
                       session.matchAll)) {
      continue;
    }
    if (!recordBuilt) {
      record.providerId = providerId;
      record.descriptor = descriptor;
      record.timestampNs = QueryPerformanceCounter();
      record.processId = static_cast<std::uint32_t>(getpid());
      record.threadId = static_cast<std::uint32_t>(syscall(SYS_gettid));
      for (std::uint32_t i = 0; i < count; ++i) {
        const auto* bytes = reinterpret_cast<const std::uint8_t*>(data[i].Ptr);
        record.items.emplace_back(bytes, bytes + data[i].Size);
      }
      recordBuilt = true;
    }
    try {
      session.sink->Consume(record);
    } catch (...) {
      // A sink's failure must not reach the traced code; the sink reports it its own way.
    }
  }
  return ERROR_SUCCESS;
}

std::uint64_t TraceRegistry::StartSession(const GUID& providerId, std::uint8_t level,
                                          std::uint64_t matchAny, std::uint64_t matchAll,
                                          ITraceSink& sink) {
  const std::lock_guard<std::mutex> changes(m_changes);
  std::uint64_t id;
  {
    const std::unique_lock<std::shared_mutex> tables(m_tables);
    id = m_nextSessionId++;
    m_sessions.push_back(Session{id, providerId, level, matchAny, matchAll, &sink});
    m_sessionCount.store(m_sessions.size(), std::memory_order_release);
  }
  NotifyProvider(providerId);
  return id;
}

void TraceRegistry::StopSession(std::uint64_t id) {
  const std::lock_guard<std::mutex> changes(m_changes);
  GUID providerId;
  {
    const std::unique_lock<std::shared_mutex> tables(m_tables);
    const auto session = std::find_if(m_sessions.begin(), m_sessions.end(),
                                      [id](const Session& s) { return s.id == id; });
    if (session == m_sessions.end()) return;
    providerId = session->providerId;
    m_sessions.erase(session);
    m_sessionCount.store(m_sessions.size(), std::memory_order_release);
  }
  NotifyProvider(providerId);
}

TraceRegistry::EnableState TraceRegistry::CombinedState(const GUID& providerId) const {
  const std::shared_lock<std::shared_mutex> tables(m_tables);
  EnableState state;
  for (const Session& session : m_sessions) {
    if (!(session.providerId == providerId)) continue;
    const std::uint64_t any = EffectiveAnyMask(session.matchAny);
    if (!state.enabled) {
      state = EnableState{true, session.level, any, session.matchAll};
    } else {
      state.level = WiderLevel(state.level, session.level);
      state.matchAny |= any;
      state.matchAll &= session.matchAll;
    }
  }
  return state;
}

void TraceRegistry::NotifyProvider(const GUID& providerId) {
  const EnableState state = CombinedState(providerId);
  std::vector<Registration> registrations;
  {
    const std::shared_lock<std::shared_mutex> tables(m_tables);
    for (const auto& entry : m_registrations) {
      if (entry.second.providerId == providerId) registrations.push_back(entry.second);
    }
  }
  for (const Registration& registration : registrations) Call(registration, state);
}

void TraceRegistry::Call(const Registration& registration, const EnableState& state) {
  if (registration.callback == nullptr) return;
  registration.callback(&registration.providerId,
                        state.enabled ? EVENT_CONTROL_CODE_ENABLE_PROVIDER
                                      : EVENT_CONTROL_CODE_DISABLE_PROVIDER,
                        state.level, state.matchAny, state.matchAll, nullptr,
                        registration.context);
}

}  // namespace LumenUtility
