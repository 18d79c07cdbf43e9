// Helpers shared by the core tests.
#pragma once

#include "lumen/core/ts_complex.h"

namespace LumenUtility::testutil {

// Restores the process-wide LogMag zero value however a test ends.
class ZeroValueGuard {
 public:
  ZeroValueGuard() : m_saved(TsComplex::GetLogMagZeroValue()) {}
  ~ZeroValueGuard() { TsComplex::SetLogMagZeroValue(m_saved); }
  ZeroValueGuard(const ZeroValueGuard&) = delete;
  ZeroValueGuard& operator=(const ZeroValueGuard&) = delete;

 private:
  double m_saved;
};

}  // namespace LumenUtility::testutil
