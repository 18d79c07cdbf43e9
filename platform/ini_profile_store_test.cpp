#include "lumen/platform/ini_profile_store.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <string>

#include "platform/temp_dir.h"

namespace {

using LumenUtility::IniProfileStore;
using LumenUtility::testutil::TempDir;
using LumenUtility::testutil::FileText;

TEST(IniProfileStore, KeepsEntriesInMemoryUntilAPathIsSet) {
  IniProfileStore store;
  EXPECT_EQ(store.GetProfileString(L"Debug", L"Debug Print", L"none"), L"none");
  EXPECT_EQ(store.WriteProfileString(L"Debug", L"Debug Print", L"0101"), 1);
  EXPECT_EQ(store.WriteProfileInt(L"Debug", L"Debug Print File", -7), 1);
  EXPECT_EQ(store.GetProfileString(L"DEBUG", L"debug print", L""), L"0101");
  EXPECT_EQ(store.GetProfileInt(L"Debug", L"Debug Print File", 0), -7);
  TempDir dir;
  store.SetPath(dir.Path("app.ini"));  // a new place starts from what is there: nothing
  EXPECT_EQ(store.GetProfileString(L"Debug", L"Debug Print", L"none"), L"none");
  EXPECT_FALSE(std::filesystem::exists(dir.NarrowPath("app.ini")));
}

TEST(IniProfileStore, WritesTheFileWholeAndReadsWhatOthersWrote) {
  TempDir dir;
  const std::string path = dir.NarrowPath("app.ini");
  std::ofstream(path, std::ios::binary) << "; by hand\r\n[Debug]\r\nDebug Print=11\r\n";
  chmod(path.c_str(), 0640);
  IniProfileStore store;
  store.SetPath(dir.Path("app.ini"));
  EXPECT_EQ(store.GetProfileString(L"Debug", L"Debug Print", L""), L"11");
  ASSERT_EQ(store.WriteProfileString(L"Debug", L"Debug Print Filename", L"µ.txt"), 1);
  EXPECT_EQ(FileText(path),
            "; by hand\n[Debug]\nDebug Print=11\nDebug Print Filename=\xC2\xB5.txt\n");
  struct stat info;
  ASSERT_EQ(stat(path.c_str(), &info), 0);
  EXPECT_EQ(info.st_mode & 0777, 0640u);
  // Another process changes the file: the next read sees it.
  std::ofstream(path, std::ios::binary) << "[Debug]\nDebug Print=00\n";
  EXPECT_EQ(store.GetProfileString(L"Debug", L"Debug Print", L""), L"00");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(dir.NarrowPath("")),
                          std::filesystem::directory_iterator()),
            1);  // no temporary file left behind
}

TEST(IniProfileStore, FileThatCannotBeReadIsNeitherReadNorReplaced) {
  TempDir dir;
  std::filesystem::create_directory(dir.NarrowPath("app.ini"));
  IniProfileStore store;
  store.SetPath(dir.Path("app.ini"));
  EXPECT_EQ(store.GetProfileString(L"Debug", L"Debug Print", L"dflt"), L"dflt");
  EXPECT_EQ(store.WriteProfileString(L"Debug", L"Debug Print", L"1"), 0);
  EXPECT_TRUE(std::filesystem::is_directory(dir.NarrowPath("app.ini")));
  store.SetPath(dir.Path("missing/app.ini"));  // its directory does not exist
  EXPECT_EQ(store.WriteProfileInt(L"Debug", L"Debug Print File", 1), 0);
  EXPECT_EQ(store.WriteProfileString(L"Debug", L"bad\nname", L"1"), 0);
}

TEST(IniProfileStore, IntegersAreTheLeadingDecimalNumberWithinRange) {
  IniProfileStore store;
  const std::pair<const wchar_t*, std::int32_t> cases[] = {
      {L"42", 42},          {L" -17 apples", -17},  {L"+5", 5},
      {L"2147483647", 2147483647}, {L"-2147483648", -2147483647 - 1},
      {L"2147483648", 99},  {L"99999999999999999999", 99}, {L"x1", 99},
      {L"-", 99},           {L"", 99},              {L"0x10", 0}};
  for (const auto& [text, expected] : cases) {
    ASSERT_EQ(store.WriteProfileString(L"S", L"n", text), 1);
    EXPECT_EQ(store.GetProfileInt(L"S", L"n", 99), expected) << text;
  }
  EXPECT_EQ(store.GetProfileInt(L"S", L"absent", 3), 3);
}

TEST(IniProfileStore, AnInstalledStoreReplacesTheDefaultUntilRemoved) {
  IniProfileStore mine;
  LumenUtility::SetProfileStore(&mine);
  EXPECT_EQ(&LumenUtility::ProfileStore(), &mine);
  LumenUtility::SetProfileStore(nullptr);
  EXPECT_EQ(&LumenUtility::ProfileStore(), &LumenUtility::DefaultProfileStore());
}

}  // namespace
