#include "lumen/diagnostics/debug_print.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "lumen/platform/debug_output.h"
#include "lumen/platform/text_conversion.h"
#include "platform/temp_dir.h"

namespace {

using LumenUtility::testutil::TempDir;
using LumenUtility::testutil::FileText;

// Collects what the debugger and console devices are given, in order.
struct DeviceLog : LumenUtility::IDebugOutputSink, ConsoleDPrint {
  void Output(const wchar_t* text) override { entries.push_back(L"debugger:" + std::wstring(text)); }
  void Print(const wchar_t* text) override { entries.push_back(L"console:" + std::wstring(text)); }
  std::vector<std::wstring> Take() { return std::exchange(entries, {}); }
  std::vector<std::wstring> entries;
};

// Returns gDebugPrint to its start-up state around each test, with the debugger output
// captured instead of going to standard error.
class DebugPrintTest : public testing::Test {
 protected:
  void SetUp() override {
    Reset();
    LumenUtility::SetDebugOutputSink(&m_log);
  }
  void TearDown() override {
    Reset();
    LumenUtility::SetDebugOutputSink(nullptr);
  }
  static void Reset() {
    gDebugPrint.SetDeviceOn(CDebugPrint::File, false);
    gDebugPrint.SetFilePath(L"");
    gDebugPrint.SetFileName(L"");
    gDebugPrint.SetDeviceOn(CDebugPrint::Debugger, true);
    gDebugPrint.SetDeviceOn(CDebugPrint::Console, false);
    gDebugPrint.SetConsolePrintDevice(nullptr);
    for (int slot = 0; slot < gDebugPrint.GetNumSlots(); ++slot) gDebugPrint.SetOn(slot, false);
    gDebugPrint.Lockout(true);
  }
  // Unlocked, slot 5 on, the console device set and on.
  void Ready() {
    gDebugPrint.Lockout(false);
    gDebugPrint.SetOn(5, true);
    gDebugPrint.SetConsolePrintDevice(&m_log);
    gDebugPrint.SetDeviceOn(CDebugPrint::Console, true);
  }
  // Points the file device at `name` in the temporary directory.
  void UseFile(const std::string& name) {
    gDebugPrint.SetFilePath((m_dir.Path("") + L"/").c_str());
    gDebugPrint.SetFileName(LumenUtility::Utf8ToWide(name).c_str());
  }

  DeviceLog m_log;
  TempDir m_dir;
};

TEST(CDebugPrint, StartsLockedWithEverySlotOffAndOnlyTheDebuggerOn) {
  const CDebugPrint fresh;
  EXPECT_TRUE(fresh.IsLocked());
  EXPECT_EQ(fresh.GetNumSlots(), 256);
  for (int slot = -1; slot <= 256; ++slot) EXPECT_FALSE(fresh.IsOn(slot)) << slot;
  EXPECT_FALSE(fresh.IsDeviceOn(CDebugPrint::Console));
  EXPECT_TRUE(fresh.IsDeviceOn(CDebugPrint::Debugger));
  EXPECT_FALSE(fresh.IsDeviceOn(CDebugPrint::File));
  EXPECT_FALSE(fresh.IsDeviceOn(static_cast<CDebugPrint::OutputDevice>(3)));
  EXPECT_EQ(fresh.GetFileName(), L"");
}

TEST_F(DebugPrintTest, PrintsOnlyWhenUnlockedAndTheSlotIsOn) {
  Ready();
  gDebugPrint.Lockout(true);
  dprint(5, L"locked");
  EXPECT_TRUE(m_log.Take().empty());
  gDebugPrint.Lockout(false);
  dprint(5, L"open %d", 1);
  dprint(6, L"slot off");
  EXPECT_EQ(m_log.Take(), (std::vector<std::wstring>{L"debugger:open 1", L"console:open 1"}));
  for (const int outside : {-1, 256, 1000}) {
    gDebugPrint.SetOn(outside, true);
    EXPECT_FALSE(gDebugPrint.IsOn(outside));
    dprint(outside, L"outside");
  }
  EXPECT_TRUE(m_log.Take().empty());
}

TEST_F(DebugPrintTest, DevicesGetTheTextInOrderDebuggerFileConsole) {
  Ready();
  UseFile("order.txt");
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  // Each device records what the file holds when it is given the message.
  struct Observer : LumenUtility::IDebugOutputSink, ConsoleDPrint {
    void Output(const wchar_t*) override { seen.push_back("debugger:" + FileText(path)); }
    void Print(const wchar_t*) override { seen.push_back("console:" + FileText(path)); }
    std::string path;
    std::vector<std::string> seen;
  } observer;
  observer.path = m_dir.NarrowPath("order.txt");
  LumenUtility::SetDebugOutputSink(&observer);
  gDebugPrint.SetConsolePrintDevice(&observer);
  dprint(5, L"one");
  EXPECT_EQ(observer.seen, (std::vector<std::string>{"debugger:", "console:one"}));

  LumenUtility::SetDebugOutputSink(&m_log);
  gDebugPrint.SetConsolePrintDevice(&m_log);
  gDebugPrint.SetDeviceOn(CDebugPrint::Debugger, false);
  dprint(5, L"two");
  gDebugPrint.SetDeviceOn(CDebugPrint::Console, false);
  dprint(5, L"three");
  gDebugPrint.SetDeviceOn(CDebugPrint::Console, true);
  gDebugPrint.SetConsolePrintDevice(nullptr);  // on, but no device set
  dprint(5, L"four");
  EXPECT_EQ(m_log.Take(), std::vector<std::wstring>{L"console:two"});
  EXPECT_EQ(FileText(observer.path), "onetwothreefour");
}

TEST_F(DebugPrintTest, MessagesOfAnyLengthArePrintedWhole) {
  Ready();
  gDebugPrint.SetDeviceOn(CDebugPrint::Debugger, false);
  for (const std::size_t length : {0u, 1u, 510u, 511u, 512u, 600u, 20000u}) {
    std::wstring text(length, L'x');
    for (std::size_t i = 0; i < length; i += 7) text[i] = static_cast<wchar_t>(L'a' + i % 26);
    dprint(5, L"%ls", text.c_str());
    dprint(5, text.c_str());  // as the format itself
    EXPECT_EQ(m_log.Take(), (std::vector<std::wstring>{L"console:" + text, L"console:" + text}))
        << length;
  }
}

TEST_F(DebugPrintTest, TagStartsWithTheSourceFileAndLine) {
  Ready();
  gDebugPrint.SetDeviceOn(CDebugPrint::Debugger, false);
  CDebugPrintX("phase/reference.cpp", 42)(5, L"%d points", 201);
  CDebugPrintX("phase/reference.cpp", 42)(DebugPrintPhaseReference, L"by id");
  CDebugPrintX()(5, L"untagged %d", 3);
  // Percent signs of the file name print as they are; those of the format keep their meaning.
  CDebugPrintX("100%s_%d%n.cpp", -7)(5, L"%d%%", 50);
  CDebugPrintX("grüße.cpp", 1)(5, L"x");
  CDebugPrintX("off.cpp", 1)(6, L"slot off");
  EXPECT_EQ(m_log.Take(), (std::vector<std::wstring>{
                              L"console:phase/reference.cpp (42) 201 points",
                              L"console:phase/reference.cpp (42) by id",
                              L"console:untagged 3",
                              L"console:100%s_%d%n.cpp (-7) 50%",
                              L"console:grüße.cpp (1) x",
                          }));
}

TEST_F(DebugPrintTest, EightBitArgumentsAreUtf8AndAFormatThatFailsPrintsAsItIs) {
  Ready();
  gDebugPrint.SetDeviceOn(CDebugPrint::Debugger, false);
  dprint(5, L"%s|%ls|%c|%lc|%5.1f", "µ€", L"µ€", 'x', L'€', 2.25);
  dprint(5, L"bad %s", "\xFF\xFE");
  EXPECT_EQ(m_log.Take(), (std::vector<std::wstring>{L"console:µ€|µ€|x|€|  2.2",
                                                     L"console:bad %s"}));
}

TEST_F(DebugPrintTest, FileGoesIntoTheDirectoryOfTheGivenPathAsDprintTxt) {
  Ready();
  std::filesystem::create_directory(m_dir.NarrowPath("logs"));
  gDebugPrint.SetFilePath(m_dir.Path("logs/run.log").c_str());
  EXPECT_EQ(gDebugPrint.GetFileName(), L"dprint.txt");
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  dprint(5, L"µ€ first\n");
  const std::string first = m_dir.NarrowPath("logs/dprint.txt");
  EXPECT_EQ(FileText(first), "\xC2\xB5\xE2\x82\xAC first\n");  // whole UTF-8, not cut
  EXPECT_FALSE(std::filesystem::exists(m_dir.NarrowPath("logs/run.log")));

  gDebugPrint.SetFileName(L"second.txt");  // on: the old file closes, the new one opens
  dprint(5, L"to second\n");
  EXPECT_EQ(FileText(m_dir.NarrowPath("logs/second.txt")), "to second\n");
  EXPECT_EQ(FileText(first), "\xC2\xB5\xE2\x82\xAC first\n");

  gDebugPrint.SetFilePath(m_dir.Path("other.log").c_str());  // reopened one level up
  EXPECT_EQ(gDebugPrint.GetFileName(), L"second.txt");
  dprint(5, L"moved\n");
  EXPECT_EQ(FileText(m_dir.NarrowPath("second.txt")), "moved\n");

  // A path without '/' leaves no directory: the file is found from the working directory.
  const std::filesystem::path workingDirectory = std::filesystem::current_path();
  std::filesystem::current_path(m_dir.NarrowPath("logs"));
  gDebugPrint.SetFilePath(L"run.log");
  dprint(5, L"relative\n");
  std::filesystem::current_path(workingDirectory);
  EXPECT_EQ(FileText(m_dir.NarrowPath("logs/second.txt")), "relative\n");  // emptied first
}

TEST_F(DebugPrintTest, FileThatCannotBeOpenedKeepsTheDeviceFlagAndWritesNothing) {
  Ready();
  gDebugPrint.SetFilePath(m_dir.Path("missing/x.log").c_str());
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  EXPECT_TRUE(gDebugPrint.IsDeviceOn(CDebugPrint::File));
  dprint(5, L"lost\n");
  EXPECT_EQ(m_log.Take().size(), 2u);  // the other devices still print
  std::filesystem::create_directory(m_dir.NarrowPath("missing"));
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);  // already on: no new attempt
  dprint(5, L"still lost\n");
  gDebugPrint.SetFilePath(m_dir.Path("missing/x.log").c_str());  // reopens
  dprint(5, L"kept\n");
  EXPECT_EQ(FileText(m_dir.NarrowPath("missing/dprint.txt")), "kept\n");
}

TEST_F(DebugPrintTest, FileWriteFailureReachesThePrinter) {
  if (!std::filesystem::exists("/dev/full")) GTEST_SKIP() << "no /dev/full here";
  Ready();
  gDebugPrint.SetFilePath(L"/dev/");
  gDebugPrint.SetFileName(L"full");
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  try {
    dprint(5, L"no room");
    FAIL() << "the write to a full device succeeded";
  } catch (const CFileException& error) {
    EXPECT_EQ(error.m_cause, CFileException::diskFull);
  }
  EXPECT_TRUE(gDebugPrint.IsDeviceOn(CDebugPrint::File));
}

TEST_F(DebugPrintTest, SwitchingTheFileOnEmptiesIt) {
  Ready();
  std::ofstream(m_dir.NarrowPath("dprint.txt")) << "from an earlier run\n";
  UseFile("dprint.txt");
  gDebugPrint.SetDeviceOn(CDebugPrint::File, true);
  dprint(5, L"new\n");
  gDebugPrint.SetDeviceOn(CDebugPrint::File, false);
  dprint(5, L"not in the file\n");
  EXPECT_EQ(FileText(m_dir.NarrowPath("dprint.txt")), "new\n");
}

}  // namespace
