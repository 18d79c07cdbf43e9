#include "lumen/phase/pa_parameter.h"

#include "phase/phase_host.h"

using LumenUtility::TsComplex;

PAParameter::PAParameter() : ratioed(false), id(-1), portCount(-1) {}

PAParameter::PAParameter(int numIndex, bool numReference, int denIndex, bool denReference,
                         int id, bool ratioed)
    : numerator(numReference, numIndex),
      denominator(denReference, denIndex),
      ratioed(ratioed),
      id(id),
      portCount(-1) {}

PAParameter::PAParameter(const PAReceiver& num, const PAReceiver& den, int id)
    : numerator(num), denominator(den), ratioed(den.index > 0), id(id), portCount(-1) {}

PAParameter::PAParameter(int numReceiverNumber, int denReceiverNumber, int id)
    : numerator(numReceiverNumber, false),
      denominator(denReceiverNumber, false),
      ratioed(denReceiverNumber >= 0),
      id(id),
      portCount(-1) {}

PAParameter::PAParameter(int numReceiverNumber)
    : numerator(numReceiverNumber, false), ratioed(false), id(-1), portCount(-1) {}

void PAParameter::Init(bool isRatioed, int newId) {
  ratioed = isRatioed;
  id = newId;
  portCount = -1;
}

bool PAParameter::operator<(const PAParameter& other) const {
  if (id != other.id) return id < other.id;
  if (denominator < other.denominator) return true;
  if (other.denominator < denominator) return false;
  return numerator < other.numerator;
}

int PAParameter::PortCount() const {
  if (portCount == -1) portCount = LumenUtility::RequireTestSet().GetPortCount();
  return portCount;
}

void PAParameter::RatioBucket(const TsComplex* point, TsComplex& out, bool mappingFlag) const {
  const TsComplex n = point[GetNumeratorSlot(mappingFlag)];
  const TsComplex d = ratioed ? point[GetDenominatorSlot(mappingFlag)] : TsComplex(1.0, 0.0);
  // TsComplex division is this very formula: n * conj(d) / |d|^2 in double, a zero |d|^2
  // taken as the smallest normal float.
  out = n / d;
}
