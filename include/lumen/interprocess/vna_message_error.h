/** @file */
/// @class vna_interprocess::VNAMessageError
/// VNAMessageError: an error report between processes (message id 3): the error code, two
/// hints (32 bits each) and an optional 8-bit text (UTF-8, the 8-bit code page here).
/// Marshaled as id (2 bytes), Error, Hint1, Hint2 (4 bytes each), then the text as a
/// length-prefixed string.
/// Thread-safety: a plain value; confine each object to one thread. Ownership: plain value.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/export.h"
#include "lumen/interprocess/vna_message_base.h"

namespace vna_interprocess {

class LUMEN_API VNAMessageError : public VNAMessageBase {
 public:
  VNAMessageError() : VNAMessageError(0, 0, 0) {}
  /// An error message carrying the error number and two hints, with no extra text.
  VNAMessageError(std::uint32_t error, std::uint32_t hint1, std::uint32_t hint2);
  /// `extraText` is converted to UTF-8.
  VNAMessageError(std::uint32_t error, std::uint32_t hint1, std::uint32_t hint2,
                  const std::wstring& extraText);
  /// Reads the fields in marshal order from `m`; a value whose 4 bytes are missing is 0 and a
  /// missing text is empty.
  explicit VNAMessageError(VNAMessageMarshaling& m);
  ///@{
  /// Copies every field.
  VNAMessageError(const VNAMessageError&) = default;
  VNAMessageError& operator=(const VNAMessageError&) = default;
  ///@}
  ~VNAMessageError() override = default;

  ///@{
  /// The error number.
  std::uint32_t get_Error() const { return m_error; }
  void set_Error(std::uint32_t error) { m_error = error; }
  ///@}
  ///@{
  /// The first hint.
  std::uint32_t get_Hint1() const { return m_hint1; }
  void set_Hint1(std::uint32_t hint) { m_hint1 = hint; }
  ///@}
  ///@{
  /// The second hint.
  std::uint32_t get_Hint2() const { return m_hint2; }
  void set_Hint2(std::uint32_t hint) { m_hint2 = hint; }
  ///@}
  ///@{
  /// The extra text, UTF-8.
  std::string get_ExtraText() const { return m_extraText; }
  void set_ExtraText(const std::string& text) { m_extraText = text; }
  ///@}
  /// Stores `text` converted to UTF-8.
  void set_ExtraText(const std::wstring& text);
  /// The text converted from UTF-8; malformed bytes become U+FFFD.
  std::wstring get_ExtraTextAsCString() const;

  void marshal(VNAMessageMarshaling& m) const override;

 private:
  static constexpr short kId = 3;

  std::uint32_t m_error = 0;
  std::uint32_t m_hint1 = 0;
  std::uint32_t m_hint2 = 0;
  std::string m_extraText;
};

}  // namespace vna_interprocess
