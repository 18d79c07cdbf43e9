// Text forms shared by the parameter value classes.
#pragma once

#include <locale>
#include <sstream>
#include <string>
#include <typeinfo>

#include "globalstate/value_type_name.h"

namespace LumenUtility {

// `value` as a wide output stream writes it by default (six significant digits for a
// double). The classic locale keeps the text the same whatever locale the host sets.
template <class T>
std::wstring ValueText(const T& value) {
  std::wostringstream out;
  out.imbue(std::locale::classic());
  out << value;
  return out.str();
}

// The name of T as value_type_to_string shows it, worked out once per type.
template <class T>
const std::wstring& ValueTypeText() {
  static const std::wstring name = ValueTypeName(typeid(T));
  return name;
}

}  // namespace LumenUtility
