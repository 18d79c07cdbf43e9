#include "lumen/platform/file_exception.h"

#include <cerrno>

#include "lumen/platform/text_conversion.h"
#include "platform/error_message.h"

namespace {

const wchar_t* PatternFor(int cause) {
  switch (cause) {
    case CFileException::none:
      return L"No error occurred while accessing %s.";
    case CFileException::fileNotFound:
      return L"%s does not exist.";
    case CFileException::badPath:
      return L"The path of %s is not valid.";
    case CFileException::tooManyOpenFiles:
      return L"%s could not be opened: too many files are open.";
    case CFileException::accessDenied:
      return L"Access to %s was refused.";
    case CFileException::invalidFile:
      return L"%s is not open.";
    case CFileException::removeCurrentDir:
      return L"%s is the current directory and cannot be removed.";
    case CFileException::directoryFull:
      return L"%s could not be created: the directory is full.";
    case CFileException::badSeek:
      return L"Cannot move to that position in %s.";
    case CFileException::hardIO:
      return L"A device input/output error occurred on %s.";
    case CFileException::sharingViolation:
      return L"%s is in use by another program.";
    case CFileException::lockViolation:
      return L"Part of %s is locked.";
    case CFileException::diskFull:
      return L"The disk is full while writing %s.";
    case CFileException::endOfFile:
      return L"Tried to read past the end of %s.";
    default:
      return L"An unexpected error occurred while accessing %s.";
  }
}

}  // namespace

CFileException::CFileException(int cause, std::int32_t osError, const wchar_t* fileName)
    : m_cause(cause), m_lOsError(osError), m_strFileName(fileName ? fileName : L"") {
  m_what = LumenUtility::WideToUtf8(GetErrorMessage());
}

int CFileException::OsErrorToException(std::int32_t osError) {
  switch (osError) {
    case 0:
      return none;
    case ENOENT:
      return fileNotFound;
    case ENOTDIR:
    case ENAMETOOLONG:
    case ELOOP:
    case EINVAL:
      return badPath;
    case EMFILE:
    case ENFILE:
      return tooManyOpenFiles;
    case EACCES:
    case EPERM:
    case EISDIR:
    case EROFS:
      return accessDenied;
    case EBADF:
      return invalidFile;
    case ESPIPE:
      return badSeek;
    case EIO:
      return hardIO;
    case EBUSY:
    case ETXTBSY:
      return sharingViolation;
    case EAGAIN:
      return lockViolation;
    case ENOSPC:
    case EDQUOT:
    case EFBIG:
      return diskFull;
    default:
      return genericException;
  }
}

void CFileException::ThrowOsError(std::int32_t osError, const wchar_t* fileName) {
  throw CFileException(OsErrorToException(osError), osError, fileName);
}

int CFileException::GetErrorMessage(wchar_t* buffer, unsigned maxChars,
                                    unsigned* helpContext) const {
  return LumenUtility::CopyMessage(GetErrorMessage(), buffer, maxChars, helpContext);
}

std::wstring CFileException::GetErrorMessage() const {
  return LumenUtility::NameInMessage(PatternFor(m_cause), m_strFileName);
}

const char* CFileException::what() const noexcept {
  return m_what.c_str();
}
