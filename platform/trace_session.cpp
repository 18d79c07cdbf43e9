#include "lumen/platform/trace_session.h"

#include "platform/trace_registry.h"

namespace LumenUtility {

TraceSession::TraceSession(const GUID& providerId, std::uint8_t level,
                           std::uint64_t matchAnyKeyword, std::uint64_t matchAllKeyword,
                           ITraceSink& sink)
    : m_id(TraceRegistry::Instance().StartSession(providerId, level, matchAnyKeyword,
                                                  matchAllKeyword, sink)) {}

TraceSession::~TraceSession() {
  Stop();
}

void TraceSession::Stop() {
  if (m_id == 0) return;
  TraceRegistry::Instance().StopSession(m_id);
  m_id = 0;
}

}  // namespace LumenUtility
