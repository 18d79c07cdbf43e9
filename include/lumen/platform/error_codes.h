/// @file
/// Result codes of the analyzer software.
///
/// Codes are 32-bit HRESULT-style values: bit 31 set means failure. The library's own
/// facility codes (0xE808xxxx) and the platform's general ones are named here; callers that
/// throw a bare code throw an HRESULT by value.
#pragma once

#include <cstdint>

/// A result code: negative for failure, 0 or positive for success.
using HRESULT = std::int32_t;

namespace LumenUtility {

/// The result code of the 32-bit pattern `bits` as written in hexadecimal.
constexpr HRESULT MakeHResult(std::uint32_t bits) {
  return static_cast<HRESULT>(bits);
}

///@{
/// The standard result codes, with their usual numbers: success (S_OK), success with a
/// false answer (S_FALSE), not implemented, null pointer, unspecified failure, unexpected
/// state, out of memory, invalid argument.
inline constexpr HRESULT S_OK = 0;
inline constexpr HRESULT S_FALSE = 1;
inline constexpr HRESULT E_NOTIMPL = MakeHResult(0x80004001);
inline constexpr HRESULT E_POINTER = MakeHResult(0x80004003);
inline constexpr HRESULT E_FAIL = MakeHResult(0x80004005);
inline constexpr HRESULT E_UNEXPECTED = MakeHResult(0x8000FFFF);
inline constexpr HRESULT E_OUTOFMEMORY = MakeHResult(0x8007000E);
inline constexpr HRESULT E_INVALIDARG = MakeHResult(0x80070057);
///@}

/// Bounds, state, format or version failure; also every phase reference failure.
inline constexpr HRESULT LUMEN_E_BOUNDS = MakeHResult(0xE8080882);
/// Archived data written by an unknown (newer) version.
inline constexpr HRESULT LUMEN_E_UNKNOWN_VERSION = MakeHResult(0xE8080867);
/// A vector kernel could not obtain its temporary buffer.
inline constexpr HRESULT LUMEN_E_KERNEL_BUFFER = MakeHResult(0xE8040453);

/// True for a failure code (negative).
constexpr bool Failed(HRESULT hr) {
  return hr < 0;
}
/// True for a success code (0 or positive).
constexpr bool Succeeded(HRESULT hr) {
  return hr >= 0;
}

}  // namespace LumenUtility
