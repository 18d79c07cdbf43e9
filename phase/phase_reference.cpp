#include "lumen/phase/phase_reference.h"

#include <array>
#include <cstring>
#include <string>
#include <type_traits>

#include "lumen/diagnostics/debug_print.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/text_conversion.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

using LumenUtility::HMODULE;

HMODULE PhaseReference::m_hPhaseReferenceDll = nullptr;
PhaseReference::StartFunc PhaseReference::m_startHalcyonFunc = nullptr;
PhaseReference::CountFunc PhaseReference::m_getNumConnectedDevicesFunc = nullptr;
PhaseReference::RatioFunc PhaseReference::m_makeRatio1Func = nullptr;
PhaseReference::RatioFunc PhaseReference::m_makeRatio2Func = nullptr;
PhaseReference::RatioFunc PhaseReference::m_makeRatio4Func = nullptr;
PhaseReference::RatioFunc PhaseReference::m_makeRatio8Func = nullptr;
PhaseReference::RatioFunc PhaseReference::m_makeRatio16Func = nullptr;
PhaseReference::TextFunc PhaseReference::m_getSerialNumberFunc = nullptr;
PhaseReference::TextFunc PhaseReference::m_getModel = nullptr;

namespace {

constexpr const wchar_t* kDriverName = L"Ferrule_rev7.dll";
constexpr const wchar_t* kSimulationFeature = L"SimulatePhaseRef";
constexpr const wchar_t* kSimulatedText = L"Simulated";
constexpr const wchar_t* kExportsMissing = L"Couldn't find the dll exports for phase reference";
// The device's access string; its meaning is the driver's.
constexpr char kAccess[] = "tamarin47261";
// The driver writes its texts into a caller buffer of this size.
constexpr std::size_t kTextBufferBytes = 1000;

// "message:code", the form every failure the device reports takes.
[[noreturn]] void ThrowDeviceError(const wchar_t* message, int code) {
  throw LumenException(std::wstring(message) + L":" + std::to_wstring(code));
}

// Calls a text entry point into a zero-filled buffer. A driver that fills the whole buffer
// leaves no terminating zero, so the text ends at the buffer's end at the latest.
template <class Func>
int ReadDriverText(Func entry, int device, std::wstring& text) {
  std::array<char, kTextBufferBytes> buffer{};
  const int code = entry(buffer.data(), device);
  if (code == 0) {
    text = LumenUtility::Utf8ToWide(
        std::string_view(buffer.data(), strnlen(buffer.data(), buffer.size())));
  }
  return code;
}

}  // namespace

template <class Func>
Func PhaseReference::Require(Func entry) {
  if (entry == nullptr) throw LumenException(kExportsMissing);
  return entry;
}

PhaseReference::PhaseReference() {
  if (IsSimulated()) return;
  if (m_hPhaseReferenceDll == nullptr) {
    Load();
  } else if (m_getModel == nullptr) {
    // The driver lacked an export when it was loaded; it is not looked at again.
    throw LumenException(kExportsMissing);
  }
}

PhaseReference& PhaseReference::operator=(const PhaseReference&) {
  return *this;
}

void PhaseReference::Load() {
  m_hPhaseReferenceDll = LumenUtility::LoadLibraryW(kDriverName);
  if (m_hPhaseReferenceDll == nullptr) {
    dprint(DebugPrintPhaseReference, L"PhaseReference: %ls not found by the library search\n",
           kDriverName);
    throw LumenException(L"couldn't load Ferrule_rev7.dll");
  }
  // Each address is kept as soon as it is found; the last one set tells that all were.
  const auto resolve = [](const char* name, auto& entry) {
    void* address = LumenUtility::GetProcAddress(m_hPhaseReferenceDll, name);
    if (address == nullptr) {
      dprint(DebugPrintPhaseReference, L"PhaseReference: export %s missing\n", name);
      throw LumenException(kExportsMissing);
    }
    entry = reinterpret_cast<std::remove_reference_t<decltype(entry)>>(address);
  };
  resolve("startHalcyon", m_startHalcyonFunc);
  resolve("getNumConnectedDevice", m_getNumConnectedDevicesFunc);
  resolve("makeRatio1", m_makeRatio1Func);
  resolve("makeRatio2", m_makeRatio2Func);
  resolve("makeRatio4", m_makeRatio4Func);
  resolve("makeRatio8", m_makeRatio8Func);
  resolve("makeRatio16", m_makeRatio16Func);
  resolve("getSerialNumber", m_getSerialNumberFunc);
  resolve("getModel", m_getModel);
}

bool PhaseReference::IsSimulated() {
  IDiagFeaturesInterface* features = LumenUtility::FindHostObject<IDiagFeaturesInterface>(
      LumenUtility::kHostCategoryApplication, 0);
  return features != nullptr && features->IsFeatureOn(kSimulationFeature);
}

void PhaseReference::SetupReference(int device, int divide) {
  if (IsSimulated()) return;
  if (device < 0 || device >= Require(m_getNumConnectedDevicesFunc)()) {
    throw LumenException(L"Selected phase reference is invalid");
  }
  char access[sizeof kAccess];
  std::memcpy(access, kAccess, sizeof kAccess);  // the driver takes a writable buffer
  if (Require(m_startHalcyonFunc)(access, device) != 0) {
    throw LumenException(L"Could not initialize phase reference.");
  }
  RatioFunc makeRatio = nullptr;
  switch (divide) {
    case 1:
      makeRatio = m_makeRatio1Func;
      break;
    case 2:
      makeRatio = m_makeRatio2Func;
      break;
    case 4:
      makeRatio = m_makeRatio4Func;
      break;
    case 8:
      makeRatio = m_makeRatio8Func;
      break;
    case 16:
      makeRatio = m_makeRatio16Func;
      break;
    default:
      throw LumenException(L"Invalid argument for setting up phase reference.");
  }
  if (const int code = Require(makeRatio)(device); code != 0) {
    ThrowDeviceError(L"Could not set the divide setting on the phase reference.", code);
  }
  dprint(DebugPrintPhaseReference, L"PhaseReference: device %d, divide %d\n", device, divide);
}

std::wstring PhaseReference::GetModel(int device) {
  if (IsSimulated()) return kSimulatedText;
  std::wstring model;
  if (const int code = ReadDriverText(Require(m_getModel), device, model); code != 0) {
    ThrowDeviceError(L"Couldn't read the model from the phase reference.", code);
  }
  return model;
}

std::vector<std::wstring> PhaseReference::GetIDStrings() {
  if (IsSimulated()) return {kSimulatedText};
  const int count = Require(m_getNumConnectedDevicesFunc)();
  TextFunc getSerialNumber = Require(m_getSerialNumberFunc);
  std::vector<std::wstring> ids;
  for (int d = 0; d < count; ++d) {
    std::wstring id;
    if (const int code = ReadDriverText(getSerialNumber, d, id); code != 0) {
      ThrowDeviceError(L"Couldn't read the ID string of the phase reference.", code);
    }
    ids.push_back(std::move(id));
  }
  return ids;
}
