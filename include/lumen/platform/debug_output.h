/// @file
/// Debugger output: the process-wide sink that diagnostic text goes to for a debugger or log
/// viewer to show.
///
/// By default the text goes to standard error, UTF-8 encoded and written with one system call
/// per text, so lines from several threads do not mix within a text. A host that shows the
/// output elsewhere installs its own sink.
/// Thread-safety: OutputDebugStringW may be called from any thread at once, and so the
/// installed sink's Output. Ownership: the sink is not owned; SetDebugOutputSink's caller
/// keeps it alive until another sink replaces it and every Output call in progress returned.
#pragma once

#include "lumen/export.h"

namespace LumenUtility {

/// Where debugger output goes; implemented by the host.
class LUMEN_API IDebugOutputSink {
 public:
  virtual ~IDebugOutputSink() = default;
  /// Shows `text` (never null), which carries its own line ends, if any.
  virtual void Output(const wchar_t* text) = 0;
};

/// Installs `sink` for all later output; null restores the standard-error default.
LUMEN_API void SetDebugOutputSink(IDebugOutputSink* sink);

/// Sends `text` to the installed sink. Null sends nothing. Errors of the default sink
/// (standard error closed or full) are ignored, as a debugger that is not there is.
LUMEN_API void OutputDebugStringW(const wchar_t* text);

}  // namespace LumenUtility
