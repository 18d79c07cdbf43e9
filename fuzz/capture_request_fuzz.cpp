// Request names handed to the data capture service, one per line of the input: each is
// either refused with 0x80070057 or read as a request that prints back to an equivalent name,
// and the accepted ones take regions that follow each other without a gap inside the largest
// block the service makes.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "capture/request_name_parser.h"
#include "lumen/capture/data_capture.h"
#include "lumen/platform/text_conversion.h"

namespace {

std::wstring Canonical(const DataRequest& r) {
  const wchar_t* type = r.isComplex ? L"SDATA" : r.isCal ? L"CAL" : L"FDATA";
  return std::to_wstring(r.channel) + L":" + std::to_wstring(r.measurement) + L":" + type + L":" +
         std::to_wstring(r.count);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  DataCapture::Create();
  DataCapture& service = DataCapture::Instance();
  service.Initialize();
  std::string_view text(reinterpret_cast<const char*>(data), size);
  std::uint32_t expectedOffset = 0;
  while (!text.empty()) {
    const std::size_t end = text.find('\n');
    const std::wstring name = LumenUtility::Utf8ToWide(text.substr(0, end));
    text = end == std::string_view::npos ? std::string_view() : text.substr(end + 1);

    bool parsed = false;
    try {
      const DataRequest request = LumenUtility::RequestNameParser::Parse(name);
      parsed = true;
      if (request.channel < 1 || request.measurement < 1 || request.count == 0) std::abort();
      if (LumenUtility::RequestNameParser::Parse(Canonical(request)).Size() != request.Size()) {
        std::abort();
      }
      const std::uint32_t offset = service.AddRequest(name);
      if (offset != expectedOffset) std::abort();
      expectedOffset = service.ComputeSizeOfPending();
      if (expectedOffset > LumenUtility::kMaxCaptureFloats || expectedOffset < offset) std::abort();
    } catch (std::int32_t code) {
      // A refused name, or an accepted one that no longer fits the block.
      if (code != LumenUtility::E_INVALIDARG) std::abort();
      if (parsed && service.ComputeSizeOfPending() != expectedOffset) std::abort();
    }
  }
  DataCapture::Destroy();
  return 0;
}
