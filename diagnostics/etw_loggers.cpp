#include <string>

#include "diagnostics/etw_logging.h"
#include "diagnostics/etw_provider.h"
#include "lumen/platform/text_conversion.h"

namespace LumenUtility {
namespace {

// The text as the payload carries it: UTF-16LE with a terminating zero unit.
std::string PayloadText(const wchar_t* text) {
  std::string bytes = WideToUtf16LeBytes(text != nullptr ? text : L"NULL");
  bytes.append(2, '\0');
  return bytes;
}

}  // namespace

bool ETWLogging::Logger::IsEnabled() const {
  return ETWProvider::IsEnabled(*m_pDescriptor);
}

void ETWLogging::Logger_NONE::WriteEvent(std::int32_t, const wchar_t*) {
  if (!IsEnabled()) return;
  ETWProvider::Write(*m_pDescriptor, 0, nullptr);
}

void ETWLogging::Logger_INT::WriteEvent(std::int32_t value, const wchar_t*) {
  if (!IsEnabled()) return;
  EVENT_DATA_DESCRIPTOR data;
  EventDataDescCreate(&data, &value, sizeof value);
  ETWProvider::Write(*m_pDescriptor, 1, &data);
}

void ETWLogging::Logger_STRING::WriteEvent(std::int32_t, const wchar_t* text) {
  if (!IsEnabled()) return;
  const std::string bytes = PayloadText(text);
  EVENT_DATA_DESCRIPTOR data;
  EventDataDescCreate(&data, bytes.data(), static_cast<std::uint32_t>(bytes.size()));
  ETWProvider::Write(*m_pDescriptor, 1, &data);
}

void ETWLogging::Logger_INT_STRING::WriteEvent(std::int32_t value, const wchar_t* text) {
  if (!IsEnabled()) return;
  const std::string bytes = PayloadText(text);
  EVENT_DATA_DESCRIPTOR data[2];
  EventDataDescCreate(&data[0], &value, sizeof value);
  EventDataDescCreate(&data[1], bytes.data(), static_cast<std::uint32_t>(bytes.size()));
  ETWProvider::Write(*m_pDescriptor, 2, data);
}

}  // namespace LumenUtility
