/// @file
/// Interfaces of the host application's objects that the library calls.
///
/// The host implements these and registers its objects in the capabilities table (see
/// "lumen/util/host_object.h"); the library looks each one up when it needs it, by category,
/// index and interface type, and treats a missing object as the calling class documents.
/// Tests implement fakes. The library never owns, copies or deletes a host object, and errors
/// thrown by a host object pass through unchanged.
///
/// The order of the operations within each interface is that of its virtual slots and must
/// not change.
///
/// Thread-safety: as the host's objects provide; the library calls them from the thread of
/// the calling library object.
#pragma once

#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "lumen/core/ts_complex.h"

namespace LumenUtility {
class DataMatrix;
}

/// The test set: port count and the slot layout of the per-point receiver buffer.
/// Looked up under category 3, index 0.
class ITestSet {
 public:
  virtual ~ITestSet() = default;
  /// Number of test ports.
  virtual int GetPortCount() = 0;
  /// Slot of receiver `index` (a reference receiver when `reference`) in a per-point buffer.
  virtual int ReceiverToSlot(int index, bool reference, bool mappingFlag) = 0;
  /// Splits a receiver number into a test-receiver index or a reference port.
  virtual void ClassifyReceiver(int receiverNumber, int& testIndex, int& refPort, bool flag) = 0;
  /// 1-based position of the named receiver.
  virtual int GetReceiverPosition(const std::wstring& name) = 0;
};

/// The host's FIFO of completed phase-coherent values. Looked up under category 3, index 0.
class AI_IFIFO {
 public:
  virtual ~AI_IFIFO() = default;
  /// Accepts `count` values starting at `values`.
  virtual void Write(const LumenUtility::TsComplex* values, int count) = 0;
};

/// Diagnostic feature switches of the host. Looked up under category 3, index 0; a missing
/// object means every feature is off. The library asks for "SimulatePhaseRef" (the phase
/// reference device is simulated while it is on).
class IDiagFeaturesInterface {
 public:
  /// Host objects are not deleted through this interface by the library.
  virtual ~IDiagFeaturesInterface() = default;
  /// Whether the diagnostic feature `name` (for example "SimulatePhaseRef") is on.
  virtual bool IsFeatureOn(const std::wstring& name) = 0;
};

/// Hardware capabilities. Looked up under category 3, index 0.
class INAHardwareCaps {
 public:
  virtual ~INAHardwareCaps() = default;
  /// True: the frequency reference setting is kept by the library; false: the hardware
  /// decides it.
  virtual bool CanStoreReference() = 0;
  /// Whether the index line polarity can be set.
  virtual bool HasIndexLine() = 0;
};

/// Hardware control of the frequency reference. Looked up under category 3, index 0.
class HWControl {
 public:
  virtual ~HWControl() = default;
  /// True when the hardware runs on the external reference.
  virtual bool IsExternalReference() = 0;
  /// Switches the hardware to the external (true) or internal (false) reference.
  virtual void SetExternalReference(bool external) = 0;
};

namespace LumenApp {

/// The analyzer core. Looked up under category 3, index 0.
class ILumenCore {
 public:
  virtual ~ILumenCore() = default;
  /// Tells the core to re-read the global state.
  virtual void OnGlobalStateChanged() = 0;
};

}  // namespace LumenApp

namespace Interface {

/// Data of one measurement. Looked up under category 1, index = measurement number.
class IGetSetData {
 public:
  virtual ~IGetSetData() = default;
  /// Fills `out` with the measurement's formatted trace of `kind` in display format `format`.
  virtual void GetFormattedData(int kind, int format, std::vector<float>& out) = 0;
  /// The measurement's display format code.
  virtual int GetFormat() = 0;
  /// The error-term buffers of an N-port correction as an N x N matrix (may be null).
  virtual boost::shared_ptr<LumenUtility::DataMatrix> GetCalData() = 0;
  /// Points `out` at the measurement's complex data (null when there is none).
  virtual void GetComplexData(const std::vector<LumenUtility::TsComplex>*& out) = 0;
};

/// The external devices the user selected. Looked up under category 3, index 0.
class ISelectedExternalDevices {
 public:
  virtual ~ISelectedExternalDevices() = default;
  /// Names of the selected external devices of `kind`.
  virtual std::vector<std::wstring> GetSelectedDevices(int kind) = 0;
};

}  // namespace Interface

/// The host's channel manager: brackets a change that touches every channel, so that the
/// channels are brought up to date once, when the change ends. Created through the factory
/// under "CHANNELS_MANAGER", whose product is a boost::shared_ptr<IChannelManager>; the library
/// creates it once and keeps it.
class IChannelManager {
 public:
  virtual ~IChannelManager() = default;
  /// Starts a change; the token returned is handed back to EndChange.
  virtual int BeginChange() = 0;
  /// Ends the change that BeginChange started with `token`.
  virtual void EndChange(int token) = 0;
};
