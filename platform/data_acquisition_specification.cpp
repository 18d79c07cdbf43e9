#include "lumen/platform/rigel/data_acquisition_specification.h"

namespace Rigel {

std::uint32_t DataAcquisitionSpecification::get_number_of_dimensions() const {
  return static_cast<std::uint32_t>(m_dynamicSpec.size());
}

DataAcquisitionSpecification::Dimension DataAcquisitionSpecification::get_dimension(
    std::uint32_t index) const {
  return index < m_dynamicSpec.size() ? m_dynamicSpec[index] : Dimension();
}

}  // namespace Rigel
