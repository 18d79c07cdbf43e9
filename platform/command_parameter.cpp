#include "lumen/platform/rigel/command_parameter.h"

namespace Rigel {

CommandParameter::CommandParameter(std::wstring elementName, GenericParameter::Ptr parameter)
    : m_elementName(std::move(elementName)), m_parameter(std::move(parameter)) {}

std::wstring CommandParameter::parameter_name() const {
  return m_parameter ? m_parameter->name() : std::wstring();
}

}  // namespace Rigel
