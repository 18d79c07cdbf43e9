#include "lumen/interprocess/vna_message_marshaling.h"

#include <cstring>
#include <limits>
#include <mutex>
#include <stdexcept>
#include <typeinfo>

#include "interprocess/wire_value.h"

namespace vna_interprocess {

namespace {

// Strings and type indices carry 4-byte prefixes.
constexpr unsigned kPrefixBytes = 4;

}  // namespace

std::vector<VNAMessageMarshaling::FACTORY_ENTRY*> VNAMessageMarshaling::sm_vector;
std::unordered_map<std::string, VNAMessageMarshaling::FACTORY_ENTRY*>
    VNAMessageMarshaling::sm_table;

VNAMessageMarshaling::VNAMessageMarshaling(OPERATION op, std::vector<unsigned char>& buffer)
    : m_storing(op == STORE), m_buffer(buffer) {
  FillRegistry();
  if (m_storing) m_buffer.clear();
}

void VNAMessageMarshaling::FillRegistry() {
  static std::once_flag filled;
  std::call_once(filled, [] {
    if (!sm_vector.empty()) return;
    for (int k = 0; sm_entries[k].index != -1; ++k) {
      FACTORY_ENTRY* entry = &sm_entries[k];
      entry->index = k;
      sm_vector.push_back(entry);
      sm_table.emplace(entry->getName(), entry);  // the first registration of a name wins
    }
  });
}

int VNAMessageMarshaling::GetIndexForName(const std::string& name) {
  const auto found = sm_table.find(name);
  return found == sm_table.end() ? -1 : found->second->index;
}

std::size_t VNAMessageMarshaling::Remaining() const {
  return m_buffer.size() > m_position ? m_buffer.size() - m_position : 0;
}

void VNAMessageMarshaling::CheckRoomFor(std::uint64_t n) const {
  if (m_position + n > std::numeric_limits<std::uint32_t>::max()) {
    throw std::length_error("message block would pass 4 GiB");
  }
}

void VNAMessageMarshaling::WriteToBuffer(const unsigned char* data, unsigned int n) {
  if (n == 0) return;
  CheckRoomFor(n);
  m_buffer.resize(m_position + static_cast<std::size_t>(n));
  std::memcpy(m_buffer.data() + m_position, data, n);
  m_position += n;
}

void VNAMessageMarshaling::WriteToBuffer(const std::string& s) {
  CheckRoomFor(kPrefixBytes + static_cast<std::uint64_t>(s.size()));
  WriteWireValue(*this, static_cast<std::uint32_t>(s.size()));
  WriteToBuffer(reinterpret_cast<const unsigned char*>(s.data()), static_cast<unsigned>(s.size()));
}

void VNAMessageMarshaling::WriteToBuffer(const VNAMarshalObject* obj) {
  if (!obj) return;
  const int index = GetIndexForName(typeid(*obj).name());
  if (index < 0) return;
  WriteWireValue(*this, static_cast<std::int32_t>(index));
  obj->marshal(*this);
}

void VNAMessageMarshaling::ReadFromBuffer(unsigned char* data, unsigned int n) {
  if (n == 0 || Remaining() < n) return;
  std::memcpy(data, m_buffer.data() + m_position, n);
  m_position += n;
}

void VNAMessageMarshaling::ReadFromBuffer(std::string& s) {
  s.clear();
  if (Remaining() < kPrefixBytes) return;
  std::uint32_t length;
  std::memcpy(&length, m_buffer.data() + m_position, kPrefixBytes);
  if (length > Remaining() - kPrefixBytes) return;
  const auto* first = reinterpret_cast<const char*>(m_buffer.data() + m_position + kPrefixBytes);
  s.assign(first, length);
  m_position += kPrefixBytes + length;
}

void VNAMessageMarshaling::ReadFromBuffer(boost::shared_ptr<VNAMarshalObject>& p) {
  p.reset();
  if (Remaining() < kPrefixBytes) return;
  std::int32_t index = -1;
  ReadWireValue(*this, index);
  if (index < 0 || static_cast<std::size_t>(index) >= sm_vector.size()) return;
  p.reset(sm_vector[index]->create(*this));
}

}  // namespace vna_interprocess
