// WorkerThread: a named thread of the library's own, joined when the object goes.
//
// The name (at most 15 bytes are kept) is what debuggers and `top -H` show for the thread.
// The thread keeps the system's default stack size: a small stack request of the original
// platform only set how much was committed up front, not the reserve the thread could grow
// into, so a smaller stack here would be a real limit that the original never had.
// Thread-safety: construct, Join and destroy from one thread. Ownership: the object owns the
// thread; the body must not destroy the object.
#pragma once

#include <functional>
#include <thread>

namespace LumenUtility {

class WorkerThread {
 public:
  // Starts `body` on a new thread named `name`. Throws std::system_error when the system
  // cannot start a thread.
  WorkerThread(const char* name, std::function<void()> body);
  WorkerThread(const WorkerThread&) = delete;
  WorkerThread& operator=(const WorkerThread&) = delete;
  // Joins the thread if Join has not: the body must be about to end.
  ~WorkerThread();

  // Waits until the body has returned; later calls return at once.
  void Join();

 private:
  std::thread m_thread;
};

}  // namespace LumenUtility
