#include "platform/auto_reset_event.h"

#include <gtest/gtest.h>

#include <atomic>

#include "platform/worker_thread.h"

namespace {

using LumenUtility::AutoResetEvent;
using LumenUtility::WorkerThread;

TEST(AutoResetEvent, ASetBeforeTheWaitIsKeptAndSeveralSetsReleaseOneWait) {
  AutoResetEvent event;
  event.Set();
  event.Set();
  event.Wait();  // returns at once: the signal was kept
  // The two sets released one wait only: a worker waiting now stays blocked until the next.
  std::atomic<int> released{0};
  AutoResetEvent done;
  WorkerThread worker("event-test", [&] {
    event.Wait();
    released = 1;
    done.Set();
  });
  EXPECT_EQ(released.load(), 0);
  event.Set();
  done.Wait();
  EXPECT_EQ(released.load(), 1);
}

TEST(WorkerThread, RunsItsBodyAndJoinsOnceWhetherJoinedOrDestroyed) {
  std::atomic<int> runs{0};
  {
    WorkerThread worker("a-name-longer-than-fifteen-bytes", [&] { ++runs; });
    worker.Join();
    EXPECT_EQ(runs.load(), 1);
    worker.Join();
  }
  { WorkerThread worker(nullptr, [&] { ++runs; }); }
  EXPECT_EQ(runs.load(), 2);
}

}  // namespace
