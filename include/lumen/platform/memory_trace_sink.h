/** @file */
/// @class LumenUtility::MemoryTraceSink
/// MemoryTraceSink: a session sink that keeps every event it is given, for tests and for hosts
/// that look at events in process.
/// Thread-safety: Consume may run on several threads at once and alongside Records and Clear.
/// Ownership: owns copies of the records.
#pragma once

#include <mutex>
#include <vector>

#include "lumen/export.h"
#include "lumen/platform/trace_session.h"

namespace LumenUtility {

class LUMEN_API MemoryTraceSink : public ITraceSink {
 public:
  void Consume(const TraceRecord& record) override;
  /// A copy of the events so far, in the order they arrived.
  std::vector<TraceRecord> Records() const;
  /// Forgets the events so far.
  void Clear();

 private:
  mutable std::mutex m_mutex;
  std::vector<TraceRecord> m_records;
};

}  // namespace LumenUtility
