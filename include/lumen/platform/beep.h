/// @file
/// Beep: the process-wide sound hook that sounds a tone of a given pitch and length.
///
/// By default a beep rings the terminal bell on standard error when that is a terminal (the
/// pitch cannot be chosen there) and then waits for the tone's duration, so callers that pace
/// themselves by beeps keep their timing. A host with a real sound device installs its hook.
/// Thread-safety: Beep may be called from any thread; the installed hook's Beep likewise.
/// Ownership: the hook is not owned; SetBeepHook's caller keeps it alive until another hook
/// replaces it and every Beep call in progress returned.
#pragma once

#include <cstdint>

#include "lumen/export.h"

namespace LumenUtility {

/// Sounds tones for Beep; implemented by the host.
class LUMEN_API IBeepHook {
 public:
  virtual ~IBeepHook() = default;
  /// Sounds `frequencyHz` (37 to 32767 Hz on the original platform) for `durationMs`
  /// milliseconds and returns when the tone has ended; nonzero on success.
  virtual int Beep(std::uint32_t frequencyHz, std::uint32_t durationMs) = 0;
};

/// Installs `hook` for all later beeps; null restores the terminal-bell default.
LUMEN_API void SetBeepHook(IBeepHook* hook);

/// Sounds a tone through the installed hook and returns its result; the default returns
/// nonzero after `durationMs` milliseconds.
LUMEN_API int Beep(std::uint32_t frequencyHz, std::uint32_t durationMs);

}  // namespace LumenUtility
