/** @file */
/// @class DataCapture
/// DataCapture: hands measurement data to other processes through named shared memory.
///
/// The host opens a request phase (Initialize or Preset), adds data requests and commits them
/// under a block name. The service then creates one shared-memory block of 32-bit floats
/// (FileMappingWithView<float>) large enough for all of them, each request owning a region
/// that follows the previous one without a gap. The measurement engine reports finished channel
/// data (ChannelDataDone) and pieces of incremental data (ChannelIRDone); the service copies the
/// data into the regions of the matching requests, never past a region's end. Client processes
/// open the block by name (FileMappingReader) and read the floats.
///
/// There is one service per process, made by Create and removed by Destroy; committed blocks
/// stay mapped, and their names stay in the shared-memory namespace, until Delete, Preset or
/// Destroy.
///
/// Errors are thrown as HRESULTs by value (codes below; 0x80070057 for a malformed request,
/// 0x8007xxxx from the file mapping when a block cannot be made). The notifications never
/// throw for missing channels, blocks or measurements; errors of host objects pass through.
///
/// Thread-safety: none. The notifications come from the measurement engine and the other calls
/// from the host; the caller keeps them from running at the same time. Ownership: the service
/// owns its blocks; host objects are looked up per request and not owned.
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "lumen/capture/data_request.h"
#include "lumen/capture/file_mapping_with_view.h"
#include "lumen/capture/no_copy.h"
#include "lumen/export.h"
#include "lumen/platform/error_codes.h"

namespace LumenUtility {

/// No service exists, or requests are added outside an open request phase.
inline constexpr HRESULT LUMEN_E_CAPTURE_STATE = MakeHResult(0xE80808CA);
/// A block name was empty.
inline constexpr HRESULT LUMEN_E_CAPTURE_NO_NAME = MakeHResult(0xE80808CB);
/// No committed block has that name.
inline constexpr HRESULT LUMEN_E_CAPTURE_NO_BLOCK = MakeHResult(0xE80808CC);

/// The most floats one block holds: its byte size must fit the 32 bits of GetLastSize.
inline constexpr std::uint32_t kMaxCaptureFloats = 0x3FFFFFFF;

}  // namespace LumenUtility

class LUMEN_API DataCapture : private NoCopy {
 public:
  /// Makes the service when there is none.
  static void Create();
  /// Removes the service with all its blocks (their names leave the namespace).
  static void Destroy();
  /// The service; throws 0xE80808CA when there is none.
  static DataCapture& Instance();
  /// When a service exists: drops every block and request and opens a new request phase.
  static void Preset();
  /// The names of all committed blocks in name order; empty when there is no service.
  static std::vector<std::wstring> Catalog();

  /// The engine finished channel `channel`: fills each request of the channel, in commit order,
  /// from its measurement's host object (category 1, index = measurement number): calibration
  /// matrices as float pairs buffer by buffer, (0,0), (1,0) ... the first index fastest; complex
  /// data as real, imaginary pairs; formatted data as floats (formats 3, 8 and 11 are skipped).
  /// The walk ends at the first incremental request or a request whose block is gone.
  static void ChannelDataDone(int channel);
  /// `n` points of measurement `measurement` arrived on `channel` (2 x n floats at `data` for
  /// a complex request, else n): appended to each such request's region after what it holds.
  /// What does not fit in the region is dropped.
  static void ChannelIRDone(int channel, int measurement, std::uint32_t n, const float* data);

  /// Opens a request phase: drops pending requests; the last size becomes 0.
  void Initialize();
  /// Appends an incremental request and returns its float offset. Throws 0xE80808CA outside a
  /// request phase, 0x80070057 when the block would exceed kMaxCaptureFloats.
  std::uint32_t AddRequest(int channel, int measurement, bool isComplex, std::uint32_t count);
  /// Appends the request named like "1:2:SDATA:201" (see DataRequest) and returns its float
  /// offset. Throws 0xE80808CA outside a request phase, 0x80070057 for a malformed name or when
  /// the block would exceed kMaxCaptureFloats.
  std::uint32_t AddRequest(const std::wstring& request);
  /// Floats all pending requests take.
  std::uint32_t ComputeSizeOfPending() const;
  /// Creates block `blockName` for the pending requests (replacing a block of that name, with
  /// its requests) and closes the request phase. Throws 0xE80808CB for an empty name,
  /// 0x80070057 when nothing is pending (nothing is changed then), and the file mapping's codes.
  void CommitDataRequest(const std::wstring& blockName);
  /// Drops a committed block and its requests; throws 0xE80808CC when there is no such block.
  void Delete(const std::wstring& blockName);
  /// "VNASharedMemory_<counter>_<process id>"; the process-wide counter starts at 1 and counts
  /// every call.
  std::wstring GenerateName();
  /// Byte size of the last committed block (0 after Initialize, Preset or a failed commit).
  std::uint32_t GetLastSize() const { return m_lastSize * 4; }

 private:
  using Block = FileMappingWithView<float>;

  DataCapture();
  ~DataCapture();
  std::uint32_t Append(DataRequest request);
  boost::shared_ptr<Block> FindBlock(const std::wstring& name) const;
  void FillRequest(const DataRequest& request, float* dest) const;

  static DataCapture* s_pImpl;

  std::map<std::wstring, boost::shared_ptr<Block>> m_blocks;
  std::uint32_t m_lastSize;
  bool m_open;
  std::vector<DataRequest> m_pending;
  std::map<int, std::vector<DataRequest>> m_byChannel;
};
