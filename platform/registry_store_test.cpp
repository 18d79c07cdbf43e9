#include "lumen/platform/registry_store.h"

#include <gtest/gtest.h>

#include <fstream>
#include <stdexcept>
#include <string>

#include "lumen/platform/file_exception.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/registry.h"
#include "platform/registry_ini_reader.h"
#include "platform/temp_dir.h"

namespace LumenUtility {
namespace {

const std::wstring kKey = L"HKEY_LOCAL_MACHINE\\SOFTWARE\\Corvane\\Network Analyzer\\";

TEST(RegistryStore, TypedQueriesAnswerOnlyValuesOfTheirType) {
  RegistryStore store;
  store.SetDword(kKey, L"T2Mode", 1);
  store.SetString(kKey, L"T2Name", L"Box");
  store.SetString(kKey, L"T2Path", L"%X%", REG_EXPAND_SZ);
  RegistryValue binary;
  binary.type = REG_BINARY;
  binary.dword = 1;
  binary.text = L"1";
  store.SetValue(kKey, L"T2ClockPort", binary);

  EXPECT_EQ(store.QueryDword(kKey, L"T2Mode"), 1u);
  EXPECT_EQ(store.QueryString(kKey, L"T2Mode"), std::nullopt);
  EXPECT_EQ(store.QueryString(kKey, L"T2Name"), L"Box");
  EXPECT_EQ(store.QueryDword(kKey, L"T2Name"), std::nullopt);
  EXPECT_EQ(store.QueryString(kKey, L"T2Path"), L"%X%");
  EXPECT_EQ(store.QueryDword(kKey, L"T2ClockPort"), std::nullopt);
  EXPECT_EQ(store.QueryString(kKey, L"T2ClockPort"), std::nullopt);
  EXPECT_EQ(store.QueryDword(kKey, L"Absent"), std::nullopt);

  // A value of another type replaces the old one.
  store.SetString(kKey, L"T2Mode", L"1");
  EXPECT_EQ(store.QueryDword(kKey, L"T2Mode"), std::nullopt);
  EXPECT_EQ(store.size(), 4u);
}

TEST(RegistryStore, PathsAndNamesIgnoreAsciiCaseAndTrailingBackslashes) {
  RegistryStore store;
  store.SetDword(kKey, L"T2Mode", 7);
  EXPECT_EQ(store.QueryDword(L"hkey_local_machine\\software\\corvane\\network analyzer", L"t2mode"),
            7u);
  EXPECT_EQ(store.QueryDword(L"HKEY_LOCAL_MACHINE\\SOFTWARE\\Corvane", L"T2Mode"), std::nullopt);
  EXPECT_EQ(store.QueryDword(kKey + L"Sub", L"T2Mode"), std::nullopt);
}

TEST(RegistryStore, SetStringRefusesATypeThatIsNoString) {
  RegistryStore store;
  try {
    store.SetString(kKey, L"T2Name", L"Box", REG_DWORD);
    FAIL() << "accepted REG_DWORD";
  } catch (const std::invalid_argument& e) {
    EXPECT_STREQ(e.what(), "RegistryStore::SetString: type must be REG_SZ or REG_EXPAND_SZ");
  }
  EXPECT_TRUE(store.empty());
}

TEST(RegistryIniReader, ReadsKeysTypedValuesAndComments) {
  const RegistryStore store = RegistryIniReader::Parse(
      "\xEF\xBB\xBF; second test set\r\n"
      "# another comment\n"
      "\n"
      "[ HKEY_LOCAL_MACHINE\\SOFTWARE\\Corvane\\Network Analyzer\\ ]\r\n"
      "  T2Mode = dword:00000001\n"
      "T2ClockPort=DWORD:fFfFfFfF\n"
      "T2Name = \"  Test set 2 \"\n"
      "T2Path = expand: %ProgramData%\\T2\n"
      "Plain = a = b\n"
      "[Other]\n"
      "T2Mode = dword:2\n"
      "[HKEY_LOCAL_MACHINE\\SOFTWARE\\Corvane\\Network Analyzer]\n"
      "T2Mode = dword:3");  // a later value of the same name wins; no final line end
  EXPECT_EQ(store.QueryDword(kKey, L"T2Mode"), 3u);
  EXPECT_EQ(store.QueryDword(kKey, L"T2ClockPort"), 0xFFFFFFFFu);
  EXPECT_EQ(store.QueryString(kKey, L"T2Name"), L"  Test set 2 ");
  const RegistryValue* path = store.Find(kKey, L"T2Path");
  ASSERT_NE(path, nullptr);
  EXPECT_EQ(path->type, REG_EXPAND_SZ);
  EXPECT_EQ(path->text, L"%ProgramData%\\T2");
  EXPECT_EQ(store.QueryString(kKey, L"Plain"), L"a = b");
  EXPECT_EQ(store.QueryDword(L"Other", L"T2Mode"), 2u);
  EXPECT_EQ(store.size(), 6u);
}

TEST(RegistryIniReader, ReadsUtf8TextAndEmptyInput) {
  EXPECT_TRUE(RegistryIniReader::Parse("").empty());
  EXPECT_TRUE(RegistryIniReader::Parse("\n\r\n ; only comments\n").empty());
  const RegistryStore store = RegistryIniReader::Parse("[K]\nT2Name = Pr\xC3\xBC" "fset\n");
  EXPECT_EQ(store.QueryString(L"K", L"T2Name"), L"Pr\u00FCfset");
}

TEST(RegistryIniReader, MalformedLineThrowsWithItsNumber) {
  const struct {
    const char* text;
    const wchar_t* message;
  } cases[] = {
      {"[K]\nT2Mode = dword:\n", L"registry configuration line 2: a dword value needs 1 to 8 hexadecimal digits"},
      {"[K]\nT2Mode = dword:123456789\n", L"registry configuration line 2: a dword value needs 1 to 8 hexadecimal digits"},
      {"[K]\nT2Mode = dword:12g\n", L"registry configuration line 2: a dword value needs 1 to 8 hexadecimal digits"},
      {"[K]\nT2Mode = dword:-1\n", L"registry configuration line 2: a dword value needs 1 to 8 hexadecimal digits"},
      {"[K]\n\nT2Name = \"open\n", L"registry configuration line 3: a quoted text has no end quote"},
      {"[K]\nQuote = \"\n", L"registry configuration line 2: a quoted text has no end quote"},
      {"[K]\nT2Path = expand:\"x\n", L"registry configuration line 2: a quoted text has no end quote"},
      {"[K\n", L"registry configuration line 1: a key path in brackets has no ']'"},
      {"[K] trailing\n", L"registry configuration line 1: a key path in brackets has no ']'"},
      {"[  ]\n", L"registry configuration line 1: the key path is empty"},
      {"[K]\njust words\n", L"registry configuration line 2: expected [key path], name = value or a comment"},
      {"[K]\n = 1\n", L"registry configuration line 2: the value has no name"},
      {"T2Mode = dword:1\n", L"registry configuration line 1: a value before the first [key path]"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.text);
    try {
      RegistryIniReader::Parse(c.text);
      ADD_FAILURE() << "accepted";
    } catch (const LumenException& e) {
      EXPECT_EQ(e.GetCode(), LUMEN_E_BOUNDS);
      EXPECT_EQ(e.GetMessage(), c.message);
    }
  }
}

TEST(RegistryConfigurationFile, ReplacesTheRegistryOnlyWhenTheWholeFileReads) {
  testutil::TempDir dir;
  std::ofstream(dir.NarrowPath("good.ini")) << "[K]\nT2Mode = dword:1\n";
  std::ofstream(dir.NarrowPath("bad.ini")) << "[K]\nT2Mode = dword:2\nbroken\n";
  std::ofstream(dir.NarrowPath("big.ini")) << std::string(RegistryIniReader::kMaxFileBytes + 1, ';');

  SetRegistryConfigurationFile(dir.Path("good.ini"));
  EXPECT_EQ(GetRegistryStore().QueryDword(L"K", L"T2Mode"), 1u);

  try {
    SetRegistryConfigurationFile(dir.Path("bad.ini"));
    ADD_FAILURE() << "accepted a malformed file";
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetMessage(),
              L"registry configuration line 3: expected [key path], name = value or a comment in " +
                  dir.Path("bad.ini"));
  }
  try {
    SetRegistryConfigurationFile(dir.Path("big.ini"));
    ADD_FAILURE() << "accepted a file over the limit";
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetMessage(), L"registry configuration larger than 1 MiB in " + dir.Path("big.ini"));
  }
  try {
    SetRegistryConfigurationFile(dir.Path("absent.ini"));
    ADD_FAILURE() << "accepted a missing file";
  } catch (const CFileException& e) {
    EXPECT_EQ(e.m_cause, CFileException::fileNotFound);
  }
  EXPECT_EQ(GetRegistryStore().QueryDword(L"K", L"T2Mode"), 1u);  // still the good file

  SetRegistryStore(RegistryStore());
  EXPECT_TRUE(GetRegistryStore().empty());
}

}  // namespace
}  // namespace LumenUtility
