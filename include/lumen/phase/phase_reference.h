// PhaseReference: control of the external phase reference device through its driver library.
#pragma once

#include <string>
#include <vector>

#include "lumen/export.h"
#include "lumen/platform/shared_library.h"

/// Drives the external phase reference device: loads its driver "Ferrule_rev7.dll" (the shared
/// object libFerrule_rev7.so), lists the connected devices by serial number, reads a device's
/// model and opens a device with a divide ratio.
///
/// While the host's diagnostic feature "SimulatePhaseRef" is on (IDiagFeaturesInterface,
/// category 3, index 0), the device is simulated: nothing is loaded or called, SetupReference
/// does nothing, and the model and the only ID string are "Simulated".
///
/// Objects hold no state of their own: the driver and its entry points are process-wide,
/// loaded by the first constructor that is not simulated and never unloaded. Every failure
/// throws LumenException with code LUMEN_E_BOUNDS (0xE8080882) and one message; failures the
/// device reports end in ":" and the device's error code in decimal.
///
/// Thread-safety: none; the whole process uses the phase reference from one thread at a time.
/// Ownership: the driver library belongs to the process and stays loaded.
class LUMEN_API PhaseReference {
 public:
  /// Loads the driver unless the device is simulated or the driver was loaded before.
  /// Throws "couldn't load Ferrule_rev7.dll" when the library cannot be loaded (a later
  /// constructor tries again), and "Couldn't find the dll exports for phase reference" when
  /// one of its nine entry points is missing (the library stays loaded; later constructors do
  /// not look again and throw the same).
  PhaseReference();
  /// Copies nothing: there is no state of its own.
  PhaseReference(const PhaseReference&) = default;
  /// Does nothing: there is no state of its own.
  PhaseReference& operator=(const PhaseReference&);
  /// Nothing to release: the driver stays loaded.
  ~PhaseReference() = default;

  /// True when the host's IDiagFeaturesInterface reports "SimulatePhaseRef" as on; false when
  /// it reports it off or no such host object is registered.
  static bool IsSimulated();

  /// Opens device number `device` (0-based, below the number of connected devices) and sets
  /// its divide ratio `divide` (1, 2, 4, 8 or 16). In simulation returns at once. The checks
  /// run in this order and throw:
  ///  - "Selected phase reference is invalid" when `device` is negative or not connected,
  ///    before anything is started;
  ///  - "Could not initialize phase reference." when the device fails to start;
  ///  - "Invalid argument for setting up phase reference." for any other `divide`, after the
  ///    device was started;
  ///  - "Could not set the divide setting on the phase reference.:CODE" when the device
  ///    refuses the ratio.
  void SetupReference(int device, int divide);

  /// The model text of device number `device` (0-based), "Simulated" in simulation. Throws
  /// "Couldn't read the model from the phase reference.:CODE" when the device reports CODE.
  std::wstring GetModel(int device);

  /// One ID (serial number) string per connected device, in device order; empty when none is
  /// connected, {"Simulated"} in simulation. Throws "Couldn't read the ID string of the phase
  /// reference.:CODE" when a device reports CODE (no strings are returned then).
  std::vector<std::wstring> GetIDStrings();

 private:
  using StartFunc = int (*)(char* access, int device);
  using CountFunc = int (*)();
  using RatioFunc = int (*)(int device);
  using TextFunc = int (*)(char* buffer, int device);

  // Throws the exports message when the entry point was never resolved: a driver that lacked
  // exports, or a process that built its objects in simulation and then left it.
  template <class Func>
  static Func Require(Func entry);
  static void Load();

  static LumenUtility::HMODULE m_hPhaseReferenceDll;
  static StartFunc m_startHalcyonFunc;
  static CountFunc m_getNumConnectedDevicesFunc;
  static RatioFunc m_makeRatio1Func;
  static RatioFunc m_makeRatio2Func;
  static RatioFunc m_makeRatio4Func;
  static RatioFunc m_makeRatio8Func;
  static RatioFunc m_makeRatio16Func;
  static TextFunc m_getSerialNumberFunc;
  static TextFunc m_getModel;
};
