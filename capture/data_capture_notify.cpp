// The measurement engine's notifications: copying channel data into the regions of the
// committed requests.
#include <algorithm>
#include <cstdint>
#include <cstring>
#include <vector>

#include "lumen/capture/data_capture.h"
#include "lumen/data/data_matrix.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

using LumenUtility::DataMatrix;
using LumenUtility::NamedBuffer;
using LumenUtility::TsComplex;

namespace {

// Display formats whose formatted trace is not captured, in the host's numbering.
bool IsSkippedFormat(int format) {
  return format == 3 || format == 8 || format == 11;
}

// The buffers of an N x N matrix in capture order, (0,0), (1,0) ... (N-1,0), (0,1) ...: the
// first logical index fastest. Empty unless the matrix holds k^2 buffers (k from 1 to 99) and
// each of those pairs exists.
std::vector<const NamedBuffer*> MatrixInCaptureOrder(DataMatrix& matrix) {
  std::vector<const NamedBuffer*> buffers;
  int k = 1;
  while (k < 99 && k * k < matrix.Size()) ++k;
  if (k * k != matrix.Size()) return buffers;
  try {
    for (int j = 0; j < k; ++j) {
      for (int i = 0; i < k; ++i) buffers.push_back(&matrix(i, j));
    }
  } catch (const LumenException&) {
    buffers.clear();  // not a matrix of port pairs: nothing is copied rather than part of it
  }
  return buffers;
}

// Each buffer takes 2 x BufferSize() floats; a buffer with fewer samples is copied as far as
// it reaches and the rest of its piece reads as zero samples. Stops after `count` floats.
void CopyCalibration(DataMatrix& matrix, float* dest, std::uint64_t count) {
  const std::uint64_t piece = 2 * static_cast<std::uint64_t>(matrix.BufferSize());
  for (const NamedBuffer* buffer : MatrixInCaptureOrder(matrix)) {
    if (count == 0) return;
    const std::uint64_t take = std::min(piece, count);
    const std::uint64_t samples = std::min<std::uint64_t>(take, 2 * buffer->GetData().size());
    if (samples > 0) std::memcpy(dest, buffer->GetData().data(), samples * sizeof(float));
    std::fill(dest + samples, dest + take, 0.0f);
    dest += take;
    count -= take;
  }
}

}  // namespace

void DataCapture::FillRequest(const DataRequest& request, float* dest) const {
  Interface::IGetSetData* data = LumenUtility::FindHostObject<Interface::IGetSetData>(
      LumenUtility::kHostCategoryMeasurement, request.measurement);
  if (data == nullptr) return;
  if (request.isCal) {
    const boost::shared_ptr<DataMatrix> matrix = data->GetCalData();
    if (matrix) CopyCalibration(*matrix, dest, request.count);
  } else if (request.isComplex) {
    const std::vector<TsComplex>* points = nullptr;
    data->GetComplexData(points);
    if (points == nullptr) return;
    const std::size_t n = std::min<std::size_t>(request.count, points->size());
    if (n > 0) std::memcpy(dest, points->data(), n * sizeof(TsComplex));
  } else {
    const int format = data->GetFormat();
    if (IsSkippedFormat(format)) return;
    std::vector<float> values;
    data->GetFormattedData(2, format, values);
    values.resize(request.count);
    if (!values.empty()) std::memcpy(dest, values.data(), values.size() * sizeof(float));
  }
}

void DataCapture::ChannelDataDone(int channel) {
  if (s_pImpl == nullptr) return;
  const auto found = s_pImpl->m_byChannel.find(channel);
  if (found == s_pImpl->m_byChannel.end()) return;
  // A copy: the host objects called below may reach the service.
  const std::vector<DataRequest> requests = found->second;
  for (const DataRequest& request : requests) {
    if (request.isIncremental) return;
    const boost::shared_ptr<Block> block = s_pImpl->FindBlock(request.blockName);
    if (!block) return;
    s_pImpl->FillRequest(request, block->GetPtr(request.offset));
  }
}

void DataCapture::ChannelIRDone(int channel, int measurement, std::uint32_t n, const float* data) {
  if (s_pImpl == nullptr || data == nullptr) return;
  const auto found = s_pImpl->m_byChannel.find(channel);
  if (found == s_pImpl->m_byChannel.end()) return;
  for (DataRequest& request : found->second) {
    if (request.measurement != measurement) continue;
    const boost::shared_ptr<Block> block = s_pImpl->FindBlock(request.blockName);
    if (!block) return;
    const std::uint64_t arrived = request.isComplex ? 2 * std::uint64_t{n} : n;
    // Only what still fits: the next request's region follows without a gap.
    const std::uint64_t room =
        request.Size() - std::min<std::uint64_t>(request.written, request.Size());
    const std::uint64_t take = std::min(arrived, room);
    if (take > 0) {
      std::memcpy(block->GetPtr(request.offset + request.written), data, take * sizeof(float));
    }
    request.written += static_cast<std::uint32_t>(take);
  }
}
