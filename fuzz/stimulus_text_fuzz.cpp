// Feeds arbitrary text to the stimulus readers: the array form, then a bare segment, and
// uses whatever they accept.
#include <cstddef>
#include <cstdint>
#include <exception>
#include <sstream>
#include <string_view>

#include "lumen/platform.h"
#include "lumen/stimulus.h"

namespace {

// Larger arrays are valid but only slow the fuzzer down.
constexpr unsigned int kMaxPointsToExpand = 100000;

void ReadArray(const std::wstring& text) {
  std::wistringstream in(text);
  LumenUtility::InputArray array;
  in >> array;
  if (in.fail() || array.size() > kMaxPointsToExpand) return;
  array.GetRawArray();
  array.IsMonotonic();
  std::wostringstream out;
  out << array;
}

void ReadSegment(const std::wstring& text) {
  std::wistringstream in(text);
  LumenUtility::Segment segment;
  in >> segment;
  if (in.fail() || segment.empty() || segment.size() > kMaxPointsToExpand) return;
  segment.GetArray();
  segment.Find(1.0, false);
  segment.Find(1.0, true);
}

template <typename F>
void IgnoringDocumentedErrors(F f) {
  try {
    f();
  } catch (const std::exception&) {
    // Documented rejections, such as a logarithmic sweep through zero.
  } catch (HRESULT) {
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::wstring text =
      LumenUtility::Utf8ToWide(std::string_view(reinterpret_cast<const char*>(data), size));
  IgnoringDocumentedErrors([&] { ReadArray(text); });
  IgnoringDocumentedErrors([&] { ReadSegment(text); });
  return 0;
}
