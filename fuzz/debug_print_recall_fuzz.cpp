// Recalls the debug print settings from an arbitrary INI profile: the slots must follow the
// stored string exactly, and saving must give back a string of 256 '0' and '1' characters
// that agrees with the slots. The file device stays off, so nothing is written to disk.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "lumen/diagnostics.h"
#include "lumen/platform.h"
#include "platform/ini_document.h"

namespace {

using LumenUtility::IniDocument;

void Check(bool condition) {
  if (!condition) std::abort();
}

// A profile over a parsed document, except that the file device is always stored off.
class DocumentProfile : public LumenUtility::IProfileStore {
 public:
  explicit DocumentProfile(IniDocument document) : m_document(std::move(document)) {}
  std::wstring GetProfileString(const std::wstring& section, const std::wstring& entry,
                                const std::wstring& defaultValue) override {
    return m_document.Find(section, entry).value_or(defaultValue);
  }
  int WriteProfileString(const std::wstring& section, const std::wstring& entry,
                         const std::wstring& value) override {
    return m_document.Set(section, entry, value) ? 1 : 0;
  }
  std::int32_t GetProfileInt(const std::wstring&, const std::wstring&, std::int32_t) override {
    return 0;
  }
  int WriteProfileInt(const std::wstring&, const std::wstring&, std::int32_t) override {
    return 1;
  }

 private:
  IniDocument m_document;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::wstring text =
      LumenUtility::Utf8ToWide(std::string_view(reinterpret_cast<const char*>(data), size));
  DocumentProfile profile(IniDocument::Parse(text));
  LumenUtility::SetProfileStore(&profile);
  for (int slot = 0; slot < 256; ++slot) gDebugPrint.SetOn(slot, slot % 3 == 0);

  const std::wstring slots = profile.GetProfileString(L"Debug", L"Debug Print", L"");
  gDebugPrint.RecallSettings();
  for (int slot = 0; slot < 256; ++slot) {
    const bool expected = static_cast<std::size_t>(slot) < slots.size()
                              ? slots[static_cast<std::size_t>(slot)] == L'1'
                              : slot % 3 == 0;
    Check(gDebugPrint.IsOn(slot) == expected);
  }
  Check(!gDebugPrint.IsDeviceOn(CDebugPrint::File));

  gDebugPrint.SaveSettings();
  const std::wstring saved = profile.GetProfileString(L"Debug", L"Debug Print", L"");
  Check(saved.size() == 256);
  for (int slot = 0; slot < 256; ++slot) {
    Check(saved[static_cast<std::size_t>(slot)] == (gDebugPrint.IsOn(slot) ? L'1' : L'0'));
  }
  LumenUtility::SetProfileStore(nullptr);
  return 0;
}
