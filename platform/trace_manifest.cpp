#include "lumen/platform/trace_manifest.h"

namespace LumenUtility {

TraceManifest::TraceManifest(std::string providerName, const GUID& providerId,
                             std::vector<TraceEventInfo> events,
                             std::vector<TraceKeywordName> keywords)
    : m_providerName(std::move(providerName)),
      m_providerId(providerId),
      m_keywords(std::move(keywords)) {
  for (TraceEventInfo& event : events) {
    if (event.id >= m_byId.size()) m_byId.resize(event.id + 1u);
    m_byId[event.id] = std::move(event);
  }
}

const TraceEventInfo* TraceManifest::Find(std::uint16_t id) const {
  if (id >= m_byId.size() || m_byId[id].name.empty()) return nullptr;
  return &m_byId[id];
}

std::string TraceManifest::KeywordNames(std::uint64_t keyword) const {
  std::string names;
  for (const TraceKeywordName& named : m_keywords) {
    if ((keyword & named.bit) == 0) continue;
    if (!names.empty()) names += ',';
    names += named.name;
  }
  return names;
}

}  // namespace LumenUtility
