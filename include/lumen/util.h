/// @file
/// General utilities: the capabilities table, the object factory, host object lookup, the
/// interfaces of the host objects, error numbers, file search, the pattern string mapper and
/// ZIP archives.
///
/// The host registers its objects with RegisterHostObject and the library finds them with
/// FindHostObject (the interfaces are in lumen/util/host_interfaces.h). StringMapper rewrites
/// names by regular-expression rules, FromHRESULT gives the analyzer's error number of an error
/// code (-200 for codes without one), FileSearch lists the entries matching a wildcard path, and
/// ZlibUtil and Zip7Util pack and extract ZIP archives, returning false instead of throwing.
///
/// @code
/// LumenUtility::StringMapper mapper(
///     {{LumenUtility::LocalRegex(L"Ch([0-9]+)_Tr([0-9]+)"), L"Channel $1, trace $2"}});
/// std::wstring name = mapper.GetMapping(L"Ch2_Tr5");               // "Channel 2, trace 5"
/// int number = FromHRESULT(LumenUtility::MakeHResult(0xE8060651));  // 100
/// bool packed = LumenUtility::ZlibUtil::DoZip(L"sweep.s2p", L"sweep.zip");
/// @endcode

/// @namespace LumenUtility::ZlibUtil
/// ZIP archives written and read with zlib.

/// @namespace LumenUtility::Zip7Util
/// ZIP archives packed and extracted by the external command-line archiver.

/// @namespace LumenApp
/// Interfaces of the host application's core objects.
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
