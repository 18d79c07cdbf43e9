/// @file
/// Property bags: keyed settings with change and destruction subscribers, and their saved forms.
///
/// A PropertyBag holds PropertyBagItems under string keys. SignalItemChange tells the bag's
/// change subscribers and then the global ones, in ascending pointer order, each with its own
/// copy of the value; subscribers may come and go during the calls. SaveContext and
/// RecallContext save and recall the items through a CArchive. Values travel as CComVariant,
/// whose getters throw COleException (DISP_E_TYPEMISMATCH) for a variant of another kind.
///
/// @code
/// struct Printer final : LumenUtility::IPropertyBagSubscriber {
///   void OnItemChange(LumenUtility::PropertyBag*, const std::string& key,
///                     CComVariant value) override { /* key changed to value.GetDouble() */ }
/// } printer;
/// LumenUtility::PropertyBag bag;
/// bag.SubscribeChanges(&printer);
/// bag.SignalItemChange("Power", CComVariant(5.0));
/// bag.UnsubscribeChanges(&printer);
/// @endcode
#pragma once

#include "lumen/propertybag/global_property_bag_subscriber.h"
#include "lumen/propertybag/global_subscriber_set.h"
#include "lumen/propertybag/property_bag.h"
#include "lumen/propertybag/property_bag_item.h"
#include "lumen/propertybag/property_bag_subscriber.h"
#include "lumen/propertybag/subscriber_interfaces.h"
