#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "lumen/diagnostics/debug_print.h"
#include "lumen/platform/debug_output.h"
#include "lumen/platform/ini_profile_store.h"
#include "platform/temp_dir.h"

namespace {

using LumenUtility::IniProfileStore;
using LumenUtility::testutil::TempDir;
using LumenUtility::testutil::FileText;

struct QuietDebugger : LumenUtility::IDebugOutputSink {
  void Output(const wchar_t*) override {}
};

// gDebugPrint unlocked with the debugger output discarded and a memory profile installed;
// returned to its start-up state afterwards.
class DebugPrintSettingsTest : public testing::Test {
 protected:
  void SetUp() override {
    LumenUtility::SetDebugOutputSink(&m_quiet);
    LumenUtility::SetProfileStore(&m_profile);
    gDebugPrint.SetFilePath((m_dir.Path("") + L"/").c_str());
    gDebugPrint.Lockout(false);
  }
  void TearDown() override {
    gDebugPrint.SetDeviceOn(CDebugPrint::File, false);
    gDebugPrint.SetFilePath(L"");
    gDebugPrint.SetFileName(L"");
    for (int slot = 0; slot < 256; ++slot) gDebugPrint.SetOn(slot, false);
    gDebugPrint.Lockout(true);
    LumenUtility::SetProfileStore(nullptr);
    LumenUtility::SetDebugOutputSink(nullptr);
  }
  std::wstring Stored(const wchar_t* entry) {
    return m_profile.GetProfileString(L"Debug", entry, L"<none>");
  }

  QuietDebugger m_quiet;
  IniProfileStore m_profile;
  TempDir m_dir;
};

TEST_F(DebugPrintSettingsTest, SaveWritesSlotsFileNameAndFileFlagToSectionDebug) {
  for (const int slot : {0, 3, 255}) gDebugPrint.SetOn(slot, true);
  gDebugPrint.SetFileName(L"f.txt");
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  gDebugPrint.SaveSettings();
  std::wstring slots(256, L'0');
  slots[0] = slots[3] = slots[255] = L'1';
  EXPECT_EQ(Stored(L"Debug Print"), slots);
  EXPECT_EQ(Stored(L"Debug Print Filename"), L"f.txt");
  EXPECT_EQ(m_profile.GetProfileInt(L"Debug", L"Debug Print File", -1), 1);
  gDebugPrint.SetDeviceOn(CDebugPrint::File, false);
  gDebugPrint.SaveSettings();
  EXPECT_EQ(m_profile.GetProfileInt(L"Debug", L"Debug Print File", -1), 0);
}

TEST_F(DebugPrintSettingsTest, RecallSetsTheSlotsItHoldsAndLeavesTheRest) {
  for (const int slot : {0, 4, 200}) gDebugPrint.SetOn(slot, true);
  gDebugPrint.SetFileName(L"kept.txt");
  m_profile.WriteProfileString(L"Debug", L"Debug Print", L"0101");
  gDebugPrint.RecallSettings();
  std::vector<int> on;
  for (int slot = 0; slot < 256; ++slot) {
    if (gDebugPrint.IsOn(slot)) on.push_back(slot);
  }
  EXPECT_EQ(on, (std::vector<int>{1, 3, 4, 200}));
  EXPECT_EQ(gDebugPrint.GetFileName(), L"kept.txt");  // no stored name: unchanged
  EXPECT_FALSE(gDebugPrint.IsDeviceOn(CDebugPrint::File));

  // A longer string sets 256 slots and ignores the rest; characters other than '1' are off.
  m_profile.WriteProfileString(L"Debug", L"Debug Print", std::wstring(255, L'x') + L"1" + L"1111");
  gDebugPrint.RecallSettings();
  EXPECT_FALSE(gDebugPrint.IsOn(1));
  EXPECT_TRUE(gDebugPrint.IsOn(255));
}

TEST_F(DebugPrintSettingsTest, RecallOpensTheRecalledFileAnewOrClosesIt) {
  gDebugPrint.SetOn(5, true);
  gDebugPrint.SetFileName(L"a.txt");
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  dprint(5, L"in a\n");
  m_profile.WriteProfileString(L"Debug", L"Debug Print Filename", L"b.txt");
  m_profile.WriteProfileInt(L"Debug", L"Debug Print File", 1);
  gDebugPrint.RecallSettings();
  dprint(5, L"in b\n");
  EXPECT_EQ(FileText(m_dir.NarrowPath("a.txt")), "in a\n");
  EXPECT_EQ(FileText(m_dir.NarrowPath("b.txt")), "in b\n");
  gDebugPrint.RecallSettings();  // on again: b.txt reopened and emptied
  EXPECT_EQ(FileText(m_dir.NarrowPath("b.txt")), "");

  m_profile.WriteProfileInt(L"Debug", L"Debug Print File", 0);
  gDebugPrint.RecallSettings();
  EXPECT_FALSE(gDebugPrint.IsDeviceOn(CDebugPrint::File));
}

TEST_F(DebugPrintSettingsTest, RecallRetriesAFileThatCouldNotBeOpenedBefore) {
  gDebugPrint.SetOn(5, true);
  gDebugPrint.SetFilePath(m_dir.Path("later/").c_str());
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);  // the directory is missing: no file
  std::filesystem::create_directory(m_dir.NarrowPath("later"));
  m_profile.WriteProfileInt(L"Debug", L"Debug Print File", 1);
  gDebugPrint.RecallSettings();
  dprint(5, L"found\n");
  EXPECT_EQ(FileText(m_dir.NarrowPath("later/dprint.txt")), "found\n");
}

TEST_F(DebugPrintSettingsTest, ThreadsPrintingToTheFileWriteWholeMessages) {
  gDebugPrint.SetOn(5, true);
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  constexpr int kThreads = 4, kMessages = 300;
  std::vector<std::thread> printers;
  for (int t = 0; t < kThreads; ++t) {
    printers.emplace_back([t] {
      for (int i = 0; i < kMessages; ++i) dprint(5, L"thread %d message %d µ\n", t, i);
    });
  }
  std::thread switcher([] {  // flags change while others print
    for (int i = 0; i < 1000; ++i) gDebugPrint.SetOn(6, i % 2 == 0);
  });
  for (std::thread& printer : printers) printer.join();
  switcher.join();
  std::istringstream lines(FileText(m_dir.NarrowPath("dprint.txt")));
  std::vector<int> next(kThreads, 0);
  std::string line;
  int count = 0;
  while (std::getline(lines, line)) {
    int t = -1, i = -1;
    ASSERT_EQ(std::sscanf(line.c_str(), "thread %d message %d", &t, &i), 2) << line;
    ASSERT_TRUE(t >= 0 && t < kThreads) << line;
    EXPECT_EQ(i, next[t]++) << line;  // each thread's messages in its order
    EXPECT_EQ(line.substr(line.size() - 3), " \xC2\xB5");
    ++count;
  }
  EXPECT_EQ(count, kThreads * kMessages);
}

}  // namespace
