#include "lumen/capture/data_capture.h"

#include <unistd.h>

#include <boost/make_shared.hpp>
#include <string>
#include <utility>

#include "capture/request_name_parser.h"

using LumenUtility::E_INVALIDARG;
using LumenUtility::kMaxCaptureFloats;

DataCapture* DataCapture::s_pImpl = nullptr;

namespace {

// Counts every generated block name in the process; the service's caller keeps calls to one
// thread at a time.
int g_blockNameCounter = 0;

}  // namespace

DataCapture::DataCapture() : m_lastSize(0), m_open(false) {}

DataCapture::~DataCapture() = default;

void DataCapture::Create() {
  if (s_pImpl == nullptr) s_pImpl = new DataCapture();
}

void DataCapture::Destroy() {
  delete s_pImpl;
  s_pImpl = nullptr;
}

DataCapture& DataCapture::Instance() {
  if (s_pImpl == nullptr) throw LumenUtility::LUMEN_E_CAPTURE_STATE;
  return *s_pImpl;
}

void DataCapture::Preset() {
  if (s_pImpl == nullptr) return;
  s_pImpl->Initialize();
  s_pImpl->m_byChannel.clear();
  s_pImpl->m_blocks.clear();
}

std::vector<std::wstring> DataCapture::Catalog() {
  std::vector<std::wstring> names;
  if (s_pImpl == nullptr) return names;
  for (const auto& block : s_pImpl->m_blocks) names.push_back(block.first);
  return names;
}

void DataCapture::Initialize() {
  m_lastSize = 0;
  m_pending.clear();
  m_open = true;
}

std::uint32_t DataCapture::AddRequest(int channel, int measurement, bool isComplex,
                                      std::uint32_t count) {
  if (!m_open) throw LumenUtility::LUMEN_E_CAPTURE_STATE;
  DataRequest request;
  request.isComplex = isComplex;
  request.isIncremental = true;
  request.measurement = measurement;
  request.channel = channel;
  request.count = count;
  return Append(std::move(request));
}

std::uint32_t DataCapture::AddRequest(const std::wstring& request) {
  if (!m_open) throw LumenUtility::LUMEN_E_CAPTURE_STATE;
  return Append(LumenUtility::RequestNameParser::Parse(request));
}

std::uint32_t DataCapture::Append(DataRequest request) {
  const std::uint32_t offset = ComputeSizeOfPending();
  // Offsets are 32-bit and a block's byte size must fit GetLastSize: a request that would
  // wrap them would give regions that overlap or lie outside the block.
  if (request.Size() > kMaxCaptureFloats - offset) throw E_INVALIDARG;
  request.offset = offset;
  m_pending.push_back(std::move(request));
  return offset;
}

std::uint32_t DataCapture::ComputeSizeOfPending() const {
  if (m_pending.empty()) return 0;
  const DataRequest& last = m_pending.back();
  return last.offset + static_cast<std::uint32_t>(last.Size());
}

void DataCapture::CommitDataRequest(const std::wstring& blockName) {
  m_lastSize = 0;
  if (blockName.empty()) throw LumenUtility::LUMEN_E_CAPTURE_NO_NAME;
  // Checked before an old block of the name is dropped: a block of no floats cannot be made.
  if (m_pending.empty()) throw E_INVALIDARG;
  if (m_blocks.count(blockName) != 0) Delete(blockName);

  const std::uint32_t size = ComputeSizeOfPending();
  boost::shared_ptr<Block> block = boost::make_shared<Block>(blockName, size);
  for (DataRequest& request : m_pending) {
    request.blockName = blockName;
    m_byChannel[request.channel].push_back(request);
  }
  m_pending.clear();
  m_blocks[blockName] = std::move(block);
  m_lastSize = size;
  m_open = false;
}

void DataCapture::Delete(const std::wstring& blockName) {
  const auto found = m_blocks.find(blockName);
  if (found == m_blocks.end()) throw LumenUtility::LUMEN_E_CAPTURE_NO_BLOCK;
  for (auto& [channel, requests] : m_byChannel) {
    std::erase_if(requests, [&](const DataRequest& r) { return r.blockName == blockName; });
  }
  m_blocks.erase(found);
}

std::wstring DataCapture::GenerateName() {
  ++g_blockNameCounter;
  return L"VNASharedMemory_" + std::to_wstring(g_blockNameCounter) + L"_" +
         std::to_wstring(getpid());
}

boost::shared_ptr<DataCapture::Block> DataCapture::FindBlock(const std::wstring& name) const {
  const auto found = m_blocks.find(name);
  return found != m_blocks.end() ? found->second : boost::shared_ptr<Block>();
}
