#include "lumen/platform/archive.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <vector>

#include "lumen/platform/mem_file.h"
#include "platform/temp_dir.h"

namespace {

using Bytes = std::vector<std::uint8_t>;

template <typename Store>
Bytes Stored(Store store) {
  CMemFile file;
  CArchive ar(&file, CArchive::store);
  store(ar);
  ar.Close();
  return file.Detach();
}

Bytes Prefix(const Bytes& bytes, std::size_t count) {
  return Bytes(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(count));
}

// What the archive reads back as a string from `bytes`.
std::wstring LoadedString(const Bytes& bytes) {
  CMemFile file(bytes);
  CArchive ar(&file, CArchive::load);
  std::wstring text = L"unchanged";
  ar >> text;
  return text;
}

int LoadCause(const Bytes& bytes, std::wstring& text) {
  CMemFile file(bytes);
  CArchive ar(&file, CArchive::load);
  try {
    ar >> text;
  } catch (const CArchiveException& e) {
    return e.m_cause;
  }
  return CArchiveException::none;
}

TEST(CArchive, ValuesAreLittleEndianAtTheirOwnWidth) {
  const Bytes bytes = Stored([](CArchive& ar) {
    ar << std::uint8_t{0xAB} << std::int16_t{-2} << std::uint32_t{0x01020304} << std::int64_t{-1}
       << 1.0f << 3.5;
  });
  const Bytes expected = {0xAB, 0xFE, 0xFF, 0x04, 0x03, 0x02, 0x01, 0xFF, 0xFF,
                          0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0x00, 0x00, 0x80,
                          0x3F, 0,    0,    0,    0,    0,    0,    0x0C, 0x40};
  EXPECT_EQ(bytes, expected);

  CMemFile file(bytes);
  CArchive ar(&file, CArchive::load);
  std::uint8_t u8;
  std::int16_t i16;
  std::uint32_t u32;
  std::int64_t i64;
  float f;
  double d;
  ar >> u8 >> i16 >> u32 >> i64 >> f >> d;
  EXPECT_EQ(u8, 0xAB);
  EXPECT_EQ(i16, -2);
  EXPECT_EQ(u32, 0x01020304u);
  EXPECT_EQ(i64, -1);
  EXPECT_EQ(f, 1.0f);
  EXPECT_EQ(d, 3.5);
}

TEST(CArchive, WideStringsCarryTheTagAndTheNarrowestCount) {
  struct Case {
    std::size_t length;
    Bytes prefix;
  } cases[] = {
      {0, {0xFF, 0xFE, 0xFF, 0x00}},
      {254, {0xFF, 0xFE, 0xFF, 0xFE}},
      {255, {0xFF, 0xFE, 0xFF, 0xFF, 0xFF, 0x00}},
      {65533, {0xFF, 0xFE, 0xFF, 0xFF, 0xFD, 0xFF}},
      {65534, {0xFF, 0xFE, 0xFF, 0xFF, 0xFF, 0xFF, 0xFE, 0xFF, 0x00, 0x00}},
      {65535, {0xFF, 0xFE, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0x00, 0x00}},
  };
  for (const Case& c : cases) {
    const std::wstring text(c.length, L'k');
    const Bytes bytes = Stored([&](CArchive& ar) { ar << text; });
    ASSERT_EQ(bytes.size(), c.prefix.size() + 2 * c.length) << c.length;
    EXPECT_EQ(Prefix(bytes, c.prefix.size()), c.prefix) << c.length;
    if (c.length) {
      EXPECT_EQ(Bytes(bytes.end() - 2, bytes.end()), (Bytes{'k', 0}));
    }
    EXPECT_EQ(LoadedString(bytes), text) << c.length;
  }
  // Code points beyond 16 bits count as two UTF-16 units.
  const Bytes pair = Stored([](CArchive& ar) { ar << std::wstring(L"\U0001F4E1"); });
  EXPECT_EQ(pair, (Bytes{0xFF, 0xFE, 0xFF, 0x02, 0x3D, 0xD8, 0xE1, 0xDC}));
  EXPECT_EQ(LoadedString(pair), L"\U0001F4E1");
}

TEST(CArchive, LoadingAcceptsTheUntaggedEightBitForm) {
  EXPECT_EQ(LoadedString({3, 'a', 'b', 'c'}), L"abc");
  EXPECT_EQ(LoadedString({2, 0xC2, 0xB0}), L"\u00b0");  // read as UTF-8 bytes
  Bytes wide = {0xFF, 0x00, 0x01};
  wide.resize(wide.size() + 256, 'z');
  EXPECT_EQ(LoadedString(wide), std::wstring(256, L'z'));
  EXPECT_EQ(LoadedString({0xFF, 0xFE, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF,
                          0x01, 0,    0,    0,    0,    0,    0,    0,    'q',  0}),
            L"q");  // the 64-bit count form
}

TEST(CArchive, ShortDataThrowsEndOfFileAndLeavesTheTargetAlone) {
  const Bytes cases[] = {
      {},
      {0xFF},
      {0xFF, 0xFE, 0xFF, 0x03, 'a', 0},
      // A count of 2^62 units: read in pieces, so nothing of that size is allocated.
      {0xFF, 0xFE, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF,
       0,    0,    0,    0,    0,    0,    0,    0x40, 'a',  0},
      {0xFF, 0xFE, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF,
       0xFF, 0xFF, 0xFF},
  };
  for (const Bytes& bytes : cases) {
    std::wstring text = L"unchanged";
    EXPECT_EQ(LoadCause(bytes, text), CArchiveException::endOfFile) << bytes.size();
    EXPECT_EQ(text, L"unchanged");
  }
  CMemFile file(Bytes{1, 2, 3});
  CArchive ar(&file, CArchive::load);
  std::int32_t value = 7;
  EXPECT_THROW(ar >> value, CArchiveException);
  EXPECT_EQ(value, 7);
  char raw[8];
  file.SeekToBegin();
  EXPECT_EQ(ar.Read(raw, 8), 3u);  // Read itself reports the count instead of throwing
}

TEST(CArchive, EachDirectionRefusesTheOtherWithItsCause) {
  CMemFile file;
  CArchive storing(&file, CArchive::store);
  CArchive loading(&file, CArchive::load);
  EXPECT_TRUE(storing.IsStoring() && !storing.IsLoading());
  EXPECT_TRUE(loading.IsLoading() && !loading.IsStoring());
  auto causeOf = [](auto operation) {
    try {
      operation();
    } catch (const CArchiveException& e) {
      return e.m_cause;
    }
    return -1;
  };
  std::int32_t value;
  std::wstring text;
  EXPECT_EQ(causeOf([&] { loading << 1; }), CArchiveException::readOnly);
  EXPECT_EQ(causeOf([&] { loading << std::wstring(L"x"); }), CArchiveException::readOnly);
  EXPECT_EQ(causeOf([&] { storing >> value; }), CArchiveException::writeOnly);
  EXPECT_EQ(causeOf([&] { storing >> text; }), CArchiveException::writeOnly);
  storing.Close();
  EXPECT_EQ(storing.GetFile(), nullptr);
  EXPECT_EQ(causeOf([&] { storing << 1; }), CArchiveException::genericException);
  EXPECT_TRUE(file.GetData().empty());
}

TEST(CArchive, RoundTripsThroughADiskFileAndNamesItInErrors) {
  LumenUtility::testutil::TempDir dir;
  const std::wstring path = dir.Path("state.bin");
  {
    CFile file(path.c_str(), CFile::modeCreate | CFile::modeWrite);
    CArchive ar(&file, CArchive::store);
    ar << std::int32_t{2} << std::wstring(L"IndexPolarity") << -0.25;
  }  // the archive flushes, the file closes
  CFile file(path.c_str(), CFile::modeRead);
  CArchive ar(&file, CArchive::load);
  std::int32_t count;
  std::wstring key;
  double value;
  ar >> count >> key >> value;
  EXPECT_EQ(count, 2);
  EXPECT_EQ(key, L"IndexPolarity");
  EXPECT_EQ(value, -0.25);
  try {
    ar >> count;
    ADD_FAILURE();
  } catch (const CArchiveException& e) {
    EXPECT_EQ(e.m_cause, CArchiveException::endOfFile);
    EXPECT_EQ(e.GetErrorMessage(), L"The archive of " + path + L" ended unexpectedly.");
  }
  EXPECT_EQ(CArchiveException(CArchiveException::badIndex).GetErrorMessage(),
            L"The archive of an unnamed file has an invalid format.");
}

}  // namespace
