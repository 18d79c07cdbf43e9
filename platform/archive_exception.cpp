#include "lumen/platform/archive_exception.h"

#include "lumen/platform/text_conversion.h"
#include "platform/error_message.h"

namespace {

const wchar_t* PatternFor(int cause) {
  switch (cause) {
    case CArchiveException::none:
      return L"No error occurred in the archive of %s.";
    case CArchiveException::readOnly:
      return L"Tried to write to the archive of %s, which is open for loading.";
    case CArchiveException::endOfFile:
      return L"The archive of %s ended unexpectedly.";
    case CArchiveException::writeOnly:
      return L"Tried to read from the archive of %s, which is open for storing.";
    case CArchiveException::badIndex:
      return L"The archive of %s has an invalid format.";
    case CArchiveException::badClass:
      return L"The archive of %s holds an unexpected object.";
    case CArchiveException::badSchema:
      return L"The archive of %s was written by an unsupported version.";
    default:
      return L"An unexpected error occurred in the archive of %s.";
  }
}

}  // namespace

CArchiveException::CArchiveException(int cause, const wchar_t* fileName)
    : m_cause(cause), m_strFileName(fileName ? fileName : L"") {
  m_what = LumenUtility::WideToUtf8(GetErrorMessage());
}

int CArchiveException::GetErrorMessage(wchar_t* buffer, unsigned maxChars,
                                       unsigned* helpContext) const {
  return LumenUtility::CopyMessage(GetErrorMessage(), buffer, maxChars, helpContext);
}

std::wstring CArchiveException::GetErrorMessage() const {
  return LumenUtility::NameInMessage(PatternFor(m_cause), m_strFileName);
}

const char* CArchiveException::what() const noexcept {
  return m_what.c_str();
}
