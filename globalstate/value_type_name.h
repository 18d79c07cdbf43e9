// The names of value types as the parameter values write them (value_type_to_string).
#pragma once

#include <string>
#include <typeinfo>

namespace LumenUtility {

// Applies the naming rules to a run-time type name: a name shorter than 7 characters stays as
// it is; otherwise a leading keyword "class" or "enum", in any case, is dropped and the blank
// after it stays ("class Foo" gives " Foo").
std::string StripTypeKeyword(std::string name);

// The demangled run-time name of `type` ("double", "int", "Vela::BYPASS_SWITCH_STATE"),
// with StripTypeKeyword applied. The mangled name stands in when it cannot be demangled.
std::wstring ValueTypeName(const std::type_info& type);

}  // namespace LumenUtility
