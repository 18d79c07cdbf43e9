#include "platform/worker_thread.h"

#include <pthread.h>

#include <string>

namespace LumenUtility {

WorkerThread::WorkerThread(const char* name, std::function<void()> body)
    : m_thread(std::move(body)) {
  // The system keeps 15 bytes and a terminating zero; a longer name would be refused whole.
  const std::string shortName = std::string(name ? name : "").substr(0, 15);
  pthread_setname_np(m_thread.native_handle(), shortName.c_str());
}

WorkerThread::~WorkerThread() {
  Join();
}

void WorkerThread::Join() {
  if (m_thread.joinable()) m_thread.join();
}

}  // namespace LumenUtility
