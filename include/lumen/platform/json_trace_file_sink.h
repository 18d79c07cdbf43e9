/** @file */
/// @class LumenUtility::JsonTraceFileSink
/// JsonTraceFileSink: a session sink that writes a trace file in the trace-event JSON format,
/// which trace viewers such as the Perfetto UI (ui.perfetto.dev) and chrome://tracing open.
///
/// Events the manifest names appear by name, their payload as named arguments ("value",
/// "text"); a Begin and End pair on one thread shows as a span named after its task, other
/// events as instants; keyword names become the category. Events the manifest does not know
/// appear as "event <id>" with their payload in hexadecimal. Times are microseconds of the
/// monotonic clock.
/// The file is written under the name given plus ".part" and renamed to that name by Close,
/// so a file under the given name is always complete.
/// Thread-safety: Consume may run on several threads at once (one lock). Stop the session
/// before Close. Ownership: owns the file; the manifest is not owned and must outlive it.
#pragma once

#include <mutex>
#include <optional>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/cfile.h"
#include "lumen/platform/trace_manifest.h"
#include "lumen/platform/trace_session.h"

namespace LumenUtility {

class LUMEN_API JsonTraceFileSink : public ITraceSink {
 public:
  /// Creates the ".part" file beside `path`; `manifest` may be null (every event by number).
  /// Throws CFileException when it cannot be created.
  JsonTraceFileSink(const std::wstring& path, const TraceManifest* manifest);
  JsonTraceFileSink(const JsonTraceFileSink&) = delete;
  JsonTraceFileSink& operator=(const JsonTraceFileSink&) = delete;
  /// Closes as Close does, discarding a failure (the ".part" file is then removed).
  ~JsonTraceFileSink() override;

  /// Writes one event; after a write failure or Close, events are dropped.
  void Consume(const TraceRecord& record) override;

  /// Completes the file and renames it to the path given. Throws CFileException when a write
  /// failed earlier or now, or the rename fails; the ".part" file is then removed and no file
  /// appears under the path. Later calls do nothing.
  void Close();

 private:
  std::string EventJson(const TraceRecord& record) const;
  void WriteText(const std::string& text);

  std::mutex m_mutex;
  std::wstring m_path;
  std::wstring m_partPath;
  const TraceManifest* m_pManifest;
  CFile m_file;
  bool m_first = true;
  bool m_closed = false;
  std::optional<CFileException> m_error;
};

}  // namespace LumenUtility
