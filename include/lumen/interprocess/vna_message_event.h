/** @file */
/// @class vna_interprocess::VNAMessageEvent
/// VNAMessageEvent: an event notification between processes (message id 2): the event number
/// and two hints, 32 bits each. Marshaled as id (2 bytes), Event, Hint1, Hint2 (4 bytes each).
/// Thread-safety: a plain value; confine each object to one thread. Ownership: plain value.
#pragma once

#include <cstdint>

#include "lumen/export.h"
#include "lumen/interprocess/vna_message_base.h"

namespace vna_interprocess {

class LUMEN_API VNAMessageEvent : public VNAMessageBase {
 public:
  VNAMessageEvent() : VNAMessageEvent(0, 0, 0) {}
  /// An event message carrying the event number and two hints.
  VNAMessageEvent(std::uint32_t event, std::uint32_t hint1, std::uint32_t hint2);
  /// Reads the fields in marshal order from `m`; a value whose 4 bytes are missing is 0.
  explicit VNAMessageEvent(VNAMessageMarshaling& m);
  ///@{
  /// Copies every field.
  VNAMessageEvent(const VNAMessageEvent&) = default;
  VNAMessageEvent& operator=(const VNAMessageEvent&) = default;
  ///@}
  ~VNAMessageEvent() override = default;

  ///@{
  /// The event number.
  std::uint32_t get_Event() const { return m_event; }
  void set_Event(std::uint32_t event) { m_event = event; }
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

  void marshal(VNAMessageMarshaling& m) const override;

 private:
  static constexpr short kId = 2;

  std::uint32_t m_event = 0;
  std::uint32_t m_hint1 = 0;
  std::uint32_t m_hint2 = 0;
};

}  // namespace vna_interprocess
