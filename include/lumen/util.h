// General utilities: the capabilities table, the object factory, host object lookup, the
// interfaces of the host objects, error numbers, file search, the pattern string mapper and
// ZIP archives.
#pragma once

#include "lumen/util/capabilities_accessor.h"
#include "lumen/util/factory.h"
#include "lumen/util/file_search.h"
#include "lumen/util/from_hresult.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"
#include "lumen/util/local_regex.h"
#include "lumen/util/string_mapper.h"
#include "lumen/util/zip7_util.h"
#include "lumen/util/zlib_util.h"
