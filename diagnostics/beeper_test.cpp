#include "diagnostics/beeper.h"

#include <gtest/gtest.h>

#include <climits>
#include <condition_variable>
#include <cstdlib>
#include <mutex>
#include <thread>

#include "lumen/diagnostics/process_utilities.h"
#include "lumen/platform/beep.h"

namespace {

using LumenUtility::Beeper;

// Counts beeps; each beep waits until the test releases it, so the test decides when a beep
// ends. Static in the tests, since a worker may still return from a beep as a test ends.
class GatedHook : public LumenUtility::IBeepHook {
 public:
  int Beep(std::uint32_t frequencyHz, std::uint32_t durationMs) override {
    std::unique_lock<std::mutex> lock(m_mutex);
    const int call = ++m_calls;
    m_lastFrequency = frequencyHz;
    m_lastDuration = durationMs;
    m_lastThread = std::this_thread::get_id();
    m_changed.notify_all();
    m_changed.wait(lock, [&] { return m_released >= call; });
    return 1;
  }
  void WaitForCalls(int calls) {
    std::unique_lock<std::mutex> lock(m_mutex);
    m_changed.wait(lock, [&] { return m_calls >= calls; });
  }
  // Lets the beeps up to number `calls` end; with `restart`, counts calls from 0 again.
  void Release(int calls, bool restart = false) {
    const std::lock_guard<std::mutex> lock(m_mutex);
    if (restart) m_calls = 0;
    m_released = calls;
    m_changed.notify_all();
  }
  int Calls() {
    const std::lock_guard<std::mutex> lock(m_mutex);
    return m_calls;
  }

  std::uint32_t m_lastFrequency = 0, m_lastDuration = 0;
  std::thread::id m_lastThread;

 private:
  std::mutex m_mutex;
  std::condition_variable m_changed;
  int m_calls = 0;
  int m_released = 0;
};

GatedHook& Hook(int released) {
  static GatedHook hook;
  hook.Release(released, true);
  LumenUtility::SetBeepHook(&hook);
  return hook;
}

TEST(Beeper, TwoQuickRequestsSoundOnceOrTwiceNeverMore) {
  GatedHook& hook = Hook(INT_MAX);
  {
    Beeper beeper;
    beeper.Request();
    beeper.Request();
    hook.WaitForCalls(1);
  }  // stopped and joined: no beep can follow
  EXPECT_GE(hook.Calls(), 1);
  EXPECT_LE(hook.Calls(), 2);
  LumenUtility::SetBeepHook(nullptr);
}

TEST(Beeper, RequestsDuringABeepMergeIntoOneMoreBeep) {
  GatedHook& hook = Hook(0);
  {
    Beeper beeper;
    beeper.Request();
    hook.WaitForCalls(1);  // the first beep sounds, held by the hook
    for (int i = 0; i < 5; ++i) beeper.Request();
    hook.Release(1);
    hook.WaitForCalls(2);  // the five requests gave one more beep
    hook.Release(INT_MAX);
  }
  EXPECT_EQ(hook.Calls(), 2);
  LumenUtility::SetBeepHook(nullptr);
}

TEST(AsyncBeep, Sounds600HzFor100msOnTheBeeperThread) {
  GatedHook& hook = Hook(INT_MAX);
  LumenUtility::AsyncBeep();
  hook.WaitForCalls(1);
  EXPECT_EQ(hook.m_lastFrequency, 600u);
  EXPECT_EQ(hook.m_lastDuration, 100u);
  EXPECT_NE(hook.m_lastThread, std::this_thread::get_id());
  LumenUtility::SetBeepHook(nullptr);
}

TEST(AsyncBeepDeathTest, ProcessExitStopsTheBeeperCleanly) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_EXIT(
      {
        Hook(INT_MAX);
        LumenUtility::AsyncBeep();
        LumenUtility::AsyncBeep();
        std::exit(3);
      },
      testing::ExitedWithCode(3), "");
}

}  // namespace
