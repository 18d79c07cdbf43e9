// Reads arbitrary text as an INI profile: every lookup must be safe, writing the document
// back and reading it again must change nothing, and a value set is the value read back.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "lumen/platform.h"
#include "platform/ini_document.h"

namespace {

using LumenUtility::IniDocument;

void Check(bool condition) {
  if (!condition) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::wstring text =
      LumenUtility::Utf8ToWide(std::string_view(reinterpret_cast<const char*>(data), size));
  IniDocument document = IniDocument::Parse(text);
  const std::wstring written = document.Text();
  Check(IniDocument::Parse(written).Text() == written);

  // Names and a value from the input itself: the first three pieces between line ends.
  std::wstring pieces[3];
  std::size_t start = 0;
  for (std::wstring& piece : pieces) {
    const std::size_t end = std::min(text.find(L'\n', start), text.size());
    piece = text.substr(start, end - start);
    start = std::min(end + 1, text.size());
  }
  const std::wstring& section = pieces[0];
  const std::wstring& entry = pieces[1];
  const std::wstring& value = pieces[2];
  document.Find(section, entry);
  const bool stored = document.Set(section, entry, value);
  Check(stored == IniDocument::CanStore(section, entry, value));
  if (stored) {
    Check(document.Find(section, entry) == value);
    Check(IniDocument::Parse(document.Text()).Find(section, entry) == value);
  }

  LumenUtility::IniProfileStore store;  // in memory
  if (store.WriteProfileString(L"S", L"n", value)) {
    Check(store.GetProfileString(L"S", L"n", L"") == value);
    store.GetProfileInt(L"S", L"n", 0);
  }
  return 0;
}
