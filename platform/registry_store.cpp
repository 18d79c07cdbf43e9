#include "lumen/platform/registry_store.h"

#include <stdexcept>

#include "platform/ascii_case.h"

namespace LumenUtility {

namespace {

std::wstring Folded(std::wstring text) {
  for (wchar_t& c : text) c = AsciiLower(c);
  return text;
}

}  // namespace

RegistryStore::Key RegistryStore::MakeKey(const std::wstring& keyPath, const std::wstring& name) {
  std::wstring path = keyPath;
  while (!path.empty() && path.back() == L'\\') path.pop_back();
  return Key(Folded(std::move(path)), Folded(name));
}

void RegistryStore::SetDword(const std::wstring& keyPath, const std::wstring& name,
                             std::uint32_t value) {
  RegistryValue entry;
  entry.type = REG_DWORD;
  entry.dword = value;
  SetValue(keyPath, name, std::move(entry));
}

void RegistryStore::SetString(const std::wstring& keyPath, const std::wstring& name,
                              const std::wstring& text, std::uint32_t type) {
  if (type != REG_SZ && type != REG_EXPAND_SZ) {
    throw std::invalid_argument("RegistryStore::SetString: type must be REG_SZ or REG_EXPAND_SZ");
  }
  RegistryValue entry;
  entry.type = type;
  entry.text = text;
  SetValue(keyPath, name, std::move(entry));
}

void RegistryStore::SetValue(const std::wstring& keyPath, const std::wstring& name,
                             RegistryValue value) {
  m_values[MakeKey(keyPath, name)] = std::move(value);
}

const RegistryValue* RegistryStore::Find(const std::wstring& keyPath,
                                         const std::wstring& name) const {
  const auto found = m_values.find(MakeKey(keyPath, name));
  return found == m_values.end() ? nullptr : &found->second;
}

std::optional<std::uint32_t> RegistryStore::QueryDword(const std::wstring& keyPath,
                                                       const std::wstring& name) const {
  const RegistryValue* value = Find(keyPath, name);
  if (value == nullptr || value->type != REG_DWORD) return std::nullopt;
  return value->dword;
}

std::optional<std::wstring> RegistryStore::QueryString(const std::wstring& keyPath,
                                                       const std::wstring& name) const {
  const RegistryValue* value = Find(keyPath, name);
  if (value == nullptr || (value->type != REG_SZ && value->type != REG_EXPAND_SZ)) {
    return std::nullopt;
  }
  return value->text;
}

}  // namespace LumenUtility
