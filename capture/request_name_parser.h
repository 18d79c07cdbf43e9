// The text form of a data request, "channel:measurement:type:count" (1:2:SDATA:201).
//
// Channel and measurement are decimal integers of at least 1 (up to 2147483647), the type is
// "SDATA" (complex data), "FDATA" (formatted data) or "CAL" (calibration matrix), and the count
// a decimal number from 1 to 4294967295. Numbers are plain digits: no sign, space or other
// character.
//
// Thread-safety: a pure function.
#pragma once

#include <string_view>

#include "lumen/capture/data_request.h"

namespace LumenUtility {

class RequestNameParser {
 public:
  // The request `name` describes (not incremental, nothing written, offset 0, no block).
  // Throws 0x80070057 (an HRESULT by value) for any other text.
  static DataRequest Parse(std::wstring_view name);
};

}  // namespace LumenUtility
