#include "lumen/platform/shared_library.h"

#include <dlfcn.h>

#include "lumen/platform/text_conversion.h"
#include "platform/ascii_case.h"

namespace LumenUtility {

std::string SharedObjectFileName(std::wstring_view moduleName) {
  const std::size_t slash = moduleName.rfind(L'/');
  const std::wstring_view directory =
      slash == std::wstring_view::npos ? std::wstring_view() : moduleName.substr(0, slash + 1);
  std::wstring_view stem = moduleName.substr(directory.size());
  constexpr std::wstring_view kDll = L".dll";
  if (stem.size() > kDll.size() && EqualsNoCase(stem.substr(stem.size() - kDll.size()), kDll)) {
    stem.remove_suffix(kDll.size());
  }
  if (stem.empty()) return std::string();
  return WideToUtf8(directory) + "lib" + WideToUtf8(stem) + ".so";
}

HMODULE LoadLibraryW(const wchar_t* moduleName) {
  if (moduleName == nullptr) return nullptr;
  const std::string file = SharedObjectFileName(moduleName);
  if (file.empty()) return nullptr;
  // RTLD_NODELETE keeps the library mapped even if some other code dlcloses the handle, so
  // stored entry points can never dangle.
  return ::dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
}

void* GetProcAddress(HMODULE module, const char* exportName) {
  if (module == nullptr || exportName == nullptr) return nullptr;
  return ::dlsym(module, exportName);
}

}  // namespace LumenUtility
