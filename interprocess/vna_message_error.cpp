#include "lumen/interprocess/vna_message_error.h"

#include "interprocess/wire_value.h"
#include "lumen/platform/text_conversion.h"

namespace vna_interprocess {

VNAMessageError::VNAMessageError(std::uint32_t error, std::uint32_t hint1, std::uint32_t hint2)
    : VNAMessageBase(kId), m_error(error), m_hint1(hint1), m_hint2(hint2) {}

VNAMessageError::VNAMessageError(std::uint32_t error, std::uint32_t hint1, std::uint32_t hint2,
                                 const std::wstring& extraText)
    : VNAMessageBase(kId),
      m_error(error),
      m_hint1(hint1),
      m_hint2(hint2),
      m_extraText(LumenUtility::WideToUtf8(extraText)) {}

VNAMessageError::VNAMessageError(VNAMessageMarshaling& m) : VNAMessageBase(kId, m) {
  ReadWireValue(m, m_error);
  ReadWireValue(m, m_hint1);
  ReadWireValue(m, m_hint2);
  m.ReadFromBuffer(m_extraText);
}

void VNAMessageError::set_ExtraText(const std::wstring& text) {
  m_extraText = LumenUtility::WideToUtf8(text);
}

std::wstring VNAMessageError::get_ExtraTextAsCString() const {
  return LumenUtility::Utf8ToWide(m_extraText);
}

void VNAMessageError::marshal(VNAMessageMarshaling& m) const {
  VNAMessageBase::marshal(m);
  WriteWireValue(m, m_error);
  WriteWireValue(m, m_hint1);
  WriteWireValue(m, m_hint2);
  m.WriteToBuffer(m_extraText);
}

}  // namespace vna_interprocess
