// The simulated phase reference driver: the nine driver entry points over a table of
// simulated devices, plus the control functions of ferrule_rev7_control.h.
//
// Built twice: as the complete driver, and with FERRULE_SIM_WITHOUT_GET_MODEL defined as a
// driver whose last entry point is missing (a driver of the wrong revision).
#include <cstring>
#include <string>
#include <string_view>

#include "simulators/ferrule_rev7/ferrule_rev7_control.h"

#define FERRULE_EXPORT extern "C" __attribute__((visibility("default")))

namespace {

// The driver's callers hand in buffers of this size.
constexpr std::size_t kTextBufferBytes = 1000;
constexpr const char* kAccessString = "tamarin47261";

enum Export : int {
  kStart,
  kCount,
  kRatio1,
  kRatio2,
  kRatio4,
  kRatio8,
  kRatio16,
  kSerial,
  kModel,
  kExportCount
};

constexpr const char* kExportNames[kExportCount] = {
    "startHalcyon", "getNumConnectedDevice", "makeRatio1",      "makeRatio2", "makeRatio4",
    "makeRatio8",   "makeRatio16",           "getSerialNumber", "getModel"};

struct Device {
  std::string model;
  std::string serialNumber;
  bool started = false;
  int divideRatio = 0;
};

struct Simulator {
  int deviceCount = 1;
  Device devices[FERRULE_SIM_MAX_DEVICES];
  int failure[kExportCount] = {};
  int calls[kExportCount] = {};
  std::string lastAccess;

  Simulator() {
    for (int d = 0; d < FERRULE_SIM_MAX_DEVICES; ++d) {
      devices[d].model = "Ferrule rev7 (simulated)";
      devices[d].serialNumber =
          "FR7-SIM-" + std::string(d < 9 ? "000" : "00") + std::to_string(d + 1);
    }
  }
};

Simulator& State() {
  static Simulator simulator;
  return simulator;
}

int ExportIndex(const char* name) {
  if (name == nullptr) return -1;
  for (int i = 0; i < kExportCount; ++i) {
    if (std::strcmp(kExportNames[i], name) == 0) return i;
  }
  return -1;
}

bool ValidDevice(int device) {
  return device >= 0 && device < State().deviceCount;
}

// Counts the call; gives the configured failure code, 0 when the call is to go ahead.
int Enter(Export e) {
  ++State().calls[e];
  return State().failure[e];
}

// Copies `text` into the caller's buffer as the device would: at most the buffer's size, and
// without a terminating zero when the text fills it.
void CopyOut(char* buffer, const std::string& text) {
  const std::size_t n = text.size() < kTextBufferBytes ? text.size() + 1 : kTextBufferBytes;
  std::memcpy(buffer, text.c_str(), n);
}

int MakeRatio(Export e, int ratio, int device) {
  if (const int failure = Enter(e)) return failure;
  if (!ValidDevice(device)) return 1;
  Device& d = State().devices[device];
  if (!d.started) return 4;
  d.divideRatio = ratio;
  return 0;
}

int SetText(int device, const char* text, std::string Device::*field) {
  if (device < 0 || device >= FERRULE_SIM_MAX_DEVICES || text == nullptr) return -1;
  State().devices[device].*field = text;
  return 0;
}

}  // namespace

FERRULE_EXPORT int startHalcyon(char* access, int device) {
  if (const int failure = Enter(kStart)) return failure;
  State().lastAccess = access != nullptr ? access : "";
  if (State().lastAccess != kAccessString) return 3;
  if (!ValidDevice(device)) return 1;
  State().devices[device].started = true;
  return 0;
}

FERRULE_EXPORT int getNumConnectedDevice() {
  if (const int failure = Enter(kCount)) return failure;
  return State().deviceCount;
}

FERRULE_EXPORT int makeRatio1(int device) {
  return MakeRatio(kRatio1, 1, device);
}
FERRULE_EXPORT int makeRatio2(int device) {
  return MakeRatio(kRatio2, 2, device);
}
FERRULE_EXPORT int makeRatio4(int device) {
  return MakeRatio(kRatio4, 4, device);
}
FERRULE_EXPORT int makeRatio8(int device) {
  return MakeRatio(kRatio8, 8, device);
}
FERRULE_EXPORT int makeRatio16(int device) {
  return MakeRatio(kRatio16, 16, device);
}

FERRULE_EXPORT int getSerialNumber(char* buffer, int device) {
  if (const int failure = Enter(kSerial)) return failure;
  if (!ValidDevice(device) || buffer == nullptr) return 1;
  CopyOut(buffer, State().devices[device].serialNumber);
  return 0;
}

#ifndef FERRULE_SIM_WITHOUT_GET_MODEL
FERRULE_EXPORT int getModel(char* buffer, int device) {
  if (const int failure = Enter(kModel)) return failure;
  if (!ValidDevice(device) || buffer == nullptr) return 1;
  CopyOut(buffer, State().devices[device].model);
  return 0;
}
#endif

FERRULE_EXPORT void ferruleSimReset(void) {
  State() = Simulator();
}

FERRULE_EXPORT void ferruleSimSetDeviceCount(int count) {
  State().deviceCount = count < 0                         ? 0
                        : count > FERRULE_SIM_MAX_DEVICES ? FERRULE_SIM_MAX_DEVICES
                                                          : count;
}

FERRULE_EXPORT int ferruleSimSetModel(int device, const char* text) {
  return SetText(device, text, &Device::model);
}

FERRULE_EXPORT int ferruleSimSetSerialNumber(int device, const char* text) {
  return SetText(device, text, &Device::serialNumber);
}

FERRULE_EXPORT int ferruleSimSetFailure(const char* exportName, int code) {
  const int e = ExportIndex(exportName);
  if (e < 0) return -1;
  State().failure[e] = code;
  return 0;
}

FERRULE_EXPORT int ferruleSimCallCount(const char* exportName) {
  const int e = ExportIndex(exportName);
  return e < 0 ? -1 : State().calls[e];
}

FERRULE_EXPORT int ferruleSimDivideRatio(int device) {
  return ValidDevice(device) ? State().devices[device].divideRatio : 0;
}

FERRULE_EXPORT const char* ferruleSimLastAccess(void) {
  return State().lastAccess.c_str();
}
