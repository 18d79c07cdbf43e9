/** @file */
/// @class vna_interprocess::VNAMessageBase
/// VNAMessageBase: the part every interprocess message shares, its 16-bit message id (2 event,
/// 3 error, 4 text), marshaled as 2 bytes before the message's own fields.
/// Thread-safety: a plain value; confine each object to one thread. Ownership: plain value.
#pragma once

#include "lumen/export.h"
#include "lumen/interprocess/vna_marshal_object.h"

namespace vna_interprocess {

class LUMEN_API VNAMessageBase : public VNAMarshalObject {
 public:
  /// A message of class id `id`.
  explicit VNAMessageBase(short id) : m_id(id) {}
  /// Reads the 2-byte id from `m`. A message keeps its own class id `id` whatever the data
  /// says, except that id 1 takes the id read. With fewer than 2 bytes left nothing is read
  /// and the id is `id`.
  VNAMessageBase(short id, VNAMessageMarshaling& m);
  ///@{
  /// Copies the id.
  VNAMessageBase(const VNAMessageBase&) = default;
  VNAMessageBase& operator=(const VNAMessageBase&) = default;
  ///@}
  ~VNAMessageBase() override = default;

  /// The message's class id.
  short get_id() const { return m_id; }
  /// Writes the id as 2 bytes.
  void marshal(VNAMessageMarshaling& m) const override;

 private:
  short m_id;
};

}  // namespace vna_interprocess
