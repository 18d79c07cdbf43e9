// Property bags: keyed settings with change and destruction subscribers, and their saved forms.
#pragma once

#include "lumen/propertybag/global_property_bag_subscriber.h"
#include "lumen/propertybag/global_subscriber_set.h"
#include "lumen/propertybag/property_bag.h"
#include "lumen/propertybag/property_bag_item.h"
#include "lumen/propertybag/property_bag_subscriber.h"
#include "lumen/propertybag/subscriber_interfaces.h"
