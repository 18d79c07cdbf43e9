#include "util/zip_extractor.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <sstream>

#include "lumen/util/zlib_util.h"
#include "platform/temp_dir.h"
#include "platform/test_files.h"
#include "util/zip_test_archive.h"

namespace {

namespace fs = std::filesystem;
using LumenUtility::testutil::ReadFileBytes;
using LumenUtility::testutil::TempDir;
using LumenUtility::testutil::TestArchive;
using LumenUtility::testutil::TestEntry;
using LumenUtility::ZlibUtil::DoUnzip;
namespace zip = LumenUtility::zip;
using Names = std::vector<std::wstring>;

// A reader-test fixture: each test writes an archive of its own (usually a valid one with a
// small corruption) and extracts it into the directory `out` of a scratch directory.
class UnzipTest : public ::testing::Test {
 protected:
  bool Unzip(const std::string& bytes, Names* names = nullptr) {
    std::ofstream(dir.NarrowPath("in.zip"), std::ios::binary) << bytes;
    return DoUnzip(dir.Path("in.zip"), dir.Path("out"), names);
  }
  bool Unzip(const TestArchive& archive, Names* names = nullptr) {
    return Unzip(archive.Bytes(), names);
  }
  // Every path below the scratch directory except the archive, relative, sorted.
  std::vector<std::string> Tree() const {
    std::vector<std::string> paths;
    const fs::path root = dir.NarrowPath("");
    for (const auto& entry : fs::recursive_directory_iterator(root)) {
      const std::string relative = fs::relative(entry.path(), root).string();
      if (relative != "in.zip") paths.push_back(relative);
    }
    std::sort(paths.begin(), paths.end());
    return paths;
  }
  std::string Out(const std::string& name) const {
    return ReadFileBytes(dir.NarrowPath("out/" + name));
  }
  // `bytes` with the 4 bytes at `at` replaced by `value`.
  static std::string Patch32(std::string bytes, std::size_t at, std::uint32_t value) {
    std::string field;
    zip::Put32(field, value);
    bytes.replace(at, 4, field);
    return bytes;
  }

  TempDir dir;
};

const std::string kText = "line one\nline two\n" + std::string(3000, 'x') + "\nend\n";

TEST_F(UnzipTest, StoredAndDeflatedEntriesAreExtractedAndNamesAppended) {
  TestArchive archive;
  archive.Add(TestEntry("stored.txt", kText).Method(zip::kMethodStored))
      .Add(TestEntry("deflated.txt", kText))
      .Add(TestEntry("sub/", "").Method(zip::kMethodStored))
      .Add(TestEntry("sub\\inner\\win.txt", "backslashes"))
      .Add(TestEntry("./dots/../empty", ""));
  Names names{L"kept"};
  ASSERT_TRUE(Unzip(archive, &names));
  EXPECT_EQ(names, (Names{L"kept", L"stored.txt", L"deflated.txt", L"sub/", L"sub/inner/win.txt",
                          L"empty"}));
  EXPECT_EQ(Out("stored.txt"), kText);
  EXPECT_EQ(Out("deflated.txt"), kText);
  EXPECT_EQ(Out("sub/inner/win.txt"), "backslashes");
  EXPECT_EQ(Out("empty"), "");
  EXPECT_EQ(Tree(),
            (std::vector<std::string>{"out", "out/deflated.txt", "out/empty", "out/stored.txt",
                                      "out/sub", "out/sub/inner", "out/sub/inner/win.txt"}));
}

TEST_F(UnzipTest, NameBytesThatAreNotUtf8AreExtractedAsReplacementCharacters) {
  TestArchive archive;
  archive.Add(TestEntry("bad\x9a.txt", "b"));
  Names names;
  ASSERT_TRUE(Unzip(archive, &names));
  EXPECT_EQ(names, Names{L"bad\uFFFD.txt"});
  EXPECT_EQ(Out("bad\xEF\xBF\xBD.txt"), "b");
}

TEST_F(UnzipTest, NamesThatLeaveTheDestinationWriteNothing) {
  for (const char* name :
       {"../x", "/abs/x", "a/../../x", "..\\x", "C:\\x", "c:x", "sub/../..", "", "/", "."}) {
    TestArchive archive;
    archive.Add(TestEntry(name, "escaped"));
    EXPECT_FALSE(Unzip(archive)) << name;
    EXPECT_TRUE(Tree().empty() || Tree() == std::vector<std::string>{"out"}) << name;
  }
  // Entries before the bad one stay extracted; nothing after it is read.
  TestArchive archive;
  archive.Add(TestEntry("first", "1")).Add(TestEntry("../x", "2")).Add(TestEntry("third", "3"));
  Names names;
  EXPECT_FALSE(Unzip(archive, &names));
  EXPECT_EQ(names, Names{L"first"});
  EXPECT_EQ(Tree(), (std::vector<std::string>{"out", "out/first"}));
}

TEST_F(UnzipTest, LinksInsideTheDestinationAreNotFollowed) {
  fs::create_directories(dir.NarrowPath("out"));
  fs::create_directories(dir.NarrowPath("elsewhere"));
  std::ofstream(dir.NarrowPath("elsewhere/target")) << "outside";
  fs::create_directory_symlink(dir.NarrowPath("elsewhere"), dir.NarrowPath("out/linkdir"));
  fs::create_symlink(dir.NarrowPath("elsewhere/target"), dir.NarrowPath("out/linkfile"));
  TestArchive through;
  through.Add(TestEntry("linkdir/planted", "x"));
  EXPECT_FALSE(Unzip(through));
  // A link in the place of a file is replaced by the file, its target left alone.
  TestArchive over;
  over.Add(TestEntry("linkfile", "inside"));
  EXPECT_TRUE(Unzip(over));
  EXPECT_EQ(ReadFileBytes(dir.NarrowPath("elsewhere/target")), "outside");
  EXPECT_FALSE(fs::is_symlink(dir.NarrowPath("out/linkfile")));
  EXPECT_EQ(Out("linkfile"), "inside");
  EXPECT_EQ(fs::directory_iterator(dir.NarrowPath("elsewhere"))->path().filename(), "target");
}

TEST_F(UnzipTest, CorruptEntriesGiveFalseAndLeaveNoFile) {
  const std::string data = kText;
  struct Case {
    const char* what;
    TestEntry entry;
  } cases[] = {
      {"method 12", TestEntry("f", data).Method(12)},
      {"encrypted", TestEntry("f", data).Flags(zip::kFlagEncrypted)},
      {"wrong CRC", TestEntry("f", data).Crc(0x12345678)},
      {"stored CRC", TestEntry("f", data).Method(zip::kMethodStored).Crc(1)},
      {"size too small", TestEntry("f", data).Size(100)},
      {"size too large", TestEntry("f", data).Size(4000)},
      {"stream cut short", TestEntry("f", data).CompressedSize(10)},
      {"stored past the end", TestEntry("f", "ab").Method(0).CompressedSize(9999)},
  };
  for (const Case& c : cases) {
    fs::remove_all(dir.NarrowPath("out"));
    TestArchive archive;
    archive.Add(c.entry);
    EXPECT_FALSE(Unzip(archive)) << c.what;
    EXPECT_TRUE(Tree().empty() || Tree() == std::vector<std::string>{"out"}) << c.what;
  }
  // Corrupt deflate data: the block type bits of the first byte set to the reserved 11.
  TestArchive good;
  good.Add(TestEntry("f", data));
  std::string bytes = good.Bytes();
  bytes[zip::kLocalHeaderBytes + 1] = static_cast<char>(bytes[zip::kLocalHeaderBytes + 1] | 6);
  EXPECT_FALSE(Unzip(bytes));
  EXPECT_FALSE(fs::exists(dir.NarrowPath("out/f")));
}

TEST_F(UnzipTest, FailedEntryLeavesAnOlderFileOfItsNameAlone) {
  fs::create_directories(dir.NarrowPath("out"));
  std::ofstream(dir.NarrowPath("out/f")) << "old";
  TestArchive archive;
  archive.Add(TestEntry("f", kText).Crc(7));
  EXPECT_FALSE(Unzip(archive));
  EXPECT_EQ(Out("f"), "old");
  EXPECT_EQ(Tree(), (std::vector<std::string>{"out", "out/f"}));
}

TEST_F(UnzipTest, ReadOnlyFileOfTheSameNameIsReplaced) {
  fs::create_directories(dir.NarrowPath("out"));
  std::ofstream(dir.NarrowPath("out/f")) << "old";
  chmod(dir.NarrowPath("out/f").c_str(), 0444);
  TestArchive archive;
  archive.Add(TestEntry("f", "new"));
  EXPECT_TRUE(Unzip(archive));
  EXPECT_EQ(Out("f"), "new");
}

TEST_F(UnzipTest, DataDescriptorsWithAndWithoutSignatureAreRead) {
  for (bool signature : {true, false}) {
    for (std::uint16_t method : {zip::kMethodDeflated, zip::kMethodStored}) {
      fs::remove_all(dir.NarrowPath("out"));
      TestEntry streamed = TestEntry("a", kText).Method(method).Flags(zip::kFlagDataDescriptor);
      if (!signature) streamed.NoDescriptorSignature();
      TestArchive archive;
      archive.Add(streamed).Add(TestEntry("b", "after"));
      Names names;
      EXPECT_TRUE(Unzip(archive, &names)) << signature << method;
      EXPECT_EQ(names, (Names{L"a", L"b"}));
      EXPECT_EQ(Out("a"), kText);
      EXPECT_EQ(Out("b"), "after");
    }
  }
  TestArchive wrong;
  wrong.Add(TestEntry("a", kText).Flags(zip::kFlagDataDescriptor).Crc(99));
  EXPECT_FALSE(Unzip(wrong));
}

TEST_F(UnzipTest, ArchiveStructureErrorsGiveFalse) {
  TestArchive archive;
  archive.Add(TestEntry("a", kText)).Add(TestEntry("b", "bee"));
  const std::string bytes = archive.Bytes();
  EXPECT_TRUE(Unzip(bytes));
  EXPECT_FALSE(Unzip(bytes + "junk"));  // an unknown signature
  EXPECT_FALSE(Unzip(bytes + "PK"));    // a cut signature
  EXPECT_FALSE(Unzip(Patch32(bytes, 0, 0x04034B51)));
  EXPECT_FALSE(DoUnzip(dir.Path("missing.zip"), dir.Path("out"), nullptr));
  EXPECT_TRUE(Unzip(std::string()));  // no records at all
  // Every cut of the archive either reads to its end or fails, never with a partial file.
  for (std::size_t length = 0; length < bytes.size(); ++length) {
    fs::remove_all(dir.NarrowPath("out"));
    Unzip(bytes.substr(0, length));
    if (fs::exists(dir.NarrowPath("out/a"))) {
      EXPECT_EQ(Out("a"), kText) << length;
    }
    if (fs::exists(dir.NarrowPath("out/b"))) {
      EXPECT_EQ(Out("b"), "bee") << length;
    }
    EXPECT_LE(Tree().size(), 3u) << length;  // no temporary file left behind
  }
}

}  // namespace
