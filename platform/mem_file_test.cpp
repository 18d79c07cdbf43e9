#include "lumen/platform/mem_file.h"

#include <gtest/gtest.h>

#include <fstream>
#include <sstream>

#include "lumen/platform/stdio_file.h"
#include "platform/temp_dir.h"

namespace {

using LumenUtility::testutil::TempDir;

TEST(CMemFile, GrowsFillsGapsWithZerosAndDetachesItsBytes) {
  CMemFile file;
  file.Write("ab", 2);
  EXPECT_EQ(file.Seek(2, CFile::current), 4u);
  file.Write("c", 1);
  EXPECT_EQ(file.GetData(), (std::vector<std::uint8_t>{'a', 'b', 0, 0, 'c'}));
  file.SeekToBegin();
  char bytes[8];
  EXPECT_EQ(file.Read(bytes, 8), 5u);
  EXPECT_EQ(file.Read(bytes, 8), 0u);
  EXPECT_EQ(file.Seek(10, CFile::begin), 10u);
  EXPECT_EQ(file.Read(bytes, 1), 0u);  // past the end reads nothing
  EXPECT_THROW(file.Seek(-11, CFile::current), CFileException);
  EXPECT_EQ(file.Detach().size(), 5u);
  EXPECT_EQ(file.GetLength(), 0u);
  EXPECT_EQ(file.GetPosition(), 0u);
}

TEST(CMemFile, StartsFromGivenBytesAndCannotOpenAPath) {
  const char text[] = "xyz";
  CMemFile file(text, 3);
  char bytes[3];
  EXPECT_EQ(file.Read(bytes, 3), 3u);
  EXPECT_EQ(std::string(bytes, 3), "xyz");
  CFileException error;
  EXPECT_EQ(file.Open(L"/tmp/x", CFile::modeRead, &error), 0);
  EXPECT_EQ(error.m_cause, CFileException::genericException);
}

TEST(CStdioFile, ReadsLinesWithoutTheirEndsAsUtf8) {
  TempDir dir;
  std::ofstream(dir.NarrowPath("t.txt"), std::ios::binary) << "1e9, 90\r\n\n\xCE\xA9 ohm\nno end";
  CStdioFile file(dir.Path("t.txt").c_str(), CFile::modeRead | CFile::typeText);
  std::wstring line;
  std::vector<std::wstring> lines;
  while (file.ReadString(line)) lines.push_back(line);
  EXPECT_EQ(lines, (std::vector<std::wstring>{L"1e9, 90", L"", L"\u03a9 ohm", L"no end"}));
  EXPECT_EQ(line, L"");
  EXPECT_EQ(file.ReadString(line), 0);

  CStdioFile binary(dir.Path("t.txt").c_str(), CFile::modeRead | CFile::typeBinary);
  ASSERT_NE(binary.ReadString(line), 0);
  EXPECT_EQ(line, L"1e9, 90\r");
}

TEST(CStdioFile, WritesUtf8WithLineFeedsAsGiven) {
  TempDir dir;
  {
    CStdioFile file(dir.Path("w.txt").c_str(), CFile::modeCreate | CFile::modeWrite);
    file.WriteString(L"f = 2.4 GHz\n\u00b0\n");
    file.WriteString(nullptr);
  }
  std::ostringstream bytes;
  bytes << std::ifstream(dir.NarrowPath("w.txt"), std::ios::binary).rdbuf();
  EXPECT_EQ(bytes.str(), "f = 2.4 GHz\n\xC2\xB0\n");
}

}  // namespace
