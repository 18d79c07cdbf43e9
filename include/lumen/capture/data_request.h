/** @file */
/// @class DataRequest
/// DataRequest: one request of the data capture service, the region of a shared-memory block
/// that one measurement's data of one kind is copied into.
///
/// A region is Size() floats from `offset`: `count` floats for formatted and calibration data,
/// 2 x `count` for complex data (real, imaginary pairs). Thread-safety: a plain value.
#pragma once

#include <cstdint>
#include <string>

struct DataRequest {
  bool isComplex = false;      ///< two floats per point ("SDATA", or the numeric form's flag)
  bool isCal = false;          ///< calibration error-term matrix ("CAL")
  bool isIncremental = false;  ///< filled piece by piece by DataCapture::ChannelIRDone
  int measurement = 0;         ///< measurement number, 1 or more
  int channel = 0;             ///< channel number, 1 or more
  std::uint32_t count = 0;     ///< points (floats for "FDATA" and "CAL")
  std::uint32_t written = 0;   ///< floats already written by ChannelIRDone
  std::uint32_t offset = 0;    ///< float offset of the region in its block
  std::wstring blockName;      ///< the block it was committed into; empty while pending

  /// Floats the region holds.
  std::uint64_t Size() const { return isComplex ? std::uint64_t{count} * 2 : count; }
};
