#include "lumen/platform/debug_output.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "lumen/platform/beep.h"

namespace {

using namespace LumenUtility;

struct RecordingSink : IDebugOutputSink {
  void Output(const wchar_t* text) override { texts.emplace_back(text); }
  std::vector<std::wstring> texts;
};

TEST(DebugOutput, GoesToStandardErrorAsUtf8UnlessASinkIsInstalled) {
  testing::internal::CaptureStderr();
  OutputDebugStringW(L"µs\n");
  OutputDebugStringW(nullptr);
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "\xC2\xB5s\n");

  RecordingSink sink;
  SetDebugOutputSink(&sink);
  testing::internal::CaptureStderr();
  OutputDebugStringW(L"to the sink");
  SetDebugOutputSink(nullptr);
  OutputDebugStringW(L"back");
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "back");
  EXPECT_EQ(sink.texts, std::vector<std::wstring>{L"to the sink"});
}

struct RecordingBeeps : IBeepHook {
  int Beep(std::uint32_t frequencyHz, std::uint32_t durationMs) override {
    calls.emplace_back(frequencyHz, durationMs);
    return 7;
  }
  std::vector<std::pair<std::uint32_t, std::uint32_t>> calls;
};

TEST(Beep, TheInstalledHookSoundsAndTheDefaultIsQuietOffATerminal) {
  RecordingBeeps hook;
  SetBeepHook(&hook);
  EXPECT_EQ(Beep(600, 100), 7);
  SetBeepHook(nullptr);
  EXPECT_EQ(hook.calls, (std::vector<std::pair<std::uint32_t, std::uint32_t>>{{600, 100}}));
  testing::internal::CaptureStderr();  // a pipe, not a terminal: no bell character
  EXPECT_NE(Beep(600, 1), 0);
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
}

}  // namespace
