#include "lumen/platform/beep.h"

#include <unistd.h>

#include <atomic>

#include "platform/system_clock.h"

namespace LumenUtility {
namespace {

std::atomic<IBeepHook*> installedHook{nullptr};

int TerminalBell(std::uint32_t durationMs) {
  if (isatty(STDERR_FILENO)) {
    const char bell = '\a';
    [[maybe_unused]] const ssize_t ignored = ::write(STDERR_FILENO, &bell, 1);
  }
  SystemSleep(durationMs);
  return 1;
}

}  // namespace

void SetBeepHook(IBeepHook* hook) {
  installedHook.store(hook, std::memory_order_release);
}

int Beep(std::uint32_t frequencyHz, std::uint32_t durationMs) {
  IBeepHook* const hook = installedHook.load(std::memory_order_acquire);
  return hook != nullptr ? hook->Beep(frequencyHz, durationMs) : TerminalBell(durationMs);
}

}  // namespace LumenUtility
