#include "lumen/data/csv_file.h"

#include <algorithm>
#include <cwchar>

#include "lumen/platform/text_conversion.h"

namespace {

// Bytes asked of the file per refill of the read-ahead buffer.
constexpr unsigned kReadAhead = 10;

bool IsLineEndByte(char c) {
  return c == '\r' || c == '\n';
}

// Replaces every CR LF and LF CR in `text` by one LF, scanning from the left so that of two
// overlapping pairs (CR LF CR) the first is taken. Returns whether the last character of the
// result is such a replacement.
bool CollapseLineEnds(std::string& text) {
  std::size_t out = 0;
  bool lastReplaced = false;
  const std::size_t n = text.size();
  for (std::size_t i = 0; i < n;) {
    const char c = text[i];
    if (i + 1 < n && IsLineEndByte(c) && IsLineEndByte(text[i + 1]) && c != text[i + 1]) {
      text[out++] = '\n';
      i += 2;
      lastReplaced = true;
    } else {
      text[out++] = c;
      ++i;
      lastReplaced = false;
    }
  }
  text.resize(out);
  return lastReplaced;
}

}  // namespace

CCSVFile::CCSVFile()
    : m_lastError{}, m_isOpen(0), m_heldBack(0), m_fieldIndex(1), m_fieldFollows(false) {}

CCSVFile::~CCSVFile() {
  Close();
}

int CCSVFile::Open(const wchar_t* path, unsigned mode) {
  m_heldBack = 0;
  m_fieldIndex = 1;
  m_readBuffer.clear();
  m_fieldFollows = false;
  CFileException error;
  m_isOpen = CFile::Open(path, mode, &error) ? 1 : 0;
  if (!m_isOpen) {
    wchar_t text[kErrorCapacity];
    SetLastError(error.GetErrorMessage(text, kErrorCapacity) ? text : L"");
  }
  return m_isOpen;
}

void CCSVFile::Close() {
  m_isOpen = 0;
  try {
    CFile::Close();
  } catch (const CFileException&) {
    // Discarded: every complete line has been handed to the system by WriteEndOfLine.
  }
}

int CCSVFile::RefillString(std::string& buffer) {
  if (!buffer.empty()) return 1;
  for (;;) {
    if (m_heldBack) {
      buffer += m_heldBack;
      m_heldBack = 0;
    }
    char bytes[kReadAhead];
    const unsigned got = m_isOpen ? Read(bytes, kReadAhead) : 0;
    if (got == 0) return buffer.empty() ? 0 : 1;
    buffer.append(bytes, got);
    const bool endReplaced = CollapseLineEnds(buffer);
    if (!endReplaced && IsLineEndByte(buffer.back())) {
      m_heldBack = buffer.back();
      buffer.pop_back();
    }
    if (!buffer.empty()) return 1;
    // The read's one byte was a line end, now held back: read on to see what follows it.
  }
}

int CCSVFile::TestFieldLength(std::string& field, unsigned* status) {
  if (field.size() <= kMaxFieldLength) return 1;
  field.resize(kMaxFieldLength);
  SetLastError(L"Too long field; \"" + LumenUtility::Utf8ToWide(field) + L"\"");
  SetStatus(status, kFieldTooLong);
  return 0;
}

int CCSVFile::ReadField(std::string& field, unsigned* status) {
  unsigned result = kField;
  try {
    const int ok = ReadFieldText(field, result);
    SetStatus(status, result);
    return ok;
  } catch (const CFileException& error) {
    SetFileError(error, status);
    return 0;
  }
}

int CCSVFile::ReadFieldText(std::string& field, unsigned& status) {
  field.clear();
  const bool fieldFollows = m_fieldFollows;
  m_fieldFollows = false;
  if (!RefillString(m_readBuffer)) {
    status = fieldFollows ? kField : kEndOfFile;
    return fieldFollows ? 1 : 0;
  }
  if (m_readBuffer[0] == '\n') {
    status = fieldFollows ? kField : kEndOfLine;
    return fieldFollows ? 1 : 0;
  }
  status = kField;
  if (m_readBuffer[0] == '"') {
    const int quoted = ReadQuoted(field, status);
    if (quoted >= 0) return quoted;
  }
  return ReadUnquoted(field, status);
}

int CCSVFile::ReadQuoted(std::string& field, unsigned& status) {
  for (;;) {
    m_readBuffer.erase(0, 1);  // the opening quote, or the second one of a doubled quote
    std::size_t quote;
    while ((quote = m_readBuffer.find('"')) == std::string::npos) {
      field += m_readBuffer;
      m_readBuffer.clear();
      if (!TestFieldLength(field, &status)) return 0;
      if (!RefillString(m_readBuffer)) {
        status = kOpenQuoteAtEnd;
        return 1;
      }
    }
    field.append(m_readBuffer, 0, quote);
    m_readBuffer.erase(0, quote + 1);
    if (!TestFieldLength(field, &status)) return 0;
    status = kQuotedField;
    if (!RefillString(m_readBuffer)) return 1;
    if (m_readBuffer[0] != '"') return -1;  // the closing quote; text up to a comma may follow
    field += '"';
  }
}

int CCSVFile::ReadUnquoted(std::string& field, unsigned& status) {
  std::size_t end;
  while ((end = m_readBuffer.find_first_of(",\n")) == std::string::npos) {
    field += m_readBuffer;
    m_readBuffer.clear();
    if (!TestFieldLength(field, &status)) return 0;
    if (!RefillString(m_readBuffer)) return 1;  // the field ends with the file
  }
  field.append(m_readBuffer, 0, end);
  const bool comma = m_readBuffer[end] == ',';
  m_readBuffer.erase(0, comma ? end + 1 : end);
  if (!TestFieldLength(field, &status)) return 0;
  m_fieldFollows = comma;
  return 1;
}

int CCSVFile::ReadEndOfLine(unsigned* status) {
  try {
    m_fieldFollows = false;
    if (!RefillString(m_readBuffer)) {
      SetStatus(status, kEndOfFile);
      return 0;
    }
    if (m_readBuffer[0] != '\n') return 0;
    m_readBuffer.erase(0, 1);
    SetStatus(status, kEndOfLine);
    return 1;
  } catch (const CFileException& error) {
    SetFileError(error, status);
    return 0;
  }
}

int CCSVFile::WriteField(const std::string& field, int quote, unsigned* status) {
  std::string text;
  text.reserve(field.size() + 3);
  if (m_fieldIndex != 1) text += ',';
  const bool quoted = quote || field.find_first_of("\n\",") != std::string::npos;
  if (quoted) {
    text += '"';
    for (const char c : field) {
      if (c == '"') text += '"';
      text += c;
    }
    text += '"';
  } else {
    text += field;
  }
  try {
    for (std::size_t done = 0; done < text.size();) {
      const unsigned piece =
          static_cast<unsigned>(std::min<std::size_t>(text.size() - done, 1u << 30));
      Write(text.data() + done, piece);
      done += piece;
    }
  } catch (const CFileException& error) {
    SetFileError(error, status);
    return 0;
  }
  ++m_fieldIndex;
  SetStatus(status, quoted ? kQuotedField : kField);
  return 1;
}

int CCSVFile::WriteEndOfLine(unsigned* status) {
  try {
    Write("\r\n", 2);
    Flush();
  } catch (const CFileException& error) {
    SetFileError(error, status);
    return 0;
  }
  m_fieldIndex = 1;
  SetStatus(status, kEndOfLine);
  return 1;
}

void CCSVFile::GetLastErrorMessage(wchar_t* text, unsigned size) const {
  if (!text || size == 0) return;
  const std::size_t length = std::min<std::size_t>(std::wcslen(m_lastError), size - 1);
  std::copy_n(m_lastError, length, text);
  text[length] = L'\0';
}

void CCSVFile::SetFileError(const CFileException& error, unsigned* status) {
  wchar_t text[kErrorCapacity];
  SetLastError(error.GetErrorMessage(text, kErrorCapacity) ? text : L"");
  SetStatus(status, kFileError);
}

void CCSVFile::SetLastError(const std::wstring& message) {
  const std::size_t length = std::min<std::size_t>(message.size(), kErrorCapacity - 1);
  std::copy_n(message.data(), length, m_lastError);
  m_lastError[length] = L'\0';
}
