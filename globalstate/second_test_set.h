// SecondTestSet: the registry's configuration of a second test set, read at each use from the
// analyzer's key (HKEY_LOCAL_MACHINE\SOFTWARE\Corvane\Network Analyzer\). A value that is
// absent or of the wrong type takes its default.
#pragma once

#include <cstdint>
#include <string>

namespace LumenUtility {

struct SecondTestSet {
  // "T2Mode" (REG_DWORD) is 1.
  bool enabled = false;
  // "T2ClockPort" (REG_DWORD): the port whose source clocks the test set; 0 or absent is 4.
  std::uint32_t clockPort = 4;
  // "T2Name" (REG_SZ or REG_EXPAND_SZ): the device name; empty or absent is "T2".
  std::wstring name = L"T2";

  // The configuration in the process-wide registry.
  static SecondTestSet Read();
};

}  // namespace LumenUtility
