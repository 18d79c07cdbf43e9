/** @file */
/// @class PAReceiver
/// PAReceiver: names one hardware receiver of a phase-coherent acquisition.
///
/// A receiver is either a reference receiver, named by its port number, or a test receiver,
/// named by the test set's receiver index. It knows nothing of the layout of the per-point
/// receiver buffer: ToSlot asks the host's test set (ITestSet, capabilities table category 3,
/// index 0) every time it is called.
/// Thread-safety: a plain value, usable from any thread; the operations that ask the test set
/// are as thread-safe as the host's test set.
#pragma once

#include <cstdint>

#include "lumen/export.h"

class LUMEN_API PAReceiver {
 public:
  /// true: a reference receiver and `index` is a port number (1-based); false: a test receiver
  /// and `index` is the test set's receiver index, -1 for none.
  bool reference;
  /// Port number or receiver index, see `reference`.
  std::int32_t index;

  /// The port-0 reference receiver (true, 0).
  PAReceiver() : reference(true), index(0) {}
  /// The receiver (`isReference`, `receiverIndex`).
  PAReceiver(bool isReference, int receiverIndex) : reference(isReference), index(receiverIndex) {}
  /// Classifies a physical receiver number through the test set's ClassifyReceiver (`flag` is
  /// passed through). A negative number gives (false, -1) without asking; a number the test
  /// set does not call a test receiver becomes the reference receiver of the port it reports,
  /// where the reports -1, 100000 and 100001 all mean port 1.
  /// Throws LumenException(E_POINTER) when no test set is registered.
  PAReceiver(int receiverNumber, bool flag);

  /// Reference receivers sort before test receivers; within a kind, by index.
  bool operator<(const PAReceiver& other) const {
    if (reference != other.reference) return reference;
    return index < other.index;
  }
  /// Both fields equal.
  bool operator==(const PAReceiver& other) const = default;

  /// The test set's 0-based slot of this receiver in a per-point buffer. `mappingFlag` is
  /// passed through to ReceiverToSlot. Throws LumenException(E_POINTER) when no test set is
  /// registered; errors of the test set pass through.
  int ToSlot(bool mappingFlag) const;
};
