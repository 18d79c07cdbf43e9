#include "platform/auto_reset_event.h"

namespace LumenUtility {

void AutoResetEvent::Set() {
  {
    const std::lock_guard<std::mutex> lock(m_mutex);
    m_signalled = true;
  }
  m_changed.notify_one();
}

void AutoResetEvent::Wait() {
  std::unique_lock<std::mutex> lock(m_mutex);
  m_changed.wait(lock, [this] { return m_signalled; });
  m_signalled = false;
}

}  // namespace LumenUtility
