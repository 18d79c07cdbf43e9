#include "lumen/platform/event_trace.h"

#include <cstdio>
#include <cstring>

#include "platform/trace_registry.h"

namespace LumenUtility {

bool operator==(const GUID& a, const GUID& b) {
  return a.Data1 == b.Data1 && a.Data2 == b.Data2 && a.Data3 == b.Data3 &&
         std::memcmp(a.Data4, b.Data4, sizeof a.Data4) == 0;
}

std::string GuidToString(const GUID& guid) {
  char text[39];
  std::snprintf(text, sizeof text, "{%08X-%04X-%04X-%02X%02X-%02X%02X%02X%02X%02X%02X}",
                static_cast<unsigned>(guid.Data1), guid.Data2, guid.Data3, guid.Data4[0],
                guid.Data4[1], guid.Data4[2], guid.Data4[3], guid.Data4[4], guid.Data4[5],
                guid.Data4[6], guid.Data4[7]);
  return text;
}

std::uint32_t EventRegister(const GUID* providerId, PENABLECALLBACK enableCallback,
                            void* callbackContext, REGHANDLE* regHandle) {
  if (providerId == nullptr || regHandle == nullptr) return ERROR_INVALID_PARAMETER;
  return TraceRegistry::Instance().Register(*providerId, enableCallback, callbackContext,
                                            *regHandle);
}

std::uint32_t EventUnregister(REGHANDLE regHandle) {
  return TraceRegistry::Instance().Unregister(regHandle);
}

std::uint32_t EventWrite(REGHANDLE regHandle, const EVENT_DESCRIPTOR* eventDescriptor,
                         std::uint32_t userDataCount, EVENT_DATA_DESCRIPTOR* userData) {
  if (eventDescriptor == nullptr) return ERROR_INVALID_PARAMETER;
  return TraceRegistry::Instance().Write(regHandle, *eventDescriptor, userDataCount, userData);
}

}  // namespace LumenUtility
