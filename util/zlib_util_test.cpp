#include "lumen/util/zlib_util.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <random>
#include <sstream>

#include "platform/process.h"
#include "platform/temp_dir.h"
#include "platform/test_files.h"
#include "util/zip_format.h"
#include "util/zip_test_archive.h"
#include "util/zip_writer.h"

namespace {

namespace fs = std::filesystem;
namespace zip = LumenUtility::zip;
using LumenUtility::RunProcess;
using LumenUtility::ZipWriter;
using LumenUtility::testutil::ReadFileBytes;
using LumenUtility::testutil::TempDir;
using LumenUtility::ZlibUtil::DoUnzip;
using LumenUtility::ZlibUtil::DoZip;
using Names = std::vector<std::wstring>;

bool HaveProgram(const char* name) {
  return access((std::string("/usr/bin/") + name).c_str(), X_OK) == 0;
}

// Runs a program of the system; true when it exited with 0.
bool RunTool(const std::wstring& program, const std::vector<std::wstring>& arguments,
             const std::wstring& workDir = L"") {
  return RunProcess(program, arguments, workDir) == 0;
}

// One local header of an archive, as a reader of the raw bytes sees it.
struct LocalEntry {
  std::string name;
  std::uint16_t flags, method;
  std::uint32_t crc, compressedSize, size;
  std::string extra, data;
};

std::vector<LocalEntry> LocalEntries(const std::string& bytes) {
  std::vector<LocalEntry> entries;
  const auto* p = reinterpret_cast<const unsigned char*>(bytes.data());
  for (std::size_t at = 0; at + 30 <= bytes.size() && zip::Get32(p + at) == 0x04034B50;) {
    LocalEntry e;
    e.flags = zip::Get16(p + at + 6);
    e.method = zip::Get16(p + at + 8);
    e.crc = zip::Get32(p + at + 14);
    e.compressedSize = zip::Get32(p + at + 18);
    e.size = zip::Get32(p + at + 22);
    const std::size_t n = zip::Get16(p + at + 26), m = zip::Get16(p + at + 28);
    e.name = bytes.substr(at + 30, n);
    e.extra = bytes.substr(at + 30 + n, m);
    e.data = bytes.substr(at + 30 + n + m, e.compressedSize);
    at += 30 + n + m + e.compressedSize;
    entries.push_back(e);
  }
  return entries;
}

std::vector<std::string> EntryNames(const std::string& bytes) {
  std::vector<std::string> names;
  for (const LocalEntry& e : LocalEntries(bytes)) names.push_back(e.name);
  return names;
}

std::string RandomBytes(std::size_t count, unsigned seed) {
  std::mt19937 random(seed);
  std::string bytes(count, '\0');
  for (char& c : bytes) c = static_cast<char>(random());
  return bytes;
}

// Sets the time zone for one test and restores the one before.
class TimeZone {
 public:
  explicit TimeZone(const char* rules) {
    if (const char* old = getenv("TZ")) m_old = old;
    setenv("TZ", rules, 1);
    tzset();
  }
  ~TimeZone() {
    if (m_old.empty())
      unsetenv("TZ");
    else
      setenv("TZ", m_old.c_str(), 1);
    tzset();
  }

 private:
  std::string m_old;
};

constexpr const char* kCentralEurope = "CET-1CEST,M3.5.0,M10.5.0/3";

class ZipTest : public ::testing::Test {
 protected:
  void Write(const std::string& name, const std::string& bytes) {
    fs::create_directories(fs::path(dir.NarrowPath("in/" + name)).parent_path());
    std::ofstream(dir.NarrowPath("in/" + name), std::ios::binary) << bytes;
  }
  bool Zip(const Names& files, const std::string& base = "in") {
    return DoZip(dir.Path(base), files, dir.Path("out.zip"));
  }
  std::string Archive() const { return ReadFileBytes(dir.NarrowPath("out.zip")); }
  // Whether the extracted tree `out` holds exactly the bytes of the inputs `names`.
  void ExpectExtracted(const std::string& out, const std::vector<std::string>& names) {
    for (const std::string& name : names)
      EXPECT_EQ(ReadFileBytes(dir.NarrowPath(out + "/" + name)),
                ReadFileBytes(dir.NarrowPath("in/" + name)))
          << out << "/" << name;
  }

  TempDir dir;
};

TEST_F(ZipTest, EntriesAreNamedRelativeToTheBaseWithSlashes) {
  Write("a.txt", "alpha");
  Write("sub/b.bin", RandomBytes(100, 1));
  Write("c.txt", "gamma");
  ASSERT_TRUE(Zip({L"a.txt", L"sub/b.bin", L"./sub/../c.txt"}, "in/"));
  EXPECT_EQ(EntryNames(Archive()), (std::vector<std::string>{"a.txt", "sub/b.bin", "c.txt"}));
  ASSERT_TRUE(Zip({L"a.txt"}, "in/sub/.."));
  EXPECT_EQ(EntryNames(Archive()), (std::vector<std::string>{"a.txt"}));
  ASSERT_TRUE(DoZip(dir.Path("in/sub/b.bin"), dir.Path("out.zip")));
  EXPECT_EQ(EntryNames(Archive()), (std::vector<std::string>{"b.bin"}));
  for (const LocalEntry& e : LocalEntries(Archive())) {
    EXPECT_EQ(e.flags, 0);
    EXPECT_EQ(e.method, zip::kMethodDeflated);
    EXPECT_EQ(e.extra.substr(0, 4), std::string("\x00\x01\x04\x00", 4));
    EXPECT_EQ(e.extra.size(), 8u);
  }
}

TEST_F(ZipTest, InputsThatCannotBePackedAreLeftOutAndTheRestIsPacked) {
  Write("good.txt", "good");
  Write("dir/inner", "x");
  const std::wstring absolute = dir.Path("in/good.txt");
  EXPECT_FALSE(Zip({L"good.txt", absolute, L"", L"../in/good.txt", L"dir/../../x", L"missing",
                    L"dir", L"dir/inner"}));
  EXPECT_EQ(EntryNames(Archive()), (std::vector<std::string>{"good.txt", "dir/inner"}));
  // The archive itself among the inputs, and a FIFO that would block a reader.
  ASSERT_EQ(mkfifo(dir.NarrowPath("in/fifo").c_str(), 0600), 0);
  EXPECT_FALSE(DoZip(dir.Path(""), {L"out.zip", L"in/fifo", L"in/good.txt"}, dir.Path("out.zip")));
  EXPECT_EQ(EntryNames(Archive()), (std::vector<std::string>{"in/good.txt"}));
  EXPECT_FALSE(DoZip(dir.Path(""), {L"in/good.txt"}, dir.Path("no/such/dir/out.zip")));
  Names extracted;
  EXPECT_TRUE(DoUnzip(dir.Path("out.zip"), dir.Path("x"), &extracted));
  EXPECT_EQ(extracted, (Names{L"in/good.txt"}));
}

TEST_F(ZipTest, NamesBeyondAsciiAreFlaggedAsUtf8) {
  Write("plain.txt", "p");
  Write("na\u00efve \u00b5F.txt", "n");
  ASSERT_TRUE(Zip({L"plain.txt", L"na\u00efve \u00b5F.txt"}));
  const std::vector<LocalEntry> entries = LocalEntries(Archive());
  ASSERT_EQ(entries.size(), 2u);
  EXPECT_EQ(entries[0].flags, 0);
  EXPECT_EQ(entries[1].flags, zip::kFlagUtf8Name);
  Names extracted;
  ASSERT_TRUE(DoUnzip(dir.Path("out.zip"), dir.Path("x"), &extracted));
  EXPECT_EQ(extracted, (Names{L"plain.txt", L"na\u00efve \u00b5F.txt"}));
  if (HaveProgram("python3")) {
    EXPECT_TRUE(RunTool(L"/usr/bin/python3",
                        {L"-c",
                         L"import sys, zipfile\n"
                         L"names = zipfile.ZipFile(sys.argv[1]).namelist()\n"
                         L"assert names == ['plain.txt', 'na\\u00efve \\u00b5F.txt'], names\n",
                         dir.Path("out.zip")}));
  }
}

TEST_F(ZipTest, EmptyFileIsAnEndBlockWithCrcZero) {
  Write("empty", "");
  ASSERT_TRUE(Zip({L"empty"}));
  const std::vector<LocalEntry> entries = LocalEntries(Archive());
  ASSERT_EQ(entries.size(), 1u);
  EXPECT_EQ(entries[0].crc, 0u);
  EXPECT_EQ(entries[0].size, 0u);
  EXPECT_EQ(entries[0].data, std::string("\x03\x00", 2));
}

TEST_F(ZipTest, CrcAndSizesArePatchedAfterTheData) {
  const std::string big = RandomBytes(200000, 2) + std::string(300000, 'z');  // several pieces
  Write("big", big);
  ASSERT_TRUE(Zip({L"big"}));
  const std::vector<LocalEntry> entries = LocalEntries(Archive());
  ASSERT_EQ(entries.size(), 1u);
  EXPECT_EQ(entries[0].crc, LumenUtility::testutil::Crc32(big));
  EXPECT_EQ(entries[0].size, big.size());
  EXPECT_LT(entries[0].compressedSize, big.size());
  ASSERT_TRUE(DoUnzip(dir.Path("out.zip"), dir.Path("x"), nullptr));
  EXPECT_EQ(ReadFileBytes(dir.NarrowPath("x/big")), big);
}

TEST_F(ZipTest, FileOf4GiBIsLeftOut) {
  Write("small", "s");
  Write("huge", "");
  ASSERT_EQ(truncate(dir.NarrowPath("in/huge").c_str(), off_t{1} << 32), 0);  // sparse
  EXPECT_FALSE(Zip({L"small", L"huge"}));
  EXPECT_EQ(EntryNames(Archive()), (std::vector<std::string>{"small"}));
}

TEST_F(ZipTest, EntryPastTheLimitsIsWoundBackAndTheArchiveStaysValid) {
  Write("one", "first file");
  Write("noise", RandomBytes(20000, 3));
  Write("two", "second file");
  ZipWriter writer(ZipWriter::Limits{.maxSize = 10000, .maxEntries = 2});
  ASSERT_TRUE(writer.Open(dir.Path("out.zip")));
  EXPECT_TRUE(writer.Add(dir.NarrowPath("in/one"), "one"));
  EXPECT_FALSE(writer.Add(dir.NarrowPath("in/noise"), "noise"));  // compressed, still too big
  EXPECT_TRUE(writer.Add(dir.NarrowPath("in/two"), "two"));
  EXPECT_FALSE(writer.Add(dir.NarrowPath("in/one"), "three"));  // a third entry
  ASSERT_TRUE(writer.Finish());
  EXPECT_LT(fs::file_size(dir.NarrowPath("out.zip")), 1000u);  // the noise was cut off
  Names extracted;
  EXPECT_TRUE(DoUnzip(dir.Path("out.zip"), dir.Path("x"), &extracted));
  EXPECT_EQ(extracted, (Names{L"one", L"two"}));
  if (HaveProgram("unzip")) {
    EXPECT_TRUE(RunTool(L"/usr/bin/unzip", {L"-tq", dir.Path("out.zip")}));
  }
}

TEST_F(ZipTest, ModificationTimesRoundTripInLocalTimeWithTheDaylightFlag) {
  const TimeZone zone(kCentralEurope);
  // Summer, winter, and both 02:30s of the autumn night the clocks go back (31 Oct 2021).
  const std::time_t times[] = {1625140800, 1610000000, 1635640200, 1635643800};
  for (const std::time_t t : times) {
    Write("f", "time");
    const timespec stamp[2] = {{t, 0}, {t, 0}};
    ASSERT_EQ(utimensat(AT_FDCWD, dir.NarrowPath("in/f").c_str(), stamp, 0), 0);
    ASSERT_TRUE(Zip({L"f"}));
    const std::vector<LocalEntry> entries = LocalEntries(Archive());
    ASSERT_EQ(entries.size(), 1u);
    std::tm local;
    localtime_r(&t, &local);
    EXPECT_EQ(entries[0].extra[4], local.tm_isdst > 0 ? 1 : 0) << t;
    ASSERT_TRUE(DoUnzip(dir.Path("out.zip"), dir.Path("x"), nullptr));
    struct stat info;
    ASSERT_EQ(stat(dir.NarrowPath("x/f").c_str(), &info), 0);
    EXPECT_EQ(info.st_mtime, t) << t;
  }
  // 2021-07-01 14:00:00 local, with the flag: 12:00 UTC. Written by a tool without the flag,
  // the time zone's rules decide, and they give the same moment.
  for (const std::string& extra :
       {std::string("\x00\x01\x04\x00\x01\x00\x00\x00", 8), std::string()}) {
    LumenUtility::testutil::TestArchive archive;
    archive.Add(LumenUtility::testutil::TestEntry("g", "g")
                    .Time(14 << 11, (41 << 9) | (7 << 5) | 1)
                    .Extra(extra));
    archive.WriteTo(dir.NarrowPath("t.zip"));
    ASSERT_TRUE(DoUnzip(dir.Path("t.zip"), dir.Path("x"), nullptr));
    EXPECT_EQ(fs::last_write_time(dir.NarrowPath("x/g")),
              fs::file_time_type::clock::from_sys(
                  std::chrono::sys_seconds{std::chrono::seconds{1625140800}}));
  }
}

TEST_F(ZipTest, ArchivesOfDoZipAreExtractedByteForByteBy7zaPythonAndUnzip) {
  const std::vector<std::string> names = {"text.txt", "random.bin", "empty", "sub dir/nested.txt"};
  std::string text;
  for (int i = 0; i < 20000; ++i) text += "line " + std::to_string(i) + "\n";
  Write(names[0], text);
  Write(names[1], RandomBytes(150000, 4));
  Write(names[2], "");
  Write(names[3], "nested");
  ASSERT_TRUE(Zip({L"text.txt", L"random.bin", L"empty", L"sub dir/nested.txt"}));
  const std::wstring archive = dir.Path("out.zip");
  if (HaveProgram("7za")) {
    EXPECT_TRUE(RunTool(L"/usr/bin/7za", {L"t", archive}));
    EXPECT_TRUE(RunTool(L"/usr/bin/7za", {L"x", archive, L"-o" + dir.Path("by7za")}));
    ExpectExtracted("by7za", names);
  }
  if (HaveProgram("unzip")) {
    EXPECT_TRUE(RunTool(L"/usr/bin/unzip", {L"-q", archive, L"-d", dir.Path("byunzip")}));
    ExpectExtracted("byunzip", names);
  }
  if (HaveProgram("python3")) {
    EXPECT_TRUE(RunTool(L"/usr/bin/python3", {L"-c",
                                              L"import sys, zipfile\n"
                                              L"z = zipfile.ZipFile(sys.argv[1])\n"
                                              L"assert z.testzip() is None\n"
                                              L"assert z.namelist() == sys.argv[3:], z.namelist()\n"
                                              L"z.extractall(sys.argv[2])\n",
                                              archive, dir.Path("bypython"), L"text.txt",
                                              L"random.bin", L"empty", L"sub dir/nested.txt"}));
    ExpectExtracted("bypython", names);
  }
  if (!HaveProgram("7za") && !HaveProgram("unzip") && !HaveProgram("python3"))
    GTEST_SKIP() << "no other ZIP reader installed";
}

TEST_F(ZipTest, ArchivesOfZipAnd7zaAreExtracted) {
  const std::vector<std::string> names = {"text.txt", "random.bin", "sub/nested.txt"};
  std::string text;
  for (int i = 0; i < 5000; ++i) text += "row," + std::to_string(i * 7) + "\n";
  Write(names[0], text);
  Write(names[1], RandomBytes(70000, 5));
  Write(names[2], "nested");
  const std::wstring in = dir.Path("in");
  std::vector<std::pair<std::string, std::vector<std::wstring>>> commands;
  if (HaveProgram("zip")) {
    commands.push_back({"zip", {L"/usr/bin/zip", L"-qr", L"-0"}});  // stored
    commands.push_back({"zip", {L"/usr/bin/zip", L"-qr", L"-9"}});  // deflated
  }
  if (HaveProgram("7za")) {
    commands.push_back({"7za", {L"/usr/bin/7za", L"a", L"-tzip", L"-mx=0"}});
    commands.push_back({"7za", {L"/usr/bin/7za", L"a", L"-tzip", L"-mx=9"}});
  }
  if (commands.empty()) GTEST_SKIP() << "neither zip nor 7za installed";
  int run = 0;
  for (auto& [name, command] : commands) {
    const std::wstring archive = dir.Path("made" + std::to_string(run) + ".zip");
    const std::wstring program = command.front();
    std::vector<std::wstring> arguments(command.begin() + 1, command.end());
    arguments.push_back(archive);
    arguments.insert(arguments.end(), {L"text.txt", L"random.bin", L"sub"});
    ASSERT_TRUE(RunTool(program, arguments, in)) << name;
    const std::string out = "x" + std::to_string(run++);
    Names extracted;
    EXPECT_TRUE(DoUnzip(archive, dir.Path(out), &extracted)) << name;
    ExpectExtracted(out, names);
    EXPECT_NE(std::find(extracted.begin(), extracted.end(), L"sub/nested.txt"), extracted.end());
  }
  // A streaming zip (output into a pipe) puts sizes and CRC into data descriptors.
  if (HaveProgram("zip")) {
    ASSERT_TRUE(
        RunTool(L"/bin/sh", {L"-c", L"zip -q - text.txt random.bin | cat > ../streamed.zip"}, in));
    const std::string bytes = ReadFileBytes(dir.NarrowPath("streamed.zip"));
    ASSERT_FALSE(LocalEntries(bytes).empty());
    EXPECT_TRUE(LocalEntries(bytes)[0].flags & zip::kFlagDataDescriptor);
    EXPECT_TRUE(DoUnzip(dir.Path("streamed.zip"), dir.Path("streamed"), nullptr));
    ExpectExtracted("streamed", {"text.txt", "random.bin"});
  }
}

}  // namespace
