#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "lumen/data/data_matrix.h"
#include "platform/temp_dir.h"

namespace LumenUtility {
namespace {

std::string FileBytes(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

TEST(DataMatrixDump, WritesOneCrLfLinePerBufferInNameOrder) {
  testutil::TempDir dir;
  DataMatrix m({L"S11", L"B", L"\u00e9t\u00e9"}, 2);
  TsComplex* s11 = m.GetDataByName(L"S11");
  s11[0] = TsComplex(0.5, -0.25);
  s11[1] = TsComplex(1, 0);
  TsComplex* b = m.GetDataByName(L"B");
  b[0] = TsComplex(123456789.0, 1e-7);
  b[1] = TsComplex(-0.0001234567, 2.5e12);
  m.AddBuffer(L"empty");
  m.Resize(0, 0);
  m.AddBuffer(L"empty");  // a buffer without samples

  const std::string path = dir.NarrowPath("dump.txt");
  ASSERT_TRUE(m.DumpData(path.c_str()));
  EXPECT_EQ(FileBytes(path),
            "TsComplex,B,1.23457e+08,1e-07,-0.000123457,2.5e+12\r\n"
            "TsComplex,S11,0.5,-0.25,1,0\r\n"
            "TsComplex,empty\r\n"
            "TsComplex,\xc3\xa9t\xc3\xa9,0,0,0,0\r\n");

  // A second dump truncates the first.
  ASSERT_TRUE(DataMatrix().DumpData(path.c_str()));
  EXPECT_TRUE(std::filesystem::exists(path));
  EXPECT_EQ(FileBytes(path), "");
}

TEST(DataMatrixDump, FileThatCannotBeWrittenIsReportedAndLeftBehindNowhere) {
  testutil::TempDir dir;
  const DataMatrix m(1, {1}, 3);
  const std::string missingFolder = dir.NarrowPath("no/such/dump.txt");
  EXPECT_FALSE(m.DumpData(missingFolder.c_str()));
  EXPECT_FALSE(std::filesystem::exists(missingFolder));
  EXPECT_FALSE(m.DumpData(nullptr));
  if (!std::filesystem::exists("/dev/full")) GTEST_SKIP() << "no /dev/full here";
  EXPECT_FALSE(m.DumpData("/dev/full"));
  EXPECT_TRUE(std::filesystem::exists("/dev/full"));  // a device is never removed
}

}  // namespace
}  // namespace LumenUtility
