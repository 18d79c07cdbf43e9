/** @file */
/// @class vna_interprocess::VNAMessageText
/// VNAMessageText: a plain text message between processes (message id 4), 8-bit text.
/// Marshaled as id (2 bytes), then the text as a length-prefixed string.
/// Thread-safety: a plain value; confine each object to one thread. Ownership: plain value.
#pragma once

#include <string>

#include "lumen/export.h"
#include "lumen/interprocess/vna_message_base.h"

namespace vna_interprocess {

class LUMEN_API VNAMessageText : public VNAMessageBase {
 public:
  VNAMessageText() : VNAMessageBase(kId) {}
  /// A text message carrying `text` (UTF-8).
  explicit VNAMessageText(const std::string& text) : VNAMessageBase(kId), m_text(text) {}
  /// Reads the fields in marshal order from `m`; a missing text is empty.
  explicit VNAMessageText(VNAMessageMarshaling& m);
  ///@{
  /// Copies the text.
  VNAMessageText(const VNAMessageText&) = default;
  VNAMessageText& operator=(const VNAMessageText&) = default;
  ///@}
  ~VNAMessageText() override = default;

  ///@{
  /// The text, UTF-8.
  std::string get_Text() const { return m_text; }
  void set_Text(std::string text) { m_text = std::move(text); }
  ///@}

  void marshal(VNAMessageMarshaling& m) const override;

 private:
  static constexpr short kId = 4;

  std::string m_text;
};

}  // namespace vna_interprocess
