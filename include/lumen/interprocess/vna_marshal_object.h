/** @file */
/// @class vna_interprocess::VNAMarshalObject
/// VNAMarshalObject: anything that VNAMessageMarshaling can write into a message block and
/// rebuild from one; the messages derive from it.
/// Thread-safety: as the derived class; the messages are plain values.
/// Ownership: objects rebuilt from a block are handed out through boost::shared_ptr.
#pragma once

#include "lumen/export.h"

namespace vna_interprocess {

class VNAMessageMarshaling;

class LUMEN_API VNAMarshalObject {
 public:
  /// An object without fields.
  VNAMarshalObject() = default;
  ///@{
  /// Nothing to copy; for derived classes.
  VNAMarshalObject(const VNAMarshalObject&) = default;
  VNAMarshalObject& operator=(const VNAMarshalObject&) = default;
  ///@}
  /// For deletion through the base.
  virtual ~VNAMarshalObject() = default;

  /// Writes the object's fields to the storing `m`, in the order in which the class's reading
  /// constructor takes them back.
  virtual void marshal(VNAMessageMarshaling& m) const = 0;
};

}  // namespace vna_interprocess
