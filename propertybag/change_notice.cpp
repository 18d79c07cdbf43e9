#include "propertybag/change_notice.h"

#include "lumen/platform/ole_exception.h"

namespace LumenUtility {

void NotifyEach(const PointerSet<IPropertyBagSubscriber>& subscribers, PropertyBag* bag,
                const std::string& key, const CComVariant& value) {
  for (IPropertyBagSubscriber* subscriber = subscribers.NextAfter(nullptr); subscriber;
       subscriber = subscribers.NextAfter(subscriber)) {
    CComVariant copy;
    AfxCheckError(VariantCopyInd(&copy, &value));
    subscriber->OnItemChange(bag, key, std::move(copy));
  }
}

}  // namespace LumenUtility
