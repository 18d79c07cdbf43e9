// General utilities: the capabilities table, the object factory, host object lookup, the
// interfaces of the host objects and error numbers.
#pragma once

#include "lumen/util/capabilities_accessor.h"
#include "lumen/util/factory.h"
#include "lumen/util/from_hresult.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"
