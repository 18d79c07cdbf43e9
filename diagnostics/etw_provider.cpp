#include "diagnostics/etw_provider.h"

#include <atomic>

#include "lumen/diagnostics/event_tracing.h"

namespace LumenUtility {
namespace {

struct EnableState {
  std::atomic<bool> enabled{false};
  std::atomic<std::uint8_t> level{0};
  std::atomic<std::uint64_t> matchAny{0};
  std::atomic<std::uint64_t> matchAll{0};
};

EnableState enableState;
std::atomic<REGHANDLE> registration{0};

}  // namespace

bool ETWProvider::Register() {
  REGHANDLE handle = 0;
  if (EventRegister(&ETWProviderId(), EnableCallback, nullptr, &handle) != ERROR_SUCCESS) {
    return false;
  }
  // The callback may already have run inside EventRegister; it does not need the handle.
  registration.store(handle);
  return true;
}

void ETWProvider::Unregister() {
  const REGHANDLE handle = registration.exchange(0);
  if (handle != 0) EventUnregister(handle);
  enableState.enabled.store(false);
}

bool ETWProvider::IsEnabled(const EVENT_DESCRIPTOR& descriptor) {
  if (!enableState.enabled.load(std::memory_order_relaxed)) return false;
  return LevelMatches(descriptor.Level, enableState.level.load(std::memory_order_relaxed)) &&
         KeywordsMatch(descriptor.Keyword, enableState.matchAny.load(std::memory_order_relaxed),
                       enableState.matchAll.load(std::memory_order_relaxed));
}

void ETWProvider::Write(const EVENT_DESCRIPTOR& descriptor, std::uint32_t count,
                        EVENT_DATA_DESCRIPTOR* data) {
  EventWrite(registration.load(std::memory_order_relaxed), &descriptor, count, data);
}

void ETWProvider::EnableCallback(const GUID*, std::uint32_t isEnabled, std::uint8_t level,
                                 std::uint64_t matchAnyKeyword, std::uint64_t matchAllKeyword,
                                 EVENT_FILTER_DESCRIPTOR*, void*) {
  // The masks and level go first, so that a writer that sees the provider enabled also sees
  // what it was enabled for.
  enableState.level.store(level);
  enableState.matchAny.store(matchAnyKeyword);
  enableState.matchAll.store(matchAllKeyword);
  enableState.enabled.store(isEnabled == EVENT_CONTROL_CODE_ENABLE_PROVIDER);
}

}  // namespace LumenUtility
