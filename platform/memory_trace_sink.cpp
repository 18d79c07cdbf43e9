#include "lumen/platform/memory_trace_sink.h"

namespace LumenUtility {

void MemoryTraceSink::Consume(const TraceRecord& record) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  m_records.push_back(record);
}

std::vector<TraceRecord> MemoryTraceSink::Records() const {
  const std::lock_guard<std::mutex> lock(m_mutex);
  return m_records;
}

void MemoryTraceSink::Clear() {
  const std::lock_guard<std::mutex> lock(m_mutex);
  m_records.clear();
}

}  // namespace LumenUtility
