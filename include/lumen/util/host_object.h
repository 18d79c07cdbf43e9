/// @file
/// Typed access to host objects in the capabilities table.
///
/// The host application registers its service objects by category, index and interface type;
/// library code asks for them by the same keys:
///
///   ITestSet* testSet = LumenUtility::FindHostObject<ITestSet>(
///       LumenUtility::kHostCategoryApplication, 0);
///   if (testSet == nullptr) { ...the object is missing... }
///
/// The interface type is registered under the name of its pointer type (typeid(Interface*)),
/// so a host that registers through the raw accessor must use that type too. The accessor and
/// the type's index are fetched once per interface type and kept in function-local statics.
///
/// Thread-safety: that of the capabilities table (none); objects are not owned.
#pragma once

#include <cstdint>
#include <typeinfo>

#include "lumen/util/capabilities_accessor.h"

namespace LumenUtility {

///@{
/// Categories in use: category 1 holds one object per measurement (index = measurement
/// number), category 3 the application-wide service objects (index 0).
inline constexpr int kHostCategoryMeasurement = 1;
inline constexpr int kHostCategoryApplication = 3;
///@}

/// Returns the index of Interface in the process-wide type list, registering it on first use.
template <class Interface>
int HostObjectTypeIndex() {
  static const int typeIndex = CreateCapabilitiesAccessor()->RegisterType(typeid(Interface*));
  return typeIndex;
}

/// Returns the object registered as Interface under (category, index), or nullptr when there
/// is none (including a negative category or index).
template <class Interface>
Interface* FindHostObject(int category, int index) {
  static ICapabilitiesAccessor* const accessor = CreateCapabilitiesAccessor();
  const std::intptr_t address =
      accessor->GetCapability(category, index, HostObjectTypeIndex<Interface>());
  return reinterpret_cast<Interface*>(address);
}

/// Registers object as Interface under (category, index), replacing any earlier object there.
/// The address stored is that of the Interface part of the object, which is what
/// FindHostObject hands back. category and index must not be negative (std::invalid_argument).
template <class Interface>
void RegisterHostObject(int category, int index, Interface* object) {
  CreateCapabilitiesAccessor()->SetCapability(category, index, HostObjectTypeIndex<Interface>(),
                                              reinterpret_cast<std::intptr_t>(object));
}

/// Removes object as Interface from every index of category; other objects stay.
template <class Interface>
void RemoveHostObject(int category, Interface* object) {
  if (object == nullptr) return;  // 0 marks free entries; there is nothing to remove
  CreateCapabilitiesAccessor()->RemoveCapabilityValue(category, HostObjectTypeIndex<Interface>(),
                                                      reinterpret_cast<std::intptr_t>(object));
}

}  // namespace LumenUtility
