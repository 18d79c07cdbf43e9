// AutoResetEvent: a signal that releases one wait and then resets itself.
//
// Set() while nobody waits keeps the event signalled until the next Wait(); several Set()
// calls before that Wait() release it once, as the system's auto-reset events do. That is
// what lets requests that come while a worker is busy merge into one.
// Thread-safety: Set and Wait may be called from any threads at once. Ownership: plain
// object; it must outlive every call in progress.
#pragma once

#include <condition_variable>
#include <mutex>

namespace LumenUtility {

class AutoResetEvent {
 public:
  AutoResetEvent() = default;
  AutoResetEvent(const AutoResetEvent&) = delete;
  AutoResetEvent& operator=(const AutoResetEvent&) = delete;

  // Signals the event: one waiting thread (or the next to wait) is released.
  void Set();
  // Blocks until the event is signalled, then resets it.
  void Wait();

 private:
  std::mutex m_mutex;
  std::condition_variable m_changed;
  bool m_signalled = false;
};

}  // namespace LumenUtility
