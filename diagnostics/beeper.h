// Beeper: the worker thread that sounds the beeps AsyncBeep asks for.
//
// Requests set an auto-reset event; the worker sounds one beep per wake-up, so requests that
// come while a beep sounds merge into one more beep. Destruction sets the stop flag, wakes
// the worker and joins it; a request still waiting then is dropped.
// Thread-safety: Request may be called from any thread, also while the worker beeps.
// Ownership: owns its event and thread.
#pragma once

#include <atomic>
#include <cstdint>

#include "platform/auto_reset_event.h"
#include "platform/worker_thread.h"

namespace LumenUtility {

class Beeper {
 public:
  static constexpr std::uint32_t kFrequencyHz = 600;
  static constexpr std::uint32_t kDurationMs = 100;

  // Starts the worker. Throws std::system_error when no thread can be started.
  Beeper();
  Beeper(const Beeper&) = delete;
  Beeper& operator=(const Beeper&) = delete;
  // Stops and joins the worker; waits for a beep that is sounding to end.
  ~Beeper();

  // Asks for a beep and returns at once.
  void Request() { m_wakeUp.Set(); }

 private:
  void Run();

  AutoResetEvent m_wakeUp;
  std::atomic<bool> m_stopping{false};
  // Last: the worker starts once everything it uses exists.
  WorkerThread m_worker;
};

}  // namespace LumenUtility
