#include "lumen/interprocess/vna_message_text.h"

#include "lumen/interprocess/vna_message_marshaling.h"

namespace vna_interprocess {

VNAMessageText::VNAMessageText(VNAMessageMarshaling& m) : VNAMessageBase(kId, m) {
  m.ReadFromBuffer(m_text);
}

void VNAMessageText::marshal(VNAMessageMarshaling& m) const {
  VNAMessageBase::marshal(m);
  m.WriteToBuffer(m_text);
}

}  // namespace vna_interprocess
