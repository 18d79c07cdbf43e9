/** @file */
/// @class CCSVFile
/// CCSVFile: a comma-separated text file read and written field by field.
///
/// Reading: call ReadField until it reports the end of the line (status 3), then ReadEndOfLine,
/// and so on until the end of the file (status 4). Writing: WriteField for each field, then
/// WriteEndOfLine. Fields are 8-bit strings (UTF-8, the code page of this system) of at most
/// 1024 characters. A field is quoted with double quotes when it holds a comma, a double quote
/// or a line feed; inside quotes a double quote is doubled. CR LF and LF CR both end a line
/// (as does LF alone); a lone CR is part of a field.
///
/// Every operation returns nonzero on success and reports a status code through an optional
/// out-parameter (codes above 4 are errors):
///   0 an unquoted field was read or written      4 the end of the file: nothing more to read
///   1 a quoted field was read or written          5 a file error, message in the last error
///   2 the file ended inside a quoted field        6 a field too long, message in the last error
///   3 the end of a line
/// File errors never escape as exceptions; only std::bad_alloc does.
///
/// The object reads ahead 10 bytes at a time through the file it derives from; whatever the
/// positions of those reads in the text, the same fields and statuses result.
/// Thread-safety: confine to one thread. Ownership: the object owns its file and closes it when
/// destroyed.
#pragma once

#include <cstddef>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/cfile.h"

class LUMEN_API CCSVFile : protected CFile {
 public:
  /// A field holds at most this many characters.
  static constexpr std::size_t kMaxFieldLength = 1024;
  /// Capacity of the last-error text in wide characters, terminator included.
  static constexpr unsigned kErrorCapacity = 256;

  /// Outcome of reading one field or line.
  enum Status : unsigned {
    kField = 0,
    kQuotedField = 1,
    kOpenQuoteAtEnd = 2,
    kEndOfLine = 3,
    kEndOfFile = 4,
    kFileError = 5,
    kFieldTooLong = 6
  };

  CCSVFile();
  ~CCSVFile() override;

  // Hides the base's Open on purpose: the base is not public, and opening must reset the
  // reading state.
#if defined(__clang__)
#pragma clang diagnostic push
#pragma clang diagnostic ignored "-Woverloaded-virtual"
#endif
  /// Opens `path` with the file's open flags (CFile::modeRead, modeCreate | modeWrite, ...) and
  /// starts reading or writing at its first field. Returns nonzero on success; on failure the
  /// last error holds the reason (cut to 255 characters), or is empty when none can be had.
  int Open(const wchar_t* path, unsigned mode);
#if defined(__clang__)
#pragma clang diagnostic pop
#endif
  /// Closes the file; a failure to close is discarded (each line end has already handed its
  /// line to the system, see WriteEndOfLine). Closing a closed file does nothing.
  void Close() override;

  /// Reads the next field of the line into `field`. Nonzero with status 0 (unquoted), 1
  /// (quoted) or 2 (the file ended inside quotes; `field` holds what was read). Zero with status
  /// 3 at the end of the line (`field` empty; call ReadEndOfLine), 4 at the end of the file, 5
  /// on a file error, 6 when the field passed 1024 characters (`field` holds the first 1024;
  /// the file is left inside the field, so reading should stop). A line that ends in a comma
  /// has an empty last field.
  int ReadField(std::string& field, unsigned* status);
  /// Consumes a line end: nonzero with status 3. Zero with status 4 at the end of the file, 5 on
  /// a file error; zero with status and position unchanged when fields are left on the line.
  int ReadEndOfLine(unsigned* status);
  /// Writes `field`, preceded by a comma unless it is the first of its line, in quotes when
  /// `quote` is nonzero or the field needs them. Nonzero with status 1 (quoted) or 0; zero with
  /// status 5 on a file error.
  int WriteField(const std::string& field, int quote, unsigned* status);
  /// Writes CR LF and hands the line to the system, so that a full disk is reported here and
  /// not lost at Close. Nonzero with status 3; zero with status 5 on a file error.
  int WriteEndOfLine(unsigned* status);

  /// Nonzero for the error statuses (above 4).
  int IsError(unsigned status) const {
    return status > kEndOfFile;
  }
  /// Copies the last error into `text` (at most `size` characters with the terminator; a longer
  /// message is cut). Nothing is written when `text` is null or `size` is 0.
  void GetLastErrorMessage(wchar_t* text, unsigned size) const;

 protected:
  /// Passes a field of up to 1024 characters (nonzero). A longer one is cut to 1024, the last
  /// error becomes "Too long field; " and the cut field in double quotes, status 6, zero.
  int TestFieldLength(std::string& field, unsigned* status);
  /// Makes `buffer` non-empty if the file has characters left: reads 10 bytes at a time, turns
  /// CR LF and LF CR into LF and holds back a CR or LF at the end of a read until the next one
  /// shows whether it pairs. Returns zero when the file has nothing more.
  int RefillString(std::string& buffer);

 private:
  /// ReadField without the handling of file exceptions.
  int ReadFieldText(std::string& field, unsigned& status);
  /// The quoted part of a field, the opening quote at the start of the buffer.
  int ReadQuoted(std::string& field, unsigned& status);
  /// The unquoted part of a field, up to a comma (consumed) or a line feed (left).
  int ReadUnquoted(std::string& field, unsigned& status);
  /// The message of a file exception into the last error, status 5.
  void SetFileError(const CFileException& error, unsigned* status);
  void SetLastError(const std::wstring& message);
  static void SetStatus(unsigned* status, unsigned value) {
    if (status) *status = value;
  }

  wchar_t m_lastError[kErrorCapacity];
  int m_isOpen;
  char m_heldBack;
  int m_fieldIndex;
  std::string m_readBuffer;
  /// A field ended at a comma: the line has one more field even if a line end follows.
  bool m_fieldFollows;
};
