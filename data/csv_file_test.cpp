#include "lumen/data/csv_file.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <fstream>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "platform/temp_dir.h"
#include "platform/test_files.h"

namespace {

using LumenUtility::testutil::TempDir;

// One step of reading: what ReadField (or, after a line end, ReadEndOfLine) gave.
struct Token {
  int ok;
  unsigned status;
  std::string field;
  bool operator==(const Token&) const = default;
};

std::ostream& operator<<(std::ostream& out, const Token& t) {
  return out << "{" << t.ok << "," << t.status << ",'" << t.field << "'}";
}

Token Field(std::string text, unsigned status = CCSVFile::kField) {
  return {1, status, std::move(text)};
}
Token Quoted(std::string text) {
  return {1, CCSVFile::kQuotedField, std::move(text)};
}
const Token kLineEnd{0, CCSVFile::kEndOfLine, ""};
const Token kLineEndRead{1, CCSVFile::kEndOfLine, ""};
const Token kFileEnd{0, CCSVFile::kEndOfFile, ""};

// A reader-test fixture: each test writes a file of its own (often a valid one with a small
// corruption) and reads it through the file path.
class CsvReadTest : public ::testing::Test {
 protected:
  void Open(const std::string& text) {
    std::ofstream(dir.NarrowPath("in.csv"), std::ios::binary) << text;
    csv = std::make_unique<CCSVFile>();
    ASSERT_TRUE(csv->Open(dir.Path("in.csv").c_str(), CFile::modeRead));
  }
  // Reads the whole file: every ReadField, and after each line end the ReadEndOfLine that
  // consumes it, up to the end of the file or the first error.
  std::vector<Token> ReadAll(const std::string& text) {
    Open(text);
    return ReadRest();
  }
  std::vector<Token> ReadRest() {
    std::vector<Token> tokens;
    for (int guard = 0; guard < 100000; ++guard) {
      Token t;
      t.ok = csv->ReadField(t.field, &t.status);
      tokens.push_back(t);
      if (t.status == CCSVFile::kEndOfFile || csv->IsError(t.status)) break;
      if (t.status == CCSVFile::kEndOfLine) {
        Token end;
        end.ok = csv->ReadEndOfLine(&end.status);
        tokens.push_back(end);
      }
    }
    return tokens;
  }
  std::wstring LastError() const {
    wchar_t text[CCSVFile::kErrorCapacity];
    csv->GetLastErrorMessage(text, CCSVFile::kErrorCapacity);
    return text;
  }
  // `text` with its first `from` replaced by `to`; the test fails if `from` is absent.
  static std::string Corrupt(std::string text, const std::string& from, const std::string& to) {
    const std::size_t at = text.find(from);
    EXPECT_NE(at, std::string::npos) << from;
    if (at != std::string::npos) text.replace(at, from.size(), to);
    return text;
  }

  TempDir dir;
  std::unique_ptr<CCSVFile> csv;
};

const std::string kExampleLine = "a,\"b,c\",\"d\"\"e\"\r\n";

TEST_F(CsvReadTest, ExampleLineGivesQuotedFieldsThenLineEndThenFileEnd) {
  EXPECT_EQ(ReadAll(kExampleLine), (std::vector<Token>{Field("a"), Quoted("b,c"), Quoted("d\"e"),
                                                       kLineEnd, kLineEndRead, kFileEnd}));
}

TEST_F(CsvReadTest, CrLfLfCrAndLfEndLinesAlikeAndALoneCrIsText) {
  const std::vector<Token> expected{Field("x"), Field("y"),   kLineEnd, kLineEndRead, Field("z"),
                                    kLineEnd,   kLineEndRead, kLineEnd, kLineEndRead, Field("w"),
                                    kLineEnd,   kLineEndRead, kFileEnd};
  for (const std::string end : {"\r\n", "\n\r", "\n"}) {
    EXPECT_EQ(ReadAll("x,y" + end + "z" + end + end + "w" + end), expected) << int(end[0]);
  }
  // Of overlapping pairs the first is taken: CR LF CR is a line end and a CR of text.
  EXPECT_EQ(ReadAll("p\rq\r\n\rr"),
            (std::vector<Token>{Field("p\rq"), kLineEnd, kLineEndRead, Field("\rr"), kFileEnd}));
  EXPECT_EQ(ReadAll("s\r"), (std::vector<Token>{Field("s\r"), kFileEnd}));
}

TEST_F(CsvReadTest, LineEndPairSplitBetweenTwoReadsIsOneLineEnd) {
  // Bytes 0-9 are the first read: its last byte is the CR, the LF opens the second read.
  for (const char* pair : {"\r\n", "\n\r"}) {
    EXPECT_EQ(
        ReadAll(std::string("abcdefghi") + pair + "j"),
        (std::vector<Token>{Field("abcdefghi"), kLineEnd, kLineEndRead, Field("j"), kFileEnd}))
        << int(pair[0]);
  }
  // Two CRs at the end of the first read, the LF after them: text CR, then a line end.
  EXPECT_EQ(ReadAll("abcdefgh\r\r\nj"), (std::vector<Token>{Field("abcdefgh\r"), kLineEnd,
                                                            kLineEndRead, Field("j"), kFileEnd}));
}

TEST_F(CsvReadTest, WhereTheTenByteReadsFallChangesNoFieldOrStatus) {
  const std::string texts[] = {
      kExampleLine,  "abcdefgh,\n",      "abcdefghi,\n",   "\"q\"\"\"\"\",\"\"\n",
      "a,\n,\n\n",   "\"x\ny\"z,\r\n\r", "a\rb\r\r\n\n\r", "\"unterminated,\nend",
      "last,field,", "\n\r\n\r\n\r",     "\"\",\"\"",      "\"a\"\"\"",
  };
  for (const std::string& text : texts) {
    const std::vector<Token> alone = ReadAll(text);
    // A first line of 0 to 10 characters shifts the text against the reads; its CR LF cannot
    // pair with what follows, since the pair that starts first is taken.
    for (int shift = 0; shift <= 10; ++shift) {
      Open(std::string(shift, 's') + "\r\n" + text);
      std::string first;
      unsigned status;
      if (shift > 0) {
        ASSERT_TRUE(csv->ReadField(first, &status));
      }
      ASSERT_FALSE(csv->ReadField(first, &status));
      ASSERT_TRUE(csv->ReadEndOfLine(&status));
      EXPECT_EQ(ReadRest(), alone) << "shift " << shift << " of '" << text << "'";
    }
  }
}

TEST_F(CsvReadTest, ALineEndingInACommaHasAnEmptyLastField) {
  EXPECT_EQ(ReadAll("a,\r\n,\r\n"),
            (std::vector<Token>{Field("a"), Field(""), kLineEnd, kLineEndRead, Field(""), Field(""),
                                kLineEnd, kLineEndRead, kFileEnd}));
  EXPECT_EQ(ReadAll("\"a\","), (std::vector<Token>{Quoted("a"), Field(""), kFileEnd}));
  // A caller that takes the line end without reading the empty field is not held up.
  Open("a,\r\nb\r\n");
  std::string field;
  unsigned status;
  ASSERT_TRUE(csv->ReadField(field, &status));
  EXPECT_TRUE(csv->ReadEndOfLine(&status));
  EXPECT_EQ(ReadRest(), (std::vector<Token>{Field("b"), kLineEnd, kLineEndRead, kFileEnd}));
}

TEST_F(CsvReadTest, QuotesJoinTextAfterTheClosingQuoteAndDoubledQuotesAreOneQuote) {
  EXPECT_EQ(ReadAll("\"x\"y,\"\",\"\"\"\"\n"),
            (std::vector<Token>{Quoted("xy"), Quoted(""), Quoted("\""), kLineEnd, kLineEndRead,
                                kFileEnd}));
  // A line end inside quotes belongs to the field, collapsed to LF like any other.
  EXPECT_EQ(ReadAll("\"two\r\nlines\",x"),
            (std::vector<Token>{Quoted("two\nlines"), Field("x"), kFileEnd}));
}

TEST_F(CsvReadTest, FileEndingInsideQuotesGivesTheTextReadSoFar) {
  const std::string good = "a,\"open quote, text\"\r\n";
  EXPECT_EQ(ReadAll(Corrupt(good, "text\"\r\n", "text\r\n")),
            (std::vector<Token>{Field("a"), Field("open quote, text\n", CCSVFile::kOpenQuoteAtEnd),
                                kFileEnd}));
  EXPECT_EQ(ReadAll("\""), (std::vector<Token>{Field("", CCSVFile::kOpenQuoteAtEnd), kFileEnd}));
}

TEST_F(CsvReadTest, FieldOver1024CharactersIsCutAndNamedInTheLastError) {
  const std::string longest(CCSVFile::kMaxFieldLength, 'k');
  EXPECT_EQ(
      ReadAll(longest + ",\"" + longest + "\"\n"),
      (std::vector<Token>{Field(longest), Quoted(longest), kLineEnd, kLineEndRead, kFileEnd}));
  for (const std::string& text : {longest + "k,next\n", "\"" + longest + "k\"\n",
                                  "\"" + longest + "\"\"\"\n", longest + "kkkkkkkkkkkkkk"}) {
    const std::vector<Token> tokens = ReadAll(text);
    ASSERT_EQ(tokens.size(), 1u) << text.size();
    EXPECT_EQ(tokens[0].ok, 0);
    EXPECT_EQ(tokens[0].status, CCSVFile::kFieldTooLong);
    EXPECT_EQ(tokens[0].field.size(), CCSVFile::kMaxFieldLength);
    const std::wstring message = L"Too long field; \"" + std::wstring(238, L'k');
    EXPECT_EQ(LastError(), message);
    EXPECT_EQ(message.size(), 255u);
  }
}

TEST_F(CsvReadTest, FieldsOfAFileOpenedForWritingAreAFileError) {
  csv = std::make_unique<CCSVFile>();
  ASSERT_TRUE(csv->Open(dir.Path("out.csv").c_str(), CFile::modeCreate | CFile::modeWrite));
  std::string field = "stale";
  unsigned status = 0;
  EXPECT_FALSE(csv->ReadField(field, &status));
  EXPECT_EQ(status, CCSVFile::kFileError);
  EXPECT_TRUE(field.empty());
  EXPECT_EQ(LastError(), L"Access to " + dir.Path("out.csv") + L" was refused.");
  EXPECT_FALSE(csv->ReadEndOfLine(&status));
  EXPECT_EQ(status, CCSVFile::kFileError);
  // Closed, there is nothing more to read.
  csv->Close();
  EXPECT_FALSE(csv->ReadField(field, &status));
  EXPECT_EQ(status, CCSVFile::kEndOfFile);
  EXPECT_FALSE(csv->ReadField(field, nullptr));
}

TEST_F(CsvReadTest, EndOfLineWithFieldsLeftChangesNothing) {
  Open("a,b\n");
  unsigned status = 77;
  EXPECT_FALSE(csv->ReadEndOfLine(&status));
  EXPECT_EQ(status, 77u);
  EXPECT_EQ(ReadRest(),
            (std::vector<Token>{Field("a"), Field("b"), kLineEnd, kLineEndRead, kFileEnd}));
  EXPECT_FALSE(csv->ReadEndOfLine(&status));
  EXPECT_EQ(status, CCSVFile::kEndOfFile);
}

TEST_F(CsvReadTest, OpenFailureLeavesTheReasonAndMessagesAreCutToTheCallersSize) {
  CCSVFile file;
  wchar_t text[8] = L"unset";
  file.GetLastErrorMessage(text, 8);
  EXPECT_STREQ(text, L"");
  const std::wstring missing = dir.Path("missing.csv");
  EXPECT_FALSE(file.Open(missing.c_str(), CFile::modeRead));
  file.GetLastErrorMessage(text, 8);
  EXPECT_EQ(std::wstring(text), (missing + L" does not exist.").substr(0, 7));
  file.GetLastErrorMessage(text, 1);
  EXPECT_STREQ(text, L"");
  text[0] = L'x';
  file.GetLastErrorMessage(text, 0);
  file.GetLastErrorMessage(nullptr, 8);
  EXPECT_EQ(text[0], L'x');
  EXPECT_FALSE(file.IsError(CCSVFile::kEndOfFile));
  EXPECT_TRUE(file.IsError(CCSVFile::kFileError));
}

class CsvWriteTest : public CsvReadTest {
 protected:
  void Create() {
    csv = std::make_unique<CCSVFile>();
    ASSERT_TRUE(csv->Open(dir.Path("out.csv").c_str(), CFile::modeCreate | CFile::modeWrite));
  }
  std::string Written() {
    csv->Close();
    return LumenUtility::testutil::ReadFileBytes(dir.NarrowPath("out.csv"));
  }
};

TEST_F(CsvWriteTest, FieldsNeedingQuotesAreQuotedWithInnerQuotesDoubled) {
  Create();
  unsigned status[5];
  EXPECT_TRUE(csv->WriteField("a", 0, &status[0]));
  EXPECT_TRUE(csv->WriteField("b\"c", 0, &status[1]));
  EXPECT_TRUE(csv->WriteField("d,e", 0, &status[2]));
  EXPECT_TRUE(csv->WriteEndOfLine(&status[3]));
  EXPECT_TRUE(csv->WriteField("plain", 1, &status[4]));
  EXPECT_TRUE(csv->WriteField("two\nlines", 0, nullptr));
  EXPECT_TRUE(csv->WriteEndOfLine(nullptr));
  EXPECT_EQ(Written(), "a,\"b\"\"c\",\"d,e\"\r\n\"plain\",\"two\nlines\"\r\n");
  EXPECT_EQ(std::vector<unsigned>(status, status + 5),
            (std::vector<unsigned>{CCSVFile::kField, CCSVFile::kQuotedField, CCSVFile::kQuotedField,
                                   CCSVFile::kEndOfLine, CCSVFile::kQuotedField}));
}

TEST_F(CsvWriteTest, WrittenFieldsReadBackUnchanged) {
  // Fields of commas, quotes, LFs, lone CRs and empty strings, also empty last fields.
  std::mt19937 random(12);
  const char alphabet[] = {'a', 'b', ',', '"', '\n', '\r', ' '};
  std::vector<std::vector<std::string>> lines(60);
  Create();
  for (std::vector<std::string>& line : lines) {
    const int fields = 1 + static_cast<int>(random() % 5);
    for (int f = 0; f < fields; ++f) {
      std::string field;
      for (int n = static_cast<int>(random() % 12); n > 0; --n) {
        const char c = alphabet[random() % sizeof alphabet];
        // CR LF and LF CR are line ends wherever they stand; keep them out of the text.
        if (!field.empty() && c != field.back() && (c == '\r' || c == '\n') &&
            (field.back() == '\r' || field.back() == '\n'))
          continue;
        field += c;
      }
      // A lone empty field writes an empty line, which reads as a line of no fields.
      if (fields == 1 && field.empty()) field = "e";
      line.push_back(field);
      ASSERT_TRUE(csv->WriteField(field, static_cast<int>(random() % 4 == 0), nullptr));
    }
    ASSERT_TRUE(csv->WriteEndOfLine(nullptr));
  }
  Written();
  csv = std::make_unique<CCSVFile>();
  ASSERT_TRUE(csv->Open(dir.Path("out.csv").c_str(), CFile::modeRead));
  for (const std::vector<std::string>& line : lines) {
    for (const std::string& expected : line) {
      std::string field;
      unsigned status;
      ASSERT_TRUE(csv->ReadField(field, &status));
      ASSERT_EQ(field, expected);
    }
    unsigned status;
    std::string rest;
    ASSERT_FALSE(csv->ReadField(rest, &status));
    ASSERT_EQ(status, CCSVFile::kEndOfLine);
    ASSERT_TRUE(csv->ReadEndOfLine(&status));
  }
  std::string rest;
  unsigned status;
  EXPECT_FALSE(csv->ReadField(rest, &status));
  EXPECT_EQ(status, CCSVFile::kEndOfFile);
}

TEST_F(CsvWriteTest, FullDiskIsReportedByTheLineEnd) {
  if (access("/dev/full", W_OK) != 0) GTEST_SKIP() << "no /dev/full";
  csv = std::make_unique<CCSVFile>();
  ASSERT_TRUE(csv->Open(L"/dev/full", CFile::modeWrite));
  unsigned status;
  EXPECT_TRUE(csv->WriteField("x", 0, &status));
  EXPECT_FALSE(csv->WriteEndOfLine(&status));
  EXPECT_EQ(status, CCSVFile::kFileError);
  EXPECT_EQ(LastError(), L"The disk is full while writing /dev/full.");
  // A closed file refuses fields.
  csv->Close();
  EXPECT_FALSE(csv->WriteField("x", 0, &status));
  EXPECT_EQ(status, CCSVFile::kFileError);
  EXPECT_EQ(LastError(), L"/dev/full is not open.");
}

}  // namespace
