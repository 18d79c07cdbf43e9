// The one walk that tells a set of change subscribers about a change: shared by a bag's own
// subscribers and the global ones.
#pragma once

#include <string>

#include "lumen/platform/com_variant.h"
#include "lumen/propertybag/pointer_set.h"
#include "lumen/propertybag/subscriber_interfaces.h"

namespace LumenUtility {

// Calls OnItemChange(bag, key, copy) for each member of `subscribers` in ascending pointer
// order, continuing after each call with the next member above the one called. Each copy is
// made by VariantCopyInd; a failed copy throws as AfxCheckError and ends the walk.
void NotifyEach(const PointerSet<IPropertyBagSubscriber>& subscribers, PropertyBag* bag,
                const std::string& key, const CComVariant& value);

}  // namespace LumenUtility
