/** @file */
/// @class Rigel::CommandParameter
/// Rigel::CommandParameter: one entry of an acquisition specification, the value of one
/// parameter of one hardware element ("Freq" of element "RFSrc0", for example).
///
/// Thread-safety: confine to one thread. Ownership: the value is shared; several entries may
/// hold the same value object.
#pragma once

#include <string>

#include <boost/shared_ptr.hpp>

#include "lumen/export.h"
#include "lumen/platform/rigel/generic_parameter.h"

namespace Rigel {

class LUMEN_API CommandParameter {
 public:
  /// `parameter` may be empty; the entry then matches no parameter name.
  CommandParameter(std::wstring elementName, GenericParameter::Ptr parameter);

  /// The hardware element's name.
  const std::wstring& element_name() const { return m_elementName; }
  /// The value's name, or an empty string when there is no value.
  std::wstring parameter_name() const;
  /// The value; may be empty.
  const GenericParameter::Ptr& parameter() const { return m_parameter; }
  /// Replaces the value.
  void set_parameter(GenericParameter::Ptr parameter) { m_parameter = std::move(parameter); }

 private:
  std::wstring m_elementName;
  GenericParameter::Ptr m_parameter;
};

}  // namespace Rigel
