// Reads the input as the registry's configuration file. What reads must answer the second
// test set's values by type; what is refused must say so with a LumenException.
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "lumen/platform.h"
#include "platform/registry_ini_reader.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view text(reinterpret_cast<const char*>(data), size);
  LumenUtility::RegistryStore store;
  try {
    store = LumenUtility::RegistryIniReader::Parse(text);
  } catch (const LumenException& e) {
    if (e.GetMessage().rfind(L"registry configuration line ", 0) != 0) __builtin_trap();
    return 0;
  }
  const std::wstring key = L"HKEY_LOCAL_MACHINE\\SOFTWARE\\Corvane\\Network Analyzer";
  for (const wchar_t* name : {L"T2Mode", L"T2ClockPort", L"T2Name"}) {
    const LumenUtility::RegistryValue* value = store.Find(key, name);
    const bool isDword = store.QueryDword(key, name).has_value();
    const bool isString = store.QueryString(key, name).has_value();
    if (isDword && isString) __builtin_trap();  // one type per value
    if (value == nullptr && (isDword || isString)) __builtin_trap();
  }
  return 0;
}
