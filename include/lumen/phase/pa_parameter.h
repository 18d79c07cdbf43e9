/** @file */
/// @class PAParameter
/// PAParameter: one measured quantity of a phase-coherent acquisition.
///
/// A numerator receiver, optionally divided by a denominator receiver, tagged with the
/// acquisition ID whose points carry its samples. Slots in the per-point buffer and the port
/// count come from the host's test set (ITestSet, capabilities table category 3, index 0); the
/// port count is asked once and cached in `portCount`, which copies carry along.
/// Thread-safety: a plain value; PortCount() fills the cache, so a parameter shared between
/// threads must have its port count asked before it is shared.
#pragma once

#include <cstdint>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"
#include "lumen/phase/pa_receiver.h"

class LUMEN_API PAParameter {
 public:
  PAReceiver numerator;    ///< the receiver whose value is measured
  PAReceiver denominator;  ///< divided into the numerator when `ratioed`
  bool ratioed;  ///< the value is numerator / denominator, else the numerator alone
  std::int32_t id;  ///< acquisition ID; -1 when not set
  /// The test set's port count once asked; -1 until then.
  mutable std::int32_t portCount;

  /// Numerator and denominator (true, 0), not ratioed, id -1.
  PAParameter();
  /// Numerator receiver (numReference, numIndex), denominator receiver (denReference,
  /// denIndex), acquisition ID `id`, ratioed when `ratioed`.
  PAParameter(int numIndex, bool numReference, int denIndex, bool denReference, int id,
              bool ratioed);
  /// Ratioed when den.index > 0: a denominator of index 0 or below is not used.
  PAParameter(const PAReceiver& num, const PAReceiver& den, int id);
  /// Both receivers classified from physical receiver numbers (PAReceiver(number, false));
  /// ratioed when denReceiverNumber >= 0. Throws as that constructor does.
  PAParameter(int numReceiverNumber, int denReceiverNumber, int id);
  /// Numerator classified from a physical receiver number; not ratioed, id -1.
  explicit PAParameter(int numReceiverNumber);

  /// Sets `ratioed` and `id` and forgets the cached port count; receivers stay.
  void Init(bool isRatioed, int newId);

  /// By id, then denominator, then numerator; `ratioed` and `portCount` take no part.
  bool operator<(const PAParameter& other) const;

  /// The test set's port count, asked on the first call only. Throws LumenException(E_POINTER)
  /// when it has to ask and no test set is registered.
  int PortCount() const;

  /// Slots of the two receivers (PAReceiver::ToSlot).
  int GetNumeratorSlot(bool mappingFlag) const { return numerator.ToSlot(mappingFlag); }
  /// Slot of the denominator receiver (PAReceiver::ToSlot).
  int GetDenominatorSlot(bool mappingFlag) const { return denominator.ToSlot(mappingFlag); }

  /// out = numerator value / denominator value of one point's receiver buffer, the
  /// denominator being 1 + 0j when not ratioed, computed in double as n * conj(d) / |d|^2 and
  /// rounded to float. A zero denominator has |d|^2 taken as 1.175494351e-38, so it gives
  /// 0 + 0j for a finite numerator, never an infinity. `point` must hold every slot the test
  /// set names; the slots are not range-checked. Throws as ToSlot does.
  void RatioBucket(const LumenUtility::TsComplex* point, LumenUtility::TsComplex& out,
                   bool mappingFlag) const;
};
