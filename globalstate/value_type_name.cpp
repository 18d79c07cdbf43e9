#include "globalstate/value_type_name.h"

#include <cxxabi.h>

#include <cstdlib>
#include <memory>
#include <string_view>

#include "lumen/platform/text_conversion.h"
#include "platform/ascii_case.h"

namespace LumenUtility {

std::string StripTypeKeyword(std::string name) {
  if (name.size() < 7) return name;
  const std::string_view view = name;
  for (const std::string_view keyword : {std::string_view("class"), std::string_view("enum")}) {
    if (StartsWithNoCase(view, keyword)) return name.substr(keyword.size());
  }
  return name;
}

std::wstring ValueTypeName(const std::type_info& type) {
  int status = 0;
  const std::unique_ptr<char, void (*)(void*)> demangled(
      abi::__cxa_demangle(type.name(), nullptr, nullptr, &status), std::free);
  const std::string name = status == 0 && demangled ? demangled.get() : type.name();
  return Utf8ToWide(StripTypeKeyword(name));
}

}  // namespace LumenUtility
