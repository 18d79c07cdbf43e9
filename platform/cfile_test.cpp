#include "lumen/platform/cfile.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <fstream>
#include <string>
#include <vector>

#include "platform/temp_dir.h"

namespace {

using LumenUtility::testutil::TempDir;

std::uintmax_t SizeOnDisk(const std::string& path) {
  struct stat info;
  return stat(path.c_str(), &info) == 0 ? static_cast<std::uintmax_t>(info.st_size) : 0;
}

void WriteFileBytes(const std::string& path, const std::string& bytes) {
  std::ofstream(path, std::ios::binary) << bytes;
}

std::string ReadBytes(CFile& file, unsigned count) {
  std::string bytes(count, '\0');
  bytes.resize(file.Read(bytes.data(), count));
  return bytes;
}

TEST(CFile, SmallWritesReachTheSystemOnlyWhenFlushed) {
  TempDir dir;
  CFile file(dir.Path("out.bin").c_str(), CFile::modeCreate | CFile::modeWrite);
  for (int i = 0; i < 1000; ++i) file.Write("0123456789", 10);
  EXPECT_EQ(SizeOnDisk(dir.NarrowPath("out.bin")), 0u);  // not one write(2) so far
  EXPECT_EQ(file.GetPosition(), 10000u);
  EXPECT_EQ(file.GetLength(), 10000u);
  file.Flush();
  EXPECT_EQ(SizeOnDisk(dir.NarrowPath("out.bin")), 10000u);
}

TEST(CFile, SmallReadsAreServedFromOneSystemRead) {
  TempDir dir;
  const std::string path = dir.NarrowPath("in.bin");
  WriteFileBytes(path, std::string(100, 'a'));
  CFile file(dir.Path("in.bin").c_str(), CFile::modeRead);
  EXPECT_EQ(ReadBytes(file, 1), "a");
  // Changing the file behind the object's back shows where the next reads come from.
  const int fd = open(path.c_str(), O_WRONLY);
  ASSERT_EQ(pwrite(fd, std::string(100, 'b').data(), 100, 0), 100);
  close(fd);
  EXPECT_EQ(ReadBytes(file, 10), std::string(10, 'a'));  // the buffer, no read(2)
  EXPECT_EQ(file.Seek(0, CFile::current), 11u);          // a seek drops the buffer
  EXPECT_EQ(ReadBytes(file, 89), std::string(89, 'b'));
  EXPECT_EQ(ReadBytes(file, 5), "");
}

TEST(CFile, LargeAndMixedTransfersKeepTheLogicalPosition) {
  TempDir dir;
  std::string big(200 * 1024, '\0');
  for (std::size_t i = 0; i < big.size(); ++i) big[i] = static_cast<char>(i * 7);
  CFile file(dir.Path("mix.bin").c_str(), CFile::modeCreate | CFile::modeReadWrite);
  file.Write("head", 4);
  file.Write(big.data(), static_cast<unsigned>(big.size()));
  EXPECT_EQ(file.GetLength(), big.size() + 4);
  file.SeekToBegin();
  EXPECT_EQ(ReadBytes(file, 4), "head");
  file.Write("XY", 2);  // lands right after the 4 bytes read, not after the read-ahead
  EXPECT_EQ(file.GetPosition(), 6u);
  EXPECT_EQ(ReadBytes(file, 3), big.substr(2, 3));
  file.SeekToBegin();
  EXPECT_EQ(ReadBytes(file, static_cast<unsigned>(big.size() + 10)),
            "head" + std::string("XY") + big.substr(2));
  EXPECT_EQ(file.Seek(-2, CFile::end), big.size() + 2);
  EXPECT_EQ(file.Seek(1, CFile::current), big.size() + 3);
}

TEST(CFile, BadSeeksThrowWithoutMoving) {
  TempDir dir;
  CFile file(dir.Path("s.bin").c_str(), CFile::modeCreate | CFile::modeReadWrite);
  file.Write("abc", 3);
  for (auto [offset, from] : {std::pair<std::int64_t, unsigned>{-1, CFile::begin},
                              {-4, CFile::current},
                              {-4, CFile::end},
                              {0, 7u},
                              {INT64_MAX, CFile::current}}) {
    try {
      file.Seek(offset, from);
      ADD_FAILURE() << offset << " from " << from;
    } catch (const CFileException& e) {
      EXPECT_EQ(e.m_cause, CFileException::badSeek);
    }
  }
  EXPECT_EQ(file.GetPosition(), 3u);
}

TEST(CFile, OpenFailuresReportCauseErrnoAndPath) {
  TempDir dir;
  WriteFileBytes(dir.NarrowPath("plain"), "x");
  struct Case {
    std::wstring path;
    unsigned flags;
    int cause;
    int osError;
  } cases[] = {
      {dir.Path("missing"), CFile::modeRead, CFileException::fileNotFound, ENOENT},
      {dir.Path("plain") + L"/below", CFile::modeRead, CFileException::badPath, ENOTDIR},
      {dir.Path(""), CFile::modeRead, CFileException::accessDenied, EISDIR},
      {dir.Path("plain"), 3u, CFileException::badPath, EINVAL},
  };
  for (const Case& c : cases) {
    CFile file;
    CFileException error;
    EXPECT_EQ(file.Open(c.path.c_str(), c.flags, &error), 0);
    EXPECT_EQ(error.m_cause, c.cause);
    EXPECT_EQ(error.m_lOsError, c.osError);
    EXPECT_EQ(error.m_strFileName, c.path);
    EXPECT_FALSE(file.IsOpen());
  }
  CFile open(dir.Path("plain").c_str(), CFile::modeRead);
  CFileException again;
  EXPECT_EQ(open.Open(dir.Path("plain").c_str(), CFile::modeRead, &again), 0);
  EXPECT_EQ(again.m_cause, CFileException::genericException);
  EXPECT_THROW(CFile(dir.Path("missing").c_str(), CFile::modeRead), CFileException);
}

TEST(CFile, AccessOutsideTheOpenModeThrowsAtOnce) {
  TempDir dir;
  WriteFileBytes(dir.NarrowPath("r"), "abc");
  CFile reader(dir.Path("r").c_str(), CFile::modeRead);
  try {
    reader.Write("x", 1);
    ADD_FAILURE();
  } catch (const CFileException& e) {
    EXPECT_EQ(e.m_cause, CFileException::accessDenied);
  }
  CFile writer(dir.Path("w").c_str(), CFile::modeCreate | CFile::modeWrite);
  char c;
  EXPECT_THROW(writer.Read(&c, 1), CFileException);
  CFile closed;
  try {
    closed.Read(&c, 1);
    ADD_FAILURE();
  } catch (const CFileException& e) {
    EXPECT_EQ(e.m_cause, CFileException::invalidFile);
  }
}

TEST(CFile, RefusedBufferedBytesSurfaceAtFlushAndClose) {
  if (access("/dev/full", W_OK) != 0) GTEST_SKIP() << "no /dev/full here";
  CFile full(L"/dev/full", CFile::modeWrite);
  full.Write("abc", 3);  // buffered: the refusal comes later
  try {
    full.Flush();
    ADD_FAILURE();
  } catch (const CFileException& e) {
    EXPECT_EQ(e.m_cause, CFileException::diskFull);
    EXPECT_EQ(e.m_lOsError, ENOSPC);
    EXPECT_EQ(e.m_strFileName, L"/dev/full");
  }
  full.Write("def", 3);
  EXPECT_THROW(full.Close(), CFileException);
  EXPECT_FALSE(full.IsOpen());
  full.Close();  // closing twice does nothing
}

TEST(CFile, CreateTruncatesUnlessToldNotTo) {
  TempDir dir;
  WriteFileBytes(dir.NarrowPath("f"), "previous");
  CFile(dir.Path("f").c_str(), CFile::modeCreate | CFile::modeNoTruncate | CFile::modeWrite)
      .Close();
  EXPECT_EQ(SizeOnDisk(dir.NarrowPath("f")), 8u);
  CFile(dir.Path("f").c_str(), CFile::modeCreate | CFile::modeWrite).Close();
  EXPECT_EQ(SizeOnDisk(dir.NarrowPath("f")), 0u);
}

TEST(CFileException, MessagesNameTheFileAndFitTheBuffer) {
  const CFileException e(CFileException::fileNotFound, ENOENT, L"/data/a.prn");
  EXPECT_EQ(e.GetErrorMessage(), L"/data/a.prn does not exist.");
  EXPECT_STREQ(e.what(), "/data/a.prn does not exist.");
  wchar_t buffer[8];
  unsigned help = 99;
  EXPECT_NE(e.GetErrorMessage(buffer, 8, &help), 0);
  EXPECT_EQ(std::wstring(buffer), L"/data/a");
  EXPECT_EQ(help, 0u);
  EXPECT_NE(e.GetErrorMessage(buffer, 1), 0);
  EXPECT_EQ(std::wstring(buffer), L"");
  EXPECT_EQ(e.GetErrorMessage(nullptr, 8), 0);
  EXPECT_EQ(e.GetErrorMessage(buffer, 0), 0);
  EXPECT_EQ(CFileException(CFileException::endOfFile).GetErrorMessage(),
            L"Tried to read past the end of an unnamed file.");
  EXPECT_EQ(CFileException::OsErrorToException(EDQUOT), CFileException::diskFull);
  EXPECT_EQ(CFileException::OsErrorToException(12345), CFileException::genericException);
}

}  // namespace
