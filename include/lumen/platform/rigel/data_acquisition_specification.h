/** @file */
/// @class Rigel::DataAcquisitionSpecification
/// Rigel::DataAcquisitionSpecification: what the hardware layer is to do for one acquisition,
/// as command parameters: a static collection that holds for the whole acquisition, and the
/// dynamic dimensions whose parameters change from step to step.
///
/// Thread-safety: confine to one thread. Ownership: a DataAcquisitionSpecification owns its static
/// collection and shares its dimensions.
#pragma once

#include <cstdint>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "lumen/export.h"
#include "lumen/platform/rigel/cp_collection.h"
#include "lumen/platform/rigel/cp_dimension.h"

namespace Rigel {

class LUMEN_API DataAcquisitionSpecification {
 public:
  /// How dynamic dimensions are held.
  using Dimension = boost::shared_ptr<CPDimension>;

  /// The static collection.
  CPCollection& get_static_spec() { return m_staticSpec; }
  /// The dynamic dimensions in order; an entry may be empty.
  std::vector<Dimension>& get_dynamic_spec() { return m_dynamicSpec; }
  /// Number of dynamic dimensions, empty entries included.
  std::uint32_t get_number_of_dimensions() const;
  /// Dimension `index`, or an empty pointer past the end.
  Dimension get_dimension(std::uint32_t index) const;

 private:
  CPCollection m_staticSpec;
  std::vector<Dimension> m_dynamicSpec;
};

}  // namespace Rigel
