#include "lumen/util/zip7_util.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <sstream>

#include "lumen/platform/text_conversion.h"
#include "platform/temp_dir.h"
#include "platform/test_files.h"
#include "util/zip7_listing.h"

namespace {

namespace fs = std::filesystem;
using LumenUtility::testutil::ReadFileBytes;
using LumenUtility::testutil::TempDir;
namespace Zip7Util = LumenUtility::Zip7Util;
using Names = std::vector<std::wstring>;

// The lines a 7za listing of an archive with a file, a directory and a name with spaces has.
const char kListing[] =
    "\n7-Zip (a) 26.02 : Copyright (c) 1999-2026 Igor Pavlov\n\nListing archive: x.zip\n\n--\n"
    "Path = x.zip\nType = zip\n\n"
    "   Date      Time    Attr         Size   Compressed  Name\n"
    "------------------- ----- ------------ ------------  ------------------------\n"
    "2024-05-01 10:00:00 .....            6            6  a.txt\n"
    "2024-05-01 10:00:00 D....            0            0  sub\n"
    "2024-05-01 10:00:00 .....            4            4  sub/two  spaces.txt  \n"
    "------------------- ----- ------------ ------------  ------------------------\n"
    "2024-05-01 10:00:00                 10           10  2 files, 1 folders\n";

// Points the archiver directory at a stand-in "7za" for one test: a script that logs its
// working directory and arguments (one per line, each call ended by "--") and, for a listing,
// prints kListing; it exits with the status in the file `status` (0 when absent).
class FakeArchiverTest : public ::testing::Test {
 protected:
  void SetUp() override {
    m_previous = Zip7Util::GetArchiverDirectory();
    const std::string log = dir.NarrowPath("log");
    std::ofstream(dir.NarrowPath("listing")) << kListing;
    std::ofstream script(dir.NarrowPath("7za"));
    script << "#!/bin/sh\n"
           << "{ pwd -P; for a in \"$@\"; do echo \"$a\"; done; echo --; } >> '" << log << "'\n"
           << "[ \"$1\" = l ] && cat '" << dir.NarrowPath("listing") << "'\n"
           << "echo noise >&2\n"
           << "[ -f '" << dir.NarrowPath("status") << "' ] && exit $(cat '"
           << dir.NarrowPath("status") << "')\n"
           << "exit 0\n";
    script.close();
    chmod(dir.NarrowPath("7za").c_str(), 0755);
    Zip7Util::SetArchiverDirectory(dir.Path(""));
  }
  void TearDown() override { Zip7Util::SetArchiverDirectory(m_previous); }
  std::string Log() const { return ReadFileBytes(dir.NarrowPath("log")); }
  std::string Cwd() const { return fs::current_path().string(); }

  TempDir dir;

 private:
  std::wstring m_previous;
};

TEST_F(FakeArchiverTest, CommandLinesReachTheArchiverAsArguments) {
  EXPECT_TRUE(Zip7Util::DoZip(L"my file.txt", L"out dir/a.zip"));
  EXPECT_EQ(Log(), Cwd() + "\na\n-tzip\n-mx=1\nout dir/a.zip\nmy file.txt\n--\n");
  fs::remove(dir.NarrowPath("log"));
  EXPECT_TRUE(Zip7Util::DoZip(dir.Path(""), {L"a.txt", L"sub/b c.txt"}, L"/tmp/x.zip"));
  const std::string work = fs::canonical(dir.NarrowPath("")).string();
  EXPECT_EQ(Log(), work + "\na\n-tzip\n-mx=1\n/tmp/x.zip\na.txt\nsub/b c.txt\n--\n");
}

TEST_F(FakeArchiverTest, UnzipWithoutListRunsOnlyTheExtraction) {
  Names names{L"stale"};
  EXPECT_TRUE(Zip7Util::DoUnzip(L"in.zip", L"/dest dir", nullptr));
  EXPECT_EQ(Log(), Cwd() + "\nx\nin.zip\n-o/dest dir\n--\n");
  fs::remove(dir.NarrowPath("log"));
  EXPECT_TRUE(Zip7Util::DoUnzip(L"in.zip", L"/dest", &names));
  EXPECT_EQ(Log(), Cwd() + "\nx\nin.zip\n-o/dest\n--\n" + Cwd() + "\nl\nin.zip\n--\n");
  EXPECT_EQ(names, (Names{L"a.txt", L"sub", L"sub/two  spaces.txt"}));
}

TEST_F(FakeArchiverTest, FailingArchiverOrUnquotablePathsGiveFalse) {
  std::ofstream(dir.NarrowPath("status")) << "2";
  EXPECT_FALSE(Zip7Util::DoZip(L"a.txt", L"a.zip"));
  Names names{L"stale"};
  EXPECT_FALSE(Zip7Util::DoUnzip(L"a.zip", L"d", &names));
  EXPECT_TRUE(names.empty());
  fs::remove(dir.NarrowPath("status"));
  fs::remove(dir.NarrowPath("log"));
  EXPECT_FALSE(Zip7Util::DoZip(L"say \"hi\".txt", L"a.zip"));
  EXPECT_FALSE(Zip7Util::DoZip(L"a.txt", L"trailing\\"));
  EXPECT_FALSE(Zip7Util::DoZip(L"-sdel", L"a.zip"));
  EXPECT_FALSE(Zip7Util::DoZip(dir.Path(""), {L"ok.txt", L"@list"}, L"a.zip"));
  EXPECT_FALSE(Zip7Util::DoUnzip(L"a.zip", L"dir\"", nullptr));
  EXPECT_FALSE(fs::exists(dir.NarrowPath("log")));             // nothing ran
  EXPECT_TRUE(Zip7Util::DoUnzip(L"a.zip", L"-dir", nullptr));  // "-o-dir" is no switch of its own
  Zip7Util::SetArchiverDirectory(dir.Path("missing/"));
  EXPECT_FALSE(Zip7Util::DoZip(L"a.txt", L"a.zip"));
}

TEST(Zip7Util, DefaultArchiverDirectoryIsTheSystemsPrograms) {
  EXPECT_EQ(Zip7Util::GetArchiverDirectory(), L"/usr/bin/");
}

TEST(Zip7Util, RealArchiverPacksAndUnpacks) {
  if (access("/usr/bin/7za", X_OK) != 0) GTEST_SKIP() << "7za is not installed";
  TempDir dir;
  fs::create_directories(dir.NarrowPath("in/sub"));
  std::ofstream(dir.NarrowPath("in/a.txt")) << "alpha";
  std::ofstream(dir.NarrowPath("in/sub/b c.txt")) << "beta";
  EXPECT_TRUE(Zip7Util::DoZip(dir.Path("in"), {L"a.txt", L"sub/b c.txt"}, dir.Path("x.zip")));
  Names names;
  EXPECT_TRUE(Zip7Util::DoUnzip(dir.Path("x.zip"), dir.Path("out"), &names));
  EXPECT_EQ(names, (Names{L"a.txt", L"sub/b c.txt"}));
  EXPECT_EQ(ReadFileBytes(dir.NarrowPath("out/sub/b c.txt")), "beta");
  // Extracting again would have to replace files; the archiver asks, reads no answer, fails.
  EXPECT_FALSE(Zip7Util::DoUnzip(dir.Path("x.zip"), dir.Path("out"), nullptr));
  EXPECT_FALSE(Zip7Util::DoZip(dir.Path("in/missing.txt"), dir.Path("y.zip")));
}

TEST(AppendListedNames, TakesTheNameColumnOfTheTableOnly) {
  std::vector<std::wstring> lines;
  std::wistringstream text(LumenUtility::Utf8ToWide(kListing));
  for (std::wstring line; std::getline(text, line);) lines.push_back(line);
  lines.insert(lines.begin() + 14, L"2024-05-01 10:00:00 .....  short");  // five pieces: skipped
  Names names{L"kept"};
  LumenUtility::AppendListedNames(lines, names);
  EXPECT_EQ(names, (Names{L"kept", L"a.txt", L"sub", L"sub/two  spaces.txt"}));
  names.clear();
  LumenUtility::AppendListedNames({L"no table here"}, names);
  EXPECT_TRUE(names.empty());
}

}  // namespace
