#include "lumen/interprocess/vna_message_base.h"

#include "interprocess/wire_value.h"

namespace vna_interprocess {

namespace {

// The id that asks for the id in the data.
constexpr short kIdFromData = 1;

}  // namespace

VNAMessageBase::VNAMessageBase(short id, VNAMessageMarshaling& m) : m_id(id) {
  short read = id;
  ReadWireValue(m, read);
  if (id == kIdFromData) m_id = read;
}

void VNAMessageBase::marshal(VNAMessageMarshaling& m) const {
  WriteWireValue(m, m_id);
}

}  // namespace vna_interprocess
