#include "lumen/interprocess/vna_message_event.h"

#include "interprocess/wire_value.h"

namespace vna_interprocess {

VNAMessageEvent::VNAMessageEvent(std::uint32_t event, std::uint32_t hint1, std::uint32_t hint2)
    : VNAMessageBase(kId), m_event(event), m_hint1(hint1), m_hint2(hint2) {}

VNAMessageEvent::VNAMessageEvent(VNAMessageMarshaling& m) : VNAMessageBase(kId, m) {
  ReadWireValue(m, m_event);
  ReadWireValue(m, m_hint1);
  ReadWireValue(m, m_hint2);
}

void VNAMessageEvent::marshal(VNAMessageMarshaling& m) const {
  VNAMessageBase::marshal(m);
  WriteWireValue(m, m_event);
  WriteWireValue(m, m_hint1);
  WriteWireValue(m, m_hint2);
}

}  // namespace vna_interprocess
