#include <string>

#include "diagnostics/etw_logging.h"
#include "lumen/diagnostics/event_tracing.h"
#include "lumen/platform/text_conversion.h"

namespace LumenUtility {
namespace {

// The logger of `id` when TPrint is on and the event exists; null otherwise. With tracing
// off this costs a pointer test and a flag test.
boost::shared_ptr<ETWLogging::Logger> ActiveLogger(short id) {
  const ETWLogging* const logging = ETWLogging::Current();
  if (logging == nullptr || !logging->IsTPrintEnabled()) return {};
  return ETWLogging::FindLogger(id);
}

}  // namespace

void TPrint(short id, std::int32_t value, const wchar_t* text) {
  if (const boost::shared_ptr<ETWLogging::Logger> logger = ActiveLogger(id)) {
    logger->WriteEvent(value, text);
  }
}

void TPrint(short id, std::int32_t value, const char* text) {
  const boost::shared_ptr<ETWLogging::Logger> logger = ActiveLogger(id);
  // The text is converted only for an event that is written.
  if (!logger || !logger->IsEnabled()) return;
  if (text == nullptr) {
    logger->WriteEvent(value, nullptr);
  } else {
    logger->WriteEvent(value, Utf8ToWide(text).c_str());
  }
}

void TPrint(short id) {
  TPrint(id, 0, L"");
}

void TPrint(short id, std::int32_t value) {
  TPrint(id, value, L"");
}

void TPrint(short id, const wchar_t* text) {
  TPrint(id, 0, text);
}

void TPrint(short id, const char* text) {
  TPrint(id, 0, text);
}

}  // namespace LumenUtility
