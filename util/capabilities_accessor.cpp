#include "lumen/util/capabilities_accessor.h"

#include "util/capability_table.h"
#include "util/capability_type_list.h"

namespace LumenUtility {
namespace {

// Both are created on first use and deliberately never destroyed: host modules unregister
// their objects from their own static destructors, which may run after ours.
CapabilityTable& Table() {
  static CapabilityTable* const table = new CapabilityTable;
  return *table;
}

CapabilityTypeList& TypeList() {
  static CapabilityTypeList* const types = new CapabilityTypeList;
  return *types;
}

}  // namespace

ICapabilitiesAccessor* CreateCapabilitiesAccessor() {
  static CapabilitiesAccessor* const accessor = new CapabilitiesAccessor;
  return accessor;
}

}  // namespace LumenUtility

using LumenUtility::Table;
using LumenUtility::TypeList;

int CapabilitiesAccessor::RegisterType(const std::type_info& type) {
  return TypeList().Register(type.name());
}

void CapabilitiesAccessor::SetCapability(int i, int j, int k, std::intptr_t value) {
  Table().Set(i, j, k, value);
}

std::intptr_t CapabilitiesAccessor::GetCapability(int i, int j, int k) {
  return Table().Get(i, j, k);
}

int CapabilitiesAccessor::RemoveCapabilityValue(int i, int k, std::intptr_t value) {
  return Table().RemoveValue(i, k, value);
}

int CapabilitiesAccessor::ClearCapability(int i, int j, int k) {
  return Table().Clear(i, j, k);
}

std::vector<int> CapabilitiesAccessor::FindCapabilities(int i, int k) {
  return Table().Find(i, k);
}
