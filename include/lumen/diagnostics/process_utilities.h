/// @file
/// Small process utilities kept beside the debug print: an asynchronous beep and sleeps that
/// never end early.
/// Thread-safety: every function may be called from any thread.
#pragma once

#include <cstdint>

#include "lumen/export.h"

namespace LumenUtility {

/// Asks for one beep of 600 Hz for 100 ms (LumenUtility::Beep, see "lumen/platform/beep.h")
/// and returns at once. The beep sounds on the library's beeper thread, started by the first
/// call; requests made while a beep sounds merge into at most one more beep. The thread is
/// stopped and joined when the process exits.
LUMEN_API void AsyncBeep();

/// Sleeps at least `milliseconds` ms (0 to 2^32 - 1) as the monotonic counter measures it,
/// sleeping again for what is left when the system wakes the thread early; 0 returns at once.
LUMEN_API void Sleep(std::uint32_t milliseconds);

/// Waits at least `microseconds` µs. Up to 20000 µs it spins on the counter without giving up
/// the processor (precise, but it keeps one core busy); longer waits sleep whole milliseconds,
/// rounded up. Zero or less returns at once.
LUMEN_API void SleepUsec(int microseconds);

}  // namespace LumenUtility
