#include "diagnostics/beeper.h"

#include "lumen/diagnostics/process_utilities.h"
#include "lumen/platform/beep.h"

namespace LumenUtility {

Beeper::Beeper() : m_worker("lumen-beeper", [this] { Run(); }) {}

Beeper::~Beeper() {
  m_stopping.store(true);
  m_wakeUp.Set();
  m_worker.Join();
}

void Beeper::Run() {
  for (;;) {
    m_wakeUp.Wait();
    if (m_stopping.load()) return;
    Beep(kFrequencyHz, kDurationMs);
  }
}

void AsyncBeep() {
  // Created on first use and destroyed at exit, which stops the worker.
  static Beeper beeper;
  beeper.Request();
}

}  // namespace LumenUtility
