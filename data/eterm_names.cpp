#include "lumen/data/eterm_names.h"

#include <cstdint>
#include <string_view>

namespace LumenUtility {
namespace {

constexpr const wchar_t* kResponseTracking = L"ResponseTracking";
constexpr const wchar_t* kSourcePowerCorrection = L"SourcePowerCorrection";

// One-based text of a zero-based number. Widened first so that INT_MAX gives 2147483648
// instead of overflowing.
std::wstring OneBased(int zeroBased) {
  return std::to_wstring(static_cast<std::int64_t>(zeroBased) + 1);
}

// prefix + term + "(" + inner + ")".
std::wstring Compose(const std::wstring& prefix, std::wstring_view term,
                     const std::wstring& inner) {
  std::wstring name = prefix;
  name += term;
  name += L'(';
  name += inner;
  name += L')';
  return name;
}

}  // namespace

const wchar_t* const gETermNames[kETermNameCount + 1] = {
    L"Directivity",
    L"SourceMatch",
    L"ReflectionTracking",
    L"ResponseTracking",
    L"TranmissionTracking",
    L"LoadMatch",
    L"CrossTalk",
    L"SourcePowerCorrection",
    L"PowerSensorMatch",
    L"PowerAdapter:",
    L"PowerMeterReading",
    L"PowerReferenceReading",
    L"",
};

std::wstring eterm_name(const std::wstring& term, int i, int j) {
  return Compose(std::wstring(), term, OneBased(i) + L',' + OneBased(j));
}

std::wstring eterm_name(const std::wstring& term, int i) {
  return Compose(std::wstring(), term, OneBased(i));
}

std::wstring reference_eterm_name(int port, const std::wstring& prefix) {
  return Compose(prefix, kResponseTracking, L'R' + OneBased(port));
}

std::wstring test_rcv_eterm_name(int port, const std::wstring& prefix) {
  return Compose(prefix, kResponseTracking,
                 std::wstring(1, static_cast<wchar_t>(std::int64_t{L'A'} + port)));
}

std::wstring reference_eterm_name_Kestrel(int port, const std::wstring& prefix) {
  return Compose(prefix, kResponseTracking, L'a' + OneBased(port));
}

std::wstring test_rcv_eterm_name_Kestrel(int port, const std::wstring& prefix) {
  return Compose(prefix, kResponseTracking, L'b' + OneBased(port));
}

std::wstring src_cal_eterm_name(int port, const std::wstring& prefix) {
  return Compose(prefix, kSourcePowerCorrection, OneBased(port));
}

}  // namespace LumenUtility
