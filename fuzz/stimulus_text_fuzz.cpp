// Feeds arbitrary text to the stimulus readers: the array form, then a bare segment.
#include <cstddef>
#include <cstdint>
#include <sstream>
#include <string_view>

#include "lumen/platform.h"
#include "lumen/stimulus.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::wstring text = LumenUtility::Utf8ToWide(
      std::string_view(reinterpret_cast<const char*>(data), size));
  {
    std::wistringstream in(text);
    LumenUtility::InputArray array;
    in >> array;
    if (!in.fail() && array.size() < 100000) {
      array.GetRawArray();
      std::wostringstream out;
      out << array;
    }
  }
  {
    std::wistringstream in(text);
    LumenUtility::Segment segment;
    in >> segment;
    if (!in.fail() && segment.size() > 0 && segment.size() < 100000) {
      segment.GetArray();
      segment.Find(1.0, false);
    }
  }
  return 0;
}
